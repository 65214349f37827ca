// `orn-hdl warnings`: the warnings of `orn-hdl run`.
#pragma once

#include "Tool.h"

namespace Tool {

/// Prints a line a warning.
Status PrintWarnings();
/// Prints the table of the documentation.
Status PrintWarningsPage();

} // namespace Tool
