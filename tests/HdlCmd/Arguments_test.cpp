// The texts and flags that a command takes from its line.

#include "HdlCmd/Arguments.h"

#include <gtest/gtest.h>

#include <string>

using namespace Orn_Hdl;

namespace {

enum class Flag { First, Second };

} // namespace

TEST(CommandArguments, AreTheTextsThatWereSet) {
    for (std::size_t size = 0; size <= 80; ++size) {
        const std::string text(size, 'x');
        Arguments arguments;
        arguments.Set({text, "", "y", text, "z"});
        EXPECT_EQ(arguments.Get(0), text);
        EXPECT_STREQ(arguments.Get(1), "");
        EXPECT_STREQ(arguments.Get(2), "y");
        EXPECT_EQ(arguments.Get(3), text);
        EXPECT_STREQ(arguments.Get(4), "z");
    }
}

TEST(CommandArguments, EndAtTheirFirstNul) {
    using namespace std::string_view_literals;
    Arguments arguments;
    arguments.Set({"a\0b"sv, "\0"sv, "c"});
    EXPECT_STREQ(arguments.Get(0), "a");
    EXPECT_STREQ(arguments.Get(1), "");
    EXPECT_STREQ(arguments.Get(2), "c");
}

TEST(CommandArguments, CanBeSetAgain) {
    Arguments arguments;
    arguments.Set({std::string(500, 'x'), "second"});
    arguments.Set({"a"});
    EXPECT_STREQ(arguments.Get(0), "a");
    EXPECT_STREQ(arguments.Get(1), "");
    arguments.Set({std::string(1000, 'x')});
    EXPECT_EQ(arguments.Get(0), std::string(1000, 'x'));
}

TEST(CommandArguments, ThatAreMissingReadAsEmpty) {
    Arguments arguments;
    EXPECT_STREQ(arguments.Get(0), "");
    arguments.Set({"a", ""});
    for (const int index : {-1, 1, 2, 1000}) {
        EXPECT_STREQ(arguments.Get(index), "") << index;
    }
}

TEST(CommandArguments, HaveFlagsUntilTheyAreSetAgain) {
    Arguments arguments;
    arguments.Set({});
    EXPECT_FALSE(arguments.Has(Flag::First));
    arguments.Raise(Flag::Second);
    EXPECT_FALSE(arguments.Has(Flag::First));
    EXPECT_TRUE(arguments.Has(Flag::Second));
    arguments.Raise(Flag::First);
    EXPECT_TRUE(arguments.Has(Flag::First));
    EXPECT_TRUE(arguments.Has(Flag::Second));
    arguments.Set({"a"});
    EXPECT_FALSE(arguments.Has(Flag::First));
    EXPECT_FALSE(arguments.Has(Flag::Second));
}
