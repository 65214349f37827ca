// Gives access to the places of an array's elements, which its interface does not.
#pragma once

#include "Orn_Hdl/Containers/PtrArray.h"

namespace Orn_Hdl {

struct Reordering {
    /// Stores a pointer at a valid index. During the reordering an element is stored twice, which
    /// `SetAt` of an owning array rejects.
    static void Place(PtrArrayBase& array, int index, void* element) noexcept {
        array.items_[index] = element;
    }

    /// Where the elements stand.
    static void** GetPlaces(const PtrArrayBase& array) noexcept { return array.items_; }
    /// Whether the elements stand in memory that somebody else owns.
    static bool IsInBorrowedPlaces(const PtrArrayBase& array) noexcept {
        return array.ownsItems_ == 0;
    }
};

} // namespace Orn_Hdl
