// Sorting objects by a rank, then by name in natural order.
#pragma once

#include "Containers/Reordering.h"
#include "HdlModel/Names/Names.h"
#include "Orn_Hdl/Containers/PtrArray.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <string_view>
#include <vector>

namespace Orn_Hdl {

/// Sorts the objects of a long list by keys. A key contains only some characters of a name, so the
/// common prefix of all names is omitted; objects with equal keys then get new keys from the
/// characters behind their common prefix.
template <class T, class RankOf, class Compare> class NaturalKeySort {
public:
    NaturalKeySort(const PtrArray<T*>& objects, RankOf rankOf, Compare compare)
        : objects_(objects), rankOf_(rankOf), compare_(compare) {
        keys_.reserve(static_cast<std::size_t>(objects.GetSize()));
        for (int i = 0; i < objects.GetSize(); ++i) {
            keys_.emplace_back(static_cast<std::uint32_t>(i));
        }
        SortByKeys(keys_.begin(), keys_.end(), SharedOf(keys_.begin(), keys_.end(), 0));
    }

    T* GetAt(int i) const noexcept { return ObjectOf(keys_[static_cast<std::size_t>(i)]); }

private:
    using Key = Names::NaturalKey;
    using Place = std::vector<Key>::iterator;

    T* ObjectOf(const Key& key) const noexcept {
        return objects_.GetAt(static_cast<int>(key.GetIndex()));
    }

    /// The length of the common prefix of all names in a range, which is at least `known`.
    std::size_t SharedOf(Place first, Place last, std::size_t known) const noexcept {
        const std::string_view name = ObjectOf(*first)->GetNameView();
        std::size_t shared = name.size();
        for (Place key = first + 1; key != last && shared > known; ++key) {
            const std::string_view other = ObjectOf(*key)->GetNameView();
            shared = std::min(shared, Names::SharedLength(name, other, known));
        }
        return shared;
    }

    /// Comparing the indices of equal names makes the order stable.
    void SortByKeys(Place first, Place last, std::size_t shared) {
        for (Place key = first; key != last; ++key) {
            const T* const object = ObjectOf(*key);
            *key = Key(rankOf_(object), object->GetNameView().substr(shared), key->GetIndex());
        }
        std::sort(first, last, [](const Key& a, const Key& b) {
            return a != b ? a < b : a.GetIndex() < b.GetIndex();
        });
        while (first != last) {
            const Place next =
                std::find_if(first + 1, last, [first](const Key& key) { return key != *first; });
            if (next - first > 1) {
                SortEqual(first, next, shared);
            }
            first = next;
        }
    }

    void SortEqual(Place first, Place last, std::size_t known) {
        const std::size_t shared = SharedOf(first, last, known);
        if (shared > known) {
            SortByKeys(first, last, shared);
            return;
        }
        std::sort(first, last, [this](const Key& a, const Key& b) {
            const int order = compare_(ObjectOf(a), ObjectOf(b));
            return order != 0 ? order < 0 : a.GetIndex() < b.GetIndex();
        });
    }

    const PtrArray<T*>& objects_;
    RankOf rankOf_;
    Compare compare_;
    std::vector<Key> keys_;
};

/// Sorts stably. `rankOf(object)` returns an int. A short array is sorted by comparing names; for a
/// long one the keys are computed once. An array that is sorted already, as after an earlier write,
/// is only checked.
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
    const NaturalKeySort byKeys(unsorted, rankOf, compare);
    for (int i = 0; i < size; ++i) {
        Reordering::Place(objects, i, byKeys.GetAt(i));
    }
}

} // namespace Orn_Hdl
