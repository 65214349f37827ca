// Puts the elements of an array into another order.
#pragma once

#include "Orn_Hdl/Containers/PtrArray.h"

namespace Orn_Hdl {

struct Reordering {
    /// Stores at a place that the array has. Halfway through a new order an element stands at two
    /// places, which `SetAt` of an owner refuses.
    static void Place(PtrArrayBase& array, int index, void* element) noexcept {
        array.items_[index] = element;
    }
};

} // namespace Orn_Hdl
