/// \file
/// Signals: scalar signals, buses, slices and bits of buses, compounds of signals; `SignalVisitor`.
#pragma once

#include "Orn_Hdl/Attributes.h"
#include "Orn_Hdl/Containers/PtrArray.h"
#include "Orn_Hdl/Containers/StringArray.h"
#include "Orn_Hdl/Containers/StringSet.h"
#include "Orn_Hdl/Model/Object.h"
#include "Orn_Hdl/Model/Pins.h"
#include "Port/Export.h"
#include "Port/String.h"

#include <memory>
#include <vector>

namespace Orn_Hdl {

class Bus;
class BusIndex;
class BusSlice;
class CompoundBus;
class ScalarSignal;
class SignalVisitor;

/// Codes of the signal classes.
enum SignalType {
    SignalTypeScalar = 50,
    SignalTypeBus = 51,
    SignalTypeBusSlice = 52,
    SignalTypeBusIndex = 53,
    SignalTypeCompoundBus = 54
};

/// Anything that a pin can be wired to. Its name carries its shape: N, D(7:0), D(3:0) as a slice of
/// D(7:0), D(2), or the compound A,D(3:0). A signal with a port polarity is a port of the netlist.
class ORN_HDL_API Signal : public Object, public AttributeHolder {
public:
    Signal(const Signal&) = delete;
    Signal& operator=(const Signal&) = delete;
    /// Opens every pin that points at this signal and leaves every list that names it.
    ~Signal() override;

    void AcceptObject(ObjectVisitor& visitor) override;
    /// The class, a `SignalType`.
    virtual int GetSignalType() const = 0;
    /// Makes the signal a port of that direction, or no port when it is invalid.
    virtual void SetPortPolarity(const Polarity& polarity) = 0;
    /// Calls the visit operation of this signal's class, then `VisitSignal`.
    virtual void AcceptSignal(SignalVisitor& visitor) = 0;
    /// The direction; invalid when the signal is no port.
    virtual Polarity GetPortPolarity() const = 0;
    /// The number of bits, at most INT_MAX; 0 for a range that does not parse.
    virtual int GetWidth() const = 0;
    /// Whether the signal is a port.
    virtual bool IsPort() const = 0;
    /// Whether the writers declare the signal: only scalar signals and buses.
    virtual bool IsNeededToDeclared() const = 0;
    /// The name of the extra signal that may stand in for this one when a netlist is written.
    virtual Port::StringBase<char> GetDummySignalName() const = 0;

    /// Lists a pin and points it here. Null, and a pin that is listed and points here, change
    /// nothing. A signal that the pin pointed at before still lists it.
    void Connect(Pin* pin);
    /// Lists another signal as an alias of this one, once. The other does not list this one.
    void Connect(Signal* other);
    /// Takes a pin out of the list; if it still points here, it becomes open.
    void Disconnect(Pin* pin);
    void Disconnect(Signal* other);
    /// Opens every pin that points here, and empties both lists.
    void DisconnectAll();
    /// Takes over, from another signal, the pins that still point at it, and its aliases.
    void CloneConnection(Signal* other);

    /// \{
    /// Ties the signal to a constant.
    void AssignConstantValue(const BitVectorValue& value);
    void AssignConstantValue(const char* value);
    /// \}
    /// The constant, with an empty text when there is none.
    const BitVectorValue& GetConstantValue() const noexcept;

    /// The listed pins, in the order in which they were connected.
    Iterator<Pin*> GetPinIterator() const noexcept { return Iterator<Pin*>(&pins_); }
    /// The listed aliases, in order.
    Iterator<Signal*> GetSignalIterator() const noexcept;

    /// Whether more than one listed output pin points at this signal.
    bool HasMultiDriver() const noexcept;
    /// Adds this signal's base names to a set: of a scalar signal its name, of a bus, slice or bit
    /// the name before "(", of a compound those of its members, then its own name.
    virtual void GetBaseName(StringSet& names) const = 0;

protected:
    /// A signal without pins; a null name is read as "".
    explicit Signal(const char* name);

    /// Leaves everything that names this signal and opens its pins, before it ends.
    virtual void LeaveAll() noexcept;
    /// Takes a signal that is about to end out of whatever lists or members name it.
    virtual void Forget(Signal* signal) noexcept;
    /// Whether both end with their netlist, so that neither need take leave of the other.
    static bool EndTogether(const Signal& a, const Signal& b) noexcept {
        return a.HasFlag(DyingFlag) && b.HasFlag(DyingFlag);
    }
    /// Remembers that `by` names this signal, so that it can be told when this signal ends.
    void NoteReferrer(Signal* by);
    /// Forgets that `by` names this signal.
    void DropReferrer(const Signal* by) noexcept;
    /// Appends a signal to a list of this one, and remembers in it that this one names it.
    void AddReference(PtrArray<Signal*>& list, Signal* signal);

private:
    friend class Bus;
    friend class CompoundBus;
    friend class DummySignals;
    friend class Netlist;
    friend class Pin;
    struct Links;

    Links& MakeLinks();
    void OpenPins() noexcept;
    void Unlist(Pin* pin) noexcept;
    /// Pins that point here without being listed.
    void AddUnlistedPin(Pin* pin);
    void RemoveUnlistedPin(const Pin* pin) noexcept;
    void ReplaceEverywhereBy(Signal* other);
    void TakeCommentOf(const Signal& other);
    /// Whether a pin of that polarity, or a bidirectional one, points at this signal.
    bool HasPinOf(int polarity) const noexcept;
    /// Whether a compound that no netlist holds has this signal as a member.
    bool HasLooseCompound() const noexcept;
    virtual void ReplaceReference(Signal* from, Signal* to);
    void MarkDying() noexcept { SetFlag(DyingFlag, true); }

    static constexpr unsigned DyingFlag = 0x10;

    /// Most nets have a driver and a load or two: their pins are listed in the signal itself.
    SmallPtrArray<Pin*, 3> pins_;
    std::unique_ptr<Links> links_;
};

/// A net of one bit.
class ORN_HDL_API ScalarSignal final : public Signal {
public:
    /// A null name is read as "".
    explicit ScalarSignal(const char* name) : Signal(name) {}

    int GetSignalType() const override { return SignalTypeScalar; }
    void SetPortPolarity(const Polarity& polarity) override { SetDirection(polarity.GetValue()); }
    void AcceptSignal(SignalVisitor& visitor) override;
    Polarity GetPortPolarity() const override { return Polarity(GetDirection()); }
    int GetWidth() const override { return 1; }
    bool IsPort() const override { return Polarity::IsValidValue(GetDirection()); }
    bool IsNeededToDeclared() const override { return true; }
    /// The name with "_DUMMY" behind it, unless it ends so.
    Port::StringBase<char> GetDummySignalName() const override;
    void GetBaseName(StringSet& names) const override;
    /// A new scalar signal with the dummy name; the caller owns it.
    ScalarSignal* CreateDummySignal() const;
};

/// A declared bus, such as D(7:0). It knows its slices and bits, which it does not own.
class ORN_HDL_API Bus final : public Signal {
public:
    /// A null name is read as "".
    explicit Bus(const char* name);
    ~Bus() override;

    int GetSignalType() const override { return SignalTypeBus; }
    void SetPortPolarity(const Polarity& polarity) override { SetDirection(polarity.GetValue()); }
    void AcceptSignal(SignalVisitor& visitor) override;
    Polarity GetPortPolarity() const override { return Polarity(GetDirection()); }
    int GetWidth() const override;
    bool IsPort() const override { return Polarity::IsValidValue(GetDirection()); }
    bool IsNeededToDeclared() const override { return true; }
    Port::StringBase<char> GetDummySignalName() const override;
    void GetBaseName(StringSet& names) const override;
    /// A new bus with the dummy name; the caller owns it.
    Bus* CreateDummySignal() const;

    /// The name before "(".
    Port::StringBase<char> GetBaseName() const;
    /// The indices of the name; untouched and false when the name is no bus name.
    bool GetIndex(Port::StringBase<char>& left, Port::StringBase<char>& right) const;
    bool GetIndex(int& left, int& right) const noexcept;
    /// Whether the left index is greater than the right one; D(3:3) is not down-to.
    bool IsDownTo() const noexcept;

    /// Lists a slice or bit, once, and becomes its parent; its former parent drops it.
    void AddBusSlice(Signal* slice);
    /// Drops a slice or bit, which then has no parent.
    void RemoveBusSlice(Signal* slice);
    /// Drops all slices and bits, which then have no parent.
    void EmptyBusSlice();
    /// The slices and bits, in order.
    Iterator<Signal*> GetBusSliceIterator() const noexcept;

    /// Whether a normalised text is a base name followed by "(", an integer, ":", an integer and
    /// ")".
    static bool IsBusName(const char* name) noexcept;
    /// Splits a bus name into the texts of its base name and indices.
    /// \return false, everything untouched, when it is no bus name.
    static bool ParseBusName(const char* name, Port::StringBase<char>& base,
                             Port::StringBase<char>& left, Port::StringBase<char>& right);
    /// As above with the indices as numbers, which saturate at 32 bits.
    static bool ParseBusName(const char* name, Port::StringBase<char>& base, int& left, int& right);
    /// Appends the name of each bit, from the left index to the right one.
    /// \return false, the list untouched, when it is no bus name or has more than 1,048,576 bits.
    static bool ParseBusName(const char* name, StringArray& bits);
    /// Of a bus name, the piece that starts `start` bits from its left and spans `count` bits, in
    /// its own direction; of any other name, name(start:count).
    static Port::StringBase<char> GetBusSliceName(const char* name, int start, int count);

private:
    struct Parts;

    /// Where a slice or bit keeps the parts to which it belongs; null for any other signal.
    static Parts** PartsLink(Signal* signal) noexcept;
    /// Takes over all slices and bits of another bus, behind its own.
    void TakeParts(Bus& other);

    void LeaveAll() noexcept override;
    void Forget(Signal* signal) noexcept override;
    void ReplaceReference(Signal* from, Signal* to) override;

    friend class BusIndex;
    friend class BusSlice;
    friend class Netlist;

    std::unique_ptr<Parts> parts_;
};

/// A contiguous part of a bus, such as D(3:0) of D(7:0).
class ORN_HDL_API BusSlice final : public Signal {
public:
    /// \param parent the bus, which lists the new slice; may be null. Not owned.
    BusSlice(const char* name, Bus* parent);
    ~BusSlice() override;

    int GetSignalType() const override { return SignalTypeBusSlice; }
    /// Does nothing: a slice has its parent's polarity.
    void SetPortPolarity(const Polarity& polarity) override;
    void AcceptSignal(SignalVisitor& visitor) override;
    Polarity GetPortPolarity() const override;
    int GetWidth() const override;
    bool IsPort() const override { return false; }
    bool IsNeededToDeclared() const override { return false; }
    Port::StringBase<char> GetDummySignalName() const override;
    void GetBaseName(StringSet& names) const override;
    /// A new slice with the dummy name and that parent; the caller owns it.
    BusSlice* CreateDummySignal(Bus* parent) const;

    /// The name before "(".
    Port::StringBase<char> GetBaseName() const;
    /// The texts of both indices; untouched and false when the name is no bus name.
    bool GetIndex(Port::StringBase<char>& left, Port::StringBase<char>& right) const;
    /// Whether the left index is greater than the right one.
    bool IsDownTo() const noexcept;
    /// True without a parent; false for a one-bit slice; otherwise whether both count down or
    /// neither does.
    bool IsSameDirectionAsParent() const noexcept;
    /// The bus that lists this; null when there is none.
    Bus* GetParentBus() const noexcept;

private:
    friend class Bus;

    void LeaveAll() noexcept override;

    Bus::Parts* parts_ = nullptr;
};

/// One bit of a bus, such as D(2).
class ORN_HDL_API BusIndex final : public Signal {
public:
    /// \param parent the bus, which lists the new bit; may be null. Not owned.
    BusIndex(const char* name, Bus* parent);
    ~BusIndex() override;

    int GetSignalType() const override { return SignalTypeBusIndex; }
    /// Sets the bit's own polarity, which shows only without a parent.
    void SetPortPolarity(const Polarity& polarity) override { SetDirection(polarity.GetValue()); }
    void AcceptSignal(SignalVisitor& visitor) override;
    Polarity GetPortPolarity() const override;
    int GetWidth() const override { return 1; }
    bool IsPort() const override { return GetPortPolarity().IsValid(); }
    bool IsNeededToDeclared() const override { return false; }
    Port::StringBase<char> GetDummySignalName() const override;
    void GetBaseName(StringSet& names) const override;
    /// A new bit with the dummy name and that parent; the caller owns it.
    BusIndex* CreateDummySignal(Bus* parent) const;

    /// The name before "(".
    Port::StringBase<char> GetBaseName() const;
    /// The text of the index; empty when the name is no bit name.
    Port::StringBase<char> GetIndex() const;
    /// The bus that lists this; null when there is none.
    Bus* GetParentBus() const noexcept;

    /// Whether a normalised text is a base name followed by "(", an integer and ")".
    static bool IsBusIndexName(const char* name) noexcept;
    /// Splits a bit name. \return false, everything untouched, when it is none.
    static bool ParseBusIndexName(const char* name, Port::StringBase<char>& base,
                                  Port::StringBase<char>& index);
    static bool ParseBusIndexName(const char* name, Port::StringBase<char>& base, int& index);

private:
    friend class Bus;

    void LeaveAll() noexcept override;

    Bus::Parts* parts_ = nullptr;
};

/// A concatenation of signals, leftmost first. It does not own its members.
///
/// Compounds may contain compounds, within limits: what would exceed one is not added.
class ORN_HDL_API CompoundBus final : public Signal {
public:
    /// How deep compounds can be nested, the outermost one counted.
    static constexpr int MostLevels = 1000;
    /// How many compounds one can contain, at all levels, each counted wherever it occurs.
    static constexpr int MostCompounds = 4000;

    /// A compound without members; a null name is read as "".
    explicit CompoundBus(const char* name) : Signal(name) {}
    /// As above, with members, which are added as `AddBusMember` does.
    CompoundBus(const char* name, const PtrArray<Signal*>& members);
    ~CompoundBus() override;

    int GetSignalType() const override { return SignalTypeCompoundBus; }
    /// Sets each member's polarity.
    void SetPortPolarity(const Polarity& polarity) override;
    void AcceptSignal(SignalVisitor& visitor) override;
    /// The value that all members share, otherwise invalid.
    Polarity GetPortPolarity() const override;
    int GetWidth() const override;
    bool IsPort() const override { return false; }
    bool IsNeededToDeclared() const override { return false; }
    /// The members' dummy names, joined by ",".
    Port::StringBase<char> GetDummySignalName() const override;
    void GetBaseName(StringSet& names) const override;
    /// A new compound without members; the caller owns it.
    CompoundBus* CreateDummySignal() const;

    /// Appends a member. Null is skipped, and so is a signal that is, or contains, this compound,
    /// and a compound that would exceed a limit.
    void AddBusMember(Signal* member);
    /// Replaces a member; an index out of range, and what `AddBusMember` skips, change nothing.
    void SetAt(int index, Signal* member);
    /// The member at an index; null when there is none.
    Signal* GetAt(int index) const noexcept { return members_.GetAt(index); }
    /// The number of members.
    int GetSize() const noexcept { return members_.GetSize(); }
    /// The members, leftmost first.
    Iterator<Signal*> GetBusMemberIterator() const noexcept { return Iterator<Signal*>(&members_); }

    /// Whether a normalised text is two or more base, bus or bit names, separated by "," or "\".
    static bool IsCompoundBusName(const char* name) noexcept;
    /// Appends the names in a compound name, in order; with `expand` a bus name gives its bits.
    /// \return false, the list untouched, when a bus to expand has more than 1,048,576 bits.
    static bool ParseCompoundBusName(const char* name, StringArray& names, bool expand);

private:
    bool Reaches(const Signal* from) const;
    bool IsWithinLimits() const;
    bool LeavesLimits() const;
    template <class TakeOut> bool KeepWithinLimits(Signal& member, const TakeOut& takeOut);
    void GetHolders(std::vector<const CompoundBus*>& holders) const;
    void LeaveAll() noexcept override;
    void Forget(Signal* signal) noexcept override;
    void ReplaceReference(Signal* from, Signal* to) override;

    PtrArray<Signal*> members_;
};

/// Visits signals by class; every operation of the base does nothing.
class ORN_HDL_API SignalVisitor {
public:
    SignalVisitor() = default;
    SignalVisitor(const SignalVisitor&) = default;
    SignalVisitor& operator=(const SignalVisitor&) = default;
    virtual ~SignalVisitor();
    /// \{
    /// Called by a signal's `AcceptSignal`: first by its class, then `VisitSignal`.
    virtual void VisitSignal(Signal* signal);
    virtual void VisitScalarSignal(ScalarSignal* signal);
    virtual void VisitBus(Bus* bus);
    virtual void VisitBusSlice(BusSlice* slice);
    virtual void VisitBusIndex(BusIndex* bit);
    virtual void VisitCompoundBus(CompoundBus* compound);
    /// \}
};

} // namespace Orn_Hdl
