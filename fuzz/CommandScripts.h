// Checks the commands that a model writes of itself.
#pragma once

#include "Orn_Hdl/Model.h"

namespace Fuzz {

/// What the commands of a replayed model have to be. Calls make designs whose commands come again
/// in another order: an instance of the name of a slice may stand elsewhere.
enum class Again { Same, Any };

/// Checks that a fresh model executes all commands of a model, and then writes the same commands.
/// Nothing is checked of a model that no commands can express.
void CheckCommands(const Orn_Hdl::Model& model, Again again);

} // namespace Fuzz
