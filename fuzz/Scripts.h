// Command scripts: they are made from bytes by the grammar of the command language, and run with
// checks.
#pragma once

#include "Bytes.h"
#include "Sampling.h"

#include <string>
#include <string_view>
#include <vector>

namespace Fuzz {

using Script = std::vector<std::string>;

/// The lines of a text.
Script SplitScript(std::string_view text);
/// A script of commands from the catalogue. Their arguments are filled in by kind, mostly from a
/// few names, so that commands meet the objects of earlier ones.
Script MakeScript(Bytes& bytes);

/// One script in so many is run with all checks.
constexpr std::size_t ScriptsPerFullCheck = 16;

/// With all checks, runs a script in two engines, writes both netlists three times, does all that
/// once more, checks the netlist every few lines and after each write, and checks that both engines
/// did and wrote the same. With few, runs it in one engine with no more than two of its WRITE
/// commands, writes the netlist once, and checks the netlist after the last line and after each
/// write.
void CheckScript(const Script& script, Checks checks);

} // namespace Fuzz
