/// \file
/// `Port::Pooled`, the base of classes of which a design has millions of objects.
#pragma once

#include "Port/Export.h"

#include <cstddef>
#include <new>

namespace Port {

namespace Pool {

/// What lives and is destroyed together has pages of its own.
enum Kind { DesignObjects, Commands };

/// Memory for one object of any type of that size that the usual operator new would serve: a type
/// that is aligned to sixteen bytes has a size to match. Each thread fills pages of its own.
/// \throws std::bad_alloc when there is none.
ORN_HDL_API void* Allocate(std::size_t size, Kind kind);
/// Gives an object's memory back; null is ignored. Any thread may do so.
ORN_HDL_API void Free(void* memory) noexcept;

} // namespace Pool

/// Objects of the classes derived from this one come from pages of their own: none of the millions
/// costs any bookkeeping. Classes of larger alignment, for which operator new is given an
/// alignment, come from the heap.
template <Pool::Kind kind> class Pooled {
public:
    /// Memory from the pages. \throws std::bad_alloc when there is none.
    static void* operator new(std::size_t size) { return Pool::Allocate(size, kind); }
    /// Memory from the pages; null when there is none.
    static void* operator new(std::size_t size, const std::nothrow_t& /*tag*/) noexcept {
        try {
            return Pool::Allocate(size, kind);
        } catch (const std::bad_alloc&) {
            return nullptr;
        }
    }
    /// Memory from the heap. \throws std::bad_alloc when there is none.
    static void* operator new(std::size_t size, std::align_val_t alignment) {
        return ::operator new(size, alignment);
    }
    /// Memory from the heap; null when there is none.
    static void* operator new(std::size_t size, std::align_val_t alignment,
                              const std::nothrow_t& tag) noexcept {
        return ::operator new(size, alignment, tag);
    }
    /// The given place: nothing is allocated.
    static void* operator new(std::size_t /*size*/, void* place) noexcept { return place; }

    /// Gives memory back to the pages.
    static void operator delete(void* memory) noexcept { Pool::Free(memory); }
    /// Gives memory back to the pages after a constructor has thrown.
    static void operator delete(void* memory, const std::nothrow_t& /*tag*/) noexcept {
        Pool::Free(memory);
    }
    /// Gives memory back to the heap.
    static void operator delete(void* memory, std::align_val_t alignment) noexcept {
        ::operator delete(memory, alignment);
    }
    /// Gives memory back to the heap after a constructor has thrown.
    static void operator delete(void* memory, std::align_val_t alignment,
                                const std::nothrow_t& tag) noexcept {
        ::operator delete(memory, alignment, tag);
    }
    /// Leaves the given place to its owner after a constructor has thrown.
    static void operator delete(void* /*memory*/, void* /*place*/) noexcept {}
};

} // namespace Port
