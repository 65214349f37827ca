// Names as the model compares them.
#pragma once

#include <string>
#include <string_view>

namespace Tool {

/// A text that two names have in common if the model takes them for one: brackets of any kind are
/// parentheses, "-" is ":", and letter case is ignored.
std::string GetNameKey(std::string_view name);

} // namespace Tool
