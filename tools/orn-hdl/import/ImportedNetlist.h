// An imported netlist, with all names and connections.
#pragma once

#include "import/BitOwners.h"
#include "import/ImportRules.h"
#include "import/ImportedComponents.h"
#include "import/ImportedDesign.h"
#include "import/UnknownValues.h"
#include "import/Warnings.h"

#include <cstdint>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace Tool::Import {

/// How a pin is connected: not at all, to a constant of its own, or to a signal.
enum class ConnectionKind : std::uint8_t { Open, Constant, Signal };

/// The design must outlive it.
struct ImportedNetlist {
    const Module& top;
    UnknownValues unknown;
    ImportedComponents components;
    BitOwners owners;
    std::string name;
    /// By the index of the cell.
    std::vector<std::string> cellNames;
    /// The new name of each attribute.
    std::unordered_map<std::string_view, std::string> attributeNames;
    /// By the index of the connection.
    std::vector<ConnectionKind> connections;
    /// Whether an input pin of some cell is open.
    bool hasOpenInputs = false;
    /// Whether a constant of a port or pin has a don't care.
    bool hasDontCares = false;
    /// Whether the netlist may be written in VHDL.
    bool hasVhdl = true;
    VhdlClauses vhdl = {};
};

/// Determines all names and connections, so that all errors are found before anything is written.
/// In the design, constants at output pins are replaced by net bits. The units of the rules learn
/// the names of the module's ports; the modules that it uses come first. \param top a module of the
/// design. \throws Error if the design cannot be imported.
ImportedNetlist MakeNetlist(ImportedDesign& design, Module& top, const ImportRules& rules,
                            Warnings& warnings);

} // namespace Tool::Import
