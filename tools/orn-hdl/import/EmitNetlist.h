// Passes an imported netlist to a sink.
#pragma once

#include "import/ImportedNetlist.h"
#include "import/Sink.h"

namespace Tool::Import {

/// Calls the same sequence of operations for every sink.
void EmitNetlist(const ImportedNetlist& netlist, Sink& sink);

} // namespace Tool::Import
