// What a program knows of the caches of a processor.
#pragma once

#include <cstddef>

namespace Port {

/// How many bytes a cache reads at once. What one thread writes and another uses stands in
/// different lines, or each waits for the other.
constexpr std::size_t CacheLine = 64;

/// Tells the processor that an object is about to be read. Any address is allowed.
inline void Prefetch(const void* address) noexcept {
#if defined(__GNUC__)
    __builtin_prefetch(address);
#else
    static_cast<void>(address);
#endif
}

} // namespace Port
