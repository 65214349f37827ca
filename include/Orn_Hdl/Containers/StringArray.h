/// \file
/// `StringArray`, an ordered list of texts, and the splitting of a text into words.
#pragma once

#include "Port/Export.h"
#include "Port/String.h"

#include <cstddef>
#include <iterator>
#include <string>
#include <string_view>
#include <vector>

namespace Orn_Hdl {

class PackedLists;

/// An ordered list of texts, indexed from 0. Reading out of range, or a slot that was never set,
/// gives the empty text.
///
/// All texts of a list share one buffer, so that splitting a line needs no allocation per word.
class ORN_HDL_API StringArray {
public:
    /// An empty list.
    StringArray() = default;
    /// The pieces of a text, split as `Parse` does. Null is read as "", and as no quotes.
    StringArray(Port::TextView text, Port::TextView separators, bool skipEmpty,
                Port::TextView quotes);

    /// The number of texts.
    int GetSize() const noexcept { return static_cast<int>(slots_.size()); }
    /// Whether there are none.
    bool IsEmpty() const noexcept { return slots_.empty(); }
    /// A copy of the text at `i`; empty for an index out of range.
    Port::StringBase<char> GetAt(int i) const { return GetView(i); }
    /// A copy of the text at `i`; empty for an index out of range.
    Port::StringBase<char> operator[](int i) const { return GetView(i); }
    /// The text at `i` without a copy, valid until the list changes or is destroyed; empty for an
    /// index out of range.
    std::string_view GetView(int i) const noexcept {
        if (i < 0 || i >= GetSize()) {
            return std::string_view();
        }
        const Slot& slot = slots_[static_cast<std::size_t>(i)];
        return std::string_view(text_.data() + slot.start, slot.length);
    }
    /// Reads element `i` as a whole decimal number.
    /// \param value receives the number; unchanged if the result is false.
    /// \param unused has no effect.
    /// \return whether the element is such a number and fits.
    bool GetIntAt(int i, int& value, int unused) const;

    /// Whether an element is equal to `text`; null is read as "".
    bool Contains(Port::TextView text) const noexcept;
    /// Whether an element is equal to `text`, letter case ignored; null is read as "".
    bool IContains(Port::TextView text) const noexcept;
    /// Whether every element of `other` is contained; never when `other` has more elements.
    bool Contains(const StringArray& other) const noexcept;
    /// Whether every element of `other` is contained, letter case ignored; never when `other` has
    /// more elements.
    bool IContains(const StringArray& other) const noexcept;
    /// All elements, with `separator` between neighbours; null is read as "".
    Port::StringBase<char> Concatenate(Port::TextView separator) const;
    /// The elements from `first` on, with one blank between neighbours.
    std::string JoinFrom(int first) const;

    /// Appends a copy of a text; null is read as "".
    /// \return its index.
    int Add(Port::TextView text) { return AddView(text); }
    /// Appends copies of all texts of another list, which may be this one.
    void Add(const StringArray& other);
    /// Sets element `i` to a copy of a text, growing the list with empty slots up to it; a negative
    /// index is ignored, and null is read as "".
    void SetAt(int i, Port::TextView text);
    /// Drops all texts.
    void Empty() noexcept;
    /// Sorts stably by bytes, a shorter text before a longer one that begins with it.
    void Sort();
    /// Sorts stably with the caller's less-than predicate, which receives `context`; null changes
    /// nothing. Whatever the predicate returns, no text is lost or duplicated. If it throws or
    /// changes the list, the list is left unsorted.
    void Sort(bool (*less)(const Port::StringBase<char>& a, const Port::StringBase<char>& b,
                           void* context),
              void* context);

    /// Splits a text, which may be one of the list's own, and appends the pieces. Null is read as
    /// "", and as no quotes.
    /// \param separators single characters, each of which ends a piece.
    /// \param skipEmpty whether empty pieces are dropped (an empty quoted piece before a separator
    /// is
    ///        kept nevertheless).
    /// \param quotes pairs of an opening and a closing character. A quote opens only
    ///        at the start of the text or right after a separator, and closes only before a
    ///        separator or at the end of the text; a backslash keeps a closing character inside.
    /// \return the number of pieces appended.
    int Parse(Port::TextView text, Port::TextView separators, bool skipEmpty,
              Port::TextView quotes);
    /// Splits one command line, which may be one of the list's own texts, at runs of blanks, and
    /// appends its words; double and single quotes group. Null is read as "".
    /// \return the number of words appended.
    int ParseCommandLine(Port::TextView line);

    /// A position in a list for range-based for loops, the algorithms of the standard library and
    /// its ranges: a forward iterator that yields views, each valid until the list changes or is
    /// destroyed.
    class Cursor {
    public:
#if defined(__cpp_concepts)
        /// Every walk yields the same texts.
        using iterator_concept = std::forward_iterator_tag;
#endif
        /// Texts are returned by value, so for C++17 this is an input iterator.
        using iterator_category = std::input_iterator_tag;
        /// What is yielded.
        using value_type = std::string_view;
        /// The distance of two positions.
        using difference_type = std::ptrdiff_t;
        /// There is no pointer to a position.
        using pointer = void;
        /// The result of `*`.
        using reference = std::string_view;

        /// A position in no list.
        Cursor() noexcept = default;
        /// The text at this position, valid until the list changes or is destroyed; empty at the
        /// end.
        std::string_view operator*() const noexcept {
            return list_ == nullptr ? std::string_view() : list_->GetView(index_);
        }
        /// Steps to the next text.
        Cursor& operator++() noexcept {
            ++index_;
            return *this;
        }
        /// Steps to the next text. \return the position before the step.
        Cursor operator++(int) noexcept {
            const Cursor before = *this;
            ++*this;
            return before;
        }
        /// Whether both are the same position in one list.
        friend bool operator==(const Cursor& a, const Cursor& b) noexcept {
            return a.list_ == b.list_ && a.index_ == b.index_;
        }
        /// Whether they are different positions.
        friend bool operator!=(const Cursor& a, const Cursor& b) noexcept {
            return !(a == b);
        }

    private:
        friend class StringArray;
        Cursor(const StringArray* list, int index) noexcept : list_(list), index_(index) {}

        const StringArray* list_ = nullptr;
        int index_ = 0;
    };
    /// The position of the first text.
    Cursor begin() const noexcept {
        return Cursor(this, 0);
    }
    /// The position behind the last text that the list has now.
    Cursor end() const noexcept {
        return Cursor(this, GetSize());
    }

private:
    friend class PackedLists;

    struct Slot {
        std::size_t start;
        std::size_t length;
    };

    bool IsOwn(std::string_view text) const noexcept;
    int AddView(std::string_view text);
    int Split(std::string_view text, std::string_view separators, bool skipEmpty,
              std::string_view quotes);
    void MakeRoom(std::size_t length);
    void ClosePiece(std::size_t start);

    std::string text_;
    std::vector<Slot> slots_;
};

} // namespace Orn_Hdl
