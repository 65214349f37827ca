// What the user asks of an import.
#pragma once

#include "import/CellLibrary.h"
#include "import/NameRules.h"
#include "import/UnknownValues.h"

namespace Tool::Import {

class DesignUnits;

/// The clauses that VHDL gets.
struct VhdlClauses {
    /// Whether each module gets a configuration, which binds the cells of other modules to these.
    bool configuration = false;
    /// Whether no other library than IEEE is named.
    bool ieeeAlone = false;
};

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
    VhdlClauses vhdl = {};
};

} // namespace Tool::Import
