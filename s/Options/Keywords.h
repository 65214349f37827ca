// The reserved words of both languages.
#pragma once

#include <string_view>

namespace Orn_Hdl {

/// Reserved in VHDL (IEEE 1076-1993, 13.9); letter case ignored.
bool IsReservedInVhdl(std::string_view word);
/// Reserved in Verilog (IEEE 1364-1995, annex B, without "force"); letter case kept.
bool IsReservedInVerilog(std::string_view word);

} // namespace Orn_Hdl
