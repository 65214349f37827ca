// `orn-hdl import`: a design in Yosys' JSON form becomes a command file or a netlist.
#pragma once

#include "Output.h"
#include "Tool.h"

#include <string>

namespace Tool {

struct ImportOptions {
    /// The JSON file; "-" is standard input.
    std::string file;
    /// The module to import; empty for the one marked as top.
    std::string top;
    /// The command file to write; empty for none.
    std::string commandFile;
    Outputs outputs;
    /// What the values x and z become, "0" or "1"; empty to refuse them.
    std::string unknownAs;
    /// Take over the attributes of cells and nets.
    bool attributes = false;
    /// Where the table of old and new names goes; empty for nowhere.
    std::string nameMap;
};

/// Without any output the file is only checked.
Status ImportDesign(const ImportOptions& options);

} // namespace Tool
