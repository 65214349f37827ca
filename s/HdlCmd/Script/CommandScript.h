// The commands from which a design and its options come.
#pragma once

#include "Orn_Hdl/Model/Netlist.h"
#include "Orn_Hdl/Options.h"
#include "Orn_Hdl/Streams.h"

namespace Orn_Hdl {

/// Writes the canonical script of a design, one command a line. Throws before it writes anything
/// if no command can express a part of the design.
void WriteCommandScript(const Netlist& netlist, const HdlOptions& options, OutStream& out);

} // namespace Orn_Hdl
