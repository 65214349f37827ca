// The way past an array's interface to the places of its elements.
#pragma once

#include "Orn_Hdl/Containers/PtrArray.h"

namespace Orn_Hdl {

struct Reordering {
    /// Stores at a place that the array has. Halfway through a new order an element stands at two
    /// places, which `SetAt` of an owner refuses.
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
