// Sorting objects by a rank, then by name in natural order.
#pragma once

#include "Containers/Reordering.h"
#include "HdlModel/Names/Names.h"
#include "Orn_Hdl/Containers/PtrArray.h"

#include <algorithm>
#include <cstdint>
#include <string_view>
#include <vector>

namespace Orn_Hdl {

/// Sorts stably. `rankOf(object)` gives an int. A short array is sorted by the names as they are;
/// of a long one the keys are made once, and one that is in order already, as after a former write,
/// is only looked at.
template <class T, class RankOf> void SortNaturally(PtrArray<T*>& objects, RankOf rankOf) {
    const auto compare = [&rankOf](const T* a, const T* b) {
        const int rankA = rankOf(a);
        const int rankB = rankOf(b);
        return rankA != rankB ? (rankA < rankB ? -1 : 1)
                              : Names::CompareNatural(a->GetNameView(), b->GetNameView());
    };
    const auto isLess = [&compare](const T* a, const T* b) { return compare(a, b) < 0; };
    constexpr int Short = 8;
    const int size = objects.GetSize();
    if (size <= Short) {
        for (int i = 1; i < size; ++i) {
            for (int j = i; j > 0 && isLess(objects.GetAt(j), objects.GetAt(j - 1)); --j) {
                objects.Swap(j, j - 1);
            }
        }
        return;
    }
    int sorted = 1;
    while (sorted < size && !isLess(objects.GetAt(sorted), objects.GetAt(sorted - 1))) {
        ++sorted;
    }
    if (sorted == size) {
        return;
    }
    const PtrArray<T*> unsorted = objects;
    std::vector<Names::NaturalKey> keys;
    keys.reserve(static_cast<std::size_t>(size));
    for (int i = 0; i < size; ++i) {
        const T* const object = unsorted.GetAt(i);
        keys.emplace_back(rankOf(object), object->GetNameView(), static_cast<std::uint32_t>(i));
    }
    const auto objectOf = [&unsorted](const Names::NaturalKey& key) {
        return unsorted.GetAt(static_cast<int>(key.GetIndex()));
    };
    // The index makes every comparison decide, so this order is the stable one.
    std::sort(keys.begin(), keys.end(), [&](const auto& a, const auto& b) {
        if (a != b) {
            return a < b;
        }
        const int order = compare(objectOf(a), objectOf(b));
        return order != 0 ? order < 0 : a.GetIndex() < b.GetIndex();
    });
    for (int i = 0; i < size; ++i) {
        Reordering::Place(objects, i, objectOf(keys[static_cast<std::size_t>(i)]));
    }
}

} // namespace Orn_Hdl
