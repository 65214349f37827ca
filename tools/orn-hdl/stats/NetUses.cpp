#include "stats/NetUses.h"

#include "Orn_Hdl/Model.h"

#include <algorithm>
#include <string_view>

namespace Tool::Stats {

namespace {

using Orn_Hdl::Polarity;
using Orn_Hdl::Signal;

/// The range at the end of a name. \return false if the name is no bus name.
bool GetRange(std::string_view name, int& left, int& right) {
    Port::String base;
    return Orn_Hdl::Bus::ParseBusName(std::string(name).c_str(), base, left, right);
}

bool GetIndex(std::string_view name, int& index) {
    Port::String base;
    return Orn_Hdl::BusIndex::ParseBusIndexName(std::string(name).c_str(), base, index);
}

bool Reads(Polarity polarity) {
    return polarity == Polarity::Input || polarity == Polarity::BiDirectional;
}

bool Drives(Polarity polarity) {
    return polarity == Polarity::Output || polarity == Polarity::BiDirectional;
}

} // namespace

bool IsDeclared(const Signal& signal) {
    return signal.GetSignalType() == Orn_Hdl::SignalTypeScalar ||
           signal.GetSignalType() == Orn_Hdl::SignalTypeBus;
}

NetUses::NetUses(const Orn_Hdl::Netlist& netlist) {
    for (const Signal* signal : netlist.GetSignalIterator()) {
        if (IsDeclared(*signal)) {
            Declare(*signal);
        }
    }
    for (const Signal* signal : netlist.GetSignalIterator()) {
        if (IsDeclared(*signal)) {
            TakePort(*signal);
        }
        TakeAssignments(*signal);
    }
    TakePins(netlist);
    SumUp();
}

void NetUses::Declare(const Signal& signal) {
    Declared declared;
    declared.signal = &signal;
    declared.first = uses_.size();
    int left = 0;
    int right = 0;
    if (signal.GetSignalType() == Orn_Hdl::SignalTypeBus &&
        GetRange(signal.GetNameView(), left, right)) {
        const std::int64_t width = std::max(std::int64_t(left) - right, std::int64_t(right) - left);
        // The width is one bit more than the distance of the indices.
        if (width < MostBits) {
            declared.left = left;
            declared.right = right;
            declared.count = static_cast<std::size_t>(width) + 1;
        }
    }
    uses_.resize(uses_.size() + declared.count + (declared.count > 1 ? 1 : 0));
    indices_.emplace(&signal, declared_.size());
    declared_.push_back(declared);
}

void NetUses::TakePort(const Signal& signal) {
    const Polarity polarity = signal.GetPortPolarity();
    if (Reads(polarity)) {
        Add(signal, Driver);
    }
    if (Drives(polarity)) {
        Add(signal, Load);
    }
}

void NetUses::TakeAssignments(const Signal& signal) {
    if (!signal.GetConstantValue().GetValue().IsEmpty()) {
        Add(signal, Driver);
    }
    for (const Signal* driver : signal.GetSignalIterator()) {
        Add(signal, Driver);
        Add(*driver, Load);
    }
}

void NetUses::TakePins(const Orn_Hdl::Netlist& netlist) {
    for (const Orn_Hdl::Instance* instance : netlist.GetInstanceIterator()) {
        for (const Orn_Hdl::Pin* pin : instance->GetPinIterator()) {
            const Signal* const signal = pin->GetSignal();
            if (signal == nullptr) {
                continue;
            }
            if (Reads(pin->GetPolarity())) {
                Add(*signal, Load);
            }
            if (Drives(pin->GetPolarity())) {
                Add(*signal, Driver);
            }
        }
    }
}

const NetUses::Declared* NetUses::Find(const Signal* signal) const {
    const auto found = indices_.find(signal);
    return found == indices_.end() ? nullptr : &declared_[found->second];
}

void NetUses::Add(const Declared& declared, std::int64_t left, std::int64_t right,
                  const NetUse& use) {
    if (declared.count == 1) {
        uses_[declared.first] += use;
        return;
    }
    const bool ascends = declared.left < declared.right;
    const std::int64_t from =
        ascends ? std::min(left, right) - declared.left : declared.left - std::max(left, right);
    const std::int64_t to = from + std::max(left - right, right - left);
    const auto last = static_cast<std::int64_t>(declared.count) - 1;
    if (to >= 0 && from <= last) {
        uses_[declared.first + static_cast<std::size_t>(std::max<std::int64_t>(from, 0))] += use;
        uses_[declared.first + static_cast<std::size_t>(std::min(to, last)) + 1] -= use;
    }
}

void NetUses::Add(const Signal& signal, const NetUse& use) {
    int left = 0;
    int right = 0;
    switch (signal.GetSignalType()) {
    case Orn_Hdl::SignalTypeCompoundBus:
        for (const Signal* member :
             static_cast<const Orn_Hdl::CompoundBus&>(signal).GetBusMemberIterator()) {
            Add(*member, use);
        }
        return;
    case Orn_Hdl::SignalTypeBusSlice:
    case Orn_Hdl::SignalTypeBusIndex: {
        const bool isSlice = signal.GetSignalType() == Orn_Hdl::SignalTypeBusSlice;
        const Declared* const parent =
            Find(static_cast<const Orn_Hdl::BusPart&>(signal).GetParentBus());
        if (parent != nullptr && (isSlice ? GetRange(signal.GetNameView(), left, right)
                                          : GetIndex(signal.GetNameView(), left))) {
            Add(*parent, left, isSlice ? right : left, use);
        }
        return;
    }
    default:
        if (const Declared* const declared = Find(&signal)) {
            Add(*declared, declared->left, declared->right, use);
        }
    }
}

void NetUses::SumUp() {
    for (const Declared& declared : declared_) {
        for (std::size_t bit = 1; bit < declared.count; ++bit) {
            uses_[declared.first + bit] += uses_[declared.first + bit - 1];
        }
    }
}

std::string GetBitName(const Signal& signal, std::size_t index) {
    std::string name(signal.GetNameView());
    int left = 0;
    int right = 0;
    if (signal.GetSignalType() != Orn_Hdl::SignalTypeBus || !GetRange(name, left, right) ||
        signal.GetWidth() > NetUses::MostBits) {
        return name;
    }
    const auto distance = static_cast<std::int64_t>(index);
    const std::int64_t bit = left < right ? left + distance : left - distance;
    name.resize(name.find('('));
    return name.append("(").append(std::to_string(bit)).append(")");
}

} // namespace Tool::Stats
