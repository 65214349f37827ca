// Pages for the millions of small objects of a design. An object costs its own size, rounded up to
// eight bytes, and nothing else; a page returns to the system when its last object has ended, so
// what ends as a whole gives its memory back as a whole.
#pragma once

#include <cstddef>

namespace Port::Pool {

/// What lives and ends together has pages of its own.
enum Kind { DesignObjects, Commands };

/// Memory for one object, aligned to eight bytes; throws std::bad_alloc. Each thread fills pages of
/// its own.
void* Allocate(std::size_t size, Kind kind);
/// Gives an object's memory back; null is ignored. Any thread may do so.
void Free(void* memory) noexcept;

} // namespace Port::Pool
