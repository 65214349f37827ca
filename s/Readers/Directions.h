// The directions of pins that nothing declares, taken from what they are connected to.
#pragma once

#include <string>
#include <vector>

namespace Orn_Hdl {

class Component;
class Netlist;

namespace Readers {

/// A component whose pins have directions that the design does not tell.
struct UntoldDirections {
    const Component* component = nullptr;
    /// The pins for which the design gives no answer, in order.
    std::vector<std::string> open;
    /// The pins for which it gives two answers, in order.
    std::vector<std::string> contradictory;
};

/// Gives a direction to every pin that has none, as far as only one is possible: a net that has a
/// driver makes a pin an input, and a net without one, which something reads, makes the only pin of
/// unknown direction an output. Bidirectional pins and ports leave open what drives their nets.
/// \return the components with pins that are left, in the order of the netlist. The netlist must
///         not be used if there are any.
std::vector<UntoldDirections> InferDirections(Netlist& netlist);

} // namespace Readers
} // namespace Orn_Hdl
