// Modules that no file declares: their ports' directions, and what is said when these cannot be
// told.
#pragma once

#include "Readers/Heads.h"
#include "Readers/Place.h"

namespace Orn_Hdl {

class Netlist;

namespace Readers {

/// Gives the pins of undeclared modules the directions that follow from the netlist. Throws for
/// pins without a direction or a width, the message listing all of them.
void SettleUndeclared(const Files& files, const Heads& heads, Netlist& netlist);

} // namespace Readers
} // namespace Orn_Hdl
