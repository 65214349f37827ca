// Readable names for the copies of modules that Yosys makes for sets of parameters.
#pragma once

#include "import/ImportedDesign.h"

#include <string>
#include <string_view>

namespace Tool::Import {

/// A name that says which copy of a module it is: "fifo_DEPTH_16" for
/// "$paramod\fifo\DEPTH=s32'00000000000000000000000000010000". In the name
/// "$paramod$b7ca9bd56160cd76a1240b83200703503dd53850\fifo" a number stands for a long list: the
/// name is made of the module's parameters then, or is "fifo_b7ca9bd5" if that would be long. A
/// module that is no copy keeps its name.
std::string MakeReadableName(const Module& module);

/// Whether Yosys gave the name to a copy of a module.
bool IsCopyOfModule(std::string_view name) noexcept;

} // namespace Tool::Import
