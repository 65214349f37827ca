// Verilog texts of extreme sizes and shapes: each is read, or refused with a message, in a time
// that grows with the text and no faster.
#include "Readers/ReadText.h"

#include <gtest/gtest.h>

#include <string>

namespace {

using Support::TextReader;

std::string Repeat(std::size_t count, const std::string& text) {
    std::string result;
    for (std::size_t i = 0; i < count; ++i) {
        result += text;
    }
    return result;
}

/// The first line of what reading fails with, without its place.
std::string ErrorOf(TextReader& reader, const std::string& text) {
    const std::string failure = reader.GetFailure(text);
    const std::string line = failure.substr(0, failure.find('\n'));
    const std::string mark = ": error: ";
    const std::size_t error = line.find(mark);
    return error == std::string::npos ? line : line.substr(error + mark.size());
}

std::string ErrorOf(const std::string& text) {
    TextReader reader;
    return ErrorOf(reader, text);
}

TEST(VerilogLimits, NestingIsRefusedWhereItIsTooDeep) {
    const std::string error = "an expression that is nested too deeply";
    EXPECT_EQ(ErrorOf("module m(input a, output b); assign b = " + Repeat(300'000, "{") + "a"),
              error);
    EXPECT_EQ(ErrorOf("module m(input a, output b); assign b = " + Repeat(300'000, "(") + "a"),
              error);
    EXPECT_EQ(ErrorOf("module m(input a, output b); assign b = " + Repeat(300'000, "{1{") + "a"),
              error);
    EXPECT_EQ(ErrorOf("module m; wire [" + Repeat(300'000, "(") + "3:0] a; endmodule"), error);
    EXPECT_EQ(ErrorOf("module m(input a, output b); assign b = " + Repeat(400, "{") + "a" +
                      Repeat(400, "}") + "; endmodule"),
              "");
}

TEST(VerilogLimits, NamesCommentsAndStringsHaveAnyLength) {
    const std::string longName(1'000'000, 'a');
    TextReader reader;
    reader.reader.KeepComments(true);
    EXPECT_EQ(ErrorOf(reader, "module m; /*" + longName + longName + "*/ wire " + longName +
                                  "; //" + longName + "\n(* A = \"" + longName + "\" *) wire \\." +
                                  longName + " ; endmodule"),
              "");
    EXPECT_NE(reader.model.GetSignal(longName.c_str()), nullptr);
    const Orn_Hdl::Signal* const escaped = reader.model.GetSignal((longName + "_2").c_str());
    ASSERT_NE(escaped, nullptr);
    EXPECT_EQ(escaped->GetAttr("A")->GetValueString().GetView().size(), longName.size());
    EXPECT_EQ(escaped->GetCommentView().size(), longName.size() + 1);
}

TEST(VerilogLimits, ALongNameIsShortenedInMessages) {
    const std::string longName(1'000'000, 'a');
    const std::string failure = TextReader().GetFailure("module m; wire w; assign w = " + longName);
    EXPECT_LT(failure.size(), 500U);
}

TEST(VerilogLimits, UnendedTextIsRefused) {
    EXPECT_EQ(ErrorOf("module m; /* " + Repeat(100'000, "* / \n")), "this comment does not end");
    EXPECT_EQ(ErrorOf("module m; (* A = \"" + std::string(1'000'000, 'x')),
              "this string does not end in its line");
    EXPECT_EQ(ErrorOf(Repeat(100'000, "`ifdef X\n")), "this directive has no `endif");
    EXPECT_EQ(ErrorOf(std::string(100'000, '\0')),
              "a character that Verilog has outside of comments and strings only: code 0");
    EXPECT_EQ(ErrorOf("module m(input a" + Repeat(100'000, ", a")),
              "the port \"a\" is declared already");
}

TEST(VerilogLimits, RangesReachToTheLargestIndex) {
    TextReader reader;
    EXPECT_EQ(ErrorOf(reader, "module m; wire [2147483647:0] w; wire a; assign a = w[2147483647];\n"
                              "endmodule"),
              "");
    EXPECT_EQ(ErrorOf("module m; wire [2147483648:0] w; endmodule"),
              "the index 2147483648 is too large");
    EXPECT_EQ(ErrorOf("module m; wire [2147483647:0] w; assign w = 0; endmodule"),
              "a constant of more than 1048576 bits");
    EXPECT_EQ(ErrorOf("module m; wire [2147483647:0] w; wire a; assign a = {w, w}; endmodule"),
              "4294967294 bits are assigned to 1");
    EXPECT_EQ(ErrorOf("module m(input [2147483647:0] a, output [2147483646:-1] b); endmodule"),
              "the port \"b\": a range with an index that no model has: from 0 to 2147483647 are "
              "possible");
}

TEST(VerilogLimits, NumbersOfManyDigitsAreReadOrRefused) {
    EXPECT_EQ(ErrorOf("module m; wire [3:0] w; assign w = " + std::string(100'000, '9') + ";"),
              "a decimal number of more than 300 digits");
    EXPECT_EQ(ErrorOf("module m; wire [3:0] w; assign w = 4'b" + std::string(1'000'000, '1') +
                      "; endmodule"),
              "");
    EXPECT_EQ(ErrorOf("module m; wire [1048575:0] w; assign w = {1048576{1'b1}}; endmodule"), "");
}

TEST(VerilogLimits, RepetitionsAndMacrosMakeNoMoreThanTheyMay) {
    EXPECT_EQ(ErrorOf("module m; wire a; wire [1:0] b;\n" +
                      Repeat(100, "assign b = {1000000{a}};\n") + "endmodule"),
              "1000000 bits are assigned to 2");
    std::string instances;
    for (int i = 0; i < 30; ++i) {
        instances += "REG #(.W({{900000{1'b1}}})) r" + std::to_string(i) + "();\n";
    }
    EXPECT_EQ(ErrorOf("module m; " + instances + "endmodule"),
              "the repetitions of this module are too long in all");
    std::string doubling = "`define M0 a\n";
    for (int i = 1; i < 60; ++i) {
        const std::string former = "`M" + std::to_string(i - 1);
        doubling += "`define M" + std::to_string(i) + " " + former + " " + former + "\n";
    }
    EXPECT_EQ(ErrorOf(doubling + "module m; `M59 endmodule"), "macros use each other too often");
}

/// A macro that uses another one, and so on.
std::string NestedMacros(int count) {
    std::string text = "`define M1 wire w;\n";
    for (int i = 2; i <= count; ++i) {
        text += "`define M" + std::to_string(i) + " `M" + std::to_string(i - 1) + "\n";
    }
    return text + "module m; `M" + std::to_string(count) + "\nendmodule";
}

/// A text that includes a file that includes another one, and so on.
std::string NestedFiles(TextReader& reader, int count) {
    std::string text = "// the innermost one\n";
    for (int i = 1; i <= count; ++i) {
        const std::string name = "f" + std::to_string(i) + ".v";
        reader.Put(name.c_str(), text);
        text = "`include \"" + name + "\"\n";
    }
    return text + "module m; endmodule";
}

TEST(VerilogLimits, MacrosAndFilesNestSixtyThreeTimes) {
    constexpr int Most = 63;
    TextReader reader;
    EXPECT_EQ(ErrorOf(reader, NestedMacros(Most)), "");
    EXPECT_NE(reader.model.GetSignal("w"), nullptr);
    EXPECT_EQ(ErrorOf(reader, NestedMacros(Most + 1)), "macros use each other too often");
    EXPECT_EQ(ErrorOf(reader, NestedFiles(reader, Most)), "");
    EXPECT_EQ(ErrorOf(reader, NestedFiles(reader, Most + 1)), "too many files include each other");
}

TEST(VerilogLimits, MillionsOfSmallThingsAreRead) {
    std::string text = "module m; wire a;\n";
    for (int i = 0; i < 20'000; ++i) {
        const std::string number = std::to_string(i);
        text +=
            "wire \\w." + number + " ; INV u" + number + "(.I(1'b0), .O(\\w." + number + " ));\n";
    }
    TextReader reader;
    EXPECT_EQ(ErrorOf(reader, text + "endmodule"), "");
    EXPECT_NE(reader.model.GetSignal("w_19999"), nullptr);
    std::string clashes = "module m;\n";
    for (int i = 0; i < 5'000; ++i) {
        clashes += "wire \\a" + std::string(static_cast<std::size_t>(i % 50), '.') +
                   std::to_string(i) + ". ;\n";
    }
    EXPECT_EQ(ErrorOf(reader, clashes + "endmodule"), "");
    EXPECT_EQ(ErrorOf("module m(" + Repeat(50'000, "input ") + "a); endmodule").substr(0, 10),
              "\"input\" is");
}

} // namespace
