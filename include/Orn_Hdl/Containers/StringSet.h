/// \file
/// `StringSet`, a set of names whose order of iteration is part of its behaviour.
#pragma once

#include "Port/Export.h"
#include "Port/String.h"

#include <memory>
#include <string_view>

namespace Orn_Hdl {

class NameTable;
class StringSet;

/// A position in a `StringSet`, valid until the set changes or ends.
class ORN_HDL_API StringSetIterator {
public:
    /// The end position.
    StringSetIterator() noexcept = default;
    /// A position that a set gives.
    explicit StringSetIterator(const void* position) noexcept : position_(position) {}

    /// The name at the position; the empty text at the end.
    const Port::StringBase<char> operator*() const;
    /// As `operator*`, without a copy: valid as long as the position is.
    std::string_view GetView() const noexcept;

    /// Steps to the next name; at the end nothing happens.
    StringSetIterator& operator++() noexcept;
    void operator++(int) noexcept { ++*this; }

    friend bool operator==(const StringSetIterator& a, const StringSetIterator& b) noexcept {
        return a.position_ == b.position_;
    }
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
/// A table takes memory with its first name.
class ORN_HDL_API StringSet {
public:
    StringSet();
    /// Copies keep the order of iteration.
    StringSet(const StringSet& other);
    StringSet& operator=(const StringSet& other);
    ~StringSet();

    /// Adds a name to each table that does not have it yet.
    void Add(const char* name);
    void Add(std::string_view name);
    /// Whether this very spelling is in the set.
    bool Contains(const char* name) const noexcept;
    bool Contains(std::string_view name) const noexcept;
    /// Whether the name is in the set in any letter case.
    bool IContains(const char* name) const noexcept;
    bool IContains(std::string_view name) const noexcept;
    /// Removes this spelling from the case-keeping table, any spelling from the other.
    void Remove(const char* name) noexcept;
    /// Whether the case-keeping table is empty.
    bool IsEmpty() const noexcept;
    /// Empties the case-keeping table only: `IContains` still knows the old names.
    void Empty() noexcept;

    /// The position of the first name.
    StringSetIterator GetBeginPos() const noexcept;
    /// The position behind the last name.
    StringSetIterator GetEndPos() const noexcept { return StringSetIterator(); }

private:
    std::unique_ptr<NameTable> ignoringCase_;
    std::unique_ptr<NameTable> keepingCase_;
};

} // namespace Orn_Hdl
