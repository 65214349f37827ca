// What the attribute commands do to the attributes of a design.

#include "Orn_Hdl/Orn_Hdl.h"
#include "Support/EngineScript.h"

#include <gtest/gtest.h>

#include <ostream>
#include <string>

using namespace Orn_Hdl;
using Support::EngineScript;

namespace {

constexpr const char* Design = "ADD COMPONENT AND2\n"
                               "ADD PIN AND2 I0 Input\n"
                               "ADD PIN AND2 D(3:0) Input\n"
                               "ADD INSTANCE AND2 U1\n"
                               "ADD SIGNAL N\n";

/// One kind of object that attributes can be given to: how commands name it, and how it is found.
struct Target {
    const char* kind;
    const char* name;
    AttributeHolder* (*find)(Model& model);
};

void PrintTo(const Target& target, std::ostream* out) {
    *out << target.kind;
}

const Target Targets[] = {
    {"MODULE", "", [](Model& m) -> AttributeHolder* { return m.GetNetlist(); }},
    {"COMPONENT", "and2", [](Model& m) -> AttributeHolder* { return m.GetComponent("AND2"); }},
    {"INSTANCE", "u1", [](Model& m) -> AttributeHolder* { return m.GetInstance("U1"); }},
    {"SIGNAL", "n", [](Model& m) -> AttributeHolder* { return m.GetSignal("N"); }},
    {"COMPONENT PIN", "and2.d[3-0]",
     [](Model& m) -> AttributeHolder* { return m.GetComponent("AND2")->GetPin("D(3:0)"); }},
    {"INSTANCE PIN", "u1.i0",
     [](Model& m) -> AttributeHolder* { return m.GetInstance("U1")->GetPin("I0"); }},
};

class AttributeCommands : public testing::TestWithParam<Target> {
protected:
    std::string Line(const char* verb, const std::string& what, const std::string& arguments) {
        return std::string(verb) + " " + target_.kind + " ATTRIBUTE " + what + " " + target_.name +
               " " + arguments;
    }
    void Add(const std::string& arguments) { script_.Run(Line("ADD", "", arguments)); }
    void Set(const char* what, const std::string& arguments) {
        script_.Run(Line("SET", what, arguments));
    }
    Attribute* Get(const char* name) { return target_.find(script_.GetModel())->GetAttr(name); }
    int Count() {
        int count = 0;
        for ([[maybe_unused]] const Attribute* attribute :
             target_.find(script_.GetModel())->GetAttrIterator()) {
            ++count;
        }
        return count;
    }

    const Target& target_ = GetParam();
    EngineScript script_{Design};
};

} // namespace

TEST_P(AttributeCommands, AddMakesAString) {
    Add("LOC P1 ignored");
    ASSERT_NE(Get("loc"), nullptr);
    EXPECT_EQ(Get("LOC")->GetValueType(), Attribute::String);
    EXPECT_EQ(Get("LOC")->GetValueString(), "P1");
    EXPECT_EQ(Get("LOC")->GetGeneric(), "NONE");
    EXPECT_EQ(Get("LOC")->GetSynAttr(), "NONE");
}

TEST_P(AttributeCommands, AValueIsOptional) {
    Add("KEEP");
    ASSERT_NE(Get("KEEP"), nullptr);
    EXPECT_EQ(Get("KEEP")->GetValueString(), "");
    Add("-TYPE=Integer COUNT");
    EXPECT_EQ(Get("COUNT")->GetValueString(), "0");
}

TEST_P(AttributeCommands, AddTakesAType) {
    const struct {
        const char* type;
        Attribute::ValueType valueType;
        const char* value;
        const char* stored;
    } cases[] = {{"String", Attribute::String, "\"two  words\"", "two  words"},
                 {"integer", Attribute::Integer, "12abc", "12"},
                 {"FLOAT", Attribute::Float, "12.345", "12.345"},
                 {"Boolean", Attribute::Boolean, "true", "TRUE"},
                 {"bit", Attribute::Bit, "1", "1"},
                 {"BitVector", Attribute::BitVector, "8:H:A5", "A5"},
                 {"USER", Attribute::User, "ready", "ready"}};
    for (const auto& c : cases) {
        Add(std::string("-Type=") + c.type + " " + c.type + " " + c.value);
        ASSERT_NE(Get(c.type), nullptr) << c.type;
        EXPECT_EQ(Get(c.type)->GetValueType(), c.valueType) << c.type;
        EXPECT_EQ(Get(c.type)->GetValueString(), c.stored) << c.type;
    }
    EXPECT_EQ(Count(), 7);
}

TEST_P(AttributeCommands, ATypeAfterTheNameIsAValue) {
    Add("LOC -TYPE=Integer 5");
    EXPECT_EQ(Get("LOC")->GetValueType(), Attribute::String);
    EXPECT_EQ(Get("LOC")->GetValueString(), "-TYPE=Integer");
}

TEST_P(AttributeCommands, ASecondAddChangesTheValueAndKeepsTheType) {
    Add("-TYPE=Integer COUNT 5");
    Set("OPTION", "COUNT -GENERIC=SYN");
    Add("-TYPE=Boolean count 7");
    Add("-TYPE=unknown COUNT 8");
    EXPECT_EQ(Count(), 1);
    EXPECT_EQ(Get("COUNT")->GetValueType(), Attribute::Integer);
    EXPECT_EQ(Get("COUNT")->GetValueString(), "8");
    EXPECT_EQ(Get("COUNT")->GetName(), "COUNT");
    EXPECT_EQ(Get("COUNT")->GetGeneric(), "SYN");
}

TEST_P(AttributeCommands, NamesAreNormalised) {
    Add("LOC[3-0] P1");
    ASSERT_NE(Get("LOC(3:0)"), nullptr);
    Add("loc<3:0> P2");
    EXPECT_EQ(Count(), 1);
    EXPECT_EQ(Get("LOC{3-0}")->GetValueString(), "P2");
}

TEST_P(AttributeCommands, SetChangesTheValue) {
    Add("LOC P1");
    Set("VALUE", "loc \"P 2\" ignored");
    EXPECT_EQ(Get("LOC")->GetValueString(), "P 2");
    Set("VALUE", "LOC \"\" x");
    EXPECT_EQ(Get("LOC")->GetValueString(), "");
    Add("-TYPE=BitVector V 101");
    Set("VALUE", "V 4:B:1010");
    EXPECT_EQ(Get("V")->GetValueString(), "1010");
}

TEST_P(AttributeCommands, SetNamesTheUserType) {
    Add("-TYPE=User STATE idle");
    Set("USERTYPE", "state state_type ignored");
    const auto* attribute = dynamic_cast<AttributeUser*>(Get("STATE"));
    ASSERT_NE(attribute, nullptr);
    EXPECT_EQ(attribute->GetUserType(), "state_type");
    EXPECT_EQ(attribute->GetValueString(), "idle");
}

TEST_P(AttributeCommands, OptionsAreSetOneByOneOrTogether) {
    Add("LOC P1");
    Set("OPTION", "LOC -generic=nosyn");
    EXPECT_EQ(Get("LOC")->GetGeneric(), "NOSYN");
    EXPECT_EQ(Get("LOC")->GetSynAttr(), "NONE");
    Set("OPTION", "LOC -SynAttr=AssignNoDec");
    EXPECT_EQ(Get("LOC")->GetGeneric(), "NOSYN");
    EXPECT_EQ(Get("LOC")->GetSynAttr(), "ASSIGNNODEC");
    Set("OPTION", "LOC -SYNATTR=ASSIGN -GENERIC=SYN ignored");
    EXPECT_EQ(Get("LOC")->GetGeneric(), "SYN");
    EXPECT_EQ(Get("LOC")->GetSynAttr(), "ASSIGN");
    Set("OPTION", "LOC -GENERIC=NONE -SYNATTR=NONE");
    EXPECT_EQ(Get("LOC")->GetGeneric(), "NONE");
    EXPECT_EQ(Get("LOC")->GetSynAttr(), "NONE");
}

TEST_P(AttributeCommands, OfTwoOptionsOfOneKindTheLaterCounts) {
    Add("LOC P1");
    Set("OPTION", "LOC -GENERIC=unknown -GENERIC=SYN");
    EXPECT_EQ(Get("LOC")->GetGeneric(), "SYN");
    Set("OPTION", "LOC -SYNATTR=ASSIGN -SYNATTR=NONE");
    EXPECT_EQ(Get("LOC")->GetSynAttr(), "NONE");
}

TEST_P(AttributeCommands, TheGenericOptionIsSetFirst) {
    Add("LOC P1");
    EXPECT_EQ(script_.GetFailure(Line("SET", "OPTION", "LOC -SYNATTR=x -GENERIC=SYN")),
              "Invalid generic value.\n");
    EXPECT_EQ(Get("LOC")->GetGeneric(), "SYN");
    EXPECT_EQ(script_.GetFailure(Line("SET", "OPTION", "LOC -SYNATTR=ASSIGN -GENERIC=x")),
              "Invalid generic value.\n");
    EXPECT_EQ(Get("LOC")->GetSynAttr(), "NONE");
}

INSTANTIATE_TEST_SUITE_P(Objects, AttributeCommands, testing::ValuesIn(Targets));

TEST(InstanceAttributes, AreLookedForOnTheComponentToo) {
    EngineScript script(Design);
    script.Run("ADD COMPONENT ATTRIBUTE AND2 -TYPE=User BOTH c\n"
               "ADD COMPONENT ATTRIBUTE AND2 -TYPE=User OWN c\n"
               "ADD INSTANCE ATTRIBUTE U1 -TYPE=User BOTH i\n"
               "SET INSTANCE ATTRIBUTE VALUE U1 BOTH new\n"
               "SET INSTANCE ATTRIBUTE VALUE U1 OWN new\n"
               "SET INSTANCE ATTRIBUTE USERTYPE U1 OWN type\n"
               "SET INSTANCE ATTRIBUTE OPTION U1 OWN -GENERIC=SYN -SYNATTR=ASSIGN");
    const Component* component = script.GetModel().GetComponent("AND2");
    const Instance* instance = script.GetModel().GetInstance("U1");
    EXPECT_EQ(component->GetAttr("BOTH")->GetValueString(), "c");
    EXPECT_EQ(instance->GetAttr("BOTH")->GetValueString(), "new");
    EXPECT_EQ(instance->GetAttr("OWN"), nullptr);
    const auto* own = dynamic_cast<AttributeUser*>(component->GetAttr("OWN"));
    EXPECT_EQ(own->GetValueString(), "new");
    EXPECT_EQ(own->GetUserType(), "type");
    EXPECT_EQ(own->GetGeneric(), "SYN");
    EXPECT_EQ(own->GetSynAttr(), "ASSIGN");
}

TEST(InstanceAttributes, AnAddedOneHidesTheComponents) {
    EngineScript script(Design);
    script.Run("ADD COMPONENT ATTRIBUTE AND2 LOC c\nADD INSTANCE ATTRIBUTE U1 LOC i");
    EXPECT_EQ(script.GetModel().GetComponent("AND2")->GetAttr("LOC")->GetValueString(), "c");
    EXPECT_EQ(script.GetModel().GetInstance("U1")->GetAttr("LOC")->GetValueString(), "i");
}

TEST(PinAttributes, OfAnInstanceAreItsOwn) {
    EngineScript script(Design);
    script.Run("ADD COMPONENT PIN ATTRIBUTE AND2.I0 LOC c");
    EXPECT_EQ(script.GetFailure("SET INSTANCE PIN ATTRIBUTE VALUE U1.I0 LOC i"),
              "Attribute \"LOC\" not found.\n");
    script.Run("ADD INSTANCE AND2 U2");
    EXPECT_EQ(script.GetModel().GetInstance("U2")->GetPin("I0")->GetAttr("LOC"), nullptr);
}

TEST(PinNames, AreWhatFollowsTheFirstDot) {
    EngineScript script("ADD COMPONENT C\nADD PIN C A.B Input\nADD PIN C \"\" Input");
    script.Run("ADD COMPONENT PIN COMMENT C.A.B text\nADD COMPONENT PIN COMMENT C. empty");
    const Component* component = script.GetModel().GetComponent("C");
    EXPECT_EQ(component->GetPin("A.B")->GetComment(), "text\n");
    EXPECT_EQ(component->GetPin("")->GetComment(), "empty\n");
}

// Attributes without commands

TEST(ModelAttributes, NullHoldersAreIgnored) {
    CommandFactory factory;
    Model model(&factory);
    const std::string failure = Support::FailureOf([&] {
        model.AddAttr(static_cast<AttributeHolder*>(nullptr), "A", "v", "String");
        model.SetAttrValue(static_cast<AttributeHolder*>(nullptr), "A", "v");
        model.SetGenericAttrValue(static_cast<AttributeHolder*>(nullptr), "A", "SYN");
        model.SetSynAttrValue(static_cast<AttributeHolder*>(nullptr), "A", "ASSIGN");
        model.SetUserType(static_cast<AttributeHolder*>(nullptr), "A", "t");
    });
    EXPECT_EQ(failure, "");
    EXPECT_EQ(model.GetAttr("A", nullptr), nullptr);
}

TEST(ModelAttributes, NullTypesAndValuesHaveDefaults) {
    CommandFactory factory;
    Model model(&factory);
    model.AddModuleAttr("A", nullptr, nullptr);
    const Attribute* attribute = model.GetAttr("a", model.GetNetlist());
    ASSERT_NE(attribute, nullptr);
    EXPECT_EQ(attribute->GetValueType(), Attribute::String);
    EXPECT_EQ(attribute->GetValueString(), "");
    EXPECT_TRUE(model.IsModified());
    model.SetModuleAttrValue("A", "x");
    model.SetModuleAttrValue("A", nullptr);
    EXPECT_EQ(attribute->GetValueString(), "");
}
