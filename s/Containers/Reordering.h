// Reorders the elements of an array.
#pragma once

#include "Orn_Hdl/Containers/PtrArray.h"

namespace Orn_Hdl {

struct Reordering {
    /// Stores a pointer at a valid index. During the reordering an element is stored twice, which
    /// `SetAt` of an owning array rejects.
    static void Place(PtrArrayBase& array, int index, void* element) noexcept {
        array.items_[index] = element;
    }
};

} // namespace Orn_Hdl
