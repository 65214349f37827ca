// Writing the netlists that the user asked for on the command line.
#pragma once

#include "Tool.h"

#include <string>

namespace Orn_Hdl {
class Model;
}

namespace Tool {

class Progress;

/// The netlists to write. An empty name writes none of that language.
struct Outputs {
    std::string verilog;
    std::string vhdl;
    bool noHeader = false;
};

/// Writes the netlists, Verilog first, and complains of those that did not reach their file.
Status WriteOutputs(Orn_Hdl::Model& model, const Outputs& outputs, Progress& progress);

} // namespace Tool
