// Which signals name which, so that none names a destroyed one.
//
//   a signal is named by                   it is named in           at its destruction is told
//   a signal of which it is an alias       Links::aliases           that signal: Forget
//   a compound of which it is a member     CompoundBus::members_    that compound: Forget
//   a bus that lists it as a slice though  BusParts::signals_       that bus: Forget
//   it is a signal of another class
//   the dummy signals of a netlist         DummySignals::entries_   its keeper: Forget
//
// The first three are its referrers: each notes itself in `Links::referrers` of the signal that it
// names, once for each time, and drops that note when it no longer names it. A keeper counts its
// entries in `Links::timesKept`. A slice or bit knows its bus by itself: see BusParts.
//
// When a netlist is destroyed, signals that are all destroyed with it need not tell each other.
#pragma once

#include "Orn_Hdl/Model/Signals/Signal.h"

#include <vector>

namespace Orn_Hdl {

class DummySignals;

/// The operations on the references between signals. If allocation fails, nothing changes.
class References {
public:
    /// Notes that a signal is named by another one.
    static void Note(Signal& signal, Signal& by);
    /// Drops one such note, unless both signals are destroyed together.
    static void Drop(Signal& signal, const Signal& by) noexcept;
    /// Appends a signal to a list of another one, and notes that.
    static void Add(Signal& by, PtrArray<Signal*>& list, Signal& signal);
    /// The signals that name a signal as an alias, a member or a slice, once for each time.
    static const std::vector<Signal*>& GetReferrers(const Signal& signal) noexcept;
    /// Lets all referrers of a signal name another one in its place.
    static void ReplaceEverywhere(Signal& from, Signal& to);

    /// Lists an alias, once.
    static void AddAlias(Signal& signal, Signal& alias);
    /// Takes a signal out of the aliases of another one.
    static void RemoveAlias(Signal& signal, Signal& alias) noexcept;
    /// Takes all aliases out, but for one if it is not null.
    static void RemoveAliases(Signal& signal, const Signal* remaining = nullptr) noexcept;
    /// Puts a signal in the place of another one, if that is an alias.
    static void ReplaceAlias(Signal& signal, Signal& from, Signal& to);
    /// Takes an alias out that is about to be destroyed.
    static void ForgetAlias(Signal& signal, Signal& alias) noexcept;
    /// The aliases; null for none.
    static const PtrArray<Signal*>* GetAliases(const Signal& signal) noexcept;

    /// Who keeps a signal; null for nobody.
    static DummySignals* GetKeeper(const Signal& signal) noexcept;
    /// Makes room for a keeper.
    static void PrepareToKeep(Signal& signal);
    /// Counts one more entry of the keeper. `PrepareToKeep` was called before.
    static void Keep(Signal& signal, DummySignals& keeper) noexcept;
    /// Counts one entry less; with the last one the signal has no keeper.
    static void Release(Signal& signal) noexcept;

    /// Whether both signals are destroyed with their netlist, so that neither must tell the other.
    static bool AreDestroyedTogether(const Signal& a, const Signal& b) noexcept;
    /// Drops all aliases of a signal, and lets all that name it forget it, before it is destroyed.
    static void Leave(Signal& signal) noexcept;
    /// Unlinks signals from everything, before all of them are destroyed.
    static void LeaveTogether(const PtrArray<Signal*>& signals) noexcept;
};

} // namespace Orn_Hdl
