// Netlists and engines that are moved, and visitors over constant objects.
#include "Orn_Hdl/Orn_Hdl.h"

#include "Support/Names.h"
#include "Support/Parts.h"

#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <vector>

namespace {

using namespace Orn_Hdl;
using Support::In;
using Support::Names;
using Support::NamesOf;
using Support::Out;

/// A netlist with a component that has three pins, two instances of it and a signal on their pins.
struct Design {
    Netlist netlist;
    Component* component = new Component("C");
    Instance* first = nullptr;
    Instance* second = nullptr;
    ScalarSignal* net = new ScalarSignal("N");

    Design() {
        component->AddPin("I", In, "");
        component->AddPin("J(3:0)", In, "");
        component->AddPin("K(1)", Out, "");
        netlist.Add(component);
        first = new Instance("U1", component);
        second = new Instance("U2", component);
        netlist.Add(first);
        netlist.Add(second);
        netlist.Add(net);
        net->Connect(first->GetPin("I"));
        net->Connect(second->GetPin("I"));
    }
};

template <class Work> std::string Message(Work work) {
    try {
        work();
    } catch (const Exception& exception) {
        return exception.what();
    }
    return "";
}

TEST(Moving, ANetlistTakesEverythingAlong) {
    Design design;
    design.netlist.SetName("top");
    design.netlist.AddComment("note");
    design.netlist.AddAttr(new AttributeString("A", "a"));
    Netlist taken(std::move(design.netlist));
    EXPECT_EQ(taken.GetName(), "top");
    EXPECT_EQ(taken.GetComment(), "note\n");
    EXPECT_NE(taken.GetAttr("A"), nullptr);
    EXPECT_EQ(taken.GetInstance("U1"), design.first);
    // NOLINTBEGIN(bugprone-use-after-move)
    EXPECT_EQ(design.netlist.GetName(), "hdlNetlist");
    EXPECT_FALSE(design.netlist.HasAttrs());
    EXPECT_EQ(design.netlist.GetInstance("U1"), nullptr);
    design.netlist.Add(new ScalarSignal("M"));
    // NOLINTEND(bugprone-use-after-move)
    delete design.net;
    EXPECT_EQ(taken.GetSignal("N"), nullptr);
    design.netlist = std::move(taken);
    EXPECT_EQ(design.netlist.GetSignal("M"), nullptr);
    EXPECT_EQ(design.netlist.GetInstance("U2"), design.second);
    Netlist& same = design.netlist;
    design.netlist = std::move(same);
    EXPECT_EQ(design.netlist.GetInstance("U2"), design.second);
}

TEST(Moving, AMovedNetlistRenamesItsModel) {
    Engine engine;
    engine.CreateAndAddModel("one", "");
    Model* const model = engine.GetModel("one");
    Netlist other("two");
    other.Add(new ScalarSignal("N"));
    *model->GetNetlist() = std::move(other);
    EXPECT_EQ(engine.GetModel("one"), nullptr);
    EXPECT_EQ(engine.GetModel("two"), model);
    EXPECT_NE(model->GetSignal("N"), nullptr);
}

TEST(Moving, AnEngineTakesItsModelsAlong) {
    Engine engine;
    engine.CreateAndAddModel("top", "");
    engine.UseModel("top");
    Model* const model = engine.GetModel("top");
    Engine taken(std::move(engine));
    EXPECT_EQ(taken.GetModel("top"), model);
    taken.Execute("SET NETLIST NAME next");
    EXPECT_EQ(taken.GetModel("next"), model);
    // NOLINTNEXTLINE(bugprone-use-after-move)
    EXPECT_EQ(engine.GetModel("top"), nullptr);
    EXPECT_EQ(Message([&] { engine.Execute("ADD NET N"); }), "Missing Model.\n");
    engine.CreateAndAddModel("other", "");
    engine = std::move(taken);
    EXPECT_EQ(engine.GetModel("next"), model);
    EXPECT_EQ(engine.GetModel("other"), nullptr);
}

struct Kinds : ConstObjectVisitor {
    void VisitAttribute(const Attribute* attribute) override { Note("attribute", *attribute); }
    void VisitSignal(const Signal* signal) override { Note("signal", *signal); }
    void VisitComponent(const Component* component) override { Note("component", *component); }
    void VisitPin(const Pin* pin) override { Note("pin", *pin); }
    void VisitInstance(const Instance* instance) override { Note("instance", *instance); }
    void VisitNetlist(const Netlist* netlist) override { Note("netlist", *netlist); }
    void Note(const char* kind, const Object& object) {
        text += kind + (" " + std::string(object.GetNameView())) + ";";
    }
    std::string text;
};

struct SignalClasses : ConstSignalVisitor {
    void VisitSignal(const Signal* /*signal*/) override { text += "signal;"; }
    void VisitScalarSignal(const ScalarSignal* /*signal*/) override { text += "scalar,"; }
    void VisitBus(const Bus* /*bus*/) override { text += "bus,"; }
    void VisitBusSlice(const BusSlice* /*slice*/) override { text += "slice,"; }
    void VisitBusIndex(const BusIndex* /*bit*/) override { text += "bit,"; }
    void VisitCompoundBus(const CompoundBus* /*compound*/) override { text += "compound,"; }
    std::string text;
};

struct PinClasses : ConstPinVisitor {
    void VisitScalarPin(const ScalarPin* /*pin*/) override { text += "scalar;"; }
    void VisitBusPin(const BusPin* /*pin*/) override { text += "bus;"; }
    void VisitBusIndexPin(const BusIndexPin* /*pin*/) override { text += "bit;"; }
    std::string text;
};

struct AttributeTypes : ConstAttributeVisitor {
    void VisitAttributeString(const AttributeString* /*a*/) override { text += "String;"; }
    void VisitAttributeInteger(const AttributeInteger* /*a*/) override { text += "Integer;"; }
    void VisitAttributeFloat(const AttributeFloat* /*a*/) override { text += "Float;"; }
    void VisitAttributeBit(const AttributeBit* /*a*/) override { text += "Bit;"; }
    void VisitAttributeBitVector(const AttributeBitVector* /*a*/) override { text += "Vector;"; }
    void VisitAttributeBoolean(const AttributeBoolean* /*a*/) override { text += "Boolean;"; }
    void VisitAttributeUser(const AttributeUser* /*a*/) override { text += "User;"; }
    std::string text;
};

TEST(ConstVisitors, ConstantObjectsAreToldApart) {
    const Design design;
    const AttributeString attribute("A", "");
    Kinds kinds;
    for (const Object* object :
         std::vector<const Object*>{&attribute, design.net, design.component,
                                    design.first->GetPin("I"), design.first, &design.netlist}) {
        kinds.Visit(*object);
    }
    EXPECT_EQ(kinds.text, "attribute A;signal N;component C;pin I;instance U1;netlist hdlNetlist;");
    PinClasses pins;
    for (const Pin* pin : design.first->GetPinIterator()) {
        pins.Visit(*pin);
    }
    EXPECT_EQ(pins.text, "scalar;bus;bit;");
    Bus bus("D(7:0)");
    SignalClasses signals;
    signals.Visit(*design.net);
    signals.Visit(bus);
    signals.Visit(BusSlice("D(3:0)", &bus));
    signals.Visit(BusIndex("D(1)", &bus));
    signals.Visit(CompoundBus("X,Y"));
    EXPECT_EQ(signals.text, "scalar,signal;bus,signal;slice,signal;bit,signal;compound,signal;");
    AttributeTypes types;
    types.Visit(AttributeString("A", ""));
    types.Visit(AttributeInteger("A", ""));
    types.Visit(AttributeFloat("A", ""));
    types.Visit(AttributeBoolean("A", ""));
    types.Visit(AttributeBit("A", ""));
    types.Visit(AttributeBitVector("A", ""));
    types.Visit(AttributeUser("A", ""));
    EXPECT_EQ(types.text, "String;Integer;Float;Boolean;Bit;Vector;User;");
}

} // namespace
