// Differences as text and as JSON.
#pragma once

#include "diff/Difference.h"

#include <string>
#include <vector>

namespace Tool::Diff {

/// What is printed.
struct Report {
    /// The names of both files.
    std::string fileA;
    std::string fileB;
    /// The counts.
    const Differences& all;
    const std::vector<Difference>& shown;
};

/// The differences, grouped by what changed, and a line with their numbers.
std::string SpellAsText(const Report& report);
/// One object.
std::string SpellAsJson(const Report& report);

} // namespace Tool::Diff
