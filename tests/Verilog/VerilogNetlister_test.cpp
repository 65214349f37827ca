// What the Verilog writer writes in which situation, beside the golden designs.

#include "Orn_Hdl/Orn_Hdl.h"
#include "Support/EngineScript.h"
#include "Support/NetlistText.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

using namespace Orn_Hdl;
using Support::EngineScript;
using Support::Inverters;
using Support::LinesThatBegin;

namespace {

using Lines = std::vector<std::string>;

template <class Options> std::string WriteToMemory(Netlist* netlist, Options&& options) {
    TextMemOutStream out;
    VerilogNetlister netlister(out);
    netlister.WriteNetlist(netlist, options);
    return std::string(out.GetValue().GetView());
}

HdlOptions WithoutHeader() {
    HdlOptions options;
    options.writeHeader = false;
    return options;
}

Lines Assigns(const std::string& text) {
    return LinesThatBegin(text, "assign ");
}

Lines Wires(const std::string& text) {
    return LinesThatBegin(text, "wire ");
}

bool Holds(const std::string& text, const std::string& piece) {
    return text.find(piece) != std::string::npos;
}

constexpr const char* Adder = "ADD COMPONENT ADD4\n"
                              "ADD PIN ADD4 A(3:0) Input\n"
                              "ADD PIN ADD4 CI Input\n"
                              "ADD PIN ADD4 S(3:0) Output\n"
                              "ADD INSTANCE ADD4 U1\n";

} // namespace

// The frame

TEST(VerilogNetlisterTest, NullIsNothing) {
    EXPECT_EQ(WriteToMemory(nullptr, HdlOptions()), "");
}

TEST(VerilogNetlisterTest, AnEmptyDesignIsAFrame) {
    EngineScript script;
    EXPECT_EQ(script.Verilog(), "`timescale 1ns / 1ps\n\nmodule top();\n\n\n\nendmodule\n");
}

TEST(VerilogNetlisterTest, AModuleWithoutPortsClosesItsListAtOnce) {
    EngineScript script("ADD SIGNAL N");
    EXPECT_TRUE(Holds(script.Verilog(), "\nmodule top();\n\n\n   wire N;\n\nendmodule\n"));
}

TEST(VerilogNetlisterTest, EmptyLinesAreEmpty) {
    EngineScript script("ADD MODULE ATTRIBUTE A v\nSET MODULE ATTRIBUTE OPTION A -GENERIC=SYN\n"
                        "ADD PORT A Input\nADD SIGNAL N");
    for (const std::string& line : Support::SplitLines(script.Verilog())) {
        EXPECT_TRUE(line.empty() || line.find_first_not_of(' ') != std::string::npos);
    }
}

TEST(VerilogNetlisterTest, MemoryHasNeitherIndentationNorBrokenLines) {
    EngineScript script(Inverters({"U1 A Y"}) + "CONNECT SIGNAL " + std::string(100, 'l') + " " +
                        std::string(100, 'r'));
    EXPECT_EQ(WriteToMemory(&script.GetNetlist(), WithoutHeader()),
              "`timescale 1ns / 1ps\n\nmodule top();\n\n\nwire A;\nwire " + std::string(100, 'l') +
                  ";\nwire " + std::string(100, 'r') + ";\nwire Y;\n\nassign " +
                  std::string(100, 'l') + " = " + std::string(100, 'r') +
                  ";\nINV U1 (.I(A), \n        .O(Y));\nendmodule\n");
}

TEST(VerilogNetlisterTest, OneNetlisterWritesManyNetlists) {
    EngineScript first("ADD PORT A Input");
    EngineScript second("ADD PORT B Output\nSET NETLIST NAME other");
    TextMemOutStream out;
    VerilogNetlister netlister(out);
    netlister.WriteNetlist(&first.GetNetlist(), WithoutHeader());
    netlister.WriteNetlist(&second.GetNetlist(), WithoutHeader());
    const std::string both = WriteToMemory(&first.GetNetlist(), WithoutHeader()) +
                             WriteToMemory(&second.GetNetlist(), WithoutHeader());
    EXPECT_EQ(out.GetValue(), both.c_str());
}

TEST(VerilogNetlisterTest, PortsAndPinsMayStandOnOneLine) {
    EngineScript script("ADD PORT A Input\nADD PORT B(3:0) Input\nADD PORT Y Output\n" +
                        Inverters({"U1 A Y"}));
    script.GetOptions().onePortPerLine = false;
    const std::string text = script.Verilog();
    EXPECT_TRUE(Holds(text, "\nmodule top(A, B, Y);\n")) << text;
    EXPECT_TRUE(Holds(text, "\n   INV U1 (.I(A), .O(Y));\n")) << text;
}

TEST(VerilogNetlisterTest, NamesAreWrittenAsTheyAre) {
    EngineScript script("ADD PORT module Input\nADD SIGNAL \"a b\"\nADD SIGNAL 1st\n"
                        "SET NETLIST NAME \"my top\"");
    const std::string text = script.Verilog();
    EXPECT_TRUE(Holds(text, "module my top(module);\n")) << text;
    EXPECT_EQ(Wires(text), (Lines{"wire a b;", "wire 1st;"}));
}

TEST(VerilogNetlisterTest, AnIncludePathIsNeverBroken) {
    const std::string path = std::string(60, 'p') + " with blanks " + std::string(60, 'q');
    EngineScript script("ADD INCLUDE \"" + path + "\"");
    EXPECT_TRUE(Holds(script.Verilog(), "`include \"" + path + "\"\n"));
}

TEST(VerilogNetlisterTest, NaturalOrderDecides) {
    EngineScript script("ADD PORT p10 Input\nADD PORT p9 Input\nADD PORT P1 Input\n"
                        "ADD PORT a_b Output\nADD PORT a1 Output\nADD PORT z BiDirectional\n"
                        "ADD SIGNAL n2\nADD SIGNAL N10\nADD SIGNAL n1");
    const std::string text = script.Verilog();
    EXPECT_TRUE(Holds(text, "module top(P1, \n           p9, \n           p10, \n"
                            "           a_b, \n           a1, \n           z);\n"))
        << text;
    EXPECT_EQ(Wires(text), (Lines{"wire n1;", "wire n2;", "wire N10;"}));
}

// Signals that are special

TEST(VerilogNetlisterTest, AnOpenPinHasEmptyParentheses) {
    EngineScript script(Adder);
    script.Run("CONNECT SIGNAL Open U1.CI");
    const std::string text = script.Verilog();
    EXPECT_TRUE(Holds(text, "(.A(), \n            .CI(), \n            .S());\n")) << text;
    // Only the connection is empty; the signal is a signal.
    EXPECT_EQ(Wires(text), (Lines{"wire Open;"}));
}

TEST(VerilogNetlisterTest, ASignalWithoutANameIsNowhere) {
    EngineScript script(Adder);
    script.Run("ADD PORT \"\" Input\nCONNECT SIGNAL \"\" U1.CI\nCONNECT SIGNAL \"\" X\n"
               "CONNECT SIGNAL Y \"\" \nASSIGN CONSTANT \"\" 1");
    const std::string text = script.Verilog();
    EXPECT_TRUE(Holds(text, "module top();\n")) << text;
    EXPECT_TRUE(Holds(text, ".CI()")) << text;
    EXPECT_EQ(Wires(text), (Lines{"wire X;", "wire Y;"}));
    EXPECT_TRUE(Assigns(text).empty());
    EXPECT_TRUE(LinesThatBegin(text, "input").empty());
}

TEST(VerilogNetlisterTest, ABusWhoseNameDoesNotParseIsAScalar) {
    EngineScript script;
    script.GetNetlist().Add(new Bus("no_range"));
    auto* port = new Bus("also none");
    port->SetPortPolarity(Polarity(Polarity::Input));
    script.GetNetlist().Add(port);
    const std::string text = script.Verilog();
    EXPECT_EQ(Wires(text), (Lines{"wire no_range;"}));
    EXPECT_EQ(LinesThatBegin(text, "input"), (Lines{"input also none;"}));
    EXPECT_TRUE(Holds(text, "module top(also none);")) << text;
}

TEST(VerilogNetlisterTest, AnInstanceWithoutAComponentIsWrittenWithoutOne) {
    EngineScript script(Inverters({"U1 A Y"}));
    script.GetNetlist().Remove(script.GetModel().GetComponent("INV"));
    const std::string text = script.Verilog();
    EXPECT_TRUE(Holds(text, "\n    U1 (.I(A), \n        .O(Y));\n")) << text;
}

// Connections

TEST(VerilogNetlisterTest, BitsAndSlicesHaveBrackets) {
    EngineScript script(Adder);
    script.Run("ADD SIGNAL D(7:0)\nCONNECT SIGNAL D(7:4) U1.A(3:0)\nCONNECT SIGNAL D(0) U1.CI\n"
               "CONNECT SIGNAL T(3:0) U1.S(3:0)");
    EXPECT_TRUE(Holds(script.Verilog(),
                      "(.A(D[7:4]), \n            .CI(D[0]), \n            .S(T[3:0]));"));
}

TEST(VerilogNetlisterTest, ABusOfOneBitIsItsBit) {
    EngineScript script(Adder);
    script.Run("CONNECT SIGNAL D(5:5) U1.CI");
    const std::string text = script.Verilog();
    EXPECT_TRUE(Holds(text, ".CI(D[5])")) << text;
    EXPECT_EQ(Wires(text), (Lines{"wire [5:5] D;"}));
}

TEST(VerilogNetlisterTest, ACompoundIsAConcatenation) {
    EngineScript script(Adder);
    script.Run("ADD SIGNAL D(7:0)\nCONNECT SIGNAL A,B U1.CI\n"
               "CONNECT SIGNAL A,D(0:1),D(3:3) U1.A(3:0)");
    const std::string text = script.Verilog();
    EXPECT_TRUE(Holds(text, ".CI({A, B})")) << text;
    EXPECT_TRUE(Holds(text, ".A({A, {D[0], D[1]}, D[3:3]})")) << text;
}

TEST(VerilogNetlisterTest, ACompoundOfACompoundIsNested) {
    EngineScript script(Adder);
    script.Run("ADD SIGNAL X\nCONNECT SIGNAL A,B Y");
    auto* outer = new CompoundBus("outer");
    outer->AddBusMember(script.GetModel().GetSignal("X"));
    outer->AddBusMember(script.GetModel().GetSignal("A,B"));
    script.GetNetlist().Add(outer);
    outer->Connect(script.GetModel().GetInstance("U1")->GetPin("A(3:0)"));
    EXPECT_TRUE(Holds(script.Verilog(), ".A({X, {A, B}})"));
}

TEST(VerilogNetlisterTest, ASliceTooWideToBeSpelledOutIsWrittenWhole) {
    EngineScript script(Adder);
    script.Run("ADD SIGNAL D(3000000:0)\nCONNECT SIGNAL D(0:2000000) U1.CI");
    EXPECT_TRUE(Holds(script.Verilog(), ".CI(D[0:2000000])"));
}

TEST(VerilogNetlisterTest, ABusBitPinHasItsBaseName) {
    EngineScript script("ADD COMPONENT C\nADD PIN C K(2) Input\nADD INSTANCE C U1\n"
                        "CONNECT SIGNAL N U1.K(2)");
    EXPECT_TRUE(Holds(script.Verilog(), "   C U1 (.K(N));\n"));
}

// Assignments

TEST(VerilogNetlisterTest, ConstantsComeBeforeAliases) {
    EngineScript script("CONNECT SIGNAL A X\nASSIGN CONSTANT Z 1\nASSIGN CONSTANT X 0");
    EXPECT_EQ(Assigns(script.Verilog()),
              (Lines{"assign X = 0;", "assign Z = 1;", "assign A = X;"}));
}

TEST(VerilogNetlisterTest, ConstantsOfEveryKindOfSignal) {
    EngineScript script("ADD SIGNAL D(7:0)\nASSIGN CONSTANT D(7:0) 8:H:FF\n"
                        "ASSIGN CONSTANT D(3) 4:B:1110\nASSIGN CONSTANT D(1:0) 2:B:01\n"
                        "ASSIGN CONSTANT D(4:5) 2:O:3\nASSIGN CONSTANT D(6:6) 1:B:1\n"
                        "ASSIGN CONSTANT E(3:0) 1010\nASSIGN CONSTANT N 1'b0\n"
                        "ASSIGN CONSTANT A,E(3:0) 5:B:10101\nASSIGN CONSTANT A,N 10");
    EXPECT_EQ(
        Assigns(script.Verilog()),
        (Lines{"assign {A, E[3:0]} = 5'b10101;", "assign {A, N} = 10;", "assign D[1:0] = 2'b01;",
               "assign D[3] = 0;", "assign {D[4], D[5]} = 2'o3;", "assign D[6:6] = 1'b1;",
               "assign D = 8'hFF;", "assign E = 1010;", "assign N = 0;"}));
}

TEST(VerilogNetlisterTest, AliasesOfEveryKindOfSignal) {
    EngineScript script(
        "ADD SIGNAL D(7:0)\nADD SIGNAL E(0:7)\nADD SIGNAL F(0:0)\n"
        "CONNECT SIGNAL N D(3)\nCONNECT SIGNAL N D(0:1)\nCONNECT SIGNAL D(3) F(0:0)\n"
        "CONNECT SIGNAL D(7:0) E(0:7)\nCONNECT SIGNAL D(5:4) A,B\n"
        "CONNECT SIGNAL D(1:2) E(1:2)\nCONNECT SIGNAL A,F(0:0) D(6:6)");
    EXPECT_EQ(Assigns(script.Verilog()),
              (Lines{"assign {A, F[0]} = D[6:6];", "assign {D[1], D[2]} = E[1:2];",
                     "assign D[3] = F[0:0];", "assign D[5:4] = {A, B};", "assign D[7:0] = E[0:7];",
                     "assign N = D[3];", "assign N = {D[0], D[1]};"}));
}

// Attributes, parameters

TEST(VerilogNetlisterTest, SynplicityAttributesStandBeforeTheSemicolon) {
    EngineScript script("SET SYNTHESIS SYNPLICITY\nADD PORT A Input\nADD PORT B Input\n"
                        "ADD SIGNAL ATTRIBUTE A LOC P1\n"
                        "SET SIGNAL ATTRIBUTE OPTION A LOC -SYNATTR=ASSIGN");
    EXPECT_TRUE(
        Holds(script.Verilog(), "\n    input A/* synthesis \"LOC=P1\" */;\n    input B;\n"));
    script.Run("SET SYNTHESIS QSN");
    EXPECT_TRUE(Holds(script.Verilog(), "\n    input A;\n   // synthesis attribute LOC of A is "
                                        "\"P1\"\n    input B;\n"));
}

TEST(VerilogNetlisterTest, AttributesOfABusNameItsBase) {
    EngineScript script("ADD SIGNAL D(7:0)\nADD SIGNAL ATTRIBUTE D(7:0) KEEP yes\n"
                        "SET SIGNAL ATTRIBUTE OPTION D(7:0) KEEP -SYNATTR=ASSIGNNODEC");
    EXPECT_TRUE(Holds(script.Verilog(), "// synthesis attribute KEEP of D is \"yes\"\n"));
}

TEST(VerilogNetlisterTest, DefparamsFollowTheirInstance) {
    EngineScript script("ADD COMPONENT C\nADD INSTANCE C U1\n"
                        "ADD COMPONENT ATTRIBUTE C A component\n"
                        "ADD COMPONENT ATTRIBUTE C B component\n"
                        "ADD COMPONENT ATTRIBUTE C N component\n"
                        "ADD INSTANCE ATTRIBUTE U1 a instance\n"
                        "ADD INSTANCE ATTRIBUTE U1 M instance\n"
                        "ADD INSTANCE ATTRIBUTE U1 Z instance\n"
                        "SET COMPONENT ATTRIBUTE OPTION C A -GENERIC=SYN\n"
                        "SET COMPONENT ATTRIBUTE OPTION C B -GENERIC=SYN -SYNATTR=ASSIGN\n"
                        "SET COMPONENT ATTRIBUTE OPTION C N -GENERIC=NOSYN\n"
                        "SET INSTANCE ATTRIBUTE OPTION U1 a -GENERIC=SYN\n"
                        "SET INSTANCE ATTRIBUTE OPTION U1 M -GENERIC=NOSYN\n");
    EXPECT_TRUE(Holds(script.Verilog(), "\n   C U1 ();\n"
                                        "   // synthesis attribute B of U1 is \"component\"\n"
                                        "   defparam U1.a = \"instance\";\n"
                                        "   defparam U1.B = \"component\";\n"
                                        "   // synopsys translate_off\n"
                                        "   defparam U1.M = \"instance\";\n"
                                        "   defparam U1.N = \"component\";\n"
                                        "   // synopsys translate_on\n"
                                        "endmodule\n"))
        << script.Verilog();
}

TEST(VerilogNetlisterTest, AnInstanceAttributeHidesTheComponentsEvenWhenItIsNotWritten) {
    EngineScript script("ADD COMPONENT C\nADD INSTANCE C U1\n"
                        "ADD COMPONENT ATTRIBUTE C A component\n"
                        "SET COMPONENT ATTRIBUTE OPTION C A -GENERIC=SYN -SYNATTR=ASSIGN\n"
                        "ADD INSTANCE ATTRIBUTE U1 a instance");
    EXPECT_TRUE(Holds(script.Verilog(), "\n   C U1 ();\nendmodule\n"));
}

TEST(VerilogNetlisterTest, AnInstanceAttributeHidesTheComponentsByItsPresentName) {
    EngineScript script("ADD COMPONENT C\nADD INSTANCE C U1\n"
                        "ADD COMPONENT ATTRIBUTE C A component\n"
                        "SET COMPONENT ATTRIBUTE OPTION C A -GENERIC=SYN\n"
                        "ADD INSTANCE ATTRIBUTE U1 B instance");
    Instance* const instance = script.GetNetlist().GetInstance("U1");
    EXPECT_FALSE(Holds(script.Verilog(), "\n   C U1 ();\nendmodule\n"));
    instance->GetAttr("B")->SetName("a");
    EXPECT_TRUE(Holds(script.Verilog(), "\n   C U1 ();\nendmodule\n"));
}

class HierarchicalInit : public testing::Test {
protected:
    /// A design of one instance that has INIT; its name and the module's INIT vary.
    std::string Write(const std::string& name, const std::string& moduleLines,
                      const std::string& generic = "SYN") {
        EngineScript script("ADD COMPONENT C\nADD INSTANCE C U1\n"
                            "ADD INSTANCE ATTRIBUTE U1 INIT own\n"
                            "SET INSTANCE ATTRIBUTE OPTION U1 INIT -GENERIC=" +
                            generic + "\n" + moduleLines);
        Netlist& netlist = script.GetNetlist();
        netlist.SetName(name.c_str());
        HdlOptions options = WithoutHeader();
        const std::string text = WriteToMemory(&netlist, options);
        isSet_ = options.hierarchicalInit;
        return text;
    }

    const std::string moduleInit_ = "ADD MODULE ATTRIBUTE INIT outer\n"
                                    "SET MODULE ATTRIBUTE OPTION INIT -GENERIC=SYN\n";
    bool isSet_ = false;
};

TEST_F(HierarchicalInit, NeedsAMarkInTheName) {
    for (const char* name : {"MHALVEX_ADD4", "HHALVEX", "xMHALVEXy", "aHHALVEXb"}) {
        const std::string text = Write(name, moduleInit_);
        EXPECT_EQ(LinesThatBegin(text, "defparam"), (Lines{"defparam U1.INIT = INIT;"})) << name;
        EXPECT_EQ(LinesThatBegin(text, "parameter"), (Lines{"parameter INIT = \"outer\";"}));
        EXPECT_TRUE(isSet_) << name;
    }
    for (const char* name : {"mhalvex", "HALVEX", "MHALVE", "Hhalvex"}) {
        const std::string text = Write(name, moduleInit_);
        EXPECT_EQ(LinesThatBegin(text, "defparam"), (Lines{"defparam U1.INIT = \"own\";"})) << name;
        EXPECT_FALSE(isSet_) << name;
    }
}

TEST_F(HierarchicalInit, NeedsAGenericInitOfTheModule) {
    const Lines own = {"defparam U1.INIT = \"own\";"};
    const Lines passed = {"defparam U1.INIT = INIT;"};
    EXPECT_EQ(LinesThatBegin(Write("MHALVEX", ""), "defparam"), own);
    EXPECT_EQ(LinesThatBegin(Write("MHALVEX", "ADD MODULE ATTRIBUTE INIT x\n"), "defparam"), own);
    EXPECT_EQ(LinesThatBegin(Write("MHALVEX", "ADD MODULE ATTRIBUTE Init x\nSET MODULE ATTRIBUTE "
                                              "OPTION INIT -GENERIC=SYN\n"),
                             "defparam"),
              own);
    EXPECT_EQ(LinesThatBegin(Write("MHALVEX", "ADD MODULE ATTRIBUTE INIT x\nSET MODULE ATTRIBUTE "
                                              "OPTION INIT -GENERIC=NOSYN\n"),
                             "defparam"),
              passed);
}

TEST_F(HierarchicalInit, LeavesAnInitForSimulationInItsPlace) {
    EXPECT_EQ(LinesThatBegin(Write("MHALVEX", moduleInit_, "NOSYN"), "defparam"),
              (Lines{"defparam U1.INIT = INIT;", "defparam U1.INIT = \"own\";"}));
}

TEST_F(HierarchicalInit, IsNotRecordedInConstantOptions) {
    EngineScript script("ADD COMPONENT C\nADD INSTANCE C U1\nADD INSTANCE ATTRIBUTE U1 INIT own\n"
                        "SET INSTANCE ATTRIBUTE OPTION U1 INIT -GENERIC=SYN\n" +
                        moduleInit_);
    script.GetNetlist().SetName("MHALVEX");
    for (const bool before : {false, true}) {
        HdlOptions options = WithoutHeader();
        options.hierarchicalInit = before;
        const std::string text =
            WriteToMemory(&script.GetNetlist(), static_cast<const HdlOptions&>(options));
        EXPECT_EQ(LinesThatBegin(text, "defparam"), (Lines{"defparam U1.INIT = INIT;"}));
        EXPECT_EQ(options.hierarchicalInit, before);
    }
}

TEST_F(HierarchicalInit, StaysWhenThereIsNoNetlist) {
    HdlOptions options;
    options.hierarchicalInit = true;
    EXPECT_EQ(WriteToMemory(nullptr, options), "");
    EXPECT_TRUE(options.hierarchicalInit);
}

TEST_F(HierarchicalInit, IsSetAfreshByEveryWrite) {
    EngineScript script(moduleInit_);
    script.GetOptions().hierarchicalInit = true;
    script.Verilog();
    EXPECT_FALSE(script.GetOptions().hierarchicalInit);
    script.GetNetlist().SetName("MHALVEX");
    script.Verilog();
    EXPECT_TRUE(script.GetOptions().hierarchicalInit);
}

// Name cases

TEST(VerilogNameCases, RenameTheObjectsForGood) {
    EngineScript script("ADD SIGNAL D(7:0)\nCONNECT SIGNAL D(3) n\nCONNECT SIGNAL D(3),n x\n"
                        "ADD COMPONENT Cell\nADD INSTANCE Cell u\nUPPERCASE siganl\n"
                        "UPPERCASE instance\nLOWERCASE component");
    EXPECT_EQ(Assigns(script.Verilog()), (Lines{"assign D[3] = N;", "assign {D[3], N} = X;"}));
    EXPECT_EQ(script.GetModel().GetSignal("n")->GetName(), "N");
    EXPECT_EQ(script.GetModel().GetSignal("D(3),n")->GetName(), "D(3),N");
    EXPECT_EQ(script.GetModel().GetComponent("Cell")->GetName(), "cell");
    EXPECT_EQ(script.GetModel().GetInstance("u")->GetName(), "U");
    script.Run("LOWERCASE signal\nCONNECT SIGNAL N fresh");
    EXPECT_EQ(Wires(script.Verilog()),
              (Lines{"wire [7:0] d;", "wire fresh;", "wire n;", "wire x;"}));
}

TEST(VerilogNameCases, LeaveTheOthersAlone) {
    EngineScript script(Inverters({"u1 Aa Yy"}) + "UPPERCASE instance");
    const std::string text = script.Verilog();
    EXPECT_TRUE(Holds(text, "   INV U1 (.I(Aa), \n           .O(Yy));\n")) << text;
}

TEST(VerilogNameCases, OnlyAsciiLettersHaveCase) {
    EngineScript script("ADD SIGNAL \xe4z{\nUPPERCASE siganl");
    EXPECT_EQ(Wires(script.Verilog()), (Lines{"wire \xe4Z(;"}));
}

// Long lines

TEST(VerilogLongLines, BreakAtTheLastBlank) {
    std::string members = "M0";
    for (int i = 1; i < 30; ++i) {
        members += ",M" + std::to_string(i);
    }
    EngineScript script("ADD COMPONENT C\nADD PIN C I(29:0) Input\nADD INSTANCE C U1\n"
                        "CONNECT SIGNAL " +
                        members + " U1.I(29:0)");
    const std::string text = script.Verilog();
    EXPECT_TRUE(Holds(
        text, "   C U1 (.I({M0, M1, M2, M3, M4, M5, M6, M7, M8, M9, M10, M11, M12, M13, M14, \n"
              "         M15, M16, M17, M18, M19, M20, M21, M22, M23, M24, M25, M26, M27, M28, \n"
              "         M29}));\n"))
        << text;
}
