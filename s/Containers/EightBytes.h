// Eight characters of a text, processed as one number.
#pragma once

#include <bit>
#include <cstddef>
#include <cstdint>
#include <cstring>

namespace Orn_Hdl::EightBytes {

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

/// The index in memory, counted from 0, of the first marked byte. At least one must be marked.
constexpr std::size_t FirstMarked(std::uint64_t marks) noexcept {
    static_assert(std::endian::native == std::endian::little,
                  "the first byte in memory is the lowest of a number");
    return static_cast<std::size_t>(std::countr_zero(marks)) / 8;
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

} // namespace Orn_Hdl::EightBytes
