// Numbers and strings of Verilog as values.
#pragma once

#include "Readers/Value.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace Orn_Hdl::Readers {

/// A number (IEEE 1364-2005, clause 3.5).
struct Number {
    /// The text of one, with blanks inside when it has any.
    /// \throws LiteralProblem.
    static Number Read(std::string_view text, Unknowns unknowns = Unknowns::Refuse);

    enum Kind { Integer, Real, Fill };
    Kind kind = Integer;
    /// In bits; 0 when no size is given.
    std::uint32_t size = 0;
    /// 2, 8, 10 or 16.
    int base = 10;
    /// Whether a base is given.
    bool isBased = false;
    bool isSigned = false;
    /// Without "_". Of a real number, its whole text; of a fill, one digit.
    std::string digits;

    /// The width that the number has by itself: its size, else 32, or more when its digits need it.
    std::uint32_t GetWidth() const;
    /// So many bits of the number, leftmost first, as an assignment would extend or cut it. A bit
    /// is one of "01xz-". \throws LiteralProblem.
    std::string GetBits(std::uint32_t width) const;
    /// The value as a number without a sign; nothing when it is none below 2 to the power of 62.
    std::optional<std::int64_t> GetValue() const;
};

/// The constant of a model that has the bits of a number in so many bits: "8:H:A5", or "1" for one
/// bit when `isBare`.
std::string MakeConstant(const Number& number, std::uint32_t width, bool isBare);

/// The value that a number is.
/// \throws LiteralProblem.
Value ValueOf(const Number& number, bool isNegative);
/// The value that a string is.
Value ValueOfString(std::string_view text);

/// The characters of a string, whose escape sequences are replaced.
std::string ReadString(std::string_view text);

} // namespace Orn_Hdl::Readers
