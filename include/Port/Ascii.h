/// \file
/// Letter case and digits of ASCII text. Only the letters A to Z have case, and no locale is ever
/// consulted, so the same input gives the same output on every machine.
#pragma once

#include "Port/TextView.h"

#include <cstddef>
#include <string_view>

namespace Port {

/// Whether a character is 0 to 9.
constexpr bool IsDigit(char c) noexcept {
    return c >= '0' && c <= '9';
}

/// Whether a character is a letter of ASCII.
constexpr bool IsLetter(char c) noexcept {
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z');
}

/// The letter in upper case; any other character unchanged.
constexpr char ToUpper(char c) noexcept {
    return c >= 'a' && c <= 'z' ? static_cast<char>(c - 'a' + 'A') : c;
}

/// The letter in lower case; any other character unchanged.
constexpr char ToLower(char c) noexcept {
    return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
}

/// Whether two texts are equal but for the case of ASCII letters; null is read as "".
constexpr bool EqualIgnoringCase(TextView textA, TextView textB) noexcept {
    const std::string_view a = textA;
    const std::string_view b = textB;
    if (a.size() != b.size()) {
        return false;
    }
    for (std::size_t i = 0; i < a.size(); ++i) {
        if (a[i] != b[i] && ToUpper(a[i]) != ToUpper(b[i])) {
            return false;
        }
    }
    return true;
}

/// Compares two texts as `memcmp` does, but for the case of ASCII letters; null is read as "".
/// \return a number below, at or above zero as the first text sorts before, with or after the
/// other,
///         bytes taken as unsigned.
constexpr int OrderIgnoringCase(TextView textA, TextView textB) noexcept {
    const std::string_view a = textA;
    const std::string_view b = textB;
    for (std::size_t i = 0; i < a.size() && i < b.size(); ++i) {
        const auto x = static_cast<unsigned char>(ToUpper(a[i]));
        const auto y = static_cast<unsigned char>(ToUpper(b[i]));
        if (x != y) {
            return x < y ? -1 : 1;
        }
    }
    return a.size() == b.size() ? 0 : (a.size() < b.size() ? -1 : 1);
}

} // namespace Port
