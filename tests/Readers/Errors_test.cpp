// What the Verilog reader refuses: the text of each error and its place.
#include "Readers/ReadText.h"

#include <gtest/gtest.h>

#include <string>

namespace {

using Support::TextReader;

struct Refused {
    /// What is read, with a "^" in front of the place of the error.
    const char* text;
    const char* error;
};

/// Takes the mark out of a text. \return LINE:COLUMN of the mark.
std::string TakeMark(std::string& text) {
    const std::size_t mark = text.find('^');
    text.erase(mark, 1);
    std::size_t line = 1;
    std::size_t start = 0;
    for (std::size_t i = 0; i < mark; ++i) {
        if (text[i] == '\n') {
            ++line;
            start = i + 1;
        }
    }
    return std::to_string(line) + ":" + std::to_string(mark - start + 1);
}

constexpr Refused Table[] = {
    // Behaviour.
    {"module m(input a);\n  ^always @(a) b = a;\nendmodule",
     "\"always\" describes behaviour: synthesise the design first"},
    {"module m; ^initial x = 1; endmodule",
     "\"initial\" describes behaviour: synthesise the design first"},
    {"module m; ^reg r; endmodule", "\"reg\" describes behaviour: synthesise the design first"},
    {"module m; ^function f; input i; f = i; endfunction endmodule",
     "\"function\" describes behaviour: synthesise the design first"},
    {"module m; ^genvar i; endmodule",
     "\"genvar\" describes behaviour: synthesise the design first"},
    {"module m(input a, output b); assign b = ^~a; endmodule",
     "the operator \"~\" describes behaviour: synthesise the design first"},
    {"module m(input a, output b); assign b = a ^& a; endmodule",
     "the operator \"&\" describes behaviour: synthesise the design first"},
    {"module m(input a, output b); assign b = a ^? a : a; endmodule",
     "the operator \"?\" describes behaviour: synthesise the design first"},
    {"module m(output b); assign b = ^f(1); endmodule",
     "the function \"f\" describes behaviour: synthesise the design first"},
    {"module m(output b); assign b = ^$random; endmodule",
     "the function \"$random\" describes behaviour: synthesise the design first"},
    {"module m(output b); ^$display; endmodule",
     "a declaration, an assignment or an instance is expected here, not \"$display\""},
    // What a model cannot say.
    {"module m(input a, output b); ^not u(b, a); endmodule",
     "the gate \"not\": a model's instances are of modules with named ports; map gates to cells of "
     "a library first"},
    {"module m; ^wand w; endmodule", "nets of the kind \"wand\": a model has wires alone"},
    {"module m; wire ^#3 w; endmodule", "a delay of a net: a model has none"},
    {"module m; wire ^(strong0, weak1) w = 0; endmodule", "a strength of a net: a model has none"},
    {"module m(output a); assign ^#1 a = 0; endmodule",
     "a delay of an assignment: a model has none"},
    {"module m; INV ^u[3:0](); endmodule",
     "the array of instances \"u\": a model has single instances"},
    {"module m; wire ^w [3:0]; endmodule", "the array \"w\": a model has nets and buses alone"},
    {"module m; wire ^[3:-1] w; endmodule",
     "the negative index -1, which no name in a model can have"},
    {"module m; wire [^99999999999:0] w; endmodule", "an index whose value cannot be told"},
    {"module m; wire [3:0] w; wire v; assign v = w^[-1]; endmodule",
     "the negative index -1, which no name in a model can have"},
    {"module m; wire [3:0] w; wire v; assign v = w^[4]; endmodule",
     "there is no bit 4 in \"w(3:0)\""},
    {"module m; wire [3:0] w; wire [1:0] v; assign v = w^[4:3]; endmodule",
     "the part 4:3 is not within \"w(3:0)\""},
    {"module m; wire [3:0] w; wire [1:0] v; assign v = w^[0:1]; endmodule",
     "the part 0:1 runs against its net \"w(3:0)\""},
    {"module m; wire [3:0] w; wire v; assign v = w[2:1]^[1]; endmodule",
     "a part of a part of a net, which a model cannot name"},
    {"module m; wire w, v; assign v = ^w[0]; endmodule",
     "\"w\" is a net of one bit and has no range"},
    {"module m; wire w; INV u(); assign w = ^u.x; endmodule",
     "a name of another level of the design: a model has one level"},
    {"module m; wire w; assign w = ^1'bx; endmodule",
     "the digit x: a model has the values 0 and 1 alone"},
    {"module m; wire [3:0] w; assign w = ^4'b10Z0; endmodule",
     "the digit Z: a model has the values 0 and 1 alone"},
    {"module m; INV u(.I(^1'b?)); endmodule", "the digit ?: a model has the values 0 and 1 alone"},
    {"module m; wire w; assign w = ^1'b2; endmodule", "the digit 2 in a number of base 2"},
    {"module m; wire w; assign w = ^2.5; endmodule", "a real number is no value of a net"},
    {"module m; wire w; assign w = ^\"a\"; endmodule", "a string is no value of a net"},
    {"module m; wire w; assign w = 0; assign w = ^1; endmodule",
     "\"w\" has a constant already, and a model has one"},
    {"module m; wire w; assign w = ^w; endmodule", "\"w\" is assigned to itself"},
    {"module m; wire w; assign ^1'b0 = w; endmodule", "a constant on the left of an assignment"},
    {"module m; wire w; assign ^{w, 1'b0} = w; endmodule",
     "a constant on the left of an assignment"},
    {"module m; wire [3:0] w; wire [1:0] v; assign w = ^v; endmodule", "2 bits are assigned to 4"},
    {"module m #(parameter W = 1)(); wire [^W:0] w; endmodule",
     "this depends on the parameter \"W\", which a model cannot say: make it a localparam"},
    {"module ^m #(parameter W = 1)(input [W:0] a); endmodule",
     "the port \"a\" depends on the parameter \"W\", which a model cannot say: make it a "
     "localparam"},
    {"module m #(parameter W = 1)(); REG #(.W(^W)) u(); endmodule",
     "the parameter \"W\" as a value: a model passes no parameter on but INIT in a module with "
     "MHALVEX or HHALVEX in its name"},
    {"module ^m(.a(b)); input b; endmodule", "the port \"a\": a port that is an expression"},
    {"module ^m(input a [3:0]); endmodule", "the port \"a\": an array of ports"},
    {"module m; wire w; INV u(.^*); endmodule",
     "the connection \".*\": write the connections one by one"},
    {"module P #(parameter W = 1)(input [W:0] a); endmodule\n"
     "module m; P #(^.W(2)) u(); endmodule",
     "the port \"a\" of \"P\" depends on this parameter, and a model's components have pins of "
     "fixed ranges"},
    {"module m; REG #(.W(^99999999999)) u(); endmodule",
     "the number 99999999999 does not fit in the 32 bits that a model's integers have"},
    {"primitive p(o, i); output o; input i; table 0 : 1; endtable endprimitive\n"
     "module m; wire a, b; ^p u(a, b); endmodule",
     "the module \"p\" cannot be a component: it is a primitive, whose ports have no names"},
    {"module C(input A, a); endmodule\nmodule m; ^C u(); endmodule",
     "the module \"C\" cannot be a component: its port \"a\" is one that a model does not tell "
     "from "
     "another one"},
    {"module C(input A); endmodule\nmodule c(input A); endmodule\n"
     "module m; C u(); ^c v(); endmodule",
     "the module \"c\" cannot be a component: a model does not tell it from another component, "
     "whose name differs in letter case alone"},
    // Declarations.
    {"module m; wire w; wire ^w; endmodule", "\"w\" is declared already"},
    {"module m; INV u(); wire ^u; endmodule", "\"u\" is declared already, as an instance"},
    {"module m; wire u; INV ^u(); endmodule", "\"u\" is declared already"},
    {"module m(input [3:0] a); wire [4:0] ^a; endmodule", "\"a\" is a port of another range"},
    {"module m(a); input a, ^b; endmodule", "\"b\" is not in the list of ports"},
    {"module ^m(a); endmodule", "the port \"a\" has no direction"},
    {"module m(a, ^a); input a; endmodule", "the port \"a\" is declared already"},
    {"module m; wire w; assign w = ^x; endmodule", "the net \"x\" is not declared"},
    {"module m; wire w; assign w = ^x[3]; endmodule", "the net \"x\" is not declared"},
    {"`default_nettype none\nmodule m; INV u(^x); endmodule", "the net \"x\" is not declared"},
    {"module m; wire w; INV u(); assign w = ^u; endmodule", "\"u\" is an instance and no net"},
    {"module m; wire ^begin; endmodule",
     "\"begin\" is a keyword and no name of a net unless a backslash stands before it"},
    {"module x; endmodule module ^x; endmodule",
     "the module \"x\" is declared already, in top.v:1:8"},
    // Instances.
    {"module m; ^MISSING u(); endmodule",
     "the module \"MISSING\" is not declared: a library file has to say which ports it has"},
    {"module m; INV ^(); endmodule", "an instance of \"INV\" without a name"},
    {"module m; wire w; INV u(.^X(w)); endmodule", "the module \"INV\" has no port \"X\""},
    {"module m; wire w; INV u(.I(w), .^I(w)); endmodule", "the port \"I\" is connected already"},
    {"module m; wire w; INV u(w, w, ^w); endmodule",
     "the module \"INV\" has 2 ports and no further one"},
    {"module m; wire w; INV u(.I(w), ^w); endmodule",
     "connections by name and by position in one instance"},
    {"module m; wire [1:0] w; INV u(.^I(w)); endmodule",
     "the port \"I\" of \"INV\" has 1 bit, and 2 are connected to it"},
    {"module m; INV u(.I^); endmodule", "the net \"I\" is not declared"},
    {"module m; REG #(^.X(1)) u(); endmodule", "the module \"REG\" has no parameter \"X\""},
    {"module m; REG #(1, 2, 3, ^4) u(); endmodule",
     "the module \"REG\" has no further parameter that this could be the value of"},
    {"module m; defparam ^u.W = 1; endmodule", "the instance \"u\" is not declared"},
    {"module m; REG u(); defparam ^u.v.W = 1; endmodule",
     "a name of another level of the design: a model has one level"},
    {"module m; wire w; REG #(.W(^{w, w})) u(); endmodule", "a net as the value of a parameter"},
    {"module m; wire [1:0] w; assign w = {1'b0, ^1}; endmodule",
     "a constant in a concatenation needs a size"},
    {"module m; wire w; assign w = {^0{w}}; endmodule",
     "a repetition of so many bits: from 1 to 1048576 can be read"},
    {"module m; wire w; assign w = {^2000000{w}}; endmodule",
     "a repetition of so many bits: from 1 to 1048576 can be read"},
    // Text.
    {"module m; wire w^", "\";\" is expected here, not the end of the file"},
    {"module ^m; wire w;\n", "\"endmodule\" does not follow this"},
    {"module m; wire w ^endmodule", "\";\" is expected here, not \"endmodule\""},
    {"module m; wire w; ^/* never", "this comment does not end"},
    {"module m; ^(* a = \"b\" , ", "\"*)\" does not follow this"},
    {"module m; (* a = ^) *) wire w; endmodule",
     "a number or a string is expected here, not \")\""},
    {"module m; wire ^\\ ; endmodule", "a backslash that no name follows"},
    {"module m; wire w; assign w = ^1'; endmodule",
     "an apostrophe that no base of a number follows"},
    {"module m; wire w; assign w = ^1'b; endmodule", "a base without digits"},
    {"module m; wire w; assign w = ^0'b1; endmodule",
     "a number of 0 bits: from 1 to 1048576 can be read"},
    {"module m; wire w; assign w = ^9999999'b1; endmodule",
     "a number of 9999999 bits: from 1 to 1048576 can be read"},
    {"module m; REG #(.NAME(^\"x\n\")) u(); endmodule", "this string does not end in its line"},
    {"module m; wire ^\x01; endmodule",
     "a character that Verilog has outside of comments and strings only: code 1"},
    {"^wire w;", "a module is expected here, not \"wire\""},
    // Directives.
    {"^`ifdef X\nmodule m; endmodule", "this directive has no `endif"},
    {"^`endif", "no `ifdef is open to which this directive could belong"},
    {"`ifdef A\n`else\n^`else\n`endif", "no `ifdef is open to which this directive could belong"},
    {"module m; ^`NONE endmodule", "the macro \"`NONE\" is not defined"},
    {"`define F(x) x\nmodule m; ^`F(1) endmodule",
     "the macro \"`F\" has arguments: have them replaced first, by iverilog -E for example"},
    {"`define A `A\nmodule m; ^`A endmodule", "macros use each other too often"},
    {"^`include \"none.v\"\nmodule m; endmodule",
     "cannot open \"none.v\": No such file or directory"},
    {"^`include none\nmodule m; endmodule", "`include without the name of a file"},
    {"^`include \"top.v\"\n", "too many files include each other"},
    {"^`unconnected_drive pull1\nmodule m; endmodule",
     "`unconnected_drive: a model leaves open pins open"},
    {"^`default_nettype wor\nmodule m; endmodule", "`default_nettype wor: a model has wires alone"},
    {"^`define", "`define without a name"},
    {"^` x", "no directive follows the accent"},
};

TEST(VerilogErrors, HaveTheirTextAndPlace) {
    for (const Refused& row : Table) {
        std::string text = row.text;
        const std::string place = TakeMark(text);
        SCOPED_TRACE(text);
        TextReader reader;
        const std::string failure = reader.GetFailure(text);
        EXPECT_EQ(failure.substr(0, failure.find('\n')),
                  "top.v:" + place + ": error: " + row.error);
    }
}

TEST(VerilogErrors, ShowTheLineAndACaret) {
    TextReader reader;
    EXPECT_EQ(reader.GetFailure("module m;\n\twire\tw; wire w;\nendmodule"),
              "top.v:2:15: error: \"w\" is declared already\n"
              " wire w; wire w;\n"
              "              ^\n");
}

TEST(VerilogErrors, ShowAPartOfALongLine) {
    TextReader reader;
    const std::string failure =
        reader.GetFailure("module m; " + std::string(100'000, ' ') + "wire w, w; endmodule" +
                          std::string(100'000, ' ') + "// end");
    EXPECT_EQ(failure, "top.v:1:100019: error: \"w\" is declared already\n" + std::string(62, ' ') +
                           "wire w, w; endmodule\n" + std::string(70, ' ') + "^\n");
}

TEST(VerilogErrors, AreToldForAFileAsAWhole) {
    TextReader reader;
    EXPECT_EQ(reader.GetFailure(""),
              "top.v: error: there is no module that no other one instantiates\n");
    EXPECT_EQ(reader.GetFailure("module a; endmodule module b; endmodule"),
              "top.v: error: no module instantiates \"a\", \"b\": say which one to read\n");
    EXPECT_EQ(reader.GetFailure("module a; b u(); endmodule module b; a u(); endmodule"),
              "top.v: error: there is no module that no other one instantiates\n");
    reader.reader.SetTop("c");
    EXPECT_EQ(reader.GetFailure("module a; endmodule"), "top.v: error: there is no module \"c\"\n");
    const std::string missing =
        Support::FailureOf([&reader] { reader.reader.Read("/no/such/file.v", reader.model); });
    EXPECT_EQ(missing, "/no/such/file.v: error: cannot open \"/no/such/file.v\": No such file or "
                       "directory\n");
}

TEST(VerilogErrors, LeaveTheModelAsItWas) {
    TextReader reader;
    reader.Read("module before(input a); endmodule");
    reader.model.SetModifiedFlag(false);
    EXPECT_NE(reader.GetFailure("module after(input b); always ;"), "");
    EXPECT_EQ(std::string(reader.model.GetName().GetView()), "before");
    EXPECT_NE(reader.model.GetSignal("a"), nullptr);
    EXPECT_EQ(reader.model.GetSignal("b"), nullptr);
    EXPECT_FALSE(reader.model.IsModified());
}

} // namespace
