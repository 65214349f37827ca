#include "HdlModel/DummySignals.h"

#include "HdlModel/SignalLinks.h"

#include <algorithm>
#include <memory>
#include <string>

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

/// Whether this memory, or that of another netlist, holds the signal.
bool DummySignals::IsKept(const Signal& signal) noexcept {
    return signal.links_ != nullptr && signal.links_->keeper != nullptr;
}

void DummySignals::Forget(const Signal* signal) noexcept {
    const auto isAbout = [signal](const Entry& entry) {
        return entry.original == signal || entry.dummy == signal;
    };
    const auto end = std::remove_if(entries_.begin(), entries_.end(), [&](const Entry& entry) {
        if (isAbout(entry)) {
            entry.original->links_->keeper = nullptr;
            dummyOf_.erase(entry.original);
            return true;
        }
        return false;
    });
    entries_.erase(end, entries_.end());
}

void DummySignals::Clear() noexcept {
    for (const Entry& entry : entries_) {
        entry.original->links_->keeper = nullptr;
    }
    entries_.clear();
    dummyOf_.clear();
}

/// The dummy takes the pins that still point at its signal. In the place of an output port it takes
/// the aliases and the constant away too, so that the port has no driver but the dummy.
void DummySignals::TakeOver(const Entry& entry) {
    Signal& original = *entry.original;
    Signal& dummy = *entry.dummy;
    dummy.CloneConnection(&original);
    if (!entry.forOutputs) {
        return;
    }
    for (int i = 0; original.links_ != nullptr && i < original.links_->signals.GetSize();) {
        Signal* const alias = original.links_->signals.GetAt(i);
        if (alias == &dummy) {
            ++i;
        } else {
            original.Disconnect(alias);
        }
    }
    if (!original.GetConstantValue().GetValue().IsEmpty()) {
        dummy.AssignConstantValue(original.GetConstantValue());
        original.AssignConstantValue(BitVectorValue());
    }
}

void DummySignals::Link(const Entry& entry) {
    Signal* const driven = entry.forOutputs ? entry.original : entry.dummy;
    driven->Connect(driven == entry.original ? entry.dummy : entry.original);
}

void DummySignals::ReplaceInCompounds(const Entry& entry) {
    if (entry.original->links_ == nullptr) {
        return;
    }
    const std::vector<Signal*> referrers = entry.original->links_->referrers;
    // The last first: that is where the original, which forgets each of them, looks first.
    for (auto referrer = referrers.rbegin(); referrer != referrers.rend(); ++referrer) {
        if ((*referrer)->GetSignalType() != SignalTypeCompoundBus) {
            continue;
        }
        CompoundBus& compound = static_cast<CompoundBus&>(**referrer);
        for (int i = 0; i < compound.GetSize(); ++i) {
            if (compound.GetAt(i) == entry.original) {
                compound.SetAt(i, entry.dummy);
            }
        }
    }
}

void DummySignals::Adopt(Netlist& netlist, Signal& original, Signal* dummy, bool forOutputs) {
    netlist.Add(dummy);
    Signal::Links& links = original.MakeLinks();
    entries_.push_back({&original, dummy, forOutputs});
    links.keeper = this;
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
    ReplaceInCompounds(entries_.back());
}

void DummySignals::MakeForParts(Netlist& netlist, Bus& bus, Bus& dummy, bool forOutputs) {
    for (Signal* part : bus.GetBusSliceIterator()) {
        const int type = part->GetSignalType();
        const bool isPart = type == SignalTypeBusSlice || type == SignalTypeBusIndex;
        if (!isPart || IsKept(*part) || IsNameTaken(netlist, *part)) {
            continue;
        }
        Signal* const partDummy =
            type == SignalTypeBusSlice
                ? static_cast<Signal*>(static_cast<BusSlice*>(part)->CreateDummySignal(&dummy))
                : static_cast<BusIndex*>(part)->CreateDummySignal(&dummy);
        Adopt(netlist, *part, partDummy, forOutputs);
        ReplaceInCompounds(entries_.back());
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
    ReplaceInCompounds(entries_.back());
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
    std::vector<CompoundBus*> compounds;
    for (StringSetIterator i = names.GetBeginPos(); i != names.GetEndPos(); ++i) {
        Signal* const signal = netlist.GetSignal(i.GetView());
        const int type = signal == nullptr ? 0 : signal->GetSignalType();
        if (type == SignalTypeScalar) {
            MakeForScalar(netlist, static_cast<ScalarSignal&>(*signal), forOutputs);
        } else if (type == SignalTypeCompoundBus) {
            compounds.push_back(static_cast<CompoundBus*>(signal));
        } else if (Bus* bus = netlist.GetParentBus(std::string(i.GetView()).c_str())) {
            MakeForBus(netlist, *bus, forOutputs);
        }
    }
    for (CompoundBus* compound : compounds) {
        MakeForCompound(netlist, *compound, forOutputs);
    }
}

void DummySignals::Refresh(Netlist& netlist) {
    // By index: dummies of new slices and bits join the list on the way.
    for (std::size_t i = 0; i < entries_.size(); ++i) {
        const Entry entry = entries_[i];
        TakeOver(entry);
        ReplaceInCompounds(entry);
        if (entry.original->GetSignalType() == SignalTypeBus) {
            MakeForParts(netlist, static_cast<Bus&>(*entry.original),
                         static_cast<Bus&>(*entry.dummy), entry.forOutputs);
        }
    }
}

} // namespace Orn_Hdl
