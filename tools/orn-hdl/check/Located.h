// Findings with the lines of the command file to which they belong.
#pragma once

#include "Orn_Hdl/Check.h"

#include <cstdint>
#include <string>
#include <vector>

namespace Tool::Checking {

/// A finding, and where it is.
struct Located {
    Orn_Hdl::Check::Finding finding;
    /// The line of the command that brought it in; 0 when there is none.
    std::uint64_t line = 0;
    /// The line of the other half of a clash; 0 for none.
    std::uint64_t otherLine = 0;
    /// The line at which the design was checked.
    std::uint64_t checkedAt = 0;
    /// Whether it keeps a netlist from being written, whatever the targets make of it.
    bool isObstacle = false;

    bool IsError() const noexcept {
        return isObstacle || finding.GetSeverity() == Orn_Hdl::Check::Severity::Error;
    }
};

/// Reads a command file once more for the lines of the findings' causes. Only causes are kept in
/// memory, and reading stops when all are found.
/// \param systemName the name under which the system opens the file.
/// \return false when the file cannot be read.
bool Locate(const char* systemName, std::vector<Located>& findings);

} // namespace Tool::Checking
