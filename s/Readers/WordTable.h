// Tells quickly that a name is no reserved word.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <string_view>

namespace Orn_Hdl::Readers {

/// Finds words by their length and three of their characters, letter case ignored. Most names are
/// in the place of no word, and need not be compared with one.
template <std::size_t Count> class WordTable {
public:
    /// \param entries have a member `word` of two characters or more.
    template <class Entry> explicit constexpr WordTable(const Entry (&entries)[Count]) {
        static_assert(Count < 255, "an index and none have to fit in a byte");
        for (std::size_t i = Count; i-- > 0;) {
            std::uint8_t& first = first_[PlaceOf(entries[i].word)];
            next_[i] = first;
            first = static_cast<std::uint8_t>(i + 1);
        }
    }

    /// The index of the entry that \p isSame accepts; Count when there is none.
    template <class IsSame>
    std::size_t Find(std::string_view word, const IsSame& isSame) const noexcept {
        if (word.size() < 2) {
            return Count;
        }
        std::size_t next = first_[PlaceOf(word)];
        while (next != 0 && !isSame(next - 1)) {
            next = next_[next - 1];
        }
        return next == 0 ? Count : next - 1;
    }

private:
    static constexpr unsigned PlaceBits = 9;

    static constexpr std::size_t PlaceOf(std::string_view word) noexcept {
        constexpr std::uint32_t Factor = 0x9E3779B1U;
        constexpr auto Fold = [](char c) { return static_cast<unsigned char>(c) & 0x1FU; };
        const std::uint32_t key = Fold(word[0]) | Fold(word[1]) << 5U | Fold(word.back()) << 10U |
                                  static_cast<std::uint32_t>(word.size()) << 15U;
        return (key * Factor) >> (32U - PlaceBits);
    }

    /// One more than an index; 0 for none.
    std::array<std::uint8_t, std::size_t{1} << PlaceBits> first_{};
    std::array<std::uint8_t, Count> next_{};
};

} // namespace Orn_Hdl::Readers
