// What names, constants and values of a design have to mean in a netlist.
#pragma once

#include "Orn_Hdl/Attributes.h"
#include "Orn_Hdl/Language.h"
#include "Orn_Hdl/Model/Signals.h"
#include "Readers/Value.h"

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace Orn_Hdl::Proving {

/// The name that a reader finds for a name of a design, whose escaped names have their marks.
std::string_view NameInVerilog(std::string_view name) noexcept;

/// Whether a name stands for no signal: the empty one, and in VHDL "open".
bool IsNothing(std::string_view name, Language language) noexcept;

/// The bits of a constant on a signal of so many bits, leftmost first, each one of "01xz"; nothing
/// when the digits do not say which.
/// \param dontCares whether a digit "-" stands for don't cares, which are bits "-".
std::optional<std::string> BitsOf(const BitVectorValue& value, std::size_t width,
                                  bool dontCares = false);
/// The bits of the constant that a signal is tied to, as a language has them: VHDL has "-" for a
/// don't care, Verilog has x.
/// \param dontCares whether a digit "-" stands for don't cares.
std::optional<std::string> BitsOfConstant(const Signal& signal, bool dontCares, Language language);

/// The text of an attribute in one line, without quotes around it.
std::string TextOf(const Attribute& attribute);

/// Whether the value of a parameter or generic in a netlist is that of an attribute.
/// \param isEscaped whether texts hold the escapes of the language.
bool IsSameValue(const Attribute& attribute, const Readers::Value& value, Language language,
                 bool isEscaped);
/// Whether the text of an attribute in a netlist is that of one in the design.
bool IsSameText(const Attribute& attribute, const Readers::Value& value, Language language,
                bool isEscaped);

} // namespace Orn_Hdl::Proving
