/// \file
/// `Port::StringBase<char>`, the string type of every interface of the library: a thin front over
/// `std::string` whose letter case rules are those of ASCII.
#pragma once

#include "Port/Export.h"
#include "Port/Range.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <utility>

namespace Port {

class File;

/// An owned text of bytes. Indices count from 0; a search that finds nothing gives -1.
template <class Char> class ORN_HDL_API StringBase {
public:
    /// A piece of such a text that someone else owns.
    using View = std::basic_string_view<Char>;

    /// How letters compare.
    enum CompareType { CompareExact, CompareIgnoringCase };
    /// Which ends are trimmed.
    enum TrimType { TrimLeft, TrimRight, TrimBoth };
    /// What becomes of empty tokens.
    enum ParseType { KeepEmptyTokens = 0, SkipEmptyTokens = 1 };

    StringBase() = default;
    /// A null pointer gives the empty text.
    StringBase(const Char* text) : text_(text == nullptr ? View() : View(text)) {}
    /// A copy of a text.
    StringBase(View text) : text_(text) {}
    /// Takes over a text.
    StringBase(std::basic_string<Char> text) : text_(std::move(text)) {}

    /// \{
    /// Appends a text or a character; a null text appends nothing.
    StringBase& operator+=(View text) {
        text_ += text;
        return *this;
    }
    StringBase& operator+=(const Char* text) { return *this += StringBase(text).GetView(); }
    StringBase& operator+=(const StringBase& text) { return *this += text.GetView(); }
    StringBase& operator+=(Char c) {
        text_ += c;
        return *this;
    }
    /// \}

    /// \{
    /// The text without a copy, valid until the string changes or ends.
    View GetView() const noexcept { return text_; }
    operator View() const noexcept { return text_; }
    /// \}
    /// The text with a closing NUL, valid until the string changes or ends.
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

    /// Below, at or above zero as this text sorts before, with or after `other` (bytes unsigned).
    int Compare(View other, CompareType type = CompareExact) const noexcept;
    /// The index of the first `c`.
    int GetIndexOfFirstChar(Char c) const noexcept;
    /// The index of the last `c`.
    int GetIndexOfLastChar(Char c) const noexcept;
    /// The index of the first occurrence of a text.
    int GetIndexOfString(View text) const noexcept;

    /// The piece that `range` names, cut to what the text has.
    StringBase Extract(const Port_Range& range) const;
    /// Takes the piece that `range` names out of the text.
    void Remove(const Port_Range& range);

    /// \{
    /// Turns the letters of ASCII into upper or lower case.
    void MakeUpper() noexcept;
    void MakeLower() noexcept;
    /// \}
    /// Takes every `c` off the chosen ends.
    void Trim(Char c, TrimType type = TrimBoth);
    /// Replaces each character that occurs in `from` by `to`.
    void ReplaceChars(View from, Char to) noexcept;

    /// Steps to the next token after `range`.
    /// \param range the present token, `Port_Range()` before the first; receives the next one.
    /// \param separators the single characters that separate tokens.
    /// \return false when there is no further token.
    bool NextTokenRange(Port_Range& range, const Char* separators, ParseType type) const;

    /// Finds the leftmost, longest match of `pattern`.
    bool GetRangeOfMatch(const Port_Regexp& pattern, Port_Range& range) const;

    /// Replaces the text by the file's next line without its line feed and without one carriage
    /// return before it.
    /// \return false at the end of the file or when it cannot be read (`File::GetError` tells).
    bool ReadLine(File& file);

    /// The text that printf would write. The format is the caller's, never a user's text.
#if defined(__GNUC__)
    __attribute__((format(printf, 1, 2)))
#endif
    static StringBase
    Format(const char* format, ...);

    friend bool operator==(const StringBase& a, const StringBase& b) noexcept {
        return a.text_ == b.text_;
    }
    friend bool operator==(const StringBase& a, const Char* b) noexcept {
        return a.text_ == (b == nullptr ? View() : View(b));
    }
    friend bool operator!=(const StringBase& a, const StringBase& b) noexcept {
        return !(a == b);
    }
    friend bool operator!=(const StringBase& a, const Char* b) noexcept {
        return !(a == b);
    }
    friend bool operator<(const StringBase& a, const StringBase& b) noexcept {
        return a.text_ < b.text_;
    }
    friend StringBase operator+(StringBase a, const StringBase& b) {
        return a += b;
    }

private:
    std::basic_string<Char> text_;
};

extern template class StringBase<char>;

/// The string type that the library's interfaces speak.
using String = StringBase<char>;

} // namespace Port
