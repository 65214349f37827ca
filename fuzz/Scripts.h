// Command scripts: made from bytes by the grammar of the command language, and run with everything
// checked.
#pragma once

#include "Bytes.h"

#include <string>
#include <string_view>
#include <vector>

namespace Fuzz {

using Script = std::vector<std::string>;

/// The lines of a text.
Script SplitScript(std::string_view text);
/// A script of commands from the catalogue, their arguments filled in by kind, mostly with names
/// that meet again.
Script MakeScript(Bytes& bytes);

/// Runs a script in two engines, writes both netlists again and again, and checks that all is
/// consistent and that both engines did and wrote the same.
void CheckScript(const Script& script);

} // namespace Fuzz
