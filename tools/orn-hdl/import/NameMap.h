// The table of names that an import changed or kept.
#pragma once

#include "import/ImportedNetlist.h"

namespace Port {
class Stream;
}

namespace Tool::Import {

/// Writes each object's kind, its name in the file and its name in the netlist, separated by tabs.
void WriteNameMap(const ImportedNetlist& netlist, Port::Stream& out);

} // namespace Tool::Import
