// Writes a netlist several times and checks every write.
#pragma once

#include "Orn_Hdl/Model.h"

#include <string>
#include <string_view>
#include <vector>

namespace Fuzz {

/// Writes the netlist three times in both languages into memory.
/// \return all that was written.
std::string WriteThreeTimes(Orn_Hdl::Netlist& netlist, const Orn_Hdl::HdlOptions& options);

/// Writes the netlist once in both languages into memory, and checks that each write leaves it
/// consistent and declares every signal once.
/// \param loose signals that no netlist holds.
void WriteOnceWithChecks(Orn_Hdl::Netlist& netlist, const Orn_Hdl::HdlOptions& options,
                         const std::vector<Orn_Hdl::Signal*>& loose = {});

/// Writes the netlist three times in both languages into memory and once into files, and checks
/// that each write leaves it consistent and declares every signal once, that the third write equals
/// the second, and that a file gets the text that memory gets.
/// \param loose signals that no netlist holds.
/// \return all that was written into memory.
std::string WriteWithChecks(Orn_Hdl::Netlist& netlist, const Orn_Hdl::HdlOptions& options,
                            const std::vector<Orn_Hdl::Signal*>& loose = {});

/// Checks that a file's text is a memory stream's but for indentation and inserted breaks.
void CheckSameButForBreaks(std::string_view fileText, std::string_view memoryText);

} // namespace Fuzz
