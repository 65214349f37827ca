// Names that are legal in both netlist languages.
#pragma once

#include <string>
#include <string_view>

namespace Tool::Import {

/// Whether a name can be used unchanged in both languages. It must be a VHDL basic identifier, but
/// neither a reserved word of either language nor a type that written VHDL mentions, and it must
/// not end in a suffix of the names that the library generates.
bool IsLegalName(std::string_view name);

/// The end of a message about a name for which `IsLegalName` is false.
constexpr const char* NotLegal = " is not a legal name in Verilog and VHDL";

/// A basic identifier that resembles `name`: other characters become "_", never two in a row nor
/// one at either end. A name that a program generated is reduced to its meaningful parts.
/// \param initial the letter put before a name that would begin with a digit or be empty.
std::string MakeLegalName(std::string_view name, char initial);

} // namespace Tool::Import
