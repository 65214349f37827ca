// The hash of names and words that are looked up without regard to letter case.
#pragma once

#include "Containers/EightBytes.h"

#include <cstddef>
#include <cstdint>
#include <string_view>

namespace Orn_Hdl {

/// Takes eight characters a step, since every look-up hashes a name; what is left over at the end
/// is taken together with characters before it. Names that differ in ASCII characters other than
/// letters and digits alone have one hash.
inline std::uint32_t HashFolded(std::string_view name) noexcept {
    using namespace EightBytes;
    constexpr std::size_t Step = sizeof(std::uint64_t);
    constexpr std::uint64_t Factor = 0x9E3779B97F4A7C15U;
    const char* text = name.data();
    std::size_t left = name.size();
    std::uint64_t hash = left;
    const auto mix = [&hash](std::uint64_t word) {
        hash = (hash ^ Fold(word)) * Factor;
        hash ^= hash >> 32U;
    };
    for (; left > Step; left -= Step, text += Step) {
        mix(Load(text));
    }
    const bool isShort = name.size() < Step;
    mix(isShort ? LoadShort(text, left) : Load(text + left - Step));
    return static_cast<std::uint32_t>(hash * Factor >> 32U);
}

} // namespace Orn_Hdl
