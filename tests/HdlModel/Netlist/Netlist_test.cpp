#include "Orn_Hdl/Model.h"

#include "Support/Names.h"
#include "Support/Parts.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

namespace {

using namespace Orn_Hdl;
using Support::Bi;
using Support::In;
using Support::Names;
using Support::NamesOf;
using Support::Out;

template <class T> T* Added(Netlist& netlist, T* object) {
    netlist.Add(object);
    return object;
}

TEST(Netlist, HasADefaultName) {
    EXPECT_EQ(Netlist(nullptr).GetName(), "hdlNetlist");
    EXPECT_EQ(Netlist().GetName(), "hdlNetlist");
    EXPECT_EQ(Netlist("").GetName(), "");
    EXPECT_EQ(Netlist("top").GetName(), "top");
}

TEST(Netlist, StoresItsNameAsItStands) {
    Netlist netlist("top");
    netlist.SetName("top[3-0]<x>");
    EXPECT_EQ(netlist.GetName(), "top[3-0]<x>");
    static_cast<Object&>(netlist).SetName(nullptr);
    EXPECT_EQ(netlist.GetName(), "");
}

TEST(Netlist, RemembersItsSourceFile) {
    Netlist netlist;
    EXPECT_EQ(netlist.GetSourceFileName(), "");
    netlist.SetSourceFileName("dir/top[1].cmd");
    EXPECT_EQ(netlist.GetSourceFileName(), "dir/top[1].cmd");
    netlist.SetSourceFileName(nullptr);
    EXPECT_EQ(netlist.GetSourceFileName(), "");
}

TEST(Netlist, KeepsTheOrderOfAddition) {
    Netlist netlist;
    for (const char* name : {"b", "c", "a"}) {
        netlist.Add(new ScalarSignal(name));
        netlist.Add(new Component(name));
        netlist.Add(new Instance(name, nullptr));
    }
    EXPECT_EQ(NamesOf(netlist.GetSignalIterator()), (Names{"b", "c", "a"}));
    EXPECT_EQ(NamesOf(netlist.GetComponentIterator()), (Names{"b", "c", "a"}));
    EXPECT_EQ(NamesOf(netlist.GetInstanceIterator()), (Names{"b", "c", "a"}));
}

TEST(Netlist, FindsByNormalisedNameIgnoringCase) {
    Netlist netlist;
    Signal* signal = Added(netlist, new Bus("D(3:0)"));
    Component* component = Added(netlist, new Component("C(1)"));
    Instance* instance = Added(netlist, new Instance("U(1)", component));
    for (const char* name : {"D(3:0)", "d[3-0]", "D<3:0>"}) {
        EXPECT_EQ(netlist.GetSignal(name), signal) << name;
    }
    EXPECT_EQ(netlist.GetComponent("c[1]"), component);
    EXPECT_EQ(netlist.GetInstance("u<1>"), instance);
    EXPECT_EQ(netlist.GetSignal("D"), nullptr);
    EXPECT_EQ(netlist.GetSignal(nullptr), nullptr);
    EXPECT_EQ(netlist.GetComponent(nullptr), nullptr);
    EXPECT_EQ(netlist.GetInstance("C(1)"), nullptr);
    Signal* empty = Added(netlist, new ScalarSignal(""));
    EXPECT_EQ(netlist.GetSignal(nullptr), empty);
}

TEST(Netlist, FindsLongNames) {
    Netlist netlist;
    const std::string name(100000, 'n');
    Signal* signal = Added(netlist, new ScalarSignal((name + "[1]").c_str()));
    EXPECT_EQ(netlist.GetSignal((std::string(100000, 'N') + "<1>").c_str()), signal);
    EXPECT_EQ(netlist.GetSignal(name.c_str()), nullptr);
}

TEST(Netlist, FindsTheBusOfABaseName) {
    Netlist netlist;
    Bus* bus = Added(netlist, new Bus("D(7:0)"));
    netlist.Add(new ScalarSignal("N"));
    for (const char* name : {"D", "d(3)", "D(7:0)", "D[3]", "D<9:0>", "D(x)"}) {
        EXPECT_EQ(netlist.GetParentBus(name), bus) << name;
    }
    for (const char* name : {"N", "E", "", "D(", "D(1),D(2)", static_cast<const char*>(nullptr)}) {
        EXPECT_EQ(netlist.GetParentBus(name), nullptr);
    }
}

TEST(Netlist, IgnoresNulls) {
    Netlist netlist;
    netlist.Add(static_cast<Signal*>(nullptr));
    netlist.Add(static_cast<Instance*>(nullptr));
    netlist.Add(static_cast<Component*>(nullptr));
    netlist.Remove(static_cast<Signal*>(nullptr));
    netlist.Remove(static_cast<Instance*>(nullptr));
    netlist.Remove(static_cast<Component*>(nullptr));
    EXPECT_TRUE(netlist.GetSignalIterator().IsAtEnd());
    EXPECT_TRUE(netlist.GetInstanceIterator().IsAtEnd());
    EXPECT_TRUE(netlist.GetComponentIterator().IsAtEnd());
}

TEST(Netlist, IgnoresWhatItHolds) {
    Netlist netlist;
    Signal* signal = Added(netlist, new ScalarSignal("N"));
    Component* component = Added(netlist, new Component("C"));
    Instance* instance = Added(netlist, new Instance("U", component));
    netlist.Add(signal);
    netlist.Add(component);
    netlist.Add(instance);
    EXPECT_EQ(NamesOf(netlist.GetSignalIterator()), Names{"N"});
    EXPECT_EQ(NamesOf(netlist.GetComponentIterator()), Names{"C"});
    EXPECT_EQ(NamesOf(netlist.GetInstanceIterator()), Names{"U"});
}

TEST(Netlist, IgnoresWhatAnotherNetlistOwns) {
    Netlist owner;
    Netlist other;
    Signal* signal = Added(owner, new ScalarSignal("N"));
    other.Add(signal);
    EXPECT_TRUE(other.GetSignalIterator().IsAtEnd());
    EXPECT_EQ(other.GetSignal("N"), nullptr);
    other.Remove(signal);
    EXPECT_EQ(owner.GetSignal("N"), signal);
}

TEST(Netlist, OfTwoObjectsOfOneNameFindsTheLaterAndHoldsBoth) {
    Netlist netlist;
    Signal* first = Added(netlist, new ScalarSignal("n"));
    Signal* second = Added(netlist, new ScalarSignal("N"));
    EXPECT_EQ(NamesOf(netlist.GetSignalIterator()), (Names{"n", "N"}));
    EXPECT_EQ(netlist.GetSignal("n"), second);
    netlist.Remove(first);
    EXPECT_EQ(netlist.GetSignal("n"), second) << "the entry belongs to the second";
    netlist.Remove(second);
    EXPECT_EQ(netlist.GetSignal("n"), nullptr);
}

TEST(Netlist, OfTwoBusesOfOneBaseNameFindsTheLater) {
    Netlist netlist;
    Bus* first = Added(netlist, new Bus("D(7:0)"));
    Bus* second = Added(netlist, new Bus("d(15:0)"));
    EXPECT_EQ(netlist.GetParentBus("D"), second);
    netlist.Remove(first);
    EXPECT_EQ(netlist.GetParentBus("D"), second);
    netlist.Remove(second);
    EXPECT_EQ(netlist.GetParentBus("D"), nullptr);
}

TEST(Netlist, OfTwoInstancesOrComponentsOfOneNameFindsTheLater) {
    Netlist netlist;
    Component* firstComponent = Added(netlist, new Component("C"));
    Component* secondComponent = Added(netlist, new Component("c"));
    Instance* firstInstance = Added(netlist, new Instance("U", firstComponent));
    Instance* secondInstance = Added(netlist, new Instance("u", firstComponent));
    EXPECT_EQ(netlist.GetComponent("C"), secondComponent);
    EXPECT_EQ(netlist.GetInstance("U"), secondInstance);
    netlist.Remove(firstComponent);
    netlist.Remove(firstInstance);
    EXPECT_EQ(netlist.GetComponent("C"), secondComponent);
    EXPECT_EQ(netlist.GetInstance("U"), secondInstance);
}

TEST(NetlistRemove, OfWhatItDoesNotHoldDoesNothing) {
    Netlist netlist;
    Signal* held = Added(netlist, new ScalarSignal("N"));
    ScalarSignal signal("N");
    Component component("C");
    Instance instance("U", &component);
    component.AddPin("A", In, "");
    ScalarPin pin("A", In);
    signal.Connect(&pin);
    netlist.Remove(&signal);
    netlist.Remove(&component);
    netlist.Remove(&instance);
    EXPECT_EQ(netlist.GetSignal("N"), held);
    EXPECT_EQ(pin.GetSignal(), &signal);
    EXPECT_EQ(instance.GetComponent(), &component);
}

TEST(NetlistRemove, OfASignalTakesItOutOfEverything) {
    Netlist netlist;
    Component component("C");
    component.AddPin("A", In, "");
    component.AddPin("B", In, "");
    component.AddPin("C", In, "");
    Instance* instance = Added(netlist, new Instance("U", &component));
    Signal* doomed = Added(netlist, new ScalarSignal("N"));
    Signal* other = Added(netlist, new ScalarSignal("M"));
    CompoundBus* compound = Added(netlist, new CompoundBus("N,M,N"));
    compound->AddBusMember(doomed);
    compound->AddBusMember(other);
    compound->AddBusMember(doomed);
    other->Connect(doomed);
    doomed->Connect(instance->GetPin("A"));
    instance->GetPin("B")->Connect(doomed);
    doomed->Connect(instance->GetPin("C"));
    other->Connect(instance->GetPin("C"));
    netlist.Remove(doomed);
    EXPECT_EQ(instance->GetPin("A")->GetSignal(), nullptr);
    EXPECT_EQ(instance->GetPin("B")->GetSignal(), nullptr) << "its pin list did not show it";
    EXPECT_EQ(instance->GetPin("C")->GetSignal(), other);
    EXPECT_EQ(NamesOf(other->GetSignalIterator()), Names());
    EXPECT_EQ(NamesOf(compound->GetBusMemberIterator()), Names{"M"});
    EXPECT_EQ(NamesOf(netlist.GetSignalIterator()), (Names{"M", "N,M,N"}));
    EXPECT_EQ(netlist.GetSignal("N"), nullptr);
}

TEST(NetlistRemove, OfABusLeavesItsSlicesAndBitsWithoutAParent) {
    Netlist netlist;
    Bus* bus = Added(netlist, new Bus("D(7:0)"));
    BusSlice* slice = Added(netlist, new BusSlice("D(3:0)", bus));
    BusIndex* bit = Added(netlist, new BusIndex("D(5)", bus));
    bus->SetPortPolarity(Out);
    netlist.Remove(bus);
    EXPECT_EQ(slice->GetParentBus(), nullptr);
    EXPECT_EQ(bit->GetParentBus(), nullptr);
    EXPECT_EQ(slice->GetPortPolarity(), Polarity());
    EXPECT_FALSE(bit->IsPort());
    EXPECT_TRUE(slice->IsSameDirectionAsParent());
    EXPECT_EQ(netlist.GetParentBus("D"), nullptr);
    EXPECT_EQ(NamesOf(netlist.GetSignalIterator()), (Names{"D(3:0)", "D(5)"}));
}

TEST(NetlistRemove, OfASliceLeavesTheBus) {
    Netlist netlist;
    Bus* bus = Added(netlist, new Bus("D(7:0)"));
    BusSlice* slice = Added(netlist, new BusSlice("D(3:0)", bus));
    netlist.Add(new BusIndex("D(5)", bus));
    netlist.Remove(slice);
    EXPECT_EQ(NamesOf(bus->GetBusSliceIterator()), Names{"D(5)"});
}

TEST(NetlistRemove, OfAnInstanceTakesItsPinsOutOfEverySignal) {
    Netlist netlist;
    Component component("C");
    component.AddPin("A", In, "");
    component.AddPin("B", In, "");
    Signal* first = Added(netlist, new ScalarSignal("N1"));
    Signal* second = Added(netlist, new ScalarSignal("N2"));
    Instance* doomed = Added(netlist, new Instance("U1", &component));
    Instance* other = Added(netlist, new Instance("U2", &component));
    first->Connect(doomed->GetPin("A"));
    second->Connect(doomed->GetPin("A"));
    first->Connect(doomed->GetPin("B"));
    doomed->GetPin("B")->Disconnect();
    first->Connect(other->GetPin("B"));
    netlist.Remove(doomed);
    EXPECT_EQ(NamesOf(first->GetPinIterator()), Names{"B"});
    EXPECT_EQ(first->GetPinIterator().GetCurrent(), other->GetPin("B"));
    EXPECT_EQ(NamesOf(second->GetPinIterator()), Names());
    EXPECT_EQ(netlist.GetInstance("U1"), nullptr);
    EXPECT_EQ(NamesOf(netlist.GetInstanceIterator()), Names{"U2"});
}

TEST(NetlistRemove, OfAComponentLeavesItsInstancesWithTheirPins) {
    Netlist netlist;
    Component* component = Added(netlist, new Component("C"));
    component->AddPin("A", In, "");
    Instance* instance = Added(netlist, new Instance("U", component));
    Signal* signal = Added(netlist, new ScalarSignal("N"));
    signal->Connect(instance->GetPin("A"));
    netlist.Remove(component);
    EXPECT_EQ(instance->GetComponent(), nullptr);
    EXPECT_EQ(instance->GetComponentName(), "");
    EXPECT_EQ(instance->GetPin("A")->GetSignal(), signal);
    EXPECT_EQ(netlist.GetComponent("C"), nullptr);
    EXPECT_TRUE(netlist.GetComponentIterator().IsAtEnd());
    PtrArray<Instance*> instances;
    netlist.GetInstances("C", instances);
    EXPECT_TRUE(instances.IsEmpty());
}

TEST(NetlistRemove, OfTheInstanceAddedLastLeavesTheOthers) {
    Netlist netlist;
    Instance* first = Added(netlist, new Instance("U1", nullptr));
    Instance* last = Added(netlist, new Instance("U2", nullptr));
    EXPECT_EQ(netlist.GetInstance("U2"), last);
    netlist.Remove(last);
    EXPECT_EQ(netlist.GetInstance("U2"), nullptr);
    EXPECT_EQ(netlist.GetInstance("U1"), first);
    last = Added(netlist, new Instance("U2", nullptr));
    delete last;
    EXPECT_EQ(netlist.GetInstance("U2"), nullptr);
    EXPECT_EQ(netlist.GetInstance("u1"), first);
}

TEST(NetlistRemove, MakesRoomForANewObjectOfTheName) {
    Netlist netlist;
    for (int round = 0; round < 3; ++round) {
        Bus* bus = Added(netlist, new Bus("D(7:0)"));
        Component* component = Added(netlist, new Component("C"));
        Instance* instance = Added(netlist, new Instance("U", component));
        EXPECT_EQ(netlist.GetSignal("D(7:0)"), bus);
        EXPECT_EQ(netlist.GetParentBus("D"), bus);
        EXPECT_EQ(netlist.GetComponent("C"), component);
        EXPECT_EQ(netlist.GetInstance("U"), instance);
        netlist.Remove(component);
        netlist.Remove(instance);
        netlist.Remove(bus);
    }
    EXPECT_TRUE(netlist.GetSignalIterator().IsAtEnd());
}

TEST(NetlistRemove, OfARenamedObjectLeavesNoTrace) {
    Netlist netlist;
    Signal* signal = Added(netlist, new Bus("D(7:0)"));
    Component* component = Added(netlist, new Component("C"));
    Instance* instance = Added(netlist, new Instance("U", component));
    signal->SetName("E(7:0)");
    component->SetName("CC");
    instance->SetName("UU");
    netlist.Remove(signal);
    netlist.Remove(component);
    netlist.Remove(instance);
    for (const char* name : {"D(7:0)", "E(7:0)", "C", "CC", "U", "UU"}) {
        EXPECT_EQ(netlist.GetSignal(name), nullptr) << name;
        EXPECT_EQ(netlist.GetComponent(name), nullptr) << name;
        EXPECT_EQ(netlist.GetInstance(name), nullptr) << name;
    }
    EXPECT_EQ(netlist.GetParentBus("D"), nullptr);
    EXPECT_EQ(netlist.GetParentBus("E"), nullptr);
}

TEST(NetlistGetInstances, ReplacesTheListByTheInstancesOfAComponent) {
    Netlist netlist;
    Component* and2 = Added(netlist, new Component("AND2"));
    Component* or2 = Added(netlist, new Component("OR2"));
    netlist.Add(new Instance("U3", and2));
    netlist.Add(new Instance("U2", or2));
    netlist.Add(new Instance("U1", and2));
    netlist.Add(new Instance("U0", nullptr));
    PtrArray<Instance*> instances;
    netlist.GetInstances(and2, instances);
    EXPECT_EQ(NamesOf(instances), (Names{"U3", "U1"}));
    netlist.GetInstances("or2", instances);
    EXPECT_EQ(NamesOf(instances), Names{"U2"});
    netlist.GetInstances("none", instances);
    EXPECT_TRUE(instances.IsEmpty());
    netlist.GetInstances(and2, instances);
    netlist.GetInstances(static_cast<const Component*>(nullptr), instances);
    EXPECT_TRUE(instances.IsEmpty()) << "an instance without a component is nobody's";
    netlist.GetInstances(static_cast<const char*>(nullptr), instances);
    EXPECT_TRUE(instances.IsEmpty());
}

TEST(SortNetlist, SortsSignalsByPolarityThenName) {
    Netlist netlist;
    for (const auto& [name, polarity] :
         std::vector<std::pair<const char*, Polarity>>{{"Y10", Out},
                                                       {"Y2", Out},
                                                       {"n1", Polarity()},
                                                       {"B", Bi},
                                                       {"A", In},
                                                       {"N0", Polarity()}}) {
        Added(netlist, new ScalarSignal(name))->SetPortPolarity(polarity);
    }
    Bus* bus = Added(netlist, new Bus("D(3:0)"));
    bus->SetPortPolarity(In);
    netlist.Add(new BusIndex("D(2)", bus));
    netlist.SortNetlist();
    EXPECT_EQ(NamesOf(netlist.GetSignalIterator()),
              (Names{"N0", "n1", "A", "D(2)", "D(3:0)", "Y2", "Y10", "B"}));
}

TEST(SortNetlist, SortsComponentsInstancesAndTheirPins) {
    Netlist netlist;
    Component* component = Added(netlist, new Component("C10"));
    component->AddPin("O", Out, "");
    component->AddPin("I10", In, "");
    component->AddPin("I9", In, "");
    netlist.Add(new Component("C9"));
    for (const char* name : {"U10", "U2", "U1"}) {
        netlist.Add(new Instance(name, component));
    }
    netlist.SortNetlist();
    EXPECT_EQ(NamesOf(netlist.GetComponentIterator()), (Names{"C9", "C10"}));
    EXPECT_EQ(NamesOf(netlist.GetInstanceIterator()), (Names{"U1", "U2", "U10"}));
    for (Instance* instance : netlist.GetInstanceIterator()) {
        EXPECT_EQ(NamesOf(instance->GetPinIterator()), (Names{"I9", "I10", "O"}));
    }
    EXPECT_EQ(NamesOf(component->GetPinIterator()), (Names{"O", "I10", "I9"}));
}

TEST(SortNetlist, LeavesEverythingFindableAndRemovable) {
    Netlist netlist;
    for (int i = 0; i < 300; ++i) {
        const std::string number = std::to_string(i * 37 % 300);
        netlist.Add(new ScalarSignal(("N" + number).c_str()));
        netlist.Add(new Component(("C" + number).c_str()));
        netlist.Add(new Instance(("U" + number).c_str(), nullptr));
    }
    netlist.SortNetlist();
    for (int i = 0; i < 300; ++i) {
        const std::string number = std::to_string(i);
        netlist.Remove(netlist.GetSignal("N" + number));
        netlist.Remove(netlist.GetComponent("C" + number));
        netlist.Remove(netlist.GetInstance("U" + number));
        ASSERT_EQ(netlist.GetSignal("N" + number), nullptr);
        netlist.SortNetlist();
    }
    EXPECT_TRUE(netlist.GetSignalIterator().IsAtEnd());
    EXPECT_TRUE(netlist.GetComponentIterator().IsAtEnd());
    EXPECT_TRUE(netlist.GetInstanceIterator().IsAtEnd());
}

TEST(ConnectOpenPinToDummy, GivesEachOpenInputASignalOfItsOwn) {
    Netlist netlist;
    Component* component = Added(netlist, new Component("C"));
    component->AddPin("A", In, "");
    component->AddPin("D[3:+0]", In, "");
    component->AddPin("E[2]", In, "");
    component->AddPin("W", In, "");
    component->AddPin("O", Out, "");
    component->AddPin("B", Bi, "");
    Instance* instance = Added(netlist, new Instance("U1", component));
    Signal* wired = Added(netlist, new ScalarSignal("N"));
    wired->Connect(instance->GetPin("W"));
    netlist.ConnectOpenPinToDummy();
    EXPECT_EQ(NamesOf(netlist.GetSignalIterator()),
              (Names{"N", "U1_A_openSignal", "U1_D_openSignal(3:+0)"}));
    Signal* scalar = netlist.GetSignal("U1_A_openSignal");
    Signal* bus = netlist.GetSignal("U1_D_openSignal(3:+0)");
    EXPECT_EQ(scalar->GetSignalType(), 50);
    EXPECT_EQ(bus->GetSignalType(), 51);
    EXPECT_EQ(netlist.GetParentBus("U1_D_openSignal"), bus);
    EXPECT_EQ(instance->GetPin("A")->GetSignal(), scalar);
    EXPECT_EQ(instance->GetPin("D(3:+0)")->GetSignal(), bus);
    EXPECT_EQ(instance->GetPin("E(2)")->GetSignal(), nullptr) << "a bit gets nothing";
    EXPECT_EQ(instance->GetPin("W")->GetSignal(), wired);
    EXPECT_EQ(instance->GetPin("O")->GetSignal(), nullptr);
    EXPECT_EQ(instance->GetPin("B")->GetSignal(), nullptr);
    EXPECT_TRUE(scalar->GetPinIterator().IsAtEnd()) << "the dummy has no listed pins";
    EXPECT_TRUE(bus->GetPinIterator().IsAtEnd());
}

TEST(ConnectOpenPinToDummy, UsesASignalThatHasTheName) {
    Netlist netlist;
    Component* component = Added(netlist, new Component("C"));
    component->AddPin("A", In, "");
    Signal* present = Added(netlist, new ScalarSignal("u1_a_OPENSIGNAL"));
    Instance* instance = Added(netlist, new Instance("U1", component));
    netlist.ConnectOpenPinToDummy();
    EXPECT_EQ(instance->GetPin("A")->GetSignal(), present);
    netlist.ConnectOpenPinToDummy();
    EXPECT_EQ(NamesOf(netlist.GetSignalIterator()), Names{"u1_a_OPENSIGNAL"});
}

TEST(ConnectOpenPinToDummy, RemovingTheDummyOpensThePinAgain) {
    Netlist netlist;
    Component* component = Added(netlist, new Component("C"));
    component->AddPin("A", In, "");
    Instance* instance = Added(netlist, new Instance("U1", component));
    netlist.ConnectOpenPinToDummy();
    netlist.Remove(netlist.GetSignal("U1_A_openSignal"));
    EXPECT_EQ(instance->GetPin("A")->GetSignal(), nullptr);
    netlist.ConnectOpenPinToDummy();
    netlist.Remove(instance);
    netlist.Remove(netlist.GetSignal("U1_A_openSignal"));
    EXPECT_TRUE(netlist.GetSignalIterator().IsAtEnd());
}

TEST(SetBoxTypeAttribute, MarksComponentsOfTheLevel) {
    Netlist netlist;
    Component* marked = Added(netlist, new Component("C1"));
    marked->AddAttr(new AttributeString("LEVEL", "halvex"));
    Component* other = Added(netlist, new Component("C2"));
    other->AddAttr(new AttributeString("Level", "HALVEXX"));
    Component* none = Added(netlist, new Component("C3"));
    Component* user = Added(netlist, new Component("C4"));
    user->AddAttr(new AttributeUser("level", "Halvex"));
    netlist.SetBoxTypeAttribute();
    for (const Component* component : {marked, user}) {
        const Attribute* boxType = component->GetAttr("BOX_TYPE");
        ASSERT_NE(boxType, nullptr);
        EXPECT_EQ(boxType->GetName(), "BOX_TYPE");
        EXPECT_EQ(boxType->GetValueString(), "BLACK_BOX");
        EXPECT_EQ(boxType->GetValueTypeName(), "String");
        EXPECT_EQ(boxType->GetSynAttr(), "ASSIGN");
        EXPECT_EQ(boxType->GetGeneric(), "NONE");
    }
    EXPECT_EQ(other->GetAttr("BOX_TYPE"), nullptr);
    EXPECT_EQ(none->GetAttr("BOX_TYPE"), nullptr);
    netlist.SetBoxTypeAttribute();
    EXPECT_EQ(NamesOf(marked->GetAttrIterator()), (Names{"LEVEL", "BOX_TYPE"}));
}

TEST(SetBoxTypeAttribute, LeavesAComponentThatHasABoxType) {
    Netlist netlist;
    Component* component = Added(netlist, new Component("C"));
    component->AddAttr(new AttributeString("Level", "HALVEX"));
    component->AddAttr(new AttributeInteger("box_type", "7"));
    netlist.SetBoxTypeAttribute();
    EXPECT_EQ(NamesOf(component->GetAttrIterator()), (Names{"Level", "box_type"}));
    EXPECT_EQ(component->GetAttr("BOX_TYPE")->GetValueString(), "7");
}

TEST(LongestName, OfPins) {
    Component component("C");
    component.AddPin("A", In, "");
    component.AddPin("DATA(15:0)", Out, "");
    component.AddPin("BC", In, "");
    Iterator<Pin*> pins = component.GetPinIterator();
    EXPECT_EQ(Netlist::GetLongestPinName(pins), 10);
    EXPECT_EQ(pins.GetCurrent()->GetName(), "A") << "the iterator has not moved";
    EXPECT_EQ(Netlist::GetLongestPinName(Iterator<Pin*>()), 0);
}

TEST(LongestName, OfPortsAndOfSignals) {
    Netlist netlist;
    Bus* bus = Added(netlist, new Bus("DATA(7:0)"));
    netlist.Add(new BusSlice("DATA(000003:000000)", bus));
    Added(netlist, new ScalarSignal("CLK"))->SetPortPolarity(In);
    netlist.Add(new CompoundBus("CLK,DATA(000003:000000)"));
    BusIndex* bit = Added(netlist, new BusIndex("DATA(00001)", bus));
    const Iterator<Signal*> signals = netlist.GetSignalIterator();
    EXPECT_EQ(Netlist::GetLongestSignalName(signals), 9) << "of what needs declaring";
    EXPECT_EQ(Netlist::GetLongestPortName(signals), 3);
    bus->SetPortPolarity(Out);
    EXPECT_TRUE(bit->IsPort());
    EXPECT_EQ(Netlist::GetLongestPortName(signals), 11) << "the bit is a port, too";
    EXPECT_EQ(Netlist::GetLongestPortName(Iterator<Signal*>()), 0);
    EXPECT_EQ(Netlist::GetLongestSignalName(Iterator<Signal*>()), 0);
}

TEST(LongestName, OfAttributes) {
    Netlist netlist;
    EXPECT_EQ(Netlist::GetLongestAttrName(&netlist), 0);
    netlist.AddAttr(new AttributeString("A", ""));
    EXPECT_EQ(Netlist::GetLongestAttrName(&netlist), 1);
    Component* component = Added(netlist, new Component("C"));
    component->AddPin("P", In, "");
    Instance* instance = Added(netlist, new Instance("U", component));
    instance->AddAttr(new AttributeString("AAA", ""));
    EXPECT_EQ(Netlist::GetLongestAttrName(&netlist), 3);
    Added(netlist, new ScalarSignal("N"))->AddAttr(new AttributeString("AAAA", ""));
    EXPECT_EQ(Netlist::GetLongestAttrName(&netlist), 4);
    component->AddAttr(new AttributeString("AAAAA", ""));
    component->AddAttr(new AttributeString("AA", ""));
    EXPECT_EQ(Netlist::GetLongestAttrName(&netlist), 5);
    component->GetPin("P")->AddAttr(new AttributeString("AAAAAA", ""));
    instance->GetPin("P")->AddAttr(new AttributeString("AAAAAA", ""));
    EXPECT_EQ(Netlist::GetLongestAttrName(&netlist), 5) << "pins do not count";
    EXPECT_EQ(Netlist::GetLongestAttrName(static_cast<const AttributeHolder*>(component)), 5);
    EXPECT_EQ(Netlist::GetLongestAttrName(static_cast<const AttributeHolder*>(&netlist)), 1);
    EXPECT_EQ(Netlist::GetLongestAttrName(static_cast<const AttributeHolder*>(nullptr)), 0);
    EXPECT_EQ(Netlist::GetLongestAttrName(static_cast<const Netlist*>(nullptr)), 0);
}

TEST(Netlist, HoldsAMillionObjects) {
    Netlist netlist;
    Component* component = Added(netlist, new Component("C"));
    component->AddPin("A", In, "");
    Signal* signal = Added(netlist, new ScalarSignal("N"));
    for (int i = 0; i < 1000000; ++i) {
        Instance* instance =
            Added(netlist, new Instance(("U" + std::to_string(i)).c_str(), component));
        signal->Connect(instance->GetPin("A"));
    }
    netlist.Remove(netlist.GetInstance("U999999"));
    netlist.Remove(signal);
    EXPECT_EQ(netlist.GetInstance("U5")->GetPin("A")->GetSignal(), nullptr);
}

} // namespace
