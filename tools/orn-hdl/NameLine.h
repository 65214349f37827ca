// A line of a table of old and new names.
#pragma once

#include <string>
#include <string_view>

namespace Port {
class Stream;
}

namespace Tool {

/// Writes an object's kind, its old name and its new name, separated by tabs.
void WriteNameLine(Port::Stream& out, std::string_view kind, std::string_view oldName,
                   std::string_view newName);

/// The name of what a component has: the component's name, a dot and the name.
std::string JoinNames(std::string_view owner, std::string_view name);

} // namespace Tool
