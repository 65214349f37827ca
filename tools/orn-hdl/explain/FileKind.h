// What a file is that is no command file.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace Tool {

/// How much of a file tells what it is.
constexpr std::size_t BeginningSize = 4096;

/// Says what a file looks like by its beginning, and what can be done with it; the empty text if it
/// looks like nothing that is known. Meant for files that have been found not to be command files.
std::string DescribeFileKind(std::string_view beginning);

} // namespace Tool
