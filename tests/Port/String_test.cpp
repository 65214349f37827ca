#include "Port/String.h"

#include "Port/File.h"
#include "Support/DecimalComma.h"
#include "Support/ShortTexts.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <climits>
#include <clocale>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace {

using Port::String;

std::vector<std::string> Tokens(const String& text, const char* separators,
                                String::ParseType type) {
    std::vector<std::string> tokens;
    Port_Range range;
    while (text.NextTokenRange(range, separators, type)) {
        tokens.emplace_back(text.Extract(range).GetView());
        if (tokens.size() > text.GetLength() + 1) {
            ADD_FAILURE() << "the tokens of <" << text.CStr() << "> never end";
            break;
        }
    }
    return tokens;
}

TEST(String, ANullPointerGivesTheEmptyText) {
    const String text(static_cast<const char*>(nullptr));
    EXPECT_TRUE(text.IsEmpty());
    EXPECT_EQ(text, "");
    EXPECT_EQ(text, static_cast<const char*>(nullptr));
}

TEST(String, AppendsTextsAndCharacters) {
    String text("a");
    text += "b";
    text += String("c");
    text += std::string_view("d");
    text += 'e';
    text += static_cast<const char*>(nullptr);
    EXPECT_EQ(text, "abcde");
    EXPECT_EQ(text + String("f"), "abcdef");
    text += text;
    EXPECT_EQ(text, "abcdeabcde");
}

template <class A, class B> void ExpectOrdered(const A& smaller, const B& larger) {
    EXPECT_TRUE(smaller < larger);
    EXPECT_FALSE(larger < smaller);
    EXPECT_FALSE(smaller == larger);
    EXPECT_TRUE(larger != smaller);
}

TEST(String, ComparesWithTextsOfEveryKind) {
    const String a("a");
    const String b("b");
    ExpectOrdered(a, b);
    ExpectOrdered(a, "b");
    ExpectOrdered("a", b);
    ExpectOrdered(a, std::string("b"));
    ExpectOrdered(std::string("a"), b);
    ExpectOrdered(a, std::string_view("b"));
    ExpectOrdered(std::string_view("a"), b);
    ExpectOrdered(static_cast<const char*>(nullptr), b);
    EXPECT_TRUE(String() == nullptr);
    EXPECT_TRUE(nullptr == String());
    EXPECT_TRUE(a != nullptr);
    EXPECT_TRUE(nullptr < a);
    EXPECT_TRUE(String(std::string(1, '\0')) != nullptr);
    EXPECT_TRUE(a == std::string("a"));
    EXPECT_TRUE(std::string_view("a") == a);
}

TEST(String, IsExtendedByAndJoinedToTextsOfEveryKind) {
    String text("a");
    text += std::string("b");
    text += std::string_view("c");
    text += nullptr;
    text += std::string(1, '\0');
    EXPECT_EQ(text, std::string_view("abc\0", 4));
    text = "0123456789abcdef";
    text += text.GetView().substr(1, 2);
    EXPECT_EQ(text, "0123456789abcdef12") << "a piece of its own";
    const String a("a");
    EXPECT_EQ(a + "b", "ab");
    EXPECT_EQ("b" + a, "ba");
    EXPECT_EQ(a + 'b', "ab");
    EXPECT_EQ('b' + a, "ba");
    EXPECT_EQ(a + std::string("b"), "ab");
    EXPECT_EQ(std::string("b") + a, "ba");
    EXPECT_EQ(a + std::string_view("b"), "ab");
    EXPECT_EQ(std::string_view("b") + a, "ba");
    EXPECT_EQ(a + nullptr + a, "aa");
    EXPECT_EQ(String("x") + a, "xa");
}

template <class Text, class Other>
concept Extendable = requires(Text text, Other other) {
    text += other;
};
template <class Text, class Other>
concept Joinable = requires(Text text, Other other) {
    text + other;
};

TEST(String, IsNotExtendedByNumbers) {
    static_assert(Extendable<String, char> && Joinable<String, char> && Joinable<char, String>);
    static_assert(!Extendable<String, int> && !Joinable<String, int> && !Joinable<int, String>);
    static_assert(!Extendable<String, double> && !Joinable<String, double>);
    static_assert(!Extendable<String, bool> && !Extendable<String, wchar_t>);
}

TEST(String, ReadsNullAsTheEmptyTextEverywhere) {
    const char* const null = nullptr;
    String text("abc");
    EXPECT_GT(text.Compare(null), 0);
    EXPECT_GT(text.Compare(nullptr, String::CompareIgnoringCase), 0);
    EXPECT_EQ(String().Compare(null), 0);
    EXPECT_EQ(text.GetIndexOfString(null), 0);
    EXPECT_EQ(text.GetIndexOfString(nullptr), 0);
    text.ReplaceChars(null, 'x');
    text.ReplaceChars(nullptr, 'x');
    EXPECT_EQ(text, "abc");
    Port_Range range;
    EXPECT_TRUE(text.NextTokenRange(range, null, String::SkipEmptyTokens));
    EXPECT_EQ(range, Port_Range(0, 3));
    EXPECT_TRUE(text.GetRangeOfMatch(Port_Regexp(null), range));
    EXPECT_EQ(range, Port_Range(0, 0));
    EXPECT_EQ(String::Format(null), "");
}

TEST(String, TokensStartAtEitherRangeBeforeTheText) {
    const String text("ab,c");
    for (const String::ParseType type : {String::SkipEmptyTokens, String::KeepEmptyTokens}) {
        Port_Range range(1, 0);
        ASSERT_TRUE(text.NextTokenRange(range, ",", type));
        EXPECT_EQ(range, Port_Range(0, 2));
        ASSERT_TRUE(text.NextTokenRange(range, ",", type));
        EXPECT_EQ(range, Port_Range(3, 1));
        EXPECT_FALSE(text.NextTokenRange(range, ",", type));
        EXPECT_EQ(range, Port_Range(3, 1));
    }
}

TEST(String, AnEmptyTokenAtIndexOneIsNoStart) {
    Port_Range range(1, 0);
    const String text(",,x");
    for (const std::size_t start : {0u, 1u}) {
        ASSERT_TRUE(text.NextTokenRange(range, ",", String::KeepEmptyTokens));
        EXPECT_EQ(range, Port_Range(start, 0));
    }
    ASSERT_TRUE(text.NextTokenRange(range, ",", String::KeepEmptyTokens));
    EXPECT_EQ(range, Port_Range(2, 1));
    EXPECT_FALSE(text.NextTokenRange(range, ",", String::KeepEmptyTokens));
}

TEST(String, BehindARangeThatReachesBeyondTheTextThereIsNoToken) {
    for (Port_Range range : {Port_Range(0, SIZE_MAX), Port_Range(5, SIZE_MAX), Port_Range(3, 0),
                             Port_Range(SIZE_MAX, 1), Port_Range(SIZE_MAX - 1, 1)}) {
        EXPECT_FALSE(String("a,b").NextTokenRange(range, ",", String::SkipEmptyTokens));
    }
}

template <class Type>
concept IsParseType = requires(Type type, Port_Range range) {
    String().NextTokenRange(range, ",", type);
};

TEST(String, TokensTakeTheKindOfParsingAsANumber) {
    const String text(",a");
    Port_Range range(1, 0);
    EXPECT_TRUE(text.NextTokenRange(range, ",", 1));
    EXPECT_EQ(range, Port_Range(1, 1));
    range = Port_Range(1, 0);
    EXPECT_TRUE(text.NextTokenRange(range, ",", 0));
    EXPECT_EQ(range, Port_Range(0, 0));
    for (const int unknown : {-1, 2, INT_MAX}) {
        range = Port_Range(1, 0);
        EXPECT_FALSE(text.NextTokenRange(range, ",", unknown));
        EXPECT_EQ(range, Port_Range(1, 0));
    }
    static_assert(IsParseType<String::ParseType> && IsParseType<bool>);
    static_assert(!IsParseType<String::CompareType>);
}

TEST(String, ComparesBytesUnsigned) {
    EXPECT_EQ(String("abc").Compare("abc"), 0);
    EXPECT_LT(String("ABC").Compare("abc"), 0);
    EXPECT_LT(String("ab").Compare("abc"), 0);
    EXPECT_GT(String("\x80").Compare("a"), 0);
    EXPECT_TRUE(String("a") < String("\x80"));
    EXPECT_FALSE(String("\xFF") < String("a"));
}

TEST(String, ComparesIgnoringTheCaseOfAsciiLettersOnly) {
    EXPECT_EQ(String("ClK_1").Compare("cLk_1", String::CompareIgnoringCase), 0);
    EXPECT_NE(String("ClK_1").Compare("cLk_1"), 0);
    EXPECT_NE(String("\xC4").Compare("\xE4", String::CompareIgnoringCase), 0);
    EXPECT_LT(String("a").Compare("AB", String::CompareIgnoringCase), 0);
    EXPECT_GT(String("\x80").Compare("a", String::CompareIgnoringCase), 0);
}

TEST(String, FindsCharactersAndTexts) {
    const String text("D(7:0)(1)");
    EXPECT_EQ(text.GetIndexOfFirstChar('('), 1);
    EXPECT_EQ(text.GetIndexOfLastChar('('), 6);
    EXPECT_EQ(text.GetIndexOfFirstChar('x'), -1);
    EXPECT_EQ(text.GetIndexOfLastChar('x'), -1);
    EXPECT_EQ(text.GetIndexOfString("0)"), 4);
    EXPECT_EQ(text.GetIndexOfString(""), 0);
    EXPECT_EQ(text.GetIndexOfString("x"), -1);
}

TEST(String, ReadsNulPastItsEnd) {
    const String text("ab");
    EXPECT_EQ(text[1], 'b');
    EXPECT_EQ(text[2], '\0');
    EXPECT_EQ(text[1000], '\0');
}

TEST(String, CutsRangesToWhatItHas) {
    const String text("abcdef");
    EXPECT_EQ(text.Extract(Port_Range(1, 3)), "bcd");
    EXPECT_EQ(text.Extract(Port_Range(4, 100)), "ef");
    EXPECT_EQ(text.Extract(Port_Range(6, 1)), "");
    EXPECT_EQ(text.Extract(Port_Range(100, 1)), "");
    EXPECT_EQ(text.Extract(Port_Range(2, SIZE_MAX)), "cdef");

    String rest("abcdef");
    rest.Remove(Port_Range(1, 2));
    EXPECT_EQ(rest, "adef");
    rest.Remove(Port_Range(100, 1));
    EXPECT_EQ(rest, "adef");
    rest.Remove(Port_Range(2, SIZE_MAX));
    EXPECT_EQ(rest, "ad");
}

TEST(String, ChangesTheCaseOfAsciiLettersOnly) {
    String text("aZ_[`{\xE4\xC4");
    text.MakeUpper();
    EXPECT_EQ(text, "AZ_[`{\xE4\xC4");
    text.MakeLower();
    EXPECT_EQ(text, "az_[`{\xE4\xC4");
}

TEST(String, TrimsEveryOccurrenceOffTheChosenEnds) {
    String text("xxaxbxx");
    text.Trim('x', String::TrimLeft);
    EXPECT_EQ(text, "axbxx");
    text.Trim('x', String::TrimRight);
    EXPECT_EQ(text, "axb");
    String all("xxxx");
    all.Trim('x');
    EXPECT_EQ(all, "");
    all.Trim('x');
    EXPECT_EQ(all, "");
}

TEST(String, ReplacesCharactersOfASet) {
    String text("a[b{c<d");
    text.ReplaceChars("[{<", '(');
    EXPECT_EQ(text, "a(b(c(d");
    text.ReplaceChars("", 'x');
    EXPECT_EQ(text, "a(b(c(d");
}

TEST(String, SkippingTokensAreTheNonEmptyPieces) {
    Support::ForEachText("ab ,", 5, [](const std::string& text) {
        std::vector<std::string> expected(1);
        for (const char c : text) {
            if (c == ' ' || c == ',') {
                expected.emplace_back();
            } else {
                expected.back() += c;
            }
        }
        std::erase(expected, "");
        ASSERT_EQ(Tokens(text, " ,", String::SkipEmptyTokens), expected) << "'" << text << "'";
    });
}

TEST(String, WithoutSeparatorsTheWholeTextIsOneToken) {
    EXPECT_EQ(Tokens("a b", "", String::SkipEmptyTokens), std::vector<std::string>{"a b"});
    EXPECT_EQ(Tokens("", " ", String::SkipEmptyTokens), std::vector<std::string>());
}

TEST(String, KeepingTokensEndsOnAnyText) {
    EXPECT_EQ(Tokens("a,b", ",", String::KeepEmptyTokens), (std::vector<std::string>{"a", "b"}));
    EXPECT_EQ(Tokens("a,,b", ",", String::KeepEmptyTokens),
              (std::vector<std::string>{"a", "", "b"}));
    Support::ForEachText(
        "a,", 6, [](const std::string& text) { Tokens(text, ",", String::KeepEmptyTokens); });
}

TEST(String, FindsTheMatchOfAPattern) {
    Port_Range range;
    EXPECT_TRUE(String("--12x").GetRangeOfMatch(Port_Regexp("[+-]?[0-9]+"), range));
    EXPECT_EQ(range, Port_Range(1, 3));
    EXPECT_FALSE(String("x").GetRangeOfMatch(Port_Regexp("[0-9]"), range));
    EXPECT_EQ(range, Port_Range(1, 3));
}

TEST(String, FormatsAsPrintfDoes) {
    EXPECT_EQ(String::Format("%s(%d)", "D", -7), "D(-7)");
    EXPECT_EQ(String::Format("%*d|%5.2f", 4, 7, 1.0), "   7| 1.00");
    EXPECT_EQ(String::Format("%d", INT_MIN), "-2147483648");
    const std::string longText(100000, 'x');
    EXPECT_EQ(String::Format("<%s>", longText.c_str()), ("<" + longText + ">").c_str());
    EXPECT_EQ(String::Format("%s", "%n%s"), "%n%s");
}

TEST(String, FormatsInNoLocale) {
    const Support::DecimalComma locale;
    ASSERT_TRUE(locale.IsSet());
    EXPECT_EQ(String::Format("%.2f", 1.5), "1.50");
    EXPECT_EQ(std::localeconv()->decimal_point, std::string(",")) << "the locale is left in use";
}

TEST(String, ReadsLinesWithoutTheirEnds) {
    const Support::TemporaryFolder folder;
    Support::WriteWholeFile(folder / "lines", "one\r\n\r\n\ntwo\r\r\nth\rree\nlast");
    Port::File file;
    ASSERT_TRUE(file.open((folder / "lines").c_str(), Port::File::Read, true));
    String line("old");
    for (const char* expected : {"one", "", "", "two\r", "th\rree", "last"}) {
        ASSERT_TRUE(line.ReadLine(file));
        EXPECT_EQ(line, expected);
    }
    EXPECT_FALSE(line.ReadLine(file));
    EXPECT_FALSE(line.ReadLine(file));
    EXPECT_EQ(file.GetError(), 0);
}

TEST(String, AFileThatEndsInALineFeedHasNoFurtherLine) {
    const Support::TemporaryFolder folder;
    Support::WriteWholeFile(folder / "lines", "one\n");
    Port::File file;
    ASSERT_TRUE(file.open((folder / "lines").c_str(), Port::File::Read, true));
    String line;
    EXPECT_TRUE(line.ReadLine(file));
    EXPECT_EQ(line, "one");
    EXPECT_FALSE(line.ReadLine(file));
}

TEST(String, ALastLineWithoutALineFeedLosesItsCarriageReturnToo) {
    const Support::TemporaryFolder folder;
    Support::WriteWholeFile(folder / "lines", "one\ntwo\r");
    Port::File file;
    ASSERT_TRUE(file.open((folder / "lines").c_str(), Port::File::Read, true));
    String line;
    EXPECT_TRUE(line.ReadLine(file));
    EXPECT_TRUE(line.ReadLine(file));
    EXPECT_EQ(line, "two");
}

TEST(String, ReadsLinesThatAreLongerThanAnyBuffer) {
    const Support::TemporaryFolder folder;
    const std::string first(3000000, 'a');
    const std::string second(70000, 'b');
    Support::WriteWholeFile(folder / "lines", first + "\r\n" + second);
    Port::File file;
    ASSERT_TRUE(file.open((folder / "lines").c_str(), Port::File::Read, true));
    String line;
    EXPECT_TRUE(line.ReadLine(file));
    EXPECT_TRUE(line.GetView() == first);
    EXPECT_TRUE(line.ReadLine(file));
    EXPECT_TRUE(line.GetView() == second);
    EXPECT_FALSE(line.ReadLine(file));
}

TEST(String, ReadsNoLineFromAFileThatIsNotOpen) {
    Port::File file;
    String line;
    EXPECT_FALSE(line.ReadLine(file));
}

} // namespace
