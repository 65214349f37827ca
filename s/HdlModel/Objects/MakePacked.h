// Objects of the library's own classes, close together.
#pragma once

#include "Port/Pool.h"

#include <memory>
#include <new>
#include <utility>

namespace Orn_Hdl {

/// Makes an object of which a design has millions. The general operator new keeps sixteen bytes of
/// alignment, for classes derived from the library's; the library's own do with eight.
template <class T, class... Arguments> std::unique_ptr<T> MakePacked(Arguments&&... arguments) {
    static_assert(alignof(T) <= 8);
    void* const memory = Port::Pool::AllocatePacked(sizeof(T), Port::Pool::DesignObjects);
    try {
        return std::unique_ptr<T>(::new (memory) T(std::forward<Arguments>(arguments)...));
    } catch (...) {
        Port::Pool::Free(memory);
        throw;
    }
}

} // namespace Orn_Hdl
