// The indices of a bus, a slice or a bus pin.
#pragma once

#include <algorithm>
#include <climits>
#include <cstdint>

namespace Orn_Hdl::Names {

/// The greatest number of bits into which a name is expanded.
constexpr std::int64_t MostExpandedBits = 1048576;

/// The indices in a name such as D(7:0), saturated to 32 bits. A range is descending, ascending, or
/// has one bit.
struct Range {
    int leftIndex = 0;
    int rightIndex = 0;

    /// Whether the range is descending; D(3:3) is not.
    constexpr bool IsDownTo() const noexcept { return leftIndex > rightIndex; }
    constexpr bool IsOneBit() const noexcept { return leftIndex == rightIndex; }
    /// The number of bits, exact.
    constexpr std::int64_t GetBits() const noexcept {
        const std::int64_t distance = std::int64_t(leftIndex) - rightIndex;
        return (distance < 0 ? -distance : distance) + 1;
    }
    /// The number of bits, at most INT_MAX.
    constexpr int GetWidth() const noexcept {
        return static_cast<int>(std::min<std::int64_t>(GetBits(), INT_MAX));
    }
    /// Whether the bits are few enough to be listed one by one.
    constexpr bool IsExpandable() const noexcept { return GetBits() <= MostExpandedBits; }
    /// The index of the bit at `position`, counted from the left, beginning with 0.
    constexpr int IndexAt(std::int64_t position) const noexcept {
        return static_cast<int>(leftIndex >= rightIndex ? leftIndex - position
                                                        : leftIndex + position);
    }
};

} // namespace Orn_Hdl::Names
