// Pages for the millions of small objects of a design. An object takes its own size, rounded up to
// eight bytes and to its alignment. A page is returned to the system when its last object is
// destroyed, so destroying a design frees its memory.
#pragma once

#include "Port/Pooled.h"

#include <cstddef>
#include <cstdint>
#include <new>

namespace Port::Pool {

/// Memory for an object whose alignment is at most eight bytes.
void* AllocatePacked(std::size_t size, Kind kind);

/// Has the system clear memory for the next thread that fills pages, which takes longer than
/// filling them: one page at a time, held ready for any thread. A thread that has nothing else to
/// do calls it for one that is busy.
class Reserve {
public:
    Reserve() = default;
    Reserve(const Reserve&) = delete;
    Reserve& operator=(const Reserve&) = delete;
    /// Returns the page that is held ready to the system.
    ~Reserve();
    /// Makes a page ready if there is none. If allocation fails, there is none.
    void Replenish() noexcept;
    /// Whether a page is ready. Sanitizers have no pages.
    static bool IsFull() noexcept;
};

/// An allocator for standard containers that become large: it uses huge pages for memory of at
/// least that size.
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
