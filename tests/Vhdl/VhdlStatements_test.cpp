// The text of every single VHDL construct, to the byte.

#include "Orn_Hdl/Orn_Hdl.h"
#include "Support/Environment.h"

#include <gtest/gtest.h>

#include <string>

using namespace Orn_Hdl;

namespace {

class VhdlStatementsTest : public testing::Test {
protected:
    /// What was written since the last call.
    std::string Written() {
        const std::string text(out_.GetValue().GetView());
        out_.SetValue("");
        return text;
    }
    std::string BusIndexText(int first, int second) {
        statements_.WriteBusIndex(first, second);
        return Written();
    }
    std::string BusText(const char* name) {
        statements_.WriteBus(name);
        return Written();
    }
    std::string Port(const char* name, int polarity, int width) {
        statements_.WritePortStatement(name, Polarity(polarity), width);
        return Written();
    }
    std::string Assignment(const char* left, const char* right) {
        statements_.WriteSignalAssignment(left, right);
        return Written();
    }
    std::string Constant(const char* name, bool singleBit, const char* value) {
        statements_.WriteConstantSignalAssignment(name, singleBit, BitVectorValue(value));
        return Written();
    }
    std::string Generic(Attribute&& attribute) {
        statements_.WriteGenericMapAttrType(&attribute);
        return Written();
    }
    std::string Declaration(Attribute&& attribute, bool typed, int width) {
        statements_.WriteAttrDeclaration(&attribute, typed, width);
        return Written();
    }
    std::string AttributeAssignment(Attribute&& attribute, bool typed) {
        statements_.WriteAttrAssignment(&attribute, "U1", "label", typed);
        return Written();
    }

    TextMemOutStream out_;
    VhdlStatements statements_{out_};
};

void Add(AttributeHolder& holder, const char* name, const char* value, const char* option) {
    auto* attribute = new AttributeString(name, value);
    attribute->SetSynAttr(option);
    holder.AddAttr(attribute);
}

AttributeUser UserAttribute(const char* name, const char* value, const char* type) {
    AttributeUser attribute(name, value);
    attribute.SetUserType(type);
    return attribute;
}

} // namespace

TEST_F(VhdlStatementsTest, Types) {
    statements_.WriteStdLogic();
    EXPECT_EQ(Written(), "std_logic");
    statements_.WriteStdLogicVector(7, 0);
    EXPECT_EQ(Written(), "std_logic_vector (7 downto 0)");
    statements_.WriteStdLogicVector(0, 7);
    EXPECT_EQ(Written(), "std_logic_vector (0 to 7)");
}

TEST_F(VhdlStatementsTest, BusIndex) {
    EXPECT_EQ(BusIndexText(0, 0), "(0 downto 0)");
    EXPECT_EQ(BusIndexText(0, 7), "(0 to 7)");
    EXPECT_EQ(BusIndexText(7, 0), "(7 downto 0)");
    EXPECT_EQ(BusIndexText(-1, -3), "(-1 downto -3)");
}

TEST_F(VhdlStatementsTest, Bus) {
    EXPECT_EQ(BusText("D(7:0)"), "D(7 downto 0)");
    EXPECT_EQ(BusText("D(0:7)"), "D(0 to 7)");
    EXPECT_EQ(BusText("D(3:3)"), "D(3 downto 3)");
    EXPECT_EQ(BusText("D(3)"), "D(3)");
    EXPECT_EQ(BusText("N"), "N");
    EXPECT_EQ(BusText(""), "");
}

TEST_F(VhdlStatementsTest, Libraries) {
    statements_.WriteIEEELibrary();
    EXPECT_EQ(Written(),
              "library ieee;\nuse ieee.std_logic_1164.ALL;\nuse ieee.numeric_std.ALL;\n");
    statements_.WriteKestraLibrary(false);
    EXPECT_EQ(Written(), "library KESTRA;\nuse KESTRA.Vcomponents.ALL;\n");
    statements_.WriteKestraLibrary(true);
    EXPECT_EQ(Written(), "-- synopsys translate_off\nlibrary KESTRA;\n"
                         "use KESTRA.Vcomponents.ALL;\n-- synopsys translate_on\n");
    StringArray list;
    statements_.WriteUserLibrary(list);
    statements_.WriteUseUserLibrary(list);
    EXPECT_EQ(Written(), "");
    list.Add("a");
    list.Add("b.all");
    statements_.WriteUserLibrary(list);
    EXPECT_EQ(Written(), "library a;\nlibrary b.all;\n");
    statements_.WriteUseUserLibrary(list);
    EXPECT_EQ(Written(), "use a;\nuse b.all;\n");
}

TEST_F(VhdlStatementsTest, TimeStamp) {
    const Support::EnvironmentVariable time("SOURCE_DATE_EPOCH", "0");
    statements_.WriteTimeStamp("top.src");
    EXPECT_EQ(Written(), "-- VHDL model created from top.src - 01/01/1970 00:00:00\n");
    statements_.WriteTimeStamp("");
    EXPECT_EQ(Written(), "-- VHDL model - 01/01/1970 00:00:00\n");
    statements_.WriteTimeStamp(nullptr);
    EXPECT_EQ(Written(), "-- VHDL model - 01/01/1970 00:00:00\n");
}

TEST_F(VhdlStatementsTest, Comment) {
    ScalarSignal signal("N");
    statements_.WriteComment(&signal);
    EXPECT_EQ(Written(), "");
    signal.AddComment("first\n\n second");
    statements_.WriteComment(&signal);
    EXPECT_EQ(Written(), "-- first\n--  second\n");
    statements_.WriteComment(nullptr);
    EXPECT_EQ(Written(), "");
}

TEST_F(VhdlStatementsTest, SignalStatement) {
    statements_.WriteSignalStatement("n1", 5);
    EXPECT_EQ(Written(), "signal n1    : std_logic;\n");
    statements_.WriteSignalStatement("n1", 2);
    EXPECT_EQ(Written(), "signal n1 : std_logic;\n");
    statements_.WriteSignalStatement("longer", 2);
    EXPECT_EQ(Written(), "signal longer : std_logic;\n");
    statements_.WriteSignalStatement("n1", -5);
    EXPECT_EQ(Written(), "signal n1 : std_logic;\n");
}

TEST_F(VhdlStatementsTest, SignalVectorStatement) {
    statements_.WriteSignalVectorStatement("D(7:0)", 6);
    EXPECT_EQ(Written(), "signal D      : std_logic_vector (7 downto 0);\n");
    statements_.WriteSignalVectorStatement("D(0:3)", 0);
    EXPECT_EQ(Written(), "signal D : std_logic_vector (0 to 3);\n");
}

TEST_F(VhdlStatementsTest, PortStatement) {
    EXPECT_EQ(Port("A", Polarity::Input, 3), "A   : in    std_logic");
    EXPECT_EQ(Port("Y", Polarity::Output, 1), "Y : out   std_logic");
    EXPECT_EQ(Port("P", Polarity::BiDirectional, 1), "P : inout std_logic");
    EXPECT_EQ(Port("Z", Polarity::Invalid, 1), "Z : out   std_logic");
    EXPECT_EQ(Port("Z", 9, 1), "Z : out   std_logic");
    EXPECT_EQ(Port("D(7:0)", Polarity::Input, 6), "D      : in    std_logic_vector (7 downto 0)");
    EXPECT_EQ(Port("D(0:7)", Polarity::Output, 0), "D : out   std_logic_vector (0 to 7)");
    EXPECT_EQ(Port("D(3)", Polarity::Output, 0), "D(3) : out   std_logic");
    EXPECT_EQ(Port("longer", Polarity::Input, 3), "longer : in    std_logic");
}

TEST_F(VhdlStatementsTest, SignalAssignment) {
    EXPECT_EQ(Assignment("A", "B"), "A <= B;\n");
    EXPECT_EQ(Assignment("D(7:0)", "E(0:7)"), "D(7 downto 0) <= E(0 to 7);\n");
    EXPECT_EQ(Assignment("D(3)", "A,B"), "D(3) <= A,B;\n");
}

TEST_F(VhdlStatementsTest, ConstantOfASingleBit) {
    EXPECT_EQ(Constant("S", true, "1"), "S <= '1';\n");
    EXPECT_EQ(Constant("S", true, "0"), "S <= '0';\n");
    EXPECT_EQ(Constant("S", true, "0101"), "S <= '1';\n");
    EXPECT_EQ(Constant("S", true, "x"), "S <= '1';\n");
    EXPECT_EQ(Constant("S", true, ""), "S <= '1';\n");
    EXPECT_EQ(Constant("S", true, "8:H:F0"), "S <= '0';\n");
    EXPECT_EQ(Constant("D(3)", true, "1"), "D(3) <= '1';\n");
}

TEST_F(VhdlStatementsTest, ConstantOfABus) {
    EXPECT_EQ(Constant("A(7:0)", false, "8:H:FF"), "A(7 downto 0) <= x\"FF\";\n");
    EXPECT_EQ(Constant("A(8:0)", false, "9:O:377"), "A(8 downto 0) <= o\"377\";\n");
    EXPECT_EQ(Constant("A(0:3)", false, "4:B:0011"), "A(0 to 3) <= b\"0011\";\n");
    EXPECT_EQ(Constant("A(7:0)", false, "00001111"), "A(7 downto 0) <= \"00001111\";\n");
}

TEST_F(VhdlStatementsTest, GenericDeclaration) {
    EXPECT_EQ(Generic(AttributeString("S", "\"abc\"")), "S : string :=  \"abc\"");
    EXPECT_EQ(Generic(AttributeString("S", "'abc'")), "S : string :=  \"abc\"");
    EXPECT_EQ(Generic(AttributeInteger("I", "-42")), "I : integer :=  -42");
    EXPECT_EQ(Generic(AttributeFloat("F", "5")), "F : real :=  5.0");
    EXPECT_EQ(Generic(AttributeBoolean("B", "true")), "B : boolean :=  TRUE");
    EXPECT_EQ(Generic(AttributeBit("B", "1")), "B : bit :=  '1'");
    EXPECT_EQ(Generic(AttributeBitVector("V", "8:H:A5")), "V : bit_vector :=  x\"A5\"");
    EXPECT_EQ(Generic(AttributeBitVector("V", "1010")), "V : bit_vector :=  \"1010\"");
    EXPECT_EQ(Generic(UserAttribute("U", "idle", "state")), "U : state :=  idle");
    EXPECT_EQ(Generic(UserAttribute("U", "", "state")), "U : state :=  \"\"");
}

TEST_F(VhdlStatementsTest, GenericAssociation) {
    AttributeBitVector attribute("INIT", "4:B:1010");
    statements_.WriteGenericMapAttr(&attribute);
    EXPECT_EQ(Written(), "INIT => b\"1010\"");
    statements_.WriteGenericMapInitAttr(&attribute);
    EXPECT_EQ(Written(), "INIT => INIT");
}

TEST_F(VhdlStatementsTest, AttributeDeclaration) {
    EXPECT_EQ(Declaration(AttributeInteger("LOC", "5"), false, 5), "attribute LOC   : string ;\n");
    EXPECT_EQ(Declaration(AttributeInteger("LOC", "5"), true, 3), "attribute LOC : integer ;\n");
    EXPECT_EQ(Declaration(AttributeString("LONGER", "5"), true, 3),
              "attribute LONGER : string ;\n");
    EXPECT_EQ(Declaration(UserAttribute("S", "x", "state"), true, 1), "attribute S : state ;\n");
}

TEST_F(VhdlStatementsTest, AttributesOfAHolderAreDeclaredOnce) {
    AttributeHolder holder;
    Add(holder, "A", "1", "ASSIGN");
    Add(holder, "B", "2", "NONE");
    Add(holder, "C", "3", "ASSIGNNODEC");
    Add(holder, "D", "4", "ASSIGN");
    Add(holder, "a", "5", "ASSIGN");
    StringSet declared;
    declared.Add("d");
    statements_.WriteAttrDeclaration(&holder, declared, false, 1);
    EXPECT_EQ(Written(), "attribute A : string ;\n");
    EXPECT_TRUE(declared.Contains("A"));
    EXPECT_FALSE(declared.IContains("C"));
    statements_.WriteAttrDeclaration(&holder, declared, false, 1);
    statements_.WriteAttrDeclaration(static_cast<const AttributeHolder*>(nullptr), declared, false,
                                     1);
    EXPECT_EQ(Written(), "");
}

TEST_F(VhdlStatementsTest, AttributeAssignment) {
    EXPECT_EQ(AttributeAssignment(AttributeString("LOC", "\"P1\""), false),
              "attribute LOC of U1 : label is \"P1\";\n");
    EXPECT_EQ(AttributeAssignment(AttributeInteger("LOC", "5"), false),
              "attribute LOC of U1 : label is \"5\";\n");
    EXPECT_EQ(AttributeAssignment(AttributeInteger("LOC", "5"), true),
              "attribute LOC of U1 : label is 5;\n");
    EXPECT_EQ(AttributeAssignment(AttributeBitVector("V", "4:H:A"), false),
              "attribute V of U1 : label is \"A\";\n");
    EXPECT_EQ(AttributeAssignment(AttributeBitVector("V", "4:H:A"), true),
              "attribute V of U1 : label is x\"A\";\n");
    EXPECT_EQ(AttributeAssignment(UserAttribute("S", "", "state"), true),
              "attribute S of U1 : label is \"\";\n");
}

TEST_F(VhdlStatementsTest, AttributesOfAHolderAreAssignedUnlessMarkedNone) {
    AttributeHolder holder;
    Add(holder, "A", "1", "ASSIGN");
    Add(holder, "B", "2", "NONE");
    Add(holder, "C", "3", "ASSIGNNODEC");
    statements_.WriteAttrAssignment(&holder, "N", "signal", false);
    EXPECT_EQ(Written(), "attribute A of N : signal is \"1\";\n"
                         "attribute C of N : signal is \"3\";\n");
    statements_.WriteAttrAssignment(static_cast<const AttributeHolder*>(nullptr), "N", "signal",
                                    false);
    EXPECT_EQ(Written(), "");
}

TEST_F(VhdlStatementsTest, NullAttributesAreNothing) {
    Attribute* const none = nullptr;
    statements_.WriteGenericMapAttrType(none);
    statements_.WriteGenericMapAttr(none);
    statements_.WriteGenericMapInitAttr(none);
    WriteVhdlAttrTypeVisitor types(out_);
    WriteVhdlAttrValueVisitor values(out_);
    for (AttributeVisitor* visitor :
         {static_cast<AttributeVisitor*>(&types), static_cast<AttributeVisitor*>(&values)}) {
        visitor->VisitAttribute(nullptr);
        visitor->VisitAttributeString(nullptr);
        visitor->VisitAttributeInteger(nullptr);
        visitor->VisitAttributeFloat(nullptr);
        visitor->VisitAttributeBit(nullptr);
        visitor->VisitAttributeBitVector(nullptr);
        visitor->VisitAttributeBoolean(nullptr);
        visitor->VisitAttributeUser(nullptr);
        AttributeString attribute("A", "v");
        visitor->VisitAttribute(&attribute);
    }
    EXPECT_EQ(Written(), "");
    // A declaration and an assignment of no attribute write nothing, either.
    statements_.WriteAttrDeclaration(none, true, 3);
    statements_.WriteAttrAssignment(none, "U1", "label", true);
    EXPECT_EQ(Written(), "");
}

TEST_F(VhdlStatementsTest, UserTextsAreNoFormats) {
    EXPECT_EQ(Assignment("%s", "%n"), "%s <= %n;\n");
    EXPECT_EQ(Generic(AttributeString("%d", "%s")), "%d : string :=  \"%s\"");
}
