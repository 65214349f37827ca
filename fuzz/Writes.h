// Writing a netlist over and over, with what must hold of every write.
#pragma once

#include "Orn_Hdl/Model.h"

#include <string>
#include <vector>

namespace Fuzz {

/// Writes the netlist three times in both languages into memory.
/// \return all that was written.
std::string WriteThreeTimes(Orn_Hdl::Netlist& netlist, const Orn_Hdl::HdlOptions& options);

/// Does the same, and checks that a write leaves the netlist consistent and writable, that every
/// signal is declared once, that from the second time on nothing changes any more, and that a file
/// gets what memory gets.
/// \param loose signals that no netlist holds.
/// \return all that was written into memory.
std::string WriteWithChecks(Orn_Hdl::Netlist& netlist, const Orn_Hdl::HdlOptions& options,
                            const std::vector<Orn_Hdl::Signal*>& loose = {});

/// Checks that a file's text is a memory stream's but for indentation and inserted breaks.
void CheckSameButForBreaks(const std::string& fileText, const std::string& memoryText);

} // namespace Fuzz
