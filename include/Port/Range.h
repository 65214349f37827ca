/// \file
/// `Port_Range`, a piece of a text, and `Port_Regexp`, a small pattern to search a text for.
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

/// A piece of a text: the index of its first character (from 0) and its length. For a search of
/// tokens, a default range and the range of length 0 at index 1 mean the start of the text, unless
/// that search has set them.
class Port_Range {
public:
    /// An empty range, from which a search of tokens starts.
    constexpr Port_Range() noexcept = default;
    /// A piece of that index and length, which may exceed the text.
    constexpr Port_Range(std::size_t start, std::size_t length) noexcept
        : start_(start), length_(length) {}

    /// The index of the first character.
    constexpr std::size_t GetStart() const noexcept { return start_; }
    /// The number of characters.
    constexpr std::size_t GetLength() const noexcept { return length_; }
    /// The index behind the last character, saturated at the largest index.
    constexpr std::size_t GetEnd() const noexcept {
        constexpr auto Largest = static_cast<std::size_t>(-1);
        return length_ > Largest - start_ ? Largest : start_ + length_;
    }

    /// Whether two ranges have the same index and length.
    friend constexpr bool operator==(const Port_Range& a, const Port_Range& b) noexcept {
        return a.start_ == b.start_ && a.length_ == b.length_;
    }
    /// Whether two ranges differ in index or length.
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
    /// Distinguishes an empty token at index 1 from the start of a search.
    bool isToken_ = false;
};

/// A pattern made of single characters, "." and character classes such as "[A-Za-z_]", each
/// followed by "*", "+", "?" or nothing. Matching is linear in the text and uses no recursion, so
/// texts of any length can be searched.
class ORN_HDL_API Port_Regexp {
public:
    /// Reads a pattern, which need not outlive the constructor.
    /// \param pattern the pattern; null is the empty pattern, which matches the empty text. A class
    ///        without a "]" extends to the end of the pattern.
    explicit Port_Regexp(Port::TextView pattern);

    /// Searches for the longest of the leftmost matches in `text`; null is read as "".
    /// \param range receives the range of the match; unchanged if there is none.
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
