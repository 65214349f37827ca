// Pages for the millions of small objects of a design. An object costs its own size, rounded up to
// eight bytes, and what alignment takes, and nothing else; a page returns to the system when its
// last object is destroyed, so a design that is destroyed as a whole gives its memory back.
#pragma once

#include "Port/Pooled.h"

#include <cstddef>
#include <cstdint>
#include <new>

namespace Port::Pool {

/// Memory for what need not be aligned to more than eight bytes.
void* AllocatePacked(std::size_t size, Kind kind);

/// For standard containers that become large: what is as large as a huge page stands in huge pages.
template <class T> struct Allocator {
    using value_type = T;

    Allocator() noexcept = default;
    template <class Other> explicit Allocator(const Allocator<Other>& /*other*/) noexcept {}

    T* allocate(std::size_t count) {
        if (count > SIZE_MAX / sizeof(T)) {
            throw std::bad_alloc();
        }
        return static_cast<T*>(Allocate(count * sizeof(T), DesignObjects));
    }
    void deallocate(T* memory, std::size_t /*count*/) noexcept { Free(memory); }

    friend bool operator==(const Allocator& /*a*/, const Allocator& /*b*/) noexcept { return true; }
};

} // namespace Port::Pool
