/// \file
/// `StringSet`, a set of names whose order of iteration is part of its behaviour.
#pragma once

#include "Port/Export.h"
#include "Port/String.h"

#include <cstddef>
#include <iterator>
#include <memory>
#include <string_view>

namespace Orn_Hdl {

class NameTable;
class StringSet;

/// A position in a `StringSet`, valid until the set changes or is destroyed. An input iterator that
/// yields copies of the names.
class ORN_HDL_API StringSetIterator {
public:
    /// An input iterator, because the postfix `++` returns nothing.
    using iterator_category = std::input_iterator_tag;
    /// What is yielded.
    using value_type = Port::StringBase<char>;
    /// The distance of two positions.
    using difference_type = std::ptrdiff_t;
    /// There is no pointer to a position.
    using pointer = void;
    /// The result of `*`.
    using reference = const Port::StringBase<char>;

    /// The end position.
    StringSetIterator() noexcept = default;
    /// A position returned by a set.
    explicit StringSetIterator(const void* position) noexcept : position_(position) {}

    /// A copy of the name at the position; the empty text at the end.
    const Port::StringBase<char> operator*() const;
    /// The name at the position without a copy, valid as long as the position is; the empty text at
    /// the end.
    std::string_view GetView() const noexcept;

    /// Steps to the next name; at the end nothing happens.
    StringSetIterator& operator++() noexcept;
    /// Steps to the next name and returns nothing; at the end nothing happens.
    void operator++(int) noexcept { ++*this; }

    /// Whether both are the same position.
    friend bool operator==(const StringSetIterator& a, const StringSetIterator& b) noexcept {
        return a.position_ == b.position_;
    }
    /// Whether they are different positions.
    friend bool operator!=(const StringSetIterator& a, const StringSetIterator& b) noexcept {
        return !(a == b);
    }

private:
    const void* position_ = nullptr;
};

/// A set of names that answers membership with and without regard to letter case.
///
/// It keeps two tables: one ignores case and holds the first spelling of each name, the other keeps
/// every spelling. Iteration walks the case-keeping table, and its order depends only on the
/// sequence of calls and on the spellings: the dummy signals of a netlist are made in this order.
/// A table allocates nothing before its first name.
class ORN_HDL_API StringSet {
public:
    /// The empty set.
    StringSet();
    /// Holds the same names and walks them in the same order.
    StringSet(const StringSet& other);
    /// Holds the same names and walks them in the same order; the former names are dropped.
    StringSet& operator=(const StringSet& other);
    /// Invalidates every position in the set.
    ~StringSet();

    /// Adds a copy of a name to each table that does not have it yet; null is read as "".
    void Add(const char* name);
    /// Adds a copy of a name to each table that does not have it yet.
    void Add(std::string_view name);
    /// Whether this very spelling is in the set; null is read as "".
    bool Contains(const char* name) const noexcept;
    /// Whether this very spelling is in the set.
    bool Contains(std::string_view name) const noexcept;
    /// Whether the name is in the set in any letter case; null is read as "".
    bool IContains(const char* name) const noexcept;
    /// Whether the name is in the set in any letter case.
    bool IContains(std::string_view name) const noexcept;
    /// Removes this spelling from the case-keeping table and any spelling from the other one; null
    /// is read as "". A name that is not there is ignored.
    void Remove(const char* name) noexcept;
    /// Removes this spelling from the case-keeping table and any spelling from the other one. A
    /// name that is not there is ignored.
    void Remove(std::string_view name) noexcept;
    /// Whether the case-keeping table is empty.
    bool IsEmpty() const noexcept;
    /// Empties the case-keeping table only: `IContains` still finds the old names.
    void Empty() noexcept;

    /// The position of the first name.
    StringSetIterator GetBeginPos() const noexcept;
    /// The position behind the last name.
    StringSetIterator GetEndPos() const noexcept { return StringSetIterator(); }

    /// A position for range-based for loops, the algorithms of the standard library and its ranges:
    /// a forward iterator that yields views, each valid until the set changes or is destroyed.
    class Cursor {
    public:
#if defined(__cpp_concepts)
        /// Every walk yields the same names.
        using iterator_concept = std::forward_iterator_tag;
#endif
        /// Names are returned by value, so for C++17 this is an input iterator.
        using iterator_category = std::input_iterator_tag;
        /// What is yielded.
        using value_type = std::string_view;
        /// The distance of two positions.
        using difference_type = std::ptrdiff_t;
        /// There is no pointer to a position.
        using pointer = void;
        /// The result of `*`.
        using reference = std::string_view;

        /// The end of every set.
        Cursor() noexcept = default;
        /// The position of an iterator.
        explicit Cursor(StringSetIterator position) noexcept : position_(position) {}
        /// The name at the position, valid until the set changes or is destroyed; empty at the end.
        std::string_view operator*() const noexcept {
            return position_.GetView();
        }
        /// Steps to the next name; at the end nothing happens.
        Cursor& operator++() noexcept {
            ++position_;
            return *this;
        }
        /// Steps to the next name; at the end nothing happens.
        /// \return the position before the step.
        Cursor operator++(int) noexcept {
            const Cursor before = *this;
            ++*this;
            return before;
        }
        /// Whether both are the same position.
        friend bool operator==(const Cursor& a, const Cursor& b) noexcept {
            return a.position_ == b.position_;
        }
        /// Whether they are different positions.
        friend bool operator!=(const Cursor& a, const Cursor& b) noexcept {
            return !(a == b);
        }

    private:
        StringSetIterator position_;
    };
    /// The position of the first name.
    Cursor begin() const noexcept {
        return Cursor(GetBeginPos());
    }
    /// The position behind the last name.
    Cursor end() const noexcept {
        return Cursor();
    }

private:
    std::unique_ptr<NameTable> ignoringCase_;
    std::unique_ptr<NameTable> keepingCase_;
};

} // namespace Orn_Hdl
