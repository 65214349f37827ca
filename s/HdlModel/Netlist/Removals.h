// How many objects a netlist has given up.
#pragma once

#include "Orn_Hdl/Model/Netlist.h"

#include <cstdint>

namespace Orn_Hdl {

/// Tells those who keep pointers to components, instances and signals whether all of them still
/// stand in the netlist.
class Removals {
public:
    /// A number that grows whenever a component, an instance or a signal leaves the netlist, and
    /// whenever another netlist is moved into it. Pins and attributes do not count by themselves.
    static std::uint64_t Count(const Netlist& netlist) noexcept;
};

} // namespace Orn_Hdl
