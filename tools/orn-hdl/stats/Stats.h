// `orn-hdl stats`: counts what the design of a command file is made of.
#pragma once

#include "Tool.h"
#include "diagnostics/Reporter.h"

#include <optional>
#include <string>

namespace Tool {

enum class StatsFormat { Text, Json };

struct StatsOptions {
    /// The command file; "-" is standard input.
    std::string file;
    /// The name of the model; the default is the file's name without folder and extension.
    std::optional<std::string> model;
    StatsFormat format = StatsFormat::Text;
    bool quiet = false;
    /// How messages about the command file are printed.
    ReportOptions report;
    /// How many threads may work together; 0 is what the system gives.
    unsigned threads = 0;
};

/// Replays the file without its WRITE commands and prints the counts on standard output.
Status PrintStats(const StatsOptions& options);

} // namespace Tool
