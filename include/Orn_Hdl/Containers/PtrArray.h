/// \file
/// Ordered arrays of pointers, and the iterator over them.
#pragma once

#include "Port/Export.h"

#include <cstddef>
#include <cstdint>
#include <type_traits>

namespace Orn_Hdl {

/// An ordered sequence of untyped pointers. It never deletes what they point at; nulls may be
/// stored. Made small, since every signal and every instance holds one: an empty array owns no
/// memory, and growth from empty begins with three places, what most nets need.
class ORN_HDL_API PtrArrayBase {
public:
    /// Whether `a` comes before `b`; `context` is the caller's.
    using Less = bool (*)(void* a, void* b, void* context);

    PtrArrayBase() noexcept : capacity_(0), ownsItems_(0) {}
    PtrArrayBase(const PtrArrayBase& other);
    PtrArrayBase& operator=(const PtrArrayBase& other);
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
    /// Makes room for `capacity` elements in all.
    void Reserve(int capacity);
    /// Appends. \return the index of the new element.
    int Add(void* p) {
        if (size_ >= capacity_) {
            Grow();
        }
        items_[size_] = p;
        return static_cast<int>(size_++);
    }
    /// Stores at `i`, growing the array with nulls up to it; a negative index is ignored.
    void SetAt(int i, void* p);
    /// Puts an element before the one at `i`; an index out of range is ignored, but for that behind
    /// the last element.
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
            --size_;
        }
    }
    /// Exchanges two elements; an index out of range changes nothing.
    void Swap(int i, int j) noexcept;
    /// Sorts stably with the caller's less-than predicate, which receives `context`.
    void Sort(Less less, void* context);

protected:
    /// Lets an empty array use memory that somebody else owns and that outlives the array, until it
    /// grows beyond it. The first `size` elements are there already.
    void Borrow(void** items, int size, int capacity) noexcept {
        items_ = items;
        size_ = static_cast<std::uint32_t>(size);
        capacity_ = static_cast<std::uint32_t>(capacity) & MostElements;
        ownsItems_ = 0;
    }

private:
    static constexpr std::uint32_t MostElements = INT32_MAX;

    void Grow();
    void Reallocate(std::size_t capacity);

    void** items_ = nullptr;
    std::uint32_t size_ = 0;
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
    /// Appends. \return the index of the new element.
    int Add(T p) { return PtrArrayBase::Add(p); }
    /// Stores at `i`, growing the array with nulls up to it; a negative index is ignored.
    void SetAt(int i, T p) { PtrArrayBase::SetAt(i, p); }
    /// Puts an element before the one at `i`; an index out of range is ignored, but for that behind
    /// the last element.
    void InsertAt(int i, T p) { PtrArrayBase::InsertAt(i, p); }
    /// Removes the first element equal to `p`, keeping the others' order.
    /// \return false when there is none.
    bool Remove(T p) noexcept { return PtrArrayBase::Remove(p); }
    /// Removes the element at `i`, keeping the others' order; an index out of range is ignored.
    void RemoveAt(int i) noexcept { PtrArrayBase::RemoveAt(i); }
    /// Sorts stably with the caller's less-than predicate, which receives `context`.
    void Sort(bool (*less)(T a, T b, void* context), void* context) {
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
    SmallPtrArray() noexcept { this->Borrow(first_, 0, Room); }
    SmallPtrArray(const SmallPtrArray&) = delete;
    SmallPtrArray& operator=(const SmallPtrArray&) = delete;

private:
    void* first_[Room];
};

/// A `PtrArray` that owns its elements: its destructor deletes them, the last one first. Only the
/// destructor and `DeleteAll` delete; `Empty`, `Remove`, `RemoveAt`, `RemoveTail` and `SetAt` let
/// go of what they drop.
template <class T> class OwnPtrArray : public PtrArray<T> {
public:
    OwnPtrArray() noexcept = default;
    OwnPtrArray(const OwnPtrArray&) = delete;
    OwnPtrArray& operator=(const OwnPtrArray&) = delete;
    ~OwnPtrArray() override { DeleteAll(); }

    /// Appends; a pointer that the array holds already is ignored.
    /// \return the index of the element. Looks at every element: a caller who knows that the
    ///         object is new uses `AddNew`.
    int Add(T p) {
        const int present = p == nullptr ? -1 : this->GetIndex(p);
        return present >= 0 ? present : AddNew(p);
    }
    /// Appends an object that the array does not hold.
    int AddNew(T p) { return PtrArray<T>::Add(p); }
    /// As `PtrArray::SetAt`; a pointer that the array holds at another place is ignored.
    void SetAt(int i, T p) {
        if (p == nullptr || this->GetIndex(p) < 0) {
            PtrArray<T>::SetAt(i, p);
        }
    }
    /// As `PtrArray::InsertAt`; a pointer that the array holds already is ignored.
    void InsertAt(int i, T p) {
        if (p == nullptr || this->GetIndex(p) < 0) {
            PtrArray<T>::InsertAt(i, p);
        }
    }
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
/// step, so elements appended on the way are met too. The array must outlive it.
///
/// \code
/// for (Signal* signal : netlist.GetSignalIterator()) { ... }
/// \endcode
template <class T> class Iterator {
public:
    /// Over no array: yields nothing.
    Iterator() noexcept = default;
    /// Starts at the first element; the array is not owned.
    explicit Iterator(const PtrArray<T>* array) noexcept : array_(array) {}
    Iterator(const Iterator&) noexcept = default;
    Iterator& operator=(const Iterator&) noexcept = default;
    virtual ~Iterator() = default;

    /// Whether there is no present element.
    bool IsAtEnd() const noexcept { return array_ == nullptr || index_ >= array_->GetSize(); }
    /// The present element; null at the end.
    T GetCurrent() const noexcept { return array_ == nullptr ? nullptr : array_->GetAt(index_); }
    /// Steps to the next element; at the end nothing happens.
    void Next() noexcept {
        if (!IsAtEnd()) {
            ++index_;
        }
    }

    /// For range-based for loops, from the present element on.
    class Cursor {
    public:
        /// Starts at the iterator's present element.
        explicit Cursor(const Iterator& from) noexcept : array_(from.array_), index_(from.index_) {}
        /// The present element.
        T operator*() const noexcept { return array_->GetAt(index_); }
        /// Steps on.
        Cursor& operator++() noexcept {
            ++index_;
            return *this;
        }
        /// Whether there is a present element.
        friend bool operator!=(const Cursor& a, std::nullptr_t) noexcept {
            return a.array_ != nullptr && a.index_ < a.array_->GetSize();
        }

    private:
        const PtrArray<T>* array_;
        int index_;
    };
    /// \{
    /// For range-based for loops.
    Cursor begin() const noexcept { return Cursor(*this); }
    std::nullptr_t end() const noexcept { return nullptr; }
    /// \}

private:
    const PtrArray<T>* array_ = nullptr;
    int index_ = 0;
};

} // namespace Orn_Hdl
