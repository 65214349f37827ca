// A stable sort that stays within its bounds for any predicate.
#pragma once

#include <algorithm>
#include <cstddef>
#include <vector>

namespace Orn_Hdl {

/// Sorts stably. `std::stable_sort` may read before its first element if the predicate is
/// inconsistent; merging compares only the remaining elements of both halves. If the predicate
/// throws, the contents of `items` are unspecified.
template <class T, class Less> void StableSort(std::vector<T>& items, const Less& less) {
    std::vector<T> merged(items.size());
    for (std::size_t width = 1; width < items.size(); width *= 2) {
        auto out = merged.begin();
        for (std::size_t start = 0; start < items.size(); start += 2 * width) {
            const auto at = [&](std::size_t index) {
                return items.begin() + static_cast<std::ptrdiff_t>(std::min(index, items.size()));
            };
            const auto middle = at(start + width);
            out = std::merge(at(start), middle, middle, at(start + 2 * width), out, less);
        }
        items.swap(merged);
    }
}

} // namespace Orn_Hdl
