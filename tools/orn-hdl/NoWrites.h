// WRITE commands that do nothing, for tool commands that must not write the files that a command
// file names.
#pragma once

namespace Orn_Hdl {
class CommandFactory;
}

namespace Tool {

/// Replaces the WRITE commands of a factory by commands that do nothing.
void DropWrites(Orn_Hdl::CommandFactory& factory);

} // namespace Tool
