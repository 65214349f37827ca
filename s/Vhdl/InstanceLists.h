// The instances that a VHDL file declares or attributes before it instantiates them.
#pragma once

#include "Orn_Hdl/Model/Netlist.h"

#include <unordered_map>
#include <vector>

namespace Orn_Hdl {

/// The instances by component, and the holders of attributes, collected in one walk.
class InstanceLists {
public:
    explicit InstanceLists(const Netlist& netlist);

    /// The components that have instances, in the order of their first instances.
    const std::vector<const Component*>& GetComponents() const noexcept { return components_; }
    /// The instances of a component, in the netlist's order.
    const std::vector<const Instance*>& GetInstances(const Component* component) const;
    /// The instances with attributes, in the netlist's order.
    const std::vector<const Instance*>& GetAttributed() const noexcept { return attributed_; }
    /// The components and instances with attributes, each component before its first instance.
    const std::vector<const AttributeHolder*>& GetHolders() const noexcept { return holders_; }

private:
    void AddComponent(const Component* component);

    std::vector<const Component*> components_;
    std::unordered_map<const Component*, std::vector<const Instance*>> instances_;
    std::vector<const Instance*> attributed_;
    std::vector<const AttributeHolder*> holders_;
};

} // namespace Orn_Hdl
