#include "Port/Pool.h"

#include <atomic>
#include <cstdint>
#include <cstdlib>
#include <new>

#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
#define PORT_POOL_IS_HEAP 1
#elif defined(__has_feature)
#if __has_feature(address_sanitizer) || __has_feature(thread_sanitizer) || __has_feature(memory_sanitizer)
#define PORT_POOL_IS_HEAP 1
#endif
#endif

namespace Port::Pool {

#if defined(PORT_POOL_IS_HEAP)

// The sanitizers see misuse only of memory that comes from the heap object by object.
void* Allocate(std::size_t size) {
    return ::operator new(size);
}

void Free(void* memory) noexcept {
    ::operator delete(memory);
}

#else

namespace {

constexpr std::size_t PageSize = std::size_t(1) << 18;

/// Stands at the start of every page. Pages are aligned to their size, so the page of an object is
/// found from the object's address.
struct Page {
    /// The objects in the page, and one more while a thread still fills it.
    std::atomic<std::size_t> users;
};

constexpr std::size_t HeaderSize = alignof(std::max_align_t);
static_assert(sizeof(Page) <= HeaderSize);

Page* NewPage(std::size_t size) {
    const std::size_t rounded = (size + PageSize - 1) / PageSize * PageSize;
    void* memory = std::aligned_alloc(PageSize, rounded);
    if (memory == nullptr) {
        throw std::bad_alloc();
    }
    return ::new (memory) Page{{1}};
}

void Leave(Page* page) noexcept {
    if (page->users.fetch_sub(1, std::memory_order_acq_rel) == 1) {
        std::free(page);
    }
}

/// The page that a thread fills at present.
class Filler {
public:
    ~Filler() { Close(); }

    void* Allocate(std::size_t size) {
        if (size > Left()) {
            Page* fresh = NewPage(PageSize);
            Close();
            page_ = fresh;
            used_ = HeaderSize;
        }
        void* memory = reinterpret_cast<char*>(page_) + used_;
        used_ += size;
        page_->users.fetch_add(1, std::memory_order_relaxed);
        return memory;
    }

private:
    std::size_t Left() const noexcept { return page_ == nullptr ? 0 : PageSize - used_; }

    void Close() noexcept {
        if (page_ != nullptr) {
            Leave(page_);
            page_ = nullptr;
        }
    }

    Page* page_ = nullptr;
    std::size_t used_ = 0;
};

thread_local Filler filler;

} // namespace

void* Allocate(std::size_t size) {
    const std::size_t rounded = (size + 7) / 8 * 8;
    if (rounded < size || rounded > PageSize / 8) {
        Page* own = rounded < size ? throw std::bad_alloc() : NewPage(HeaderSize + rounded);
        return reinterpret_cast<char*>(own) + HeaderSize;
    }
    return filler.Allocate(rounded);
}

void Free(void* memory) noexcept {
    if (memory != nullptr) {
        const auto address = reinterpret_cast<std::uintptr_t>(memory);
        Leave(reinterpret_cast<Page*>(address & ~(std::uintptr_t(PageSize) - 1)));
    }
}

#endif

} // namespace Port::Pool
