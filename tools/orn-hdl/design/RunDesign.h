// `orn-hdl run` with several command files: the models of a design.
#pragma once

#include "Run.h"
#include "Tool.h"

namespace Tool {

/// Replays each file into a model of its own and writes all models, in the order of the files.
Status RunDesign(const RunOptions& options);

} // namespace Tool
