// Names the objects of an imported netlist.
#pragma once

#include "import/ImportedNetlist.h"
#include "import/UniqueNames.h"
#include "import/Warnings.h"

namespace Tool::Import {

/// Sets the name of the netlist.
/// \param names the scope of signals, instances and components.
void NameDesign(ImportedNetlist& netlist, UniqueNames& names, Warnings& warnings);
/// Sets the names of cells and signals. Legal names are claimed before similar names are generated
/// for others.
void NameCellsAndSignals(ImportedNetlist& netlist, UniqueNames& names);
/// Sets the names of attributes, and warns of values that cannot be written unchanged.
void NameAttributes(ImportedNetlist& netlist, UniqueNames& names, Warnings& warnings);

} // namespace Tool::Import
