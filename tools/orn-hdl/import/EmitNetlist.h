// Passes an imported netlist to a sink.
#pragma once

#include "import/ImportedNetlist.h"
#include "import/Sink.h"

namespace Tool::Import {

/// Calls the operations of a sink, for every sink in the same order.
void EmitNetlist(const ImportedNetlist& netlist, Sink& sink);

} // namespace Tool::Import
