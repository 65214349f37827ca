// Simulation models in VHDL of the cells that Yosys makes by itself.
#pragma once

#include "import/ImportedNetlist.h"
#include "import/Warnings.h"

#include "Port/File.h"

#include <vector>

namespace Tool::Import {

/// Writes an entity for each component whose type is a cell of Yosys. A component that several
/// modules have is written once.
/// \param netlists the modules of a design, whose names are legal in VHDL.
/// \param warnings gets the types of Yosys that have no model.
/// \throws Error if a module or component has a name that the models need.
void WriteCellModels(const std::vector<ImportedNetlist>& netlists, Port::Stream& out,
                     Warnings& warnings);

/// Whether the type is one of registers, whose model has a first value.
bool HasModelWithFirstValue(std::string_view type);

} // namespace Tool::Import
