// What the Verilog reader accepts, and what becomes of it.
#include "Readers/ReadText.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace {

using Support::TextReader;

struct Accepted {
    const char* what;
    /// The module as it is read.
    const char* text;
    /// The lines that the model is written in, blanks at their ends left out.
    const char* written;
};

/// The lines that are not empty, without blanks around them.
std::string Essence(const std::string& text) {
    std::string result;
    for (std::string line : Support::SplitLines(text)) {
        line.erase(0, line.find_first_not_of(' '));
        line.erase(line.find_last_not_of(' ') + 1);
        if (!line.empty()) {
            result += line + "\n";
        }
    }
    return result;
}

constexpr Accepted Table[] = {
    {"no ports", "module m; endmodule", "module m();\nendmodule\n"},
    {"no ports in parentheses", "module m(); endmodule", "module m();\nendmodule\n"},
    {"ports without ANSI",
     "module m(a, b, c, d); input a, c; output [7:0] b; inout [0:3] d; wire a; wire [7:0] b;\n"
     "endmodule",
     "module m(a, c, b, d);\ninput a;\ninput c;\noutput [7:0] b;\ninout [0:3] d;\nendmodule\n"},
    {"ports with ANSI",
     "module m(input a, input wire [7:0] b, c, output d, inout tri [3:3] e, output logic f);\n"
     "endmodule",
     "module m(a, b, c, d, f, e);\ninput a;\ninput [7:0] b;\ninput [7:0] c;\noutput d;\n"
     "output f;\ninout [3:3] e;\nendmodule\n"},
    {"nets of all kinds",
     "module m; wire a, b; tri [3:0] c; wire signed [0:1] d; uwire e; wire vectored [1:0] f;\n"
     "logic g; supply0 h; supply1 [1:0] i; endmodule",
     "module m();\nwire a;\nwire b;\nwire [3:0] c;\nwire [0:1] d;\nwire e;\nwire [1:0] f;\n"
     "wire g;\nwire h;\nwire [1:0] i;\nassign h = 0;\nassign i = 2'b11;\nendmodule\n"},
    {"assignments of nets, slices, bits and concatenations",
     "module m; wire a, b; wire [7:0] c, d; assign a = b, c[3] = a; assign c[2:1] = d[7:6];\n"
     "assign {c[7:6], a} = {d[1:0], b}; assign d = {c[3:0], {2{a, b}}}; endmodule",
     "module m();\nwire a;\nwire b;\nwire [7:0] c;\nwire [7:0] d;\nassign a = b;\n"
     "assign c[2:1] = d[7:6];\nassign c[3] = a;\n"
     "assign {c[7:6], a} = {d[1:0], b};\nassign d[7:0] = {c[3:0], a, b, a, b};\nendmodule\n"},
    {"parts counted from an index",
     "module m; wire [7:0] a; wire [0:7] b; wire [1:0] c; assign c = a[2 +: 2];\n"
     "assign a[7 -: 2] = b[1 +: 2]; endmodule",
     "module m();\nwire [7:0] a;\nwire [0:7] b;\nwire [1:0] c;\nassign a[7:6] = b[1:2];\n"
     "assign c[1:0] = a[3:2];\nendmodule\n"},
    {"the whole of a bus is the bus, a bit of a bus of one bit is a bit",
     "module m; wire [3:0] a; wire [2:2] b, c; assign a[3:0] = 4'h5; assign b = 1'b1;\n"
     "INV u(.I(b[2:2]), .O(c[2])); endmodule",
     "module m();\nwire [3:0] a;\nwire [2:2] b;\nwire [2:2] c;\nassign a = 4'h5;\n"
     "assign b = 1'b1;\nINV u (.I(b[2]), .O(c[2]));\nendmodule\n"},
    {"constants",
     "module m; wire a, b; wire [3:0] c, d; wire [7:0] f, g, h, i, j, k; wire [5:0] l, n;\n"
     "assign a = 0, b = 3, c = 4'b10_10, d = 10, f = 8'hF, g = 4'b1111, h = 4'sb1111;\n"
     "assign i = 16'h1234, j = 'hA5, k = {4{2'b01}}, l = 6 'o 17, n = 6'h3F; endmodule",
     "module m();\nwire a;\nwire b;\nwire [3:0] c;\nwire [3:0] d;\nwire [7:0] f;\nwire [7:0] g;\n"
     "wire [7:0] h;\nwire [7:0] i;\nwire [7:0] j;\nwire [7:0] k;\nwire [5:0] l;\nwire [5:0] n;\n"
     "assign a = 0;\nassign b = 1;\nassign c = 4'b1010;\nassign d = 4'b1010;\n"
     "assign f = 8'h0F;\nassign g = 8'b00001111;\nassign h = 8'b11111111;\n"
     "assign i = 8'b00110100;\nassign j = 8'b10100101;\nassign k = 8'b01010101;\n"
     "assign l = 6'o17;\nassign n = 6'b111111;\nendmodule\n"},
    {"constants of parts, and of pins",
     "module m; wire [3:0] a; wire b; assign a[1:0] = 2'b01, a[2] = 1'b1; assign {b, a[3]} = '1;\n"
     "REG u(.C(1'b0), .D(4'hA)); REG v(.D({b, 2'b10, b})); endmodule",
     "module m();\nwire [3:0] a;\nwire b;\nwire const_0;\nwire const_1;\nwire u_C_CONST_SIGNAL;\n"
     "wire [3:0] u_D_CONST_SIGNAL;\nassign a[1:0] = 2'b01;\nassign a[2] = 1;\n"
     "assign {b, a[3]} = 2'b11;\nassign const_0 = 0;\nassign const_1 = 1;\n"
     "assign u_C_CONST_SIGNAL = 0;\nassign u_D_CONST_SIGNAL = 4'hA;\n"
     "REG u (.C(u_C_CONST_SIGNAL), .D(u_D_CONST_SIGNAL[3:0]), .Q());\n"
     "REG v (.C(), .D({b, const_1, const_0, b}), .Q());\nendmodule\n"},
    {"a net declared with its driver", "module m; wire a; wire [1:0] b = {a, 1'b0}; endmodule",
     "module m();\nwire a;\nwire [1:0] b;\nwire const_0;\nassign const_0 = 0;\n"
     "assign b[1:0] = {a, const_0};\nendmodule\n"},
    {"instances by name, by position, several in one statement, open pins",
     "module m(input a, output [3:0] y); wire n; INV u1(.O(n), .I(a)), u2(n, y[0]);\n"
     "AND2 u3(a, , y[1]), u4(); AND2 u5(.I0(a), .I1(), .O(y[2])); endmodule",
     "module m(a, y);\ninput a;\noutput [3:0] y;\nwire n;\nINV u1 (.I(a), .O(n));\n"
     "INV u2 (.I(n), .O(y[0]));\nAND2 u3 (.I0(a), .I1(), .O(y[1]));\n"
     "AND2 u4 (.I0(), .I1(), .O());\nAND2 u5 (.I0(a), .I1(), .O(y[2]));\nendmodule\n"},
    {"connections by name alone", "module m; wire I, O; INV u(.I, .O); endmodule",
     "module m();\nwire I;\nwire O;\nINV u (.I(I), .O(O));\nendmodule\n"},
    {"undeclared nets", "module m(input a); INV u(a, n); assign o = n; endmodule",
     "module m(a);\ninput a;\nwire n;\nwire o;\nassign o = n;\nINV u (.I(a), .O(n));\nendmodule\n"},
    {"ascending ranges",
     "module m; wire [0:3] a; wire b; UP u(.A(a), .P(b));\n"
     "UP v(.A({a[0:1], a[2], b})); endmodule",
     "module m();\nwire [0:3] a;\nwire b;\nUP u (.A(a[0:3]), .P(b));\n"
     "UP v (.A({a[0:1], a[2], b}), .P());\nendmodule\n"},
    {"parameters",
     "module m; REG #(.INIT(8'hA5), .NAME(\"x\")) u1(); REG #(5, 8'b1) u2(); endmodule",
     "module m();\nREG u1 (.C(), .D(), .Q());\ndefparam u1.INIT = 8'hA5;\n"
     "defparam u1.NAME = \"x\";\ndefparam u1.W = 4;\nREG u2 (.C(), .D(), .Q());\n"
     "defparam u2.W = 5;\ndefparam u2.INIT = 8'b00000001;\ndefparam u2.NAME = \"none\";\n"
     "endmodule\n"},
    {"defparam in front of its instance",
     "module m; defparam u.W = 7, u.NAME = \"n\"; REG u(); endmodule",
     "module m();\nREG u (.C(), .D(), .Q());\ndefparam u.W = 7;\ndefparam u.NAME = \"n\";\n"
     "endmodule\n"},
    {"parameters of the module itself, local ones as values",
     "module m #(parameter A = 3, B = \"b\")(); parameter [3:0] C = 4'h9; parameter D = 2.5;\n"
     "localparam L = 2, M = L * 4 - 1; wire [M:0] w; wire [L-1:0] v; assign v = L;\n"
     "REG #(.W(M)) u(.D(w[L+1:0])); endmodule",
     "module m();\nparameter A = 3;\nparameter B = \"b\";\nparameter C = 4'h9;\nparameter D = "
     "2.5;\n"
     "wire [1:0] v;\nwire [7:0] w;\nassign v = 2'b10;\n"
     "REG u (.C(), .D(w[3:0]), .Q());\ndefparam u.W = 7;\nendmodule\n"},
    {"quotients in a range, exponents of real numbers",
     "module m #(parameter A = 1.25e1, B = 25.0e-1, C = 3e2)(); wire [8/2-1:9%4] w; endmodule",
     "module m();\nparameter A = 12.5;\nparameter B = 2.50;\nparameter C = 300.0;\nwire [3:1] w;\n"
     "endmodule\n"},
    {"a repetition as often as a local parameter says, behind a net",
     "module m; localparam P = 2; wire a, b; wire [2:0] v; assign v = {a, {P{b}}}; endmodule",
     "module m();\nwire a;\nwire b;\nwire [2:0] v;\nassign v[2:0] = {a, b, b};\nendmodule\n"},
    {"escaped names",
     "module \\m ; wire \\a , \\b.c , \\d[3] , \\wire ; wire [1:0] \\e/f ; INV \\u.1 (\\a , \\b.c "
     ");\n"
     "assign \\d[3] = \\e/f [0]; assign \\wire = a; endmodule",
     "module m();\nwire a;\nwire b_c;\nwire d_3;\nwire [1:0] e_f;\nwire wire_2;\n"
     "assign d_3 = e_f[0];\nassign wire_2 = a;\nINV u_1 (.I(a), .O(b_c));\nendmodule\n"},
    {"names that differ in letter case alone, or are like a component's",
     "module m; wire n, N; wire [1:0] inv; INV Inv(n, N); assign inv[0] = N; endmodule",
     "module m();\nwire [1:0] inv_2;\nwire n;\nwire N_2;\nassign inv_2[0] = N_2;\n"
     "INV Inv_3 (.I(n), .O(N_2));\nendmodule\n"},
    {"statements that say nothing of the netlist",
     "module m; ; specify specparam t = 1; (a => b) = t; endspecify specparam s = 2;\n"
     "generate wire a; endgenerate endmodule",
     "module m();\nwire a;\nendmodule\n"},
    {"a module behind others, and a primitive",
     "primitive p(o, i); output o; input i; table 0 : 1; 1 : 0; endtable endprimitive\n"
     "module sub(input x); always @(*) if (x) begin : b y = 1; end endmodule\n"
     "module m; wire a; sub s(a); endmodule",
     "module m();\nwire a;\nsub s (.x(a));\nendmodule\n"},
};

TEST(VerilogConstructs, AreReadAsTheyAreMeant) {
    for (const Accepted& row : Table) {
        SCOPED_TRACE(row.what);
        TextReader text;
        EXPECT_EQ(text.GetFailure(row.text), "");
        EXPECT_EQ(Essence(text.Write()), row.written);
    }
}

/// What is written of a model is read as the same model.
TEST(VerilogConstructs, AreReadBack) {
    for (const Accepted& row : Table) {
        SCOPED_TRACE(row.what);
        TextReader text;
        ASSERT_EQ(text.GetFailure(row.text), "");
        const std::string written = text.Write();
        text.reader.AddLibrary(*text.model.GetNetlist());
        ASSERT_EQ(text.GetFailure(written), "");
        EXPECT_EQ(text.Write(), written);
    }
}

} // namespace
