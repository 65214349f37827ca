#include "Port/Ascii.h"

#include <gtest/gtest.h>

#include <string>

namespace {

TEST(Ascii, OnlyTheTenDigitsAreDigits) {
    for (int c = 0; c < 256; ++c) {
        EXPECT_EQ(Port::IsDigit(static_cast<char>(c)), c >= 48 && c <= 57) << c;
    }
}

TEST(Ascii, OnlyTheFiftyTwoLettersAreLettersAndHaveCase) {
    const std::string lower = "abcdefghijklmnopqrstuvwxyz";
    const std::string upper = "ABCDEFGHIJKLMNOPQRSTUVWXYZ";
    for (int i = 0; i < 256; ++i) {
        const char c = static_cast<char>(i);
        const std::size_t inLower = lower.find(c);
        const std::size_t inUpper = upper.find(c);
        EXPECT_EQ(Port::IsLetter(c), inLower != std::string::npos || inUpper != std::string::npos)
            << i;
        EXPECT_EQ(Port::ToUpper(c), inLower == std::string::npos ? c : upper[inLower]) << i;
        EXPECT_EQ(Port::ToLower(c), inUpper == std::string::npos ? c : lower[inUpper]) << i;
    }
}

TEST(Ascii, TextsAreEqualIgnoringTheCaseOfLettersOnly) {
    EXPECT_TRUE(Port::EqualIgnoringCase("", ""));
    EXPECT_TRUE(Port::EqualIgnoringCase("aBc_1", "AbC_1"));
    EXPECT_FALSE(Port::EqualIgnoringCase("abc", "abcd"));
    EXPECT_FALSE(Port::EqualIgnoringCase("@", "`"));
    EXPECT_FALSE(Port::EqualIgnoringCase("[", "{"));
    EXPECT_FALSE(Port::EqualIgnoringCase("\xC4", "\xE4"));
}

TEST(Ascii, ANullPointerReadsAsTheEmptyText) {
    EXPECT_EQ(Port::ViewOf(nullptr), "");
    EXPECT_EQ(Port::ViewOf("abc"), "abc");
}

} // namespace
