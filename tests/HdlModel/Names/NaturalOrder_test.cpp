#include "Orn_Hdl/Model.h"

#include "Support/Names.h"
#include "Support/ShortTexts.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <algorithm>
#include <cstddef>
#include <limits>
#include <memory>
#include <string>
#include <vector>

namespace {

using namespace Orn_Hdl;
using Support::Names;
using Support::NamesOf;

/// A name cut into digit runs and single characters in upper case.
std::vector<std::string> Cut(const std::string& name) {
    std::vector<std::string> pieces;
    bool inRun = false;
    for (const char c : name) {
        const bool digit = c >= '0' && c <= '9';
        if (digit && inRun) {
            pieces.back() += c;
        } else {
            pieces.emplace_back(1, c >= 'a' && c <= 'z' ? static_cast<char>(c - 32) : c);
        }
        inRun = digit;
    }
    return pieces;
}

bool IsRun(const std::string& piece) {
    return piece[0] >= '0' && piece[0] <= '9';
}

/// Natural order, computed piece by piece: a digit run sorts after every other character, a longer
/// run after a shorter one, and the end of a name before everything.
bool IsLessSlowly(const std::string& nameA, const std::string& nameB) {
    const std::vector<std::string> a = Cut(nameA);
    const std::vector<std::string> b = Cut(nameB);
    for (std::size_t i = 0; i < a.size() && i < b.size(); ++i) {
        if (a[i] == b[i]) {
            continue;
        }
        if (IsRun(a[i]) != IsRun(b[i])) {
            return IsRun(b[i]);
        }
        if (a[i].size() != b[i].size()) {
            return a[i].size() < b[i].size();
        }
        return a[i] < b[i];
    }
    return a.size() < b.size();
}

Names SortedAsInstances(const Names& names) {
    Netlist netlist("top");
    for (const std::string& name : names) {
        netlist.Add(new Instance(name.c_str(), nullptr));
    }
    netlist.SortNetlist();
    return NamesOf(netlist.GetInstanceIterator());
}

Names SortedAsComponents(const Names& names) {
    Netlist netlist("top");
    for (const std::string& name : names) {
        netlist.Add(new Component(name.c_str()));
    }
    netlist.SortNetlist();
    return NamesOf(netlist.GetComponentIterator());
}

Names SortedAsSignals(const Names& names) {
    Netlist netlist("top");
    for (const std::string& name : names) {
        netlist.Add(new ScalarSignal(name.c_str()));
    }
    netlist.SortNetlist();
    return NamesOf(netlist.GetSignalIterator());
}

Names SortedAsPins(const Names& names) {
    Component component("C");
    for (const std::string& name : names) {
        component.AddPin(name.c_str(), Polarity("in"), "");
    }
    Instance instance("U", &component);
    instance.SortPinName();
    return NamesOf(instance.GetPinIterator());
}

Names SortedSlowly(Names names) {
    std::stable_sort(names.begin(), names.end(), IsLessSlowly);
    return names;
}

TEST(NaturalOrder, SortsNumbersByTheirValue) {
    EXPECT_EQ(SortedAsInstances({"U10", "U2", "U1"}), (Names{"U1", "U2", "U10"}));
}

TEST(NaturalOrder, ADigitStandsAboveEveryOtherCharacter) {
    EXPECT_EQ(SortedAsInstances({"A1", "A_B", "Az", "A\xFF", "A"}),
              (Names{"A", "Az", "A_B", "A\xFF", "A1"}));
}

TEST(NaturalOrder, ALongerRunOfDigitsIsGreaterWhateverItsValue) {
    EXPECT_EQ(SortedAsInstances({"A01", "A9", "A1", "A001", "A10"}),
              (Names{"A1", "A9", "A01", "A10", "A001"}));
}

TEST(NaturalOrder, TheEndOfANameStandsBelowEverything) {
    EXPECT_EQ(SortedAsInstances({"ab", "a ", "a\x01", "a", ""}),
              (Names{"", "a", "a\x01", "a ", "ab"}));
}

TEST(NaturalOrder, NamesThatDifferInCaseKeepTheirOrder) {
    EXPECT_EQ(SortedAsInstances({"b1", "a", "A", "B1", "a", "B1"}),
              (Names{"a", "A", "a", "b1", "B1", "B1"}));
    EXPECT_EQ(SortedAsPins({"B", "b", "A"}), (Names{"A", "B", "b"}));
}

TEST(NaturalOrder, BytesCompareUnsigned) {
    EXPECT_EQ(SortedAsSignals({"\xFF", "\x80", "z", "\x7F"}), (Names{"z", "\x7F", "\x80", "\xFF"}));
}

TEST(NaturalOrder, LettersFoldToUpperCase) {
    // "_" stands between the upper-case and the lower-case letters.
    EXPECT_EQ(SortedAsSignals({"_", "a", "B"}), (Names{"a", "B", "_"}));
}

TEST(NaturalOrder, AgreesWithASlowOrderOnAllShortNames) {
    Names names;
    Support::ForEachText("10a_B9\xC4", 4, [&](const std::string& name) { names.push_back(name); });
    std::reverse(names.begin(), names.end());
    const Names expected = SortedSlowly(names);
    EXPECT_TRUE(SortedAsInstances(names) == expected);
    EXPECT_TRUE(SortedAsComponents(names) == expected);
    EXPECT_TRUE(SortedAsSignals(names) == expected);
    EXPECT_TRUE(SortedAsPins(names) == expected);
}

TEST(NaturalOrder, AgreesWithASlowOrderOnLongNames) {
    for (const std::string& beginning :
         {std::string("abcdefg"), std::string("abcdefghijklm"), std::string("a12345678901"),
          std::string(300, '7'), "x" + std::string(17, '0')}) {
        Names names;
        Support::ForEachText("10aB_", 3,
                             [&](const std::string& name) { names.push_back(beginning + name); });
        std::reverse(names.begin(), names.end());
        EXPECT_TRUE(SortedAsInstances(names) == SortedSlowly(names)) << beginning;
    }
}

TEST(NaturalOrder, AgreesWithASlowOrderOnGroupsOfLongNames) {
    const std::string unfoldable(3, '\xFF');
    Names names;
    for (const std::string& beginning :
         {std::string("top_of_the_design_"), std::string("Top_Of_The_Design_alu_of_core_"),
          std::string("top_of_the_design_alu_of_core_12"), "top_of_the_design_" + unfoldable,
          "top_of_the_design_" + unfoldable + "_behind_these", std::string(300, '7') + "_and_",
          std::string()}) {
        Support::ForEachText("10aB_", 3,
                             [&](const std::string& name) { names.push_back(beginning + name); });
    }
    std::reverse(names.begin(), names.end());
    const Names expected = SortedSlowly(names);
    EXPECT_TRUE(SortedAsInstances(names) == expected);
    EXPECT_TRUE(SortedAsSignals(names) == expected);
}

TEST(NaturalOrder, AgreesWithASlowOrderWhereASingleNameBeginsOtherwise) {
    Names alike;
    for (int i = 400; i > 0; --i) {
        alike.push_back("top_of_core_" + std::to_string(i));
    }
    for (const std::size_t place : {0U, 1U, 2U, 200U, 399U}) {
        for (const char* const other : {"to", "top_of", "tOP_OG_1", "top_of_core", "zero"}) {
            Names names = alike;
            names[place] = other;
            EXPECT_TRUE(SortedAsInstances(names) == SortedSlowly(names)) << other << ' ' << place;
        }
    }
}

TEST(NaturalOrder, ComesBehindTheOrderOfPolaritiesWhateverTheirValues) {
    constexpr int Least = std::numeric_limits<int>::min();
    constexpr int Most = std::numeric_limits<int>::max();
    const std::vector<int> values = {Least, -300, -3,  -2,  -1,  0,   1,
                                     2,     251,  252, 253, 254, 300, Most};
    Netlist netlist("top");
    Names expected;
    for (std::size_t i = 0; i < values.size(); ++i) {
        expected.push_back("P" + std::to_string(values.size() - i));
    }
    for (std::size_t i = values.size(); i-- > 0;) {
        auto port = std::make_unique<ScalarSignal>(expected[i].c_str());
        port->SetPortPolarity(Polarity(values[i]));
        netlist.Add(port.release());
    }
    netlist.SortNetlist();
    EXPECT_EQ(NamesOf(netlist.GetSignalIterator()), expected);
}

RC_GTEST_PROP(NaturalOrder, AgreesWithASlowOrderOnAnyNames, ()) {
    const auto names = *rc::gen::container<Names>(rc::gen::container<std::string>(
        rc::gen::elementOf(std::string("0123456789abcABC_ \xC4\x7F"))));
    RC_ASSERT(SortedAsInstances(names) == SortedSlowly(names));
    RC_ASSERT(SortedAsPins(names) == SortedSlowly(names));
}

TEST(NaturalOrder, TakesNamesOfAMillionCharacters) {
    const std::string digits(1000000, '1');
    EXPECT_TRUE(SortedAsInstances({"U" + digits + "0", "U" + digits, "U1"}) ==
                (Names{"U1", "U" + digits, "U" + digits + "0"}));
}

} // namespace
