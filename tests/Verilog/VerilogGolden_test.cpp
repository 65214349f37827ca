// The golden designs as Verilog.

#include "Support/Golden.h"
#include "Verilog/Dialects.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

using Support::GoldenDesign;
using Support::GoldenNames;
using Support::GoldenText;

namespace {

class VerilogGolden : public testing::TestWithParam<std::string> {};

} // namespace

TEST_P(VerilogGolden, IsWrittenToTheByte) {
    GoldenDesign design(GetParam());
    EXPECT_EQ(design.Verilog(), GoldenText(GetParam() + ".v"));
}

TEST_P(VerilogGolden, IsTheSameWhenWrittenAgain) {
    GoldenDesign design(GetParam());
    const std::string first = design.Verilog();
    EXPECT_EQ(design.Verilog(), first);
    EXPECT_EQ(design.Verilog(), first);
}

TEST_P(VerilogGolden, IsTheSameAfterVhdl) {
    GoldenDesign design(GetParam());
    const std::string golden = Support::GoldenTextAfterOther(GetParam(), "vhdl", ".v");
    for (int i = 0; i < 2; ++i) {
        design.Vhdl();
        EXPECT_EQ(design.Verilog(), golden);
    }
}

TEST_P(VerilogGolden, HasTheBannerBeforeIt) {
    GoldenDesign design(GetParam());
    const std::string golden = GoldenText(GetParam() + ".v");
    const std::string text = design.Verilog("");
    ASSERT_GT(text.size(), golden.size());
    EXPECT_EQ(text.substr(text.size() - golden.size()), golden);
    for (const std::string& line :
         Support::SplitLines(text.substr(0, text.size() - golden.size()))) {
        EXPECT_EQ(line.substr(0, 2), "//");
    }
}

INSTANTIATE_TEST_SUITE_P(Designs, VerilogGolden, testing::ValuesIn(GoldenNames()),
                         [](const auto& test) { return test.param; });

namespace {

/// The names of the synthesis dialects but for the default, whose output is the design's own golden
/// file.
std::vector<std::string> OtherDialects() {
    std::vector<std::string> names;
    for (const Orn_Hdl::Dialect& dialect : Orn_Hdl::Dialects) {
        names.emplace_back(dialect.name);
    }
    names.erase(names.begin());
    return names;
}

class SynthesisDialects : public testing::TestWithParam<std::string> {};

} // namespace

TEST_P(SynthesisDialects, AreWrittenToTheByte) {
    GoldenDesign design("synthesis_attributes");
    design.Run(std::string("SET SYNTHESIS ") + GetParam());
    EXPECT_EQ(design.Verilog(),
              GoldenText(std::string("synthesis_attributes.") + GetParam() + ".v"));
}

TEST_P(SynthesisDialects, FallBackToTheDefault) {
    GoldenDesign design("synthesis_attributes");
    design.Run(std::string("SET SYNTHESIS ") + GetParam());
    design.Verilog();
    for (const char* other : {"QSN", "qsn", "unknown"}) {
        design.Run(std::string("SET SYNTHESIS ") + other);
        EXPECT_EQ(design.Verilog(), GoldenText("synthesis_attributes.v"));
    }
}

INSTANTIATE_TEST_SUITE_P(Tools, SynthesisDialects, testing::ValuesIn(OtherDialects()));

TEST(SynthesisDialectTable, HasSixRows) {
    EXPECT_EQ(OtherDialects(), (std::vector<std::string>{"EXEMPLAR", "SYNPLICITY", "SYNOPSYS",
                                                         "VERILOG2001", "PRECISION"}));
}

TEST(VerilogAndGate, IsWrittenAsItStandsHere) {
    GoldenDesign design("and_gate_located");
    EXPECT_EQ(design.Verilog(), "`timescale 1ns / 1ps\n"
                                "\n"
                                "module top(A, \n"
                                "           Y);\n"
                                "\n"
                                "    input [1:0] A;\n"
                                "   output Y;\n"
                                "\n"
                                "   wire n1;\n"
                                "\n"
                                "   AND2 U1 (.I0(A[0]), \n"
                                "            .I1(n1), \n"
                                "            .O(Y));\n"
                                "   // synthesis attribute LOC of U1 is \"P1\"\n"
                                "endmodule\n");
}
