#include "HdlModel/Netlist/DummySignals.h"

#include "HdlModel/Signals/References.h"
#include "HdlModel/Signals/SignalCast.h"

#include <algorithm>
#include <memory>
#include <string>
#include <unordered_set>

namespace Orn_Hdl {

namespace {

bool IsNameTaken(const Netlist& netlist, const Signal& signal) {
    return netlist.GetSignal(signal.GetDummySignalName().GetView()) != nullptr;
}

int WantedPolarity(bool forOutputs) noexcept {
    return forOutputs ? Polarity::Output : Polarity::Input;
}

} // namespace

Signal* DummySignals::Find(const Signal* original) const noexcept {
    const auto found = dummyOf_.find(original);
    return found == dummyOf_.end() ? nullptr : found->second;
}

/// Whether the signal has a dummy already, here or in another netlist.
bool DummySignals::IsKeptAsOriginal(const Signal& signal) const noexcept {
    const DummySignals* const keeper = References::GetKeeper(signal);
    return keeper != nullptr && (keeper != this || Find(&signal) != nullptr);
}

void DummySignals::Forget(const Signal* signal) noexcept {
    if (References::GetKeeper(*signal) != this) {
        return;
    }
    const auto end = std::remove_if(entries_.begin(), entries_.end(), [&](const Entry& entry) {
        if (entry.original != signal && entry.dummy != signal) {
            return false;
        }
        dummyOf_.erase(entry.original);
        References::Release(*entry.original);
        References::Release(*entry.dummy);
        return true;
    });
    entries_.erase(end, entries_.end());
}

void DummySignals::Clear() noexcept {
    for (const Entry& entry : entries_) {
        References::Release(*entry.original);
        References::Release(*entry.dummy);
    }
    entries_.clear();
    dummyOf_.clear();
}

/// The dummy takes over the pins that still point at its signal. The dummy of an output port takes
/// the aliases and the constant away as well, so that it is the port's only driver.
void DummySignals::TakeOver(const Entry& entry) {
    Signal& original = *entry.original;
    Signal& dummy = *entry.dummy;
    dummy.CloneConnection(&original);
    if (!entry.forOutputs) {
        return;
    }
    References::RemoveAliases(original, &dummy);
    if (!original.GetConstantValue().GetValue().IsEmpty()) {
        dummy.AssignConstantValue(original.GetConstantValue());
        original.AssignConstantValue(BitVectorValue());
    }
}

void DummySignals::Link(const Entry& entry) {
    Signal* const driven = entry.forOutputs ? entry.original : entry.dummy;
    driven->Connect(driven == entry.original ? entry.dummy : entry.original);
}

/// Replaces signals by their dummies in all compounds that have one of them as a member; each
/// compound is gone through once.
/// \param firstEntry the first of the entries whose signals are looked for.
void DummySignals::ReplaceInCompounds(std::size_t firstEntry, Members which) {
    std::unordered_set<const Signal*> met;
    for (std::size_t i = firstEntry; i < entries_.size(); ++i) {
        const std::vector<Signal*> referrers = References::GetReferrers(*entries_[i].original);
        // The last first: that is where the original, which drops each note, looks first.
        for (auto referrer = referrers.rbegin(); referrer != referrers.rend(); ++referrer) {
            CompoundBus* const compound = As<CompoundBus>(*referrer);
            if (compound != nullptr && met.insert(compound).second) {
                ReplaceMembers(*compound, which);
            }
        }
    }
}

void DummySignals::ReplaceMembers(CompoundBus& compound, Members which) {
    // From the end: that is where the notes of the members are looked for first.
    for (int i = compound.GetSize() - 1; i >= 0; --i) {
        const Signal* const member = compound.GetAt(i);
        if (which == Members::All || As<CompoundBus>(member) == nullptr) {
            if (Signal* dummy = Find(member)) {
                compound.SetAt(i, dummy);
            }
        }
    }
}

void DummySignals::Adopt(Netlist& netlist, Signal& original, Signal* dummy, bool forOutputs) {
    netlist.Add(dummy);
    // Room comes first: an entry whose signals are kept is dropped when either is destroyed.
    References::PrepareToKeep(original);
    References::PrepareToKeep(*dummy);
    entries_.push_back({&original, dummy, forOutputs});
    References::Keep(original, *this);
    References::Keep(*dummy, *this);
    dummyOf_.emplace(&original, dummy);
    TakeOver(entries_.back());
}

void DummySignals::MakeForScalar(Netlist& netlist, ScalarSignal& signal, bool forOutputs) {
    if (signal.GetPortPolarity().GetValue() != WantedPolarity(forOutputs) ||
        Find(&signal) != nullptr || IsNameTaken(netlist, signal)) {
        return;
    }
    Adopt(netlist, signal, signal.CreateDummySignal(), forOutputs);
    Link(entries_.back());
}

void DummySignals::MakeForParts(Netlist& netlist, Bus& bus, Bus& dummy, bool forOutputs) {
    for (Signal* part : bus.GetBusSliceIterator()) {
        if (As<BusPart>(part) == nullptr || IsKeptAsOriginal(*part) ||
            IsNameTaken(netlist, *part)) {
            continue;
        }
        Signal* partDummy = nullptr;
        if (const BusSlice* const slice = As<BusSlice>(part)) {
            partDummy = slice->CreateDummySignal(&dummy);
        } else if (const BusIndex* const bit = As<BusIndex>(part)) {
            partDummy = bit->CreateDummySignal(&dummy);
        }
        Adopt(netlist, *part, partDummy, forOutputs);
    }
}

void DummySignals::MakeForBus(Netlist& netlist, Bus& bus, bool forOutputs) {
    if (bus.GetPortPolarity().GetValue() != WantedPolarity(forOutputs) || Find(&bus) != nullptr ||
        IsNameTaken(netlist, bus) ||
        netlist.GetParentBus(bus.GetDummySignalName().CStr()) != nullptr) {
        return;
    }
    Bus* const dummy = bus.CreateDummySignal();
    Adopt(netlist, bus, dummy, forOutputs);
    Link(entries_.back());
    MakeForParts(netlist, bus, *dummy, forOutputs);
}

void DummySignals::MakeForCompound(Netlist& netlist, CompoundBus& compound, bool forOutputs) {
    if (Find(&compound) != nullptr || IsNameTaken(netlist, compound)) {
        return;
    }
    CompoundBus* const dummy = compound.CreateDummySignal();
    Adopt(netlist, compound, dummy, forOutputs);
    for (Signal* member : compound.GetBusMemberIterator()) {
        Signal* const memberDummy = Find(member);
        dummy->AddBusMember(memberDummy == nullptr ? member : memberDummy);
    }
}

void DummySignals::Make(Netlist& netlist, const StringSet& names, bool forOutputs) {
    const std::size_t firstEntry = entries_.size();
    std::vector<CompoundBus*> compounds;
    for (StringSetIterator i = names.GetBeginPos(); i != names.GetEndPos(); ++i) {
        Signal* const signal = netlist.GetSignal(i.GetView());
        if (ScalarSignal* const scalar = As<ScalarSignal>(signal)) {
            MakeForScalar(netlist, *scalar, forOutputs);
        } else if (CompoundBus* const compound = As<CompoundBus>(signal)) {
            compounds.push_back(compound);
        } else if (Bus* bus = netlist.GetParentBus(std::string(i.GetView()).c_str())) {
            MakeForBus(netlist, *bus, forOutputs);
        }
    }
    ReplaceInCompounds(firstEntry, Members::NoCompounds);
    for (CompoundBus* compound : compounds) {
        MakeForCompound(netlist, *compound, forOutputs);
    }
}

void DummySignals::Refresh(Netlist& netlist) {
    // By index: dummies of new slices and bits join the list on the way.
    for (std::size_t i = 0; i < entries_.size(); ++i) {
        const Entry entry = entries_[i];
        TakeOver(entry);
        if (Bus* const bus = As<Bus>(entry.original)) {
            MakeForParts(netlist, *bus, *As<Bus>(entry.dummy), entry.forOutputs);
        }
    }
    ReplaceInCompounds(0, Members::All);
}

} // namespace Orn_Hdl
