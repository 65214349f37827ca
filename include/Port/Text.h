/// \file
/// Helpers over texts: numbers, comparison, wildcards. A null pointer reads as the empty text.
#pragma once

#include "Port/Export.h"
#include "Port/TextView.h"

#include <cstddef>

namespace Port {

/// Converts a text that consists of one decimal integer with an optional sign.
/// \param value receives the number; unchanged if the result is false.
/// \return false for any other text and for a number that does not fit.
ORN_HDL_API bool strtol(TextView text, long& value) noexcept;

/// The integer at the start of a text by the rules of `atoi`: leading white space, an optional
/// sign, digits up to the first other character; no digits give 0. Saturates at the limits of int.
ORN_HDL_API int ToIntSaturated(TextView text) noexcept;

/// The number at the start of a text by the rules of `atof` in the "C" locale, whatever locale is
/// in use. A number too small for a double gives a zero of its sign, one that is not finite 0.0.
ORN_HDL_API double ToDouble(TextView text);

/// Compares two texts ignoring the case of ASCII letters.
/// \return a number below, at or above zero as `a` sorts before, with or after `b`.
ORN_HDL_API int stricmp(TextView a, TextView b) noexcept;

/// Compares at most the first `count` characters of two texts, ignoring the case of ASCII letters.
/// \return a number below, at or above zero as `a` sorts before, with or after `b`.
ORN_HDL_API int strnicmp(TextView a, TextView b, std::size_t count) noexcept;

/// Whether the whole text matches a pattern in which "*" matches any characters, including none.
ORN_HDL_API bool strmatch(TextView text, TextView pattern) noexcept;

/// Whether the whole text matches a pattern in which "*" matches any characters, including none,
/// ignoring the case of ASCII letters.
ORN_HDL_API bool strimatch(TextView text, TextView pattern) noexcept;

} // namespace Port
