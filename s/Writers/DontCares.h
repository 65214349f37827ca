// Constants with don't cares, as each language can have them.
#pragma once

#include "Orn_Hdl/Attributes.h"

#include <string_view>

namespace Orn_Hdl::Writers {

/// The digit that is a don't care where the options say so.
constexpr char DontCare = '-';

/// Whether the value of a constant for a signal of one bit is a don't care: the last digit tells.
bool IsDontCare(const BitVectorValue& value) noexcept;

/// Whether the value of a constant for several bits has a don't care. A text that is no number but
/// for its "-" has none: the writers write it as it stands.
bool HasDontCare(const BitVectorValue& value) noexcept;

/// The value that Verilog gets: x in the place of the don't cares, and a length and a base.
/// \param value one for which `HasDontCare` is true.
BitVectorValue InVerilog(const BitVectorValue& value);

/// The value that VHDL gets: a string of std_logic with one element a bit, since VHDL-93 has no
/// don't care in a literal with a base.
/// \param value one for which `HasDontCare` is true.
BitVectorValue InVhdl(const BitVectorValue& value);

} // namespace Orn_Hdl::Writers
