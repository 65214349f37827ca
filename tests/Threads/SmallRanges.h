/// \file
/// Lists are cut into small ranges, so that small designs are written by several threads.
#pragma once

#include "Writers/ItemWriter.h"

#include <cstddef>

namespace ThreadTests {

/// Cuts lists into small ranges for a while.
class SmallRanges {
public:
    SmallRanges(std::size_t items, std::size_t memory)
        : former_(Orn_Hdl::Writers::GetRangeSizes()) {
        Orn_Hdl::Writers::GetRangeSizes() = {items, 1, memory};
    }
    SmallRanges(const SmallRanges&) = delete;
    SmallRanges& operator=(const SmallRanges&) = delete;
    ~SmallRanges() { Orn_Hdl::Writers::GetRangeSizes() = former_; }

private:
    const Orn_Hdl::Writers::RangeSizes former_;
};

} // namespace ThreadTests
