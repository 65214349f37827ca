// Reads the JSON netlists that Yosys' write_json produces.
#pragma once

#include "import/ImportedDesign.h"
#include "import/TextSource.h"
#include "import/TokenBatches.h"

#include <memory>
#include <string_view>

namespace Tool::Import {

/// Reads a whole text, piece by piece. Parts that the import does not need are only checked to be
/// JSON. \param keepAttributes whether the attributes of cells and nets are kept. \throws Error if
/// the text is not JSON, or not a netlist.
std::unique_ptr<ImportedDesign> ReadDesign(TextSource& source, bool keepAttributes);
/// Reads a whole text while a thread scans ahead in it, which calls the source. The design and the
/// errors are the same as without it.
std::unique_ptr<ImportedDesign> ReadDesign(TextSource& source, bool keepAttributes,
                                           const TokenBatches::Settings& settings);
/// Reads a text in memory.
std::unique_ptr<ImportedDesign> ReadDesign(std::string_view text, bool keepAttributes);

} // namespace Tool::Import
