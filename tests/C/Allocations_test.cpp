// Whichever allocation of a call fails, the call says ORN_HDL_NO_MEMORY, and its handles are good.
#include "C/Session.h"

#include <gtest/gtest.h>

#include <atomic>
#include <cstdlib>
#include <new>
#include <string>

// GCC sees malloc through the operator below, and then free in the place of delete.
#pragma GCC diagnostic ignored "-Wmismatched-new-delete"

namespace {

/// How many allocations succeed before one fails; below zero none fails.
std::atomic<long> allowedBlocks{-1};

void* AllocateBlock(std::size_t size) {
    if (allowedBlocks.load() >= 0 && allowedBlocks.fetch_sub(1) == 0) {
        return nullptr;
    }
    return std::malloc(size == 0 ? 1 : size);
}

} // namespace

void* operator new(std::size_t size) {
    if (void* const memory = AllocateBlock(size)) {
        return memory;
    }
    throw std::bad_alloc();
}
void* operator new(std::size_t size, const std::nothrow_t&) noexcept {
    return AllocateBlock(size);
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

namespace {

/// Makes a call again and again, its first allocation failing, then its second, until it succeeds.
/// \return how often it said that memory is exhausted.
template <class Call> int FailInTurn(const Call& call) {
    for (long count = 0;; ++count) {
        allowedBlocks = count;
        const orn_hdl_status_t status = call();
        const bool hasFailed = allowedBlocks < 0;
        allowedBlocks = -1;
        if (status != ORN_HDL_NO_MEMORY) {
            // An allocation may fail without harm, such as one for a table that only speeds up.
            EXPECT_EQ(status, ORN_HDL_OK) << orn_hdl_status_text(status);
            if (!hasFailed || status != ORN_HDL_OK) {
                return static_cast<int>(count);
            }
        }
    }
}

TEST(CAllocations, AFailedAllocationIsAStatus) {
    const CTests::Session session;
    session.Run(CTests::SmallDesign);
    const std::string longName(100, 'x');
    EXPECT_GT(FailInTurn([&] {
                  orn_hdl_engine_t engine;
                  const orn_hdl_status_t status = orn_hdl_engine_create(&engine);
                  return status == ORN_HDL_OK ? orn_hdl_engine_destroy(engine) : status;
              }),
              0);
    EXPECT_GT(FailInTurn([&] {
                  const orn_hdl_status_t status =
                      orn_hdl_engine_add_model(session.engine, longName.c_str(), "", nullptr);
                  return status == ORN_HDL_OK
                             ? orn_hdl_engine_remove_model(session.engine, longName.c_str())
                             : status;
              }),
              0);
    EXPECT_GT(FailInTurn([&] {
                  char* text = nullptr;
                  const orn_hdl_status_t status =
                      orn_hdl_model_write_text(session.model, ORN_HDL_VERILOG, &text, nullptr);
                  orn_hdl_free(text);
                  return status;
              }),
              0);
    EXPECT_GT(FailInTurn([&] {
                  orn_hdl_findings_t findings;
                  const orn_hdl_status_t status =
                      orn_hdl_model_check(session.model, ORN_HDL_ALL_TARGETS, &findings);
                  return status == ORN_HDL_OK ? orn_hdl_findings_destroy(findings) : status;
              }),
              0);
    EXPECT_GT(FailInTurn([&] {
                  orn_hdl_reader_t reader;
                  const orn_hdl_status_t status = orn_hdl_reader_create(ORN_HDL_VHDL, &reader);
                  return status == ORN_HDL_OK ? orn_hdl_reader_destroy(reader) : status;
              }),
              0);
    orn_hdl_error_t error;
    ASSERT_EQ(orn_hdl_engine_error(session.engine, &error), ORN_HDL_OK);
    EXPECT_EQ(error.status, ORN_HDL_NO_MEMORY);
    EXPECT_EQ(CTests::ToString(error.text), "out of memory");
    session.GetInstance("U1");
}

} // namespace
