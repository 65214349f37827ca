#include "HdlModel/Netlist/DummySignals.h"

#include "Containers/HashByEights.h"
#include "HdlModel/Signals/References.h"
#include "HdlModel/Signals/SignalCast.h"

#include <memory>
#include <string>
#include <unordered_set>

namespace Orn_Hdl {

namespace {

bool IsNameTaken(const Netlist& netlist, const Signal& signal) {
    return netlist.GetSignal(signal.GetDummySignalName().GetView()) != nullptr;
}

std::uint32_t HashAddress(const Signal* signal) noexcept {
    constexpr std::uint64_t Factor = 0x9E3779B97F4A7C15U;
    return static_cast<std::uint32_t>(
        MultiplyAndFold(reinterpret_cast<std::uintptr_t>(signal), Factor) >> 32U);
}

int WantedPolarity(bool forOutputs) noexcept {
    return forOutputs ? Polarity::Output : Polarity::Input;
}

} // namespace

const DummySignals::Entry* DummySignals::FindBy(const Places& places, Signal* Entry::*side,
                                                const Signal* signal) const noexcept {
    const std::uint32_t hash = HashAddress(signal);
    const std::uint32_t place = places.Find(hash, [&](std::uint32_t other, std::uint32_t value) {
        return other == hash && entries_[value - 1].*side == signal;
    });
    return place == 0 ? nullptr : &entries_[place - 1];
}

Signal* DummySignals::Find(const Signal* original) const noexcept {
    const Entry* const entry = FindBy(byOriginal_, &Entry::original, original);
    return entry == nullptr ? nullptr : entry->dummy;
}

const DummySignals::Entry* DummySignals::FindByOriginal(const Signal* original) const noexcept {
    return FindBy(byOriginal_, &Entry::original, original);
}

const DummySignals::Entry* DummySignals::FindByDummy(const Signal* dummy) const noexcept {
    return FindBy(byDummy_, &Entry::dummy, dummy);
}

const DummySignals::Entry* DummySignals::FindPending(const Netlist& netlist,
                                                     const Signal& part) const {
    const BusPart* const known = As<BusPart>(&part);
    const Bus* const bus = known == nullptr ? nullptr : known->GetParentBus();
    const Entry* const entry = bus == nullptr ? nullptr : FindByOriginal(bus);
    return entry == nullptr || !CanMakeForPart(netlist, part) ? nullptr : entry;
}

/// Whether the signal already has a dummy, here or in another netlist.
bool DummySignals::IsKeptAsOriginal(const Signal& signal) const noexcept {
    const DummySignals* const keeper = References::GetKeeper(signal);
    return keeper != nullptr && (keeper != this || Find(&signal) != nullptr);
}

void DummySignals::Forget(const Signal* signal) noexcept {
    if (References::GetKeeper(*signal) != this) {
        return;
    }
    if (const Entry* const entry = FindBy(byOriginal_, &Entry::original, signal)) {
        Drop(*entry);
    }
    if (const Entry* const entry = FindBy(byDummy_, &Entry::dummy, signal)) {
        Drop(*entry);
    }
    if (emptyPlaces_ > entries_.size() / 2) {
        DropEmptyPlaces();
    }
}

void DummySignals::Drop(const Entry& entry) noexcept {
    const auto index = static_cast<std::size_t>(&entry - entries_.data());
    const auto place = static_cast<std::uint32_t>(index + 1);
    byOriginal_.Remove(HashAddress(entry.original), place);
    byDummy_.Remove(HashAddress(entry.dummy), place);
    References::Release(*entry.original);
    References::Release(*entry.dummy);
    entries_[index] = {nullptr, nullptr, false};
    ++emptyPlaces_;
}

void DummySignals::DropEmptyPlaces() noexcept {
    std::uint32_t place = 0;
    for (std::uint32_t former = 0; former < entries_.size(); ++former) {
        const Entry entry = entries_[former];
        if (entry.original != nullptr) {
            byOriginal_.Replace(HashAddress(entry.original), former + 1, place + 1);
            byDummy_.Replace(HashAddress(entry.dummy), former + 1, place + 1);
            entries_[place] = entry;
            ++place;
        }
    }
    entries_.resize(place);
    emptyPlaces_ = 0;
}

void DummySignals::Clear() noexcept {
    for (const Entry& entry : entries_) {
        if (entry.original != nullptr) {
            References::Release(*entry.original);
            References::Release(*entry.dummy);
        }
    }
    entries_.clear();
    emptyPlaces_ = 0;
    byOriginal_.Clear();
    byDummy_.Clear();
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

/// Replaces signals by their dummies in all compounds that have one of them as a member. Each
/// compound is visited once.
/// \param firstEntry the first of the entries whose signals are looked for.
void DummySignals::ReplaceInCompounds(std::size_t firstEntry, Members which) {
    std::unordered_set<const Signal*> met;
    for (std::size_t i = firstEntry; i < entries_.size(); ++i) {
        if (entries_[i].original == nullptr) {
            continue;
        }
        const std::vector<Signal*> referrers = References::GetReferrers(*entries_[i].original);
        // Backwards, because the original searches its notes from the end to drop them.
        for (auto referrer = referrers.rbegin(); referrer != referrers.rend(); ++referrer) {
            CompoundBus* const compound = As<CompoundBus>(*referrer);
            if (compound != nullptr && met.insert(compound).second) {
                ReplaceMembers(*compound, which);
            }
        }
    }
}

void DummySignals::ReplaceMembers(CompoundBus& compound, Members which) {
    // Backwards, because the notes of the members are searched from the end.
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
    // All room is reserved first, so that an entry with marked signals is dropped with either of
    // them.
    References::PrepareToKeep(original);
    References::PrepareToKeep(*dummy);
    byOriginal_.MakeRoom();
    byDummy_.MakeRoom();
    entries_.push_back({&original, dummy, forOutputs});
    References::Keep(original, *this);
    References::Keep(*dummy, *this);
    const auto place = static_cast<std::uint32_t>(entries_.size());
    byOriginal_.Add(HashAddress(&original), place);
    byDummy_.Add(HashAddress(dummy), place);
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

bool DummySignals::CanMakeForPart(const Netlist& netlist, const Signal& part) const {
    return !IsKeptAsOriginal(part) && !IsNameTaken(netlist, part);
}

void DummySignals::MakeForParts(Netlist& netlist, Bus& bus, Bus& dummy, bool forOutputs) {
    for (Signal* part : bus.GetBusSliceIterator()) {
        if (As<BusPart>(part) == nullptr || !CanMakeForPart(netlist, *part)) {
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
    // By index, because dummies of new slices and bits are appended meanwhile.
    for (std::size_t i = 0; i < entries_.size(); ++i) {
        const Entry entry = entries_[i];
        if (entry.original == nullptr) {
            continue;
        }
        TakeOver(entry);
        if (Bus* const bus = As<Bus>(entry.original)) {
            MakeForParts(netlist, *bus, *As<Bus>(entry.dummy), entry.forOutputs);
        }
    }
    ReplaceInCompounds(0, Members::All);
}

} // namespace Orn_Hdl
