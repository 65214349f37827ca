#include "Port/Pool.h"

#include <atomic>
#include <cstdint>
#include <new>
#include <sys/mman.h>

#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
#define PORT_POOL_IS_HEAP 1
#elif defined(__has_feature)
#if __has_feature(address_sanitizer) || __has_feature(thread_sanitizer)
#define PORT_POOL_IS_HEAP 1
#endif
#endif

namespace Port::Pool {

#if defined(PORT_POOL_IS_HEAP)

// Sanitizers only detect misuse of objects that are allocated separately on the heap.
void* Allocate(std::size_t size, Kind /*kind*/) {
    return ::operator new(size);
}

void* AllocatePacked(std::size_t size, Kind /*kind*/) {
    return ::operator new(size);
}

void Free(void* memory) noexcept {
    ::operator delete(memory);
}

Reserve::~Reserve() = default;

void Reserve::Replenish() noexcept {}

bool Reserve::IsFull() noexcept {
    return false;
}

#else

namespace {

/// Pages have the size and alignment of the system's huge pages. The addresses of a walk over a
/// netlist are in random order; huge pages need far fewer address translations, and cause far fewer
/// page faults when the memory is first used.
constexpr std::size_t PageSize = std::size_t(2) << 20;

/// The header at the start of every page. Pages are aligned to their size, so the address of an
/// object determines its page.
struct Page {
    /// The number of objects in the page; while a thread fills the page, `Filling` minus the number
    /// of objects that have been destroyed.
    std::atomic<std::size_t> users;
    /// The size of the whole mapping.
    std::size_t size;
};

/// More than the number of objects in any page. The thread that fills a page counts its objects
/// separately.
constexpr std::size_t Filling = SIZE_MAX / 2;

constexpr std::size_t HeaderSize = sizeof(Page);
static_assert(HeaderSize % 16 == 0);

/// Maps memory aligned to `PageSize`: maps more than is needed and unmaps both ends.
Page* NewPage(std::size_t least, bool isHuge, std::size_t users) {
    const std::size_t size = (least + 4095) / 4096 * 4096;
    if (size < least || size + PageSize < size) {
        throw std::bad_alloc();
    }
    void* const mapped =
        mmap(nullptr, size + PageSize, PROT_READ | PROT_WRITE, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0);
    if (mapped == MAP_FAILED) {
        throw std::bad_alloc();
    }
    char* const start = static_cast<char*>(mapped);
    const std::size_t offset = reinterpret_cast<std::uintptr_t>(start) % PageSize;
    const std::size_t before = offset == 0 ? 0 : PageSize - offset;
    if (before > 0) {
        munmap(start, before);
    }
    munmap(start + before + size, PageSize - before);
    if (isHuge) {
        madvise(start + before, size, MADV_HUGEPAGE);
    }
    return ::new (start + before) Page{{users}, size};
}

void Leave(Page* page, std::size_t users) noexcept {
    if (page->users.fetch_sub(users, std::memory_order_acq_rel) == users) {
        munmap(page, page->size);
    }
}

/// The page that is held ready; null if there is none.
std::atomic<Page*> readyPage{nullptr};

Page* TakeReadyPage() noexcept {
    return readyPage.load(std::memory_order_relaxed) == nullptr
               ? nullptr
               : readyPage.exchange(nullptr, std::memory_order_acquire);
}

/// The page that a thread is filling with objects of one kind.
class Filler {
public:
    ~Filler() { Close(); }

    /// \param size a multiple of eight.
    void* AllocatePacked(std::size_t size) {
        if (size > left_) {
            // The first page does not use huge pages: most processes need only a part of it.
            Page* fresh = page_ == nullptr ? nullptr : TakeReadyPage();
            if (fresh == nullptr) {
                fresh = NewPage(PageSize, page_ != nullptr, Filling);
            }
            Close();
            page_ = fresh;
            left_ = PageSize - HeaderSize;
        }
        void* const memory = reinterpret_cast<char*>(page_) + (PageSize - left_);
        left_ -= size;
        ++objects_;
        return memory;
    }

    void* Allocate(std::size_t size) {
        // The rest of the page is a multiple of eight, and of sixteen in a new page.
        if (size % 16 == 0 && left_ % 16 != 0) {
            left_ -= 8;
        }
        return AllocatePacked(size);
    }

private:
    void Close() noexcept {
        if (page_ != nullptr) {
            Leave(page_, Filling - objects_);
            page_ = nullptr;
        }
        objects_ = 0;
        left_ = 0;
    }

    Page* page_ = nullptr;
    std::size_t objects_ = 0;
    std::size_t left_ = 0;
};

// Read at every allocation: the default thread-local model of a shared library would need a call.
#if defined(__GNUC__)
[[gnu::tls_model("initial-exec")]]
#endif
thread_local Filler fillers[2];

/// Larger objects have pages of their own.
constexpr std::size_t MostInFiller = PageSize / 8;

std::size_t RoundUp(std::size_t size) {
    const std::size_t rounded = (size + 7) / 8 * 8;
    if (rounded < size) {
        throw std::bad_alloc();
    }
    return rounded;
}

void* AllocatePage(std::size_t size) {
    return reinterpret_cast<char*>(NewPage(HeaderSize + size, size >= PageSize, 1)) + HeaderSize;
}

} // namespace

Reserve::~Reserve() {
    if (Page* const page = TakeReadyPage()) {
        munmap(page, page->size);
    }
}

bool Reserve::IsFull() noexcept {
    return readyPage.load(std::memory_order_relaxed) != nullptr;
}

void Reserve::Replenish() noexcept {
    if (IsFull()) {
        return;
    }
    try {
        // Its header is written, so the system clears a huge page as a whole.
        Page* const page = NewPage(PageSize, true, Filling);
        Page* none = nullptr;
        if (!readyPage.compare_exchange_strong(none, page, std::memory_order_release,
                                               std::memory_order_relaxed)) {
            munmap(page, page->size);
        }
    } catch (const std::bad_alloc&) {
        // Whoever needs the page will see.
    }
}

void* Allocate(std::size_t size, Kind kind) {
    const std::size_t rounded = RoundUp(size);
    return rounded > MostInFiller ? AllocatePage(rounded) : fillers[kind].Allocate(rounded);
}

void* AllocatePacked(std::size_t size, Kind kind) {
    const std::size_t rounded = RoundUp(size);
    return rounded > MostInFiller ? AllocatePage(rounded) : fillers[kind].AllocatePacked(rounded);
}

void Free(void* memory) noexcept {
    if (memory != nullptr) {
        const auto address = reinterpret_cast<std::uintptr_t>(memory);
        // The page around the address. NOLINTNEXTLINE(performance-no-int-to-ptr)
        Leave(reinterpret_cast<Page*>(address & ~(std::uintptr_t(PageSize) - 1)), 1);
    }
}

#endif

} // namespace Port::Pool
