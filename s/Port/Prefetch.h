// A hint for the processor.
#pragma once

namespace Port {

/// Hints that an object is about to be read. The address may be any.
inline void Prefetch(const void* address) noexcept {
#if defined(__GNUC__)
    __builtin_prefetch(address);
#else
    static_cast<void>(address);
#endif
}

} // namespace Port
