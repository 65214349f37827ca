// How components, instances and signals leave the netlist that owns them.
#pragma once

#include "HdlModel/Objects/ObjectKey.h"
#include "Orn_Hdl/Model/Netlist.h"

namespace Orn_Hdl {

/// Called first by the destructors of the objects that a netlist can own. An object without an
/// owner leaves nothing; a netlist that destroys its objects is their owner no longer.
class NetlistOwner {
public:
    template <class T> static void Leave(T& object) noexcept {
        if (OwnedFlag::Get(object)) {
            LetGo(object);
        }
    }

private:
    static void LetGo(Component& component) noexcept;
    static void LetGo(Instance& instance) noexcept;
    /// Called when the derived class of the signal is already destroyed, so a bus must leave
    /// earlier.
    static void LetGo(Signal& signal) noexcept;
    static void LetGo(Bus& bus) noexcept;
};

} // namespace Orn_Hdl
