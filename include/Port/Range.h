/// \file
/// `Port_Range`, a piece of a text, and `Port_Regexp`, a small pattern to look for in one.
#pragma once

#include "Port/Export.h"
#include "Port/TextView.h"

#include <bitset>
#include <cstddef>
#include <string_view>
#include <vector>

namespace Port {
template <class Char> class StringBase;
} // namespace Port

/// A piece of a text: its first character's index (from 0) and its length. A range that was given
/// neither, and the range of length 0 at index 1, stand before the text for a search of tokens,
/// unless that search has set them.
class Port_Range {
public:
    /// The range before every text, from which a search of tokens starts. It holds nothing.
    constexpr Port_Range() noexcept = default;
    /// A piece of that place and length. A text need not reach that far.
    constexpr Port_Range(std::size_t start, std::size_t length) noexcept
        : start_(start), length_(length) {}

    /// The index of the first character.
    constexpr std::size_t GetStart() const noexcept { return start_; }
    /// The number of characters.
    constexpr std::size_t GetLength() const noexcept { return length_; }
    /// The index behind the last character; the largest index where the sum is beyond it.
    constexpr std::size_t GetEnd() const noexcept {
        constexpr auto Largest = static_cast<std::size_t>(-1);
        return length_ > Largest - start_ ? Largest : start_ + length_;
    }

    /// Whether two ranges have the same place and length.
    friend constexpr bool operator==(const Port_Range& a, const Port_Range& b) noexcept {
        return a.start_ == b.start_ && a.length_ == b.length_;
    }
    /// Whether two ranges differ in place or length.
    friend constexpr bool operator!=(const Port_Range& a, const Port_Range& b) noexcept {
        return !(a == b);
    }

private:
    template <class Char> friend class Port::StringBase;

    constexpr bool IsBeforeText() const noexcept {
        return !isToken_ && length_ == 0 && (start_ == 1 || start_ == static_cast<std::size_t>(-1));
    }
    static constexpr Port_Range MakeToken(std::size_t start, std::size_t length) noexcept {
        Port_Range token(start, length);
        token.isToken_ = true;
        return token;
    }

    std::size_t start_ = static_cast<std::size_t>(-1);
    std::size_t length_ = 0;
    /// An empty token may stand at index 1, where a search would otherwise start anew.
    bool isToken_ = false;
};

/// A pattern made of single characters, "." and character classes such as "[A-Za-z_]", each
/// followed by "*", "+", "?" or nothing. Matching is linear in the text and uses no recursion, so
/// texts of any length can be searched.
class ORN_HDL_API Port_Regexp {
public:
    /// Reads a pattern, which need not outlive the constructor.
    /// \param pattern the pattern; null is the empty pattern, which matches the empty text. A class
    ///        without its "]" reaches to the end of the pattern.
    explicit Port_Regexp(Port::TextView pattern);

    /// Looks for the leftmost match in `text` and, there, for the longest; null is read as "".
    /// \param range receives the place of the match; untouched when there is none.
    /// \return whether there is a match.
    bool Search(Port::TextView text, Port_Range& range) const;

private:
    struct Step {
        std::bitset<256> accepted;
        bool optional = false;
        bool repeated = false;
    };

    bool MatchAt(std::string_view text, std::size_t start, std::size_t& length) const;

    std::vector<Step> steps_;
};
