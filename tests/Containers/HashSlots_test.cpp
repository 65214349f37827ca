#include "Containers/HashSlots.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <cstdint>
#include <map>
#include <utility>
#include <vector>

namespace {

using Slots = Orn_Hdl::HashSlots<std::uint32_t>;

/// Hashes whose homes are few and often at the end of the table, so that searches are long and go
/// on at its beginning.
std::uint32_t HashOf(std::uint32_t key) {
    return (key % 3 == 0 ? ~std::uint32_t(0) : (key % 7) << 29U) - (key % 2) * 8;
}

auto IsKey(std::uint32_t key) {
    return [key](std::uint32_t hash, std::uint32_t value) {
        return hash == HashOf(key) && value % 100 == key;
    };
}

} // namespace

RC_GTEST_PROP(HashSlots, BehavesAsAMap, ()) {
    // What is done with which key.
    const auto calls = *rc::gen::container<std::vector<std::pair<int, std::uint32_t>>>(
        rc::gen::pair(rc::gen::inRange(0, 4), rc::gen::inRange<std::uint32_t>(1, 60)));
    Slots slots;
    std::map<std::uint32_t, std::uint32_t> expected;
    std::uint32_t round = 0;
    for (const auto& [call, key] : calls) {
        const std::uint32_t value = ++round * 100 + key;
        const auto found = expected.find(key);
        if (call > 0) {
            slots.AddOrReplace(HashOf(key), value, IsKey(key));
            expected[key] = value;
        } else if (found != expected.end()) {
            slots.Remove(HashOf(key), found->second);
            expected.erase(found);
        }
        RC_ASSERT(slots.GetSize() == expected.size());
        for (std::uint32_t each = 1; each < 60; ++each) {
            const auto one = expected.find(each);
            RC_ASSERT(slots.Find(HashOf(each), IsKey(each)) ==
                      (one == expected.end() ? 0U : one->second));
        }
    }
}

TEST(HashSlots, WhatIsAddedLastIsFoundInItsPlace) {
    constexpr std::uint32_t Count = 40;
    Slots slots;
    for (std::uint32_t value = 1; value <= Count; ++value) {
        slots.AddOrReplace(0, value,
                           [value](std::uint32_t, std::uint32_t other) { return other == value; });
        const auto isValue = [&value](std::uint32_t, std::uint32_t other) {
            return other == value;
        };
        EXPECT_EQ(slots.FindInPlace(0, isValue), value);
    }
    const auto isFirst = [](std::uint32_t, std::uint32_t value) { return value == 1; };
    EXPECT_EQ(slots.FindInPlace(0, isFirst), 0U);
    EXPECT_EQ(slots.Find(0, isFirst), 1U);
}
