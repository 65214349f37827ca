// The sorting of a netlist in parts.
#pragma once

#include "Orn_Hdl/Model/Netlist.h"

#include <cstddef>

namespace Orn_Hdl {

/// `Netlist::SortNetlist` in parts that have nothing to do with one another, so that each may run
/// in a thread of its own.
class NetlistSorting {
public:
    static constexpr std::size_t Parts = 2;

    /// Whether there is enough to sort that a thread pays.
    static bool IsLong(const Netlist& netlist) noexcept;
    /// Sorts one of the parts, numbered from 0.
    static void SortPart(Netlist& netlist, std::size_t part);
};

} // namespace Orn_Hdl
