// Names the objects of an imported netlist.
#pragma once

#include "import/ImportedNetlist.h"
#include "import/UniqueNames.h"
#include "import/Warnings.h"

#include <string>
#include <vector>

namespace Tool::Import {

/// The names of ports that must be claimed before all others, in the order of the file; empty for
/// a port that is named later. If names may be escaped, as many ports as possible keep their names.
std::vector<std::string> ClaimPortNames(const Module& top, UniqueNames& names);
/// Sets the name of the netlist.
/// \param units the modules of the design, which have names; null for a single module.
/// \param names the scope of signals, instances and components.
void NameDesign(ImportedNetlist& netlist, const DesignUnits* units, UniqueNames& names,
                Warnings& warnings);
/// Sets the names of cells and signals. Legal names are claimed before similar names are generated
/// for others.
void NameCellsAndSignals(ImportedNetlist& netlist, UniqueNames& names);
/// Warns of each port that was renamed. \throws Error if `keepPorts` and there is one.
void ReportRenamedPorts(const ImportedNetlist& netlist, const NameRules& rules, bool keepPorts,
                        Warnings& warnings);
/// Sets the names of attributes, and warns of values that cannot be written unchanged.
/// \param signalNames the scope of signals, instances and components.
void NameAttributes(ImportedNetlist& netlist, UniqueNames& signalNames, Warnings& warnings);

} // namespace Tool::Import
