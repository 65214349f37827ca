#include "Port/Range.h"

#include "Support/ShortTexts.h"

#include <gtest/gtest.h>

#include <optional>
#include <regex>
#include <string>

namespace {

std::optional<Port_Range> Search(const char* pattern, std::string_view text) {
    Port_Range range(7, 9);
    if (Port_Regexp(pattern).Search(text, range)) {
        return range;
    }
    EXPECT_EQ(range, Port_Range(7, 9)) << "a search without a match left its mark";
    return std::nullopt;
}

/// The leftmost, longest match, by trying every piece of the text.
std::optional<Port_Range> SearchSlowly(const std::regex& pattern, const std::string& text) {
    for (std::size_t start = 0; start <= text.size(); ++start) {
        for (std::size_t length = text.size() - start + 1; length-- > 0;) {
            if (std::regex_match(text.substr(start, length), pattern)) {
                return Port_Range(start, length);
            }
        }
    }
    return std::nullopt;
}

TEST(PortRange, KnowsItsEnd) {
    const Port_Range range(3, 4);
    EXPECT_EQ(range.GetStart(), 3u);
    EXPECT_EQ(range.GetLength(), 4u);
    EXPECT_EQ(range.GetEnd(), 7u);
    EXPECT_NE(Port_Range(), Port_Range(0, 0)) << "a range of nothing stands before the text";
    EXPECT_NE(range, Port_Range(3, 5));
    EXPECT_NE(range, Port_Range(4, 4));
}

class PortRegexpPattern : public testing::TestWithParam<const char*> {};

TEST_P(PortRegexpPattern, FindsTheLeftmostLongestMatchInAllShortTexts) {
    const std::regex slow(GetParam());
    Support::ForEachText("aB1_-'", 4, [&](const std::string& text) {
        ASSERT_EQ(Search(GetParam(), text), SearchSlowly(slow, text)) << "'" << text << "'";
    });
}

INSTANTIATE_TEST_SUITE_P(Patterns, PortRegexpPattern,
                         testing::Values("[A-Za-z'_][A-Za-z0-9_]*", "[+-]?[0-9]+", "a", "aB", "a*",
                                         "a+", "a?", "a?aB?", "a*ab*", ".", ".*", ".+B", ".?1.?",
                                         "[aB]+[B1]+1", "a*a*a*B", "", "[_-]", "a?a?a?a?"));

TEST(PortRegexp, AnEmptyOrNullPatternMatchesTheEmptyText) {
    EXPECT_EQ(Search(nullptr, "abc"), Port_Range(0, 0));
    EXPECT_EQ(Search("", ""), Port_Range(0, 0));
}

TEST(PortRegexp, AClassWithoutItsEndReachesToTheEndOfThePattern) {
    EXPECT_EQ(Search("[ab", "xxb"), Port_Range(2, 1));
    EXPECT_EQ(Search("[ab+", "x+"), Port_Range(1, 1));
}

TEST(PortRegexp, MatchesBytesOfAnyValue) {
    EXPECT_EQ(Search(".", "\xFF"), Port_Range(0, 1));
    EXPECT_EQ(Search("[\x80-\xFF]+", "ab\x80\xFFz"), Port_Range(2, 2));
    EXPECT_EQ(Search("[A-Za-z]", "\xE4"), std::nullopt);
}

TEST(PortRegexp, SearchesAMillionCharactersWithoutOverflowingTheStack) {
    const std::string name(1000000, 'a');
    EXPECT_EQ(Search("[A-Za-z'_][A-Za-z0-9_]*", name), Port_Range(0, name.size()));
    EXPECT_EQ(Search("a*b", "b"), Port_Range(0, 1));
    EXPECT_EQ(Search("[0-9]+", name + "12"), Port_Range(name.size(), 2));
}

} // namespace
