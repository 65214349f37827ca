// A hint for the processor.
#pragma once

namespace Port {

/// Tells the processor that an object is about to be read. Any address is allowed.
inline void Prefetch(const void* address) noexcept {
#if defined(__GNUC__)
    __builtin_prefetch(address);
#else
    static_cast<void>(address);
#endif
}

} // namespace Port
