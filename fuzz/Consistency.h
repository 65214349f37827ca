// Checks that everything that a netlist links to exists and is linked correctly.
#pragma once

#include "Orn_Hdl/Model.h"

#include <vector>

namespace Fuzz {

/// Checks every object of a netlist and of `loose`, signals that no netlist holds: lists and pins
/// refer to objects that exist, a bus and its parts refer to each other, no list but a compound's
/// holds an object twice, no compound contains itself, and every getter can be called.
void CheckNetlist(const Orn_Hdl::Netlist& netlist, const std::vector<Orn_Hdl::Signal*>& loose = {});

/// Checks that every object of the netlist is found by its name.
void CheckNames(const Orn_Hdl::Netlist& netlist);

} // namespace Fuzz
