// Whichever allocation fails while several threads write: std::bad_alloc comes to the caller, all
// threads end, and the design is what it was.
#include "Robustness/MidSizedDesign.h"
#include "Support/EngineScript.h"
#include "Support/Sanitized.h"
#include "Threads/SmallRanges.h"

#include <gtest/gtest.h>

#include <atomic>
#include <cstdlib>
#include <new>
#include <string>

// The sanitizers keep these operators for themselves.
#if !defined(ORN_HDL_SANITIZED)

namespace {

/// How many allocations succeed before one fails; below zero none fails (any more).
std::atomic<long> allowedAllocations{-1};

} // namespace

void* operator new(std::size_t size) {
    // Several threads allocate: one of them takes the number 0.
    if (allowedAllocations.load() >= 0 && allowedAllocations.fetch_sub(1) == 0) {
        throw std::bad_alloc();
    }
    if (void* const memory = std::malloc(size == 0 ? 1 : size)) {
        return memory;
    }
    throw std::bad_alloc();
}
void operator delete(void* memory) noexcept {
    std::free(memory);
}
void operator delete(void* memory, std::size_t) noexcept {
    std::free(memory);
}

namespace {

std::string Write(Orn_Hdl::Model& model, Orn_Hdl::Language language, unsigned threads) {
    model.GetOptions()->threads = threads;
    model.GetOptions()->writeHeader = false;
    Orn_Hdl::TextMemOutStream out;
    if (language == Orn_Hdl::Language::Verilog) {
        Orn_Hdl::VerilogNetlister(out).WriteNetlist(model.GetNetlist(), *model.GetOptions());
    } else {
        Orn_Hdl::VhdlNetlister(out).WriteNetlist(model.GetNetlist(), model.GetOptions());
    }
    return std::string(out.GetValue().GetView());
}

TEST(FailingAllocationInThreads, ComesToTheCaller) {
    const ThreadTests::SmallRanges ranges(4, 1 << 14);
    for (const Orn_Hdl::Language language : Orn_Hdl::Languages) {
        Support::EngineScript script(Robustness::MidSizedDesign());
        // The first writes make dummy signals.
        Write(script.GetModel(), language, 1);
        Write(script.GetModel(), language, 1);
        const std::string expected = Write(script.GetModel(), language, 1);
        int failures = 0;
        bool isUsedUp = true;
        for (long count = 0; isUsedUp; ++count) {
            allowedAllocations = count;
            try {
                Write(script.GetModel(), language, 3);
            } catch (const std::bad_alloc&) {
                ++failures;
            }
            isUsedUp = allowedAllocations.exchange(-1) < 0;
            ASSERT_TRUE(Write(script.GetModel(), language, 1) == expected) << count;
        }
        EXPECT_GT(failures, 50);
    }
}

} // namespace

#endif
