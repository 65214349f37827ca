// The text of every single Verilog construct, to the byte.

#include "Orn_Hdl/Orn_Hdl.h"
#include "Support/Environment.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

using namespace Orn_Hdl;

namespace {

class VerilogStatementsTest : public testing::Test {
protected:
    /// What was written since the last call.
    std::string Written() {
        const std::string text(out_.GetValue().GetView());
        out_.SetValue("");
        return text;
    }
    std::string PortDeclaration(const char* name, int polarity) {
        statements_.WritePortDeclaration(name, Polarity(polarity));
        return Written();
    }
    std::string SignalDeclaration(const char* name) {
        statements_.WriteSignalDeclaration(name);
        return Written();
    }
    std::string SignalName(const char* name) {
        statements_.WriteSignalName(name);
        return Written();
    }
    std::string Constant(const char* name, bool singleBit, const char* value) {
        statements_.WriteConstantSignalAssignment(name, singleBit, BitVectorValue(value));
        return Written();
    }
    std::string Parameter(Attribute&& attribute) {
        statements_.WriteParameterStatement(&attribute);
        return Written();
    }

    TextMemOutStream out_;
    VerilogStatements statements_{out_};
};

/// Attributes of one object, with their synthesis option.
class Attributes {
public:
    Attributes& Add(const char* name, const char* value, const char* option = "ASSIGN") {
        auto* attribute = new AttributeString(name, value);
        attribute->SetSynAttr(option);
        holder_.AddAttr(attribute);
        return *this;
    }
    Iterator<Attribute*> Get() const { return holder_.GetAttrIterator(); }

private:
    AttributeHolder holder_;
};

} // namespace

TEST_F(VerilogStatementsTest, NormalizeBusName) {
    Port::StringBase<char> name("A(7:0)(x)");
    statements_.NormalizeBusName(name);
    EXPECT_EQ(name, "A[7:0][x]");
    EXPECT_EQ(Written(), "");
}

TEST_F(VerilogStatementsTest, TimeScale) {
    statements_.WriteTimeScale("1ns", "1ps");
    EXPECT_EQ(Written(), "`timescale 1ns / 1ps\n");
}

TEST_F(VerilogStatementsTest, TimeStamp) {
    const Support::EnvironmentVariable time("SOURCE_DATE_EPOCH", "0");
    statements_.WriteTimeStamp("top.src");
    EXPECT_EQ(Written(), "// Verilog model created from top.src - 01/01/1970 00:00:00\n");
    statements_.WriteTimeStamp("");
    EXPECT_EQ(Written(), "// Verilog model  - 01/01/1970 00:00:00\n");
    statements_.WriteTimeStamp(nullptr);
    EXPECT_EQ(Written(), "// Verilog model  - 01/01/1970 00:00:00\n");
}

TEST_F(VerilogStatementsTest, PortDeclaration) {
    EXPECT_EQ(PortDeclaration("A(7:0)", Polarity::Input), " input [7:0] A");
    EXPECT_EQ(PortDeclaration("Y", Polarity::Output), "output Y");
    EXPECT_EQ(PortDeclaration("D", Polarity::BiDirectional), " inout D");
    EXPECT_EQ(PortDeclaration("Z", Polarity::Invalid), "output Z");
    EXPECT_EQ(PortDeclaration("Z", 7), "output Z");
    EXPECT_EQ(PortDeclaration("Q(0:7)", Polarity::Output), "output [0:7] Q");
    EXPECT_EQ(PortDeclaration("B(3)", Polarity::Input), " input B(3)");
    EXPECT_EQ(PortDeclaration("A[7:0]", Polarity::Input), " input A[7:0]");
    EXPECT_EQ(PortDeclaration("A(+7:-1)", Polarity::Input), " input [7:-1] A");
}

TEST_F(VerilogStatementsTest, PortDeclarationOfNoNameIsNothing) {
    for (const int polarity : {-1, 0, 1, 2}) {
        EXPECT_EQ(PortDeclaration("", polarity), "");
        EXPECT_EQ(PortDeclaration(nullptr, polarity), "");
    }
}

TEST_F(VerilogStatementsTest, SignalDeclaration) {
    EXPECT_EQ(SignalDeclaration("n1"), "wire n1");
    EXPECT_EQ(SignalDeclaration("D(7:0)"), "wire [7:0] D");
    EXPECT_EQ(SignalDeclaration("D(0:7)"), "wire [0:7] D");
    EXPECT_EQ(SignalDeclaration("D(0:0)"), "wire [0:0] D");
    EXPECT_EQ(SignalDeclaration("D(3)"), "wire D(3)");
    EXPECT_EQ(SignalDeclaration("D(007:-0)"), "wire [7:0] D");
}

TEST_F(VerilogStatementsTest, SignalName) {
    EXPECT_EQ(SignalName("n1"), "n1");
    EXPECT_EQ(SignalName("D(7:0)"), "D[7:0]");
    EXPECT_EQ(SignalName("D(0:7)"), "D[0:7]");
    EXPECT_EQ(SignalName("D(3)"), "D(3)");
    EXPECT_EQ(SignalName("A,D(7:0)"), "A,D(7:0)");
    EXPECT_EQ(SignalName(""), "");
}

TEST_F(VerilogStatementsTest, SignalAssignment) {
    statements_.WriteSignalAssignment("D(7:0)", "n1");
    EXPECT_EQ(Written(), "assign D[7:0] = n1");
    statements_.WriteSignalAssignment("n1", "E(0:3)");
    EXPECT_EQ(Written(), "assign n1 = E[0:3]");
}

TEST_F(VerilogStatementsTest, ConstantOfABus) {
    EXPECT_EQ(Constant("D(7:0)", false, "8:H:FF"), "assign D = 8'hFF");
    EXPECT_EQ(Constant("D(7:0)", false, "8:O:377"), "assign D = 8'o377");
    EXPECT_EQ(Constant("D(3:0)", false, "4:B:1010"), "assign D = 4'b1010");
    EXPECT_EQ(Constant("D(3:0)", false, "1010"), "assign D = 1010");
    EXPECT_EQ(Constant("D[3:0]", false, "1010"), "assign D = 1010");
}

TEST_F(VerilogStatementsTest, ConstantOfASingleBitIsOneDigit) {
    EXPECT_EQ(Constant("N", true, "0"), "assign N = 0");
    EXPECT_EQ(Constant("N", true, "1"), "assign N = 1");
    EXPECT_EQ(Constant("N", true, "1'b0"), "assign N = 0");
    EXPECT_EQ(Constant("N", true, "x"), "assign N = 1");
    EXPECT_EQ(Constant("N", true, ""), "assign N = 1");
    EXPECT_EQ(Constant("N", true, "8:H:F0"), "assign N = 0");
    EXPECT_EQ(Constant("D(3)", true, "0101"), "assign D = 1");
}

TEST_F(VerilogStatementsTest, Parameter) {
    EXPECT_EQ(Parameter(AttributeString("S", "abc")), "parameter S = \"abc\"");
    EXPECT_EQ(Parameter(AttributeString("S", "\"abc\"")), "parameter S = \"abc\"");
    EXPECT_EQ(Parameter(AttributeString("S", "'abc'")), "parameter S = \"abc\"");
    EXPECT_EQ(Parameter(AttributeString("S", "\"'abc'\"")), "parameter S = \"'abc'\"");
    EXPECT_EQ(Parameter(AttributeString("S", "")), "parameter S = \"\"");
    EXPECT_EQ(Parameter(AttributeInteger("I", "-42")), "parameter I = -42");
    EXPECT_EQ(Parameter(AttributeFloat("F", "2.50")), "parameter F = 2.50");
    EXPECT_EQ(Parameter(AttributeBoolean("B", "true")), "parameter B = \"TRUE\"");
    EXPECT_EQ(Parameter(AttributeBoolean("B", "1")), "parameter B = \"FALSE\"");
    EXPECT_EQ(Parameter(AttributeBit("B", "1")), "parameter B = 1'b1");
    EXPECT_EQ(Parameter(AttributeBitVector("V", "16:H:CAFE")), "parameter V = 16'hCAFE");
    EXPECT_EQ(Parameter(AttributeBitVector("V", "4:B:1010")), "parameter V = 4'b1010");
    EXPECT_EQ(Parameter(AttributeBitVector("V", "1010")), "parameter V = 1010");
    EXPECT_EQ(Parameter(AttributeUser("U", "idle")), "parameter U = \"idle\"");
    EXPECT_EQ(Parameter(AttributeUser("U", "\"idle\"")), "parameter U = \"\"idle\"\"");
}

TEST_F(VerilogStatementsTest, DefParam) {
    AttributeBitVector init("INIT", "4:H:8");
    statements_.WriteDefParamStatement(&init, "U1");
    EXPECT_EQ(Written(), "defparam U1.INIT = 4'h8");
    statements_.WriteDefParamInitStatement(&init, "U1");
    EXPECT_EQ(Written(), "defparam U1.INIT = INIT");
}

TEST_F(VerilogStatementsTest, NullAttributesAreNothing) {
    statements_.WriteParameterStatement(nullptr);
    statements_.WriteDefParamStatement(nullptr, "U1");
    statements_.WriteDefParamInitStatement(nullptr, "U1");
    WriteVerilogAttrValueVisitor visitor(out_);
    visitor.VisitAttribute(nullptr);
    visitor.VisitAttributeString(nullptr);
    visitor.VisitAttributeInteger(nullptr);
    visitor.VisitAttributeFloat(nullptr);
    visitor.VisitAttributeBit(nullptr);
    visitor.VisitAttributeBitVector(nullptr);
    visitor.VisitAttributeBoolean(nullptr);
    visitor.VisitAttributeUser(nullptr);
    AttributeString attribute("A", "v");
    visitor.VisitAttribute(&attribute);
    EXPECT_EQ(Written(), "");
}

TEST_F(VerilogStatementsTest, Comment) {
    ScalarSignal signal("N");
    statements_.WriteComment(&signal);
    EXPECT_EQ(Written(), "");
    signal.AddComment("first");
    signal.AddComment("");
    signal.AddComment("second\n\n  third ");
    statements_.WriteComment(&signal);
    EXPECT_EQ(Written(), "// first\n// second\n//   third \n");
    statements_.WriteComment(nullptr);
    EXPECT_EQ(Written(), "");
}

TEST_F(VerilogStatementsTest, IncludePath) {
    StringArray files;
    statements_.WriteIncludePath(files);
    EXPECT_EQ(Written(), "");
    files.Add("a.vh");
    files.Add("\"b.vh\"");
    files.Add("'c.vh'");
    files.Add("\"half");
    statements_.WriteIncludePath(files);
    EXPECT_EQ(Written(), "`include \"a.vh\"\n`include \"b.vh\"\n`include \"c.vh\"\n"
                         "`include \"\"half\"\n");
}

TEST_F(VerilogStatementsTest, QsnAttributes) {
    statements_.WriteQSNAttr(
        Attributes().Add("A", "1").Add("N", "x", "NONE").Add("B", "\"2\"", "ASSIGNNODEC").Get(),
        "U1");
    EXPECT_EQ(Written(), "// synthesis attribute A of U1 is \"1\"\n"
                         "// synthesis attribute B of U1 is \"2\"\n");
}

TEST_F(VerilogStatementsTest, ExemplarAttributes) {
    statements_.WriteExemplarAttr(Attributes().Add("A", "1").Add("B", "'2'").Get(), "U1");
    EXPECT_EQ(Written(), "// exemplar attribute U1 A 1\n// exemplar attribute U1 B 2\n");
}

TEST_F(VerilogStatementsTest, PrecisionAttributes) {
    statements_.WritePrecisionAttr(Attributes().Add("A", "1").Add("B", "2").Get(), "U1");
    EXPECT_EQ(Written(), "//pragma attribute U1 A 1\n//pragma attribute U1 B 2\n");
}

TEST_F(VerilogStatementsTest, SynplicityAttributes) {
    statements_.WriteSynplicityAttr(Attributes().Add("A", "1").Get());
    EXPECT_EQ(Written(), "/* synthesis \"A=1\" */");
    statements_.WriteSynplicityAttr(
        Attributes().Add("X", "0", "NONE").Add("A", "1").Add("B", "\"2\"").Add("C", "3").Get());
    EXPECT_EQ(Written(), "/* synthesis \"A=1, \\\n"
                         "                      B=2, \\\n"
                         "                      C=3\" */");
}

TEST_F(VerilogStatementsTest, SynopsysAttributes) {
    statements_.WriteSynopsysAttr(Attributes().Add("A", "1").Get());
    EXPECT_EQ(Written(), "/* synopsys attribute A \"1\" */\n");
    statements_.WriteSynopsysAttr(
        Attributes().Add("A", "1").Add("B", "\"2\"").Add("X", "0", "NONE").Get());
    EXPECT_EQ(Written(), "/* synopsys attribute A \"1\"\n"
                         "                      B \"2\" */\n");
}

TEST_F(VerilogStatementsTest, AttributesThatAreAllMarkedNoneAreNothing) {
    const Attributes none = Attributes().Add("A", "1", "NONE").Add("B", "2", "NONE");
    const Attributes empty;
    for (const Attributes* attributes : {&none, &empty}) {
        statements_.WriteQSNAttr(attributes->Get(), "U1");
        statements_.WriteExemplarAttr(attributes->Get(), "U1");
        statements_.WritePrecisionAttr(attributes->Get(), "U1");
        statements_.WriteSynplicityAttr(attributes->Get());
        statements_.WriteSynopsysAttr(attributes->Get());
    }
    EXPECT_EQ(Written(), "");
}

TEST_F(VerilogStatementsTest, NullEntriesOfAListAreSkipped) {
    AttributeString attribute("A", "1");
    attribute.SetSynAttr("ASSIGN");
    PtrArray<Attribute*> list;
    list.Add(nullptr);
    list.Add(&attribute);
    list.Add(nullptr);
    const Iterator<Attribute*> attributes(&list);
    statements_.WriteQSNAttr(attributes, "U1");
    statements_.WriteSynplicityAttr(attributes);
    EXPECT_EQ(Written(), "// synthesis attribute A of U1 is \"1\"\n/* synthesis \"A=1\" */");
}

TEST_F(VerilogStatementsTest, UserTextsAreNoFormats) {
    EXPECT_EQ(SignalDeclaration("%s%n"), "wire %s%n");
    EXPECT_EQ(Parameter(AttributeString("%d", "%s")), "parameter %d = \"%s\"");
    ScalarSignal signal("N");
    signal.AddComment("100%n");
    statements_.WriteComment(&signal);
    EXPECT_EQ(Written(), "// 100%n\n");
}
