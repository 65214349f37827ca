#include "HdlCmd/Script/InstanceStages.h"

#include <algorithm>
#include <iterator>

namespace Orn_Hdl::Script {

int CountPins(const Iterator<Pin*>& pins) {
    return static_cast<int>(std::distance(pins.begin(), pins.end()));
}

InstanceStages::InstanceStages(const Netlist& netlist) : netlist_(netlist) {
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

int InstanceStages::GetPinCountIfEarly(const Instance& instance) const {
    const auto found = pinCounts_.find(instance.GetComponent());
    if (found == pinCounts_.end()) {
        return NotEarly;
    }
    const int count = CountPins(instance.GetPinIterator());
    const bool isEarly =
        count < found->second || netlist_.GetSignal(instance.GetNameView()) != nullptr;
    return isEarly ? count : NotEarly;
}

bool InstanceStages::IsEarly(const Instance& instance) const {
    return !early_.empty() && GetPinCountIfEarly(instance) != NotEarly;
}

} // namespace Orn_Hdl::Script
