// Importing a JSON netlist written by Yosys. What it is made of lies in the folder import.
#pragma once

#include "Import.h"
#include "Tool.h"
#include "diagnostics/Reporter.h"

namespace Tool {

Status ImportJson(const ImportOptions& options, Reporter& reporter);

} // namespace Tool
