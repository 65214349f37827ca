#include "HdlCmd/Script/InstanceStages.h"

#include "HdlCmd/Script/Values.h"

#include <algorithm>
#include <iterator>

namespace Orn_Hdl::Script {

int CountPins(const Iterator<Pin*>& pins) {
    return static_cast<int>(std::distance(pins.begin(), pins.end()));
}

InstanceStages::InstanceStages(const Netlist& netlist, const SettledSignals& settled)
    : netlist_(netlist), settled_(settled) {
    for (const Component* component : netlist.GetComponentIterator()) {
        pinCounts_[component] = CountPins(component->GetPinIterator());
    }
    for (const Instance* instance : netlist.GetInstanceIterator()) {
        const int count = GetPinCountIfEarly(*instance);
        if (count != NotEarly) {
            early_[instance->GetComponent()].push_back({instance, count});
        }
    }
    for (auto& [component, instances] : early_) {
        std::stable_sort(instances.begin(), instances.end(),
                         [](const Early& a, const Early& b) { return a.pinCount < b.pinCount; });
    }
}

const std::vector<InstanceStages::Early>&
InstanceStages::GetEarly(const Component& component) const {
    static const std::vector<Early> none;
    const auto found = early_.find(&component);
    return found == early_.end() ? none : found->second;
}

bool InstanceStages::HasNameOfSignal(const Instance& instance) const {
    const std::string_view name = instance.GetNameView();
    const Signal* const signal = netlist_.GetSignal(name);
    // A signal that was renamed is found by its former name, and in the script it may get another.
    return signal != nullptr && Folded(settled_.GetName({signal})) == Folded(name);
}

int InstanceStages::GetPinCountIfEarly(const Instance& instance) const {
    const auto found = pinCounts_.find(instance.GetComponent());
    if (found == pinCounts_.end()) {
        return NotEarly;
    }
    const int count = CountPins(instance.GetPinIterator());
    const bool isEarly = count < found->second || HasNameOfSignal(instance);
    return isEarly ? count : NotEarly;
}

bool InstanceStages::IsEarly(const Instance& instance) const {
    return !early_.empty() && GetPinCountIfEarly(instance) != NotEarly;
}

} // namespace Orn_Hdl::Script
