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

/// Sorts stably. `rankOf(object)` gives an int; the keys of names are made once, and an array that is
/// in order already, as after a former write, is only looked at.
template <class T, class RankOf> void SortNaturally(PtrArray<T*>& objects, RankOf rankOf) {
    struct Entry {
        int rank;
        std::uint64_t key;
        T* object;
    };
    const auto less = [](const Entry& a, const Entry& b) {
        if (a.rank != b.rank) {
            return a.rank < b.rank;
        }
        if (a.key != b.key) {
            return a.key < b.key;
        }
        return Names::CompareNatural(a.object->GetNameView(), b.object->GetNameView()) < 0;
    };
    const auto entryOf = [&rankOf](T* object) {
        return Entry{rankOf(object), Names::NaturalKey(object->GetNameView()), object};
    };
    const int size = objects.GetSize();
    int sorted = 1;
    for (Entry before{}, entry{}; sorted <= size; ++sorted, before = entry) {
        entry = entryOf(objects.GetAt(sorted - 1));
        if (sorted > 1 && less(entry, before)) {
            break;
        }
    }
    if (sorted > size) {
        return;
    }
    std::vector<Entry> entries;
    entries.reserve(static_cast<std::size_t>(size));
    for (int i = 0; i < size; ++i) {
        entries.push_back(entryOf(objects.GetAt(i)));
    }
    std::stable_sort(entries.begin(), entries.end(), less);
    for (int i = 0; i < size; ++i) {
        objects.SetAt(i, entries[static_cast<std::size_t>(i)].object);
    }
}

} // namespace Orn_Hdl
