// Prefetching during a walk over the objects of a netlist.
#pragma once

#include "Orn_Hdl/Containers/PtrArray.h"
#include "Port/Prefetch.h"

#include <cstddef>

namespace Orn_Hdl {

/// Calls `visit(object)` for each object of a walk and has those some steps ahead prefetched: once
/// a netlist is sorted, objects that follow one another are spread over its memory.
template <class T, class Visit> void WalkAhead(const Iterator<T*>& objects, const Visit& visit) {
    constexpr int Lead = 12;
    auto coming = objects.begin();
    for (int i = 0; i < Lead; ++i) {
        ++coming;
    }
    for (T* object : objects) {
        if (const T* const next = *coming) {
            for (std::size_t offset = 0; offset < sizeof(T); offset += Port::CacheLine) {
                Port::Prefetch(reinterpret_cast<const char*>(next) + offset);
            }
            ++coming;
        }
        visit(*object);
    }
}

} // namespace Orn_Hdl
