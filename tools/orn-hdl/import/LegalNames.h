// Names that both netlist languages can hold.
#pragma once

#include <string>
#include <string_view>

namespace Tool::Import {

/// Whether a name can stand unchanged in both languages: a VHDL basic identifier that is no
/// reserved word of either language, no type that written VHDL mentions, and has no suffix of the
/// names that the library generates.
bool IsLegalName(std::string_view name);

/// A basic identifier that resembles `name`: other characters become "_", never two in a row nor
/// one at either end. Of a name that a program made up, only the parts that mean something are
/// kept. \param initial the letter put before a name that would begin with a digit or be empty.
std::string MakeLegalName(std::string_view name, char initial);

} // namespace Tool::Import
