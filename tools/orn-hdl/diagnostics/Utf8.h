// Characters of a text that may be UTF-8.
#pragma once

#include <cstddef>
#include <string_view>

namespace Tool {

/// How many bytes the first character of a text takes: those of a character of UTF-8, or 1 for
/// ASCII and for a byte that is no UTF-8.
std::size_t GetCharacterSize(std::string_view text) noexcept;
/// The number of characters of a text. A byte that is no UTF-8 counts as one.
std::size_t CountCharacters(std::string_view text) noexcept;

} // namespace Tool
