#include "Port/Text.h"

#include "Port/Ascii.h"
#include "Port/String.h"
#include "Port/Version.h"
#include "Support/DecimalComma.h"
#include "Support/ShortTexts.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <cctype>
#include <climits>
#include <cmath>
#include <cstdlib>
#include <locale>
#include <regex>
#include <string>
#include <string_view>

namespace {

int SignOf(int value) {
    return value < 0 ? -1 : value > 0 ? 1 : 0;
}

/// A locale with a decimal comma and grouped digits, the global one as long as the object lives.
class ForeignLocale {
public:
    ForeignLocale() : former_(std::locale::global(std::locale(std::locale(), new Comma))) {}
    ForeignLocale(const ForeignLocale&) = delete;
    ForeignLocale& operator=(const ForeignLocale&) = delete;
    ~ForeignLocale() { std::locale::global(former_); }

private:
    struct Comma : std::numpunct<char> {
        char do_decimal_point() const override { return ','; }
        char do_thousands_sep() const override { return '.'; }
        std::string do_grouping() const override { return "\3"; }
    };

    std::locale former_;
};

TEST(Strtol, ConvertsExactlyTheTextsThatAreOneInteger) {
    const std::regex integer("[+-]?[0-9]+");
    Support::ForEachText("+-09 x.", 5, [&](const std::string& text) {
        long value = 77;
        const bool expected = std::regex_match(text, integer);
        ASSERT_EQ(Port::strtol(text.c_str(), value), expected) << "'" << text << "'";
        ASSERT_EQ(value, expected ? std::atol(text.c_str()) : 77) << "'" << text << "'";
    });
}

TEST(Strtol, RefusesWhiteSpaceAndNull) {
    long value = 77;
    for (const char* text : {"\t1", "\n1", "1\n", "1 ", "0x1", "1e1", "\xB1", "1\x80"}) {
        EXPECT_FALSE(Port::strtol(text, value)) << text;
    }
    EXPECT_FALSE(Port::strtol(nullptr, value));
    EXPECT_EQ(value, 77);
}

TEST(Strtol, RefusesNumbersThatDoNotFit) {
    long value = 77;
    EXPECT_TRUE(Port::strtol(std::to_string(LONG_MAX).c_str(), value));
    EXPECT_EQ(value, LONG_MAX);
    EXPECT_TRUE(Port::strtol(std::to_string(LONG_MIN).c_str(), value));
    EXPECT_EQ(value, LONG_MIN);
    EXPECT_TRUE(Port::strtol("+0000000000000000000000000000000000000012", value));
    EXPECT_EQ(value, 12);
    EXPECT_FALSE(Port::strtol("9223372036854775808", value));
    EXPECT_FALSE(Port::strtol("-9223372036854775809", value));
    EXPECT_FALSE(Port::strtol(std::string(100000, '9').c_str(), value));
    EXPECT_EQ(value, 12);
}

TEST(ToIntSaturated, FollowsTheRulesOfAtoi) {
    Support::ForEachText("+-07 \ta", 5, [](const std::string& text) {
        ASSERT_EQ(Port::ToIntSaturated(text), std::atoi(text.c_str())) << "'" << text << "'";
    });
    EXPECT_EQ(Port::ToIntSaturated("\n\v\f\r 12abc"), 12);
}

TEST(ToIntSaturated, StaysWithinTheLimits) {
    EXPECT_EQ(Port::ToIntSaturated("2147483647"), INT_MAX);
    EXPECT_EQ(Port::ToIntSaturated("2147483648"), INT_MAX);
    EXPECT_EQ(Port::ToIntSaturated("-2147483648"), INT_MIN);
    EXPECT_EQ(Port::ToIntSaturated("-2147483649"), INT_MIN);
    EXPECT_EQ(Port::ToIntSaturated(std::string(100000, '9') + "x"), INT_MAX);
    EXPECT_EQ(Port::ToIntSaturated("-" + std::string(100000, '9')), INT_MIN);
    EXPECT_EQ(Port::ToIntSaturated(std::string(100000, '0') + "5"), 5);
}

TEST(ToDouble, FollowsTheRulesOfAtof) {
    Support::ForEachText("+-.05eE x", 5, [](const std::string& text) {
        const double value = std::atof(text.c_str());
        const double converted = Port::ToDouble(text.c_str());
        ASSERT_EQ(converted, std::isfinite(value) ? value : 0.0) << "'" << text << "'";
        ASSERT_EQ(std::signbit(converted), std::isfinite(value) && std::signbit(value))
            << "'" << text << "'";
    });
    EXPECT_EQ(Port::ToDouble("\t\n12.5rest"), 12.5);
    EXPECT_EQ(Port::ToDouble(nullptr), 0.0);
}

TEST(ToDouble, GivesZeroForWhatIsNotFinite) {
    for (const char* text : {"inf", "-inf", "INFINITY", "nan", "NAN(1)", "1e999", "-1e999",
                             "1e99999999999999999999"}) {
        EXPECT_EQ(Port::ToDouble(text), 0.0) << text;
    }
    EXPECT_EQ(Port::ToDouble("1e308"), 1e308);
    EXPECT_EQ(Port::ToDouble(("1" + std::string(1000, '0')).c_str()), 0.0);
}

TEST(ToDouble, KeepsTheSignOfWhatIsTooSmall) {
    for (const char* text : {"-1e-400", "-0", "-0x", "-.0e5", "-1e-99999999999999999999"}) {
        EXPECT_EQ(Port::ToDouble(text), 0.0) << text;
        EXPECT_TRUE(std::signbit(Port::ToDouble(text))) << text;
    }
    for (const char* text : {"1e-400", "0", "-", "--1e-400", "-x"}) {
        EXPECT_EQ(Port::ToDouble(text), 0.0) << text;
        EXPECT_FALSE(std::signbit(Port::ToDouble(text))) << text;
    }
    EXPECT_EQ(Port::ToDouble("-5e-324"), -5e-324);
}

TEST(ToDouble, ReadsTheTextOfAViewOnly) {
    EXPECT_EQ(Port::ToDouble(std::string_view("12345").substr(1, 2)), 23.0);
}

TEST(ToDouble, ConsultsNoLocale) {
    const ForeignLocale foreign;
    const Support::DecimalComma comma;
    ASSERT_TRUE(comma.IsSet());
    EXPECT_EQ(Port::ToDouble("1.5"), 1.5);
    EXPECT_EQ(Port::ToDouble("1,5"), 1.0);
}

TEST(Stricmp, IgnoresTheCaseOfLetters) {
    EXPECT_EQ(Port::stricmp("Clk_1", "cLK_1"), 0);
    EXPECT_LT(Port::stricmp("abc", "ABD"), 0);
    EXPECT_GT(Port::stricmp("ABD", "abc"), 0);
    EXPECT_LT(Port::stricmp("ab", "ABC"), 0);
    EXPECT_GT(Port::stricmp("abc", "AB"), 0);
    EXPECT_NE(Port::stricmp("\xC4", "\xE4"), 0);
    EXPECT_GT(Port::stricmp("\x80", "z"), 0);
}

TEST(Stricmp, ReadsNullAsTheEmptyText) {
    EXPECT_EQ(Port::stricmp(nullptr, nullptr), 0);
    EXPECT_EQ(Port::stricmp(nullptr, ""), 0);
    EXPECT_LT(Port::stricmp(nullptr, "a"), 0);
    EXPECT_GT(Port::stricmp("a", nullptr), 0);
}

TEST(Text, IsTakenInEveryForm) {
    const std::string_view part = std::string_view("12ab34").substr(0, 2);
    long value = 0;
    EXPECT_TRUE(Port::strtol(part, value));
    EXPECT_EQ(value, 12);
    EXPECT_TRUE(Port::strtol(std::string("-7"), value));
    EXPECT_EQ(value, -7);
    EXPECT_EQ(Port::ToIntSaturated(nullptr), 0);
    EXPECT_EQ(Port::ToIntSaturated(static_cast<const char*>(nullptr)), 0);
    EXPECT_EQ(Port::ToIntSaturated(Port::String("5x")), 5);
    EXPECT_EQ(Port::stricmp(part, "12"), 0);
    EXPECT_TRUE(Port::strmatch(part, std::string("*2")));
    EXPECT_TRUE(Port::EqualIgnoringCase(nullptr, ""));
    EXPECT_LT(Port::OrderIgnoringCase(nullptr, "a"), 0);
    EXPECT_EQ(Port::Version::getValue(std::string("version")), Port::Version::getValue("version"));
}

TEST(Strnicmp, ComparesAtMostTheFirstCharacters) {
    EXPECT_EQ(Port::strnicmp("inputs", "INPUT", 5), 0);
    EXPECT_GT(Port::strnicmp("inputs", "INPUT", 6), 0);
    EXPECT_LT(Port::strnicmp("in", "INPUT", 5), 0);
    EXPECT_EQ(Port::strnicmp("in", "IN", 100), 0);
    EXPECT_EQ(Port::strnicmp("a", "b", 0), 0);
    EXPECT_EQ(Port::strnicmp(nullptr, nullptr, 3), 0);
    EXPECT_LT(Port::strnicmp(nullptr, "x", 3), 0);
}

RC_GTEST_PROP(Stricmp, OrdersAsTheTextsInOneCaseDo, (std::string a, std::string b)) {
    // Texts without the characters between the two cases, where either folding would do.
    const auto clean = [](std::string& text) {
        std::erase_if(text, [](char c) { return (c >= '[' && c <= '`') || c == '\0'; });
    };
    clean(a);
    clean(b);
    const auto upper = [](std::string text) {
        for (char& c : text) {
            if (c >= 'a' && c <= 'z') {
                c = static_cast<char>(std::toupper(c));
            }
        }
        return text;
    };
    RC_ASSERT(SignOf(Port::stricmp(a.c_str(), b.c_str())) == SignOf(upper(a).compare(upper(b))));
}

/// Wildcard matching by trying everything.
bool MatchSlowly(const char* text, const char* pattern, bool ignoreCase) {
    if (*pattern == '\0') {
        return *text == '\0';
    }
    if (*pattern == '*') {
        return MatchSlowly(text, pattern + 1, ignoreCase) ||
               (*text != '\0' && MatchSlowly(text + 1, pattern, ignoreCase));
    }
    const bool same = ignoreCase ? std::tolower(static_cast<unsigned char>(*text)) ==
                                       std::tolower(static_cast<unsigned char>(*pattern))
                                 : *text == *pattern;
    return *text != '\0' && same && MatchSlowly(text + 1, pattern + 1, ignoreCase);
}

TEST(Strmatch, AgreesWithASlowMatcherOnAllShortTexts) {
    Support::ForEachText("aA*", 4, [](const std::string& pattern) {
        Support::ForEachText("aA*", 4, [&](const std::string& text) {
            ASSERT_EQ(Port::strmatch(text.c_str(), pattern.c_str()),
                      MatchSlowly(text.c_str(), pattern.c_str(), false))
                << text << " against " << pattern;
            ASSERT_EQ(Port::strimatch(text.c_str(), pattern.c_str()),
                      MatchSlowly(text.c_str(), pattern.c_str(), true))
                << text << " against " << pattern;
        });
    });
}

TEST(Strmatch, KnowsNoOtherWildcard) {
    EXPECT_FALSE(Port::strmatch("a", "?"));
    EXPECT_TRUE(Port::strmatch("?", "?"));
    EXPECT_FALSE(Port::strmatch("a", "[a]"));
    EXPECT_TRUE(Port::strmatch("[a]", "[a]"));
    EXPECT_FALSE(Port::strmatch("*", "\\*"));
}

TEST(Strmatch, ReadsNullAsTheEmptyText) {
    EXPECT_TRUE(Port::strmatch(nullptr, nullptr));
    EXPECT_TRUE(Port::strmatch(nullptr, "*"));
    EXPECT_FALSE(Port::strmatch("a", nullptr));
    EXPECT_TRUE(Port::strimatch(nullptr, ""));
}

TEST(Strmatch, TakesLongTextsAndManyStarsInReasonableTime) {
    const std::string text(200000, 'a');
    EXPECT_TRUE(Port::strmatch(text.c_str(), "*a*a*a*a*a*a*a*a*"));
    EXPECT_FALSE(Port::strmatch(text.c_str(), "*a*a*a*a*a*a*a*b"));
    EXPECT_TRUE(Port::strimatch((text + "_dummy").c_str(), "*_DUMMY"));
}

} // namespace
