// Every message that a command line can fail with, through the engine.

#include "Orn_Hdl/Orn_Hdl.h"
#include "Support/EngineScript.h"

#include <gtest/gtest.h>

#include <ostream>
#include <string>
#include <typeinfo>
#include <vector>

using namespace Orn_Hdl;
using Support::EngineScript;

namespace {

/// The design that every line is tried on.
constexpr const char* Design = "ADD COMPONENT AND2\n"
                               "ADD PIN AND2 I0 Input\n"
                               "ADD PIN AND2 D(3:0) Input\n"
                               "ADD PIN AND2 O Output\n"
                               "ADD INSTANCE AND2 U1\n"
                               "ADD PORT A Input\n"
                               "ADD SIGNAL N\n"
                               "ADD SIGNAL B(7:0)\n"
                               "ADD MODULE ATTRIBUTE MA mv\n"
                               "ADD COMPONENT ATTRIBUTE AND2 CA cv\n"
                               "ADD INSTANCE ATTRIBUTE U1 IA iv\n"
                               "ADD SIGNAL ATTRIBUTE N SA sv\n"
                               "ADD COMPONENT PIN ATTRIBUTE AND2.I0 PA pv\n"
                               "ADD INSTANCE PIN ATTRIBUTE U1.I0 PA pv\n";

struct FailingLine {
    const char* line;
    const char* message;
    /// The part of the library that speaks.
    const char* unit = "../s/HdlModel";
};

void PrintTo(const FailingLine& failing, std::ostream* out) {
    *out << failing.line;
}

class ModelFailures : public testing::TestWithParam<FailingLine> {};
class CommandFailures : public testing::TestWithParam<FailingLine> {};

void ExpectFailure(const FailingLine& failing) {
    EngineScript script(Design);
    const int done = script.GetDoneCount();
    script.GetModel().SetModifiedFlag(false);
    try {
        script.GetEngine().Execute(failing.line);
        FAIL() << "carried out: " << failing.line;
    } catch (const std::exception& thrown) {
        ASSERT_EQ(typeid(thrown), typeid(Exception));
        const Exception& exception = dynamic_cast<const Exception&>(thrown);
        EXPECT_EQ(exception.getLocalized(), failing.message);
        EXPECT_STREQ(exception.what(), failing.message);
        EXPECT_EQ(exception.GetModule(), "DesignEntry");
        EXPECT_EQ(exception.GetSourceUnit(), failing.unit);
        EXPECT_EQ(exception.GetRevision(), exception.GetSourceUnit() == "../s/HdlModel"
                                               ? "$Revision: 1.8 $"
                                               : "$Revision: 1.19 $");
        EXPECT_GT(exception.GetLine(), 0);
    }
    EXPECT_EQ(script.GetDoneCount(), done);
    EXPECT_FALSE(script.GetModel().IsModified());
}

} // namespace

TEST_P(ModelFailures, CarryTheirMessage) {
    ExpectFailure(GetParam());
}

TEST_P(CommandFailures, CarryTheirMessage) {
    ExpectFailure(GetParam());
}

// Names that are taken

INSTANTIATE_TEST_SUITE_P(
    TakenNames, ModelFailures,
    testing::Values(
        FailingLine{"ADD COMPONENT AND2", "Identifier \"AND2\" already defined.\n"},
        FailingLine{"ADD COMPONENT and2", "Identifier \"and2\" already defined.\n"},
        FailingLine{"ADD COMPONENT U1", "Identifier \"U1\" already defined.\n"},
        FailingLine{"ADD COMPONENT N", "Identifier \"N\" already defined.\n"},
        FailingLine{"ADD COMPONENT b[7:0]", "Identifier \"b[7:0]\" already defined.\n"},
        FailingLine{"ADD INSTANCE AND2 AND2", "Identifier \"AND2\" already defined.\n"},
        FailingLine{"ADD INSTANCE AND2 u1", "Identifier \"u1\" already defined.\n"},
        FailingLine{"ADD INSTANCE AND2 a", "Identifier \"a\" already defined.\n"},
        FailingLine{"ADD INSTANCE NONE U1", "Identifier \"U1\" already defined.\n"},
        FailingLine{"ADD SIGNAL AND2", "Identifier \"AND2\" already defined.\n"},
        FailingLine{"ADD SIGNAL u1", "Identifier \"u1\" already defined.\n"},
        FailingLine{"ADD SIGNAL n", "Identifier \"n\" already defined.\n"},
        FailingLine{"ADD SIGNAL B<7-0>", "Identifier \"B<7-0>\" already defined.\n"},
        FailingLine{"ADD SIGNAL B(3:0)", "Signal \"B(3:0)\" already declared.\n"},
        FailingLine{"ADD SIGNAL b{15-0}", "Signal \"b{15-0}\" already declared.\n"},
        FailingLine{"ADD PORT N Input", "Identifier \"N\" already defined.\n"},
        FailingLine{"ADD PORT AND2 Output", "Identifier \"AND2\" already defined.\n"},
        FailingLine{"ADD PORT B(0:7) Output", "Signal \"B(0:7)\" already declared.\n"},
        FailingLine{"ADD PIN AND2 i0 Input", "Component \"AND2\" already has pin \"i0\".\n"},
        FailingLine{"ADD PIN and2 d[3-0] Output",
                    "Component \"and2\" already has pin \"d[3-0]\".\n"},
        FailingLine{"CONNECT SIGNAL AND2 U1.I0", "Identifier \"AND2\" already defined.\n"},
        FailingLine{"CONNECT SIGNAL AND2,X U1.I0", "Identifier \"AND2\" already defined.\n"},
        FailingLine{"CONNECT SIGNAL N u1", "Identifier \"u1\" already defined.\n"},
        FailingLine{"CONNECT SIGNAL B<3:0> N", "Signal \"B<3:0>\" already declared.\n"},
        FailingLine{"ASSIGN CONSTANT U1 1", "Identifier \"U1\" already defined.\n"}));

// Components, instances, signals and pins that are missing

INSTANTIATE_TEST_SUITE_P(
    MissingObjects, ModelFailures,
    testing::Values(
        FailingLine{"ADD PIN OR2 I Input", "Component \"OR2\" not found.\n"},
        FailingLine{"ADD PIN \"\" I Input", "Component \"\" not found.\n"},
        FailingLine{"ADD PIN U1 I Input", "Component \"U1\" not found.\n"},
        FailingLine{"ADD INSTANCE OR2 U2", "Component \"OR2\" not found.\n"},
        FailingLine{"ADD INSTANCE N U2", "Component \"N\" not found.\n"},
        FailingLine{"CONNECT SIGNAL C(3) U1.I0", "Signal \"C(3)\" not found.\n"},
        FailingLine{"CONNECT SIGNAL N(0) U1.I0", "Signal \"N(0)\" not found.\n"},
        FailingLine{"CONNECT SIGNAL N U9.I0", "Signal \"U9\" not found.\n"},
        FailingLine{"CONNECT SIGNAL N AND2.I0", "Signal \"AND2\" not found.\n"},
        FailingLine{"CONNECT SIGNAL N .I0", "Signal \"\" not found.\n"},
        FailingLine{"CONNECT SIGNAL C(3) U9.I0", "Signal \"C(3)\" not found.\n"},
        FailingLine{"CONNECT SIGNAL N U1.X", "Pin \"U1.X\" not found.\n"},
        FailingLine{"CONNECT SIGNAL N u1.D(2)", "Pin \"u1.D(2)\" not found.\n"},
        FailingLine{"CONNECT SIGNAL N U1.", "Pin \"U1.\" not found.\n"},
        FailingLine{"CONNECT SIGNAL N U1.I0.I1", "Pin \"U1.I0.I1\" not found.\n"},
        FailingLine{"CONNECT SIGNAL C(3) N", "Signal \"C(3)\" not found.\n"},
        FailingLine{"CONNECT SIGNAL N C(3)", "Signal \"C(3)\" not found.\n"},
        FailingLine{"CONNECT SIGNAL C(1) C(2)", "Signal \"C(1)\" not found.\n"},
        FailingLine{"ASSIGN CONSTANT C(3) 1", "Signal \"C(3)\" not found.\n"},
        FailingLine{"ASSIGN CONSTANT U9.I0 1", "Signal \"U9\" not found.\n"},
        FailingLine{"ASSIGN CONSTANT U1.X 1", "Pin \"X\" not found.\n"},
        FailingLine{"ASSIGN CONSTANT U1.D(3) 1", "Pin \"D(3)\" not found.\n"},
        FailingLine{"ADD COMPONENT COMMENT OR2 text", "\"OR2\" not found.\n"},
        FailingLine{"ADD COMPONENT COMMENT U1 text", "\"U1\" not found.\n"},
        FailingLine{"ADD INSTANCE COMMENT U9 text", "\"U9\" not found.\n"},
        FailingLine{"ADD SIGNAL COMMENT M text", "\"M\" not found.\n"},
        FailingLine{"ADD SIGNAL COMMENT B(3:0) text", "\"B(3:0)\" not found.\n"},
        FailingLine{"ADD COMPONENT PIN COMMENT OR2.I0 text", "Pin \"I0\" not found.\n"},
        FailingLine{"ADD COMPONENT PIN COMMENT AND2.X text", "Pin \"X\" not found.\n"},
        FailingLine{"ADD INSTANCE PIN COMMENT U9.I0 text", "Pin \"I0\" not found.\n"},
        FailingLine{"ADD INSTANCE PIN COMMENT U1.X.Y text", "Pin \"X.Y\" not found.\n"},
        FailingLine{"ADD COMPONENT ATTRIBUTE OR2 LOC P1", "\"OR2\" not found.\n"},
        FailingLine{"ADD INSTANCE ATTRIBUTE AND2 LOC P1", "\"AND2\" not found.\n"},
        FailingLine{"ADD SIGNAL ATTRIBUTE M LOC P1", "\"M\" not found.\n"},
        FailingLine{"ADD COMPONENT PIN ATTRIBUTE OR2.I0 LOC P1", "Pin \"I0\" not found.\n"},
        FailingLine{"ADD COMPONENT PIN ATTRIBUTE AND2.X LOC P1", "Pin \"X\" not found.\n"},
        FailingLine{"ADD INSTANCE PIN ATTRIBUTE U9.I0 LOC P1", "Pin \"I0\" not found.\n"},
        FailingLine{"ADD INSTANCE PIN ATTRIBUTE U1.X LOC P1", "Pin \"X\" not found.\n"}));

INSTANTIATE_TEST_SUITE_P(
    MissingOwnersOfAttributes, ModelFailures,
    testing::Values(
        FailingLine{"SET COMPONENT ATTRIBUTE VALUE OR2 CA v", "\"OR2\" not found.\n"},
        FailingLine{"SET INSTANCE ATTRIBUTE VALUE U9 IA v", "\"U9\" not found.\n"},
        FailingLine{"SET SIGNAL ATTRIBUTE VALUE M SA v", "\"M\" not found.\n"},
        FailingLine{"SET COMPONENT PIN ATTRIBUTE VALUE OR2.I0 PA v", "Pin \"I0\" not found.\n"},
        FailingLine{"SET COMPONENT PIN ATTRIBUTE VALUE AND2.X PA v", "Pin \"X\" not found.\n"},
        FailingLine{"SET INSTANCE PIN ATTRIBUTE VALUE U9.I0 PA v", "Pin \"I0\" not found.\n"},
        FailingLine{"SET INSTANCE PIN ATTRIBUTE VALUE U1.X PA v", "Pin \"X\" not found.\n"},
        FailingLine{"SET COMPONENT ATTRIBUTE USERTYPE OR2 CA t", "\"OR2\" not found.\n"},
        FailingLine{"SET INSTANCE ATTRIBUTE USERTYPE U9 IA t", "\"U9\" not found.\n"},
        FailingLine{"SET SIGNAL ATTRIBUTE USERTYPE M SA t", "\"M\" not found.\n"},
        FailingLine{"SET COMPONENT PIN ATTRIBUTE USERTYPE OR2.I0 PA t", "Pin \"I0\" not found.\n"},
        FailingLine{"SET INSTANCE PIN ATTRIBUTE USERTYPE U1.X PA t", "Pin \"X\" not found.\n"},
        FailingLine{"SET COMPONENT ATTRIBUTE OPTION OR2 CA -GENERIC=SYN", "\"OR2\" not found.\n"},
        FailingLine{"SET COMPONENT ATTRIBUTE OPTION OR2 CA -SYNATTR=ASSIGN",
                    "\"OR2\" not found.\n"},
        FailingLine{"SET INSTANCE ATTRIBUTE OPTION U9 IA -GENERIC=SYN", "\"U9\" not found.\n"},
        FailingLine{"SET INSTANCE ATTRIBUTE OPTION U9 IA -SYNATTR=ASSIGN", "\"U9\" not found.\n"},
        FailingLine{"SET SIGNAL ATTRIBUTE OPTION M SA -GENERIC=SYN", "\"M\" not found.\n"},
        FailingLine{"SET SIGNAL ATTRIBUTE OPTION M SA -SYNATTR=ASSIGN", "\"M\" not found.\n"},
        FailingLine{"SET COMPONENT PIN ATTRIBUTE OPTION OR2.I0 PA -GENERIC=SYN",
                    "Pin \"I0\" not found.\n"},
        FailingLine{"SET COMPONENT PIN ATTRIBUTE OPTION OR2.I0 PA -SYNATTR=ASSIGN",
                    "Pin \"I0\" not found.\n"},
        FailingLine{"SET INSTANCE PIN ATTRIBUTE OPTION U1.X PA -GENERIC=SYN",
                    "Pin \"X\" not found.\n"},
        FailingLine{"SET INSTANCE PIN ATTRIBUTE OPTION U1.X PA -SYNATTR=ASSIGN",
                    "Pin \"X\" not found.\n"}));

// Attributes that are missing or refuse what they are given

INSTANTIATE_TEST_SUITE_P(
    MissingAttributes, ModelFailures,
    testing::Values(
        FailingLine{"SET MODULE ATTRIBUTE VALUE X v", "Attribute \"X\" not found.\n"},
        FailingLine{"SET COMPONENT ATTRIBUTE VALUE AND2 X v", "Attribute \"X\" not found.\n"},
        FailingLine{"SET INSTANCE ATTRIBUTE VALUE U1 X v", "Attribute \"X\" not found.\n"},
        FailingLine{"SET SIGNAL ATTRIBUTE VALUE N X v", "Attribute \"X\" not found.\n"},
        FailingLine{"SET COMPONENT PIN ATTRIBUTE VALUE AND2.I0 X v",
                    "Attribute \"X\" not found.\n"},
        FailingLine{"SET INSTANCE PIN ATTRIBUTE VALUE U1.D(3:0) PA v",
                    "Attribute \"PA\" not found.\n"},
        FailingLine{"SET COMPONENT ATTRIBUTE VALUE AND2 IA v", "Attribute \"IA\" not found.\n"},
        FailingLine{"SET MODULE ATTRIBUTE USERTYPE X t", "Attribute \"X\" not found.\n"},
        FailingLine{"SET COMPONENT ATTRIBUTE USERTYPE AND2 X t", "Attribute \"X\" not found.\n"},
        FailingLine{"SET INSTANCE ATTRIBUTE USERTYPE U1 X t", "Attribute \"X\" not found.\n"},
        FailingLine{"SET SIGNAL ATTRIBUTE USERTYPE N X t", "Attribute \"X\" not found.\n"},
        FailingLine{"SET COMPONENT PIN ATTRIBUTE USERTYPE AND2.I0 X t",
                    "Attribute \"X\" not found.\n"},
        FailingLine{"SET INSTANCE PIN ATTRIBUTE USERTYPE U1.I0 X t",
                    "Attribute \"X\" not found.\n"},
        FailingLine{"SET MODULE ATTRIBUTE OPTION X -GENERIC=SYN", "Attribute \"X\" not found.\n"},
        FailingLine{"SET MODULE ATTRIBUTE OPTION X -SYNATTR=NONE", "Attribute \"X\" not found.\n"},
        FailingLine{"SET COMPONENT ATTRIBUTE OPTION AND2 X -GENERIC=SYN",
                    "Attribute \"X\" not found.\n"},
        FailingLine{"SET INSTANCE ATTRIBUTE OPTION U1 X -GENERIC=SYN",
                    "Attribute \"X\" not found.\n"},
        FailingLine{"SET SIGNAL ATTRIBUTE OPTION N X -SYNATTR=NONE",
                    "Attribute \"X\" not found.\n"},
        FailingLine{"SET COMPONENT PIN ATTRIBUTE OPTION AND2.I0 X -GENERIC=SYN",
                    "Attribute \"X\" not found.\n"},
        FailingLine{"SET INSTANCE PIN ATTRIBUTE OPTION U1.I0 X -SYNATTR=NONE",
                    "Attribute \"X\" not found.\n"}));

INSTANTIATE_TEST_SUITE_P(
    AttributeTypes, ModelFailures,
    testing::Values(
        FailingLine{"ADD MODULE ATTRIBUTE -TYPE=Text X v", "Invalid attribute type.\n"},
        FailingLine{"ADD MODULE ATTRIBUTE -TYPE= X v", "Invalid attribute type.\n"},
        FailingLine{"ADD COMPONENT ATTRIBUTE AND2 -TYPE=Strings X", "Invalid attribute type.\n"},
        FailingLine{"ADD INSTANCE ATTRIBUTE U1 -type=int X 1", "Invalid attribute type.\n"},
        FailingLine{"ADD SIGNAL ATTRIBUTE N -TYPE=-TYPE=Bit X", "Invalid attribute type.\n"},
        FailingLine{"ADD COMPONENT PIN ATTRIBUTE AND2.I0 -TYPE=x X", "Invalid attribute type.\n"},
        FailingLine{"ADD INSTANCE PIN ATTRIBUTE U1.I0 -TYPE=x X", "Invalid attribute type.\n"},
        FailingLine{"SET MODULE ATTRIBUTE USERTYPE MA t", "Invalid attribute type.\n"},
        FailingLine{"SET COMPONENT ATTRIBUTE USERTYPE AND2 CA t", "Invalid attribute type.\n"},
        FailingLine{"SET INSTANCE ATTRIBUTE USERTYPE U1 IA t", "Invalid attribute type.\n"},
        FailingLine{"SET INSTANCE ATTRIBUTE USERTYPE U1 CA t", "Invalid attribute type.\n"},
        FailingLine{"SET SIGNAL ATTRIBUTE USERTYPE N SA t", "Invalid attribute type.\n"},
        FailingLine{"SET COMPONENT PIN ATTRIBUTE USERTYPE AND2.I0 PA t",
                    "Invalid attribute type.\n"},
        FailingLine{"SET INSTANCE PIN ATTRIBUTE USERTYPE U1.I0 PA t",
                    "Invalid attribute type.\n"}));

INSTANTIATE_TEST_SUITE_P(
    AttributeOptions, ModelFailures,
    testing::Values(
        FailingLine{"SET MODULE ATTRIBUTE OPTION MA -GENERIC=YES", "Invalid generic value.\n"},
        FailingLine{"SET MODULE ATTRIBUTE OPTION MA -SYNATTR=YES", "Invalid generic value.\n"},
        FailingLine{"SET MODULE ATTRIBUTE OPTION MA -GENERIC=", "Invalid generic value.\n"},
        FailingLine{"SET MODULE ATTRIBUTE OPTION MA -GENERIC=ASSIGN", "Invalid generic value.\n"},
        FailingLine{"SET MODULE ATTRIBUTE OPTION MA -SYNATTR=ASSIGN_NODEC",
                    "Invalid generic value.\n"},
        FailingLine{"SET COMPONENT ATTRIBUTE OPTION AND2 CA -GENERIC=x",
                    "Invalid generic value.\n"},
        FailingLine{"SET INSTANCE ATTRIBUTE OPTION U1 IA -SYNATTR=x", "Invalid generic value.\n"},
        FailingLine{"SET INSTANCE ATTRIBUTE OPTION U1 CA -GENERIC=x", "Invalid generic value.\n"},
        FailingLine{"SET SIGNAL ATTRIBUTE OPTION N SA -GENERIC=x", "Invalid generic value.\n"},
        FailingLine{"SET COMPONENT PIN ATTRIBUTE OPTION AND2.I0 PA -SYNATTR=x",
                    "Invalid generic value.\n"},
        FailingLine{"SET INSTANCE PIN ATTRIBUTE OPTION U1.I0 PA -GENERIC=x",
                    "Invalid generic value.\n"}));

// Lines that are no command

INSTANTIATE_TEST_SUITE_P(
    UnknownPhrases, CommandFailures,
    testing::Values(FailingLine{"ADD", "Command not find.\n", "../s/HdlCmd"},
                    FailingLine{"MAKE COFFEE", "Command not find.\n", "../s/HdlCmd"},
                    FailingLine{"SET COMPONENT", "Command not find.\n", "../s/HdlCmd"},
                    FailingLine{"# comment", "Command not find.\n", "../s/HdlCmd"},
                    FailingLine{"// comment", "Command not find.\n", "../s/HdlCmd"},
                    FailingLine{"ADD\tCOMPONENT X", "Command not find.\n", "../s/HdlCmd"},
                    FailingLine{"\tNOOP", "Command not find.\n", "../s/HdlCmd"},
                    FailingLine{"NOOP\r", "Command not find.\n", "../s/HdlCmd"},
                    FailingLine{"ADDCOMPONENT X", "Command not find.\n", "../s/HdlCmd"},
                    FailingLine{"ADD \"\" COMPONENT X", "Command not find.\n", "../s/HdlCmd"},
                    FailingLine{"\"\" NOOP", "Command not find.\n", "../s/HdlCmd"},
                    FailingLine{"%s%n%d", "Command not find.\n", "../s/HdlCmd"}));

// A user's text is shown unchanged, never used as a format

INSTANTIATE_TEST_SUITE_P(
    UserTexts, ModelFailures,
    testing::Values(
        FailingLine{"ADD INSTANCE %s%n U2", "Component \"%s%n\" not found.\n"},
        FailingLine{"CONNECT SIGNAL N %d.%s", "Signal \"%d\" not found.\n"},
        FailingLine{"ADD INSTANCE \"two words\" U2", "Component \"two words\" not found.\n"},
        FailingLine{"ADD INSTANCE \"a\\\"b\" U2", "Component \"a\"b\" not found.\n"},
        FailingLine{"ADD INSTANCE \xff\x80 U2", "Component \"\xff\x80\" not found.\n"}));

// Failures that no command line reaches: the commands never hand over a null name

TEST(ModelNullNames, AreInvalid) {
    CommandFactory factory;
    Model model(&factory);
    const Polarity input(Polarity::Input);
    model.AddComponent("AND2");
    const auto expectInvalid = [](auto&& action) {
        EXPECT_EQ(Support::FailureOf(action), "Invalid Name.\n");
    };
    expectInvalid([&] { model.AddComponent(nullptr); });
    expectInvalid([&] { model.AddPin(nullptr, input, "AND2", ""); });
    expectInvalid([&] { model.AddPin(nullptr, input, nullptr, nullptr); });
    expectInvalid([&] { model.AddInstance(nullptr, "AND2"); });
    expectInvalid([&] { model.AddInstance(nullptr, nullptr); });
    expectInvalid([&] { model.AddSignal(nullptr); });
    expectInvalid([&] { model.AddModuleAttr(nullptr, "v", "String"); });
    expectInvalid([&] { model.AddComponentAttr("AND2", nullptr, "v", "String"); });
    expectInvalid([&] { model.AddInstanceAttr("none", nullptr, "v", "String"); });
    expectInvalid([&] { model.AddSignalAttr("none", nullptr, "v", "String"); });
    expectInvalid([&] { model.AddComponentPinAttr("none", "I", nullptr, "v", "String"); });
    expectInvalid([&] { model.AddInstancePinAttr("none", "I", nullptr, "v", "String"); });
}

TEST(ModelNullNames, AreEmptyInLookUps) {
    CommandFactory factory;
    Model model(&factory);
    EXPECT_EQ(Support::FailureOf([&] { model.AddInstance("U1", nullptr); }),
              "Component \"\" not found.\n");
    EXPECT_EQ(Support::FailureOf([&] { model.AssignConstantToPin(nullptr, nullptr, nullptr); }),
              "Signal \"\" not found.\n");
    EXPECT_EQ(Support::FailureOf([&] { model.AddComponentComment(nullptr, "text"); }),
              "\"\" not found.\n");
    EXPECT_EQ(Support::FailureOf([&] { model.SetModuleAttrValue(nullptr, nullptr); }),
              "Attribute \"\" not found.\n");
}

TEST(ModelNullNames, EmptyNamesAreNames) {
    EngineScript script;
    EXPECT_EQ(script.GetFailure("ADD INSTANCE \"\" \"\" x"), "Component \"\" not found.\n");
    EXPECT_EQ(script.GetFailure("ADD SIGNAL \"\" Input"), "");
    EXPECT_NE(script.GetModel().GetSignal(""), nullptr);
    EXPECT_EQ(script.GetFailure("ADD SIGNAL \"\" Input"), "Identifier \"\" already defined.\n");
}

// What was done before a failure stays done

TEST(Failures, KeepWhatWasDoneBefore) {
    EngineScript script(Design);
    EXPECT_EQ(script.GetFailure("CONNECT SIGNAL Fresh U9.I0"), "Signal \"U9\" not found.\n");
    EXPECT_NE(script.GetModel().GetSignal("Fresh"), nullptr);
    EXPECT_EQ(script.GetFailure("CONNECT SIGNAL P,Q,C(3) U1.X"), "Pin \"U1.X\" not found.\n");
    EXPECT_NE(script.GetModel().GetSignal("P,Q,C(3)"), nullptr);
    EXPECT_NE(script.GetModel().GetSignal("C(3)"), nullptr);
}
