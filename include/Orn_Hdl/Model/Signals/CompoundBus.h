/// \file
/// `CompoundBus`, a concatenation of signals.
#pragma once

#include "Orn_Hdl/Containers/StringArray.h"
#include "Orn_Hdl/Model/Signals/Signal.h"
#include "Port/Export.h"

namespace Orn_Hdl {

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
    explicit CompoundBus(const Port::TextArgument& name) : Signal(name) {}
    /// A compound with members, which are added as `AddBusMember` does; a null name is read as "".
    CompoundBus(const Port::TextArgument& name, const PtrArray<Signal*>& members);
    ~CompoundBus() override;

    int GetSignalType() const override { return SignalTypeCompoundBus; }
    /// Sets each member's polarity.
    void SetPortPolarity(const Polarity& polarity) override;
    void AcceptSignal(SignalVisitor& visitor) override;
    /// The value that all members share, otherwise invalid.
    Polarity GetPortPolarity() const override;
    /// The sum of the members' widths, at most INT_MAX.
    int GetWidth() const override;
    bool IsPort() const override { return false; }
    bool IsNeededToDeclared() const override { return false; }
    /// The members' dummy names, joined by ",".
    Port::StringBase<char> GetDummySignalName() const override;
    void GetBaseName(StringSet& names) const override;
    /// A new compound with the dummy name and without members; the caller owns it.
    CompoundBus* CreateDummySignal() const;

    /// Appends a member. Null is skipped, and so is a signal that is, or contains, this compound,
    /// and a compound that would exceed a limit. If allocation fails, nothing changes.
    /// \param member not owned.
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
    template <class TakeOut> bool KeepWithinLimits(Signal& member, const TakeOut& takeOut);
    void LeaveAll() noexcept override;
    void Forget(Signal* signal) noexcept override;
    void ReplaceReference(Signal* from, Signal* to) override;

    PtrArray<Signal*> members_;
};

} // namespace Orn_Hdl
