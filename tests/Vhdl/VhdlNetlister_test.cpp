// What the VHDL writer writes in which situation, beside the golden designs.

#include "Orn_Hdl/Orn_Hdl.h"
#include "Support/EngineScript.h"
#include "Support/NetlistText.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

using namespace Orn_Hdl;
using Support::Between;
using Support::EngineScript;
using Support::Inverters;
using Support::LinesThatBegin;
using Support::SplitLines;

namespace {

using Lines = std::vector<std::string>;

std::string WriteToMemory(Netlist* netlist, const HdlOptions* options) {
    TextMemOutStream out;
    VhdlNetlister netlister(out);
    netlister.WriteNetlist(netlist, options);
    return std::string(out.GetValue().GetView());
}

bool Holds(const std::string& text, const std::string& piece) {
    return text.find(piece) != std::string::npos;
}

/// The assignments of the architecture's body.
Lines Assigns(const std::string& text) {
    Lines found;
    for (const std::string& line : SplitLines(Between(text, "\nbegin\n", "\nend BEHAVIORAL;"))) {
        if (Holds(line, " <= ")) {
            found.push_back(line.substr(line.find_first_not_of(' ')));
        }
    }
    return found;
}

Lines Signals(const std::string& text) {
    return LinesThatBegin(text, "signal ");
}

/// The port map of an instance, on one line however long.
std::string PortMap(EngineScript& script, const std::string& instance) {
    script.GetOptions().onePortPerLine = false;
    const std::string text = WriteToMemory(&script.GetNetlist(), &script.GetOptions());
    const std::string start = "\n" + instance + " : C\nport map ";
    const std::string piece = Between(text, start, ";\n");
    return piece.empty() ? text : piece.substr(start.size());
}

std::string Cell(const std::string& pins) {
    std::string lines = "ADD COMPONENT C\n";
    const StringArray names(pins.c_str(), " ", true, nullptr);
    for (int i = 0; i < names.GetSize(); ++i) {
        lines += "ADD PIN C " + std::string(names.GetView(i)) + " Input\n";
    }
    return lines + "ADD INSTANCE C U1\n";
}

constexpr const char* DefaultLibraries = "library ieee;\n"
                                         "use ieee.std_logic_1164.ALL;\n"
                                         "use ieee.numeric_std.ALL;\n"
                                         "library KESTRA;\n"
                                         "use KESTRA.Vcomponents.ALL;\n"
                                         "\n";

} // namespace

// The frame

TEST(VhdlNetlisterTest, NullIsNothing) {
    EngineScript script;
    EXPECT_EQ(WriteToMemory(nullptr, &script.GetOptions()), "");
    EXPECT_EQ(WriteToMemory(&script.GetNetlist(), nullptr), "");
    EXPECT_EQ(WriteToMemory(nullptr, nullptr), "");
}

TEST(VhdlNetlisterTest, AnEmptyDesignIsAFrame) {
    EngineScript script;
    EXPECT_EQ(script.Vhdl(), "\n" + std::string(DefaultLibraries) +
                                 "entity top is\n"
                                 "   port ( );\n"
                                 "end top;\n"
                                 "architecture BEHAVIORAL of top is\n"
                                 "begin\n"
                                 "end BEHAVIORAL;\n"
                                 "\n"
                                 "-- synopsys translate_off\n"
                                 "configuration CFG_top of  top is\n"
                                 "   for BEHAVIORAL\n"
                                 "   end for;\n"
                                 "end CFG_top;\n"
                                 "-- synopsys translate_on\n"
                                 "\n");
}

TEST(VhdlNetlisterTest, EverySwitchTakesItsPartAway) {
    EngineScript script("SUPPRESS CONFIGURATION\nUSE DEFAULT LIBRARY false\nSUPPRESS COMPONENT\n" +
                        Inverters({"U1 A Y"}));
    EXPECT_EQ(script.Vhdl(), "\n"
                             "entity top is\n"
                             "   port ( );\n"
                             "end top;\n"
                             "architecture BEHAVIORAL of top is\n"
                             "   signal A : std_logic;\n"
                             "   signal Y : std_logic;\n"
                             "begin\n"
                             "   U1 : INV\n"
                             "      port map (I=>A,\n"
                             "                O=>Y);\n"
                             "end BEHAVIORAL;\n"
                             "\n");
}

TEST(VhdlNetlisterTest, UserLibrariesComeBeforeTheDefaultOnes) {
    EngineScript script("ADD LIBRARY one\nADD LIBRARY two\nADD USE LIBRARY one.all.all\n"
                        "ADD USE LIBRARY two.x\nADD NOTES note");
    EXPECT_EQ(script.Vhdl().find("-- note\n\nlibrary one;\nlibrary two;\nuse one.all.all;\n"
                                 "use two.x;\n" +
                                 std::string(DefaultLibraries) + "entity top is\n"),
              0u);
}

TEST(VhdlNetlisterTest, EmptyLinesAreEmpty) {
    EngineScript script("ADD PORT A Input\nADD NOTES x\n" + Inverters({"U1 A Y"}));
    for (const std::string& line : SplitLines(script.Vhdl())) {
        EXPECT_TRUE(line.empty() || line.find_first_not_of(' ') != std::string::npos);
    }
}

TEST(VhdlNetlisterTest, PortMapsMayStandOnOneLine) {
    EngineScript script(Inverters({"U1 A Y"}));
    script.GetOptions().onePortPerLine = false;
    EXPECT_TRUE(Holds(script.Vhdl(), "   U1 : INV\n      port map (I=>A, O=>Y);\n"));
}

TEST(VhdlNetlisterTest, AnInstanceWithoutPinsHasNoPortMap) {
    EngineScript script("ADD COMPONENT C\nADD INSTANCE C U1");
    const std::string text = script.Vhdl();
    EXPECT_TRUE(Holds(text, "begin\n   U1 : C\n      ;\nend BEHAVIORAL;\n")) << text;
    EXPECT_TRUE(Holds(text, "   component C\n   end component;\n\nbegin\n")) << text;
}

TEST(VhdlNetlisterTest, OneNetlisterDeclaresAttributesAnewForEachNetlist) {
    EngineScript script("ADD SIGNAL N\nADD SIGNAL ATTRIBUTE N LOC P1\n"
                        "SET SIGNAL ATTRIBUTE OPTION N LOC -SYNATTR=ASSIGN");
    script.GetOptions().writeHeader = false;
    TextMemOutStream out;
    VhdlNetlister netlister(out);
    netlister.WriteNetlist(&script.GetNetlist(), &script.GetOptions());
    const std::string once(out.GetValue().GetView());
    netlister.WriteNetlist(&script.GetNetlist(), &script.GetOptions());
    VhdlNetlister(netlister).WriteNetlist(&script.GetNetlist(), &script.GetOptions());
    EXPECT_EQ(out.GetValue(), (once + once + once).c_str());
    EXPECT_TRUE(Holds(once, "attribute LOC : string ;\n"));
}

TEST(VhdlNetlisterTest, CommentsOfPortsAndPinsAreNotWritten) {
    EngineScript script("ADD PORT A Input\nADD SIGNAL COMMENT A port\n" + Inverters({"U1 A Y"}) +
                        "ADD COMPONENT PIN COMMENT INV.I pin\nADD INSTANCE PIN COMMENT U1.I pin\n"
                        "ADD SIGNAL COMMENT Y signal\nADD INSTANCE COMMENT U1 instance\n"
                        "ADD COMPONENT COMMENT INV component\nSUPPRESS CONFIGURATION");
    EXPECT_EQ(LinesThatBegin(script.Vhdl(), "--"),
              (Lines{"-- signal", "-- component", "-- instance"}));
}

// Declarations

TEST(VhdlNetlisterTest, OnlyScalarsAndBusesAreDeclared) {
    EngineScript script("ADD SIGNAL D(7:0)\nCONNECT SIGNAL D(3:0) A,B\nCONNECT SIGNAL D(5) N");
    EXPECT_EQ(
        Signals(script.Vhdl()),
        (Lines{"signal A      : std_logic;", "signal B      : std_logic;",
               "signal D      : std_logic_vector (7 downto 0);", "signal N      : std_logic;"}));
}

TEST(VhdlNetlisterTest, SignalsNamedOpenOrNothingAreNotDeclared) {
    EngineScript script(Cell("I K") + "CONNECT SIGNAL OPEN U1.I\nCONNECT SIGNAL OPEN N\n"
                                      "CONNECT SIGNAL \"\" U1.K\nADD PORT A Input");
    const std::string text = script.Vhdl();
    EXPECT_EQ(Signals(text), (Lines{"signal N    : std_logic;"}));
    EngineScript ports("ADD PORT \"\" Input\nADD PORT A Output");
    EXPECT_TRUE(Holds(ports.Vhdl(), "   port ( A : out   std_logic);\n")) << ports.Vhdl();
}

TEST(VhdlNetlisterTest, ABusWhoseNameDoesNotParseIsAScalar) {
    EngineScript script;
    script.GetNetlist().Add(new Bus("no_range"));
    auto* port = new Bus("port_bus");
    port->SetPortPolarity(Polarity(Polarity::Input));
    script.GetNetlist().Add(port);
    const std::string text = script.Vhdl();
    EXPECT_EQ(Signals(text), (Lines{"signal no_range : std_logic;"}));
    EXPECT_TRUE(Holds(text, "   port ( port_bus : in    std_logic);\n")) << text;
}

TEST(VhdlNetlisterTest, ComponentsAreDeclaredWhenTheirFirstInstanceIsMet) {
    EngineScript script("ADD COMPONENT Zeta\nADD COMPONENT Alpha\nADD COMPONENT Unused\n"
                        "ADD INSTANCE Alpha U2\nADD INSTANCE Zeta U1\nADD INSTANCE Alpha U3");
    EXPECT_EQ(LinesThatBegin(script.Vhdl(), "component "),
              (Lines{"component Zeta", "component Alpha"}));
}

TEST(VhdlNetlisterTest, EveryWidthIsThatOfTheWholeName) {
    EngineScript script("ADD PORT A(15:0) Input\nADD PORT Y Output\n" + Cell("Data(7:0) CE") +
                        "ADD SIGNAL N");
    const std::string text = script.Vhdl();
    EXPECT_TRUE(Holds(text, "   port ( A       : in    std_logic_vector (15 downto 0); \n"
                            "          Y       : out   std_logic);\n"))
        << text;
    EXPECT_TRUE(Holds(text, "      port ( Data      : in    std_logic_vector (7 downto 0); \n"
                            "             CE        : in    std_logic);\n"))
        << text;
    EXPECT_TRUE(Holds(text, "   signal N       : std_logic;\n")) << text;
}

// Port maps

TEST(VhdlPortMap, OpenPins) {
    EngineScript script(Cell("D(3:0) I J K K(2)") +
                        "CONNECT SIGNAL open U1.I\nCONNECT SIGNAL \"\" U1.J");
    EXPECT_EQ(PortMap(script, "U1"), "(D=>open, I=>open, J=>open, K=>open, K(2)=>open)");
}

TEST(VhdlPortMap, ScalarsAndBits) {
    EngineScript script(Cell("I K K(2)") + "ADD SIGNAL D(7:0)\nCONNECT SIGNAL N U1.I\n"
                                           "CONNECT SIGNAL D(3) U1.K\nCONNECT SIGNAL D(4) U1.K(2)");
    EXPECT_EQ(PortMap(script, "U1"), "(I=>N, K=>D(3), K(2)=>D(4))");
}

TEST(VhdlPortMap, Buses) {
    EngineScript script(Cell("A(3:0) B(0:3) I") +
                        "CONNECT SIGNAL D(3:0) U1.A(3:0)\nCONNECT SIGNAL D(3:0) U1.B(0:3)\n"
                        "CONNECT SIGNAL E(0:0) U1.I");
    EXPECT_EQ(PortMap(script, "U1"),
              "(A(3 downto 0)=>D(3 downto 0), B(0 to 3)=>D(3 downto 0), I=>E(0))");
}

TEST(VhdlPortMap, Slices) {
    EngineScript script(Cell("A(3:0) B(0:3) I") +
                        "ADD SIGNAL D(7:0)\nCONNECT SIGNAL D(7:4) U1.A(3:0)\n"
                        "CONNECT SIGNAL D(4:7) U1.B(0:3)\nCONNECT SIGNAL D(2:2) U1.I");
    EXPECT_EQ(PortMap(script, "U1"), "(A(3 downto 0)=>D(7 downto 4), B(0)=>D(4), B(1)=>D(5), "
                                     "B(2)=>D(6), B(3)=>D(7), I=>D(2))");
}

TEST(VhdlPortMap, Compounds) {
    EngineScript script(Cell("A(7:4) B(0:4)") + "ADD SIGNAL D(7:0)\nADD SIGNAL E(1:0)\n"
                                                "CONNECT SIGNAL X,E(1:0),D(0) U1.A(7:4)\n"
                                                "CONNECT SIGNAL D(7:6),D(2:3),X U1.B(0:4)");
    EXPECT_EQ(PortMap(script, "U1"), "(A(7)=>X, A(6 downto 5)=>E(1 downto 0), A(4)=>D(0), "
                                     "B(0 to 1)=>D(7 downto 6), B(2)=>D(2), B(3)=>D(3), B(4)=>X)");
}

TEST(VhdlPortMap, AFormalThatIsNoBusStaysAsItIs) {
    EngineScript script(Cell("I K(2)") + "CONNECT SIGNAL X,Y U1.I\nCONNECT SIGNAL X,Y U1.K(2)");
    EXPECT_EQ(PortMap(script, "U1"), "(I=>X, I=>Y, K(2)=>X, K(2)=>Y)");
}

TEST(VhdlPortMap, MembersWithoutBitsAreSkipped) {
    EngineScript script(Cell("A(1:0)") + "CONNECT SIGNAL X,Y U1.A(1:0)");
    auto* compound = dynamic_cast<CompoundBus*>(script.GetModel().GetSignal("X,Y"));
    auto* empty = new CompoundBus("empty");
    script.GetNetlist().Add(empty);
    compound->AddBusMember(empty);
    EXPECT_EQ(PortMap(script, "U1"), "(A(1)=>X, A(0)=>Y)");
}

TEST(VhdlPortMap, TemporariesLeaveNoTrace) {
    EngineScript script(Cell("B(0:1)") + "ADD SIGNAL D(7:0)\nCONNECT SIGNAL D(0:1) U1.B(0:1)");
    script.Vhdl();
    const Bus* bus = script.GetNetlist().GetParentBus("D");
    int slices = 0;
    for (const Signal* slice : bus->GetBusSliceIterator()) {
        EXPECT_EQ(slice->GetName(), "D(0:1)");
        ++slices;
    }
    EXPECT_EQ(slices, 1);
    EXPECT_EQ(script.GetModel().GetSignal("D(0)"), nullptr);
}

TEST(VhdlPortMap, OpenInputsCanBeTied) {
    EngineScript script(Cell("A(3:0) I K(2)") + "Set Open Pin false\nADD PIN C O Output\n"
                                                "ADD INSTANCE C U2\nADD SIGNAL u2_i_OPENsignal");
    EXPECT_EQ(PortMap(script, "U2"),
              "(A(3 downto 0)=>U2_A_openSignal(3 downto 0), I=>u2_i_OPENsignal, K(2)=>open, "
              "O=>open)");
    EXPECT_EQ(PortMap(script, "U1"),
              "(A(3 downto 0)=>U1_A_openSignal(3 downto 0), I=>U1_I_openSignal, K(2)=>open)");
    script.Run("Set Open Pin true");
    EXPECT_EQ(Signals(script.Vhdl()).size(), 4u);
}

// Assignments

TEST(VhdlAssignments, OfConstants) {
    EngineScript script("ADD SIGNAL D(7:0)\nASSIGN CONSTANT D(7:0) 8:H:FF\n"
                        "ASSIGN CONSTANT D(3) 4:B:1110\nASSIGN CONSTANT D(1:0) 2:B:01\n"
                        "ASSIGN CONSTANT E(3:0) 1010\nASSIGN CONSTANT N 1");
    EXPECT_EQ(Assigns(script.Vhdl()),
              (Lines{"D(1 downto 0) <= b\"01\";", "D(3) <= '0';", "D(7 downto 0) <= x\"FF\";",
                     "E(3 downto 0) <= \"1010\";", "N <= '1';"}));
}

TEST(VhdlAssignments, OfConstantsBitByBit) {
    EngineScript script(
        "ADD SIGNAL D(7:0)\nADD SIGNAL N\nASSIGN CONSTANT N,D(1:0),D(4:5) 5:B:10110\n"
        "ASSIGN CONSTANT D(6:7) 01");
    EXPECT_EQ(Assigns(script.Vhdl()),
              (Lines{"D(6) <= '0';", "D(7) <= '1';", "N <= '1';", "D(1) <= '0';", "D(0) <= '1';",
                     "D(4) <= '1';", "D(5) <= '0';"}));
}

TEST(VhdlAssignments, OfConstantsThatCannotBeWrittenBitByBit) {
    for (const char* value : {"4:B:101", "4:B:10x0", "4:H:A", "4:O:12", "4:B:10101"}) {
        EngineScript script("ADD SIGNAL D(7:0)\nASSIGN CONSTANT A,B,C,E " + std::string(value) +
                            "\nASSIGN CONSTANT D(0:3) " + value);
        EXPECT_TRUE(Assigns(script.Vhdl()).empty()) << value;
    }
}

TEST(VhdlAssignments, OfConstantsOnSlicesOfOneBit) {
    EngineScript script(
        "ADD SIGNAL D(7:0)\nADD SIGNAL E(0:7)\nADD SIGNAL F(3:3)\nASSIGN CONSTANT D(5:5) 1:B:1\n"
        "ASSIGN CONSTANT E(5:5) 1:B:0\nASSIGN CONSTANT E(6:6) 1\nASSIGN CONSTANT F(3:3) 1:B:1");
    EXPECT_EQ(Assigns(script.Vhdl()), (Lines{"D(5 downto 5) <= b\"1\";", "E(5) <= '0';",
                                             "E(6) <= '1';", "F(3 downto 3) <= b\"1\";"}));
}

TEST(VhdlAssignments, OfConstantsThatAreNotTheOneBitOfAnAscendingBus) {
    for (const char* value : {"1:H:1", "4:H:A", "1:O:0", "2:B:01", "01", "x"}) {
        EngineScript script("ADD SIGNAL E(0:7)\nASSIGN CONSTANT E(5:5) " + std::string(value));
        EXPECT_TRUE(Assigns(script.Vhdl()).empty()) << value;
    }
}

TEST(VhdlAssignments, OfAliases) {
    EngineScript script("ADD SIGNAL D(7:0)\nADD SIGNAL E(0:7)\nCONNECT SIGNAL N D(3)\n"
                        "CONNECT SIGNAL D(7:0) E(0:7)\nCONNECT SIGNAL D(5:4) E(1:2)\n"
                        "CONNECT SIGNAL D(2) N");
    EXPECT_EQ(Assigns(script.Vhdl()), (Lines{"D(2) <= N;", "D(5 downto 4) <= E(1 to 2);",
                                             "D(7 downto 0) <= E(0 to 7);", "N <= D(3);"}));
}

TEST(VhdlAssignments, OfAliasesBitByBit) {
    const struct {
        const char* left;
        const char* right;
        Lines lines;
    } cases[] = {
        {"A,B", "D(5:4)", {"A <= D(5);", "B <= D(4);"}},
        {"D(5:4)", "B,A", {"D(5) <= B;", "D(4) <= A;"}},
        {"A,D(1:0)", "D(7:6),B", {"A <= D(7);", "D(1) <= D(6);", "D(0) <= B;"}},
        {"D(0:1)", "D(7:6)", {"D(0) <= D(7);", "D(1) <= D(6);"}},
        {"D(7:6)", "D(0:1)", {"D(7) <= D(0);", "D(6) <= D(1);"}},
        {"F(0:0)", "A", {"F(0) <= A;"}},
        {"A", "F(5:5)", {"A <= F(5);"}},
        {"D(3:3)", "A", {"D(3) <= A;"}},
        {"A", "D(3:3)", {"A <= D(3);"}},
        {"D(3:3)", "D(4)", {"D(3) <= D(4);"}},
        // Up to the narrower width.
        {"A,B,C", "D(5:4)", {"A <= D(5);", "B <= D(4);"}},
        {"D(0:3)", "A,B", {"D(0) <= A;", "D(1) <= B;"}},
    };
    for (const auto& c : cases) {
        EngineScript script("ADD SIGNAL D(7:0)\nCONNECT SIGNAL " + std::string(c.left) + " " +
                            c.right);
        EXPECT_EQ(Assigns(script.Vhdl()), c.lines) << c.left << " " << c.right;
    }
}

TEST(VhdlAssignments, OfAliasesTooWideToBeSpelledOut) {
    EngineScript script("ADD SIGNAL D(3000000:0)\nCONNECT SIGNAL X(2000000:0) D(0:2000000)");
    EXPECT_EQ(Assigns(script.Vhdl()), (Lines{"X(2000000 downto 0) <= D(0 to 2000000);"}));
}

TEST(VhdlAssignments, OfSignalsWithoutANameAreNotWritten) {
    EngineScript script("CONNECT SIGNAL \"\" X\nCONNECT SIGNAL Y \"\" \nASSIGN CONSTANT \"\" 1\n"
                        "ASSIGN CONSTANT Z 1");
    EXPECT_EQ(Assigns(script.Vhdl()), (Lines{"Z <= '1';"}));
}

// Attributes

TEST(VhdlAttributes, AreDeclaredOncePerFileAndOnlyWhenMarkedAssign) {
    EngineScript script("ADD PORT A Input\nADD PORT B Input\nADD SIGNAL N\n"
                        "ADD SIGNAL ATTRIBUTE A LOC P1\nADD SIGNAL ATTRIBUTE B loc P2\n"
                        "ADD SIGNAL ATTRIBUTE N Loc P3\nADD SIGNAL ATTRIBUTE N KEEP yes\n"
                        "ADD SIGNAL ATTRIBUTE N HIDE x\n"
                        "SET SIGNAL ATTRIBUTE OPTION A LOC -SYNATTR=ASSIGN\n"
                        "SET SIGNAL ATTRIBUTE OPTION B LOC -SYNATTR=ASSIGN\n"
                        "SET SIGNAL ATTRIBUTE OPTION N LOC -SYNATTR=ASSIGN\n"
                        "SET SIGNAL ATTRIBUTE OPTION N KEEP -SYNATTR=ASSIGNNODEC");
    EXPECT_EQ(
        LinesThatBegin(script.Vhdl(), "attribute "),
        (Lines{"attribute LOC  : string ;", "attribute LOC of A : signal is \"P1\";",
               "attribute loc of B : signal is \"P2\";", "attribute Loc of N : signal is \"P3\";",
               "attribute KEEP of N : signal is \"yes\";"}));
}

TEST(VhdlAttributes, OfABusNameItsBase) {
    EngineScript script("ADD PORT A(7:0) Input\nADD SIGNAL ATTRIBUTE A(7:0) LOC P1\n"
                        "SET SIGNAL ATTRIBUTE OPTION A(7:0) LOC -SYNATTR=ASSIGNNODEC");
    EXPECT_EQ(LinesThatBegin(script.Vhdl(), "attribute "),
              (Lines{"attribute LOC of A : signal is \"P1\";"}));
}

TEST(VhdlAttributes, ThatAnInstanceSharesWithItsComponentAreNotRepeated) {
    EngineScript script("ADD COMPONENT C\nADD INSTANCE C U1\nADD INSTANCE C U2\nADD INSTANCE C U3\n"
                        "ADD COMPONENT ATTRIBUTE C LOC P1\n"
                        "ADD INSTANCE ATTRIBUTE U1 LOC p1\n"
                        "ADD INSTANCE ATTRIBUTE U2 LOC P2\n"
                        "ADD INSTANCE ATTRIBUTE U3 LOC P1\n"
                        "SET COMPONENT ATTRIBUTE OPTION C LOC -SYNATTR=ASSIGN\n"
                        "SET INSTANCE ATTRIBUTE OPTION U1 LOC -SYNATTR=ASSIGN\n"
                        "SET INSTANCE ATTRIBUTE OPTION U2 LOC -SYNATTR=ASSIGN\n"
                        "SET INSTANCE ATTRIBUTE OPTION U3 LOC -SYNATTR=ASSIGNNODEC");
    EXPECT_EQ(LinesThatBegin(script.Vhdl(), "attribute "),
              (Lines{"attribute LOC : string ;", "attribute LOC of C : component is \"P1\";",
                     "attribute LOC of U2 : label is \"P2\";",
                     "attribute LOC of U3 : label is \"P1\";"}));
}

TEST(VhdlAttributes, HaveTheirTypeWhenAskedFor) {
    EngineScript script("Use AttrType\nADD SIGNAL N\nADD SIGNAL ATTRIBUTE N -TYPE=Integer COUNT 5\n"
                        "SET SIGNAL ATTRIBUTE OPTION N COUNT -SYNATTR=ASSIGN");
    EXPECT_EQ(LinesThatBegin(script.Vhdl(), "attribute "),
              (Lines{"attribute COUNT : integer ;", "attribute COUNT of N : signal is 5;"}));
}

TEST(VhdlAttributes, OfPortsHaveTheirTypeAndTheWidthOfAll) {
    EngineScript script("Use AttrType\nADD PORT A Input\n"
                        "ADD SIGNAL ATTRIBUTE A -TYPE=Boolean KEEP true\n"
                        "SET SIGNAL ATTRIBUTE OPTION A KEEP -SYNATTR=ASSIGN\n"
                        "ADD MODULE ATTRIBUTE OF_THE_MODULE x");
    EXPECT_EQ(
        LinesThatBegin(script.Vhdl(), "attribute "),
        (Lines{"attribute KEEP          : boolean ;", "attribute KEEP of A : signal is TRUE;"}));
}

TEST(VhdlAttributes, HaveTheWidthOfTheLongestNameOfAnyHolder) {
    const char* const additions[] = {
        "ADD MODULE ATTRIBUTE LONG_NAME x", "ADD SIGNAL ATTRIBUTE N LONG_NAME x",
        "ADD SIGNAL ATTRIBUTE D(2) LONG_NAME x", "ADD COMPONENT ATTRIBUTE UNUSED LONG_NAME x",
        "ADD INSTANCE ATTRIBUTE U1 LONG_NAME x"};
    for (const char* const addition : additions) {
        EngineScript script(
            "Use AttrType\nADD PORT A Input\nADD COMPONENT C\nADD COMPONENT UNUSED\n"
            "ADD INSTANCE C U1\nADD SIGNAL N\nADD SIGNAL D(3:0)\nADD SIGNAL D(2)\n"
            "ADD SIGNAL ATTRIBUTE A KEEP x\n"
            "SET SIGNAL ATTRIBUTE OPTION A KEEP -SYNATTR=ASSIGN\n" +
            std::string(addition));
        EXPECT_EQ(LinesThatBegin(script.Vhdl(), "attribute ").front(),
                  "attribute KEEP      : string ;")
            << addition;
    }
}

// Black boxes and configurations

TEST(VhdlConfiguration, ListsTheInstancesOfEachComponent) {
    EngineScript script("ADD COMPONENT B\nADD COMPONENT A\nADD COMPONENT Unused\n"
                        "ADD INSTANCE A U10\nADD INSTANCE B U1\nADD INSTANCE A U2");
    EXPECT_EQ(Between(script.Vhdl(), "-- synopsys translate_off", "-- synopsys translate_on"),
              "-- synopsys translate_off\n"
              "configuration CFG_top of  top is\n"
              "   for BEHAVIORAL\n"
              "      for U2, U10 : A\n"
              "         use configuration WORK.CFG_A;\n"
              "      end for;\n"
              "      for U1 : B\n"
              "         use configuration WORK.CFG_B;\n"
              "      end for;\n"
              "   end for;\n"
              "end CFG_top;\n");
}

TEST(VhdlConfiguration, LeavesPrimitiveCellsOut) {
    EngineScript script(
        "ADD COMPONENT A\nADD COMPONENT B\nADD COMPONENT C\nADD INSTANCE A U1\n"
        "ADD INSTANCE B U2\nADD INSTANCE C U3\nADD COMPONENT ATTRIBUTE A Level Halvex\n"
        "ADD COMPONENT ATTRIBUTE B level HALVEX1\n"
        "ADD INSTANCE ATTRIBUTE U3 Level HALVEX");
    EXPECT_EQ(LinesThatBegin(script.Vhdl(), "use configuration"),
              (Lines{"use configuration WORK.CFG_B;", "use configuration WORK.CFG_C;"}));
}

TEST(VhdlBlackBoxes, AreMarkedOnce) {
    EngineScript script(
        "ADD COMPONENT A\nADD COMPONENT B\nADD INSTANCE A U1\nADD INSTANCE B U2\n"
        "ADD COMPONENT ATTRIBUTE A level HALVEX\nADD COMPONENT ATTRIBUTE B LEVEL halvex\n"
        "ADD COMPONENT ATTRIBUTE B box_type own\n"
        "SET COMPONENT ATTRIBUTE OPTION B box_type -SYNATTR=ASSIGN");
    const Lines expected = {"attribute BOX_TYPE : string ;",
                            "attribute BOX_TYPE of A : component is \"BLACK_BOX\";",
                            "attribute box_type of B : component is \"own\";"};
    EXPECT_EQ(LinesThatBegin(script.Vhdl(), "attribute "), expected);
    EXPECT_EQ(LinesThatBegin(script.Vhdl(), "attribute "), expected);
}

// Generics

TEST(VhdlGenerics, OfAComponent) {
    EngineScript script("ADD COMPONENT C\nADD INSTANCE C U1\nADD COMPONENT ATTRIBUTE C A 1\n"
                        "ADD COMPONENT ATTRIBUTE C B 2\nADD COMPONENT ATTRIBUTE C X 3\n"
                        "ADD COMPONENT ATTRIBUTE C Y 4\nADD COMPONENT ATTRIBUTE C Z 5\n"
                        "SET COMPONENT ATTRIBUTE OPTION C A -GENERIC=SYN\n"
                        "SET COMPONENT ATTRIBUTE OPTION C X -GENERIC=NOSYN\n"
                        "SET COMPONENT ATTRIBUTE OPTION C B -GENERIC=SYN\n"
                        "SET COMPONENT ATTRIBUTE OPTION C Y -GENERIC=NOSYN\n");
    EXPECT_TRUE(Holds(script.Vhdl(), "   component C\n"
                                     "      generic( A : string :=  \"1\";\n"
                                     "               B : string :=  \"2\"\n"
                                     "      -- synopsys translate_off\n"
                                     "      ;\n"
                                     "               X : string :=  \"3\";\n"
                                     "               Y : string :=  \"4\"\n"
                                     "      -- synopsys translate_on\n"
                                     "      );\n"
                                     "   end component;\n"))
        << script.Vhdl();
}

TEST(VhdlGenerics, OfAnInstance) {
    EngineScript script("ADD COMPONENT C\nADD PIN C I Input\nADD INSTANCE C U1\n"
                        "ADD COMPONENT ATTRIBUTE C A c\nADD COMPONENT ATTRIBUTE C B c\n"
                        "ADD COMPONENT ATTRIBUTE C N c\n"
                        "ADD INSTANCE ATTRIBUTE U1 a i\nADD INSTANCE ATTRIBUTE U1 M i\n"
                        "SET COMPONENT ATTRIBUTE OPTION C A -GENERIC=SYN\n"
                        "SET COMPONENT ATTRIBUTE OPTION C B -GENERIC=SYN\n"
                        "SET COMPONENT ATTRIBUTE OPTION C N -GENERIC=NOSYN\n"
                        "SET INSTANCE ATTRIBUTE OPTION U1 a -GENERIC=SYN\n"
                        "SET INSTANCE ATTRIBUTE OPTION U1 M -GENERIC=NOSYN\n");
    EXPECT_TRUE(Holds(script.Vhdl(), "   U1 : C\n"
                                     "      generic map( a => \"i\",\n"
                                     "               B => \"c\"\n"
                                     "      -- synopsys translate_off\n"
                                     "      ,\n"
                                     "               M => \"i\",\n"
                                     "               N => \"c\"\n"
                                     "      -- synopsys translate_on\n"
                                     "      )\n"
                                     "      port map (I=>open);\n"))
        << script.Vhdl();
}

TEST(VhdlGenerics, ForSimulationOnlyStandWhollyBetweenTheMarks) {
    EngineScript script("ADD MODULE ATTRIBUTE A 1\nADD MODULE ATTRIBUTE B 2\n"
                        "SET MODULE ATTRIBUTE OPTION A -GENERIC=NOSYN\n"
                        "SET MODULE ATTRIBUTE OPTION B -GENERIC=NOSYN\n");
    EXPECT_TRUE(Holds(script.Vhdl(), "entity top is\n"
                                     "   -- synopsys translate_off\n"
                                     "   generic( A : string :=  \"1\";\n"
                                     "            B : string :=  \"2\");\n"
                                     "   -- synopsys translate_on\n"
                                     "   port ( );\n"))
        << script.Vhdl();
}

class VhdlInheritedInit : public testing::Test {
protected:
    std::string GenericMap(const char* name, const std::string& lines) {
        EngineScript script("ADD COMPONENT C\nADD INSTANCE C U1\n" + lines);
        script.GetNetlist().SetName(name);
        return Between(script.Vhdl(), "generic map", "\n      ;\n");
    }

    const std::string outer_ = "ADD MODULE ATTRIBUTE INIT outer\n"
                               "SET MODULE ATTRIBUTE OPTION INIT -GENERIC=SYN\n";
    const std::string own_ = "ADD INSTANCE ATTRIBUTE U1 A i\n"
                             "SET INSTANCE ATTRIBUTE OPTION U1 A -GENERIC=SYN\n"
                             "ADD INSTANCE ATTRIBUTE U1 INIT i\n"
                             "SET INSTANCE ATTRIBUTE OPTION U1 INIT -GENERIC=SYN\n";
    const std::string simulated_ = "ADD COMPONENT ATTRIBUTE C INIT c\n"
                                   "SET COMPONENT ATTRIBUTE OPTION C INIT -GENERIC=NOSYN\n"
                                   "ADD COMPONENT ATTRIBUTE C N c\n"
                                   "SET COMPONENT ATTRIBUTE OPTION C N -GENERIC=NOSYN\n";
};

TEST_F(VhdlInheritedInit, StandsFirst) {
    EXPECT_EQ(GenericMap("xMHALVEXx", outer_ + own_),
              "generic map( INIT => INIT,\n               A => \"i\")");
}

TEST_F(VhdlInheritedInit, NeedsTheMarkAndTheModulesInit) {
    const std::string plain = "generic map( A => \"i\",\n               INIT => \"i\")";
    EXPECT_EQ(GenericMap("HHALVEX", outer_ + own_), plain);
    EXPECT_EQ(GenericMap("mhalvex", outer_ + own_), plain);
    EXPECT_EQ(GenericMap("MHALVEX", own_), plain);
}

TEST_F(VhdlInheritedInit, IsTakenOutOfTheSimulationList) {
    EXPECT_EQ(GenericMap("MHALVEX", outer_ + simulated_), "generic map( INIT => INIT\n"
                                                          "      -- synopsys translate_off\n"
                                                          "      ,\n"
                                                          "               N => \"c\"\n"
                                                          "      -- synopsys translate_on\n"
                                                          "      )");
}

TEST_F(VhdlInheritedInit, DoesNotTouchTheVerilogSwitch) {
    EngineScript script("ADD COMPONENT C\nADD INSTANCE C U1\n" + outer_ + own_);
    script.GetNetlist().SetName("MHALVEX");
    EXPECT_NE(WriteToMemory(&script.GetNetlist(), &script.GetOptions()), "");
    EXPECT_FALSE(script.GetOptions().hierarchicalInit);
}
