// The hash of names and words that are looked up without regard to letter case.
#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string_view>

namespace Orn_Hdl {

namespace FoldedHashDetail {

constexpr std::uint64_t Each(unsigned byte) noexcept {
    return byte * 0x0101010101010101U;
}

/// The letters of eight characters in upper case and the digits as they are; zero in the place of
/// any other character. Names that are equal as look-ups compare them stay equal so.
inline std::uint64_t FoldEight(std::uint64_t text) noexcept {
    constexpr std::uint64_t High = Each(0x80);
    const std::uint64_t low = text & ~High;
    const auto isFrom = [low](char c) { return low + Each(0x80U - static_cast<unsigned>(c)); };
    const std::uint64_t small = isFrom('a') & ~isFrom('z' + 1);
    const std::uint64_t kept =
        small | (isFrom('A') & ~isFrom('Z' + 1)) | (isFrom('0') & ~isFrom('9' + 1));
    const std::uint64_t upper = text - ((small & High & ~text) >> 2U);
    const std::uint64_t marks = (kept & High & ~text) >> 7U;
    return upper & ((marks << 8U) - marks);
}

inline std::uint64_t LoadEight(const char* text) noexcept {
    std::uint64_t word = 0;
    std::memcpy(&word, text, sizeof word);
    return word;
}

/// Up to eight characters; each of them counts, some of them twice.
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

} // namespace FoldedHashDetail

/// Takes eight characters a step, since every look-up hashes a name; what is left over at the end
/// is taken together with characters before it. Names that differ in other characters than letters
/// and digits alone have one hash.
inline std::uint32_t HashFolded(std::string_view name) noexcept {
    using namespace FoldedHashDetail;
    constexpr std::size_t Step = sizeof(std::uint64_t);
    constexpr std::uint64_t Factor = 0x9E3779B97F4A7C15U;
    const char* text = name.data();
    std::size_t left = name.size();
    std::uint64_t hash = left;
    const auto mix = [&hash](std::uint64_t word) {
        hash = (hash ^ FoldEight(word)) * Factor;
        hash ^= hash >> 32U;
    };
    for (; left > Step; left -= Step, text += Step) {
        mix(LoadEight(text));
    }
    const bool isShort = name.size() < Step;
    mix(isShort ? LoadShort(text, left) : LoadEight(text + left - Step));
    return static_cast<std::uint32_t>(hash * Factor >> 32U);
}

} // namespace Orn_Hdl
