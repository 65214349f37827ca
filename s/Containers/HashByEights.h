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

inline std::uint64_t MixEight(std::uint64_t hash, std::uint64_t word) noexcept {
    constexpr std::uint64_t Factor = 0x9E3779B97F4A7C15U;
    return MultiplyAndFold(hash ^ word, Factor);
}

/// Continues a hash with at most 16 characters.
/// \param fold returns eight characters with equivalent ones unified, each at its position.
template <class Fold>
inline std::uint64_t MixTwoEights(std::uint64_t hash, std::string_view text, Fold fold) noexcept {
    using namespace EightBytes;
    if (text.size() > Count) {
        hash = MixEight(hash, fold(Load(text.data())));
    }
    // The last step overlaps with the one before it.
    return MixEight(hash, fold(text.size() < Count ? LoadShort(text.data(), text.size())
                                                   : Load(text.data() + text.size() - Count)));
}

/// What `WideHashByEights` returns for a text of at most 16 characters. It is short enough to be
/// inlined.
template <class Fold>
inline std::uint64_t WideHashByTwoEights(std::string_view text, Fold fold) noexcept {
    return MixTwoEights(text.size() ^ HashSeed(), text, fold);
}

/// Processes eight characters a step. With the names of a flattened hierarchy, 50 characters long,
/// a replay takes 1.3 times as long if single characters are hashed. With names of 8 characters
/// there is no difference.
/// \param fold returns eight characters with equivalent ones unified, each at its position.
template <class Fold>
inline std::uint64_t WideHashByEights(std::string_view name, Fold fold) noexcept {
    using namespace EightBytes;
    std::uint64_t hash = name.size() ^ HashSeed();
    for (; name.size() > 2 * Count; name.remove_prefix(Count)) {
        hash = MixEight(hash, fold(Load(name.data())));
    }
    return MixTwoEights(hash, name, fold);
}

inline std::uint32_t UpperHalf(std::uint64_t hash) noexcept {
    return static_cast<std::uint32_t>(hash >> 32U);
}

/// The upper half of the wide hash.
template <class Fold> inline std::uint32_t HashByEights(std::string_view name, Fold fold) noexcept {
    return UpperHalf(WideHashByEights(name, fold));
}

/// The hash of a text, letter case ignored.
inline std::uint32_t HashUpperByEights(std::string_view name) noexcept {
    return HashByEights(name, [](std::uint64_t text) { return EightBytes::ToUpper(text); });
}

} // namespace Orn_Hdl
