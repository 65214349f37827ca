// What the user asks of an import.
#pragma once

#include "import/CellLibrary.h"
#include "import/NameRules.h"
#include "import/UnknownValues.h"

namespace Tool::Import {

class DesignUnits;

/// What the user asks of an import.
struct ImportRules {
    UnknownValues unknown;
    NameRules names;
    /// Whether renaming a port is an error.
    bool keepPorts = false;
    const CellLibrary& library;
    /// The modules of a design with hierarchy; null if the design is a single module, whose cells
    /// must be leaf cells.
    DesignUnits* units = nullptr;
};

} // namespace Tool::Import
