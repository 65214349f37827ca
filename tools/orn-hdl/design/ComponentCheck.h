// Components that are models of the same design have to be as these models are.
#pragma once

#include "design/ModelLinks.h"
#include "diagnostics/CommandLines.h"
#include "diagnostics/Reporter.h"

#include <vector>

namespace Orn_Hdl {
class Model;
}

namespace Tool {

/// A model and the command file that it comes from.
struct ModelOfFile {
    Orn_Hdl::Model* model = nullptr;
    CommandLines* lines = nullptr;
};

/// Compares the pins of each component that is a model of the design with the ports of that model:
/// their names, directions and widths. Reports what differs, with both places.
/// \return whether nothing differs.
bool CheckComponents(const std::vector<ModelOfFile>& models, const ModelLinks& links,
                     Reporter& reporter);

} // namespace Tool
