// Importing a netlist in Verilog or VHDL, which the library's readers read.
#pragma once

#include "Import.h"
#include "Tool.h"
#include "diagnostics/Reporter.h"

namespace Tool {

/// \param format the language of the netlist.
Status ImportNetlist(const ImportOptions& options, ImportFormat format, Reporter& reporter);

} // namespace Tool
