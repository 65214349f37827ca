#include "Orn_Hdl/Model.h"

#include "Support/Names.h"
#include "Support/ShortTexts.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <climits>
#include <optional>
#include <regex>
#include <string>
#include <vector>

namespace {

using namespace Orn_Hdl;
using Support::Names;
using Support::NamesOf;
using Support::Text;

const std::string BaseName = "[A-Za-z'_][A-Za-z0-9_]*";
const std::string Integer = "[+-]?[0-9]+";

const std::regex& BaseNamePattern() {
    static const std::regex pattern(BaseName);
    return pattern;
}
const std::regex& IntegerPattern() {
    static const std::regex pattern(Integer);
    return pattern;
}
const std::regex& BusPattern() {
    static const std::regex pattern("(" + BaseName + ")\\((" + Integer + "):(" + Integer + ")\\)");
    return pattern;
}
const std::regex& BitPattern() {
    static const std::regex pattern("(" + BaseName + ")\\((" + Integer + ")\\)");
    return pattern;
}

/// The capture groups of a match of the whole text.
std::optional<Names> Match(const std::string& text, const std::regex& pattern) {
    std::smatch match;
    if (!std::regex_match(text, match, pattern)) {
        return std::nullopt;
    }
    Names groups;
    for (std::size_t i = 1; i < match.size(); ++i) {
        groups.push_back(match[i].str());
    }
    return groups;
}

/// The pieces between "," and "\", without empty ones.
Names SplitCompound(const std::string& text) {
    Names pieces(1);
    for (const char c : text) {
        if (c == ',' || c == '\\') {
            pieces.emplace_back();
        } else {
            pieces.back() += c;
        }
    }
    std::erase(pieces, "");
    return pieces;
}

bool IsCompoundSlowly(const std::string& text) {
    const Names pieces = SplitCompound(text);
    for (const std::string& piece : pieces) {
        if (!Match(piece, BaseNamePattern()) && !Match(piece, BusPattern()) &&
            !Match(piece, BitPattern())) {
            return false;
        }
    }
    return pieces.size() > 1;
}

std::string NormalizeSlowly(std::string text) {
    text = std::regex_replace(text, std::regex("[\\[{<]"), "(");
    text = std::regex_replace(text, std::regex("[\\]}>]"), ")");
    return std::regex_replace(text, std::regex("-"), ":");
}

Names BitsSlowly(const std::string& base, long left, long right) {
    Names bits;
    for (long i = left;; i += left >= right ? -1 : 1) {
        bits.push_back(base + "(" + std::to_string(i) + ")");
        if (i == right) {
            return bits;
        }
    }
}

void ExpectRulesHold(const std::string& text) {
    ASSERT_EQ(Object::IsValidBaseName(text.c_str()), Match(text, BaseNamePattern()).has_value())
        << text;
    ASSERT_EQ(Object::IsValidIntegerString(text.c_str()), Match(text, IntegerPattern()).has_value())
        << text;

    const std::optional<Names> bus = Match(text, BusPattern());
    ASSERT_EQ(Bus::IsBusName(text.c_str()), bus.has_value()) << text;
    Port::String base("b");
    Port::String left("l");
    Port::String right("r");
    ASSERT_EQ(Bus::ParseBusName(text.c_str(), base, left, right), bus.has_value()) << text;
    ASSERT_EQ((Names{Text(base), Text(left), Text(right)}), bus.value_or(Names{"b", "l", "r"}))
        << text;
    int leftNumber = 77;
    int rightNumber = 78;
    base = "b";
    ASSERT_EQ(Bus::ParseBusName(text.c_str(), base, leftNumber, rightNumber), bus.has_value());
    ASSERT_EQ(base, bus ? bus->at(0).c_str() : "b") << text;
    ASSERT_EQ(leftNumber, bus ? std::stoi(bus->at(1)) : 77) << text;
    ASSERT_EQ(rightNumber, bus ? std::stoi(bus->at(2)) : 78) << text;
    StringArray bits;
    bits.Add("old");
    ASSERT_EQ(Bus::ParseBusName(text.c_str(), bits), bus.has_value()) << text;
    Names expectedBits{"old"};
    if (bus) {
        for (const std::string& bit :
             BitsSlowly(bus->at(0), std::stoi(bus->at(1)), std::stoi(bus->at(2)))) {
            expectedBits.push_back(bit);
        }
    }
    ASSERT_EQ(NamesOf(bits), expectedBits) << text;

    const std::optional<Names> bit = Match(text, BitPattern());
    ASSERT_EQ(BusIndex::IsBusIndexName(text.c_str()), bit.has_value()) << text;
    Port::String bitBase("b");
    Port::String index("i");
    ASSERT_EQ(BusIndex::ParseBusIndexName(text.c_str(), bitBase, index), bit.has_value()) << text;
    ASSERT_EQ((Names{Text(bitBase), Text(index)}), bit.value_or(Names{"b", "i"})) << text;
    int indexNumber = 77;
    ASSERT_EQ(BusIndex::ParseBusIndexName(text.c_str(), bitBase, indexNumber), bit.has_value());
    ASSERT_EQ(indexNumber, bit ? std::stoi(bit->at(1)) : 77) << text;

    ASSERT_EQ(CompoundBus::IsCompoundBusName(text.c_str()), IsCompoundSlowly(text)) << text;
}

void ExpectNormalised(const std::string& text) {
    const std::string normal = NormalizeSlowly(text);
    Port::String name(text.c_str());
    Object::NormalizeName(name);
    ASSERT_EQ(name, normal.c_str()) << text;
    const bool cut = normal.find('(') != std::string::npos &&
                     normal.find(')') != std::string::npos && normal.find(',') == std::string::npos;
    ASSERT_EQ(Object::GetBaseName(text.c_str()),
              (cut ? normal.substr(0, normal.find('(')) : normal).c_str())
        << text;
}

TEST(NameRules, EveryCharacterIsNormalisedAtEveryPlace) {
    for (int c = 1; c < 256; ++c) {
        const std::string normal = NormalizeSlowly(std::string(1, static_cast<char>(c)));
        for (std::size_t size = 1; size <= 18; ++size) {
            for (std::size_t place = 0; place < size; ++place) {
                const std::string before(place, 'n');
                const std::string behind(size - place - 1, 'n');
                Port::String name((before + static_cast<char>(c) + behind).c_str());
                Object::NormalizeName(name);
                ASSERT_EQ(name, (before + normal + behind).c_str()) << c;
            }
        }
    }
}

TEST(NameRules, HoldForAllShortTexts) {
    Support::ForEachText("A1(:),+", 6, ExpectRulesHold);
}

TEST(NameRules, HoldForAllShortTextsOfRareCharacters) {
    Support::ForEachText("a_'0- \\,[\x80", 4, ExpectRulesHold);
}

TEST(NameRules, HoldForAllEndingsOfABus) {
    Support::ForEachText("0+-:)(x", 5, [](const std::string& text) {
        ExpectRulesHold("D(" + text);
        ExpectRulesHold("D(1:" + text);
    });
}

TEST(NameRules, HoldForAllShortCompounds) {
    const std::vector<std::string> tokens{"A", ",", "\\", "B(3:0)", "K(2)", "'", "1", "(", " "};
    std::vector<std::string> texts{""};
    for (std::size_t first = 0, length = 0; length < 5; ++length) {
        const std::size_t end = texts.size();
        for (; first < end; ++first) {
            for (const std::string& token : tokens) {
                texts.push_back(texts[first] + token);
            }
        }
    }
    for (const std::string& text : texts) {
        ASSERT_EQ(CompoundBus::IsCompoundBusName(text.c_str()), IsCompoundSlowly(text)) << text;
        StringArray names;
        ASSERT_TRUE(CompoundBus::ParseCompoundBusName(text.c_str(), names, false));
        ASSERT_EQ(NamesOf(names), SplitCompound(text)) << text;
    }
}

TEST(NameRules, NormaliseAllShortTexts) {
    Support::ForEachText("a[]{}<>()-,:", 4, ExpectNormalised);
}

TEST(NameRules, ReadNullAsTheEmptyText) {
    EXPECT_FALSE(Object::IsValidBaseName(nullptr));
    EXPECT_FALSE(Bus::IsBusName(nullptr));
    EXPECT_FALSE(BusIndex::IsBusIndexName(nullptr));
    EXPECT_FALSE(CompoundBus::IsCompoundBusName(nullptr));
    EXPECT_EQ(Object::GetBaseName(nullptr), "");
    StringArray names;
    EXPECT_FALSE(Bus::ParseBusName(nullptr, names));
    EXPECT_TRUE(CompoundBus::ParseCompoundBusName(nullptr, names, true));
    EXPECT_TRUE(names.IsEmpty());
}

TEST(NameRules, KnowOnlyTheFormInParentheses) {
    EXPECT_FALSE(Bus::IsBusName("A[7:0]"));
    EXPECT_FALSE(Bus::IsBusName("A<7:0>"));
    EXPECT_FALSE(BusIndex::IsBusIndexName("A[7]"));
    EXPECT_FALSE(Bus::IsBusName("A(7:0)x"));
    EXPECT_FALSE(Bus::IsBusName("A(7)"));
    EXPECT_TRUE(Bus::IsBusName("A(0:7)"));
    EXPECT_FALSE(Bus::IsBusName("A):(1"));
}

TEST(NameRules, ExpandABusFromLeftToRight) {
    const auto bitsOf = [](const char* name) {
        StringArray bits;
        EXPECT_TRUE(Bus::ParseBusName(name, bits)) << name;
        return NamesOf(bits);
    };
    EXPECT_EQ(bitsOf("D(2:0)"), (Names{"D(2)", "D(1)", "D(0)"}));
    EXPECT_EQ(bitsOf("D(0:2)"), (Names{"D(0)", "D(1)", "D(2)"}));
    EXPECT_EQ(bitsOf("D(3:3)"), Names{"D(3)"});
    EXPECT_EQ(bitsOf("D(+01:-1)"), (Names{"D(1)", "D(0)", "D(-1)"}));
    EXPECT_EQ(bitsOf("D(2147483647:2147483646)"), (Names{"D(2147483647)", "D(2147483646)"}));
    EXPECT_EQ(bitsOf("D(-2147483648:-2147483647)"), (Names{"D(-2147483648)", "D(-2147483647)"}));
}

TEST(NameRules, ExpandOfACompoundItsBusesOnly) {
    const auto namesOf = [](const char* name, bool expand) {
        StringArray names;
        EXPECT_TRUE(CompoundBus::ParseCompoundBusName(name, names, expand));
        return NamesOf(names);
    };
    EXPECT_EQ(namesOf("A,B(3:2),K(2)", false), (Names{"A", "B(3:2)", "K(2)"}));
    EXPECT_EQ(namesOf("A,B(3:2),K(2)", true), (Names{"A", "B(3)", "B(2)", "K(2)"}));
    EXPECT_EQ(namesOf("A\\B(0:1),C\\D", true), (Names{"A", "B(0)", "B(1)", "C", "D"}));
    EXPECT_EQ(namesOf(",A,,\\B\\", false), (Names{"A", "B"}));
    EXPECT_EQ(namesOf("A", true), Names{"A"});
}

TEST(NameRules, SaturateIndices) {
    Port::String base;
    int left = 0;
    int right = 0;
    EXPECT_TRUE(Bus::ParseBusName("D(99999999999999999999:-99999999999)", base, left, right));
    EXPECT_EQ(left, INT_MAX);
    EXPECT_EQ(right, INT_MIN);
    int index = 0;
    EXPECT_TRUE(BusIndex::ParseBusIndexName("D(4294967296)", base, index));
    EXPECT_EQ(index, INT_MAX);
}

TEST(NameRules, RefuseToExpandMoreThanAMillionBits) {
    StringArray bits;
    bits.Add("old");
    EXPECT_FALSE(Bus::ParseBusName("D(1048576:0)", bits));
    EXPECT_FALSE(Bus::ParseBusName("D(0:2147483647)", bits));
    EXPECT_FALSE(Bus::ParseBusName("D(2147483647:-2147483648)", bits));
    EXPECT_FALSE(CompoundBus::ParseCompoundBusName("A,D(1048576:0),B", bits, true));
    EXPECT_EQ(NamesOf(bits), Names{"old"});
    EXPECT_TRUE(CompoundBus::ParseCompoundBusName("A,D(1048576:0),B", bits, false));
    EXPECT_EQ(NamesOf(bits), (Names{"old", "A", "D(1048576:0)", "B"}));

    StringArray most;
    EXPECT_TRUE(Bus::ParseBusName("D(1048575:0)", most));
    EXPECT_EQ(most.GetSize(), 1048576);
    EXPECT_EQ(most.GetAt(0), "D(1048575)");
    EXPECT_EQ(most.GetAt(1048575), "D(0)");
}

TEST(NameRules, TakeNamesOfAMillionCharacters) {
    const std::string base(1000000, 'a');
    const std::string digits(1000000, '1');
    EXPECT_TRUE(Object::IsValidBaseName(base.c_str()));
    EXPECT_FALSE(Object::IsValidBaseName((base + "-").c_str()));
    EXPECT_TRUE(Object::IsValidIntegerString(digits.c_str()));
    EXPECT_TRUE(Bus::IsBusName((base + "(" + digits + ":" + digits + ")").c_str()));
    EXPECT_TRUE(BusIndex::IsBusIndexName((base + "(" + digits + ")").c_str()));
    std::string compound;
    for (int i = 0; i < 300000; ++i) {
        compound += "a(1),";
    }
    EXPECT_TRUE(CompoundBus::IsCompoundBusName(compound.c_str()));
    EXPECT_FALSE(CompoundBus::IsCompoundBusName((compound + "(").c_str()));
    StringArray names;
    EXPECT_TRUE(CompoundBus::ParseCompoundBusName(compound.c_str(), names, true));
    EXPECT_EQ(names.GetSize(), 300000);
}

TEST(BusSliceName, IsAPieceOfABusInItsOwnDirection) {
    EXPECT_EQ(Bus::GetBusSliceName("D(7:0)", 0, 4), "D(7:4)");
    EXPECT_EQ(Bus::GetBusSliceName("D(7:0)", 4, 4), "D(3:0)");
    EXPECT_EQ(Bus::GetBusSliceName("D(0:7)", 2, 1), "D(2:2)");
    EXPECT_EQ(Bus::GetBusSliceName("D(0:7)", 1, 3), "D(1:3)");
    EXPECT_EQ(Bus::GetBusSliceName("D(3:3)", 0, 1), "D(3:3)");
}

TEST(BusSliceName, OfAnyOtherNameIsTheNameWithBothNumbers) {
    EXPECT_EQ(Bus::GetBusSliceName("D", 7, 0), "D(7:0)");
    EXPECT_EQ(Bus::GetBusSliceName("D(3)", 1, 2), "D(3)(1:2)");
    EXPECT_EQ(Bus::GetBusSliceName("", -1, INT_MIN), "(-1:-2147483648)");
    EXPECT_EQ(Bus::GetBusSliceName(nullptr, 1, 0), "(1:0)");
    EXPECT_EQ(Bus::GetBusSliceName("D[7:0]", 0, 4), "D[7:0](0:4)");
}

TEST(BusSliceName, TakesAnyNumbers) {
    for (const char* name : {"D(7:0)", "D(0:7)", "D(2147483647:-2147483648)",
                             "D(-2147483648:2147483647)", "D(999999999999:0)"}) {
        for (const int start : {INT_MIN, -1, 0, 1, INT_MAX}) {
            for (const int count : {INT_MIN, -1, 0, 1, INT_MAX}) {
                EXPECT_EQ(Text(Bus::GetBusSliceName(name, start, count)).rfind("D(", 0), 0u);
            }
        }
    }
}

RC_GTEST_PROP(NameRules, HoldForAnyTexts, ()) {
    const auto pieces = *rc::gen::container<std::vector<std::string>>(rc::gen::element<std::string>(
        "D", "d_1", "'", "(", ")", ":", "7", "-12", "+0", ",", "\\", " ", "[", "]", "\xFF"));
    std::string text;
    for (const std::string& piece : pieces) {
        text += piece;
    }
    if (std::regex_search(text, std::regex("[0-9]{4}"))) {
        return; // the slow rules expand every bus
    }
    ExpectRulesHold(text);
    ExpectNormalised(text);
    RC_ASSERT(!testing::Test::HasFailure());
}

} // namespace
