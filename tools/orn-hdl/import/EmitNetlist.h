// Hands an imported netlist to a sink.
#pragma once

#include "import/ImportedNetlist.h"
#include "import/Sink.h"

namespace Tool::Import {

/// Every sink gets the same sequence of operations.
void EmitNetlist(const ImportedNetlist& netlist, Sink& sink);

} // namespace Tool::Import
