// How an object that is destroyed finds its owner.
#pragma once

#include "HdlModel/Objects/AttributeTable.h"
#include "Orn_Hdl/Attributes.h"

namespace Orn_Hdl {

/// Leads from a component, an instance or a signal to the netlist's `Implementation`, and from a
/// pin to the `PinList` of its component or instance. Null for an object without an owner.
class OwnerLink {
public:
    template <class Owner> static Owner* Get(const AttributeHolder& object) noexcept {
        return static_cast<Owner*>(Get(object));
    }
    /// \param owner null for none; its address is even.
    static void Set(AttributeHolder& object, void* owner) noexcept {
        if (AttributeTable* const table = object.GetTable()) {
            table->owner = owner;
        } else {
            object.link_ = owner == nullptr ? nullptr : static_cast<char*>(owner) + 1;
        }
    }

private:
    static void* Get(const AttributeHolder& object) noexcept {
        if (object.IsLinkToOwner()) {
            return static_cast<char*>(object.link_) - 1;
        }
        const AttributeTable* const table = object.GetTable();
        return table == nullptr ? nullptr : table->owner;
    }
};

} // namespace Orn_Hdl
