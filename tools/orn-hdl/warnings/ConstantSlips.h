// Slips in the constants of ASSIGN CONSTANT.
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

namespace Tool {

/// What is wrong with a part of a constant.
struct WrongDigit {
    std::string message;
    /// The wrong part of the constant.
    std::size_t offset = 0;
    std::size_t length = 1;
};

/// The first digit that the base of a constant does not have, or a base that is unknown. Digits
/// that one of the languages knows besides, such as x, z and -, are none.
/// \param dontCares whether "-" is a digit of every base.
std::optional<WrongDigit> FindWrongDigit(std::string_view value, bool dontCares);

/// Whether the digits of a constant need more than one bit.
bool NeedsSeveralBits(std::string_view value);

} // namespace Tool
