// Checks the commands that a model writes of itself.
#pragma once

#include "Orn_Hdl/Model.h"

namespace Fuzz {

/// Checks that a fresh model executes all commands of a model, and then writes the same commands.
/// Nothing is checked of a model that no commands can express.
void CheckCommands(const Orn_Hdl::Model& model);

} // namespace Fuzz
