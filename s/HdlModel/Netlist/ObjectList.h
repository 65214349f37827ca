// The list in which a netlist owns its components, instances or signals.
#pragma once

#include "Containers/HashByEights.h"
#include "Containers/HashSlots.h"
#include "Containers/Reordering.h"
#include "Orn_Hdl/Containers/PtrArray.h"

#include <cstddef>
#include <cstdint>
#include <memory>
#include <new>
#include <utility>

namespace Orn_Hdl {

/// Objects in the order in which they were added, until the list is sorted.
///
/// An object that is taken out leaves a null in its place, which walks pass over, so that no other
/// object moves. The nulls go when the list is sorted, and when they are the larger part of a list
/// that gets another object. The last place always holds an object.
///
/// Objects do not know their places, because that would take memory for each of them. Few objects
/// are ever taken out, and most of those stand at one of the ends, from where they are searched. A
/// table of all places is made as soon as these searches have taken longer than making it takes.
template <class T> class ObjectList {
public:
    Iterator<T*> GetIterator() const noexcept { return Reordering::WalkFrom(objects_, first_); }

    /// Appends an object that the list does not hold.
    void Add(T* object) {
        constexpr int FewHoles = 64;
        if (holes_ > FewHoles && holes_ > objects_.GetSize() / 2) {
            CloseHoles();
        }
        if (places_ != nullptr) {
            places_->MakeRoom();
        }
        const int place = objects_.AddNew(object);
        if (places_ != nullptr) {
            places_->Add(HashOf(object), ToEntry(place));
        }
    }

    /// \return the place of an object; negative if the list does not hold it.
    int Find(const T* object) noexcept {
        constexpr int LeastTabled = 512;
        if (places_ == nullptr && objects_.GetSize() >= LeastTabled &&
            searched_ > CostOfPlaces * objects_.GetSize()) {
            MakePlaces();
        }
        return places_ != nullptr ? FindInPlaces(object) : Search(object);
    }

    /// Takes out the object at a place without destroying it. The classes that are derived from `T`
    /// may be gone.
    void TakeOut(int place) noexcept {
        if (places_ != nullptr) {
            places_->Remove(HashOf(objects_.GetAt(place)), ToEntry(place));
        }
        Reordering::Place(objects_, place, nullptr);
        ++holes_;
        while (!objects_.IsEmpty() && objects_.GetTail() == nullptr) {
            objects_.RemoveTail();
            --holes_;
        }
        while (first_ < objects_.GetSize() && objects_.GetAt(first_) == nullptr) {
            ++first_;
        }
        if (objects_.IsEmpty()) {
            first_ = 0;
        }
    }

    /// Takes out the last object; null when there is none.
    T* TakeOutLast() noexcept {
        T* const last = objects_.GetTail();
        if (last != nullptr) {
            TakeOut(objects_.GetSize() - 1);
        }
        return last;
    }

    /// Sorts by `sort(array)`, which finds no null in the array.
    template <class Sort> void SortBy(Sort sort) {
        CloseHoles();
        searched_ = 0;
        sort(objects_);
    }

    /// How many objects there are, holes included.
    int GetLength() const noexcept { return objects_.GetSize(); }
    /// The objects without nulls between them.
    const PtrArray<T*>& GetArray() noexcept {
        CloseHoles();
        return objects_;
    }

private:
    /// Places are counted from one, since zero marks a free slot.
    using Places = HashSlots<std::uint32_t>;

    /// How many objects can be passed in a search while one is entered into the table.
    static constexpr std::int64_t CostOfPlaces = 64;

    static std::uint32_t ToEntry(int place) noexcept {
        return static_cast<std::uint32_t>(place) + 1;
    }
    static std::uint32_t HashOf(const T* object) noexcept {
        constexpr std::uint64_t Factor = 0x9E3779B97F4A7C15U;
        const std::uint64_t product =
            MultiplyAndFold(reinterpret_cast<std::uintptr_t>(object), Factor);
        return static_cast<std::uint32_t>(product >> 32U);
    }

    /// Searches from both ends at once.
    int Search(const T* object) noexcept {
        const int end = objects_.GetSize() - 1;
        for (int first = first_, last = end; first <= last; ++first, --last) {
            const bool isFirst = objects_.GetAt(first) == object;
            if (isFirst || objects_.GetAt(last) == object) {
                searched_ += std::int64_t(2) * (end - last);
                return isFirst ? first : last;
            }
        }
        searched_ += end - first_;
        return -1;
    }

    int FindInPlaces(const T* object) const noexcept {
        const std::uint32_t entry =
            places_->Find(HashOf(object), [this, object](std::uint32_t, std::uint32_t present) {
                return objects_.GetAt(static_cast<int>(present) - 1) == object;
            });
        return static_cast<int>(entry) - 1;
    }

    /// Does nothing if allocation fails: objects are then searched as before.
    void MakePlaces() noexcept {
        searched_ = 0;
        try {
            auto places = std::make_unique<Places>();
            for (int place = first_; place < objects_.GetSize(); ++place) {
                if (const T* const object = objects_.GetAt(place)) {
                    places->Add(HashOf(object), ToEntry(place));
                }
            }
            places_ = std::move(places);
        } catch (const std::bad_alloc&) {
            places_ = nullptr;
        }
    }

    void CloseHoles() noexcept {
        places_ = nullptr;
        if (holes_ > 0) {
            Reordering::DropNulls(objects_);
            holes_ = 0;
            first_ = 0;
        }
    }

    OwnPtrArray<T*> objects_;
    std::unique_ptr<Places> places_;
    /// How many objects searches have passed since the table was last made.
    std::int64_t searched_ = 0;
    /// The place of the first object.
    int first_ = 0;
    /// How many nulls there are.
    int holes_ = 0;
};

} // namespace Orn_Hdl
