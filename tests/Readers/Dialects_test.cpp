// Attributes and comments: what the Verilog reader makes of them, in every dialect that the library
// writes.
#include "Readers/ReadText.h"

#include <gtest/gtest.h>

#include <string>

namespace {

using Orn_Hdl::Attribute;
using Support::TextReader;

/// "NAME TYPE VALUE GENERIC SYNATTR" of each attribute, one a line.
std::string AttributesOf(const Orn_Hdl::AttributeHolder* holder) {
    std::string text;
    for (const Attribute* attribute : holder->GetAttrIterator()) {
        text += std::string(attribute->GetNameView()) + " " + attribute->GetValueTypeName().CStr() +
                " " + attribute->GetValueString().CStr() + " " + attribute->GetGeneric().CStr() +
                " " + attribute->GetSynAttr().CStr() + "\n";
    }
    return text;
}

std::string CommentOf(const Orn_Hdl::Object* object) {
    return std::string(object->GetCommentView());
}

TEST(VerilogAttributes, OfTheStandardHaveTheTypeOfTheirValue) {
    TextReader text;
    text.Read("(* top, n = 3 *) (* v = 8'hA5 *) module m((* LOC = \"P1\" *) input a, b, input c);\n"
              "(* keep *) wire w, x; (* b = 1'b1, r = 2.5, m = -4 *) INV u(), v();\n"
              "INV p((* in *) w); wire none; endmodule");
    EXPECT_EQ(AttributesOf(text.model.GetNetlist()), "top Integer 1 NONE ASSIGN\n"
                                                     "n Integer 3 NONE ASSIGN\n"
                                                     "v BitVector A5 NONE ASSIGN\n");
    EXPECT_EQ(AttributesOf(text.model.GetSignal("a")), "LOC String P1 NONE ASSIGN\n");
    EXPECT_EQ(AttributesOf(text.model.GetSignal("b")), "LOC String P1 NONE ASSIGN\n");
    EXPECT_EQ(AttributesOf(text.model.GetSignal("c")), "");
    EXPECT_EQ(AttributesOf(text.model.GetSignal("w")), "keep Integer 1 NONE ASSIGN\n");
    EXPECT_EQ(AttributesOf(text.model.GetSignal("x")), "keep Integer 1 NONE ASSIGN\n");
    EXPECT_EQ(AttributesOf(text.model.GetSignal("none")), "");
    const std::string ofInstances = "b Bit 1 NONE ASSIGN\nr Float 2.5 NONE ASSIGN\n"
                                    "m Integer -4 NONE ASSIGN\n";
    EXPECT_EQ(AttributesOf(text.model.GetInstance("u")), ofInstances);
    EXPECT_EQ(AttributesOf(text.model.GetInstance("v")), ofInstances);
    EXPECT_EQ(AttributesOf(text.model.GetInstance("p")), "");
}

TEST(VerilogAttributes, ThatTookThePlaceOfOthersLeaveTheirHolder) {
    TextReader text;
    text.Read("module m; (* keep, n = 1, n = \"text\" *) wire w; endmodule");
    Orn_Hdl::Signal* const signal = text.model.GetSignal("w");
    EXPECT_EQ(AttributesOf(signal), "keep Integer 1 NONE ASSIGN\nn String text NONE ASSIGN\n");
    delete signal->GetAttr("n");
    EXPECT_EQ(signal->GetAttr("n"), nullptr);
    EXPECT_EQ(AttributesOf(signal), "keep Integer 1 NONE ASSIGN\n");
}

TEST(VerilogAttributes, OfAModuleAreNotThoseOfTheModuleInFront) {
    TextReader text;
    text.reader.SetTop("m");
    text.Read("(* first *) module other; endmodule\n(* second *) module m; endmodule");
    EXPECT_EQ(AttributesOf(text.model.GetNetlist()), "second Integer 1 NONE ASSIGN\n");
}

TEST(VerilogAttributes, InFrontOfALoneSemicolonBelongToNothing) {
    TextReader text;
    text.Read("(* NONE = 1 *) ;\n(* LEVEL = 2 *) module m; endmodule");
    EXPECT_EQ(text.model.GetNetlist()->GetAttr("NONE"), nullptr);
    EXPECT_NE(text.model.GetNetlist()->GetAttr("LEVEL"), nullptr);
}

TEST(VerilogAttributes, MayBeOfAnEscapedName) {
    TextReader text;
    text.Read("module m(input a);\n"
              "INV \\table (a); // synthesis attribute LOC of \\table  is \"P1\"\nendmodule");
    EXPECT_EQ(AttributesOf(text.model.GetNetlist()->GetInstanceIterator().GetCurrent()),
              "LOC String P1 NONE ASSIGN\n");
}

TEST(VerilogAttributes, ArePassedOverWhenNotWanted) {
    TextReader text;
    text.reader.KeepAttributes(false);
    text.Read("(* top *) module m(input a); (* keep *) wire w;\n"
              "INV u(a); // synthesis attribute LOC of u is \"P1\"\n/* synthesis x=1 */ endmodule");
    EXPECT_EQ(AttributesOf(text.model.GetNetlist()), "");
    EXPECT_EQ(AttributesOf(text.model.GetSignal("w")), "");
    EXPECT_EQ(AttributesOf(text.model.GetInstance("u")), "");
}

/// A design with attributes on everything that the writers write attributes of.
constexpr const char* Design =
    "module m(input a, output [3:0] y);\n"
    "(* A = \"1\", B = \"two words, and a comma\" *) wire w;\n"
    "(* LOC = \"P1\" *) wire [1:0] v; (* X = \"\", Y = \"y\" *) INV u(a, y[0]);\n"
    "(* Z = \"5\" *) REG #(.W(3), .INIT(8'h0F)) r(); endmodule";

TEST(VerilogAttributes, OfEveryDialectAreReadBack) {
    for (const char* dialect : {"QSN", "EXEMPLAR", "SYNPLICITY", "SYNOPSYS", "PRECISION"}) {
        SCOPED_TRACE(dialect);
        TextReader text;
        text.Read(Design);
        text.model.GetOptions()->verilog.SetSynthesisType(dialect);
        const std::string written = text.Write();
        const std::string ofNet = AttributesOf(text.model.GetSignal("w"));
        EXPECT_EQ(ofNet, "A String 1 NONE ASSIGN\nB String two words, and a comma NONE ASSIGN\n");
        text.Read(written);
        EXPECT_EQ(text.Write(), written);
        EXPECT_EQ(AttributesOf(text.model.GetSignal("w")), ofNet);
        EXPECT_EQ(AttributesOf(text.model.GetSignal("v(1:0)")), "LOC String P1 NONE ASSIGN\n");
        EXPECT_EQ(AttributesOf(text.model.GetInstance("u")),
                  "X String  NONE ASSIGN\nY String y NONE ASSIGN\n");
    }
}

TEST(VerilogAttributes, OfOtherFormsOfTheDialectsAreRead) {
    TextReader text;
    text.Read("module m; wire w /* synthesis syn_keep=1 alias=\"a b\", last */;\n"
              "INV u(); // synthesis attribute LOC of nothing is \"x\"\n"
              "// synopsys full_case\n"
              "INV v();// exemplar attribute v LOC P 2\n"
              "//pragma attribute v KEEP\nendmodule");
    EXPECT_EQ(AttributesOf(text.model.GetSignal("w")), "syn_keep String 1 NONE ASSIGN\n"
                                                       "alias String a b NONE ASSIGN\n"
                                                       "last String 1 NONE ASSIGN\n");
    EXPECT_EQ(AttributesOf(text.model.GetInstance("u")), "");
    EXPECT_EQ(AttributesOf(text.model.GetInstance("v")),
              "LOC String P 2 NONE ASSIGN\nKEEP String  NONE ASSIGN\n");
}

TEST(VerilogAttributes, ShareTheirNameWithAParameterOfTheSameValue) {
    TextReader text;
    text.Read("module m; (* W = \"3\", K = \"k\", INIT = \"0F\" *) REG #(.W(3)) r();\n"
              "defparam r.INIT = 8'h0F; endmodule");
    EXPECT_EQ(AttributesOf(text.model.GetInstance("r")), "W Integer 3 SYN ASSIGN\n"
                                                         "K String k NONE ASSIGN\n"
                                                         "INIT BitVector 0F SYN ASSIGN\n");
    EXPECT_EQ(
        text.GetFailure("module m; (* W = \"4\" *) REG #(.W(3)) r(); endmodule"),
        "top.v:1:31: error: the parameter \"W\": there is an attribute and a parameter of this "
        "name, with different values, and a model has one of both\n"
        "module m; (* W = \"4\" *) REG #(.W(3)) r(); endmodule\n"
        "                              ^\n");
}

TEST(VerilogParameters, BetweenSwitchesAreHiddenFromSynthesis) {
    TextReader text;
    text.Read("module m;\nparameter A = 1;\n// synopsys translate_off\nparameter B = 2;\n"
              "// synopsys translate_on\nREG r();\ndefparam r.W = 5;\n// synopsys translate_off\n"
              "defparam r.NAME = \"x\";\n// synopsys translate_on\nendmodule");
    EXPECT_EQ(AttributesOf(text.model.GetNetlist()),
              "A Integer 1 SYN NONE\nB Integer 2 NOSYN NONE\n");
    EXPECT_EQ(AttributesOf(text.model.GetInstance("r")),
              "W Integer 5 SYN NONE\nNAME String x NOSYN NONE\n");
}

TEST(VerilogParameters, AreDeclaredByTheComponentOnceAnInstanceSetsThem) {
    TextReader text;
    text.Read("module m; REG a(); REG #(.INIT(8'h01)) b(); endmodule");
    EXPECT_EQ(AttributesOf(text.model.GetComponent("REG")), "INIT BitVector 00 SYN NONE\n");
    EXPECT_EQ(AttributesOf(text.model.GetInstance("a")), "");
    EXPECT_EQ(AttributesOf(text.model.GetInstance("b")), "INIT BitVector 01 SYN NONE\n");
}

TEST(VerilogParameters, NamedInitIsPassedOnInAMacro) {
    TextReader text;
    text.Read("module MHALVEX_A; parameter INIT = 8'h3C; REG r(); defparam r.INIT = INIT;\n"
              "endmodule");
    EXPECT_EQ(AttributesOf(text.model.GetInstance("r")), "INIT BitVector 3C SYN NONE\n");
    EXPECT_NE(text.Write().find("defparam r.INIT = INIT;"), std::string::npos);
}

TEST(VerilogStrings, LoseTheirEscapes) {
    TextReader text;
    text.Read("module m; (* A = \"q\\\"b\\\\c\\101\\n\" *) wire w; endmodule");
    EXPECT_EQ(AttributesOf(text.model.GetSignal("w")), "A String q\"b\\cA\n NONE ASSIGN\n");
}

TEST(VerilogComments, BelongToWhatFollowsThem) {
    TextReader text;
    text.reader.KeepComments(true);
    text.Read(
        "// the module\n`timescale 1ns / 1ps\n/* in\n   lines */\nmodule m(\n  // port a\n"
        "  input a,\n  // port b\n  input b);\n  // net\n  //  indented\n  wire w;\n"
        "  // dropped\n  assign w = a;\n  (* k *) // instance\n  INV u(); // next\n  INV v();\n"
        "  // last\nendmodule\n");
    EXPECT_EQ(CommentOf(text.model.GetNetlist()), "the module\nin\nlines\n");
    EXPECT_EQ(CommentOf(text.model.GetSignal("a")), "port a\n");
    EXPECT_EQ(CommentOf(text.model.GetSignal("b")), "port b\n");
    EXPECT_EQ(CommentOf(text.model.GetSignal("w")), "net\n indented\n");
    EXPECT_EQ(CommentOf(text.model.GetInstance("u")), "instance\n");
    EXPECT_EQ(CommentOf(text.model.GetInstance("v")), "next\n");
}

TEST(VerilogComments, AreDroppedUnlessTheyAreWanted) {
    TextReader text;
    text.Read("// the module\nmodule m;\n// net\nwire w;\nendmodule");
    EXPECT_EQ(CommentOf(text.model.GetNetlist()), "");
    EXPECT_EQ(CommentOf(text.model.GetSignal("w")), "");
}

TEST(VerilogComments, OfWhatIsPassedOverAreDropped) {
    TextReader text;
    text.reader.KeepComments(true);
    text.Read("// other\nmodule other; // inside\n// synopsys translate_off\nINV u();\nendmodule\n"
              "// of m\nmodule m #(parameter P = 1)();\nspecify // timing\nendspecify\n// net\n"
              "wire w; other o();\nendmodule");
    EXPECT_EQ(CommentOf(text.model.GetNetlist()), "of m\n");
    EXPECT_EQ(CommentOf(text.model.GetSignal("w")), "net\n");
    EXPECT_EQ(AttributesOf(text.model.GetNetlist()), "P Integer 1 SYN NONE\n");
}

TEST(VerilogComments, AreNoneInABanner) {
    TextReader text;
    text.reader.KeepComments(true);
    Support::EngineScript script;
    script.Run("SET NETLIST NAME top");
    script.Run("ADD NOTES a note");
    script.Run("ADD PORT A Input");
    const std::string written = script.Verilog("");
    ASSERT_NE(written.find("Timestamp"), std::string::npos);
    text.Read(written);
    EXPECT_EQ(CommentOf(text.model.GetNetlist()), "a note\n");
}

} // namespace
