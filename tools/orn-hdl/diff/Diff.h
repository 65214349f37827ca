// `orn-hdl diff`: tells in what two designs differ.
#pragma once

#include "Tool.h"
#include "diagnostics/Reporter.h"
#include "load/Load.h"

#include <cstddef>
#include <string>
#include <vector>

namespace Tool {

enum class DiffFormat { Text, Json };

struct DiffOptions {
    DesignFile a;
    DesignFile b;
    /// Files that declare the components of netlists.
    std::vector<std::string> libraries;
    /// What does not count: some of the words of `GetIgnorable`.
    std::vector<std::string> ignored;
    DiffFormat format = DiffFormat::Text;
    /// How many differences are shown; 0 for all.
    std::size_t limit = 100;
    bool quiet = false;
    /// How messages about the files are printed.
    ReportOptions report;
    /// How many threads may work together; 0 is what the system gives.
    unsigned threads = 0;
};

/// The words that an option may ignore.
const std::vector<std::string>& GetIgnorable();

/// Prints the differences on standard output.
/// \return `Success` if there are none, `Failed` if there are some, and `Usage` if a file cannot be
///         read or is invalid.
Status PrintDiff(const DiffOptions& options);

} // namespace Tool
