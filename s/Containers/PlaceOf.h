// A search of an unsorted list.
#pragma once

#include "Orn_Hdl/Containers/PtrArray.h"

namespace Orn_Hdl {

/// The index of an equal element, either the first or the last one; negative if there is none. Most
/// elements are removed either soon after they were added or in the order in which they were added,
/// so both ends are searched at once.
template <class T> int PlaceOf(const PtrArray<T*>& list, const T* element) noexcept {
    int first = 0;
    int last = list.GetSize() - 1;
    for (; first <= last; ++first, --last) {
        if (list.GetAt(last) == element) {
            return last;
        }
        if (list.GetAt(first) == element) {
            return first;
        }
    }
    return -1;
}

} // namespace Orn_Hdl
