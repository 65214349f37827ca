// Constants and the values of attributes, as each language can have them.
#pragma once

#include "Legal/Plan.h"
#include "Orn_Hdl/Attributes.h"
#include "Orn_Hdl/Language.h"

#include <cstddef>
#include <memory>
#include <optional>
#include <string>

namespace Orn_Hdl::Legal {

/// The bits that a constant means, leftmost first, each of "01xz"; nothing when it has no meaning,
/// or one that the languages do not share.
/// \param dontCares whether a digit "-" is a don't care, which is a bit "-".
std::optional<std::string> FindBits(const BitVectorValue& value, std::size_t width, bool dontCares);

/// The bits of the value of an attribute: as many as its length says, or one a digit when it has
/// none. Nothing when the digits do not fit the length, or there are others than 0 and 1.
std::optional<std::string> FindBits(const BitVectorValue& value);

/// A constant of these bits as the writer of a language takes it.
BitVectorValue MakeConstant(const std::string& bits, Language language);

/// A copy of an attribute, under the same name, with a value that can be written.
std::unique_ptr<Attribute> CopyAttribute(const Attribute& attribute, const Plan& plan,
                                         Language language);

/// Whether the text of the attribute can be written in VHDL. A control character is written between
/// two strings, and the writer removes quotes that enclose a whole value.
bool CanBeEscaped(const Attribute& attribute);

/// A line of a comment that no tool takes for a command.
std::string WithoutDirective(std::string_view line);

} // namespace Orn_Hdl::Legal
