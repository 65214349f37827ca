// Names, ranges and constants as written in the command language.
#pragma once

#include "import/ImportedDesign.h"

#include <cstdint>
#include <string>
#include <string_view>

namespace Tool::Import {

/// A range with indices that are valid in both languages: a range that begins below 0, or exceeds
/// 32 bits, is renumbered from 0.
BitRange Normalize(BitRange range, std::uint32_t width) noexcept;
/// The index of a bit of a bus, whose position is counted from the rightmost bit.
std::int64_t GetIndex(BitRange range, std::uint32_t width, std::uint32_t position) noexcept;

std::string MakeBitName(std::string_view base, std::int64_t index);
std::string MakeBusName(std::string_view base, std::int64_t left, std::int64_t right);

/// A constant: a bare digit for one bit without a range, otherwise LENGTH:B:DIGITS.
std::string MakeConstant(const std::string& digits, bool scalar);

/// An unspecified direction is written as that of an inout pin.
const char* GetDirectionName(Direction direction) noexcept;

} // namespace Tool::Import
