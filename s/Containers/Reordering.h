// What the library does to arrays beyond their interface: reordering, room before the front, and
// nulls that walks pass over.
#pragma once

#include "Orn_Hdl/Containers/PtrArray.h"

namespace Orn_Hdl {

struct Reordering {
    /// Stores a pointer at a valid index. During the reordering an element is stored twice, which
    /// `SetAt` of an owning array rejects.
    static void Place(PtrArrayBase& array, int index, void* element) noexcept {
        array.items_[index] = element;
    }

    /// Makes sure that an element can be put to the front of a large array without moving others.
    /// \return false when the array is too small to be worth it.
    static bool MakeRoomBefore(PtrArrayBase& array);

    /// Removes all nulls, keeping the order of the other elements.
    static void DropNulls(PtrArrayBase& array) noexcept;

    /// A walk that starts at an index and passes over nulls. The last element must not become null
    /// while the array is walked.
    template <class T> static Iterator<T> WalkFrom(const PtrArray<T>& array, int first) noexcept {
        return Iterator<T>(&array, first);
    }

    /// The same walk, its present element being the first at or behind an index.
    template <class T> static Iterator<T> Continue(Iterator<T> walk, int index) noexcept {
        walk.index_ = index > walk.index_ ? index : walk.index_;
        return walk;
    }

    /// The index of the present element of a walk that is not at its end.
    template <class T> static int IndexOf(const Iterator<T>& walk) noexcept {
        return walk.passesNulls_ ? Iterator<T>::PassNulls(walk.GetArray(), walk.index_)
                                 : walk.index_;
    }
};

} // namespace Orn_Hdl
