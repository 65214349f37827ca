#include "Orn_Hdl/Containers/StringPtrMap.h"

#include "Port/String.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <map>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace {

using Map = Orn_Hdl::IStringPtrMap<int*>;

std::string Upper(std::string name) {
    for (char& c : name) {
        if (c >= 'a' && c <= 'z') {
            c = static_cast<char>(c - 32);
        }
    }
    return name;
}

TEST(StringPtrMap, ASecondSpellingReplacesThePointerOfTheOneEntry) {
    int first = 1;
    int second = 2;
    Map map;
    map.Add("Clk", &first);
    map.Add("CLK", &second);
    EXPECT_EQ(map.Get("Clk"), &second);
    EXPECT_EQ(map.Get("clk"), &second);
    map.Remove("cLK");
    EXPECT_EQ(map.Get("Clk"), nullptr);
    EXPECT_TRUE(map.IsEmpty()) << "there was one entry";
}

TEST(StringPtrMap, AnAbsentNameGivesNull) {
    Map map;
    EXPECT_TRUE(map.IsEmpty());
    EXPECT_EQ(map.Get("a"), nullptr);
    EXPECT_FALSE(map.Contains("a"));
    map.Remove("a");
    map.Empty();
    int value = 1;
    map.Add("a", &value);
    EXPECT_EQ(map.Get("ab"), nullptr);
    EXPECT_EQ(map.Get(""), nullptr);
    EXPECT_FALSE(map.IsEmpty());
}

TEST(StringPtrMap, ReadsNullAsTheEmptyName) {
    int value = 1;
    Map map;
    map.Add(static_cast<const char*>(nullptr), &value);
    EXPECT_EQ(map.Get(""), &value);
    EXPECT_TRUE(map.Contains(nullptr));
    map.Remove(nullptr);
    EXPECT_FALSE(map.Contains(""));
}

/// Calls every operation with a name of some type.
template <class Map, class Pointer, class Name>
void ExpectToTake(const Name& name, Pointer pointer) {
    Map map;
    map.Add(name, pointer);
    EXPECT_EQ(map.Get(name), pointer);
    EXPECT_TRUE(map.Contains(name));
    map.Remove(name);
    EXPECT_FALSE(map.Contains(name));
    EXPECT_TRUE(map.IsEmpty());
}

template <class Map, class Pointer> void ExpectToTakeNamesOfAnyType(Pointer pointer) {
    char characters[] = "name";
    ExpectToTake<Map>(static_cast<const char*>(characters), pointer);
    ExpectToTake<Map>(static_cast<char*>(characters), pointer);
    ExpectToTake<Map>(characters, pointer);
    ExpectToTake<Map>(std::string("name"), pointer);
    ExpectToTake<Map>(std::string_view("name"), pointer);
    ExpectToTake<Map>(Port::String("name"), pointer);
    ExpectToTake<Map>(static_cast<const char*>(nullptr), pointer);
    ExpectToTake<Map>(static_cast<char*>(nullptr), pointer);
    ExpectToTake<Map>(nullptr, pointer);
}

TEST(StringPtrMap, TakesNamesOfAnyType) {
    int value = 1;
    ExpectToTakeNamesOfAnyType<Map>(&value);
    ExpectToTakeNamesOfAnyType<Orn_Hdl::IStringPtrMapBase>(static_cast<void*>(&value));
}

TEST(StringPtrMapBase, ReadsNullAsTheEmptyName) {
    const char* const none = nullptr;
    int value = 1;
    Orn_Hdl::IStringPtrMapBase map;
    EXPECT_EQ(map.Get(none), nullptr);
    EXPECT_FALSE(map.Contains(none));
    map.Remove(none);
    map.Add(none, &value);
    EXPECT_EQ(map.Get(""), &value);
    map.Remove("");
    EXPECT_FALSE(map.Contains(none));
}

TEST(StringPtrMap, HoldsNullPointers) {
    Map map;
    map.Add("a", nullptr);
    EXPECT_TRUE(map.Contains("A"));
    EXPECT_EQ(map.Get("a"), nullptr);
}

TEST(StringPtrMap, CopiesTheNames) {
    int value = 1;
    Map map;
    {
        std::string name = "a name that is too long for its object";
        map.Add(name.c_str(), &value);
        name.assign(name.size(), 'x');
    }
    EXPECT_EQ(map.Get("A NAME THAT IS TOO LONG FOR ITS OBJECT"), &value);
}

TEST(StringPtrMap, OnlyAsciiLettersHaveCase) {
    int value = 1;
    Map map;
    map.Add("\xC4[", &value);
    EXPECT_EQ(map.Get("\xE4["), nullptr);
    EXPECT_EQ(map.Get("\xC4{"), nullptr);
    EXPECT_EQ(map.Get("\xC4["), &value);
}

TEST(StringPtrMap, CopiesHaveTheSamePointersAndGoTheirOwnWay) {
    int a = 1;
    int b = 2;
    Map map;
    map.Add("a", &a);
    Map copy(map);
    copy.Add("b", &b);
    copy.Remove("A");
    EXPECT_EQ(map.Get("a"), &a);
    EXPECT_EQ(map.Get("b"), nullptr);
    EXPECT_EQ(copy.Get("a"), nullptr);
    EXPECT_EQ(copy.Get("b"), &b);

    map = copy;
    EXPECT_EQ(map.Get("a"), nullptr);
    EXPECT_EQ(map.Get("b"), &b);
    Map& same = map;
    map = same;
    EXPECT_EQ(map.Get("b"), &b);
    map = Map();
    EXPECT_TRUE(map.IsEmpty());
    EXPECT_EQ(copy.Get("b"), &b);
}

TEST(StringPtrMap, IsUsableAfterEmptying) {
    int a = 1;
    Map map;
    map.Add("a", &a);
    map.Empty();
    EXPECT_TRUE(map.IsEmpty());
    EXPECT_EQ(map.Get("a"), nullptr);
    map.Add("a", &a);
    EXPECT_EQ(map.Get("a"), &a);
}

int* CreateNothing(const char*, const char*) {
    return nullptr;
}

TEST(StringPtrMap, HoldsFunctions) {
    using Creator = int* (*)(const char*, const char*);
    Orn_Hdl::IStringPtrMap<Creator> map;
    map.Add("String", &CreateNothing);
    EXPECT_EQ(map.Get("STRING"), &CreateNothing);
    EXPECT_EQ(map.Get("x"), nullptr);
}

TEST(StringPtrMap, FindsEveryOneOfAHundredThousandNames) {
    std::vector<int> values(100000);
    Map map;
    for (std::size_t i = 0; i < values.size(); ++i) {
        map.Add(("Net_" + std::to_string(i)).c_str(), &values[i]);
    }
    for (std::size_t i = 0; i < values.size(); i += 2) {
        map.Remove(("NET_" + std::to_string(i)).c_str());
    }
    for (std::size_t i = 0; i < values.size(); ++i) {
        ASSERT_EQ(map.Get(("net_" + std::to_string(i)).c_str()), i % 2 == 0 ? nullptr : &values[i])
            << i;
    }
}

RC_GTEST_PROP(StringPtrMap, BehavesAsAMapOfUpperCaseNames, ()) {
    const auto calls = *rc::gen::scale(
        4.0, rc::gen::container<std::vector<std::pair<int, std::string>>>(rc::gen::pair(
                 rc::gen::inRange(0, 30), rc::gen::container<std::string>(
                                              rc::gen::elementOf(std::string("abAB_\xE4\xC4"))))));
    std::vector<int> values(calls.size());
    Map map;
    std::map<std::string, int*> expected;
    for (std::size_t i = 0; i < calls.size(); ++i) {
        const auto& [call, name] = calls[i];
        if (call == 0) {
            map.Empty();
            expected.clear();
        } else if (call == 1) {
            Map copy(map);
            map = copy;
        } else if (call < 10) {
            map.Remove(name.c_str());
            expected.erase(Upper(name));
        } else {
            map.Add(name.c_str(), &values[i]);
            expected[Upper(name)] = &values[i];
        }
        RC_ASSERT(map.IsEmpty() == expected.empty());
        for (const auto& [other, pointer] : expected) {
            RC_ASSERT(map.Get(other.c_str()) == pointer);
        }
        const auto found = expected.find(Upper(name));
        RC_ASSERT(map.Contains(name.c_str()) == (found != expected.end()));
    }
}

} // namespace
