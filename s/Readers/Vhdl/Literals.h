// Numbers, strings and bit strings of VHDL.
#pragma once

#include "Readers/Value.h"

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace Orn_Hdl::Readers::Vhdl {

/// The value of an integer literal, with or without a base; nothing when it is none, or is far too
/// large.
std::optional<std::int64_t> GetInteger(std::string_view text);
/// Whether a number has a point.
bool IsReal(std::string_view text) noexcept;

/// The characters of a string, in which two quotes stand for one.
std::string ReadString(std::string_view text);
/// The bit of a character literal: 0 or 1, x, z or "-" where these are kept, and "-" for a don't
/// care.
/// \throws LiteralProblem for another value.
char ReadBit(char character, Unknowns unknowns = Unknowns::Refuse);
/// The bits of a string.
/// \throws LiteralProblem.
std::string ReadBits(std::string_view text, Unknowns unknowns = Unknowns::Refuse);

/// A bit string literal.
struct BitString {
    /// The text of one as it stands in the file.
    /// \throws LiteralProblem.
    static BitString Read(std::string_view text);

    std::string bits;
    /// The constant of a model with the digits of the literal, such as "8:H:A5"; empty when the
    /// model can have no more than the bits.
    std::string constant;

    /// The constant of a model that the literal is.
    std::string GetConstant() const {
        return constant.empty() ? MakeConstant(bits, false) : constant;
    }
};

} // namespace Orn_Hdl::Readers::Vhdl
