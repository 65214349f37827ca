// `orn-hdl verify`: compares a netlist with the design of a command file.
#pragma once

#include "Tool.h"
#include "diagnostics/Reporter.h"

#include <optional>
#include <string>

namespace Tool {

struct VerifyOptions {
    std::string netlist;
    /// The command file; "-" is standard input. Its WRITE commands do nothing.
    std::string commands;
    /// The name of the model; the default is the command file's name without folder and extension.
    std::optional<std::string> model;
    /// "verilog" or "vhdl"; empty for what the extension of the netlist says.
    std::string language;
    /// Compare with the design as it is written legally.
    bool legal = false;
    /// How a legal netlist changes names: "rename" or "escape".
    std::string names = "rename";
    /// The file for the certificate; empty for none.
    std::string certificate;
    bool quiet = false;
    ReportOptions report;
    /// Whether the digit "-" of a constant is a don't care.
    bool dontCares = false;
    /// How many threads may work together; 0 is what the system gives.
    unsigned threads = 0;
};

Status Verify(const VerifyOptions& options);

} // namespace Tool
