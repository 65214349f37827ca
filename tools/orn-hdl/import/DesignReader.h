// Reads the JSON netlists that Yosys' write_json produces.
#pragma once

#include "import/ImportedDesign.h"

#include <memory>
#include <string>

namespace Tool::Import {

/// Reads the text of a whole file. Parts that the import does not need are only checked to be JSON.
/// \param keepAttributes whether the attributes of cells and nets are kept.
/// \throws Error if the text is not JSON, or not a netlist.
std::unique_ptr<ImportedDesign> ReadDesign(std::string text, bool keepAttributes);

} // namespace Tool::Import
