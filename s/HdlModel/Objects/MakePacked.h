// Allocation of the library's own objects close together.
#pragma once

#include "Port/Pool.h"

#include <memory>
#include <new>
#include <utility>

namespace Orn_Hdl {

/// Creates an object of a class of which a design has millions. The general `operator new` aligns
/// to sixteen bytes, which derived classes may need; the library's own classes need eight.
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
