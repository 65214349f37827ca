// Compares two designs.
#pragma once

#include "diff/Difference.h"
#include "diff/Rules.h"

#include <cstddef>

namespace Orn_Hdl {
class Netlist;
}

namespace Tool::Diff {

/// The differences of two designs, in an order that depends on nothing but them.
/// \param most how many differences of each kind are described; 0 for all. All are counted.
Differences Compare(const Orn_Hdl::Netlist& a, const Orn_Hdl::Netlist& b, const Rules& rules,
                    std::size_t most);

} // namespace Tool::Diff
