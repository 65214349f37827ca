/// \file
/// `Language`, the languages in which netlists are written.
#pragma once

#include "Port/Export.h"

namespace Orn_Hdl {

/// A language in which a netlist is written.
enum class Language { Verilog, Vhdl };

/// Every language, in the order in which a program that writes several of them writes them.
inline constexpr Language Languages[] = {Language::Verilog, Language::Vhdl};

/// The name of a language as people write it: "Verilog" or "VHDL". The command `WRITE` takes it
/// too.
ORN_HDL_API const char* GetLanguageName(Language language) noexcept;

} // namespace Orn_Hdl
