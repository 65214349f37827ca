// Sorting objects by a rank, then by name in natural order.
#pragma once

#include "HdlModel/Names.h"
#include "Orn_Hdl/Containers/PtrArray.h"

#include <algorithm>
#include <cstdint>
#include <string_view>
#include <utility>
#include <vector>

namespace Orn_Hdl {

/// Sorts stably. `rankOf(object)` gives an int. A short array is sorted by the names as they are;
/// of a long one the keys are made once, and one that is in order already, as after a former write,
/// is only looked at.
template <class T, class RankOf> void SortNaturally(PtrArray<T*>& objects, RankOf rankOf) {
    const auto isLess = [&rankOf](const T* a, const T* b) {
        const int rankA = rankOf(a);
        const int rankB = rankOf(b);
        return rankA != rankB ? rankA < rankB
                              : Names::CompareNatural(a->GetNameView(), b->GetNameView()) < 0;
    };
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
    struct Entry {
        Names::NaturalKey key;
        int rank;
        T* object;
    };
    std::vector<Entry> entries;
    entries.reserve(static_cast<std::size_t>(size));
    for (T* object : Iterator<T*>(&objects)) {
        entries.push_back({Names::NaturalKey(object->GetNameView()), rankOf(object), object});
    }
    std::stable_sort(entries.begin(), entries.end(), [](const Entry& a, const Entry& b) {
        if (a.rank != b.rank) {
            return a.rank < b.rank;
        }
        if (a.key != b.key) {
            return a.key < b.key;
        }
        return Names::CompareNatural(a.object->GetNameView(), b.object->GetNameView()) < 0;
    });
    for (int i = 0; i < size; ++i) {
        objects.SetAt(i, entries[static_cast<std::size_t>(i)].object);
    }
}

} // namespace Orn_Hdl
