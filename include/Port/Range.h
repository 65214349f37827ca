/// \file
/// `Port_Range`, a piece of a text, and `Port_Regexp`, a small pattern to look for in one.
#pragma once

#include "Port/Export.h"

#include <bitset>
#include <cstddef>
#include <string_view>
#include <vector>

/// A piece of a text: its first character's index (from 0) and its length. A range that was given
/// neither stands before the text.
class Port_Range {
public:
    constexpr Port_Range() noexcept = default;
    /// A piece of that place and length.
    constexpr Port_Range(std::size_t start, std::size_t length) noexcept
        : start_(start), length_(length) {}

    /// The index of the first character.
    constexpr std::size_t GetStart() const noexcept { return start_; }
    /// The number of characters.
    constexpr std::size_t GetLength() const noexcept { return length_; }
    /// The index behind the last character.
    constexpr std::size_t GetEnd() const noexcept { return start_ + length_; }

    friend constexpr bool operator==(const Port_Range& a, const Port_Range& b) noexcept {
        return a.start_ == b.start_ && a.length_ == b.length_;
    }
    friend constexpr bool operator!=(const Port_Range& a, const Port_Range& b) noexcept {
        return !(a == b);
    }

private:
    std::size_t start_ = static_cast<std::size_t>(-1);
    std::size_t length_ = 0;
};

/// A pattern made of single characters, "." and character classes such as "[A-Za-z_]", each
/// followed by "*", "+", "?" or nothing. Matching is linear in the text and uses no recursion, so
/// texts of any length can be searched.
class ORN_HDL_API Port_Regexp {
public:
    /// \param pattern the pattern; null is the empty pattern, which matches the empty text. A class
    ///        without its "]" reaches to the end of the pattern.
    explicit Port_Regexp(const char* pattern);

    /// Looks for the leftmost match in `text` and, there, for the longest.
    /// \param range receives the place of the match; untouched when there is none.
    /// \return whether there is a match.
    bool Search(std::string_view text, Port_Range& range) const;

private:
    struct Step {
        std::bitset<256> accepted;
        bool optional = false;
        bool repeated = false;
    };

    bool MatchAt(std::string_view text, std::size_t start, std::size_t& length) const;

    std::vector<Step> steps_;
};
