// The signals of a netlist as the next write settles them, before it makes dummies for further
// signals: the remembered dummies have taken over what their signals have gained in the meantime.
//
// A write does that first, and only a write makes dummies, so a script says the result of it: the
// dummies are signals like any others.
#pragma once

#include "HdlModel/Netlist/DummySignals.h"
#include "Orn_Hdl/Model/Netlist.h"

#include <string>
#include <string_view>
#include <unordered_map>
#include <unordered_set>
#include <vector>

namespace Orn_Hdl::Script {

/// A signal of a settled netlist: one that is there, or the dummy that the next write makes for a
/// slice or bit whose bus has one.
struct SettledSignal {
    /// The signal, or the slice or bit for which the dummy will be made.
    const Signal* signal = nullptr;
    bool isDummyToCome = false;
};

/// A look at the signals of a netlist, which must not change meanwhile.
class SettledSignals {
public:
    explicit SettledSignals(const Netlist& netlist);
    SettledSignals(const SettledSignals&) = delete;
    SettledSignals& operator=(const SettledSignals&) = delete;

    /// The signal to which the listed pins of a signal belong.
    SettledSignal GetCarrier(const Signal& signal) const;
    /// The name by which commands know a signal; empty for a compound that no command can name.
    std::string GetName(const SettledSignal& settled) const;
    /// The signals that drive a signal by aliases, in order.
    std::vector<const Signal*> GetAliases(const SettledSignal& settled) const;
    /// The constant of a signal, valid as long as the netlist does not change.
    const BitVectorValue& GetConstant(const SettledSignal& settled) const;
    /// Whether a listed pin belongs to a signal.
    bool HasListedPin(const SettledSignal& settled) const;
    /// Whether everything of a compound has gone to its dummy, so that nothing shows it.
    bool IsEmptied(const CompoundBus& compound) const;
    /// Calls `visit` with each part of a bus, in order, those to come last.
    template <class Visit> void ForEachPart(const Bus& bus, const Visit& visit) const {
        for (const Signal* part : bus.GetBusSliceIterator()) {
            visit(SettledSignal{part});
        }
        for (const Signal* original : GetOriginalsOfPartsToCome(bus)) {
            visit(SettledSignal{original, true});
        }
    }

private:
    using Entry = DummySignals::Entry;

    std::vector<const Signal*> GetOriginalsOfPartsToCome(const Bus& bus) const;
    /// The aliases that a signal has, with those that it takes over if it is a dummy.
    std::vector<const Signal*> GetOwnAliases(const Signal& signal) const;
    const BitVectorValue& GetOwnConstant(const Signal& signal) const;
    bool HasOwnPin(const Signal& signal) const;
    /// The entry by which a signal hands over to a dummy that is there or to come; null for none.
    const Entry* FindSuccession(const Signal& signal) const;
    SettledSignal GetSuccessor(const Signal& signal) const;
    std::vector<std::string> GetMemberNames(const CompoundBus& compound) const;
    void NameCompound(const CompoundBus& compound);

    const Netlist& netlist_;
    const DummySignals& dummies_;
    /// The names of the compounds whose own names do not name their members.
    std::unordered_map<const Signal*, std::string> compoundNames_;
    std::unordered_set<std::string> givenNames_;
};

} // namespace Orn_Hdl::Script
