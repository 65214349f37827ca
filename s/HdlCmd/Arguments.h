// What a command takes from its line: its argument texts.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <initializer_list>
#include <string_view>
#include <type_traits>
#include <vector>

namespace Orn_Hdl {

/// The texts and up to eight flags of a command.
class Arguments {
public:
    /// Sets the texts, which are read up to their first NUL, and lowers every flag.
    /// \param texts at most `MostTexts`.
    void Set(std::initializer_list<std::string_view> texts);
    /// The text at `index`, closed by a NUL; empty if there is none.
    const char* Get(int index) const noexcept {
        const auto place = static_cast<std::size_t>(index);
        return place < count_ ? &room_[starts_[place]] : "";
    }

    /// Raises a flag, an enumerator of the command's own flags.
    template <class Flag> void Raise(Flag flag) noexcept {
        flags_ = static_cast<std::uint8_t>(flags_ | BitOf(flag));
    }
    /// Whether a flag has been raised since the texts were set.
    template <class Flag> bool Has(Flag flag) const noexcept { return (flags_ & BitOf(flag)) != 0; }

private:
    static constexpr std::size_t MostTexts = 5;

    template <class Flag> static constexpr unsigned BitOf(Flag flag) noexcept {
        static_assert(std::is_enum_v<Flag> && !std::is_convertible_v<Flag, int>,
                      "each kind of command has an enum class of its own");
        return 1U << static_cast<unsigned>(flag);
    }

    /// The texts, each closed by a NUL; behind them what former ones have left.
    std::vector<char> room_;
    std::array<std::size_t, MostTexts> starts_;
    std::uint8_t count_ = 0;
    std::uint8_t flags_ = 0;
};

} // namespace Orn_Hdl
