// What a command keeps of its line: its argument texts.
#pragma once

#include "Orn_Hdl/Containers/StringArray.h"

#include <cstddef>
#include <cstdint>
#include <initializer_list>
#include <string_view>
#include <type_traits>

namespace Orn_Hdl {

/// The texts and up to eight flags of a command. Millions of done commands are kept, so the texts
/// stand in memory directly behind this object; only texts that are longer than the room there get
/// a block of their own.
///
/// It must be the last member of an object that is allocated with `RoomFor` bytes more than its
/// size.
class Arguments {
public:
    /// How many bytes to allocate for the texts of a line: what its words take, without those of
    /// the phrase, or what the pointer to a block takes if that is more.
    /// \param phraseLength the length of the phrase in characters.
    static std::size_t RoomFor(const StringArray& tokens, std::size_t phraseLength) noexcept;

    /// \param room how many bytes were allocated for the texts.
    explicit Arguments(std::size_t room) noexcept;
    Arguments(const Arguments&) = delete;
    Arguments& operator=(const Arguments&) = delete;
    ~Arguments() { Release(); }

    /// Sets the texts, each up to its first NUL, and lowers every flag.
    void Set(std::initializer_list<std::string_view> texts);
    /// The text at `index`, closed by a NUL; empty if there is none.
    const char* Get(int index) const noexcept;

    /// Raises a flag, an enumerator of the command's own flags.
    template <class Flag> void Raise(Flag flag) noexcept {
        flags_ = static_cast<std::uint8_t>(flags_ | BitOf(flag));
    }
    /// Whether a flag has been raised since the texts were set.
    template <class Flag> bool Has(Flag flag) const noexcept { return (flags_ & BitOf(flag)) != 0; }

private:
    /// A bit of `count_`: the texts stand in a block, and the room holds a pointer to it.
    static constexpr std::uint8_t OwnBlock = 0x80;

    template <class Flag> static constexpr unsigned BitOf(Flag flag) noexcept {
        static_assert(std::is_enum_v<Flag> && !std::is_convertible_v<Flag, int>,
                      "each kind of command has an enum class of its own");
        return 1U << static_cast<unsigned>(flag);
    }

    char* GetRoom() noexcept { return reinterpret_cast<char*>(this) + sizeof(Arguments); }
    const char* GetRoom() const noexcept {
        return reinterpret_cast<const char*>(this) + sizeof(Arguments);
    }
    const char* GetTexts() const noexcept;
    /// Where to put texts of that size altogether, the NULs behind them included.
    char* MakePlace(std::size_t size);
    void Release() noexcept;

    std::uint16_t room_;
    std::uint8_t count_ = 0;
    std::uint8_t flags_ = 0;
};

static_assert(sizeof(Arguments) == 4, "every kept command holds one");

} // namespace Orn_Hdl
