// A declared range of indices.
#pragma once

#include <cstdint>

namespace Orn_Hdl::Readers {

struct Range {
    int left = 0;
    int right = 0;

    std::uint64_t GetWidth() const noexcept {
        const std::int64_t distance = std::int64_t(left) - right;
        return static_cast<std::uint64_t>(distance < 0 ? -distance : distance) + 1;
    }
    bool IsDescending() const noexcept { return left > right; }
    bool Has(std::int64_t index) const noexcept {
        return IsDescending() ? index <= left && index >= right : index >= left && index <= right;
    }

    friend bool operator==(const Range& a, const Range& b) noexcept {
        return a.left == b.left && a.right == b.right;
    }
};

} // namespace Orn_Hdl::Readers
