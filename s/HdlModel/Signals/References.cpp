#include "HdlModel/Signals/References.h"

#include "HdlModel/Netlist/DummySignals.h"
#include "HdlModel/Signals/SignalLinks.h"

#include <algorithm>
#include <functional>
#include <unordered_set>

namespace Orn_Hdl {

void References::Note(Signal& signal, Signal& by) {
    signal.MakeLinks().referrers.push_back(&by);
}

void References::Drop(Signal& signal, const Signal& by) noexcept {
    if (signal.links_ != nullptr && !AreDestroyedTogether(signal, by)) {
        EraseOne(signal.links_->referrers, &by);
    }
}

void References::Add(Signal& by, PtrArray<Signal*>& list, Signal& signal) {
    Note(signal, by);
    try {
        list.Add(&signal);
    } catch (...) {
        Drop(signal, by);
        throw;
    }
}

const std::vector<Signal*>& References::GetReferrers(const Signal& signal) noexcept {
    static const std::vector<Signal*> none;
    return signal.links_ == nullptr ? none : signal.links_->referrers;
}

void References::ReplaceEverywhere(Signal& from, Signal& to) {
    // The last first: that is where `from`, which drops each note, looks first. A compound may have
    // noted itself many times.
    const std::vector<Signal*> referrers = GetReferrers(from);
    std::unordered_set<const Signal*> met;
    for (auto referrer = referrers.rbegin(); referrer != referrers.rend(); ++referrer) {
        if (met.insert(*referrer).second) {
            (*referrer)->ReplaceReference(&from, &to);
        }
    }
}

void References::AddAlias(Signal& signal, Signal& alias) {
    Signal::Links& links = signal.MakeLinks();
    // Whichever side has fewer links tells whether the two are linked already.
    const std::vector<Signal*>& referrers = alias.MakeLinks().referrers;
    const bool lookHere = static_cast<std::size_t>(links.aliases.GetSize()) <= referrers.size();
    const bool isListed =
        lookHere ? links.aliases.Contains(&alias)
                 : std::find(referrers.begin(), referrers.end(), &signal) != referrers.end() &&
                       links.aliases.Contains(&alias);
    if (!isListed) {
        Add(signal, links.aliases, alias);
    }
}

void References::RemoveAlias(Signal& signal, Signal& alias) noexcept {
    if (signal.links_ != nullptr && signal.links_->aliases.Remove(&alias)) {
        Drop(alias, signal);
    }
}

void References::RemoveAliases(Signal& signal, const Signal* remaining) noexcept {
    if (signal.links_ == nullptr) {
        return;
    }
    PtrArray<Signal*>& aliases = signal.links_->aliases;
    for (int i = aliases.GetSize() - 1; i >= 0; --i) {
        Signal* const alias = aliases.GetAt(i);
        if (alias != remaining) {
            aliases.RemoveAt(i);
            Drop(*alias, signal);
        }
    }
}

void References::ReplaceAlias(Signal& signal, Signal& from, Signal& to) {
    const int index = signal.links_ == nullptr ? -1 : signal.links_->aliases.GetIndex(&from);
    if (index < 0) {
        return;
    }
    PtrArray<Signal*>& aliases = signal.links_->aliases;
    if (&to == &signal || aliases.Contains(&to)) {
        aliases.RemoveAt(index);
    } else {
        Note(to, signal);
        aliases.SetAt(index, &to);
    }
    Drop(from, signal);
}

void References::ForgetAlias(Signal& signal, Signal& alias) noexcept {
    if (signal.links_ != nullptr) {
        signal.links_->aliases.Remove(&alias);
    }
}

const PtrArray<Signal*>* References::GetAliases(const Signal& signal) noexcept {
    return signal.links_ == nullptr ? nullptr : &signal.links_->aliases;
}

DummySignals* References::GetKeeper(const Signal& signal) noexcept {
    return signal.links_ == nullptr ? nullptr : signal.links_->keeper;
}

void References::PrepareToKeep(Signal& signal) {
    signal.MakeLinks();
}

void References::Keep(Signal& signal, DummySignals& keeper) noexcept {
    signal.links_->keeper = &keeper;
    ++signal.links_->timesKept;
}

void References::Release(Signal& signal) noexcept {
    if (--signal.links_->timesKept == 0) {
        signal.links_->keeper = nullptr;
    }
}

bool References::AreDestroyedTogether(const Signal& a, const Signal& b) noexcept {
    return a.HasFlag(Signal::DyingFlag) && b.HasFlag(Signal::DyingFlag);
}

void References::Leave(Signal& signal) noexcept {
    if (signal.links_ == nullptr) {
        return;
    }
    if (DummySignals* const keeper = GetKeeper(signal)) {
        keeper->Forget(&signal);
    }
    RemoveAliases(signal);
    // Each is told once, however often it noted itself. The order of the notes does not matter.
    std::vector<Signal*>& referrers = signal.links_->referrers;
    std::sort(referrers.begin(), referrers.end(), std::less<>());
    const Signal* told = nullptr;
    for (Signal* referrer : referrers) {
        if (referrer != told && !AreDestroyedTogether(signal, *referrer)) {
            referrer->Forget(&signal);
        }
        told = referrer;
    }
    signal.links_.reset();
}

void References::LeaveTogether(const PtrArray<Signal*>& signals) noexcept {
    // They part all at once, while all of them are alive.
    for (Signal* signal : Iterator<Signal*>(&signals)) {
        signal->SetFlag(Signal::DyingFlag, true);
    }
    for (Signal* signal : Iterator<Signal*>(&signals)) {
        signal->LeaveAll();
    }
}

} // namespace Orn_Hdl
