// Pages for the millions of small objects of a design. An object costs its own size, rounded up to
// eight bytes, and what alignment takes, and nothing else; a page returns to the system when its
// last object has ended, so what ends as a whole gives its memory back as a whole.
#pragma once

#include <cstddef>
#include <cstdint>
#include <new>

namespace Port::Pool {

/// What lives and ends together has pages of its own.
enum Kind { DesignObjects, Commands };

/// Memory for one object of any type of that size that the usual operator new would serve: a type
/// that is aligned to sixteen bytes has a size to match. Throws std::bad_alloc. Each thread fills
/// pages of its own.
void* Allocate(std::size_t size, Kind kind);
/// Memory for what need not be aligned to more than eight bytes.
void* AllocatePacked(std::size_t size, Kind kind);
/// Gives an object's memory back; null is ignored. Any thread may do so.
void Free(void* memory) noexcept;

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
