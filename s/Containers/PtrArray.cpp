#include "Orn_Hdl/Containers/PtrArray.h"

#include "Containers/Reordering.h"
#include "Containers/StableSort.h"

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <new>
#include <vector>

namespace Orn_Hdl {

namespace {

/// A large array may begin behind the start of its memory, so that elements can be removed from and
/// put to its front without moving all the others. It has one place more than it needs, before the
/// first element, which holds the start of the memory.
constexpr std::size_t LeastLarge = 512;

bool IsLarge(std::size_t capacity) noexcept {
    return capacity >= LeastLarge;
}

void** StartOf(void** items) noexcept {
    return static_cast<void**>(items[-1]);
}

/// How many places are free before the elements of a large array.
std::size_t RoomBefore(void** items) noexcept {
    return static_cast<std::size_t>(items - StartOf(items)) - 1;
}

/// Memory that holds the first elements of what was there, which is given back.
void** MoveTo(void** items, std::size_t size, bool wasLarge, std::size_t capacity) {
    if (!IsLarge(capacity)) {
        // What is small was never large.
        return static_cast<void**>(std::realloc(items, capacity * sizeof(void*)));
    }
    void** start = wasLarge ? StartOf(items) : nullptr;
    if (wasLarge && RoomBefore(items) == 0) {
        start = static_cast<void**>(std::realloc(start, (capacity + 1) * sizeof(void*)));
    } else {
        void** const former = wasLarge ? start : items;
        start = static_cast<void**>(std::malloc((capacity + 1) * sizeof(void*)));
        if (start != nullptr) {
            if (size > 0) {
                std::memcpy(start + 1, items, size * sizeof(void*));
            }
            std::free(former);
        }
    }
    if (start == nullptr) {
        return nullptr;
    }
    *start = start;
    return start + 1;
}

} // namespace

PtrArrayBase::PtrArrayBase(const PtrArrayBase& other) : PtrArrayBase() {
    *this = other;
}

PtrArrayBase& PtrArrayBase::operator=(const PtrArrayBase& other) {
    if (this == &other) {
        return *this;
    }
    if (isOwner_ != 0) {
        TakeOver(other);
        return *this;
    }
    Reserve(other.GetSize());
    if (other.size_ > 0) {
        std::memcpy(items_, other.items_, other.size_ * sizeof(void*));
    }
    size_ = other.size_;
    return *this;
}

/// The other array may contain a pointer twice. It must not be an owning array.
void PtrArrayBase::TakeOver(const PtrArrayBase& other) {
    if (other.isOwner_ != 0) {
        return;
    }
    Reserve(other.GetSize());
    size_ = 0;
    for (int i = 0; i < other.GetSize(); ++i) {
        AddToOwner(other.GetAt(i));
    }
}

int PtrArrayBase::AddToOwner(void* p) {
    const int present = p == nullptr ? -1 : GetIndex(p);
    return present >= 0 ? present : Append(p);
}

PtrArrayBase::~PtrArrayBase() {
    PtrArrayBase::Empty();
}

void PtrArrayBase::Reallocate(std::size_t capacity) {
    // Indices are of type int, which limits the size.
    const bool isBorrowed = ownsItems_ == 0;
    void** const own = isBorrowed ? nullptr : items_;
    void** const items =
        capacity > MostElements
            ? nullptr
            : MoveTo(own, isBorrowed ? 0 : size_, !isBorrowed && IsLarge(capacity_), capacity);
    if (items == nullptr) {
        throw std::bad_alloc();
    }
    if (isBorrowed && size_ > 0) {
        std::memcpy(items, items_, size_ * sizeof(void*));
    }
    items_ = items;
    capacity_ = static_cast<std::uint32_t>(capacity) & MostElements;
    ownsItems_ = 1;
}

void PtrArrayBase::Grow() {
    // 3, 5, 9, 17, ...: together with the allocator's own word, these sizes leave no memory unused.
    Reallocate(size_ < 3 ? 3 : std::size_t(size_) * 2 - 1);
}

void PtrArrayBase::Reserve(int capacity) {
    const auto wanted = static_cast<std::uint32_t>(capacity < 0 ? 0 : capacity);
    if (wanted > capacity_ && wanted > size_) {
        Reallocate(wanted);
    }
}

void PtrArrayBase::Empty() noexcept {
    if (ownsItems_ != 0) {
        std::free(IsLarge(capacity_) ? StartOf(items_) : items_);
    }
    items_ = nullptr;
    size_ = 0;
    capacity_ = 0;
    ownsItems_ = 0;
}

void PtrArrayBase::Swap(int i, int j) noexcept {
    if (i >= 0 && j >= 0 && i < GetSize() && j < GetSize()) {
        std::swap(items_[i], items_[j]);
    }
}

int PtrArrayBase::GetIndex(const void* p) const noexcept {
    for (std::uint32_t i = 0; i < size_; ++i) {
        if (items_[i] == p) {
            return static_cast<int>(i);
        }
    }
    return -1;
}

void PtrArrayBase::SetAt(int i, void* p) {
    if (i < 0 || !Takes(p)) {
        return;
    }
    const auto index = static_cast<std::uint32_t>(i);
    if (index >= size_) {
        if (index == MostElements) {
            // The new size would not fit in an int.
            throw std::bad_alloc();
        }
        Reserve(i + 1);
        std::fill(items_ + size_, items_ + index, nullptr);
        size_ = (index + 1) & MostElements;
    }
    items_[index] = p;
}

void PtrArrayBase::InsertAt(int i, void* p) {
    if (i < 0 || i > GetSize() || !Takes(p)) {
        return;
    }
    const auto index = static_cast<std::uint32_t>(i);
    if (index < size_ / 2 && Reordering::MakeRoomBefore(*this)) {
        void** const start = StartOf(items_);
        --items_;
        std::memmove(items_, items_ + 1, index * sizeof(void*));
        items_[-1] = start;
        size_ = (size_ + 1) & MostElements;
        capacity_ = (capacity_ + 1) & MostElements;
    } else {
        Append(p);
        std::memmove(items_ + index + 1, items_ + index, (size_ - index - 1) * sizeof(void*));
    }
    items_[index] = p;
}

bool Reordering::MakeRoomBefore(PtrArrayBase& array) {
    if (array.ownsItems_ == 0 || !IsLarge(array.capacity_)) {
        return false;
    }
    if (RoomBefore(array.items_) > 0) {
        return true;
    }
    // Half of what is free behind the elements goes before them.
    if (array.capacity_ - array.size_ < array.size_ / 2) {
        array.Reallocate(std::size_t(array.size_) * 2);
    }
    const std::uint32_t room = (array.capacity_ - array.size_) / 2;
    if (room == 0 || !IsLarge(array.capacity_ - room)) {
        return false;
    }
    void** const start = StartOf(array.items_);
    std::memmove(array.items_ + room, array.items_, array.size_ * sizeof(void*));
    array.items_ += room;
    array.items_[-1] = start;
    array.capacity_ = (array.capacity_ - room) & PtrArrayBase::MostElements;
    return true;
}

void Reordering::DropNulls(PtrArrayBase& array) noexcept {
    void** const end = std::remove(array.items_, array.items_ + array.size_, nullptr);
    array.size_ = static_cast<std::uint32_t>(end - array.items_) & PtrArrayBase::MostElements;
}

bool PtrArrayBase::Remove(const void* p) noexcept {
    const int index = GetIndex(p);
    RemoveAt(index);
    return index >= 0;
}

void PtrArrayBase::RemoveAt(int i) noexcept {
    if (i >= 0 && i < GetSize()) {
        const auto index = static_cast<std::uint32_t>(i);
        if (index < size_ / 2 && ownsItems_ != 0 && IsLarge(capacity_ - 1)) {
            void** const start = StartOf(items_);
            std::memmove(items_ + 1, items_, index * sizeof(void*));
            ++items_;
            items_[-1] = start;
            capacity_ = (capacity_ - 1) & MostElements;
        } else {
            std::memmove(items_ + index, items_ + index + 1, (size_ - index - 1) * sizeof(void*));
        }
        RemoveTail();
    }
}

void PtrArrayBase::Sort(Less less, void* context) {
    if (less == nullptr) {
        return;
    }
    // The caller's predicate may modify the array, so the array is not changed before the order is
    // final.
    const std::vector<void*> before(items_, items_ + size_);
    std::vector<void*> sorted = before;
    StableSort(sorted, [less, context](void* a, void* b) { return less(a, b, context); });
    if (std::equal(before.begin(), before.end(), items_, items_ + size_)) {
        std::copy(sorted.begin(), sorted.end(), items_);
    }
}

} // namespace Orn_Hdl
