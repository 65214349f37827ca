// Reads the JSON netlists that Yosys' write_json produces.
#pragma once

#include "ImportDesign.h"

#include <memory>
#include <string>
#include <string_view>

namespace Tool::Import {

/// Reads the text of a whole file. What the importer has no use for is checked to be JSON and
/// dropped. \param keepAttributes whether the attributes of cells and nets are kept. \throws Error
/// when the text is not JSON, or not a netlist.
std::unique_ptr<Design> ReadDesign(std::string text, bool keepAttributes);

/// The module to import: the named one, or, when `name` is empty, the one marked as top, or the
/// only one that is no black box.
/// \throws Error when there is none, or more than one.
Module& FindTop(Design& design, std::string_view name);

/// Whether a module is a leaf: marked as a black box, or without contents.
bool IsLeaf(const Module& module);

} // namespace Tool::Import
