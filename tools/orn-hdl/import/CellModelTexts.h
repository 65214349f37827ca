// The models of share/orn-hdl/cells, which the build makes a part of the tool.
#pragma once

#include <string_view>

namespace Tool::Import {

/// The gate-level cells, one entity each.
std::string_view GetGateModels();
/// The word-level cells: a package, then one entity each.
std::string_view GetWordModels();

} // namespace Tool::Import
