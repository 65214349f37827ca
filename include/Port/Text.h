/// \file
/// Helpers over C texts. A null pointer reads as the empty text everywhere.
#pragma once

#include "Port/Export.h"

#include <cstddef>
#include <string_view>

namespace Port {

/// Converts a text that is, as a whole, one decimal integer with an optional sign.
/// \return false, `value` untouched, for any other text and for a number that does not fit.
ORN_HDL_API bool strtol(const char* text, long& value) noexcept;

/// The integer at the start of a text by the rules of `atoi`: leading white space, an optional
/// sign, digits up to the first other character; no digits give 0. Saturates at the limits of int.
ORN_HDL_API int ToIntSaturated(std::string_view text) noexcept;

/// The number at the start of a text by the rules of `atof` in the "C" locale; 0.0 when the text
/// gives no finite number.
ORN_HDL_API double ToDouble(const char* text);

/// Compares ignoring the case of ASCII letters; below, at or above zero.
ORN_HDL_API int stricmp(const char* a, const char* b) noexcept;

/// As `stricmp`, over at most the first `count` characters.
ORN_HDL_API int strnicmp(const char* a, const char* b, std::size_t count) noexcept;

/// Whether the whole text matches a pattern in which "*" stands for any characters, none included.
ORN_HDL_API bool strmatch(const char* text, const char* pattern) noexcept;

/// As `strmatch`, ignoring the case of ASCII letters.
ORN_HDL_API bool strimatch(const char* text, const char* pattern) noexcept;

} // namespace Port
