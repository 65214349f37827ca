// Reports where a netlist does not mean what its design does.
#pragma once

#include "Tool.h"
#include "diagnostics/Diagnostic.h"

#include "Orn_Hdl/Proof.h"

#include <cstdint>
#include <string>
#include <vector>

namespace Tool {

class CommandLines;
class Reporter;

/// Reports differences at the lines of the command file that brought the objects in.
/// \param netlist the netlist, as the user named it.
/// \param line the line that wrote the netlist, where everything else is reported.
/// \return the exit status.
Status ReportDifferences(const std::vector<Orn_Hdl::Proof::Difference>& differences,
                         const std::string& netlist, std::uint64_t line, CommandLines& lines,
                         Reporter& reporter);
/// Reports differences at the lines of the netlist.
Status ReportDifferences(const std::vector<Orn_Hdl::Proof::Difference>& differences,
                         const std::string& netlist, Reporter& reporter);

} // namespace Tool
