// How an object that is destroyed finds its owner.
#pragma once

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
    static void Set(AttributeHolder& object, void* owner) noexcept;

private:
    static void* Get(const AttributeHolder& object) noexcept;
};

} // namespace Orn_Hdl
