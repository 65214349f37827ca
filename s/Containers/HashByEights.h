// The hash for case-insensitive look-ups of names and words whose order is not visible.
#pragma once

#include "Containers/EightBytes.h"

#include <cstddef>
#include <cstdint>
#include <string_view>

namespace Orn_Hdl {

/// The seed differs between processes on systems that randomise addresses, so that nobody can write
/// a command file whose names all collide. Nothing else may depend on it.
inline std::uint64_t HashSeed() noexcept {
    static const char place = 0;
    return reinterpret_cast<std::uintptr_t>(&place);
}

/// Combines both halves of a product. Every bit depends on the seed in one of the factors, so names
/// that collide with one seed do not collide with another.
inline std::uint64_t MultiplyAndFold(std::uint64_t a, std::uint64_t b) noexcept {
#if defined(__SIZEOF_INT128__)
    __extension__ typedef unsigned __int128 Wide; // NOLINT(modernize-use-using)
    const Wide product = static_cast<Wide>(a) * b;
    return static_cast<std::uint64_t>(product) ^ static_cast<std::uint64_t>(product >> 64);
#else
    return (a * b) ^ ((a >> 32U) * (b >> 32U));
#endif
}

/// Processes eight characters a step; the last step overlaps with the one before it. With the names
/// of a flattened hierarchy, 50 characters long, a replay takes 1.3 times as long if single
/// characters are hashed. With names of 8 characters there is no difference.
/// \param fold returns eight characters with equivalent ones unified, each at its position.
template <class Fold>
inline std::uint64_t WideHashByEights(std::string_view name, Fold fold) noexcept {
    using namespace EightBytes;
    constexpr std::size_t Step = sizeof(std::uint64_t);
    constexpr std::uint64_t Factor = 0x9E3779B97F4A7C15U;
    const char* text = name.data();
    std::size_t left = name.size();
    std::uint64_t hash = left ^ HashSeed();
    const auto mix = [&hash, fold](std::uint64_t word) {
        hash = MultiplyAndFold(hash ^ fold(word), Factor);
    };
    for (; left > Step; left -= Step, text += Step) {
        mix(Load(text));
    }
    const bool isShort = name.size() < Step;
    mix(isShort ? LoadShort(text, left) : Load(text + left - Step));
    return hash;
}

/// The upper half of the wide hash.
template <class Fold> inline std::uint32_t HashByEights(std::string_view name, Fold fold) noexcept {
    return static_cast<std::uint32_t>(WideHashByEights(name, fold) >> 32U);
}

/// The hash of a text, letter case ignored.
inline std::uint32_t HashUpperByEights(std::string_view name) noexcept {
    return HashByEights(name, [](std::uint64_t text) { return EightBytes::ToUpper(text); });
}

} // namespace Orn_Hdl
