// `orn-hdl draw`: a picture of a design, drawn by Graphviz.
#pragma once

#include "Tool.h"
#include "diagnostics/Reporter.h"

#include <string>

namespace Tool {

struct DrawOptions {
    /// The command file; "-" is standard input. Its WRITE commands write nothing.
    std::string file;
    /// The SVG file to write.
    std::string output;
    /// The instance, port or signal whose surroundings are drawn; empty for the whole design.
    std::string around;
    /// The distance, in instances, of the outermost drawn instances.
    int depth = 1;
    ReportOptions report;
};

Status Draw(const DrawOptions& options);

} // namespace Tool
