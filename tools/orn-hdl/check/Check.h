// `orn-hdl check`: tells what standards and tools make of the netlists that a command file writes.
#pragma once

#include "Orn_Hdl/Check.h"
#include "Tool.h"
#include "diagnostics/Reporter.h"

#include <optional>
#include <string>
#include <vector>

namespace Tool {

struct CheckOptions {
    /// The command files; "-" is standard input.
    std::vector<std::string> files;
    /// The name of the model; without one, the file's name without folder and extension.
    std::optional<std::string> model;
    /// The names of the targets with commas between them; empty for all.
    std::string targets;
    /// "error", "warning" or "never".
    std::string failOn = "error";
    /// How findings are printed, and lines that fail.
    ReportOptions report;
    /// Prints the rules in place of a check.
    bool list = false;
    /// The same as a table of the documentation.
    bool markdown = false;
    /// Prints one rule in place of a check.
    std::string explain;
    /// Whether the digit "-" of a constant is a don't care.
    bool dontCares = false;
    /// How many threads may work together; 0 is what the system gives.
    unsigned threads = 0;
};

Status CheckFiles(const CheckOptions& options);

} // namespace Tool
