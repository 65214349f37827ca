// The reserved words of each target.
#pragma once

#include "Orn_Hdl/Check.h"

#include <string_view>

namespace Orn_Hdl::Checking {

/// What each target makes of a name that could be one of its reserved words: Verilog's have their
/// letter case, VHDL's have none.
/// \param verilogName the name as the Verilog writer spells it.
/// \param vhdlName the name as the VHDL writer spells it.
Check::Verdicts FindReserved(std::string_view verilogName, std::string_view vhdlName);

} // namespace Orn_Hdl::Checking
