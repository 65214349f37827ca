// Whether everything that a netlist links is alive, and linked as it has to be.
#pragma once

#include "Orn_Hdl/Model.h"

#include <vector>

namespace Fuzz {

/// Checks every object of a netlist and of `loose`, signals that no netlist holds: lists and pins
/// name live objects only, parents and parts know each other, no list names a thing twice, no
/// compound contains itself, and every question about an object has an answer.
void CheckNetlist(const Orn_Hdl::Netlist& netlist, const std::vector<Orn_Hdl::Signal*>& loose = {});

/// Checks that everything the netlist holds is found by its name.
void CheckNames(const Orn_Hdl::Netlist& netlist);

} // namespace Fuzz
