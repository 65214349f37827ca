#include "Port/TextSet.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <functional>
#include <list>
#include <new>
#include <set>
#include <string>
#include <string_view>

namespace {

struct Hash {
    std::uint64_t operator()(std::string_view text) const noexcept {
        return std::hash<std::string_view>()(text) * 0x9E3779B97F4A7C15U;
    }
};

/// All texts of one length collide.
struct LengthHash {
    std::uint64_t operator()(std::string_view text) const noexcept {
        return std::uint64_t(text.size()) << 32U;
    }
};

struct EqualEnds {
    bool operator()(std::string_view a, std::string_view b) const noexcept {
        return a.empty() == b.empty() && (a.empty() || a.back() == b.back());
    }
};

std::string_view Same(std::string_view text) {
    return text;
}

TEST(TextSet, FindsNothingWhileEmpty) {
    const Port::TextSet<Hash, std::equal_to<>> set;
    EXPECT_EQ(set.Find("a"), nullptr);
    EXPECT_EQ(set.Get("a"), "");
    EXPECT_EQ(set.GetSize(), 0U);
}

TEST(TextSet, KeepsOneOfEqualTexts) {
    Port::TextSet<LengthHash, EqualEnds> set;
    EXPECT_TRUE(set.Add("ab", Same));
    EXPECT_FALSE(set.Add("cb", Same));
    EXPECT_TRUE(set.Add("bc", Same));
    EXPECT_EQ(set.Get("xb"), "ab");
    EXPECT_EQ(set.Get("xc"), "bc");
    EXPECT_EQ(set.GetSize(), 2U);
}

TEST(TextSet, HoldsTheEmptyText) {
    Port::TextSet<Hash, std::equal_to<>> set;
    EXPECT_EQ(set.Find(""), nullptr);
    EXPECT_TRUE(set.Add("", Same));
    EXPECT_FALSE(set.Add("", Same));
    EXPECT_NE(set.Find(""), nullptr);
}

TEST(TextSet, AsksForACopyOfNewTextsAlone) {
    Port::TextSet<Hash, std::equal_to<>> set;
    int copies = 0;
    const auto keep = [&copies](std::string_view text) {
        ++copies;
        return text;
    };
    set.Add("a", keep);
    set.Add("a", keep);
    EXPECT_EQ(copies, 1);
}

TEST(TextSet, StaysAsItWasIfNoCopyIsMade) {
    Port::TextSet<Hash, std::equal_to<>> set;
    const auto fail = [](std::string_view) -> std::string_view { throw std::bad_alloc(); };
    EXPECT_THROW(set.Add("a", fail), std::bad_alloc);
    EXPECT_EQ(set.GetSize(), 0U);
    EXPECT_EQ(set.Find("a"), nullptr);
    EXPECT_TRUE(set.Add("a", Same));
}

/// The same as a sorted set, with many texts that share a slot and with few.
template <class TextHash> void CompareWithSortedSet(std::size_t reserved, int most) {
    Port::TextSet<TextHash, std::equal_to<>> set;
    set.Reserve(reserved);
    std::list<std::string> stored;
    std::set<std::string> expected;
    const auto keep = [&stored](std::string_view text) -> std::string_view {
        return stored.emplace_back(text);
    };
    std::uint32_t random = 1;
    for (int i = 0; i < most; ++i) {
        random = random * 1664525U + 1013904223U;
        const std::string text = std::to_string((random >> 8U) % static_cast<unsigned>(most));
        ASSERT_EQ(set.Get(text), expected.count(text) != 0 ? text : "");
        ASSERT_EQ(set.Add(text, keep), expected.insert(text).second) << text;
        ASSERT_EQ(set.GetSize(), expected.size());
    }
    for (const std::string& text : expected) {
        ASSERT_EQ(set.Get(text), text);
    }
}

TEST(TextSet, IsASetWhateverItsSize) {
    CompareWithSortedSet<Hash>(0, 20000);
    CompareWithSortedSet<Hash>(100, 20000);
    CompareWithSortedSet<Hash>(50000, 20000);
    CompareWithSortedSet<LengthHash>(0, 1500);
}

} // namespace
