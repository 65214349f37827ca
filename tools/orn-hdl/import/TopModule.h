// The roles of modules: the top module, and leaf modules.
#pragma once

#include "import/ImportedDesign.h"

#include <string_view>

namespace Tool::Import {

/// The module to import: the named one, or, if `name` is empty, the one marked as top, the only one
/// that is not a black box, or the only one with contents that no other one uses.
/// \throws Error if there is none, or more than one.
Module& FindTop(ImportedDesign& design, std::string_view name);

/// Whether a module is a leaf: marked as a black box, or without contents.
bool IsLeaf(const Module& module);

} // namespace Tool::Import
