// What the library does to arrays beyond their interface: reordering, and room before the front.
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
};

} // namespace Orn_Hdl
