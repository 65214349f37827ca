// Owned objects that somebody else destroys or takes over: no owner may go on naming them.
#include "Orn_Hdl/Model.h"

#include "Support/Names.h"
#include "Support/Parts.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

namespace {

using namespace Orn_Hdl;
using Support::In;
using Support::Names;
using Support::NamesOf;
using Support::Out;

/// A holder with the attributes A, B and C.
struct Holder : AttributeHolder {
    Holder() {
        for (const char* name : {"A", "B", "C"}) {
            AddAttr(new AttributeString(name, name));
        }
    }
};

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

TEST(Ownership, ADeletedAttributeLeavesItsHolder) {
    Holder holder;
    delete holder.GetAttr("B");
    EXPECT_EQ(holder.GetAttr("B"), nullptr);
    EXPECT_EQ(NamesOf(holder.GetAttrIterator()), Names({"A", "C"}));
    EXPECT_TRUE(holder.HasAttrs());
    delete holder.GetAttr("A");
    delete holder.GetAttr("C");
    EXPECT_FALSE(holder.HasAttrs());
    holder.AddAttr(new AttributeString("A", "again"));
    EXPECT_EQ(holder.GetAttr("A")->GetValueString(), "again");
}

TEST(Ownership, ARenamedAttributeLeavesItsHolder) {
    Holder holder;
    holder.GetAttr("B")->SetName("a-name-that-is-far-longer-than-most");
    delete holder.GetAttr("B");
    EXPECT_EQ(holder.GetAttr("B"), nullptr);
    EXPECT_EQ(NamesOf(holder.GetAttrIterator()), Names({"A", "C"}));
}

TEST(Ownership, AnAttributeOfTheSameNameIsFoundAgain) {
    Holder holder;
    Attribute* const first = holder.GetAttr("B");
    holder.AddAttr(new AttributeString("b", "second"));
    holder.AddAttr(new AttributeString("B", "third"));
    delete holder.GetAttr("B");
    EXPECT_EQ(holder.GetAttr("B")->GetValueString(), "second");
    holder.RemoveAttr(first);
    EXPECT_EQ(holder.GetAttr("B")->GetValueString(), "second");
    delete holder.GetAttr("B");
    EXPECT_EQ(holder.GetAttr("B"), nullptr);
}

TEST(Ownership, AttributesAreRemovedAndDetached) {
    Holder holder;
    Holder other;
    holder.RemoveAttr(nullptr);
    holder.RemoveAttr(other.GetAttr("A"));
    EXPECT_EQ(holder.DetachAttr(nullptr), nullptr);
    EXPECT_EQ(holder.DetachAttr(other.GetAttr("A")), nullptr);
    EXPECT_EQ(NamesOf(other.GetAttrIterator()), Names({"A", "B", "C"}));

    holder.RemoveAttr(holder.GetAttr("A"));
    std::unique_ptr<Attribute> taken = holder.DetachAttr(holder.GetAttr("B"));
    ASSERT_NE(taken, nullptr);
    EXPECT_EQ(NamesOf(holder.GetAttrIterator()), Names({"C"}));
    taken->SetName("D");
    other.AddAttr(taken.release());
    EXPECT_EQ(NamesOf(other.GetAttrIterator()), Names({"A", "B", "C", "D"}));
    ASSERT_NE(other.GetAttr("D"), nullptr);
    EXPECT_EQ(other.GetAttr("D")->GetValueString(), "B");
}

TEST(Ownership, ACopiedAttributeHasNoHolder) {
    Holder holder;
    auto& attribute = static_cast<AttributeString&>(*holder.GetAttr("A"));
    attribute.SetGeneric("SYN");
    attribute.SetSynAttr("ASSIGN");
    {
        AttributeString copy(attribute);
        EXPECT_EQ(copy.GetGeneric(), "SYN");
        EXPECT_EQ(copy.GetSynAttr(), "ASSIGN");
        AttributeString assigned("X", "x");
        assigned = attribute;
        EXPECT_TRUE(assigned == attribute);
        attribute = copy;
    }
    EXPECT_EQ(NamesOf(holder.GetAttrIterator()), Names({"A", "B", "C"}));
    delete &attribute;
    EXPECT_EQ(NamesOf(holder.GetAttrIterator()), Names({"B", "C"}));
}

TEST(Ownership, AnAssignedHolderKeepsItsOwner) {
    Design design;
    Holder holder;
    static_cast<AttributeHolder&>(*design.net) = holder;
    static_cast<AttributeHolder&>(*design.first->GetPin("I")) = *design.net;
    static_cast<AttributeHolder&>(*design.net) = AttributeHolder();
    delete design.net;
    delete design.first->GetPin("I");
    EXPECT_EQ(NamesOf(design.netlist.GetSignalIterator()), Names());
    EXPECT_EQ(NamesOf(design.first->GetPinIterator()), Names({"J(3:0)", "K(1)"}));
}

TEST(Ownership, DeletedObjectsLeaveTheNetlist) {
    Design design;
    delete design.net;
    EXPECT_EQ(design.netlist.GetSignal("N"), nullptr);
    EXPECT_EQ(NamesOf(design.netlist.GetSignalIterator()), Names());
    EXPECT_EQ(design.first->GetPin("I")->GetSignal(), nullptr);
    design.netlist.SortNetlist();
    delete design.first;
    EXPECT_EQ(design.netlist.GetInstance("U1"), nullptr);
    EXPECT_EQ(NamesOf(design.netlist.GetInstanceIterator()), Names({"U2"}));
    delete design.component;
    EXPECT_EQ(design.netlist.GetComponent("C"), nullptr);
    EXPECT_EQ(design.second->GetComponent(), nullptr);
    delete design.second;
    EXPECT_FALSE(design.netlist.IsNameUsed("U2"));
    EXPECT_FALSE(design.netlist.IsNameUsed("C"));
}

TEST(Ownership, AComponentMayBeDeletedAfterItsInstances) {
    Design design;
    delete design.second;
    delete design.first;
    delete design.component;
    EXPECT_EQ(NamesOf(design.netlist.GetComponentIterator()), Names());
    EXPECT_EQ(NamesOf(design.net->GetPinIterator()), Names());
}

TEST(Ownership, RenamedObjectsLeaveTheNetlist) {
    Design design;
    auto* const bus = new Bus("D(7:0)");
    design.netlist.Add(bus);
    bus->SetName("E(7:0)");
    design.net->SetName("M");
    design.component->SetName("a-name-that-is-far-longer-than-most");
    design.component->AddAttr(new AttributeString("A", ""));
    delete bus;
    delete design.net;
    delete design.component;
    EXPECT_EQ(design.netlist.GetParentBus("D"), nullptr);
    EXPECT_FALSE(design.netlist.IsNameUsed("N"));
    EXPECT_FALSE(design.netlist.IsNameUsed("C"));
}

TEST(Ownership, DeletedSignalsOfEveryClassLeaveTheNetlist) {
    Netlist netlist;
    auto* const bus = new Bus("D(7:0)");
    auto* const slice = new BusSlice("D(3:0)", bus);
    auto* const bit = new BusIndex("D(5)", bus);
    auto* const compound = new CompoundBus("D(3:0),D(5)");
    compound->AddBusMember(slice);
    compound->AddBusMember(bit);
    for (Signal* signal : std::vector<Signal*>{bus, slice, bit, compound}) {
        netlist.Add(signal);
    }
    delete slice;
    EXPECT_EQ(NamesOf(netlist.GetSignalIterator()), Names({"D(7:0)", "D(5)", "D(3:0),D(5)"}));
    EXPECT_EQ(NamesOf(compound->GetBusMemberIterator()), Names({"D(5)"}));
    delete bus;
    EXPECT_EQ(netlist.GetParentBus("D"), nullptr);
    EXPECT_EQ(netlist.GetSignal("D(7:0)"), nullptr);
    EXPECT_EQ(bit->GetParentBus(), nullptr);
    delete compound;
    delete bit;
    EXPECT_EQ(NamesOf(netlist.GetSignalIterator()), Names());
    netlist.Add(new Bus("D(1:0)"));
    EXPECT_NE(netlist.GetParentBus("D"), nullptr);
}

TEST(Ownership, APortWithADummySignalMayBeDeleted) {
    Design design;
    auto* const port = new ScalarSignal("Y");
    port->SetPortPolarity(Out);
    design.netlist.Add(port);
    port->Connect(design.first->GetPin("K(1)"));
    port->Connect(design.second->GetPin("J(3:0)"));
    design.netlist.CreateVhdlDummySignals();
    ASSERT_NE(design.netlist.GetSignal("Y_DUMMY"), nullptr);
    delete port;
    design.netlist.CreateVhdlDummySignals();
    delete design.netlist.GetSignal("Y_DUMMY");
    design.netlist.CreateVerilogDummySignals();
    EXPECT_EQ(NamesOf(design.netlist.GetSignalIterator()), Names({"N"}));
}

TEST(Ownership, DeletedPinsLeaveTheirComponentOrInstance) {
    Design design;
    delete design.component->GetPin("J(3:0)");
    EXPECT_EQ(NamesOf(design.component->GetPinIterator()), Names({"I", "K(1)"}));
    for (const char* name : {"I", "K(1)", "J(3:0)"}) {
        delete design.first->GetPin(name);
        EXPECT_EQ(design.first->GetPin(name), nullptr);
    }
    EXPECT_EQ(NamesOf(design.first->GetPinIterator()), Names());
    EXPECT_EQ(NamesOf(design.net->GetPinIterator()), Names({"I"}));
    delete design.second->GetPin("I");
    EXPECT_EQ(NamesOf(design.net->GetPinIterator()), Names());
    design.netlist.SortNetlist();
    EXPECT_EQ(NamesOf(design.second->GetPinIterator()), Names({"J(3:0)", "K(1)"}));
    EXPECT_EQ(NamesOf(Instance("U3", design.component).GetPinIterator()), Names({"I", "K(1)"}));
}

TEST(Ownership, DeletedPinsOfLongListsAreNotFound) {
    Component component("C");
    for (int i = 0; i < 40; ++i) {
        component.AddPin(("P" + std::to_string(i)).c_str(), In, "");
    }
    Instance instance("U", &component);
    ASSERT_NE(component.GetPin("P39"), nullptr);
    ASSERT_NE(instance.GetPin("P39"), nullptr);
    delete component.GetPin("P39");
    delete instance.GetPin("P0");
    EXPECT_EQ(component.GetPin("P39"), nullptr);
    EXPECT_EQ(instance.GetPin("P0"), nullptr);
    EXPECT_EQ(instance.GetPin("P39")->GetName(), "P39");
    component.AddPin("P39", In, "");
    EXPECT_NE(component.GetPin("P39"), nullptr);
}

TEST(Ownership, PinsOfInstancesKeepTheirClass) {
    Design design;
    EXPECT_NE(dynamic_cast<ScalarPin*>(design.first->GetPin("I")), nullptr);
    EXPECT_NE(dynamic_cast<BusPin*>(design.first->GetPin("J(3:0)")), nullptr);
    EXPECT_NE(dynamic_cast<BusIndexPin*>(design.first->GetPin("K(1)")), nullptr);
    const std::unique_ptr<Pin> clone(design.first->GetPin("J(3:0)")->ClonePin());
    EXPECT_EQ(clone->GetPinType(), PinTypeBus);
}

TEST(Ownership, APinIsRemovedWithThoseOfItsInstances) {
    Design design;
    Netlist other;
    auto* const foreign = new Instance("V", design.component);
    other.Add(foreign);
    design.netlist.RemovePin(nullptr, nullptr);
    design.netlist.RemovePin(design.component, nullptr);
    design.netlist.RemovePin(design.component, design.first->GetPin("I"));
    ASSERT_NE(design.first->GetPin("I"), nullptr);
    design.netlist.RemovePin(design.component, design.component->GetPin("I"));
    EXPECT_EQ(NamesOf(design.component->GetPinIterator()), Names({"J(3:0)", "K(1)"}));
    EXPECT_EQ(NamesOf(design.first->GetPinIterator()), Names({"J(3:0)", "K(1)"}));
    EXPECT_EQ(NamesOf(design.second->GetPinIterator()), Names({"J(3:0)", "K(1)"}));
    EXPECT_EQ(NamesOf(design.net->GetPinIterator()), Names());
    EXPECT_NE(foreign->GetPin("I"), nullptr);

    design.component->RemovePin(design.first->GetPin("K(1)"));
    design.component->RemovePin(nullptr);
    design.first->RemovePin(design.second->GetPin("K(1)"));
    design.first->RemovePin(design.first->GetPin("K(1)"));
    EXPECT_EQ(NamesOf(design.first->GetPinIterator()), Names({"J(3:0)"}));
    EXPECT_EQ(NamesOf(design.second->GetPinIterator()), Names({"J(3:0)", "K(1)"}));
    EXPECT_EQ(NamesOf(design.component->GetPinIterator()), Names({"J(3:0)", "K(1)"}));
}

TEST(Ownership, ADetachedObjectIsTheCallers) {
    Design design;
    const std::unique_ptr<Signal> signal = design.netlist.DetachSignal(design.net);
    EXPECT_EQ(signal.get(), design.net);
    EXPECT_EQ(design.netlist.GetSignal("N"), nullptr);
    EXPECT_EQ(design.first->GetPin("I")->GetSignal(), signal.get());
    std::unique_ptr<Component> component = design.netlist.DetachComponent(design.component);
    EXPECT_EQ(design.first->GetComponent(), component.get());
    std::unique_ptr<Instance> instance = design.netlist.DetachInstance(design.first);
    EXPECT_EQ(NamesOf(design.netlist.GetInstanceIterator()), Names({"U2"}));
    EXPECT_EQ(design.netlist.DetachInstance(instance.get()), nullptr);
    EXPECT_EQ(design.netlist.DetachSignal(nullptr), nullptr);
    EXPECT_EQ(design.netlist.DetachComponent(component.get()), nullptr);

    Netlist other;
    instance->SetName("V");
    other.Add(instance.release());
    EXPECT_EQ(other.GetInstance("V"), design.first);
    EXPECT_EQ(other.GetInstance("U1"), nullptr);
    component.reset();
    EXPECT_EQ(design.second->GetComponent(), nullptr);
    EXPECT_EQ(NamesOf(signal->GetPinIterator()), Names({"I", "I"}));
}

TEST(Ownership, ADetachedBusIsFoundNoMore) {
    Netlist netlist;
    auto* const bus = new Bus("D(7:0)");
    auto* const slice = new BusSlice("D(3:0)", bus);
    netlist.Add(bus);
    netlist.Add(slice);
    std::unique_ptr<Signal> taken = netlist.DetachSignal(bus);
    EXPECT_EQ(netlist.GetParentBus("D"), nullptr);
    EXPECT_EQ(slice->GetParentBus(), bus);
    netlist.Add(taken.release());
    EXPECT_EQ(netlist.GetParentBus("D"), bus);
}

/// Deletes another object when it is destroyed.
struct Greedy : Instance {
    Greedy(const char* name, Instance* other) : Instance(name, nullptr), other_(other) {}
    ~Greedy() override { delete other_; }

private:
    Instance* other_;
};

TEST(Ownership, AnObjectOfADyingNetlistMayDeleteAnother) {
    Netlist netlist;
    auto* const last = new Instance("U1", nullptr);
    netlist.Add(last);
    netlist.Add(new Greedy("U2", last));
    netlist.Add(new Instance("U3", nullptr));
}

TEST(Ownership, NothingIsAmbiguousAboutALiteralNull) {
    Design design;
    design.netlist.Add(nullptr);
    design.netlist.Remove(nullptr);
    PtrArray<Instance*> instances;
    instances.Add(design.first);
    design.netlist.GetInstances(nullptr, instances);
    EXPECT_TRUE(instances.IsEmpty());
    EXPECT_EQ(Netlist::GetLongestAttrName(nullptr), 0);
    EXPECT_EQ(design.netlist.GetSignal(nullptr), nullptr);
}

TEST(Ownership, ANullInAListHasNoName) {
    ScalarSignal net("NET");
    net.SetPortPolarity(In);
    PtrArray<Signal*> signals;
    signals.Add(nullptr);
    signals.Add(&net);
    EXPECT_EQ(Netlist::GetLongestSignalName(Iterator<Signal*>(&signals)), 3);
    EXPECT_EQ(Netlist::GetLongestPortName(Iterator<Signal*>(&signals)), 3);
    ScalarPin pin("PIN2", In);
    PtrArray<Pin*> pins;
    pins.Add(nullptr);
    pins.Add(&pin);
    EXPECT_EQ(Netlist::GetLongestPinName(Iterator<Pin*>(&pins)), 4);
}

TEST(Ownership, AnIteratorMeetsTheFirstAliasThatIsAddedLater) {
    ScalarSignal first("A");
    ScalarSignal second("B");
    Iterator<Signal*> aliases = first.GetSignalIterator();
    EXPECT_TRUE(aliases.IsAtEnd());
    first.Connect(&second);
    EXPECT_EQ(aliases.GetCurrent(), &second);
}

struct Nameless : Object {
    void AcceptObject(ObjectVisitor& /*visitor*/) override {}
};

TEST(Ownership, AnObjectOfTheCallersOwnKindIsNameless) {
    const Nameless object;
    EXPECT_EQ(object.GetName(), "");
    EXPECT_EQ(object.GetComment(), "");
}

} // namespace
