/// \file
/// `Port::StringBase<char>`, the string type of every interface of the library: a thin front over
/// `std::string` whose letter case rules are those of ASCII.
#pragma once

#include "Port/Export.h"
#include "Port/Range.h"
#include "Port/TextView.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <type_traits>
#include <utility>

namespace Port {

class File;

/// An owned text of bytes. Indices count from 0; a search that finds nothing gives -1.
///
/// It is compared with, extended by and joined to whatever a `TextView` is made from, and extended
/// by and joined to single characters.
template <class Char> class ORN_HDL_API StringBase {
    template <class Text>
    static constexpr bool IsText = std::is_convertible_v<const Text&, BasicTextView<Char>>;
    /// The types that can be joined to a string on either side.
    template <class Text>
    static constexpr bool IsOtherText = IsText<Text> && !std::is_same_v<Text, StringBase>;

public:
    /// A view of such a text.
    using View = std::basic_string_view<Char>;
    /// A parameter that takes any kind of text; null is read as "".
    using TextView = BasicTextView<Char>;

    /// Whether letter case matters in a comparison.
    enum CompareType { CompareExact, CompareIgnoringCase };
    /// The ends to trim.
    enum TrimType { TrimLeft, TrimRight, TrimBoth };
    /// Whether empty tokens are kept or skipped.
    enum ParseType { KeepEmptyTokens = 0, SkipEmptyTokens = 1 };

    /// The empty text.
    StringBase() = default;
    /// A copy of a text that ends in NUL; a null pointer gives the empty text.
    StringBase(const Char* text) : text_(TextView(text).GetView()) {}
    /// A copy of a text.
    StringBase(View text) : text_(text) {}
    /// Takes over the buffer of a text.
    StringBase(std::basic_string<Char> text) : text_(std::move(text)) {}

    /// Appends a text, which may be this one or a piece of it; null appends nothing.
    StringBase& operator+=(TextView text) {
        text_ += text.GetView();
        return *this;
    }
    /// Appends a character.
    StringBase& operator+=(Char c) {
        text_ += c;
        return *this;
    }
    /// A number is not a text: `+= 65` would append "A".
    template <class Number, std::enable_if_t<std::is_arithmetic_v<Number>, int> = 0>
    StringBase& operator+=(Number) = delete;

    /// The text without a copy, valid until the string changes or is destroyed.
    View GetView() const noexcept { return text_; }
    /// The text without a copy, valid until the string changes or is destroyed.
    operator View() const noexcept { return text_; }
    /// The text with a closing NUL, valid until the string changes or is destroyed.
    const Char* CStr() const noexcept { return text_.c_str(); }
    /// The number of characters.
    std::size_t GetLength() const noexcept { return text_.size(); }
    /// Whether there are none.
    bool IsEmpty() const noexcept { return text_.empty(); }
    /// The character at `index`; NUL when there is none.
    Char operator[](std::size_t index) const noexcept {
        return index < text_.size() ? text_[index] : Char();
    }
    /// Makes the text empty.
    void Empty() noexcept { text_.clear(); }

    /// Compares with another text, bytes taken as unsigned; null is read as "".
    /// \return a number below, at or above zero as this text sorts before, with or after `other`.
    int Compare(TextView other, CompareType type = CompareExact) const noexcept;
    /// The index of the first `c`; -1 when there is none.
    int GetIndexOfFirstChar(Char c) const noexcept;
    /// The index of the last `c`; -1 when there is none.
    int GetIndexOfLastChar(Char c) const noexcept;
    /// The index of the first occurrence of a text, -1 when there is none. The empty text, as which
    /// null is read, occurs at index 0.
    int GetIndexOfString(TextView text) const noexcept;

    /// The piece of the text in `range`, as far as the text reaches.
    StringBase Extract(const Port_Range& range) const;
    /// Removes the piece in `range`, as far as the text reaches.
    void Remove(const Port_Range& range);

    /// Turns ASCII letters into upper case.
    void MakeUpper() noexcept;
    /// Turns ASCII letters into lower case.
    void MakeLower() noexcept;
    /// Removes every `c` at the chosen ends.
    void Trim(Char c, TrimType type = TrimBoth);
    /// Replaces each character that occurs in `from` by `to`; null is read as "".
    void ReplaceChars(TextView from, Char to) noexcept;

    /// Steps to the next token.
    /// \param range the present token, `Port_Range()` or `Port_Range(1, 0)` before the first one;
    ///        receives the next one, and is unchanged if there is none.
    /// \param separators the single characters that separate tokens; null for none.
    /// \return false when there is no further token.
    bool NextTokenRange(Port_Range& range, TextView separators, ParseType type) const;
    /// Steps to the next token like the overload with a `ParseType`.
    /// \param type 0 keeps empty tokens, 1 skips them; any other number finds no token.
    bool NextTokenRange(Port_Range& range, TextView separators, int type) const;
    /// Rejects enumerators of other enumerations.
    template <class Other, std::enable_if_t<std::is_enum_v<Other>, int> = 0>
    bool NextTokenRange(Port_Range& range, TextView separators, Other type) const = delete;

    /// Finds the leftmost, longest match of `pattern`.
    /// \param range receives the range of the match; unchanged if there is none.
    /// \return whether there is a match.
    bool GetRangeOfMatch(const Port_Regexp& pattern, Port_Range& range) const;

    /// Replaces the text by the file's next line without its line feed and without one carriage
    /// return before it.
    /// \return false at the end of the file or on an error (see `File::GetError`).
    bool ReadLine(File& file);

    /// The text that printf writes in the "C" locale, whatever locale is in use.
    /// \param format the caller's own text, never a user's; null is read as "".
#if defined(__GNUC__)
    __attribute__((format(printf, 1, 2)))
#endif
    static StringBase
    Format(const char* format, ...);

    /// Whether two texts are equal; null is read as "".
    template <class Text, std::enable_if_t<IsText<Text>, int> = 0>
    friend bool operator==(const StringBase& a, const Text& b) noexcept {
        return a.GetView() == TextView(b).GetView();
    }
    /// Whether two texts are equal; null is read as "".
    template <class Text, std::enable_if_t<IsOtherText<Text>, int> = 0>
    friend bool operator==(const Text& a, const StringBase& b) noexcept {
        return TextView(a).GetView() == b.GetView();
    }
    /// Whether two texts differ; null is read as "".
    template <class Text, std::enable_if_t<IsText<Text>, int> = 0>
    friend bool operator!=(const StringBase& a, const Text& b) noexcept {
        return a.GetView() != TextView(b).GetView();
    }
    /// Whether two texts differ; null is read as "".
    template <class Text, std::enable_if_t<IsOtherText<Text>, int> = 0>
    friend bool operator!=(const Text& a, const StringBase& b) noexcept {
        return TextView(a).GetView() != b.GetView();
    }
    /// Whether one text sorts before another by bytes taken as unsigned; null is read as "".
    template <class Text, std::enable_if_t<IsText<Text>, int> = 0>
    friend bool operator<(const StringBase& a, const Text& b) noexcept {
        return a.GetView() < TextView(b).GetView();
    }
    /// Whether one text sorts before another by bytes taken as unsigned; null is read as "".
    template <class Text, std::enable_if_t<IsOtherText<Text>, int> = 0>
    friend bool operator<(const Text& a, const StringBase& b) noexcept {
        return TextView(a).GetView() < b.GetView();
    }

    /// A string followed by a text; null adds nothing.
    template <class Text, std::enable_if_t<IsText<Text>, int> = 0>
    friend StringBase operator+(StringBase a, const Text& b) {
        a += TextView(b);
        return a;
    }
    /// A text followed by a string; null adds nothing.
    template <class Text, std::enable_if_t<IsOtherText<Text>, int> = 0>
    friend StringBase operator+(const Text& a, const StringBase& b) {
        StringBase joined(TextView(a).GetView());
        joined += b;
        return joined;
    }
    /// A string followed by a character.
    template <class One, std::enable_if_t<std::is_same_v<One, Char>, int> = 0>
    friend StringBase operator+(StringBase a, One b) {
        a += b;
        return a;
    }
    /// A character followed by a string.
    template <class One, std::enable_if_t<std::is_same_v<One, Char>, int> = 0>
    friend StringBase operator+(One a, const StringBase& b) {
        StringBase joined;
        joined += a;
        joined += b;
        return joined;
    }

private:
    std::basic_string<Char> text_;
};

extern template class StringBase<char>;

/// The string type of the library's interfaces.
using String = StringBase<char>;

} // namespace Port
