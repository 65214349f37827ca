// `orn-hdl import`: converts a JSON netlist written by Yosys to a command file or a netlist.
#pragma once

#include "Output.h"
#include "Tool.h"
#include "diagnostics/Reporter.h"
#include "import/NameRules.h"

#include <optional>
#include <string>
#include <vector>

namespace Tool {

struct ImportOptions {
    /// The JSON file; "-" is standard input.
    std::string file;
    /// The module to import; empty for the one marked as top.
    std::string top;
    /// The command file to write; empty for none.
    std::string commandFile;
    Outputs outputs;
    /// The replacement of x and z, "0" or "1"; empty to reject them.
    std::string unknownAs;
    /// The cell libraries.
    std::vector<std::string> cells;
    /// The languages in which names must be legal; without one, those of the netlists.
    std::optional<Import::NameLanguages> names;
    /// Reject a design whose ports cannot keep their names.
    bool keepPorts = false;
    /// Import the attributes of cells and nets.
    bool attributes = false;
    /// The file for the table of old and new names; empty for none.
    std::string nameMap;
    /// Write legal netlists, or nothing.
    bool legal = false;
    /// Read each netlist back and compare it with the design before it replaces its file.
    bool verify = false;
    ReportOptions report;
};

/// Imports a file. If no output is given, the file is only checked.
Status ImportDesign(const ImportOptions& options);

} // namespace Tool
