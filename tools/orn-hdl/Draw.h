// `orn-hdl draw`: a picture of a design, drawn by Graphviz.
#pragma once

#include "Tool.h"

#include <string>

namespace Tool {

struct DrawOptions {
    /// The command file; "-" is standard input. Its WRITE lines write nothing.
    std::string file;
    /// The SVG file to write.
    std::string output;
    /// The instance, port or signal whose neighbourhood is drawn; empty for the whole design.
    std::string around;
    /// How many instances the neighbourhood reaches away.
    int depth = 1;
};

Status Draw(const DrawOptions& options);

} // namespace Tool
