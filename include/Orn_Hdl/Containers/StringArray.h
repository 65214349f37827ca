/// \file
/// `StringArray`, an ordered list of texts, and the splitting of a text into words.
#pragma once

#include "Port/Export.h"
#include "Port/String.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace Orn_Hdl {

/// An ordered list of texts, indexed from 0. Reading out of range, or a slot that was never set,
/// gives the empty text.
///
/// All texts of a list stand in one buffer, so that splitting a line costs no allocation a word.
class ORN_HDL_API StringArray {
public:
    StringArray() = default;
    /// An empty list on which `Parse` is called.
    StringArray(const char* text, const char* separators, bool skipEmpty, const char* quotes);

    /// The number of texts.
    int GetSize() const noexcept { return static_cast<int>(slots_.size()); }
    /// Whether there are none.
    bool IsEmpty() const noexcept { return slots_.empty(); }
    /// The text at `i`, as a copy.
    Port::StringBase<char> GetAt(int i) const { return GetView(i); }
    /// As `GetAt`.
    Port::StringBase<char> operator[](int i) const { return GetView(i); }
    /// As `GetAt` without a copy; valid until the list changes.
    std::string_view GetView(int i) const noexcept {
        if (i < 0 || i >= GetSize()) {
            return std::string_view();
        }
        const Slot& slot = slots_[static_cast<std::size_t>(i)];
        return std::string_view(text_.data() + slot.start, slot.length);
    }
    /// Reads element `i` as a whole decimal number.
    /// \param value receives the number; untouched when the result is false.
    /// \param unused has no effect.
    bool GetIntAt(int i, int& value, int unused) const;

    /// Whether an element is equal to `text`.
    bool Contains(const Port::StringBase<char>& text) const noexcept;
    /// The same, letter case ignored.
    bool IContains(const Port::StringBase<char>& text) const noexcept;
    /// Whether every element of `other` is contained; never when `other` has more elements.
    bool Contains(const StringArray& other) const noexcept;
    /// The same, letter case ignored.
    bool IContains(const StringArray& other) const noexcept;
    /// All elements, with `separator` between neighbours.
    Port::StringBase<char> Concatenate(const Port::StringBase<char>& separator) const;
    /// The elements from `first` on, with one blank between neighbours.
    std::string JoinFrom(int first) const;

    /// Appends a text. \return its index.
    int Add(const Port::StringBase<char>& text) { return AddView(text.GetView()); }
    int Add(const char* text) { return Add(Port::StringBase<char>(text)); }
    /// Appends all texts of another list.
    void Add(const StringArray& other);
    /// Sets element `i`, growing the list with empty slots up to it; a negative index is ignored.
    void SetAt(int i, const Port::StringBase<char>& text);
    /// Drops all texts.
    void Empty() noexcept;
    /// Sorts stably by bytes, a shorter text before a longer one that begins with it.
    void Sort();
    /// Sorts stably with the caller's less-than predicate, which receives `context`.
    void Sort(bool (*less)(const Port::StringBase<char>& a, const Port::StringBase<char>& b,
                           void* context),
              void* context);

    /// Splits a text and appends the pieces.
    /// \param separators single characters, each of which ends a piece.
    /// \param skipEmpty whether empty pieces are dropped (an empty quoted piece that a separator
    ///        follows is kept all the same).
    /// \param quotes pairs of an opening and a closing character; null for none. A quote opens only
    ///        at the start of the text or right after a separator, and closes only before a
    ///        separator or at the end of the text; a backslash keeps a closing character inside.
    /// \return the number of pieces appended.
    int Parse(const char* text, const char* separators, bool skipEmpty, const char* quotes);
    int Parse(std::string_view text, std::string_view separators, bool skipEmpty,
              std::string_view quotes);
    /// Splits one command line: at blanks, runs of them counting as one, with double and single
    /// quotes.
    int ParseCommandLine(std::string_view line);

private:
    struct Slot {
        std::size_t start;
        std::size_t length;
    };

    int AddView(std::string_view text);
    void MakeRoom(std::size_t length);
    void ClosePiece(std::size_t start);

    std::string text_;
    std::vector<Slot> slots_;
};

} // namespace Orn_Hdl
