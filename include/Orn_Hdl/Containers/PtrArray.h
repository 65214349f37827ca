/// \file
/// Ordered arrays of pointers, and the iterator over them.
#pragma once

#include "Port/Export.h"

#include <cstddef>
#include <cstdint>
#include <iterator>
#include <type_traits>

namespace Orn_Hdl {

struct Reordering;

/// An ordered sequence of untyped pointers. It never deletes what they point at; nulls may be
/// stored. Made small, since every signal and every instance holds one: an empty array owns no
/// memory, and growth from empty begins with three places, what most nets need.
class ORN_HDL_API PtrArrayBase {
public:
    /// Whether `a` comes before `b`; `context` is the caller's.
    using Less = bool (*)(void* a, void* b, void* context);

    /// An empty array.
    PtrArrayBase() noexcept : size_(0), isOwner_(0), capacity_(0), ownsItems_(0) {}
    /// Holds the same pointers in the same order; of an owner's elements the copy owns none.
    PtrArrayBase(const PtrArrayBase& other);
    /// Holds the same pointers in the same order. An owner takes what it is assigned and lets go of
    /// what it had, but for another owner's elements: then nothing changes.
    PtrArrayBase& operator=(const PtrArrayBase& other);
    /// Leaves what the elements point at alone.
    virtual ~PtrArrayBase();

    /// The number of elements, nulls included.
    int GetSize() const noexcept { return static_cast<int>(size_); }
    /// Whether there are none.
    bool IsEmpty() const noexcept { return size_ == 0; }
    /// The element at `i`; null for an index out of range.
    void* GetAt(int i) const noexcept {
        return i < 0 || static_cast<std::uint32_t>(i) >= size_ ? nullptr : items_[i];
    }
    /// The last element; null when there is none.
    void* GetTail() const noexcept { return size_ == 0 ? nullptr : items_[size_ - 1]; }
    /// The index of the first element equal to `p`, or -1.
    int GetIndex(const void* p) const noexcept;
    /// Whether an element is equal to `p`.
    bool Contains(const void* p) const noexcept { return GetIndex(p) >= 0; }
    /// Makes room for `capacity` elements in all, so that none of them takes memory when it is
    /// added.
    void Reserve(int capacity);
    /// Appends; a pointer that an owner holds already is ignored.
    /// \return the index of the element.
    int Add(void* p) { return isOwner_ != 0 ? AddToOwner(p) : Append(p); }
    /// Stores at `i`, growing the array with nulls up to it. A negative index is ignored, and so is
    /// a pointer that an owner holds already.
    void SetAt(int i, void* p);
    /// Puts an element before the one at `i`. An index out of range is ignored, but for that behind
    /// the last element, and so is a pointer that an owner holds already.
    void InsertAt(int i, void* p);
    /// Removes the first element equal to `p`, keeping the others' order.
    /// \return false when there is none.
    bool Remove(const void* p) noexcept;
    /// Removes the element at `i`, keeping the others' order; an index out of range is ignored.
    void RemoveAt(int i) noexcept;
    /// Drops all elements without deleting them.
    void Empty() noexcept;
    /// Drops the last element without deleting it; an empty array stays as it is.
    void RemoveTail() noexcept {
        if (size_ > 0) {
            size_ = (size_ - 1) & MostElements;
        }
    }
    /// Exchanges two elements; an index out of range changes nothing.
    void Swap(int i, int j) noexcept;
    /// Sorts stably with the caller's less-than predicate, which receives `context`; null changes
    /// nothing. Whatever the predicate answers, each element is there once afterwards. When it
    /// throws, or has changed the array, the array is left as it is by then, unsorted.
    void Sort(Less less, void* context);

protected:
    /// Marks an array whose elements are deleted by a derived class: no pointer is held twice.
    void BecomeOwner() noexcept { isOwner_ = 1; }
    /// Appends a pointer that an owner is known not to hold. \return its index.
    int Append(void* p) {
        if (size_ >= capacity_) {
            Grow();
        }
        const std::uint32_t index = size_;
        items_[index] = p;
        size_ = (index + 1) & MostElements;
        return static_cast<int>(index);
    }
    /// Lets an empty array use memory that somebody else owns and that outlives the array, until it
    /// grows beyond it. The first `size` elements are there already.
    void Borrow(void** items, int size, int capacity) noexcept {
        items_ = items;
        size_ = static_cast<std::uint32_t>(size) & MostElements;
        capacity_ = static_cast<std::uint32_t>(capacity) & MostElements;
        ownsItems_ = 0;
    }

private:
    friend struct Reordering;

    static constexpr std::uint32_t MostElements = INT32_MAX;

    void TakeOver(const PtrArrayBase& other);
    int AddToOwner(void* p);
    /// Whether `p` may be stored: an owner refuses what it holds.
    bool Takes(const void* p) const noexcept {
        return isOwner_ == 0 || p == nullptr || GetIndex(p) < 0;
    }
    void Grow();
    void Reallocate(std::size_t capacity);

    void** items_ = nullptr;
    std::uint32_t size_ : 31;
    std::uint32_t isOwner_ : 1;
    std::uint32_t capacity_ : 31;
    std::uint32_t ownsItems_ : 1;
};

/// The typed front: `T` is a pointer to an object.
template <class T> class PtrArray : public PtrArrayBase {
public:
    static_assert(std::is_pointer<T>::value, "the array holds pointers");

    /// The element at `i`; null for an index out of range.
    T GetAt(int i) const noexcept { return static_cast<T>(PtrArrayBase::GetAt(i)); }
    /// The last element; null when there is none.
    T GetTail() const noexcept { return static_cast<T>(PtrArrayBase::GetTail()); }
    /// The index of the first element equal to `p`, or -1.
    int GetIndex(T p) const noexcept { return PtrArrayBase::GetIndex(p); }
    /// Whether an element is equal to `p`.
    bool Contains(T p) const noexcept { return GetIndex(p) >= 0; }
    /// Appends; a pointer that an owner holds already is ignored.
    /// \return the index of the element.
    int Add(T p) { return PtrArrayBase::Add(p); }
    /// Stores at `i`, growing the array with nulls up to it. A negative index is ignored, and so is
    /// a pointer that an owner holds already.
    void SetAt(int i, T p) { PtrArrayBase::SetAt(i, p); }
    /// Puts an element before the one at `i`. An index out of range is ignored, but for that behind
    /// the last element, and so is a pointer that an owner holds already.
    void InsertAt(int i, T p) { PtrArrayBase::InsertAt(i, p); }
    /// Removes the first element equal to `p`, keeping the others' order.
    /// \return false when there is none.
    bool Remove(T p) noexcept { return PtrArrayBase::Remove(p); }
    /// Removes the element at `i`, keeping the others' order; an index out of range is ignored.
    void RemoveAt(int i) noexcept { PtrArrayBase::RemoveAt(i); }
    /// Sorts stably with the caller's less-than predicate, which receives `context`; null changes
    /// nothing. Whatever the predicate answers, each element is there once afterwards. When it
    /// throws, or has changed the array, the array is left as it is by then, unsorted.
    void Sort(bool (*less)(T a, T b, void* context), void* context) {
        if (less == nullptr) {
            return;
        }
        struct Caller {
            bool (*less)(T, T, void*);
            void* context;
        } caller{less, context};
        PtrArrayBase::Sort(
            [](void* a, void* b, void* c) {
                const Caller* typed = static_cast<const Caller*>(c);
                return typed->less(static_cast<T>(a), static_cast<T>(b), typed->context);
            },
            &caller);
    }
};

/// A `PtrArray` with room for its first elements in itself.
template <class T, int Room> class SmallPtrArray : public PtrArray<T> {
public:
    /// An empty array that takes no memory until it grows beyond its room.
    SmallPtrArray() noexcept { this->Borrow(first_, 0, Room); }
    SmallPtrArray(const SmallPtrArray&) = delete;
    SmallPtrArray& operator=(const SmallPtrArray&) = delete;

private:
    void* first_[Room];
};

/// A `PtrArray` that owns its elements: its destructor deletes them, the last one first. Only the
/// destructor and `DeleteAll` delete; `Empty`, `Remove`, `RemoveAt`, `RemoveTail` and `SetAt` let
/// go of what they drop. It holds no pointer twice but null, by whatever reference it is called.
template <class T> class OwnPtrArray : public PtrArray<T> {
public:
    /// An empty array.
    OwnPtrArray() noexcept { this->BecomeOwner(); }
    OwnPtrArray(const OwnPtrArray&) = delete;
    OwnPtrArray& operator=(const OwnPtrArray&) = delete;
    /// Deletes every element, the last one first.
    ~OwnPtrArray() override { DeleteAll(); }

    /// Appends and takes ownership; a pointer that the array holds already is ignored. Looks at
    /// every element: a caller who knows that the object is new uses `AddNew`.
    /// \return the index of the element.
    int Add(T p) { return PtrArray<T>::Add(p); }
    /// Appends an object that the array does not hold, and takes ownership.
    /// \return its index.
    int AddNew(T p) { return this->Append(p); }
    /// Deletes every element, the last one first.
    void DeleteAll() {
        while (!this->IsEmpty()) {
            T last = this->GetTail();
            this->RemoveTail();
            delete last;
        }
    }
};

/// Walks a `PtrArray<T>` by index, stored nulls included. It reads the array's present size at each
/// step, so elements appended on the way are met too. The array must outlive it; of an object that
/// makes its array on first use, the object must.
///
/// \code
/// for (Signal* signal : netlist.GetSignalIterator()) { ... }
/// \endcode
template <class T> class Iterator {
public:
    /// Gives the array of an object; null as long as it has none.
    using Find = const PtrArray<T>* (*)(const void* owner);

    /// Over no array: yields nothing.
    Iterator() noexcept = default;
    /// Starts at the first element; the array is not owned, and null is no array.
    explicit Iterator(const PtrArray<T>* array) noexcept : source_(array) {}
    /// Starts at the first element of an array that its owner makes on first use, or makes anew:
    /// `find(owner)` is asked for it at each step.
    Iterator(const void* owner, Find find) noexcept : source_(owner), find_(find) {}
    /// Stands at the same element of the same array.
    Iterator(const Iterator&) noexcept = default;
    /// Moves to the same element of the same array.
    Iterator& operator=(const Iterator&) noexcept = default;
    /// Leaves the array alone.
    virtual ~Iterator() = default;

    /// Whether there is no present element.
    bool IsAtEnd() const noexcept {
        const PtrArray<T>* const array = GetArray();
        return array == nullptr || index_ >= array->GetSize();
    }
    /// The present element; null at the end.
    T GetCurrent() const noexcept {
        const PtrArray<T>* const array = GetArray();
        return array == nullptr ? nullptr : array->GetAt(index_);
    }
    /// Steps to the next element; at the end nothing happens.
    void Next() noexcept {
        if (!IsAtEnd()) {
            ++index_;
        }
    }

    /// A place in the array for range-based for loops, the algorithms of the standard library and
    /// its ranges: a forward iterator that yields the pointers. It depends on what the `Iterator`
    /// walks, not on the `Iterator`.
    class Cursor {
    public:
#if defined(__cpp_concepts)
        /// A second walk meets the same elements.
        using iterator_concept = std::forward_iterator_tag;
#endif
        /// Elements are given by value, which C++17 knows of input iterators only.
        using iterator_category = std::input_iterator_tag;
        /// What is yielded.
        using value_type = T;
        /// The distance of two places.
        using difference_type = std::ptrdiff_t;
        /// There is no pointer to a place.
        using pointer = void;
        /// What `*` gives.
        using reference = T;

        /// The end of every array.
        Cursor() noexcept = default;
        /// Starts at the iterator's present element.
        explicit Cursor(const Iterator& from) noexcept
            : source_(from.source_), find_(from.find_), index_(from.index_) {}
        /// The present element; null at the end.
        T operator*() const noexcept {
            const PtrArray<T>* const array = GetArray();
            return array == nullptr ? nullptr : array->GetAt(index_);
        }
        /// Steps on.
        Cursor& operator++() noexcept {
            ++index_;
            return *this;
        }
        /// Steps on. \return the place before the step.
        Cursor operator++(int) noexcept {
            const Cursor before = *this;
            ++*this;
            return before;
        }
        /// Whether both are the same place, or both are at the end as it is now.
        friend bool operator==(const Cursor& a, const Cursor& b) noexcept {
            const bool isAtEnd = a.IsAtEnd();
            return isAtEnd || b.IsAtEnd() ? isAtEnd == b.IsAtEnd()
                                          : a.source_ == b.source_ && a.index_ == b.index_;
        }
        /// Whether they are different places, and not both at the end as it is now.
        friend bool operator!=(const Cursor& a, const Cursor& b) noexcept {
            return !(a == b);
        }

    private:
        const PtrArray<T>* GetArray() const noexcept {
            return Iterator::GetArray(source_, find_);
        }
        bool IsAtEnd() const noexcept {
            const PtrArray<T>* const array = GetArray();
            return array == nullptr || index_ >= array->GetSize();
        }

        const void* source_ = nullptr;
        Find find_ = nullptr;
        int index_ = 0;
    };
    /// The present element's place.
    Cursor begin() const noexcept {
        return Cursor(*this);
    }
    /// The place behind the last element, wherever that is when it is compared.
    Cursor end() const noexcept {
        return Cursor();
    }

private:
    static const PtrArray<T>* GetArray(const void* source, Find find) noexcept {
        return find == nullptr ? static_cast<const PtrArray<T>*>(source) : find(source);
    }
    const PtrArray<T>* GetArray() const noexcept {
        return GetArray(source_, find_);
    }

    /// The array, or the object that `find_` gives the array of.
    const void* source_ = nullptr;
    Find find_ = nullptr;
    int index_ = 0;
};

} // namespace Orn_Hdl
