// Ports, pins by the text of their direction, bits by number, and attributes with their options.
#include "Orn_Hdl/Exception.h"
#include "Orn_Hdl/Model.h"
#include "Support/Names.h"

#include <gtest/gtest.h>

#include <string>

namespace {

using namespace Orn_Hdl;

class ModelAdditionsTest : public testing::Test {
protected:
    /// The message with which an action fails; empty if it does not.
    template <class Action> static std::string MessageOf(Action action) {
        try {
            action();
        } catch (const Exception& exception) {
            return exception.getLocalized().CStr();
        }
        return "";
    }

    Model model_{nullptr};
};

TEST_F(ModelAdditionsTest, AddsPorts) {
    EXPECT_TRUE(model_.AddPort("A", Polarity::Input));
    EXPECT_TRUE(model_.IsModified());
    EXPECT_TRUE(model_.AddPort("D[7-0]", "out"));
    EXPECT_TRUE(model_.AddPort("PAD", "inout"));
    EXPECT_EQ(model_.GetSignal("A")->GetPortPolarity(), Polarity::Input);
    EXPECT_EQ(model_.GetSignal("D(7:0)")->GetPortPolarity(), Polarity::Output);
    EXPECT_EQ(model_.GetSignal("PAD")->GetPortPolarity(), Polarity::BiDirectional);
}

TEST_F(ModelAdditionsTest, RefusesPortsWithoutADirectionOrAName) {
    model_.AddPort("A", "input");
    model_.SetModifiedFlag(false);
    EXPECT_EQ(MessageOf([&] { model_.AddPort("B", "sideways"); }),
              "Invalid direction \"sideways\".\n");
    EXPECT_EQ(MessageOf([&] { model_.AddPort("B", nullptr); }), "Invalid direction \"\".\n");
    EXPECT_EQ(MessageOf([&] { model_.AddPort("B", Polarity()); }), "Invalid direction \"\".\n");
    EXPECT_EQ(MessageOf([&] { model_.AddPort("a", "input"); }),
              "Identifier \"a\" already defined.\n");
    EXPECT_EQ(MessageOf([&] { model_.AddPort(nullptr, "input"); }), "Invalid Name.\n");
    EXPECT_EQ(model_.GetSignal("B"), nullptr);
    EXPECT_FALSE(model_.IsModified());
}

TEST_F(ModelAdditionsTest, AddsPinsByTheTextOfTheirDirection) {
    model_.AddComponent("PAD");
    EXPECT_TRUE(model_.AddPin("IO", "inout", "PAD"));
    EXPECT_TRUE(model_.AddPin("I", "i", "PAD", "1"));
    const Component* const component = model_.GetComponent("PAD");
    EXPECT_EQ(component->GetPin("IO")->GetPolarity(), Polarity::BiDirectional);
    EXPECT_EQ(component->GetPin("I")->GetPolarity(), Polarity::Input);
    EXPECT_EQ(component->GetPin("I")->GetDefaultValue().GetValue(), "1");
    EXPECT_EQ(MessageOf([&] { model_.AddPin("X", "inoutput", "PAD"); }),
              "Invalid direction \"inoutput\".\n");
    EXPECT_EQ(component->GetPin("X"), nullptr);
}

TEST_F(ModelAdditionsTest, ABitIsMadeOnceAndFound) {
    model_.AddSignal("D(7:0)");
    model_.SetModifiedFlag(false);
    BusIndex* const bit = model_.Bit("d", 3);
    EXPECT_TRUE(model_.IsModified());
    EXPECT_EQ(bit->GetName(), "D(3)");
    EXPECT_EQ(bit->GetParentBus(), model_.GetSignal("D(7:0)"));
    model_.SetModifiedFlag(false);
    EXPECT_EQ(model_.Bit("D[7:0]", 3), bit);
    EXPECT_EQ(model_.GetSignal("D(3)"), bit);
    EXPECT_FALSE(model_.IsModified());
    EXPECT_NO_THROW(model_.Bit("D", 0));
    EXPECT_NO_THROW(model_.Bit("D", 7));
    model_.AddSignal("UP(4:6)");
    EXPECT_NO_THROW(model_.Bit("UP", 4));
    EXPECT_NO_THROW(model_.Bit("UP", 6));
}

TEST_F(ModelAdditionsTest, RefusesABitThatDoesNotExist) {
    model_.AddSignal("A");
    model_.AddSignal("D(7:4)");
    // By accident, a scalar has the name of a bit.
    model_.AddSignal("D(5)");
    const Support::Names before = Support::NamesOf(model_.GetNetlist()->GetSignalIterator());
    model_.SetModifiedFlag(false);
    EXPECT_EQ(MessageOf([&] { model_.Bit("D", 3); }), "Signal \"D(3)\" not found.\n");
    EXPECT_EQ(MessageOf([&] { model_.Bit("D", 8); }), "Signal \"D(8)\" not found.\n");
    EXPECT_EQ(MessageOf([&] { model_.Bit("D", -1); }), "Signal \"D(-1)\" not found.\n");
    EXPECT_EQ(MessageOf([&] { model_.Bit("D", 5); }), "Signal \"D(5)\" not found.\n");
    EXPECT_EQ(MessageOf([&] { model_.Bit("D(6)", 6); }), "Signal \"D(6)\" not found.\n");
    EXPECT_EQ(MessageOf([&] { model_.Bit("A", 0); }), "Signal \"A(0)\" not found.\n");
    EXPECT_EQ(MessageOf([&] { model_.Bit("Z", 0); }), "Signal \"Z(0)\" not found.\n");
    EXPECT_EQ(MessageOf([&] { model_.Bit(nullptr, 0); }), "Signal \"(0)\" not found.\n");
    EXPECT_EQ(Support::NamesOf(model_.GetNetlist()->GetSignalIterator()), before);
    EXPECT_FALSE(model_.IsModified());
}

TEST_F(ModelAdditionsTest, AddsAnAttributeWithItsOptions) {
    model_.AddSignal("A");
    Signal* const signal = model_.GetSignal("A");
    EXPECT_TRUE(model_.AddAttr(signal, "KEEP", "true", "Boolean", Attribute::SynAttrAssign));
    EXPECT_TRUE(model_.AddAttr(signal, "WIDTH", "8", "Integer", Attribute::GenericNoSyn));
    EXPECT_TRUE(model_.AddAttr(signal, "BOTH", "x", nullptr, Attribute::GenericSyn,
                               Attribute::SynAttrAssignNoDec));
    const Attribute* const keep = signal->GetAttr("KEEP");
    EXPECT_EQ(keep->GetValueType(), Attribute::Boolean);
    EXPECT_EQ(keep->GetGenericOption(), Attribute::GenericNone);
    EXPECT_EQ(keep->GetSynAttrOption(), Attribute::SynAttrAssign);
    EXPECT_EQ(signal->GetAttr("WIDTH")->GetGenericOption(), Attribute::GenericNoSyn);
    EXPECT_EQ(signal->GetAttr("WIDTH")->GetSynAttrOption(), Attribute::SynAttrNone);
    EXPECT_EQ(signal->GetAttr("BOTH")->GetGenericOption(), Attribute::GenericSyn);
    EXPECT_EQ(signal->GetAttr("BOTH")->GetSynAttrOption(), Attribute::SynAttrAssignNoDec);

    // One that is present gets the value and the options, and keeps its type.
    EXPECT_TRUE(model_.AddAttr(signal, "KEEP", "false", "String", Attribute::GenericSyn));
    EXPECT_EQ(keep->GetValueString(), "FALSE");
    EXPECT_EQ(keep->GetValueType(), Attribute::Boolean);
    EXPECT_EQ(keep->GetGenericOption(), Attribute::GenericSyn);
    EXPECT_EQ(keep->GetSynAttrOption(), Attribute::SynAttrNone);
}

TEST_F(ModelAdditionsTest, RefusesAnAttributeOfNoTypeAndNoHolder) {
    model_.AddSignal("A");
    Signal* const signal = model_.GetSignal("A");
    EXPECT_EQ(
        MessageOf([&] { model_.AddAttr(signal, "X", "1", "Number", Attribute::SynAttrAssign); }),
        "Invalid attribute type.\n");
    EXPECT_EQ(signal->GetAttr("X"), nullptr);
    EXPECT_FALSE(model_.AddAttr(nullptr, "X", "1", nullptr, Attribute::SynAttrAssign));
}

} // namespace
