// The lines of both files that brought in what differs.
#pragma once

#include "diff/Difference.h"

#include <vector>

namespace Tool {
class LoadedDesign;
}

namespace Tool::Diff {

/// Reads each file once more for the lines of the differences. What a file does not tell has no
/// line.
void FindLines(std::vector<Difference>& differences, const LoadedDesign& a, const LoadedDesign& b);

} // namespace Tool::Diff
