/// \file
/// Counts what a program takes of the heap and maps of the system. This header replaces the global
/// allocation functions: one source file of a program may include it.
#pragma once

#include "Support/Sanitized.h"

#include <cstddef>
#include <cstdlib>
#include <new>

#include <sys/mman.h>
#include <sys/syscall.h>
#include <unistd.h>

// GCC sees malloc through the operator below, and then free in the place of delete.
#pragma GCC diagnostic ignored "-Wmismatched-new-delete"

namespace Support {

/// Since the program started; the largest block since a count began.
struct AllocationCount {
    std::size_t blocks = 0;  ///< taken from the heap; a block that grows counts each time
    std::size_t maps = 0;    ///< pages, of any size, that the program has mapped itself
    std::size_t largest = 0; ///< bytes of the largest block
};

inline AllocationCount allocationCount;

/// What an action takes.
template <class Action> AllocationCount CountAllocations(Action action) {
    const AllocationCount before = allocationCount;
    allocationCount.largest = 0;
    action();
    return {allocationCount.blocks - before.blocks, allocationCount.maps - before.maps,
            allocationCount.largest};
}

/// Counts a block of the heap.
inline void CountBlock(std::size_t size) noexcept {
    ++allocationCount.blocks;
    if (size > allocationCount.largest) {
        allocationCount.largest = size;
    }
}

} // namespace Support

void* operator new(std::size_t size) {
    Support::CountBlock(size);
    if (void* memory = std::malloc(size == 0 ? 1 : size)) {
        return memory;
    }
    throw std::bad_alloc();
}

void* operator new(std::size_t size, const std::nothrow_t&) noexcept {
    Support::CountBlock(size);
    return std::malloc(size == 0 ? 1 : size);
}

void operator delete(void* memory) noexcept {
    std::free(memory);
}

void operator delete(void* memory, std::size_t) noexcept {
    std::free(memory);
}

void operator delete(void* memory, const std::nothrow_t&) noexcept {
    std::free(memory);
}

#if !defined(ORN_HDL_SANITIZED)
// The library's other two ways to memory; the sanitizers keep these for themselves.
extern "C" void* __libc_realloc(void* memory, std::size_t size);

extern "C" void* realloc(void* memory, std::size_t size) noexcept {
    Support::CountBlock(size);
    return __libc_realloc(memory, size);
}

extern "C" void* mmap(void* address, std::size_t size, int protection, int flags, int file,
                      off_t offset) noexcept {
    ++Support::allocationCount.maps;
    return reinterpret_cast<void*>(
        syscall(SYS_mmap, address, size, protection, flags, file, offset));
}
#endif
