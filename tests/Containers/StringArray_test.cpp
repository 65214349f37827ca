#include "Orn_Hdl/Containers/StringArray.h"

#include "Support/Names.h"
#include "Support/ShortTexts.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <algorithm>
#include <climits>
#include <cstring>
#include <iterator>
#include <new>
#include <ostream>
#include <ranges>
#include <string>
#include <string_view>
#include <vector>

namespace {

using Orn_Hdl::StringArray;
using Support::Names;
using Support::NamesOf;

constexpr const char* CommandQuotes = "\"\"''";

StringArray Make(std::initializer_list<const char*> texts) {
    StringArray array;
    for (const char* text : texts) {
        array.Add(text);
    }
    return array;
}

Names Words(const char* text) {
    return NamesOf(StringArray(text, " ", true, CommandQuotes));
}

TEST(StringArray, StartsEmpty) {
    const StringArray array;
    EXPECT_EQ(array.GetSize(), 0);
    EXPECT_TRUE(array.IsEmpty());
    EXPECT_EQ(array.Concatenate(","), "");
    EXPECT_EQ(array.JoinFrom(0), "");
}

TEST(StringArray, ReadsOutOfRangeAsEmpty) {
    const StringArray array = Make({"a", "b"});
    for (const int i : {-1, INT_MIN, 2, INT_MAX}) {
        EXPECT_EQ(array.GetAt(i), "") << i;
        EXPECT_EQ(array[i], "") << i;
        EXPECT_EQ(array.GetView(i), "") << i;
    }
    EXPECT_EQ(array.GetAt(array.GetSize()), "");
}

TEST(StringArray, AddGivesTheIndex) {
    StringArray array;
    EXPECT_EQ(array.Add("a"), 0);
    EXPECT_EQ(array.Add(""), 1);
    EXPECT_EQ(array.Add(Port::String("c")), 2);
    EXPECT_EQ(array.Add(static_cast<const char*>(nullptr)), 3);
    EXPECT_EQ(NamesOf(array), (Names{"a", "", "c", ""}));
}

TEST(StringArray, SetAtPastTheEndFillsWithEmptySlots) {
    StringArray array;
    array.SetAt(5, "s");
    EXPECT_EQ(NamesOf(array), (Names{"", "", "", "", "", "s"}));
    array.SetAt(2, "t");
    array.SetAt(-1, "u");
    array.SetAt(INT_MIN, "u");
    EXPECT_EQ(NamesOf(array), (Names{"", "", "t", "", "", "s"}));
}

TEST(StringArray, SetAtReplacesByLongerAndShorterTexts) {
    StringArray array = Make({"aa", "bb", "cc"});
    array.SetAt(1, "a much longer text");
    EXPECT_EQ(NamesOf(array), (Names{"aa", "a much longer text", "cc"}));
    array.SetAt(1, "");
    array.SetAt(0, "x");
    EXPECT_EQ(NamesOf(array), (Names{"x", "", "cc"}));
}

TEST(StringArray, TakesTextsOfItsOwn) {
    StringArray array = Make({"first text", "second text"});
    array.SetAt(0, array.GetAt(1));
    array.Add(array.GetAt(0));
    array.Add(array);
    EXPECT_EQ(NamesOf(array), (Names{"second text", "second text", "second text", "second text",
                                     "second text", "second text"}));
}

TEST(StringArray, CopiesElementByElement) {
    StringArray array = Make({"a", "b"});
    array.SetAt(4, "e");
    StringArray copy(array);
    copy.SetAt(0, "x");
    EXPECT_EQ(NamesOf(array), (Names{"a", "b", "", "", "e"}));
    EXPECT_EQ(NamesOf(copy), (Names{"x", "b", "", "", "e"}));
    array = copy;
    EXPECT_EQ(NamesOf(array), NamesOf(copy));
    StringArray& same = array;
    array = same;
    EXPECT_EQ(NamesOf(array), NamesOf(copy));
    array = StringArray();
    EXPECT_TRUE(array.IsEmpty());
}

TEST(StringArray, IsUsableAfterEmptying) {
    StringArray array = Make({"a", "b"});
    array.Empty();
    EXPECT_EQ(array.GetSize(), 0);
    EXPECT_EQ(array.GetAt(0), "");
    array.SetAt(1, "c");
    EXPECT_EQ(NamesOf(array), (Names{"", "c"}));
}

TEST(StringArray, ReadsWholeNumbers) {
    const StringArray array =
        Make({"12", "-3", "+4", "", "5x", " 6", "0x7", "2147483647", "-2147483648"});
    int value = 77;
    EXPECT_TRUE(array.GetIntAt(0, value, 0));
    EXPECT_EQ(value, 12);
    EXPECT_TRUE(array.GetIntAt(1, value, 10));
    EXPECT_EQ(value, -3);
    EXPECT_TRUE(array.GetIntAt(2, value, -1));
    EXPECT_EQ(value, 4);
    for (const int i : {3, 4, 5, 6, 9, -1}) {
        EXPECT_FALSE(array.GetIntAt(i, value, 10)) << i;
        EXPECT_EQ(value, 4) << i;
    }
    EXPECT_TRUE(array.GetIntAt(7, value, 0));
    EXPECT_EQ(value, INT_MAX);
    EXPECT_TRUE(array.GetIntAt(8, value, 0));
    EXPECT_EQ(value, INT_MIN);
}

TEST(StringArray, ANumberThatDoesNotFitIsNone) {
    const StringArray array = Make({"2147483648", "-2147483649", "99999999999999999999"});
    int value = 77;
    for (int i = 0; i < array.GetSize(); ++i) {
        EXPECT_FALSE(array.GetIntAt(i, value, 0)) << i;
        EXPECT_EQ(value, 77) << i;
    }
}

TEST(StringArray, ContainsTextsExactlyOrIgnoringCase) {
    const StringArray array = Make({"Clk", "", "D(3)"});
    EXPECT_TRUE(array.Contains(Port::String("Clk")));
    EXPECT_FALSE(array.Contains(Port::String("CLK")));
    EXPECT_TRUE(array.IContains(Port::String("CLK")));
    EXPECT_TRUE(array.Contains(Port::String("")));
    EXPECT_FALSE(array.IContains(Port::String("Cl")));
    EXPECT_FALSE(StringArray().Contains(Port::String("")));
}

TEST(StringArray, ContainsArraysThatAreNotLonger) {
    const StringArray array = Make({"a", "B"});
    EXPECT_TRUE(array.Contains(Make({"B", "a"})));
    EXPECT_TRUE(array.Contains(Make({"a", "a"})));
    EXPECT_FALSE(array.Contains(Make({"b"})));
    EXPECT_TRUE(array.IContains(Make({"b", "A"})));
    EXPECT_FALSE(array.IContains(Make({"b", "c"})));
    EXPECT_FALSE(array.Contains(Make({"a", "a", "a"}))) << "all words are there, but it is longer";
    EXPECT_FALSE(array.IContains(Make({"a", "b", "a"})));
    EXPECT_TRUE(array.Contains(StringArray()));
    EXPECT_TRUE(StringArray().IContains(StringArray()));
    EXPECT_FALSE(StringArray().Contains(array));
}

TEST(StringArray, ContainsReadsEmptySlotsAsEmptyTexts) {
    StringArray array;
    array.SetAt(1, "a");
    EXPECT_TRUE(array.Contains(Port::String("")));
    EXPECT_TRUE(Make({"", "a"}).Contains(array));
}

TEST(StringArray, ConcatenatesWithSeparatorsBetween) {
    EXPECT_EQ(Make({"a"}).Concatenate(", "), "a");
    EXPECT_EQ(Make({"a", "", "c"}).Concatenate(", "), "a, , c");
    EXPECT_EQ(Make({"a", "b"}).Concatenate(""), "ab");
}

TEST(StringArray, JoinsFromAnElementOnWithBlanks) {
    const StringArray array = Make({"a", "b c", "", "d"});
    EXPECT_EQ(array.JoinFrom(1), "b c  d");
    EXPECT_EQ(array.JoinFrom(3), "d");
    EXPECT_EQ(array.JoinFrom(4), "");
}

TEST(StringArray, SortsByUnsignedBytes) {
    StringArray array = Make({"b", "\x80", "ab", "B", "", "a", "abc", "\xFF", "A_", "A1"});
    array.Sort();
    EXPECT_EQ(NamesOf(array), (Names{"", "A1", "A_", "B", "a", "ab", "abc", "b", "\x80", "\xFF"}));
}

bool IsShorter(const Port::String& a, const Port::String& b, void* context) {
    ++*static_cast<int*>(context);
    return a.GetLength() < b.GetLength();
}

TEST(StringArray, SortsStablyWithTheCallersOrder) {
    StringArray array;
    Names expected;
    for (int i = 0; i < 200; ++i) {
        const std::string text = std::to_string(i * 37 % 200);
        array.Add(text.c_str());
        expected.push_back(text);
    }
    std::stable_sort(expected.begin(), expected.end(),
                     [](const auto& a, const auto& b) { return a.size() < b.size(); });
    int calls = 0;
    array.Sort(&IsShorter, &calls);
    EXPECT_EQ(NamesOf(array), expected);
    EXPECT_GT(calls, 0);
}

TEST(StringArray, ANullPredicateChangesNothing) {
    StringArray array = Make({"b", "a"});
    array.Sort(nullptr, nullptr);
    EXPECT_EQ(NamesOf(array), (Names{"b", "a"}));
}

TEST(StringArray, AnExceptionOfThePredicateLeavesItAsItWas) {
    StringArray array = Make({"b", "a", "c"});
    const auto fails = [](const Port::String&, const Port::String&, void*) -> bool {
        throw std::bad_alloc();
    };
    EXPECT_THROW(array.Sort(+fails, nullptr), std::bad_alloc);
    EXPECT_EQ(NamesOf(array), (Names{"b", "a", "c"}));
}

TEST(StringArray, APredicateThatIsNoOrderLosesNothing) {
    StringArray array;
    Names expected;
    for (int i = 100; i < 400; ++i) {
        expected.push_back(std::to_string(i));
        array.Add(expected.back());
    }
    unsigned random = 1;
    const auto atRandom = [](const Port::String&, const Port::String&, void* context) {
        auto& number = *static_cast<unsigned*>(context);
        number = number * 1664525 + 1013904223;
        return (number >> 16) % 2 == 0;
    };
    for (int i = 0; i < 20; ++i) {
        array.Sort(+atRandom, &random);
        Names sorted = NamesOf(array);
        std::sort(sorted.begin(), sorted.end());
        ASSERT_EQ(sorted, expected);
    }
}

TEST(StringArray, APredicateMayChangeIt) {
    StringArray array = Make({"b", "a", "c"});
    const auto grows = [](const Port::String& a, const Port::String& b, void* context) {
        static_cast<StringArray*>(context)->Add("new");
        return a < b;
    };
    array.Sort(+grows, &array);
    EXPECT_GT(array.GetSize(), 3);
    EXPECT_EQ(array.Concatenate(",").GetView().substr(0, 9), "b,a,c,new");
    const auto empties = [](const Port::String& a, const Port::String& b, void* context) {
        static_cast<StringArray*>(context)->Empty();
        return a < b;
    };
    array.Sort(+empties, &array);
    EXPECT_TRUE(array.IsEmpty());
}

static_assert(std::forward_iterator<StringArray::Cursor>);
static_assert(std::ranges::forward_range<const StringArray>);
static_assert(std::ranges::common_range<StringArray>);

TEST(StringArray, IsARange) {
    const StringArray array = Make({"b", "", "a"});
    Names names;
    for (const std::string_view text : array) {
        names.emplace_back(text);
    }
    EXPECT_EQ(names, (Names{"b", "", "a"}));
    names.clear();
    for (const Port::String& text : array) {
        names.emplace_back(text.GetView());
    }
    EXPECT_EQ(names, (Names{"b", "", "a"}));
    EXPECT_EQ(Names(array.begin(), array.end()), names);
    EXPECT_EQ(std::ranges::count(array, ""), 1);
    EXPECT_EQ(*std::ranges::find(array, "a"), "a");
    auto at = array.begin();
    EXPECT_EQ(*at++, "b");
    EXPECT_EQ(*at, "");
    EXPECT_EQ(std::next(at, 2), array.end());
    EXPECT_EQ(*array.end(), "");
    EXPECT_EQ(*StringArray::Cursor(), "");
    const StringArray empty;
    EXPECT_EQ(empty.begin(), empty.end());
}

TEST(StringArray, TakesTextsInEveryForm) {
    StringArray array;
    array.Add(nullptr);
    array.Add(std::string_view("a-").substr(0, 1));
    array.Add(std::string("b"));
    array.SetAt(3, std::string("c"));
    array.SetAt(0, nullptr);
    EXPECT_EQ(NamesOf(array), (Names{"", "a", "b", "c"}));
    EXPECT_TRUE(array.Contains(nullptr));
    EXPECT_TRUE(array.Contains(std::string("a")));
    EXPECT_TRUE(array.IContains(std::string_view("B")));
    EXPECT_EQ(array.Concatenate(nullptr), "abc");
    EXPECT_EQ(array.Concatenate(std::string("+")), "+a+b+c");
    EXPECT_EQ(StringArray(nullptr, nullptr, true, nullptr).GetSize(), 0);
    EXPECT_EQ(NamesOf(StringArray(std::string("a b"), " ", true, nullptr)), (Names{"a", "b"}));
    array.Empty();
    EXPECT_EQ(array.Parse(std::string_view("a b"), " ", true, nullptr), 2);
    EXPECT_EQ(array.ParseCommandLine(nullptr), 0);
    EXPECT_EQ(NamesOf(array), (Names{"a", "b"}));
}

TEST(StringArray, SplitsATextOfItsOwn) {
    StringArray array;
    array.Add("one two three four five six seven eight nine ten");
    array.Add(" ");
    array.Add("\"\"");
    const std::string whole(array.GetView(0));
    for (int i = 0; i < 5; ++i) {
        array.SetAt(0, whole);
        EXPECT_EQ(array.Parse(array.GetView(0), array.GetView(1), true, array.GetView(2)), 10);
        EXPECT_EQ(array.ParseCommandLine(array.GetView(0)), 10);
        EXPECT_EQ(array.Parse("a b", array.GetView(1), true, nullptr), 2);
    }
    EXPECT_EQ(array.GetSize(), 3 + 5 * 22);
    EXPECT_EQ(array.JoinFrom(3 + 4 * 22), whole + " " + whole + " a b");
    StringArray quoted;
    quoted.Add("\"a b\" 'c d' e");
    quoted.Empty();
    quoted.Add("\"a b\" 'c d' eeeeeeeeeeeeeeeeeeeeeeeeeeeeeeeeeeeeeeee");
    EXPECT_EQ(quoted.ParseCommandLine(quoted.GetView(0)), 3);
    EXPECT_EQ(quoted.GetView(1), "a b");
    quoted.SetAt(0, quoted.GetView(3));
    EXPECT_EQ(quoted.GetView(0), quoted.GetView(3));
    quoted.SetAt(1, quoted.GetView(3));
    EXPECT_EQ(quoted.GetView(1), quoted.GetView(3));
}

TEST(StringArray, SortsEmptySlotsAsEmptyTexts) {
    StringArray array;
    array.SetAt(2, "a");
    array.SetAt(4, "b");
    array.Sort();
    EXPECT_EQ(NamesOf(array), (Names{"", "", "", "a", "b"}));
}

TEST(Tokeniser, RunsOfBlanksSeparateOnce) {
    EXPECT_EQ(Words("ADD  COMPONENT   AND2"), (Names{"ADD", "COMPONENT", "AND2"}));
    EXPECT_EQ(Words("  ADD COMPONENT  "), (Names{"ADD", "COMPONENT"}));
}

TEST(Tokeniser, AQuotedPieceKeepsItsBlanks) {
    EXPECT_EQ(Words("SET NAME \"a b\" x"), (Names{"SET", "NAME", "a b", "x"}));
    EXPECT_EQ(Words("'a b' \"c  d\""), (Names{"a b", "c  d"}));
}

TEST(Tokeniser, AnEmptyQuotedPieceIsKeptOnlyBeforeASeparator) {
    EXPECT_EQ(Words("SET NAME \"\" x"), (Names{"SET", "NAME", "", "x"}));
    EXPECT_EQ(Words("SET NAME \"\""), (Names{"SET", "NAME"}));
    EXPECT_EQ(Words("SET NAME \"\" "), (Names{"SET", "NAME", ""}));
    EXPECT_EQ(Words("'' ''"), Names{""});
}

TEST(Tokeniser, AQuoteOpensOnlyAtTheStartOrAfterASeparator) {
    EXPECT_EQ(Words("it's"), Names{"it's"});
    EXPECT_EQ(Words("'it s'"), Names{"it s"});
    EXPECT_EQ(Words("a\"b c\""), (Names{"a\"b", "c\""}));
}

TEST(Tokeniser, ABackslashKeepsAClosingQuote) {
    EXPECT_EQ(Words("\"a\\\"b\""), Names{"a\"b"});
    EXPECT_EQ(Words("\"a\\nb\""), Names{"a\\nb"});
    EXPECT_EQ(Words("\"a\\'b c\""), Names{"a\\'b c"});
    EXPECT_EQ(Words("\"a\\\\\" b"), Names{"a\\\" b"});
    EXPECT_EQ(Words("a\\\"b"), Names{"a\\\"b"});
}

TEST(Tokeniser, AnInnerQuoteIsDroppedAndQuotingGoesOn) {
    EXPECT_EQ(Words("\"ab\"cd ef\""), Names{"abcd ef"});
}

TEST(Tokeniser, AQuoteThatNeverClosesYieldsItsPiece) {
    EXPECT_EQ(Words("\"abc"), Names{"abc"});
    EXPECT_EQ(Words("a 'b c "), (Names{"a", "b c "}));
    EXPECT_EQ(Words("\""), Names());
}

TEST(Tokeniser, TabsAreOrdinaryCharacters) {
    EXPECT_EQ(Words("a\tb c"), (Names{"a\tb", "c"}));
    EXPECT_EQ(Words("a\t\"b c\""), (Names{"a\t\"b", "c\""}));
}

TEST(Tokeniser, AnEmptyOrNullTextYieldsNothing) {
    StringArray array;
    EXPECT_EQ(array.Parse("", " ", true, CommandQuotes), 0);
    EXPECT_EQ(array.Parse(static_cast<const char*>(nullptr), " ", true, CommandQuotes), 0);
    EXPECT_EQ(array.Parse(static_cast<const char*>(nullptr), " ", true, nullptr), 0);
    EXPECT_EQ(array.Parse("   ", " ", true, CommandQuotes), 0);
    EXPECT_TRUE(array.IsEmpty());
}

TEST(Tokeniser, AppendsToWhatIsThere) {
    StringArray array = Make({"old"});
    EXPECT_EQ(array.Parse("a 'b c'", " ", true, CommandQuotes), 2);
    EXPECT_EQ(array.Parse("8:H:A5", ":", true, nullptr), 3);
    EXPECT_EQ(NamesOf(array), (Names{"old", "a", "b c", "8", "H", "A5"}));
}

TEST(Tokeniser, WithoutSeparatorsTheTextIsOnePiece) {
    StringArray array;
    EXPECT_EQ(array.Parse("a b", nullptr, true, nullptr), 1);
    EXPECT_EQ(array.Parse("'a b", "", true, CommandQuotes), 1);
    EXPECT_EQ(NamesOf(array), (Names{"a b", "a b"}));
}

TEST(Tokeniser, WithoutQuotesQuoteCharactersAreOrdinary) {
    EXPECT_EQ(NamesOf(StringArray("\"a b\"", " ", true, nullptr)), (Names{"\"a", "b\""}));
    EXPECT_EQ(NamesOf(StringArray("\"a b\"", " ", true, "")), (Names{"\"a", "b\""}));
}

TEST(Tokeniser, AnOddLastQuoteCharacterIsIgnored) {
    EXPECT_EQ(NamesOf(StringArray("\"a b\" 'c d'", " ", true, "\"\"'")),
              (Names{"a b", "'c", "d'"}));
}

TEST(Tokeniser, TakesAMillionCharacters) {
    const std::string word(500000, 'x');
    const std::string text = word + " \"" + word + " " + word + "\"";
    const Names words = Words(text.c_str());
    ASSERT_EQ(words.size(), 2u);
    EXPECT_TRUE(words[0] == word);
    EXPECT_TRUE(words[1] == word + " " + word);
    EXPECT_EQ(Words((std::string(1000000, '"') + "\\").c_str()).size(), 1u);
}

/// The splitting rule again, one decision after the other.
class SlowTokeniser {
public:
    SlowTokeniser(const std::string& text, const char* separators, bool skipEmpty,
                  const char* quotes)
        : text_(text), separators_(separators), skipEmpty_(skipEmpty), quotes_(quotes) {}

    Names Split() {
        OpenQuote();
        while (at_ < text_.size()) {
            if (closer_ != '\0') {
                StepInsideQuotes();
            } else {
                StepOutsideQuotes();
            }
        }
        if (!piece_.empty()) {
            pieces_.push_back(piece_);
        }
        return pieces_;
    }

private:
    bool IsSeparator(char c) const { return std::strchr(separators_, c) != nullptr && c != '\0'; }

    void OpenQuote() {
        for (std::size_t pair = 0; pair + 1 < std::strlen(quotes_); pair += 2) {
            if (at_ < text_.size() && text_[at_] == quotes_[pair]) {
                closer_ = quotes_[pair + 1];
                ++at_;
                return;
            }
        }
    }

    void StepOutsideQuotes() {
        const char c = text_[at_++];
        if (!IsSeparator(c)) {
            piece_ += c;
            return;
        }
        if (!piece_.empty() || !skipEmpty_ || justClosed_) {
            pieces_.push_back(piece_);
        }
        piece_.clear();
        justClosed_ = false;
        OpenQuote();
    }

    void StepInsideQuotes() {
        const char c = text_[at_++];
        const bool atEnd = at_ == text_.size();
        if (c == '\\' && !atEnd && text_[at_] == closer_) {
            piece_ += closer_;
            ++at_;
        } else if (c != closer_) {
            piece_ += c;
        } else if (atEnd || IsSeparator(text_[at_])) {
            closer_ = '\0';
            justClosed_ = true;
        }
    }

    std::string text_;
    const char* separators_;
    bool skipEmpty_;
    const char* quotes_;
    std::size_t at_ = 0;
    char closer_ = '\0';
    bool justClosed_ = false;
    std::string piece_;
    Names pieces_;
};

struct Rule {
    const char* alphabet;
    std::size_t longest;
    const char* separators;
    bool skipEmpty;
    const char* quotes;
};

std::ostream& operator<<(std::ostream& out, const Rule& rule) {
    return out << "separators <" << rule.separators << ">, quotes <" << rule.quotes << ">";
}

class TokeniserRule : public testing::TestWithParam<Rule> {};

TEST_P(TokeniserRule, AgreesWithASlowTokeniserOnAllShortTexts) {
    const Rule& rule = GetParam();
    Support::ForEachText(rule.alphabet, rule.longest, [&](const std::string& text) {
        if (!rule.skipEmpty && text.find_first_of(rule.quotes) == std::string::npos) {
            return; // which empty pieces such a text has is nobody's promise
        }
        StringArray array;
        const int count = array.Parse(text.c_str(), rule.separators, rule.skipEmpty, rule.quotes);
        ASSERT_EQ(NamesOf(array),
                  SlowTokeniser(text, rule.separators, rule.skipEmpty, rule.quotes).Split())
            << "<" << text << ">";
        ASSERT_EQ(count, array.GetSize());
    });
}

INSTANTIATE_TEST_SUITE_P(Rules, TokeniserRule,
                         testing::Values(Rule{"a \"'\\", 7, " ", true, CommandQuotes},
                                         Rule{"a \"\\", 6, " ", false, "\"\""},
                                         Rule{"a ,()[]\\", 5, " ,", true, "()[]"},
                                         Rule{"a,(()\\", 5, ",", false, "()"},
                                         Rule{"a:'", 6, ":", true, "''\""},
                                         Rule{"ab \t", 6, " ", true, ""}));

TEST(Tokeniser, SplitsACommandLineAsItsRuleSays) {
    Support::ForEachText("a \"'\\", 6, [](const std::string& text) {
        StringArray array = Make({"old"});
        const int count = array.ParseCommandLine(text);
        Names expected = SlowTokeniser(text, " ", true, CommandQuotes).Split();
        ASSERT_EQ(count, static_cast<int>(expected.size())) << "<" << text << ">";
        expected.insert(expected.begin(), "old");
        ASSERT_EQ(NamesOf(array), expected) << "<" << text << ">";
    });
}

RC_GTEST_PROP(Tokeniser, AgreesWithASlowTokeniserOnLongTexts, ()) {
    const auto text = *rc::gen::scale(
        4.0, rc::gen::container<std::string>(rc::gen::elementOf(std::string("abc   \"\"''\\\t"))));
    const StringArray array(text.c_str(), " ", true, CommandQuotes);
    RC_ASSERT(NamesOf(array) == SlowTokeniser(text, " ", true, CommandQuotes).Split());
}

RC_GTEST_PROP(StringArray, BehavesAsAVectorOfTexts, ()) {
    const auto calls = *rc::gen::container<std::vector<std::pair<int, std::string>>>(rc::gen::pair(
        rc::gen::inRange(-2, 20), rc::gen::container<std::string>(rc::gen::inRange('a', 'e'))));
    StringArray array;
    Names expected;
    for (const auto& [call, text] : calls) {
        if (call == -2) {
            array.Empty();
            expected.clear();
        } else if (call == -1) {
            StringArray copy(array);
            array = copy;
        } else if (call == 0) {
            array.Sort();
            std::sort(expected.begin(), expected.end());
        } else if (call < 8) {
            array.SetAt(call, text.c_str());
            expected.resize(std::max(expected.size(), static_cast<std::size_t>(call) + 1));
            expected[static_cast<std::size_t>(call)] = text;
        } else {
            RC_ASSERT(array.Add(text.c_str()) == static_cast<int>(expected.size()));
            expected.push_back(text);
        }
        RC_ASSERT(NamesOf(array) == expected);
    }
}

} // namespace
