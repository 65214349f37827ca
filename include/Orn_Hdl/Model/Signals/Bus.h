/// \file
/// `Bus`, a declared bus.
#pragma once

#include "Orn_Hdl/Containers/StringArray.h"
#include "Orn_Hdl/Model/Signals/Signal.h"
#include "Port/Export.h"

#include <memory>

namespace Orn_Hdl {

class BusParts;

/// A declared bus, such as D(7:0). It knows its slices and bits, which it does not own.
class ORN_HDL_API Bus final : public Signal {
public:
    /// A bus that is no port and has no slices; a null name is read as "".
    explicit Bus(const Port::TextArgument& name);
    /// Leaves the slices and bits without a parent.
    ~Bus() override;

    int GetSignalType() const override { return SignalTypeBus; }
    void SetPortPolarity(const Polarity& polarity) override { SetDirection(polarity.GetValue()); }
    void AcceptSignal(SignalVisitor& visitor) override;
    Polarity GetPortPolarity() const override { return Polarity(GetDirection()); }
    int GetWidth() const override;
    bool IsPort() const override { return Polarity::IsValidValue(GetDirection()); }
    bool IsNeededToDeclared() const override { return true; }
    /// The name with "_DUMMY" before the range, unless the base name ends so.
    Port::StringBase<char> GetDummySignalName() const override;
    void GetBaseName(StringSet& names) const override;
    /// A new bus with the dummy name; the caller owns it.
    Bus* CreateDummySignal() const;

    /// The name before "(".
    Port::StringBase<char> GetBaseName() const;
    /// The texts of both indices. \return false, both untouched, when the name is no bus name.
    bool GetIndex(Port::StringBase<char>& left, Port::StringBase<char>& right) const;
    /// Both indices as numbers, saturated to 32 bits. \return false, both untouched, when the name
    /// is no bus name.
    bool GetIndex(int& left, int& right) const noexcept;
    /// Whether the range is descending; that of D(3:3) is not.
    bool IsDownTo() const noexcept;

    /// Lists a slice or bit, once, and becomes its parent; its former parent drops it. A signal of
    /// another class is listed without getting a parent. Null is ignored.
    /// \param slice not owned.
    void AddBusSlice(Signal* slice);
    /// Drops a slice or bit, which then has no parent. A signal that is not listed is ignored.
    void RemoveBusSlice(Signal* slice);
    /// Drops all slices and bits, which then have no parent.
    void EmptyBusSlice();
    /// The slices and bits, in order of addition.
    Iterator<Signal*> GetBusSliceIterator() const noexcept;

    /// Whether a normalised text is a base name followed by "(", an integer, ":", an integer and
    /// ")".
    static bool IsBusName(const char* name) noexcept;
    /// Splits a bus name into the texts of its base name and indices.
    /// \return false, all results untouched, when it is no bus name.
    static bool ParseBusName(const char* name, Port::StringBase<char>& base,
                             Port::StringBase<char>& left, Port::StringBase<char>& right);
    /// Splits a bus name into its base name and the indices as numbers, saturated to 32 bits.
    /// \return false, all results untouched, when it is no bus name.
    static bool ParseBusName(const char* name, Port::StringBase<char>& base, int& left, int& right);
    /// Appends the name of each bit, from the left index to the right one.
    /// \return false, the list untouched, when it is no bus name or has more than 1,048,576 bits.
    static bool ParseBusName(const char* name, StringArray& bits);
    /// Of a bus name, the piece that starts `start` bits from its left and spans `count` bits, in
    /// its own direction; of any other name, name(start:count).
    static Port::StringBase<char> GetBusSliceName(const char* name, int start, int count);

private:
    friend class BusParts;

    void LeaveAll() noexcept override;
    void Forget(Signal* signal) noexcept override;
    void ReplaceReference(Signal* from, Signal* to) override;

    std::unique_ptr<BusParts> parts_;
};

} // namespace Orn_Hdl
