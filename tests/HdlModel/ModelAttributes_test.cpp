#include "Orn_Hdl/Exception.h"
#include "Orn_Hdl/Model.h"
#include "Support/Names.h"

#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace {

using namespace Orn_Hdl;
using Support::Names;
using Support::NamesOf;

using Text = const char*;

/// The operations of one kind of owner, called with the names of an owner that is there or not.
struct Owner {
    const char* kind;
    /// What a missing owner fails with; null when the owner cannot be missing.
    const char* missingMessage;
    std::function<AttributeHolder*(Model&)> get;
    std::function<bool(Model&, bool present, Text name, Text value, Text type)> add;
    std::function<bool(Model&, bool present, Text name, Text value)> setValue;
    std::function<bool(Model&, bool present, Text name, Text value)> setGeneric;
    std::function<bool(Model&, bool present, Text name, Text value)> setSynAttr;
    std::function<bool(Model&, bool present, Text name, Text value)> setUserType;
};

void PrintTo(const Owner& owner, std::ostream* out) {
    *out << owner.kind;
}

std::vector<Owner> MakeOwners() {
    const auto c = [](bool present) { return present ? "c" : "NONE"; };
    const auto u = [](bool present) { return present ? "u" : "NONE"; };
    const auto n = [](bool present) { return present ? "n" : "NONE"; };
    const auto p = [](bool present) { return present ? "p" : "NONE"; };
    return {
        {"Module", nullptr, [](Model& m) -> AttributeHolder* { return m.GetNetlist(); },
         [](Model& m, bool, Text a, Text v, Text t) { return m.AddModuleAttr(a, v, t); },
         [](Model& m, bool, Text a, Text v) { return m.SetModuleAttrValue(a, v); },
         [](Model& m, bool, Text a, Text v) { return m.SetModuleGenericAttrValue(a, v); },
         [](Model& m, bool, Text a, Text v) { return m.SetModuleSynAttrValue(a, v); },
         [](Model& m, bool, Text a, Text v) { return m.SetModuleUserType(a, v); }},
        {"Component", "\"NONE\" not found.\n",
         [](Model& m) -> AttributeHolder* { return m.GetComponent("C"); },
         [=](Model& m, bool h, Text a, Text v, Text t) {
             return m.AddComponentAttr(c(h), a, v, t);
         },
         [=](Model& m, bool h, Text a, Text v) { return m.SetComponentAttrValue(c(h), a, v); },
         [=](Model& m, bool h, Text a, Text v) {
             return m.SetComponentGenericAttrValue(c(h), a, v);
         },
         [=](Model& m, bool h, Text a, Text v) { return m.SetComponentSynAttrValue(c(h), a, v); },
         [=](Model& m, bool h, Text a, Text v) { return m.SetComponentUserType(c(h), a, v); }},
        {"Instance", "\"NONE\" not found.\n",
         [](Model& m) -> AttributeHolder* { return m.GetInstance("U"); },
         [=](Model& m, bool h, Text a, Text v, Text t) { return m.AddInstanceAttr(u(h), a, v, t); },
         [=](Model& m, bool h, Text a, Text v) { return m.SetInstanceAttrValue(u(h), a, v); },
         [=](Model& m, bool h, Text a, Text v) {
             return m.SetInstanceGenericAttrValue(u(h), a, v);
         },
         [=](Model& m, bool h, Text a, Text v) { return m.SetInstanceSynAttrValue(u(h), a, v); },
         [=](Model& m, bool h, Text a, Text v) { return m.SetInstanceUserType(u(h), a, v); }},
        {"Signal", "\"NONE\" not found.\n",
         [](Model& m) -> AttributeHolder* { return m.GetSignal("N"); },
         [=](Model& m, bool h, Text a, Text v, Text t) { return m.AddSignalAttr(n(h), a, v, t); },
         [=](Model& m, bool h, Text a, Text v) { return m.SetSignalAttrValue(n(h), a, v); },
         [=](Model& m, bool h, Text a, Text v) { return m.SetSignalGenericAttrValue(n(h), a, v); },
         [=](Model& m, bool h, Text a, Text v) { return m.SetSignalSynAttrValue(n(h), a, v); },
         [=](Model& m, bool h, Text a, Text v) { return m.SetSignalUserType(n(h), a, v); }},
        {"ComponentPin", "Pin \"NONE\" not found.\n",
         [](Model& m) -> AttributeHolder* { return m.GetComponent("C")->GetPin("P"); },
         [=](Model& m, bool h, Text a, Text v, Text t) {
             return m.AddComponentPinAttr("C", p(h), a, v, t);
         },
         [=](Model& m, bool h, Text a, Text v) {
             return m.SetComponentPinAttrValue("C", p(h), a, v);
         },
         [=](Model& m, bool h, Text a, Text v) {
             return m.SetComponentPinGenericAttrValue("C", p(h), a, v);
         },
         [=](Model& m, bool h, Text a, Text v) {
             return m.SetComponentPinSynAttrValue("C", p(h), a, v);
         },
         [=](Model& m, bool h, Text a, Text v) {
             return m.SetComponentPinUserType("C", p(h), a, v);
         }},
        {"InstancePin", "Pin \"NONE\" not found.\n",
         [](Model& m) -> AttributeHolder* { return m.GetInstance("U")->GetPin("P"); },
         [=](Model& m, bool h, Text a, Text v, Text t) {
             return m.AddInstancePinAttr("U", p(h), a, v, t);
         },
         [=](Model& m, bool h, Text a, Text v) {
             return m.SetInstancePinAttrValue("U", p(h), a, v);
         },
         [=](Model& m, bool h, Text a, Text v) {
             return m.SetInstancePinGenericAttrValue("U", p(h), a, v);
         },
         [=](Model& m, bool h, Text a, Text v) {
             return m.SetInstancePinSynAttrValue("U", p(h), a, v);
         },
         [=](Model& m, bool h, Text a, Text v) {
             return m.SetInstancePinUserType("U", p(h), a, v);
         }},
    };
}

/// A model with the component C, its pin P, its instance U and the signal N.
class Furnished {
protected:
    Furnished() {
        model_.AddComponent("C");
        model_.AddPin("P", Polarity("in"), "C", "");
        model_.AddInstance("U", "C");
        model_.AddSignal("N");
        model_.SetModifiedFlag(false);
    }

    void ExpectFailure(const char* message, const std::function<void()>& action) {
        model_.SetModifiedFlag(false);
        try {
            action();
            ADD_FAILURE() << "no failure, but it should be " << message;
        } catch (const Exception& exception) {
            EXPECT_EQ(exception.getLocalized(), message);
            EXPECT_EQ(exception.GetSourceUnit(), "../s/HdlModel");
        }
        EXPECT_FALSE(model_.IsModified());
    }

    void ExpectChange(const std::function<bool()>& action) {
        model_.SetModifiedFlag(false);
        EXPECT_TRUE(action());
        EXPECT_TRUE(model_.IsModified());
    }

    Model model_{nullptr};
};

class AttributesOf : public Furnished, public testing::TestWithParam<Owner> {
protected:
    Attribute* Get(const char* name) { return GetParam().get(model_)->GetAttr(name); }
};

TEST_P(AttributesOf, AreAddedWithTheirType) {
    const Owner& owner = GetParam();
    ExpectChange([&] { return owner.add(model_, true, "LOC[1]", "12x", "integer"); });
    ExpectChange([&] { return owner.add(model_, true, "INIT", "8:H:A5", "BitVector"); });
    ExpectChange([&] { return owner.add(model_, true, "TEXT", nullptr, nullptr); });
    EXPECT_EQ(Get("loc<1>")->GetValueTypeName(), "Integer");
    EXPECT_EQ(Get("LOC(1)")->GetValueString(), "12");
    EXPECT_EQ(Get("INIT")->GetValueString(), "A5");
    EXPECT_EQ(Get("TEXT")->GetValueTypeName(), "String") << "the default type";
    EXPECT_EQ(Get("TEXT")->GetValueString(), "");
    EXPECT_EQ(NamesOf(owner.get(model_)->GetAttrIterator()), (Names{"LOC(1)", "INIT", "TEXT"}));
}

TEST_P(AttributesOf, ThatArePresentTakeTheValueAndKeepTheirType) {
    const Owner& owner = GetParam();
    owner.add(model_, true, "LOC", "1", "Integer");
    ExpectChange([&] { return owner.add(model_, true, "loc", "27", "String"); });
    ExpectChange([&] { return owner.add(model_, true, "LOC", "28", "no type"); });
    EXPECT_EQ(Get("LOC")->GetValueString(), "28");
    EXPECT_EQ(Get("LOC")->GetValueTypeName(), "Integer");
    EXPECT_EQ(NamesOf(owner.get(model_)->GetAttrIterator()), Names{"LOC"});
}

TEST_P(AttributesOf, AreRefusedWithoutANameOrAKnownType) {
    const Owner& owner = GetParam();
    ExpectFailure("Invalid Name.\n", [&] { owner.add(model_, true, nullptr, "1", "String"); });
    ExpectFailure("Invalid Name.\n", [&] { owner.add(model_, false, nullptr, "1", "String"); });
    ExpectFailure("Invalid attribute type.\n", [&] { owner.add(model_, true, "a", "1", "Text"); });
    ExpectFailure("Invalid attribute type.\n", [&] { owner.add(model_, true, "a", "1", ""); });
    EXPECT_FALSE(owner.get(model_)->HasAttrs());
    ExpectChange([&] { return owner.add(model_, true, "", "1", "String"); });
}

TEST_P(AttributesOf, GetValues) {
    const Owner& owner = GetParam();
    owner.add(model_, true, "LOC", "1", "Integer");
    ExpectChange([&] { return owner.setValue(model_, true, "loc", "7"); });
    EXPECT_EQ(Get("LOC")->GetValueString(), "7");
    ExpectChange([&] { return owner.setValue(model_, true, "LOC", nullptr); });
    EXPECT_EQ(Get("LOC")->GetValueString(), "0");
    ExpectFailure("Attribute \"none\" not found.\n",
                  [&] { owner.setValue(model_, true, "none", "7"); });
    ExpectFailure("Attribute \"\" not found.\n",
                  [&] { owner.setValue(model_, true, nullptr, "7"); });
}

TEST_P(AttributesOf, AreFoundByNormalisedName) {
    const Owner& owner = GetParam();
    owner.add(model_, true, "LOC(0)", "1", "Integer");
    ExpectChange([&] { return owner.setValue(model_, true, "loc[0]", "7"); });
    EXPECT_EQ(Get("LOC(0)")->GetValueString(), "7");
}

TEST_P(AttributesOf, GetGenericOptions) {
    const Owner& owner = GetParam();
    owner.add(model_, true, "LOC", "1", "Integer");
    ExpectChange([&] { return owner.setGeneric(model_, true, "loc", "syn"); });
    EXPECT_EQ(Get("LOC")->GetGeneric(), "SYN");
    ExpectFailure("Invalid generic value.\n",
                  [&] { owner.setGeneric(model_, true, "LOC", "ASSIGN"); });
    ExpectFailure("Invalid generic value.\n",
                  [&] { owner.setGeneric(model_, true, "LOC", nullptr); });
    EXPECT_EQ(Get("LOC")->GetGeneric(), "SYN");
    ExpectFailure("Attribute \"none\" not found.\n",
                  [&] { owner.setGeneric(model_, true, "none", "SYN"); });
}

TEST_P(AttributesOf, GetSynthesisOptions) {
    const Owner& owner = GetParam();
    owner.add(model_, true, "LOC", "1", "Integer");
    ExpectChange([&] { return owner.setSynAttr(model_, true, "loc", "assignNoDec"); });
    EXPECT_EQ(Get("LOC")->GetSynAttr(), "ASSIGNNODEC");
    ExpectFailure("Invalid generic value.\n",
                  [&] { owner.setSynAttr(model_, true, "LOC", "SYN"); });
    EXPECT_EQ(Get("LOC")->GetSynAttr(), "ASSIGNNODEC");
    ExpectFailure("Attribute \"none\" not found.\n",
                  [&] { owner.setSynAttr(model_, true, "none", "ASSIGN"); });
}

TEST_P(AttributesOf, GetUserTypesWhenTheyAreUserTyped) {
    const Owner& owner = GetParam();
    owner.add(model_, true, "STATE", "idle", "User");
    owner.add(model_, true, "LOC", "1", "Integer");
    ExpectChange([&] { return owner.setUserType(model_, true, "state", "state_type"); });
    EXPECT_EQ(dynamic_cast<AttributeUser&>(*Get("STATE")).GetUserType(), "state_type");
    ExpectFailure("Invalid attribute type.\n",
                  [&] { owner.setUserType(model_, true, "LOC", "state_type"); });
    ExpectFailure("Attribute \"none\" not found.\n",
                  [&] { owner.setUserType(model_, true, "none", "state_type"); });
}

TEST_P(AttributesOf, AMissingOwnerAreRefusedWithItsName) {
    const Owner& owner = GetParam();
    if (owner.missingMessage == nullptr) {
        return; // the module is always there
    }
    ExpectFailure(owner.missingMessage, [&] { owner.add(model_, false, "a", "1", "String"); });
    ExpectFailure(owner.missingMessage, [&] { owner.add(model_, false, "a", "1", "no type"); });
    ExpectFailure(owner.missingMessage, [&] { owner.setValue(model_, false, "a", "1"); });
    ExpectFailure(owner.missingMessage, [&] { owner.setGeneric(model_, false, "a", "SYN"); });
    ExpectFailure(owner.missingMessage, [&] { owner.setSynAttr(model_, false, "a", "ASSIGN"); });
    ExpectFailure(owner.missingMessage, [&] { owner.setUserType(model_, false, "a", "t"); });
}

INSTANTIATE_TEST_SUITE_P(Owners, AttributesOf, testing::ValuesIn(MakeOwners()),
                         [](const auto& chosen) { return std::string(chosen.param.kind); });

class ModelAttributes : public Furnished, public testing::Test {};

TEST_F(ModelAttributes, AMissingComponentOrInstanceOfAPinGivesThePinsMessage) {
    const char* message = "Pin \"P\" not found.\n";
    ExpectFailure(message, [&] { model_.AddComponentPinAttr("NONE", "P", "a", "1", nullptr); });
    ExpectFailure(message, [&] { model_.AddInstancePinAttr("NONE", "P", "a", "1", nullptr); });
    ExpectFailure(message, [&] { model_.SetComponentPinAttrValue("NONE", "P", "a", "1"); });
    ExpectFailure(message, [&] { model_.SetInstancePinAttrValue("NONE", "P", "a", "1"); });
    ExpectFailure(message, [&] { model_.SetComponentPinGenericAttrValue("NONE", "P", "a", "1"); });
    ExpectFailure(message, [&] { model_.SetInstancePinGenericAttrValue("NONE", "P", "a", "1"); });
    ExpectFailure(message, [&] { model_.SetComponentPinSynAttrValue("NONE", "P", "a", "1"); });
    ExpectFailure(message, [&] { model_.SetInstancePinSynAttrValue("NONE", "P", "a", "1"); });
    ExpectFailure(message, [&] { model_.SetComponentPinUserType("NONE", "P", "a", "1"); });
    ExpectFailure(message, [&] { model_.SetInstancePinUserType("NONE", "P", "a", "1"); });
    ExpectFailure(message, [&] { model_.AddComponentPinComment("NONE", "P", "text"); });
    ExpectFailure(message, [&] { model_.AddInstancePinComment("NONE", "P", "text"); });
    ExpectFailure("Pin \"\" not found.\n",
                  [&] { model_.AddComponentPinAttr("C", nullptr, "a", "1", nullptr); });
}

TEST_F(ModelAttributes, OfAnInstanceAreLookedForOnItsComponentToo) {
    model_.AddComponentAttr("C", "LEVEL", "low", "User");
    ExpectChange([&] { return model_.SetInstanceAttrValue("U", "level", "high"); });
    ExpectChange([&] { return model_.SetInstanceGenericAttrValue("U", "level", "SYN"); });
    ExpectChange([&] { return model_.SetInstanceSynAttrValue("U", "level", "ASSIGN"); });
    ExpectChange([&] { return model_.SetInstanceUserType("U", "level", "t"); });
    const Attribute* attribute = model_.GetComponent("C")->GetAttr("LEVEL");
    EXPECT_EQ(attribute->GetValueString(), "high");
    EXPECT_EQ(attribute->GetGeneric(), "SYN");
    EXPECT_EQ(attribute->GetSynAttr(), "ASSIGN");
    EXPECT_FALSE(model_.GetInstance("U")->HasAttrs());
    model_.AddInstanceAttr("U", "LEVEL", "mine", nullptr);
    model_.SetInstanceAttrValue("U", "LEVEL", "changed");
    EXPECT_EQ(attribute->GetValueString(), "high") << "the instance's own comes first";
    EXPECT_EQ(model_.GetInstance("U")->GetAttr("LEVEL")->GetValueString(), "changed");
}

TEST_F(ModelAttributes, OfANullHolderDoNothing) {
    AttributeHolder* const none = nullptr;
    EXPECT_NO_THROW(model_.AddAttr(none, "a", "1", "no type"));
    EXPECT_NO_THROW(model_.SetAttrValue(none, "a", "1"));
    EXPECT_NO_THROW(model_.SetGenericAttrValue(none, "a", "bad"));
    EXPECT_NO_THROW(model_.SetSynAttrValue(none, "a", "bad"));
    EXPECT_NO_THROW(model_.SetUserType(none, "a", "t"));
    EXPECT_FALSE(model_.IsModified());
}

TEST_F(ModelAttributes, OfAnyHolder) {
    AttributeHolder holder;
    ExpectChange([&] { return model_.AddAttr(&holder, "a", "v", "User"); });
    ExpectChange([&] { return model_.SetAttrValue(&holder, "A", "w"); });
    ExpectChange([&] { return model_.SetGenericAttrValue(&holder, "A", "NOSYN"); });
    ExpectChange([&] { return model_.SetSynAttrValue(&holder, "A", "NONE"); });
    ExpectChange([&] { return model_.SetUserType(&holder, "A", "t"); });
    EXPECT_EQ(model_.GetAttr("A", &holder)->GetValueString(), "w");
    ExpectFailure("Attribute \"b\" not found.\n", [&] { model_.SetAttrValue(&holder, "b", "w"); });
}

TEST_F(ModelAttributes, AreNotThoseOfASignalThatIsOnlyUsed) {
    ExpectFailure("\"M\" not found.\n", [&] { model_.AddSignalAttr("M", "a", "1", nullptr); });
    EXPECT_EQ(model_.GetSignal("M"), nullptr) << "an attribute declares no signal";
}

class Comments : public Furnished, public testing::Test {};

TEST_F(Comments, GoToTheirObjects) {
    ExpectChange([&] { return model_.AddNotes("module"); });
    ExpectChange([&] { return model_.AddComponentComment("c", "component"); });
    ExpectChange([&] { return model_.AddInstanceComment("u", "instance"); });
    ExpectChange([&] { return model_.AddSignalComment("n", "signal"); });
    ExpectChange([&] { return model_.AddComponentPinComment("c", "p", "component pin"); });
    ExpectChange([&] { return model_.AddInstancePinComment("u", "p", "instance pin"); });
    model_.AddNotes("second");
    EXPECT_EQ(model_.GetNetlist()->GetComment(), "module\nsecond\n");
    EXPECT_EQ(model_.GetComponent("C")->GetComment(), "component\n");
    EXPECT_EQ(model_.GetInstance("U")->GetComment(), "instance\n");
    EXPECT_EQ(model_.GetSignal("N")->GetComment(), "signal\n");
    EXPECT_EQ(model_.GetComponent("C")->GetPin("P")->GetComment(), "component pin\n");
    EXPECT_EQ(model_.GetInstance("U")->GetPin("P")->GetComment(), "instance pin\n");
}

TEST_F(Comments, NameWhatIsMissing) {
    ExpectFailure("\"NONE\" not found.\n", [&] { model_.AddComponentComment("NONE", "x"); });
    ExpectFailure("\"NONE\" not found.\n", [&] { model_.AddInstanceComment("NONE", "x"); });
    ExpectFailure("\"NONE\" not found.\n", [&] { model_.AddSignalComment("NONE", "x"); });
    ExpectFailure("Pin \"NONE\" not found.\n",
                  [&] { model_.AddComponentPinComment("C", "NONE", "x"); });
    ExpectFailure("Pin \"NONE\" not found.\n",
                  [&] { model_.AddInstancePinComment("U", "NONE", "x"); });
    ExpectFailure("\"\" not found.\n", [&] { model_.AddSignalComment(nullptr, "x"); });
}

TEST_F(Comments, OfNullAreNone) {
    EXPECT_NO_THROW(model_.AddNotes(nullptr));
    EXPECT_NO_THROW(model_.AddComponentPinComment("C", "P", nullptr));
    EXPECT_NO_THROW(model_.AddInstancePinComment("U", "P", nullptr));
    EXPECT_NO_THROW(model_.AddComponentPinComment("NONE", "P", nullptr));
    EXPECT_NO_THROW(model_.AddInstancePinComment("NONE", "P", nullptr));
    EXPECT_EQ(model_.GetNetlist()->GetComment(), "");
    EXPECT_EQ(model_.GetComponent("C")->GetPin("P")->GetComment(), "");
    EXPECT_EQ(model_.GetInstance("U")->GetPin("P")->GetComment(), "");
}

} // namespace
