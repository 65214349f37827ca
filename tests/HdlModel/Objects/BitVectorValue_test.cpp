#include "Orn_Hdl/Attributes.h"

#include <gtest/gtest.h>

#include <climits>
#include <string>

namespace {

using Orn_Hdl::BitVectorValue;

struct Expected {
    const char* text;
    const char* digits;
    int base;
    int length;
    bool hasBaseAndLength;
};

void PrintTo(const Expected& expected, std::ostream* out) {
    *out << '"' << expected.text << '"';
}

class BitVectorText : public testing::TestWithParam<Expected> {};

TEST_P(BitVectorText, IsReadAsTheRuleSays) {
    const Expected& expected = GetParam();
    const BitVectorValue value(expected.text);
    EXPECT_EQ(value.GetValue(), expected.digits);
    EXPECT_EQ(value.GetBase(), expected.base);
    EXPECT_EQ(value.GetLength(), expected.length);
    EXPECT_EQ(value.HasBaseAndLength(), expected.hasBaseAndLength);
}

INSTANTIATE_TEST_SUITE_P(
    Texts, BitVectorText,
    testing::Values(
        Expected{"4:B:1010", "1010", 2, 4, true}, Expected{"8:H:A5", "A5", 16, 8, true},
        Expected{"8:h:a5", "a5", 16, 8, true}, Expected{"6:O:17", "17", 8, 6, true},
        Expected{"6:octal:17", "17", 8, 6, true}, Expected{"6:b:17", "17", 2, 6, true},
        Expected{"6:X:17", "17", 2, 6, true}, Expected{"1010", "1010", 2, 1, false},
        Expected{"", "", 2, 1, false}, Expected{"4:B", "4:B", 2, 1, false},
        Expected{":B:1", ":B:1", 2, 1, false}, Expected{"::4::H::F::", "F", 16, 4, true},
        Expected{"8:H:A5:more", "A5", 16, 8, true}, Expected{" 8 :H:A5", "A5", 16, 8, true},
        Expected{"x:H:A5", "A5", 16, 0, true}, Expected{"-3:H:A5", "A5", 16, -3, true},
        Expected{"99999999999:H:A5", "A5", 16, INT_MAX, true},
        Expected{"8:H:zz zz", "zz zz", 16, 8, true}, Expected{"8: H:1", "1", 2, 8, true}));

TEST(BitVectorValue, StartsWithoutDigits) {
    const BitVectorValue value;
    EXPECT_EQ(value.GetValue(), "");
    EXPECT_EQ(value.GetBase(), 2);
    EXPECT_EQ(value.GetLength(), 1);
    EXPECT_FALSE(value.HasBaseAndLength());
}

TEST(BitVectorValue, ANewTextReplacesEverything) {
    BitVectorValue value("8:H:A5");
    value.SetValue("1");
    EXPECT_EQ(value.GetValue(), "1");
    EXPECT_EQ(value.GetBase(), 2);
    EXPECT_EQ(value.GetLength(), 1);
    EXPECT_FALSE(value.HasBaseAndLength());
    value.SetValue("8:H:A5");
    value.SetValue(nullptr);
    EXPECT_EQ(value.GetValue(), "");
    EXPECT_FALSE(value.HasBaseAndLength());
}

TEST(BitVectorValue, CanBeCopied) {
    BitVectorValue copy("1");
    {
        const BitVectorValue value("8:H:A5");
        copy = value;
    }
    const BitVectorValue second(copy);
    EXPECT_EQ(second.GetValue(), "A5");
    EXPECT_EQ(second.GetLength(), 8);
}

} // namespace
