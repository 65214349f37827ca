// Writing a netlist over and over, with what must hold of every write.
#pragma once

#include "Orn_Hdl/Model.h"

#include <string>
#include <vector>

namespace Fuzz {

/// Writes the netlist three times in both languages, each time into memory and into a file, and
/// checks that a write leaves the netlist consistent and writable, that every signal is declared
/// once, that from the second time on nothing changes any more, and that files and memory say the
/// same. The files must be `MemoryFiles`.
/// \param loose signals that no netlist holds.
/// \return all that was written.
std::string WriteAgainAndAgain(Orn_Hdl::Netlist& netlist, const Orn_Hdl::HdlOptions& options,
                               const std::vector<Orn_Hdl::Signal*>& loose = {});

/// Checks that a file's text is a memory stream's but for indentation and inserted breaks.
void CheckSameButForBreaks(const std::string& fileText, const std::string& memoryText);

} // namespace Fuzz
