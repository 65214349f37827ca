// Suggestions for misspelt words.
#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace Tool {

/// The candidate that a misspelt word most likely stands for, or the empty text if none resembles
/// it. A word resembles a candidate if few characters must be inserted, removed, replaced or
/// swapped with their neighbour; letter case is ignored. Of several candidates that are equally
/// near, the first is returned.
std::string GetNearest(std::string_view word, const std::vector<std::string>& candidates);

} // namespace Tool
