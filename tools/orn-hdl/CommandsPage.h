// `orn-hdl commands`: the command language, printed from the table that the library holds.
#pragma once

#include "Tool.h"

#include <string>
#include <vector>

namespace Tool {

/// Prints the commands whose phrases begin with the words, all of them without any. A command whose
/// phrase is these words is shown in full.
Status PrintCommands(const std::vector<std::string>& words);

/// Prints the page that documents the command language.
Status PrintCommandsPage();

} // namespace Tool
