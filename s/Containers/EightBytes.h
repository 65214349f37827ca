// Eight characters of a text, processed as one number.
#pragma once

#include <bit>
#include <cstddef>
#include <cstdint>
#include <cstring>

namespace Orn_Hdl::EightBytes {

/// How many characters there are.
constexpr std::size_t Count = sizeof(std::uint64_t);

constexpr std::uint64_t Each(unsigned byte) noexcept {
    return byte * 0x0101010101010101U;
}

constexpr std::uint64_t High = Each(0x80);

/// The high bit of each byte that is an ASCII character from `first` to `last`.
constexpr std::uint64_t MarkRange(std::uint64_t text, char first, char last) noexcept {
    const std::uint64_t low = text & ~High;
    const std::uint64_t from = low + Each(0x80U - static_cast<unsigned>(first));
    const std::uint64_t behind = low + Each(0x7FU - static_cast<unsigned>(last));
    return from & ~behind & ~text & High;
}

/// The high bit of each byte that is an ASCII character up to `last`.
constexpr std::uint64_t MarkUpTo(std::uint64_t text, char last) noexcept {
    const std::uint64_t behind = (text & ~High) + Each(0x7FU - static_cast<unsigned>(last));
    return ~(behind | text) & High;
}

/// The index in memory, counted from 0, of the first marked byte. At least one must be marked.
constexpr std::size_t FirstMarked(std::uint64_t marks) noexcept {
    static_assert(std::endian::native == std::endian::little,
                  "the first byte in memory is the lowest of a number");
    return static_cast<unsigned>(std::countr_zero(marks)) / 8;
}

/// Whether one of the bytes is an ASCII character below `limit`, which is one itself.
constexpr bool HasBelow(std::uint64_t text, char limit) noexcept {
    return ((text - Each(static_cast<unsigned char>(limit))) & ~text & High) != 0;
}

/// The characters with letters in upper case.
constexpr std::uint64_t ToUpper(std::uint64_t text) noexcept {
    return text - (MarkRange(text, 'a', 'z') >> 2U);
}

inline std::uint64_t Load(const char* text) noexcept {
    std::uint64_t word = 0;
    std::memcpy(&word, text, sizeof word);
    return word;
}

/// Fewer than eight characters as a number, which may contain some of them twice.
inline std::uint64_t LoadShort(const char* text, std::size_t size) noexcept {
    std::uint32_t first = 0;
    std::uint32_t last = 0;
    if (size >= sizeof first) {
        std::memcpy(&first, text, sizeof first);
        std::memcpy(&last, text + size - sizeof last, sizeof last);
        return first | std::uint64_t(last) << 32U;
    }
    const auto at = [text](std::size_t i) {
        return static_cast<std::uint64_t>(static_cast<unsigned char>(text[i]));
    };
    return size == 0 ? 0 : at(0) | at(size / 2) << 8U | at(size - 1) << 16U;
}

/// Copies a text of any length, most quickly one of a few characters, for which a call of `memcpy`
/// takes longer than copying. The places do not overlap. \return the place behind the copy.
inline char* Copy(const char* from, std::size_t size, char* to) noexcept {
    if (size > 2 * Count) {
        std::memcpy(to, from, size);
    } else if (size >= Count) {
        const std::uint64_t last = Load(from + size - Count);
        std::memcpy(to, from, Count);
        std::memcpy(to + size - Count, &last, Count);
    } else if (size >= Count / 2) {
        std::uint32_t last = 0;
        std::memcpy(&last, from + size - sizeof last, sizeof last);
        std::memcpy(to, from, sizeof last);
        std::memcpy(to + size - sizeof last, &last, sizeof last);
    } else if (size > 0) {
        to[0] = from[0];
        to[size / 2] = from[size / 2];
        to[size - 1] = from[size - 1];
    }
    return to + size;
}

/// Whether two texts of one size are equal. For a few characters this is faster than a call.
inline bool Equal(const char* a, const char* b, std::size_t size) noexcept {
    if (size < Count) {
        return LoadShort(a, size) == LoadShort(b, size);
    }
    for (std::size_t i = 0; i < size - Count; i += Count) {
        if (Load(a + i) != Load(b + i)) {
            return false;
        }
    }
    // The last step overlaps with the one before it.
    return Load(a + size - Count) == Load(b + size - Count);
}

} // namespace Orn_Hdl::EightBytes
