#include "Orn_Hdl/Proof.h"

#include "Orn_Hdl/Orn_Hdl.h"
#include "Support/EngineScript.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <ostream>
#include <string>
#include <sys/resource.h>
#include <unistd.h>
#include <vector>

namespace Orn_Hdl {
namespace {

using Support::FailureOf;
using Support::ReadWholeFile;
using Support::WriteWholeFile;

/// A design that has something of everything, and its Verilog netlist in a file.
class ProofTest : public ::testing::Test {
protected:
    ProofTest() : model_(&factory_) {
        Do({"SET NETLIST NAME top",
            "ADD MODULE ATTRIBUTE -TYPE=Integer WIDTH 8",
            "SET MODULE ATTRIBUTE OPTION WIDTH -GENERIC=SYN",
            "ADD COMPONENT INV",
            "ADD PIN INV I input",
            "ADD PIN INV O output",
            "ADD COMPONENT REG",
            "ADD PIN REG C input",
            "ADD PIN REG D(3:0) input",
            "ADD PIN REG Q(3:0) output",
            "ADD PORT A input",
            "ADD PORT B input",
            "ADD PORT D(7:0) input",
            "ADD PORT Q(3:0) output",
            "ADD PORT Y output",
            "ADD PORT Z output",
            "ADD INSTANCE INV U1",
            "ADD INSTANCE INV U2",
            "ADD INSTANCE REG U3",
            "CONNECT SIGNAL A U1.I",
            "CONNECT SIGNAL n1 U1.O",
            "CONNECT SIGNAL n1 U2.I",
            "CONNECT SIGNAL Y U2.O",
            "CONNECT SIGNAL A,D(6:4) U3.D(3:0)",
            "CONNECT SIGNAL Q(3:0) U3.Q(3:0)",
            "ADD SIGNAL K(3:0)",
            "ASSIGN CONSTANT K(3:0) 4:B:1010",
            "ADD SIGNAL T",
            "CONNECT SIGNAL T n1",
            "CONNECT SIGNAL Z T",
            "ADD INSTANCE ATTRIBUTE U1 LOC P1",
            "SET INSTANCE ATTRIBUTE OPTION U1 LOC -SYNATTR=ASSIGN",
            "ADD SIGNAL ATTRIBUTE n1 KEEP yes",
            "SET SIGNAL ATTRIBUTE OPTION n1 KEEP -SYNATTR=ASSIGN",
            "ADD INSTANCE ATTRIBUTE U3 -TYPE=BitVector INIT 16:H:8000",
            "SET INSTANCE ATTRIBUTE OPTION U3 INIT -GENERIC=SYN",
            "ADD INSTANCE ATTRIBUTE U3 -TYPE=Float DELAY 1.50",
            "SET INSTANCE ATTRIBUTE OPTION U3 DELAY -GENERIC=NOSYN",
            "ADD INCLUDE \"cells.vh\""});
    }

    void Do(const std::vector<const char*>& lines) {
        for (const char* line : lines) {
            model_.Execute(line);
        }
    }
    /// In VHDL a component declares its generics.
    void DeclareGenerics() {
        Do({"ADD COMPONENT ATTRIBUTE REG -TYPE=BitVector INIT 16:H:0000",
            "SET COMPONENT ATTRIBUTE OPTION REG INIT -GENERIC=SYN",
            "ADD COMPONENT ATTRIBUTE REG -TYPE=Float DELAY 0.5",
            "SET COMPONENT ATTRIBUTE OPTION REG DELAY -GENERIC=NOSYN"});
    }
    std::string GetFile() const { return folder_ / "top.v"; }
    void Write() { model_.ExecuteLine("WRITE VERILOG -NOHEADER " + GetFile()); }
    std::vector<Proof::Difference> Compare() {
        return Proof::Compare(GetFile(), Language::Verilog, *model_.GetNetlist(),
                              *model_.GetOptions());
    }
    /// What is found when a piece of the text is another one: "LINE: MESSAGE" of the first
    /// difference, or nothing.
    std::string FindFirst(const std::string& from, const std::string& to) {
        Write();
        std::string text = ReadWholeFile(GetFile());
        const std::size_t at = text.find(from);
        EXPECT_NE(at, std::string::npos) << from << "\n" << text;
        if (at != std::string::npos) {
            text.replace(at, from.size(), to);
        }
        WriteWholeFile(GetFile(), text);
        const std::vector<Proof::Difference> found = Compare();
        return found.empty() ? "" : found.front().message;
    }

    Support::TemporaryFolder folder_;
    CommandFactory factory_;
    Model model_;
};

TEST_F(ProofTest, ANetlistMeansItsDesign) {
    Write();
    EXPECT_TRUE(Compare().empty());
    for (const char* dialect :
         {"EXEMPLAR", "SYNPLICITY", "SYNOPSYS", "VERILOG2001", "PRECISION", "QSN"}) {
        model_.ExecuteLine(std::string("SET SYNTHESIS ") + dialect);
        Write();
        EXPECT_TRUE(Compare().empty()) << dialect;
    }
    Do({"LOWERCASE signal", "LOWERCASE instance"});
    Write();
    EXPECT_TRUE(Compare().empty());
}

/// One change of the text, and what is said of it.
struct Change {
    const char* name;
    const char* from;
    const char* to;
    const char* message;
};

std::ostream& operator<<(std::ostream& out, const Change& change) {
    return out << change.name;
}

class ProofChange : public ProofTest, public ::testing::WithParamInterface<Change> {};

TEST_P(ProofChange, IsFound) {
    EXPECT_EQ(FindFirst(GetParam().from, GetParam().to), GetParam().message);
}

constexpr Change Changes[] = {
    {"Include", "\"cells.vh\"", "\"other.vh\"",
     "the netlist includes \"other.vh\", the design \"cells.vh\""},
    {"Module", "module top(", "module tip(", "the module is \"tip\", the design \"top\""},
    {"ModuleParameter", "WIDTH = 8", "WIDTH = 9",
     "the parameter WIDTH of the module has the value \"9\", in the design \"8\""},
    {"ModuleParameterLost", "parameter WIDTH = 8;", "",
     "the parameter WIDTH of the module is not in the netlist"},
    {"PortOrder", "top(A, \n           B", "top(B, \n           A",
     "the port \"A\" is not declared where it should be"},
    {"PortDirection", " input B", " output B", "\"B\" is an output, in the design an input"},
    {"PortRange", "[7:0] D", "[8:0] D", "\"D\" is declared as [8:0], in the design as [7:0]"},
    {"PortRangeReversed", "[7:0] D", "[0:7] D",
     "\"D\" is declared as [0:7], in the design as [7:0]"},
    {"SignalRange", "[3:0] K", "[4:0] K", "\"K\" is declared as [4:0], in the design as [3:0]"},
    {"SignalLost", "wire [3:0] K;", "", "the signal \"K(3:0)\" is not declared where it should be"},
    {"SignalAdded", "wire T;", "wire T;\n wire X;",
     "\"X\" is declared as no port, the design has no such signal"},
    {"SignalTwice", "wire T;", "wire T;\n wire T;", "\"T\" is declared out of order, or twice"},
    {"SignalLetterCase", "wire T;", "wire t;",
     "\"t\" is declared as no port, the design has no such signal"},
    {"Constant", "4'b1010", "4'b1011", "the netlist has K[3:0] = 1011, the design K(3:0) = 1010"},
    {"ConstantLost", "assign K = 4'b1010;", "", "the netlist has T = n1, the design K(3:0) = 1010"},
    {"AliasTarget", "assign T =", "assign K[0] =", "the netlist has K[0] = n1, the design T = n1"},
    {"AliasSource", "= n1;", "= A;", "the netlist has T = A, the design T = n1"},
    {"AliasLost", "assign Z = T;", "", "the netlist has no further assignment, the design Z = T"},
    {"AliasAdded", "assign Z = T;", "assign Z = T; assign Z = A;",
     "the netlist has Z = A, the design no further assignment"},
    {"Component", "INV U2", "REG U2", "\"U2\" is an instance of \"REG\", in the design of \"INV\""},
    {"InstanceName", "INV U2", "INV U9",
     "the instance \"U9\" is none of the design, or out of order"},
    {"InstanceLost", "INV U2 (.I(n1), \n           .O(Y));", "",
     "the instance \"U2\" is not where it should be"},
    {"Connection", ".I(A)", ".I(B)",
     "the pin \"I\" of \"U1\" is connected to \"B\", in the design to \"A\""},
    {"ConnectionLost", ".I(A)", ".I()", "the pin \"I\" of \"U1\" is open, in the design to \"A\""},
    {"ConnectionOfOpenPin", ".C()", ".C(A)",
     "the pin \"C\" of \"U3\" is connected to \"A\", in the design it is open"},
    {"ConnectionToConstant", ".I(A)", ".I(1'b0)",
     "the pin \"I\" of \"U1\" is connected to a constant, in the design to \"A\""},
    {"ConnectionBit", "D[6:4]", "D[5:3]",
     "the pin \"D(3:0)\" of \"U3\" is connected to \"A, D[5:3]\", in the design to \"A,D(6:4)\""},
    {"ConnectionMember", "{A, D[6:4]}", "{B, D[6:4]}",
     "the pin \"D(3:0)\" of \"U3\" is connected to \"B, D[6:4]\", in the design to \"A,D(6:4)\""},
    {"ConnectionMemberOrder", "{A, D[6:4]}", "{D[6:4], A}",
     "the pin \"D(3:0)\" of \"U3\" is connected to \"D[6:4], A\", in the design to \"A,D(6:4)\""},
    {"PinName", ".I(n1)", ".X(n1)", "it cannot be read: the module \"INV\" has no port \"X\""},
    {"Attribute", "of U1 is \"P1\"", "of U1 is \"P2\"",
     "the attribute LOC of U1 is \"P2\", in the design \"P1\""},
    {"AttributeName", "LOC of U1", "LOC1 of U1",
     "the attribute LOC1 of U1 stands where the design has LOC"},
    {"AttributeLost", "// synthesis attribute LOC of U1 is \"P1\"", "",
     "the attribute LOC of U1 is not in the netlist"},
    {"SignalAttribute", "is \"yes\"", "is \"no\"",
     "the attribute KEEP of n1 is \"no\", in the design \"yes\""},
    {"SignalAttributeOwner", "KEEP of n1", "KEEP of T",
     "the attribute KEEP of T stands where the design has KEEP of n1"},
    {"SignalAttributeLost", "// synthesis attribute KEEP of n1 is \"yes\"", "",
     "the attribute KEEP of n1 is not in the netlist"},
    {"AttributeOfModule", "LOC of U1", "LOC of top",
     "the attribute LOC of U1 is not in the netlist"},
    {"Parameter", "16'h8000", "16'h8001",
     "the parameter INIT of U3 has the value \"16:H:8001\", in the design \"8000\""},
    {"ParameterWidth", "16'h8000", "17'h8000",
     "the parameter INIT of U3 has the value \"17:B:01000000000000000\", in the design \"8000\""},
    {"ParameterReal", "1.50", "1.51",
     "the parameter DELAY of U3 has the value \"1.51\", in the design \"1.50\""},
    {"ParameterHidden", "// synopsys translate_off", "",
     "the parameter DELAY of U3 is not hidden from synthesis, unlike in the design"},
    {"ParameterOwner", "defparam U3.INIT", "defparam U2.INIT",
     "the parameter DELAY of U3 stands where the design has INIT"},
    {"ParameterLost", "defparam U3.INIT = 16'h8000;", "",
     "the parameter DELAY of U3 stands where the design has INIT"},
    {"Unreadable", "endmodule", "", "it cannot be read: \"endmodule\" does not follow this"},
};

INSTANTIATE_TEST_SUITE_P(Each, ProofChange, ::testing::ValuesIn(Changes),
                         [](const auto& change) { return std::string(change.param.name); });

/// The same design in VHDL.
class ProofOfVhdl : public ProofTest, public ::testing::WithParamInterface<Change> {};

TEST_P(ProofOfVhdl, IsFound) {
    const std::string file = folder_ / "top.vhd";
    DeclareGenerics();
    model_.ExecuteLine("WRITE VHDL -NOHEADER " + file);
    const auto compare = [&] {
        return Proof::Compare(file, Language::Vhdl, *model_.GetNetlist(), *model_.GetOptions());
    };
    for (const Proof::Difference& difference : compare()) {
        FAIL() << difference.line << ": " << difference.message;
    }
    std::string text = ReadWholeFile(file);
    const std::string from = GetParam().from;
    const std::size_t at = text.find(from);
    ASSERT_NE(at, std::string::npos) << from << "\n" << text;
    WriteWholeFile(file, text.replace(at, from.size(), GetParam().to));
    const std::vector<Proof::Difference> found = compare();
    ASSERT_FALSE(found.empty());
    EXPECT_NE(found.front().message.find(GetParam().message), std::string::npos)
        << found.front().message;
}

constexpr Change VhdlChanges[] = {
    {"Clause", "use ieee.numeric_std.ALL;", "", "the use clauses are not those of the design"},
    {"Architecture", "BEHAVIORAL", "STRUCTURAL", "the end of \"STRUCTURAL\" has another name"},
    {"Generic", ":=  8", ":=  9", "the parameter WIDTH of the module has the value \"9\""},
    {"ComponentPin", "in    std_logic_vector (3 downto 0)", "out   std_logic_vector (3 downto 0)",
     "is declared as an output"},
    {"Connection", "I=>A", "I=>B", "is connected to \"B\", in the design to \"A\""},
    {"ConnectionBit", "D(6 downto 4)", "D(5 downto 3)", "is connected to \"A, D[5:3]\""},
    {"Constant", "b\"1010\"", "b\"1011\"", "the netlist has K[3:0] = 1011"},
    {"Alias", "T <= n1", "T <= A", "the netlist has T = A, the design T = n1"},
    {"InstanceGeneric", "x\"8000\"", "x\"8001\"", "the parameter INIT of U3 has the value"},
    {"Attribute", "is \"P1\"", "is \"P2\"", "the attribute LOC of U1 is \"P2\""},
    {"AttributeDeclaration", "attribute KEEP  : string ;", "", "is not declared"},
    {"Binding", "for U1, U2 : INV", "for U1 : INV", "the configuration binds other instances"},
};

INSTANTIATE_TEST_SUITE_P(Each, ProofOfVhdl, ::testing::ValuesIn(VhdlChanges),
                         [](const auto& change) { return std::string(change.param.name); });

TEST_F(ProofTest, AChangeWithoutMeaningIsNone) {
    EXPECT_EQ(FindFirst("{A, D[6:4]}", "{A, D[6], D[5:4]}"), "");
    EXPECT_EQ(FindFirst("4'b1010", "4'hA"), "");
    EXPECT_EQ(FindFirst("1.50", "1.5"), "");
    EXPECT_EQ(FindFirst("wire T;", "wire T; // and a remark"), "");
}

TEST_F(ProofTest, ADifferenceTellsWhereItIs) {
    Write();
    FindFirst(".I(A)", ".I(B)");
    const std::vector<Proof::Difference> found = Compare();
    ASSERT_EQ(found.size(), 1U);
    EXPECT_NE(found[0].source.find(".I(B)"), std::string::npos) << found[0].source;
    EXPECT_GT(found[0].line, 20U);
    EXPECT_GT(found[0].column, 1U);
    EXPECT_EQ(found[0].cause.kind, Check::Cause::Kind::Connection);
    EXPECT_EQ(found[0].cause.first, "U1");
    EXPECT_EQ(found[0].cause.second, "I");
    EXPECT_EQ(found[0].rule, nullptr);
}

TEST_F(ProofTest, NoMoreDifferencesAreLookedForThanAreTold) {
    for (int i = 10; i < 40; ++i) {
        model_.ExecuteLine("ADD INSTANCE INV U" + std::to_string(i));
    }
    Write();
    const std::string text = ReadWholeFile(GetFile());
    WriteWholeFile(GetFile(), text.substr(0, text.find("   INV U10")) + "endmodule\n");
    EXPECT_EQ(Compare().size(), Proof::MostDifferences);
}

TEST_F(ProofTest, RenamedObjectsAreKnownByTheirNewNames) {
    model_.GetInstance("U1")->SetName("first");
    model_.GetSignal("n1")->SetName("middle");
    Write();
    EXPECT_TRUE(Compare().empty()) << Compare().front().message;
}

TEST_F(ProofTest, NamesThatDifferInLetterCaseAreOneInVhdlAlone) {
    model_.GetInstance("U1")->SetName("u2");
    Write();
    EXPECT_TRUE(Compare().empty()) << Compare().front().message;
    model_.ExecuteLine("WRITE VHDL -NOHEADER " + (folder_ / "top.vhd"));
    EXPECT_FALSE(Proof::Compare((folder_ / "top.vhd").c_str(), Language::Vhdl, *model_.GetNetlist(),
                                *model_.GetOptions())
                     .empty());
}

TEST_F(ProofTest, ANameOfTwoObjectsIsFound) {
    model_.GetInstance("U1")->SetName("U2");
    Write();
    ASSERT_FALSE(Compare().empty());
    EXPECT_EQ(Compare().front().message,
              "the name of the instance \"U2\" is that of another object, too");
    model_.GetInstance("U1")->SetName("n1");
    Write();
    ASSERT_FALSE(Compare().empty());
    EXPECT_EQ(Compare().front().message,
              "the name of the instance \"n1\" is that of another object, too");
}

TEST_F(ProofTest, ASignalMayHaveSeveralAliases) {
    Do({"CONNECT SIGNAL n2 A", "CONNECT SIGNAL n2 B", "CONNECT SIGNAL n2 D(0)"});
    Write();
    EXPECT_TRUE(Compare().empty()) << Compare().front().message;
}

/// The tools take the values x and z, which stand in constants of four-valued bits.
TEST_F(ProofTest, ConstantsMayHoldUnknownBits) {
    DeclareGenerics();
    Do({"ADD SIGNAL v(3:0)", "ASSIGN CONSTANT v(3:0) 4:B:zz01", "ADD SIGNAL w(3:0)",
        "ASSIGN CONSTANT w(3:0) 4:B:1xx0", "ADD SIGNAL x(7:0)", "ASSIGN CONSTANT x(7:0) 8:H:Z5"});
    Write();
    EXPECT_TRUE(Compare().empty()) << Compare().front().message << ReadWholeFile(GetFile());
    std::string text = ReadWholeFile(GetFile());
    const std::size_t bits = text.find("4'b1xx0");
    ASSERT_NE(bits, std::string::npos) << text;
    WriteWholeFile(GetFile(), text.replace(bits, 7, "4'b1x00"));
    ASSERT_FALSE(Compare().empty());
    EXPECT_EQ(Compare().front().message, "the netlist has w[3:0] = 1x00, the design w(3:0) = 1xx0");
}

TEST_F(ProofTest, WhatIsAssignedToNothingIsLeftOutInVhdl) {
    DeclareGenerics();
    Do({"ADD SIGNAL v(3:0)", "CONNECT SIGNAL v(3:0) open,D(1:0),B", "ADD SIGNAL w(1:0)",
        "ASSIGN CONSTANT w(1),open,w(0) 3:B:101"});
    const std::string file = folder_ / "top.vhd";
    model_.ExecuteLine("WRITE VHDL -NOHEADER " + file);
    const std::vector<Proof::Difference> differences =
        Proof::Compare(file.c_str(), Language::Vhdl, *model_.GetNetlist(), *model_.GetOptions());
    EXPECT_TRUE(differences.empty()) << differences.front().message << ReadWholeFile(file);
}

TEST_F(ProofTest, ABusMayBeAnAliasOfNothingInVerilog) {
    Do({"ADD SIGNAL v(3:0)", "CONNECT SIGNAL v(3:0) open"});
    Write();
    EXPECT_TRUE(Compare().empty()) << Compare().front().message;
    model_.ExecuteLine("ADD SIGNAL x(3:0)");
    model_.ExecuteLine("CONNECT SIGNAL x(3:0) A");
    Write();
    ASSERT_FALSE(Compare().empty());
    EXPECT_EQ(Compare().front().message,
              "the netlist has 1 bits assigned to 4, the design x(3:0) = A");
}

TEST_F(ProofTest, OfLongConcatenationsTheFirstPartsAreShown) {
    Do({"ADD SIGNAL v(8:0)", "CONNECT SIGNAL v(8:0) A,B,A,B,A,B,A,B,A"});
    Write();
    std::string text = ReadWholeFile(GetFile());
    const std::size_t last = text.find("B, A}");
    ASSERT_NE(last, std::string::npos) << text;
    WriteWholeFile(GetFile(), text.replace(last, 5, "B, B}"));
    ASSERT_FALSE(Compare().empty());
    EXPECT_EQ(Compare().front().message,
              "the netlist has v[8:0] = A, B, A, B, A, B, A, B, ..., the design v(8:0) = "
              "A,B,A,B,A,B,A,B,A");
}

TEST_F(ProofTest, TwoSignalsOfOneNameAreFound) {
    model_.GetSignal("T")->SetName("n1");
    Write();
    EXPECT_FALSE(Compare().empty());
}

TEST_F(ProofTest, NegativeNumbersAndEscapedNamesOfParametersAreRead) {
    Do({"ADD MODULE ATTRIBUTE -TYPE=Float RATE -3.25",
        "SET MODULE ATTRIBUTE OPTION RATE -GENERIC=SYN",
        "ADD MODULE ATTRIBUTE -TYPE=Integer SHIFT -4",
        "SET MODULE ATTRIBUTE OPTION SHIFT -GENERIC=SYN",
        "ADD MODULE ATTRIBUTE -TYPE=Integer \"\\\\a+b \" 5",
        "SET MODULE ATTRIBUTE OPTION \"\\\\a+b \" -GENERIC=SYN",
        "ADD SIGNAL ATTRIBUTE A \"\\\\n+m \" yes",
        "SET SIGNAL ATTRIBUTE OPTION A \"\\\\n+m \" -SYNATTR=ASSIGN"});
    EXPECT_EQ(FindFirst("RATE = -3.25", "RATE = -3.250"), "");
    EXPECT_EQ(FindFirst("RATE = -3.25", "RATE = 3.25"),
              "the parameter RATE of the module has the value \"3.25\", in the design \"-3.25\"");
    EXPECT_EQ(FindFirst("SHIFT = -4", "SHIFT = -5"),
              "the parameter SHIFT of the module has the value \"-5\", in the design \"-4\"");
    EXPECT_EQ(FindFirst("\\a+b ", "\\a+b  "), "");
    EXPECT_NE(FindFirst("\\a+b ", "\\a+c "), "");
    EXPECT_NE(FindFirst("\\n+m ", "\\n+k "), "");
}

TEST_F(ProofTest, TheRuleThatTellsOfADifferenceIsNamed) {
    const auto findRule = [this](std::initializer_list<const char*> lines) {
        Model model(&factory_);
        model.GetOptions()->writeHeader = false;
        for (const char* line : lines) {
            model.Execute(line);
        }
        const std::string file = folder_ / "other.vhd";
        model.ExecuteLine("WRITE VHDL " + file);
        std::string rules;
        for (const Proof::Difference& difference :
             Proof::Compare(file, Language::Vhdl, *model.GetNetlist(), *model.GetOptions())) {
            rules.append(difference.rule == nullptr ? "none" : difference.rule->name).append(" ");
        }
        return rules.substr(0, rules.find(' '));
    };
    // A bus and a scalar signal of the same name.
    EXPECT_EQ(findRule({"ADD SIGNAL N(7:4)", "ADD SIGNAL N", "ADD PORT A input"}), "name-clash");
    // An instance and the signal that a write makes for an open pin.
    EXPECT_EQ(findRule({"ADD PORT A input", "SET OPEN PIN false", "ADD COMPONENT INV",
                        "ADD PIN INV I input", "ADD INSTANCE INV U1",
                        "ADD INSTANCE INV U1_I_openSignal", "CONNECT SIGNAL A U1_I_openSignal.I"}),
              "name-clash");
    // An instance and the signal that a write makes for a port that is read.
    EXPECT_EQ(findRule({"ADD PORT Y output", "ADD COMPONENT INV", "ADD PIN INV I input",
                        "ADD INSTANCE INV Y_DUMMY", "CONNECT SIGNAL Y Y_DUMMY.I"}),
              "name-clash");
    EXPECT_EQ(findRule({"ADD PORT W(99999999999:99999999990) input"}), "wide-bus");
    EXPECT_EQ(findRule({"ADD PORT W(0:99999999999999999999) input"}), "wide-bus");
    EXPECT_EQ(findRule({"ADD PORT Y(3:0) output", "ASSIGN CONSTANT Y(3:0) -4:B:1010"}),
              "constant-length");
    EXPECT_EQ(findRule({"ADD PORT A input", "USE ATTRTYPE true",
                        "ADD SIGNAL ATTRIBUTE A -TYPE=BitVector TAG 4:H:A5",
                        "SET SIGNAL ATTRIBUTE OPTION A TAG -SYNATTR=ASSIGN"}),
              "constant-length");
    EXPECT_EQ(findRule({"ADD PORT A input", "ADD SIGNAL N", "ADD NOTES synthesis translate_off"}),
              "directive-comment");
}

TEST_F(ProofTest, AFileThatIsNotThereIsAnException) {
    EXPECT_NE(FailureOf([this] { Compare(); }).find("Cannot read "), std::string::npos);
}

TEST_F(ProofTest, AWriteThatIsNotProvenKeepsTheFormerFile) {
    model_.GetOptions()->verify = true;
    Write();
    const std::string former = ReadWholeFile(GetFile());
    EXPECT_NE(former.find("endmodule"), std::string::npos);
    Do({"ADD SIGNAL L(3:0)", "ASSIGN CONSTANT L(3:0) 1010"});
    try {
        Write();
        ADD_FAILURE() << "it was written";
    } catch (const ProofException& exception) {
        ASSERT_EQ(exception.GetDifferences().size(), 1U);
        const Proof::Difference& difference = exception.GetDifferences().front();
        EXPECT_EQ(difference.message, "the netlist has L[3:0] = 0010, the design L(3:0) = 1010");
        ASSERT_NE(difference.rule, nullptr);
        EXPECT_EQ(difference.rule->name, "constant-digits");
        const std::string text(exception.getLocalized().GetView());
        EXPECT_NE(text.find("top.v\" does not mean what the design does: the netlist has L"),
                  std::string::npos)
            << text;
    }
    EXPECT_EQ(ReadWholeFile(GetFile()), former);
    model_.GetOptions()->legal = true;
    Write();
    EXPECT_NE(ReadWholeFile(GetFile()).find("assign L = 4'b1010"), std::string::npos);
}

TEST_F(ProofTest, AppendedTextIsProvenFirst) {
    model_.GetOptions()->verify = true;
    WriteWholeFile(GetFile(), "// former\n");
    const std::string append = "WRITE VERILOG -APPEND -NOHEADER " + GetFile();
    model_.ExecuteLine(append);
    EXPECT_NE(ReadWholeFile(GetFile()).find("endmodule"), std::string::npos);
    EXPECT_EQ(ReadWholeFile(GetFile()).substr(0, 10), "// former\n");
    const std::string written = ReadWholeFile(GetFile());
    Do({"ADD SIGNAL L(3:0)", "ASSIGN CONSTANT L(3:0) 1010"});
    EXPECT_THROW(model_.ExecuteLine(append), ProofException);
    EXPECT_EQ(ReadWholeFile(GetFile()), written);
}

/// As long as it lives, the program can open no file.
class NoMoreFiles {
public:
    NoMoreFiles() {
        getrlimit(RLIMIT_NOFILE, &former_);
        const int firstFree = dup(0);
        close(firstFree);
        const rlimit none = {static_cast<rlim_t>(firstFree), former_.rlim_max};
        setrlimit(RLIMIT_NOFILE, &none);
    }
    NoMoreFiles(const NoMoreFiles&) = delete;
    NoMoreFiles& operator=(const NoMoreFiles&) = delete;
    ~NoMoreFiles() { setrlimit(RLIMIT_NOFILE, &former_); }

private:
    rlimit former_;
};

TEST_F(ProofTest, WithoutATemporaryFileNothingIsAppended) {
    WriteWholeFile(GetFile(), "// former\n");
    TextFileOutStream out(GetFile().c_str(), TextFileOutStream::Append);
    ASSERT_TRUE(out.IsOpen());
    const auto write = [this, &out] {
        Proof::Write(
            out, GetFile().c_str(), Language::Verilog, [](OutStream& stream) { stream << "text"; },
            [this] {
                return Proof::Written{*model_.GetNetlist(), *model_.GetOptions()};
            });
    };
    std::string failure;
    {
        const NoMoreFiles limit;
        failure = FailureOf(write);
    }
    EXPECT_NE(failure.find("A temporary file for the proof cannot be used"), std::string::npos);
    out.Close();
    EXPECT_EQ(ReadWholeFile(GetFile()), "// former\n");
}

} // namespace
} // namespace Orn_Hdl
