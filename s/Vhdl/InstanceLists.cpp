#include "Vhdl/InstanceLists.h"

#include "HdlModel/Netlist/WalkAhead.h"

namespace Orn_Hdl {

InstanceLists::InstanceLists(const Netlist& netlist) {
    WalkAhead(netlist.GetInstanceIterator(), [this](const Instance& instance) {
        if (const Component* const component = instance.GetComponent()) {
            std::vector<const Instance*>& instances = instances_[component];
            if (instances.empty()) {
                AddComponent(component);
            }
            instances.push_back(&instance);
        }
        if (instance.HasAttrs()) {
            attributed_.push_back(&instance);
            holders_.push_back(&instance);
        }
    });
}

void InstanceLists::AddComponent(const Component* component) {
    components_.push_back(component);
    if (component->HasAttrs()) {
        holders_.push_back(component);
    }
}

const std::vector<const Instance*>& InstanceLists::GetInstances(const Component* component) const {
    static const std::vector<const Instance*> none;
    const auto found = instances_.find(component);
    return found == instances_.end() ? none : found->second;
}

} // namespace Orn_Hdl
