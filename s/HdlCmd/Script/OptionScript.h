// The option commands of a script.
#pragma once

#include "HdlCmd/Script/Lines.h"
#include "Orn_Hdl/Model/Netlist.h"
#include "Orn_Hdl/Options.h"

namespace Orn_Hdl::Script {

/// Writes the names of the netlist and its file, and every option that has not its default. Throws
/// for an option that commands cannot set so.
void WriteOptions(const Netlist& netlist, const HdlOptions& options, Lines& lines);

} // namespace Orn_Hdl::Script
