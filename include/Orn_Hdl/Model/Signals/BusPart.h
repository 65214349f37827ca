/// \file
/// The parts of a bus: `BusSlice`, `BusIndex`, and their base `BusPart`.
#pragma once

#include "Orn_Hdl/Model/Signals/Signal.h"
#include "Port/Export.h"

namespace Orn_Hdl {

class Bus;
class BusParts;

/// A slice or a bit of a bus. The writers do not declare it: its bus is declared.
class ORN_HDL_API BusPart : public Signal {
public:
    /// The parent drops the part.
    ~BusPart() override;

    /// The parent's direction; without a parent, the part's own.
    Polarity GetPortPolarity() const override;
    bool IsNeededToDeclared() const override { return false; }
    /// The name with "_DUMMY" before the range or index.
    Port::StringBase<char> GetDummySignalName() const override;
    void GetBaseName(StringSet& names) const override;

    /// The name before "(".
    Port::StringBase<char> GetBaseName() const;
    /// The bus that lists this part; null when there is none.
    Bus* GetParentBus() const noexcept;

protected:
    /// A part that a bus lists, which may be null. If allocation fails, the bus stays as it is.
    BusPart(const char* name, Bus* parent);

    void LeaveAll() noexcept override;

private:
    friend class BusParts;

    BusParts* parts_ = nullptr;
};

/// A contiguous part of a bus, such as D(3:0) of D(7:0).
class ORN_HDL_API BusSlice final : public BusPart {
public:
    /// A slice that its bus lists.
    /// \param name null is read as "".
    /// \param parent the bus; not owned, may be null.
    BusSlice(const Port::TextArgument& name, Bus* parent) : BusPart(name, parent) {}

    int GetSignalType() const override { return SignalTypeBusSlice; }
    /// Does nothing: a slice has its parent's polarity.
    void SetPortPolarity(const Polarity& polarity) override;
    void AcceptSignal(SignalVisitor& visitor) override;
    int GetWidth() const override;
    bool IsPort() const override { return false; }
    /// A new slice with the dummy name and that parent; the caller owns it.
    BusSlice* CreateDummySignal(Bus* parent) const;

    /// The texts of both indices. \return false, both untouched, when the name is no bus name.
    bool GetIndex(Port::StringBase<char>& left, Port::StringBase<char>& right) const;
    /// Whether the range is descending; that of D(3:3) is not.
    bool IsDownTo() const noexcept;
    /// True without a parent; false for a slice of one bit; otherwise whether both or none of slice
    /// and parent have a descending range.
    bool IsSameDirectionAsParent() const noexcept;
};

/// One bit of a bus, such as D(2).
class ORN_HDL_API BusIndex final : public BusPart {
public:
    /// A bit that its bus lists.
    /// \param name null is read as "".
    /// \param parent the bus; not owned, may be null.
    BusIndex(const Port::TextArgument& name, Bus* parent) : BusPart(name, parent) {}

    int GetSignalType() const override { return SignalTypeBusIndex; }
    /// Sets the bit's own polarity, which shows only without a parent.
    void SetPortPolarity(const Polarity& polarity) override { SetDirection(polarity.GetValue()); }
    void AcceptSignal(SignalVisitor& visitor) override;
    int GetWidth() const override { return 1; }
    bool IsPort() const override { return GetPortPolarity().IsValid(); }
    /// A new bit with the dummy name and that parent; the caller owns it.
    BusIndex* CreateDummySignal(Bus* parent) const;

    /// The text of the index; empty when the name is no bit name.
    Port::StringBase<char> GetIndex() const;

    /// Whether a normalised text is a base name followed by "(", an integer and ")".
    static bool IsBusIndexName(const char* name) noexcept;
    /// Splits a bit name into the texts of its base name and index.
    /// \return false, both results untouched, when it is no bit name.
    static bool ParseBusIndexName(const char* name, Port::StringBase<char>& base,
                                  Port::StringBase<char>& index);
    /// Splits a bit name into its base name and the index as a number, saturated to 32 bits.
    /// \return false, both results untouched, when it is no bit name.
    static bool ParseBusIndexName(const char* name, Port::StringBase<char>& base, int& index);
};

} // namespace Orn_Hdl
