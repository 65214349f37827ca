// Names that are legal in both netlist languages, whatever their letter case.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace Orn_Hdl::Legal {

/// A longer name is cut when it is changed; every tool takes that many characters.
constexpr std::size_t LongestName = 1000;
/// Verilator takes no longer name for the top of a design.
constexpr std::size_t LongestDesignName = 120;

/// Whether a changed name may be this one. It is a basic identifier of VHDL, no target reserves
/// it in any letter case, and it is no name that written VHDL mentions.
bool IsLegal(std::string_view name);

/// A basic identifier that resembles `name`: other characters become "_", never two in a row nor
/// one at either end.
/// \param initial the letter put before a name that would begin with a digit or be empty.
std::string MakeSimilar(std::string_view name, char initial, std::size_t longest);

/// A name as an escaped identifier of Verilog, with the blank that ends it, and as an extended
/// identifier of VHDL. \return whether the characters can stand in both.
bool Escape(std::string_view name, std::string& verilog, std::string& vhdl);

} // namespace Orn_Hdl::Legal
