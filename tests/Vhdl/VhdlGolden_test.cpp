// The golden designs as VHDL.

#include "Support/Golden.h"

#include <gtest/gtest.h>

#include <string>

using Support::GoldenDesign;
using Support::GoldenNames;
using Support::GoldenText;

namespace {

class VhdlGolden : public testing::TestWithParam<std::string> {};

} // namespace

TEST_P(VhdlGolden, IsWrittenToTheByte) {
    GoldenDesign design(GetParam());
    EXPECT_EQ(design.Vhdl(), GoldenText(GetParam() + ".vhd"));
}

TEST_P(VhdlGolden, IsTheSameWhenWrittenAgain) {
    GoldenDesign design(GetParam());
    const std::string first = design.Vhdl();
    EXPECT_EQ(design.Vhdl(), first);
    EXPECT_EQ(design.Vhdl(), first);
}

TEST_P(VhdlGolden, IsTheSameAfterVerilog) {
    GoldenDesign design(GetParam());
    const std::string golden = Support::GoldenTextAfterOther(GetParam(), "verilog", ".vhd");
    for (int i = 0; i < 2; ++i) {
        design.Verilog();
        EXPECT_EQ(design.Vhdl(), golden);
    }
}

TEST_P(VhdlGolden, HasTheBannerBeforeIt) {
    GoldenDesign design(GetParam());
    const std::string golden = GoldenText(GetParam() + ".vhd");
    const std::string text = design.Vhdl("");
    ASSERT_GT(text.size(), golden.size());
    EXPECT_EQ(text.substr(text.size() - golden.size()), golden);
    for (const std::string& line :
         Support::SplitLines(text.substr(0, text.size() - golden.size()))) {
        EXPECT_EQ(line.substr(0, 2), "--");
    }
}

INSTANTIATE_TEST_SUITE_P(Designs, VhdlGolden, testing::ValuesIn(GoldenNames()),
                         [](const auto& test) { return test.param; });
