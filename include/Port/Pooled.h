/// \file
/// `Port::Pooled`, the base of classes that have millions of objects in a design.
#pragma once

#include "Port/Export.h"

#include <cstddef>
#include <new>

namespace Port {

namespace Pool {

/// What lives and is destroyed together has pages of its own.
enum Kind { DesignObjects, Commands };

/// Memory for one object of that size, with the alignment that the usual operator new guarantees
/// for it. Each thread fills pages of its own. \throws std::bad_alloc if allocation fails.
ORN_HDL_API void* Allocate(std::size_t size, Kind kind);
/// Frees the memory of an object; null is ignored. Any thread may do so.
ORN_HDL_API void Free(void* memory) noexcept;

} // namespace Pool

/// Objects of derived classes are allocated in pages of their own, without bookkeeping for each
/// object. Classes of larger alignment, for which operator new receives an alignment, are allocated
/// on the heap.
template <Pool::Kind PoolKind> class Pooled {
public:
    /// Memory from the pages. \throws std::bad_alloc if allocation fails.
    static void* operator new(std::size_t size) { return Pool::Allocate(size, PoolKind); }
    /// Memory from the pages; null if allocation fails.
    static void* operator new(std::size_t size, const std::nothrow_t& /*tag*/) noexcept {
        try {
            return Pool::Allocate(size, PoolKind);
        } catch (const std::bad_alloc&) {
            return nullptr;
        }
    }
    /// Memory from the heap. \throws std::bad_alloc if allocation fails.
    static void* operator new(std::size_t size, std::align_val_t alignment) {
        return ::operator new(size, alignment);
    }
    /// Memory from the heap; null if allocation fails.
    static void* operator new(std::size_t size, std::align_val_t alignment,
                              const std::nothrow_t& tag) noexcept {
        return ::operator new(size, alignment, tag);
    }
    /// The given memory: nothing is allocated.
    static void* operator new(std::size_t /*size*/, void* place) noexcept { return place; }

    /// Returns memory to the pages.
    static void operator delete(void* memory) noexcept { Pool::Free(memory); }
    /// Returns memory to the pages after a constructor has thrown.
    static void operator delete(void* memory, const std::nothrow_t& /*tag*/) noexcept {
        Pool::Free(memory);
    }
    /// Returns memory to the heap.
    static void operator delete(void* memory, std::align_val_t alignment) noexcept {
        ::operator delete(memory, alignment);
    }
    /// Returns memory to the heap after a constructor has thrown.
    static void operator delete(void* memory, std::align_val_t alignment,
                                const std::nothrow_t& tag) noexcept {
        ::operator delete(memory, alignment, tag);
    }
    /// Does nothing after a constructor has thrown: the memory belongs to the caller.
    static void operator delete(void* /*memory*/, void* /*place*/) noexcept {}
};

} // namespace Port
