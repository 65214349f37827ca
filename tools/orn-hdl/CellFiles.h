// Reading files as a whole, and cell libraries.
#pragma once

#include "Tool.h"
#include "diagnostics/Reporter.h"
#include "import/CellLibrary.h"
#include "import/JsonPath.h"

#include <string>
#include <vector>

namespace Tool {

/// Reads a file, and prints a message if that fails.
Status ReadWholeFile(const std::string& name, std::string& text);

/// A place in a JSON file.
Place MakeJsonPlace(const std::string& file, const Import::TextPlace& place);

/// Reads cell libraries, and reports it if one cannot be read.
Status ReadCellFiles(const std::vector<std::string>& files, Import::CellLibrary& library,
                     Reporter& reporter);

} // namespace Tool
