// Short texts without line feeds, copied and searched in one go.
#pragma once

#include "Containers/EightBytes.h"

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string_view>

namespace Orn_Hdl::PlainText {

/// Whether a character is a line feed, or another control character, of which there are few.
constexpr bool IsControl(char c) noexcept {
    return static_cast<unsigned char>(c) < ' ';
}

/// Copies eight characters. \return false if there is a control character among them.
inline bool CopyEight(const char* from, char* to) noexcept {
    const std::uint64_t word = EightBytes::Load(from);
    std::memcpy(to, &word, sizeof word);
    return !EightBytes::HasBelow(word, ' ');
}

/// Copies a text, some of its characters twice. Most texts are so short that this is faster than a
/// search and a call of `memcpy`.
/// \return false, the text copied in part, if there is a control character in it.
inline bool Copy(std::string_view text, char* to) noexcept {
    constexpr std::size_t Word = EightBytes::Count;
    constexpr std::size_t Half = Word / 2;
    const char* const from = text.data();
    const std::size_t size = text.size();
    if (size <= 1) {
        if (size == 0) {
            return true;
        }
        *to = *from;
        return !IsControl(*from);
    }
    if (size < Half) {
        const char first = from[0];
        const char second = from[1];
        const char last = from[size - 1];
        to[0] = first;
        to[1] = second;
        to[size - 1] = last;
        return !IsControl(first) && !IsControl(second) && !IsControl(last);
    }
    if (size < Word) {
        const std::uint64_t both = EightBytes::LoadShort(from, size);
        const std::uint64_t last = both >> 32U;
        std::memcpy(to, &both, Half);
        std::memcpy(to + size - Half, &last, Half);
        return !EightBytes::HasBelow(both, ' ');
    }
    for (std::size_t i = 0; i < size - Word; i += Word) {
        if (!CopyEight(from + i, to + i)) {
            return false;
        }
    }
    return CopyEight(from + size - Word, to + size - Word);
}

} // namespace Orn_Hdl::PlainText
