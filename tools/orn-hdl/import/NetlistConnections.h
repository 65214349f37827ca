// Determines the connections of the pins of an imported netlist.
#pragma once

#include "import/BitUses.h"
#include "import/ImportedNetlist.h"
#include "import/UniqueNames.h"

namespace Tool::Import {

/// Sets the kinds of the connections and whether there are open inputs, and adds the signals that
/// carry constants. \param names receives the names that the library will give to the signals of
/// constant pins.
void DecideConnections(ImportedNetlist& netlist, const BitUses& uses, UniqueNames& names);

} // namespace Tool::Import
