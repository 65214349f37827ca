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
/// stored. The array is small because every signal and every instance has one: an empty array owns
/// no memory, and growth starts with room for three elements, enough for most nets.
class ORN_HDL_API PtrArrayBase {
public:
    /// Whether `a` comes before `b`; `context` is the caller's.
    using Less = bool (*)(void* a, void* b, void* context);

    /// An empty array.
    PtrArrayBase() noexcept : size_(0), isOwner_(0), capacity_(0), ownsItems_(0) {}
    /// Holds the same pointers in the same order. A copy of an owning array owns nothing.
    PtrArrayBase(const PtrArrayBase& other);
    /// Holds the same pointers in the same order. An owning array takes ownership of the new
    /// elements and releases the former ones. Assigning an owning array to another one changes
    /// nothing.
    PtrArrayBase& operator=(const PtrArrayBase& other);
    /// Does not delete what the elements point at.
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
    /// Makes room for `capacity` elements in all, so that adding them allocates nothing.
    void Reserve(int capacity);
    /// Appends; a pointer that an owning array already holds is ignored.
    /// \return the index of the element.
    int Add(void* p) { return isOwner_ != 0 ? AddToOwner(p) : Append(p); }
    /// Stores at `i`, growing the array with nulls up to it. A negative index is ignored, and so is
    /// a pointer that an owning array already holds.
    void SetAt(int i, void* p);
    /// Inserts an element before the one at `i`, or behind the last one if `i` is the size. Any
    /// other index out of range is ignored, and so is a pointer that an owning array already holds.
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
    /// nothing. Whatever the predicate returns, no element is lost or duplicated. If it throws or
    /// changes the array, the array is left unsorted.
    void Sort(Less less, void* context);

protected:
    /// Marks the array as owning: a derived class deletes its elements, and no pointer is held
    /// twice.
    void BecomeOwner() noexcept { isOwner_ = 1; }
    /// Appends a pointer that the array is known not to hold. \return its index.
    int Append(void* p) {
        if (size_ >= capacity_) {
            Grow();
        }
        const std::uint32_t index = size_;
        items_[index] = p;
        size_ = (index + 1) & MostElements;
        return static_cast<int>(index);
    }
    /// Lets an empty array use memory that it does not own until it grows beyond it. The memory
    /// must outlive the array, and its first `size` elements must be set.
    void Borrow(void** items, int size, int capacity) noexcept {
        items_ = items;
        size_ = static_cast<std::uint32_t>(size) & MostElements;
        capacity_ = static_cast<std::uint32_t>(capacity) & MostElements;
        ownsItems_ = 0;
    }

    /// Where the elements stand; for an array that has not grown since, what it borrowed.
    void** GetItems() const noexcept { return items_; }
    /// Whether somebody else owns the memory that the array uses, if it uses any.
    bool IsBorrowed() const noexcept { return ownsItems_ == 0; }
    /// How many elements have room there.
    int GetCapacity() const noexcept { return static_cast<int>(capacity_); }

private:
    friend struct Reordering;

    static constexpr std::uint32_t MostElements = INT32_MAX;

    void TakeOver(const PtrArrayBase& other);
    int AddToOwner(void* p);
    /// Whether `p` may be stored: an owning array rejects a pointer that it already holds.
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
    /// Appends; a pointer that an owning array already holds is ignored.
    /// \return the index of the element.
    int Add(T p) { return PtrArrayBase::Add(p); }
    /// Stores at `i`, growing the array with nulls up to it. A negative index is ignored, and so is
    /// a pointer that an owning array already holds.
    void SetAt(int i, T p) { PtrArrayBase::SetAt(i, p); }
    /// Inserts an element before the one at `i`, or behind the last one if `i` is the size. Any
    /// other index out of range is ignored, and so is a pointer that an owning array already holds.
    void InsertAt(int i, T p) { PtrArrayBase::InsertAt(i, p); }
    /// Removes the first element equal to `p`, keeping the others' order.
    /// \return false when there is none.
    bool Remove(T p) noexcept { return PtrArrayBase::Remove(p); }
    /// Removes the element at `i`, keeping the others' order; an index out of range is ignored.
    void RemoveAt(int i) noexcept { PtrArrayBase::RemoveAt(i); }
    /// Sorts stably with the caller's less-than predicate, which receives `context`; null changes
    /// nothing. Whatever the predicate returns, no element is lost or duplicated. If it throws or
    /// changes the array, the array is left unsorted.
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

/// A `PtrArray` with built-in room for its first elements.
template <class T, int Room> class SmallPtrArray : public PtrArray<T> {
public:
    /// An empty array that allocates nothing until it grows beyond its room.
    SmallPtrArray() noexcept { this->Borrow(first_, 0, Room); }
    SmallPtrArray(const SmallPtrArray&) = delete;
    SmallPtrArray& operator=(const SmallPtrArray&) = delete;

private:
    void* first_[Room];
};

/// A `PtrArray` that owns its elements: its destructor deletes them, the last one first. Only the
/// destructor and `DeleteAll` delete; `Empty`, `Remove`, `RemoveAt`, `RemoveTail` and `SetAt`
/// release elements without deleting them. No pointer but null is held twice, even if the array is
/// used through a reference to a base class.
template <class T> class OwnPtrArray : public PtrArray<T> {
public:
    /// An empty array.
    OwnPtrArray() noexcept { this->BecomeOwner(); }
    OwnPtrArray(const OwnPtrArray&) = delete;
    OwnPtrArray& operator=(const OwnPtrArray&) = delete;
    /// Deletes every element, the last one first.
    ~OwnPtrArray() override { DeleteAll(); }

    /// Appends and takes ownership; a pointer that the array already holds is ignored. The search
    /// for it is linear: use `AddNew` for an object that the array cannot hold yet. \return the
    /// index of the element.
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

/// Walks a `PtrArray<T>` by index, nulls included. It reads the array's size at each step, so
/// elements that are appended during the walk are visited, too. The array must outlive the
/// iterator; if an owner creates the array on first use, the owner must.
///
/// \code
/// for (Signal* signal : netlist.GetSignalIterator()) { ... }
/// \endcode
template <class T> class Iterator {
public:
    /// Returns the array of an owner; null as long as it has none.
    using Find = const PtrArray<T>* (*)(const void* owner);

    /// Over no array: yields nothing.
    Iterator() noexcept = default;
    /// Starts at the first element; the array is not owned, and null is no array.
    explicit Iterator(const PtrArray<T>* array) noexcept : source_(array) {}
    /// Starts at the first element of an array that its owner creates on first use or replaces:
    /// `find(owner)` returns the array at each step.
    Iterator(const void* owner, Find find) noexcept : source_(owner), find_(find) {}
    /// Starts at the same element of the same array.
    Iterator(const Iterator&) noexcept = default;
    /// Moves to the same element of the same array.
    Iterator& operator=(const Iterator&) noexcept = default;
    /// Does not touch the array.
    virtual ~Iterator() = default;

    /// Whether there is no present element.
    bool IsAtEnd() const noexcept {
        const PtrArray<T>* const array = GetArray();
        return array == nullptr || index_ >= array->GetSize();
    }
    /// The present element; null at the end.
    T GetCurrent() const noexcept { return ElementAt(GetArray(), index_, passesNulls_); }
    /// Steps to the next element; at the end nothing happens.
    void Next() noexcept {
        if (!IsAtEnd()) {
            index_ = (passesNulls_ ? PassNulls(GetArray(), index_) : index_) + 1;
        }
    }

    /// A position in the array for range-based for loops, the algorithms of the standard library
    /// and its ranges: a forward iterator that yields the pointers. It depends on what the
    /// `Iterator` walks, not on the `Iterator`.
    class Cursor {
    public:
#if defined(__cpp_concepts)
        /// Every walk yields the same elements.
        using iterator_concept = std::forward_iterator_tag;
#endif
        /// Elements are returned by value, so for C++17 this is an input iterator.
        using iterator_category = std::input_iterator_tag;
        /// What is yielded.
        using value_type = T;
        /// The distance of two positions.
        using difference_type = std::ptrdiff_t;
        /// There is no pointer to a position.
        using pointer = void;
        /// The result of `*`.
        using reference = T;

        /// The end of every array.
        Cursor() noexcept = default;
        /// Starts at the iterator's present element.
        explicit Cursor(const Iterator& from) noexcept
            : source_(from.source_), find_(from.find_), index_(from.index_),
              passesNulls_(from.passesNulls_) {}
        /// The present element; null at the end.
        T operator*() const noexcept {
            return ElementAt(GetArray(), index_, passesNulls_);
        }
        /// Steps to the next element.
        Cursor& operator++() noexcept {
            index_ = GetPlace() + 1;
            return *this;
        }
        /// Steps to the next element. \return the position before the step.
        Cursor operator++(int) noexcept {
            const Cursor before = *this;
            ++*this;
            return before;
        }
        /// Whether both are the same position, or both are at the present end.
        friend bool operator==(const Cursor& a, const Cursor& b) noexcept {
            const bool isAtEnd = a.IsAtEnd();
            return isAtEnd || b.IsAtEnd() ? isAtEnd == b.IsAtEnd()
                                          : a.source_ == b.source_ && a.GetPlace() == b.GetPlace();
        }
        /// Whether they are different positions, and not both at the present end.
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
        int GetPlace() const noexcept {
            return passesNulls_ ? PassNulls(GetArray(), index_) : index_;
        }

        const void* source_ = nullptr;
        Find find_ = nullptr;
        int index_ = 0;
        bool passesNulls_ = false;
    };
    /// The position of the present element.
    Cursor begin() const noexcept {
        return Cursor(*this);
    }
    /// The position behind the last element; comparisons use the size at that time.
    Cursor end() const noexcept {
        return Cursor();
    }

private:
    friend struct Reordering;

    /// Passes over nulls, the last element not being one.
    Iterator(const PtrArray<T>* array, int first) noexcept
        : source_(array), index_(first), passesNulls_(true) {}

    static const PtrArray<T>* GetArray(const void* source, Find find) noexcept {
        return find == nullptr ? static_cast<const PtrArray<T>*>(source) : find(source);
    }
    const PtrArray<T>* GetArray() const noexcept {
        return GetArray(source_, find_);
    }
    /// The index of the first element from `index` on that is not null.
    static int PassNulls(const PtrArray<T>* array, int index) noexcept {
        while (index < array->GetSize() && array->GetAt(index) == nullptr) {
            ++index;
        }
        return index;
    }
    static T ElementAt(const PtrArray<T>* array, int index, bool passesNulls) noexcept {
        const T found = array == nullptr ? nullptr : array->GetAt(index);
        return found != nullptr || !passesNulls ? found : array->GetAt(PassNulls(array, index));
    }

    /// The array, or the owner that `find_` takes.
    const void* source_ = nullptr;
    Find find_ = nullptr;
    int index_ = 0;
    bool passesNulls_ = false;
};

} // namespace Orn_Hdl
