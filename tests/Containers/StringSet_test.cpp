#include "Orn_Hdl/Containers/StringSet.h"

#include "Support/Names.h"
#include "Support/ShortTexts.h"
#include "Support/SlowStringSet.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <algorithm>
#include <iterator>
#include <ranges>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace {

using Orn_Hdl::StringSet;
using Orn_Hdl::StringSetIterator;
using Support::Names;
using Support::NamesOf;
using Support::SlowStringSet;

/// A set and its slow double, which are given the same calls.
struct Pair {
    StringSet set;
    SlowStringSet slow;

    void Add(const std::string& name) {
        set.Add(name.c_str());
        slow.Add(name);
    }
    void Remove(const std::string& name) {
        set.Remove(name.c_str());
        slow.Remove(name);
    }
    void Empty() {
        set.Empty();
        slow.Empty();
    }
};

/// `count` different names with one and the same hash: "ab" and "bA" hash alike, and so does every
/// row of such pairs. `count` is at most 1024.
std::vector<std::string> MakeCollidingNames(unsigned count) {
    std::vector<std::string> names;
    for (unsigned i = 0; i < count; ++i) {
        std::string name;
        for (unsigned bit = 0; bit < 10; ++bit) {
            name += (i >> bit & 1u) != 0 ? "bA" : "ab";
        }
        names.push_back(name);
    }
    return names;
}

TEST(StringSet, KnowsNamesWithAndWithoutRegardToCase) {
    StringSet set;
    set.Add("a");
    set.Add("A");
    EXPECT_TRUE(set.Contains("A"));
    EXPECT_TRUE(set.Contains("a"));
    EXPECT_TRUE(set.IContains("a"));
    EXPECT_EQ(NamesOf(set).size(), 2u);
}

TEST(StringSet, RemovingASpellingForgetsTheNameInEveryCase) {
    StringSet set;
    set.Add("a");
    set.Add("A");
    set.Remove("A");
    EXPECT_EQ(NamesOf(set), Names{"a"});
    EXPECT_FALSE(set.IContains("a"));
    EXPECT_TRUE(set.Contains("a"));
}

TEST(StringSet, RemovingAnAbsentSpellingForgetsTheNameInTheCaseIgnoringTable) {
    StringSet set;
    set.Add("Clk");
    set.Remove("CLK");
    EXPECT_FALSE(set.IContains("Clk"));
    EXPECT_EQ(NamesOf(set), Names{"Clk"});
    set.Remove("absent");
    EXPECT_EQ(NamesOf(set), Names{"Clk"});
}

TEST(StringSet, EmptyKeepsCaseIgnoringTable) {
    StringSet set;
    set.Add("Clk");
    set.Empty();
    EXPECT_TRUE(set.IsEmpty());
    EXPECT_FALSE(set.Contains("Clk"));
    EXPECT_TRUE(set.IContains("clk"));
    set.Add("CLK");
    EXPECT_EQ(NamesOf(set), Names{"CLK"});
    EXPECT_FALSE(set.IsEmpty());
}

TEST(StringSet, AFreshSetIsEmpty) {
    StringSet set;
    EXPECT_TRUE(set.IsEmpty());
    EXPECT_FALSE(set.Contains(""));
    EXPECT_FALSE(set.IContains(""));
    EXPECT_EQ(set.GetBeginPos(), set.GetEndPos());
    set.Remove("x");
    set.Empty();
    EXPECT_TRUE(set.IsEmpty());
}

TEST(StringSet, ReadsNullAsTheEmptyName) {
    StringSet set;
    EXPECT_FALSE(set.Contains(nullptr));
    set.Add(nullptr);
    EXPECT_TRUE(set.Contains(""));
    EXPECT_TRUE(set.IContains(nullptr));
    EXPECT_EQ(NamesOf(set), Names{""});
    set.Remove(nullptr);
    EXPECT_TRUE(set.IsEmpty());
}

TEST(StringSet, OnlyAsciiLettersHaveCase) {
    StringSet set;
    set.Add("\xC4");
    EXPECT_FALSE(set.IContains("\xE4"));
    set.Add("@[`{");
    EXPECT_FALSE(set.IContains("`{@["));
}

TEST(StringSet, ABucketIsWalkedFirstThirdSecond) {
    StringSet set;
    for (const std::string& name : MakeCollidingNames(3)) {
        set.Add(name);
    }
    const std::vector<std::string> names = MakeCollidingNames(3);
    EXPECT_EQ(NamesOf(set), (Names{names[0], names[2], names[1]}));
}

TEST(StringSet, BucketsAreWalkedInAscendingOrder) {
    // A name of one character c falls into bucket (5381 * 33 + c) mod 193 = 13 + c.
    StringSet set;
    for (const char* name : {"c", "a", "b", "A", "z"}) {
        set.Add(name);
    }
    EXPECT_EQ(NamesOf(set), (Names{"A", "a", "b", "c", "z"}));
}

TEST(StringSet, HashesBytesAsSignedCharacters) {
    // As signed bytes these fall 256 buckets below where they would fall as unsigned ones.
    Pair pair;
    for (const char* name : {"\x80", "a", "\xFF", "\xFFz", "z", "a\x80", "\x90\x91"}) {
        pair.Add(name);
    }
    EXPECT_EQ(NamesOf(pair.set), pair.slow.Walk());
}

TEST(StringSet, GrowthReversesABucket) {
    Pair pair;
    const std::vector<std::string> names = MakeCollidingNames(4);
    for (const std::string& name : names) {
        pair.Add(name);
    }
    EXPECT_EQ(NamesOf(pair.set), (Names{names[0], names[3], names[2], names[1]}));
    const unsigned hash = Support::SlowNameTable::Hash(names[0]);
    for (int i = 0; i < 190; ++i) {
        pair.Add("n" + std::to_string(i));
    }
    ASSERT_EQ(NamesOf(pair.set), pair.slow.Walk());
    Names together;
    for (const std::string& name : NamesOf(pair.set)) {
        if (Support::SlowNameTable::Hash(name) == hash) {
            together.push_back(name);
        }
    }
    EXPECT_EQ(together, (Names{names[1], names[2], names[3], names[0]}));
}

TEST(StringSet, AddingAPresentNameNeverGrowsTheTable) {
    Pair pair;
    for (const std::string& name : MakeCollidingNames(193)) {
        pair.Add(name);
    }
    const Names before = NamesOf(pair.set);
    EXPECT_EQ(before, pair.slow.Walk());
    pair.Add(before.front());
    EXPECT_EQ(NamesOf(pair.set), before);
    pair.Add("one more");
    EXPECT_NE(NamesOf(pair.set), before);
    EXPECT_EQ(NamesOf(pair.set), pair.slow.Walk());
}

/// Order at every size, past every growth up to 3079 buckets.
void ExpectSameOrderWhileGrowing(const std::vector<std::string>& names) {
    Pair pair;
    for (const std::string& name : names) {
        pair.Add(name);
        ASSERT_EQ(NamesOf(pair.set), pair.slow.Walk()) << "after " << name;
    }
}

TEST(StringSet, OrderOfNumberedNamesBeyondEachGrowth) {
    std::vector<std::string> names;
    for (int i = 0; i < 1000; ++i) {
        names.push_back("SIG_" + std::to_string(i * 7919 % 100003));
    }
    ExpectSameOrderWhileGrowing(names);
}

TEST(StringSet, OrderOfCollidingNamesBeyondEachGrowth) {
    ExpectSameOrderWhileGrowing(MakeCollidingNames(800));
}

TEST(StringSet, OrderOfAllShortNamesOfNastyCharacters) {
    Pair pair;
    Support::ForEachText("aA0_\x7F\x80\xFF (", 4, [&](const std::string& name) { pair.Add(name); });
    EXPECT_EQ(NamesOf(pair.set), pair.slow.Walk());
    EXPECT_GT(NamesOf(pair.set).size(), 6151u);
}

TEST(StringSet, OrderOfAHundredThousandNames) {
    Pair pair;
    for (int i = 0; i < 100000; ++i) {
        pair.Add("net_" + std::to_string(i));
    }
    EXPECT_TRUE(NamesOf(pair.set) == pair.slow.Walk());
}

TEST(StringSet, RemovalAndEmptyingNeverShrinkTheTable) {
    Pair pair;
    for (int i = 0; i < 500; ++i) {
        pair.Add("n" + std::to_string(i));
    }
    for (int i = 3; i < 500; ++i) {
        pair.Remove("n" + std::to_string(i));
    }
    EXPECT_EQ(NamesOf(pair.set), pair.slow.Walk());
    for (const std::string& name : MakeCollidingNames(100)) {
        pair.Add(name);
    }
    EXPECT_EQ(NamesOf(pair.set), pair.slow.Walk());
    pair.Empty();
    for (int i = 100; i > 0; --i) {
        pair.Add("n" + std::to_string(i));
    }
    EXPECT_EQ(NamesOf(pair.set), pair.slow.Walk());
}

TEST(StringSet, OrderOfFewNamesWhereOnceWereMany) {
    Pair pair;
    for (int i = 0; i < 30000; ++i) {
        pair.Add("n" + std::to_string(i));
    }
    pair.Empty();
    EXPECT_EQ(pair.slow.Walk(), Names());
    for (int i = 0; i < 1500; ++i) {
        // The names crowd together here and there.
        pair.Add("m" + std::to_string(i * i % 1009));
        pair.Add(MakeCollidingNames(1)[0] + static_cast<char>('a' + i % 26));
        if (i % 3 == 0) {
            pair.Remove("m" + std::to_string(i * 7 % 1009));
        }
        ASSERT_EQ(NamesOf(pair.set), pair.slow.Walk()) << i;
    }
}

TEST(StringSet, FewNamesTakeLittleTimeWhereOnceWereMany) {
    // This name's bucket is one of the last; to look through the empty ones before it each time
    // would take half an hour.
    StringSet set;
    for (int i = 0; i < 800000; ++i) {
        set.Add("n" + std::to_string(i));
    }
    set.Empty();
    set.Add("x");
    for (int i = 0; i < 2000000; ++i) {
        set.Add("last999");
        set.Remove("last999");
    }
    EXPECT_EQ(NamesOf(set), Names{"x"});
}

TEST(StringSet, CopiesKeepBucketCountAndOrder) {
    Pair original;
    for (int i = 0; i < 400; ++i) {
        original.Add("n" + std::to_string(i));
    }
    for (int i = 5; i < 400; ++i) {
        original.Remove("n" + std::to_string(i));
    }
    Pair copy = original;
    EXPECT_EQ(NamesOf(copy.set), NamesOf(original.set));
    for (const std::string& name : MakeCollidingNames(50)) {
        copy.Add(name);
        copy.Add("x" + name);
    }
    EXPECT_EQ(NamesOf(copy.set), copy.slow.Walk());
    EXPECT_EQ(NamesOf(original.set), original.slow.Walk());

    Pair assigned;
    assigned.Add("old");
    assigned = original;
    EXPECT_FALSE(assigned.set.IContains("OLD"));
    EXPECT_EQ(NamesOf(assigned.set), original.slow.Walk());
    assigned.Add("new");
    EXPECT_EQ(NamesOf(assigned.set), assigned.slow.Walk());
}

TEST(StringSet, CopiesKeepWhatEmptyLeft) {
    StringSet set;
    set.Add("Clk");
    set.Empty();
    const StringSet copy(set);
    EXPECT_TRUE(copy.IContains("CLK"));
    EXPECT_TRUE(copy.IsEmpty());
}

TEST(StringSet, AssignmentToItselfChangesNothing) {
    StringSet set;
    set.Add("b");
    set.Add("a");
    StringSet& same = set;
    StringSetIterator at = set.GetBeginPos();
    set = same;
    EXPECT_EQ(NamesOf(set), (Names{"a", "b"}));
    ASSERT_EQ(at, set.GetBeginPos()) << "positions stay valid";
    EXPECT_EQ(++at, ++set.GetBeginPos());
    StringSet empty;
    set = empty;
    EXPECT_TRUE(set.IsEmpty());
    EXPECT_FALSE(set.IContains("a"));
}

TEST(StringSet, AddingANameOfItsOwnIsSafe) {
    StringSet set;
    set.Add("a");
    set.Add(set.GetBeginPos().GetView());
    EXPECT_EQ(NamesOf(set), Names{"a"});
    set.Remove(NamesOf(set).front().c_str());
    EXPECT_TRUE(set.IsEmpty());
}

TEST(StringSet, TakesANameOfAMillionCharacters) {
    StringSet set;
    const std::string name(1000000, 'x');
    set.Add(name.c_str());
    EXPECT_TRUE(set.Contains(name));
    EXPECT_TRUE(set.IContains(std::string(1000000, 'X')));
    EXPECT_FALSE(set.Contains(std::string(999999, 'x')));
}

TEST(StringSetIterator, TheEndYieldsTheEmptyTextAndStaysTheEnd) {
    StringSetIterator end;
    EXPECT_EQ(*end, "");
    EXPECT_EQ(end.GetView(), "");
    ++end;
    end++;
    EXPECT_EQ(end, StringSetIterator());
    StringSet set;
    set.Add("a");
    EXPECT_EQ(end, set.GetEndPos());
    EXPECT_NE(set.GetBeginPos(), set.GetEndPos());
}

TEST(StringSetIterator, WalksEachNameOnce) {
    StringSet set;
    set.Add("b");
    set.Add("a");
    StringSetIterator at = set.GetBeginPos();
    EXPECT_EQ(*at, "a");
    StringSetIterator copy(at);
    EXPECT_EQ(copy, at);
    at++;
    EXPECT_NE(copy, at);
    EXPECT_EQ(*at, "b");
    EXPECT_EQ(*copy, "a");
    EXPECT_EQ(++at, set.GetEndPos());
    copy = at;
    EXPECT_EQ(copy, set.GetEndPos());
}

TEST(StringSetIterator, GivesACopyOfTheName) {
    Port::String name;
    {
        StringSet set;
        set.Add("long enough to live in memory of its own");
        name = *set.GetBeginPos();
    }
    EXPECT_EQ(name, "long enough to live in memory of its own");
}

static_assert(std::input_iterator<StringSetIterator>);
static_assert(std::sentinel_for<StringSetIterator, StringSetIterator>);
static_assert(std::forward_iterator<StringSet::Cursor>);
static_assert(std::ranges::forward_range<const StringSet>);
static_assert(std::ranges::common_range<StringSet>);

TEST(StringSet, IsARange) {
    StringSet set;
    set.Add("b");
    set.Add("a name that is too long to stand in its object");
    set.Add("a");
    const Support::Names expected = Support::NamesOf(set);
    Support::Names names;
    for (const std::string_view name : set) {
        names.emplace_back(name);
    }
    EXPECT_EQ(names, expected);
    names.clear();
    for (const Port::String& name : set) {
        names.emplace_back(name.GetView());
    }
    EXPECT_EQ(names, expected);
    EXPECT_EQ(Support::Names(set.begin(), set.end()), expected);
    EXPECT_EQ(std::ranges::count(set, "a"), 1);
#if !defined(__clang__) || __clang_major__ >= 16
    // Earlier versions of Clang cannot compile the views of GCC's library.
    const std::ranges::subrange copies(set.GetBeginPos(), set.GetEndPos());
    EXPECT_EQ(std::ranges::count_if(copies, [](const Port::String& name) { return name == "b"; }),
              1);
#endif
    auto at = set.begin();
    EXPECT_EQ(*at++, expected[0]);
    EXPECT_EQ(*at, expected[1]);
    EXPECT_NE(at, set.begin());
    EXPECT_EQ(std::distance(at, set.end()), 2);
    EXPECT_EQ(*set.end(), "");
    EXPECT_EQ(StringSet().begin(), StringSet().end());
}

TEST(StringSet, RemovesWhateverItAdds) {
    StringSet set;
    const std::string name("ab");
    set.Add(std::string_view(name).substr(0, 1));
    set.Add(name);
    set.Add(Port::String("c"));
    set.Add(nullptr);
    set.Add(std::string_view("\0", 1));
    set.Remove(std::string_view(name).substr(0, 1));
    set.Remove(name);
    set.Remove(Port::String("c"));
    set.Remove(nullptr);
    EXPECT_FALSE(set.IsEmpty());
    set.Remove(std::string_view("\0", 1));
    EXPECT_TRUE(set.IsEmpty());
    EXPECT_FALSE(set.IContains(name));
}

TEST(StringSet, RemovesANameOfItsOwn) {
    StringSet set;
    set.Add("a name that is too long to stand in its object");
    set.Remove(*set.begin());
    EXPECT_TRUE(set.IsEmpty());
}

RC_GTEST_PROP(StringSet, BehavesAsItsSlowDouble, ()) {
    const auto names = rc::gen::oneOf(
        rc::gen::container<std::string>(rc::gen::elementOf(std::string("abAB_\xE4\xC4"))),
        rc::gen::map(rc::gen::inRange(0, 600), [](int i) { return "n" + std::to_string(i); }));
    const auto calls =
        *rc::gen::scale(8.0, rc::gen::container<std::vector<std::pair<int, std::string>>>(
                                 rc::gen::pair(rc::gen::inRange(0, 40), names)));
    Pair pair;
    for (const auto& [call, name] : calls) {
        if (call == 0) {
            pair.Empty();
        } else if (call == 1) {
            Pair copy(pair);
            pair = copy;
        } else if (call < 10) {
            pair.Remove(name);
        } else {
            pair.Add(name);
        }
        RC_ASSERT(pair.set.Contains(name) == pair.slow.Contains(name));
        RC_ASSERT(pair.set.IContains(name) == pair.slow.IContains(name));
        RC_ASSERT(pair.set.IsEmpty() == pair.slow.IsEmpty());
    }
    RC_ASSERT(NamesOf(pair.set) == pair.slow.Walk());
}

} // namespace
