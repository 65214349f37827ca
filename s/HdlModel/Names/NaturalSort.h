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
        SortByKeys(keys_.begin(), keys_.end(), 0);
    }

    /// The index of the object that is the i-th in order.
    int GetIndex(int i) const noexcept {
        return static_cast<int>(keys_[static_cast<std::size_t>(i)].GetIndex());
    }

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

    /// The length of the common prefix of some names of a range: most often that of all of them.
    /// Names that follow one another in turn are told from each other by the odd step.
    std::size_t GuessShared(Place first, Place last, std::size_t known) const noexcept {
        constexpr std::ptrdiff_t Samples = 32;
        const std::ptrdiff_t step = (last - first) / Samples | 1;
        const std::string_view name = ObjectOf(*first)->GetNameView();
        std::size_t shared = name.size();
        for (std::ptrdiff_t i = step; i < last - first; i += step) {
            const std::string_view other = ObjectOf(first[i])->GetNameView();
            shared = std::min(shared, Names::SharedLength(name, other, known));
        }
        return shared;
    }

    /// Makes the keys of the parts of names behind a prefix.
    /// \return false if it is not a common prefix of all names.
    bool MakeKeys(Place first, Place last, std::size_t known, std::size_t shared) noexcept {
        const std::string_view prefix = ObjectOf(*first)->GetNameView().substr(0, shared);
        for (Place key = first; key != last; ++key) {
            const T* const object = ObjectOf(*key);
            const std::string_view name = object->GetNameView();
            if (Names::SharedLength(prefix, name, known) < shared) {
                return false;
            }
            *key = Key(rankOf_(object), name.substr(shared), key->GetIndex());
        }
        return true;
    }

    /// \param known so many characters are known to be common to all names.
    void SortByKeys(Place first, Place last, std::size_t known) {
        std::size_t shared = GuessShared(first, last, known);
        if (!MakeKeys(first, last, known, shared)) {
            shared = SharedOf(first, last, known);
            MakeKeys(first, last, known, shared);
        }
        std::sort(first, last);
        while (first != last) {
            const Place next = std::find_if(
                first + 1, last, [first](const Key& key) { return !AreEqual(key, *first); });
            if (next - first > 1) {
                SortEqual(first, next, shared);
            }
            first = next;
        }
    }

    void SortEqual(Place first, Place last, std::size_t known) {
        if (SharedOf(first, last, known) > known) {
            SortByKeys(first, last, known);
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
    const NaturalKeySort byKeys(objects, rankOf, compare);
    const PtrArray<T*> unsorted = objects;
    for (int i = 0; i < size; ++i) {
        Reordering::Place(objects, i, unsorted.GetAt(byKeys.GetIndex(i)));
    }
}

} // namespace Orn_Hdl
