// Where a list that is not in order has something.
#pragma once

#include "Orn_Hdl/Containers/PtrArray.h"

namespace Orn_Hdl {

/// The place of the element, of the last or the first that are equal; below zero when there is
/// none. What is removed was mostly added last, or is removed in the order in which it was added:
/// both ends are searched at once.
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
