// What a file is that is no command file.
#pragma once

#include <string>
#include <string_view>

namespace Tool {

/// Says what a file looks like by its beginning, and what can be done with it; the empty text if it
/// looks like nothing that is known. Meant for files that have been found not to be command files.
std::string DescribeFileKind(std::string_view beginning);

} // namespace Tool
