// `Model::WriteCommands`: the commands from which a design and its options come.

#include "HdlCmd/Script/RoundTrip.h"
#include "Orn_Hdl/Orn_Hdl.h"
#include "Support/EngineScript.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>

using namespace Orn_Hdl;
using Support::Agreement;
using Support::CommandsOf;
using Support::FailureOf;
using Support::RoundTrip;

namespace {

constexpr const char* Name = "SET NETLIST NAME hdlNetlist\n";

/// Checks that the commands of a design are these, behind the name of the netlist.
void ExpectCommands(const std::string& lines, const std::string& expected) {
    EXPECT_EQ(RoundTrip::OfCommands(lines).Check(), Name + expected);
}

/// Checks that lines are the commands of the design that they make.
void ExpectSame(const std::string& lines) {
    ExpectCommands(lines, lines);
}

std::string FailureOfCommands(const RoundTrip::Build& build) {
    CommandFactory factory;
    Model model(&factory);
    build(model);
    TextMemOutStream out;
    const std::string failure = FailureOf([&] { model.WriteCommands(out); });
    EXPECT_EQ(out.GetValue(), "");
    return failure;
}

TEST(WriteCommands, AFreshModelHasItsNameAlone) {
    ExpectSame("");
}

TEST(WriteCommands, OptionsAreSaidThatHaveNotTheirDefault) {
    ExpectSame("SET SOURCE FILE \"a file.src\"\n"
               "Set Application tool\n"
               "Set Command \"run  it\"\n"
               "Set Device dev\n"
               "Set Purpose some\n"
               "Set Reference \"'none'\"\n"
               "SET SYNTHESIS SYNPLICITY\n"
               "UPPERCASE siganl\n"
               "LOWERCASE instance\n"
               "UPPERCASE component\n"
               "ADD INCLUDE a.v\n"
               "ADD INCLUDE a.v\n"
               "ADD LIBRARY LIB\n"
               "ADD USE LIBRARY LIB.ALL\n"
               "USE DEFAULT LIBRARY false\n"
               "FLATTEN BUS true\n"
               "SUPPRESS CONFIGURATION true\n"
               "SUPPRESS COMPONENT true\n"
               "Use AttrType\n"
               "Set Open Pin false\n");
    ExpectCommands("LOWERCASE signal\nSET PORT ONEPERLINE\nFLATTEN BUS true\nFLATTEN BUS false\n",
                   "LOWERCASE signal\n");
}

TEST(WriteCommands, ComponentsInstancesAndConnectionsAreSaidInTheirOrder) {
    ExpectSame("ADD COMPONENT C\n"
               "ADD PIN C O Output\n"
               "ADD PIN C I(3:0) Input 4:H:A\n"
               "ADD PIN C B(2) BiDirectional\n"
               "ADD PORT P Input\n"
               "ADD SIGNAL D(7:0)\n"
               "ADD INSTANCE C U1\n"
               "CONNECT SIGNAL P U1.O\n"
               "CONNECT SIGNAL D(3:0) U1.I(3:0)\n"
               "CONNECT SIGNAL D(2) U1.B(2)\n"
               "ADD INSTANCE C U0\n"
               "ASSIGN CONSTANT U0.I(3:0) 4:B:1010\n");
}

TEST(WriteCommands, AttributesAndCommentsOfEveryKindOfObjectAreSaid) {
    const auto about = [](const std::string& kind, const std::string& object) {
        return "ADD " + kind + " COMMENT " + object + "\"a  comment\"\n" + "ADD " + kind +
               " COMMENT " + object + "\"\" \"\"\n" + "ADD " + kind + " ATTRIBUTE " + object +
               "empty\n" + "ADD " + kind + " ATTRIBUTE " + object + "text \"a \\\"b\\\"\"\n" +
               "ADD " + kind + " ATTRIBUTE " + object + "-TYPE=Integer int -7\n" + "SET " + kind +
               " ATTRIBUTE OPTION " + object + "int -GENERIC=SYN\n" + "ADD " + kind +
               " ATTRIBUTE " + object + "-TYPE=Float float 012.50\n" + "SET " + kind +
               " ATTRIBUTE OPTION " + object + "float -SYNATTR=ASSIGN\n" + "ADD " + kind +
               " ATTRIBUTE " + object + "-TYPE=Boolean bool TRUE\n" + "SET " + kind +
               " ATTRIBUTE OPTION " + object + "bool -GENERIC=NOSYN -SYNATTR=ASSIGNNODEC\n" +
               "ADD " + kind + " ATTRIBUTE " + object + "-TYPE=Bit bit 1\n" + "ADD " + kind +
               " ATTRIBUTE " + object + "-TYPE=BitVector vector 8:O:17\n" + "ADD " + kind +
               " ATTRIBUTE " + object + "-TYPE=BitVector digits 1010\n" + "ADD " + kind +
               " ATTRIBUTE " + object + "-TYPE=User user red\n" + "SET " + kind +
               " ATTRIBUTE USERTYPE " + object + "user colour_t\n";
    };
    std::string module = about("MODULE", "");
    for (std::size_t at = 0; (at = module.find("ADD MODULE COMMENT")) != std::string::npos;) {
        module.replace(at, 18, "ADD NOTES");
    }
    ExpectSame(module + "ADD COMPONENT C\n" + about("COMPONENT", "C ") + "ADD PIN C I Input\n" +
               about("COMPONENT PIN", "C.I ") + "ADD SIGNAL N\n" + about("SIGNAL", "N ") +
               "ADD PORT D(7:0) Input\n" + about("SIGNAL", "D(7:0) ") +
               "ASSIGN CONSTANT D(3:0) \"\" \"\"\n" + about("SIGNAL", "D(3:0) ") +
               "ASSIGN CONSTANT D(1) 1\n" + about("SIGNAL", "D(1) ") +
               "ASSIGN CONSTANT N,D(1) \"\" \"\"\n" + about("SIGNAL", "N,D(1) ") +
               "ADD INSTANCE C U\n" + about("INSTANCE", "U ") + about("INSTANCE PIN", "U.I "));
}

TEST(WriteCommands, FloatsKeepTheirDigitsAndTheirWidth) {
    for (const char* text : {"5", ".5", "-0.0", "1e-5", "1.5e3", "-12.25", "0.1", "1e300", "0x1p4",
                             "00.10", "-007.0", "1.2.3", "", "3.", "1e5", "123456789.123456789"}) {
        RoundTrip::OfCommands(std::string("ADD MODULE ATTRIBUTE -TYPE=Float f \"") + text +
                              "\" \"\"\nSET MODULE ATTRIBUTE OPTION f -GENERIC=SYN\n")
            .Check();
    }
}

TEST(WriteCommands, AliasesKeepTheirOrderAndStandLast) {
    ExpectSame("ADD PORT A Output\n"
               "ADD SIGNAL B\n"
               "ADD SIGNAL D(7:0)\n"
               "ASSIGN CONSTANT D(3) \"\" \"\"\n"
               "ASSIGN CONSTANT D(1:0) \"\" \"\"\n"
               "ASSIGN CONSTANT B,D(3) \"\" \"\"\n"
               "CONNECT SIGNAL A D(3)\n"
               "CONNECT SIGNAL A B\n"
               "CONNECT SIGNAL D(1:0) B,D(3)\n"
               "CONNECT SIGNAL B,D(3) D(1:0)\n");
}

TEST(WriteCommands, AWidenedBusIsDeclaredInItsLastWidth) {
    ExpectCommands("ADD PORT D(3:0) Input\n"
                   "ADD SIGNAL COMMENT D(3:0) text\n"
                   "ASSIGN CONSTANT D(3:0) 4:H:A\n"
                   "ASSIGN CONSTANT D(1) 1\n"
                   "CONNECT SIGNAL D(7:0) X\n",
                   "ADD PORT D(7:0) Input\n"
                   "ADD SIGNAL COMMENT D(7:0) text\n"
                   "ASSIGN CONSTANT D(3:0) 4:H:A\n"
                   "ASSIGN CONSTANT D(1) 1\n"
                   "ADD SIGNAL X\n"
                   "CONNECT SIGNAL D(7:0) X\n");
}

TEST(WriteCommands, ABusThatReplacedOneOfItsWidthIsWidenedAgain) {
    ExpectSame("ADD PORT D(3:0) Output\n"
               "ASSIGN CONSTANT D(0:3) \"\" \"\"\n"
               "ASSIGN CONSTANT D(4:1) \"\" \"\"\n"
               "ADD SIGNAL COMMENT D(4:1) text\n"
               "ASSIGN CONSTANT D(0:3) 4:H:A\n"
               "ASSIGN CONSTANT D(2) \"\" \"\"\n");
}

TEST(WriteCommands, AComponentGetsPinsAfterItsInstances) {
    ExpectCommands("ADD COMPONENT C\n"
                   "ADD INSTANCE C U3\n"
                   "ADD PIN C I Input\n"
                   "ADD INSTANCE C U2\n"
                   "ADD PIN C O Output\n"
                   "ADD INSTANCE C U1\n"
                   "CONNECT SIGNAL N U1.O\n"
                   "CONNECT SIGNAL N U2.I\n"
                   "ADD INSTANCE COMMENT U3 text\n",
                   "ADD COMPONENT C\n"
                   "ADD INSTANCE C U3\n"
                   "ADD PIN C I Input\n"
                   "ADD INSTANCE C U2\n"
                   "ADD PIN C O Output\n"
                   "ADD SIGNAL N\n"
                   "ADD INSTANCE COMMENT U3 text\n"
                   "CONNECT SIGNAL N U2.I\n"
                   "ADD INSTANCE C U1\n"
                   "CONNECT SIGNAL N U1.O\n");
}

TEST(WriteCommands, AnInstanceMayHaveTheNameOfABit) {
    ExpectSame("ADD COMPONENT C\n"
               "ADD INSTANCE C D(1)\n"
               "ADD SIGNAL D(7:0)\n"
               "ASSIGN CONSTANT D(1) 1\n");
}

TEST(WriteCommands, OddNamesAreQuoted) {
    ExpectSame("ADD COMPONENT \"a b\"\n"
               "ADD PIN \"a b\" \"c d\" Input\n"
               "ADD SIGNAL \"\" \"\"\n"
               "ADD SIGNAL \"'x\"\n"
               "ADD SIGNAL \"\\\"x y\"\n"
               "ADD SIGNAL a\"b\\\n"
               "ADD SIGNAL COMMENT a\"b\\ \"a \\\n"
               "ADD SIGNAL \"tail\r\"\n"
               "ADD SIGNAL \"blank and backslash\\\n"
               "ADD SIGNAL K(2)\n"
               "ADD INSTANCE \"a b\" \"u 1\"\n"
               "CONNECT SIGNAL \"\" \"u 1.c d\"\n");
}

TEST(WriteCommands, ASignalNamedAsAPhraseGoesOnIsDeclaredByItsUse) {
    ExpectCommands("ASSIGN CONSTANT COMMENT 1\nCONNECT SIGNAL attribute COMMENT\n",
                   "ASSIGN CONSTANT COMMENT \"\" \"\"\n"
                   "ASSIGN CONSTANT COMMENT 1\n"
                   "ASSIGN CONSTANT attribute \"\" \"\"\n"
                   "CONNECT SIGNAL attribute COMMENT\n");
    ExpectSame("ADD PORT COMMENT Input\n");
}

TEST(WriteCommands, ConstantsOfPinsAreSaidByTheirPins) {
    const std::string component = "ADD COMPONENT C\nADD PIN C I Input\nADD PIN C B(1:0) Input\n"
                                  "ADD PIN C X(2) Input\n";
    ExpectSame(component + "ADD INSTANCE C U\nASSIGN CONSTANT U.I 1\nASSIGN CONSTANT U.B(1:0) 2\n"
                           "ASSIGN CONSTANT U.X(2) 0\n");
    // What else is said of the signal needs a declaration.
    ExpectSame(component + "ADD SIGNAL U_I_CONST_SIGNAL\n"
                           "ASSIGN CONSTANT U_I_CONST_SIGNAL 1\n"
                           "ADD SIGNAL COMMENT U_I_CONST_SIGNAL text\n"
                           "ADD PORT U_B_CONST_SIGNAL(1:0) Output\n"
                           "ASSIGN CONSTANT U_B_CONST_SIGNAL(1:0) 2\n"
                           "ADD INSTANCE C U\n"
                           "ASSIGN CONSTANT U.I 1\n"
                           "ASSIGN CONSTANT U.B(1:0) 2\n");
    // The signal keeps its name when the instance gets another.
    RoundTrip renamed([component](Model& model) {
        for (const std::string& line :
             Support::SplitLines(component + "ADD INSTANCE C U\nASSIGN CONSTANT U.I 1\n")) {
            model.ExecuteLine(line);
        }
        model.RenameInstance("U", "V");
    });
    EXPECT_EQ(renamed.Check(), Name + component +
                                   "ADD SIGNAL U_I_CONST_SIGNAL\n"
                                   "ASSIGN CONSTANT U_I_CONST_SIGNAL 1\n"
                                   "ADD INSTANCE C V\n"
                                   "CONNECT SIGNAL U_I_CONST_SIGNAL V.I\n");
}

/// A design with an output port that is read inside, in which a write makes dummy signals.
constexpr const char* WithFeedBack = "ADD COMPONENT C\n"
                                     "ADD PIN C I Input\n"
                                     "ADD PIN C O Output\n"
                                     "ADD PORT Y Output\n"
                                     "ADD PORT D(3:0) Output\n"
                                     "ADD INSTANCE C U1\n"
                                     "CONNECT SIGNAL Y U1.I\n"
                                     "CONNECT SIGNAL Y U1.O\n"
                                     "ADD INSTANCE C U2\n"
                                     "CONNECT SIGNAL D(2) U2.I\n"
                                     "CONNECT SIGNAL D(2) U2.O\n";

/// Runs lines, writes both netlists, runs further lines.
RoundTrip AfterAWrite(const std::string& before, const std::string& after) {
    return RoundTrip([before, after](Model& model) {
        for (const std::string& line : Support::SplitLines(before)) {
            model.ExecuteLine(line);
        }
        Support::WriteVerilog(model);
        Support::WriteVhdl(model);
        for (const std::string& line : Support::SplitLines(after)) {
            model.ExecuteLine(line);
        }
    });
}

TEST(WriteCommands, DummySignalsOfAWriteAreSaidAsSignals) {
    ExpectCommands(WithFeedBack, WithFeedBack + std::string());
    EXPECT_EQ(AfterAWrite(WithFeedBack, "").Check(),
              Name + std::string("ADD COMPONENT C\n"
                                 "ADD PIN C I Input\n"
                                 "ADD PIN C O Output\n"
                                 "ADD SIGNAL D_DUMMY(3:0)\n"
                                 "ADD SIGNAL Y_DUMMY\n"
                                 "ADD PORT D(3:0) Output\n"
                                 "ASSIGN CONSTANT D(2) \"\" \"\"\n"
                                 "ADD PORT Y Output\n"
                                 "ADD INSTANCE C U1\n"
                                 "CONNECT SIGNAL Y_DUMMY U1.I\n"
                                 "CONNECT SIGNAL Y_DUMMY U1.O\n"
                                 "ADD INSTANCE C U2\n"
                                 "CONNECT SIGNAL D_DUMMY(2) U2.I\n"
                                 "CONNECT SIGNAL D_DUMMY(2) U2.O\n"
                                 "CONNECT SIGNAL D(3:0) D_DUMMY(3:0)\n"
                                 "CONNECT SIGNAL Y Y_DUMMY\n"));
}

// The next write of the model adds the dummies of further bits behind the sorted signals.
TEST(WriteCommands, WhatDummySignalsWillTakeOverIsSaidOfThem) {
    const std::string commands = AfterAWrite(WithFeedBack, "ADD INSTANCE C U3\n"
                                                           "CONNECT SIGNAL Y U3.I\n"
                                                           "CONNECT SIGNAL D(1) U3.O\n"
                                                           "CONNECT SIGNAL D(0) Y\n"
                                                           "ASSIGN CONSTANT Y 1\n"
                                                           "ASSIGN CONSTANT D(3) 0\n")
                                     .Check(Agreement::LinesInAnyOrder);
    for (const char* line : {"CONNECT SIGNAL Y_DUMMY U3.I\n", "CONNECT SIGNAL D_DUMMY(1) U3.O\n",
                             "CONNECT SIGNAL D_DUMMY(0) Y\n", "ASSIGN CONSTANT Y_DUMMY 1\n",
                             "ASSIGN CONSTANT D_DUMMY(3) 0\n"}) {
        EXPECT_NE(commands.find(line), std::string::npos) << line << commands;
    }
}

TEST(WriteCommands, ACompoundOfDummySignalsIsNamedAfterThem) {
    const std::string commands =
        AfterAWrite(std::string(WithFeedBack) + "ADD INSTANCE C U3\nCONNECT SIGNAL Y,D(2) U3.I\n",
                    "CONNECT SIGNAL Y,D(3:2) U3.O\n")
            .Check();
    EXPECT_NE(commands.find("CONNECT SIGNAL Y_DUMMY,D_DUMMY(2) U3.I\n"), std::string::npos)
        << commands;
    EXPECT_NE(commands.find("CONNECT SIGNAL Y_DUMMY,D_DUMMY(3:2) U3.O\n"), std::string::npos)
        << commands;
    EXPECT_EQ(commands.find("Y,D(2)"), std::string::npos) << commands;
}

TEST(WriteCommands, AWriteChangesLetterCaseOpenPinsAndPrimitives) {
    AfterAWrite(std::string("UPPERCASE siganl\nLOWERCASE instance\nSet Open Pin false\n"
                            "ADD COMPONENT P\nADD COMPONENT ATTRIBUTE P Level HALVEX\n"
                            "ADD PIN P b(1:0) Input\nADD INSTANCE P Up\n") +
                    WithFeedBack,
                "")
        .Check();
}

TEST(WriteCommands, RenamedObjectsAreSaidByTheirNewNames) {
    const auto rename = [](Model& model) {
        for (const std::string& line : Support::SplitLines(
                 std::string(WithFeedBack) + "CONNECT SIGNAL D(1),Y U1.I\nADD SIGNAL N\n"
                                             "ADD SIGNAL B(1:0)\nCONNECT SIGNAL N B(1)\n")) {
            model.ExecuteLine(line);
        }
        model.RenameComponent("C", "CELL");
        model.RenameInstance("U1", "first");
        model.RenameSignal("D(3:0)", "BUS(3:0)");
        model.GetSignal("N")->SetName("M");
        model.GetInstance("U2")->SetName("second");
        model.GetComponent("CELL")->SetName("Cell_2");
    };
    const std::string commands = RoundTrip(rename).Check();
    for (const char* line : {"ADD COMPONENT Cell_2\n", "ADD INSTANCE Cell_2 second\n",
                             "CONNECT SIGNAL BUS(1),Y first.I\n", "CONNECT SIGNAL M B(1)\n"}) {
        EXPECT_NE(commands.find(line), std::string::npos) << line << commands;
    }
}

TEST(WriteCommands, AnInstanceMayHaveTheNameThatACompoundWasGiven) {
    const auto rename = [](Model& model) {
        for (const char* line : {"ADD COMPONENT C", "ADD COMPONENT E", "ADD INSTANCE C B(7:0)",
                                 "ADD SIGNAL N", "ADD SIGNAL M"}) {
            model.ExecuteLine(line);
        }
        auto compound = std::make_unique<CompoundBus>("B(7:0)");
        compound->AddBusMember(model.GetSignal("N"));
        compound->AddBusMember(model.GetSignal("M"));
        model.GetNetlist()->Add(compound.release());
    };
    const std::string commands = RoundTrip(rename).Check();
    EXPECT_LT(commands.find("ADD COMPONENT E\n"), commands.find("ADD INSTANCE C B(7:0)\n"))
        << commands;
}

TEST(WriteCommands, WhatOnlyCallsCanMakeIsRefused) {
    EXPECT_EQ(
        FailureOfCommands([](Model& model) { model.AddSignal("a\nb"); }),
        "No command can express the line \"ADD SIGNAL\": the text behind it contains a line feed "
        "or a NUL.\n");
    EXPECT_EQ(FailureOfCommands([](Model& model) { model.SetName(""); }),
              "No command can express the netlist \"\": it has no name.\n");
    EXPECT_EQ(FailureOfCommands([](Model& model) { model.GetOptions()->onePortPerLine = false; }),
              "No command can express option \"onePortPerLine\": it cannot be cleared.\n");
    EXPECT_EQ(FailureOfCommands([](Model& model) {
                  model.AddComponent("C");
                  model.AddInstance("U", "C");
                  model.GetNetlist()->Remove(model.GetComponent("C"));
              }),
              "No command can express instance \"U\": it has no component.\n");
    EXPECT_EQ(FailureOfCommands([](Model& model) {
                  model.AddSignal("D(3:0)");
                  model.ConnectSignals("D(1)", "N");
                  model.GetNetlist()->Remove(model.GetSignal("D(3:0)"));
              }),
              "No command can express signal \"D(1)\": its bus is not in the netlist.\n");
    EXPECT_EQ(FailureOfCommands([](Model& model) {
                  model.AddSignal("N");
                  model.GetNetlist()->Add(new ScalarSignal("n"));
              }),
              "No command can express signal \"N\": another object has that name.\n");
    EXPECT_EQ(FailureOfCommands([](Model& model) { model.AddComponent("COMMENT"); }),
              "No command can express the line \"ADD COMPONENT COMMENT\": its words begin another "
              "command.\n");
    EXPECT_EQ(
        FailureOfCommands([](Model& model) {
            model.AddSignal("a.b");
            model.AssignConstantToSignal("a.b", "1");
        }),
        "No command can express signal \"a.b\": its name has a point, so that a command takes it "
        "for a pin's.\n");
}

TEST(WriteCommands, AFileIsReplacedAsAWhole) {
    Support::TemporaryFolder folder;
    CommandFactory factory;
    Model model(&factory);
    model.AddSignal("N");
    const std::string file = folder / "out.cmd";
    EXPECT_TRUE(model.WriteCommands(file));
    EXPECT_EQ(Support::ReadWholeFile(file), CommandsOf(model));
    model.SetName("");
    EXPECT_NE(FailureOf([&] { model.WriteCommands(file); }), "");
    EXPECT_EQ(Support::ReadWholeFile(file), Name + std::string("ADD SIGNAL N\n"));
    model.SetName("top");
    EXPECT_FALSE(model.WriteCommands(folder / "missing/out.cmd"));
}

} // namespace
