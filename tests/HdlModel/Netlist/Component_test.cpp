#include "Orn_Hdl/Model.h"

#include "Support/Names.h"
#include "Support/Parts.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <memory>
#include <string>
#include <type_traits>
#include <vector>

namespace {

using namespace Orn_Hdl;
using Support::Bi;
using Support::In;
using Support::Names;
using Support::NamesOf;
using Support::Out;

TEST(Component, StoresItsNameNormalised) {
    EXPECT_EQ(Component("C[1-0]").GetName(), "C(1:0)");
    EXPECT_EQ(Component(nullptr).GetName(), "");
}

TEST(Component, MakesPinsOfTheClassThatTheNameAsksFor) {
    Component component("C");
    component.AddPin("CLK", In, "");
    component.AddPin("D[3:0]", Out, "");
    component.AddPin("E<2>", Bi, "");
    component.AddPin(nullptr, Polarity(), static_cast<const char*>(nullptr));
    EXPECT_EQ(NamesOf(component.GetPinIterator()), (Names{"CLK", "D(3:0)", "E(2)", ""}));
    EXPECT_NE(dynamic_cast<ScalarPin*>(component.GetPin("CLK")), nullptr);
    EXPECT_NE(dynamic_cast<BusPin*>(component.GetPin("D(3:0)")), nullptr);
    EXPECT_NE(dynamic_cast<BusIndexPin*>(component.GetPin("E(2)")), nullptr);
    EXPECT_NE(dynamic_cast<ScalarPin*>(component.GetPin("")), nullptr);
    EXPECT_EQ(component.GetPin("D(3:0)")->GetPolarity(), Out);
}

TEST(Component, GivesPinsTheirDefaultValue) {
    Component component("C");
    component.AddPin("A", In, "8:H:A5");
    component.AddPin("B", In, BitVectorValue("1"));
    component.AddPin("C", In, BitVectorValue());
    component.AddPin("D", In, "");
    EXPECT_EQ(component.GetPin("A")->GetDefaultValue().GetValue(), "A5");
    EXPECT_EQ(component.GetPin("A")->GetDefaultValue().GetLength(), 8);
    EXPECT_EQ(component.GetPin("B")->GetDefaultValue().GetValue(), "1");
    EXPECT_EQ(component.GetPin("C")->GetDefaultValue().GetValue(), "");
    EXPECT_EQ(component.GetPin("D")->GetDefaultValue().GetValue(), "");
}

TEST(Component, FindsPinsByNormalisedNameIgnoringCase) {
    Component component("C");
    component.AddPin("D(3:0)", In, "");
    Pin* pin = component.GetPinIterator().GetCurrent();
    EXPECT_EQ(component.GetPin("d[3-0]"), pin);
    EXPECT_EQ(component.GetPin("D"), nullptr);
    EXPECT_EQ(component.GetPin(""), nullptr);
    EXPECT_EQ(component.GetPin(nullptr), nullptr);
}

TEST(Component, OfTwoPinsOfOneNameFindsTheFirst) {
    Component component("C");
    component.AddPin("a", In, "");
    component.AddPin("A", Out, "");
    EXPECT_EQ(NamesOf(component.GetPinIterator()), (Names{"a", "A"}));
    EXPECT_EQ(component.GetPin("A")->GetPolarity(), In);
}

TEST(Component, AppendsAClone) {
    Component component("C");
    {
        BusPin pin("D(3:0)", Out);
        pin.SetDefaultValue("1");
        component.AddPin(pin);
        component.AddPin(pin);
    }
    component.AddPin(*component.GetPinIterator().GetCurrent());
    EXPECT_EQ(NamesOf(component.GetPinIterator()), (Names{"D(3:0)", "D(3:0)", "D(3:0)"}));
    EXPECT_EQ(component.GetPin("D(3:0)")->GetDefaultValue().GetValue(), "1");
}

TEST(Instance, HasAClonesOfItsComponentsPins) {
    Component component("AND2");
    component.AddPin("O", Out, "");
    component.AddPin("I[1:0]", In, "2:B:01");
    component.GetPin("O")->AddAttr(new AttributeString("a", "b"));
    const Instance instance("U[1]", &component);
    EXPECT_EQ(instance.GetName(), "U(1)");
    EXPECT_EQ(NamesOf(instance.GetPinIterator()), (Names{"O", "I(1:0)"}));
    EXPECT_NE(instance.GetPin("O"), component.GetPin("O"));
    EXPECT_EQ(instance.GetPin("i<1-0>")->GetDefaultValue().GetValue(), "01");
    EXPECT_FALSE(instance.GetPin("O")->HasAttrs());
    EXPECT_EQ(instance.GetComponent(), &component);
    EXPECT_EQ(instance.GetComponentName(), "AND2");
}

TEST(Instance, DoesNotGetPinsThatItsComponentGetsLater) {
    Component component("C");
    component.AddPin("A", In, "");
    const Instance before("U1", &component);
    component.AddPin("B", In, "");
    const Instance after("U2", &component);
    EXPECT_EQ(NamesOf(before.GetPinIterator()), Names{"A"});
    EXPECT_EQ(before.GetPin("B"), nullptr);
    EXPECT_EQ(NamesOf(after.GetPinIterator()), (Names{"A", "B"}));
}

TEST(Instance, WithoutAComponentHasNoPins) {
    const Instance instance("U1", nullptr);
    EXPECT_TRUE(instance.GetPinIterator().IsAtEnd());
    EXPECT_EQ(instance.GetPin("A"), nullptr);
    EXPECT_EQ(instance.GetComponent(), nullptr);
    EXPECT_EQ(instance.GetComponentName(), "");
    EXPECT_EQ(instance.GetComponentAttr("a"), nullptr);
    PtrArray<Pin*> pins;
    EXPECT_FALSE(instance.GetOpenPin(pins, false));
    instance.GetInPortConnectedToOutPin(pins);
    instance.GetOutPortConnectedToInPin(pins);
    EXPECT_TRUE(pins.IsEmpty());
}

TEST(Instance, KnowsItsComponentsAttributes) {
    Component component("C");
    component.AddAttr(new AttributeString("LEVEL", "x"));
    const Instance instance("U1", &component);
    EXPECT_EQ(instance.GetComponentAttr("level"), component.GetAttr("LEVEL"));
    EXPECT_EQ(instance.GetAttr("LEVEL"), nullptr);
    EXPECT_EQ(instance.GetComponentAttr("none"), nullptr);
    EXPECT_EQ(instance.GetComponentAttr(nullptr), nullptr);
}

TEST(Instance, ShowsItsComponentsPresentName) {
    Component component("C");
    const Instance instance("U1", &component);
    component.SetName("RENAMED");
    EXPECT_EQ(instance.GetComponentName(), "RENAMED");
}

TEST(Instance, OutlivesItsComponent) {
    auto component = std::make_unique<Component>("C");
    component->AddPin("A", In, "");
    component->AddAttr(new AttributeString("LEVEL", "x"));
    const Instance instance("U1", component.get());
    component.reset();
    EXPECT_EQ(instance.GetComponent(), nullptr);
    EXPECT_EQ(instance.GetComponentName(), "");
    EXPECT_EQ(instance.GetComponentAttr("LEVEL"), nullptr);
    EXPECT_EQ(NamesOf(instance.GetPinIterator()), Names{"A"}) << "it keeps its pins";
}

TEST(Instance, ListsItsOpenPins) {
    Component component("C");
    component.AddPin("O", Out, "");
    component.AddPin("I1", In, "");
    component.AddPin("I2", In, "");
    component.AddPin("B", Bi, "");
    component.AddPin("X", Polarity(), "");
    const Instance instance("U1", &component);
    ScalarSignal signal("N");
    instance.GetPin("I1")->Connect(&signal);
    PtrArray<Pin*> inputs;
    EXPECT_TRUE(instance.GetOpenPin(inputs, true));
    EXPECT_EQ(NamesOf(inputs), Names{"I2"});
    PtrArray<Pin*> all;
    EXPECT_TRUE(instance.GetOpenPin(all, false));
    EXPECT_EQ(NamesOf(all), (Names{"O", "I2", "B", "X"}));
    EXPECT_TRUE(instance.GetOpenPin(all, true)) << "it appends";
    EXPECT_EQ(NamesOf(all), (Names{"O", "I2", "B", "X", "I2"}));
    instance.GetPin("I2")->Connect(&signal);
    EXPECT_TRUE(instance.GetOpenPin(all, true)) << "the list is not empty afterwards";
    PtrArray<Pin*> none;
    EXPECT_FALSE(instance.GetOpenPin(none, true));
}

TEST(Instance, SortsItsPinsByPolarityThenName) {
    Component component("C");
    for (const auto& [name, polarity] :
         std::vector<std::pair<const char*, Polarity>>{{"B10", Out},
                                                       {"B2", Out},
                                                       {"Z", In},
                                                       {"A", Bi},
                                                       {"z", In},
                                                       {"Y", In},
                                                       {"Q", Polarity()}}) {
        component.AddPin(name, polarity, "");
    }
    Instance instance("U1", &component);
    Pin* first = instance.GetPin("Z");
    instance.SortPinName();
    EXPECT_EQ(NamesOf(instance.GetPinIterator()), (Names{"Q", "Y", "Z", "z", "B2", "B10", "A"}));
    EXPECT_EQ(instance.GetPin("z"), first);
    EXPECT_EQ(NamesOf(component.GetPinIterator()), (Names{"B10", "B2", "Z", "A", "z", "Y", "Q"}));
}

/// An instance with four pins, one of each direction, all wired to one signal.
struct Wired {
    explicit Wired(Signal& signal) {
        component.AddPin("I", In, "");
        component.AddPin("O", Out, "");
        component.AddPin("B", Bi, "");
        component.AddPin("X", Polarity(), "");
        instance = std::make_unique<Instance>("U", &component);
        for (Pin* pin : instance->GetPinIterator()) {
            signal.Connect(pin);
        }
    }

    Names OutPortPins() const {
        PtrArray<Pin*> pins;
        instance->GetOutPortConnectedToInPin(pins);
        return NamesOf(pins);
    }
    Names InPortPins() const {
        PtrArray<Pin*> pins;
        instance->GetInPortConnectedToOutPin(pins);
        return NamesOf(pins);
    }

    Component component{"C"};
    std::unique_ptr<Instance> instance;
};

TEST(PortChecks, FindInputAndBidirectionalPinsOnAnOutputPort) {
    ScalarSignal signal("N");
    const Wired wired(signal);
    EXPECT_EQ(wired.OutPortPins(), Names());
    EXPECT_EQ(wired.InPortPins(), Names());
    signal.SetPortPolarity(Out);
    EXPECT_EQ(wired.OutPortPins(), (Names{"I", "B"}));
    EXPECT_EQ(wired.InPortPins(), Names());
}

TEST(PortChecks, FindOutputAndBidirectionalPinsOnAnInputPort) {
    ScalarSignal signal("N");
    const Wired wired(signal);
    signal.SetPortPolarity(In);
    EXPECT_EQ(wired.OutPortPins(), Names());
    EXPECT_EQ(wired.InPortPins(), (Names{"O", "B"}));
    signal.SetPortPolarity(Bi);
    EXPECT_EQ(wired.OutPortPins(), Names());
    EXPECT_EQ(wired.InPortPins(), Names());
}

TEST(PortChecks, LookAtTheParentOfASliceOrBit) {
    Bus bus("D(3:0)");
    BusSlice slice("D(1:0)", &bus);
    BusIndex bit("D(3)", &bus);
    bus.SetPortPolarity(Out);
    EXPECT_EQ(Wired(slice).OutPortPins(), (Names{"I", "B"}));
    EXPECT_EQ(Wired(bit).OutPortPins(), (Names{"I", "B"}));
}

TEST(PortChecks, LookAtEachMemberOfACompound) {
    ScalarSignal a("A");
    ScalarSignal b("B");
    CompoundBus compound("A,B");
    compound.AddBusMember(&a);
    compound.AddBusMember(&b);
    const Wired wired(compound);
    EXPECT_EQ(wired.OutPortPins(), Names());
    b.SetPortPolarity(Out);
    EXPECT_EQ(wired.OutPortPins(), (Names{"I", "B"}));
    a.SetPortPolarity(In);
    EXPECT_EQ(wired.OutPortPins(), (Names{"I", "B"}));
    EXPECT_EQ(wired.InPortPins(), (Names{"O", "B"}));
}

TEST(PortChecks, Append) {
    ScalarSignal signal("N");
    signal.SetPortPolarity(In);
    const Wired wired(signal);
    PtrArray<Pin*> pins;
    wired.instance->GetInPortConnectedToOutPin(pins);
    wired.instance->GetInPortConnectedToOutPin(pins);
    EXPECT_EQ(NamesOf(pins), (Names{"O", "B", "O", "B"}));
}

TEST(Owners, CannotBeCopied) {
    EXPECT_FALSE(std::is_copy_constructible_v<Component>);
    EXPECT_FALSE(std::is_copy_assignable_v<Component>);
    EXPECT_FALSE(std::is_copy_constructible_v<Instance>);
    EXPECT_FALSE(std::is_copy_assignable_v<Instance>);
    EXPECT_FALSE(std::is_copy_constructible_v<Netlist>);
    EXPECT_FALSE(std::is_copy_assignable_v<Netlist>);
    EXPECT_FALSE(std::is_copy_constructible_v<ScalarSignal>);
    EXPECT_FALSE(std::is_copy_assignable_v<Bus>);
    EXPECT_FALSE(std::is_copy_constructible_v<Model>);
    EXPECT_FALSE(std::is_copy_assignable_v<Model>);
}

std::string Fold(std::string name) {
    for (char& c : name) {
        c = c >= 'a' && c <= 'z' ? static_cast<char>(c - 32) : c;
    }
    return name;
}

/// The first pin of a name, by looking at one after the other.
Pin* FindSlowly(const Iterator<Pin*>& pins, const std::string& name) {
    for (Pin* pin : pins) {
        if (Fold(Support::Text(pin->GetName())) == Fold(name)) {
            return pin;
        }
    }
    return nullptr;
}

RC_GTEST_PROP(PinLookUp, FindsTheFirstPinOfANameWhateverHappensToThePins, ()) {
    const auto names =
        *rc::gen::scale(2.0, rc::gen::container<Names>(rc::gen::container<std::string>(
                                 rc::gen::elementOf(std::string("abAB12")))));
    const auto changes = *rc::gen::container<std::vector<std::pair<unsigned, std::string>>>(
        rc::gen::pair(rc::gen::inRange(0u, 60u),
                      rc::gen::container<std::string>(rc::gen::elementOf(std::string("abAB12")))));
    Component component("C");
    for (const std::string& name : names) {
        component.AddPin(name.c_str(), In, "");
    }
    Instance instance("U", &component);
    for (const auto& [where, name] : changes) {
        if (where < 5) {
            component.AddPin(name.c_str(), Out, "");
        } else if (where < 10) {
            instance.SortPinName();
        } else {
            unsigned at = where - 10;
            for (Pin* pin : instance.GetPinIterator()) {
                if (at-- == 0) {
                    pin->SetName(name.c_str());
                    pin->SetPolarity(Polarity(static_cast<int>(where % 3)));
                }
            }
        }
        RC_ASSERT(component.GetPin(name) == FindSlowly(component.GetPinIterator(), name));
        RC_ASSERT(instance.GetPin(name) == FindSlowly(instance.GetPinIterator(), name));
    }
    for (const std::string& name : names) {
        RC_ASSERT(component.GetPin(name) == FindSlowly(component.GetPinIterator(), name));
        RC_ASSERT(instance.GetPin(name) == FindSlowly(instance.GetPinIterator(), name));
    }
}

TEST(PinLookUp, OfManyPinsIsFast) {
    Component component("C");
    for (int i = 0; i < 20000; ++i) {
        component.AddPin(("P" + std::to_string(i)).c_str(), In, "");
    }
    const Instance instance("U", &component);
    for (int i = 0; i < 20000; ++i) {
        const std::string name = "p" + std::to_string(i);
        ASSERT_TRUE(component.GetPin(name)->IsNamed(name.c_str()));
        ASSERT_TRUE(instance.GetPin(name)->IsNamed(name.c_str()));
    }
}

/// The first pin of that name, looked for one by one.
Pin* FirstNamed(const Iterator<Pin*>& pins, const std::string& name) {
    for (Pin* pin : pins) {
        if (pin->IsNamed(name.c_str())) {
            return pin;
        }
    }
    return nullptr;
}

/// Long lists with pins that are added, renamed to new names and to names that are taken, assigned
/// and sorted, in any order: each look-up finds what a search one by one finds.
RC_GTEST_PROP(PinLists, FindTheFirstPinOfAnyName, ()) {
    Component component("C");
    std::vector<std::unique_ptr<Instance>> instances;
    const auto name = [] { return "P" + std::to_string(*rc::gen::inRange(0, 40)); };
    const int steps = *rc::gen::inRange(1, 60);
    for (int i = 0; i < *rc::gen::inRange(0, 30); ++i) {
        component.AddPin(name().c_str(), *rc::gen::element(In, Out), "");
    }
    const auto anyPin = [&]() -> Pin* {
        const int which = *rc::gen::inRange(0, static_cast<int>(instances.size()) + 1);
        Iterator<Pin*> pins =
            which == 0 ? component.GetPinIterator()
                       : instances[static_cast<std::size_t>(which - 1)]->GetPinIterator();
        for (int skipped = *rc::gen::inRange(0, 40); skipped > 0 && !pins.IsAtEnd(); --skipped) {
            pins.Next();
        }
        return pins.GetCurrent();
    };
    for (int step = 0; step < steps; ++step) {
        Pin* const pin = anyPin();
        switch (*rc::gen::inRange(0, 6)) {
        case 0:
            component.AddPin(name().c_str(), *rc::gen::element(In, Out), "");
            break;
        case 1:
            instances.push_back(std::make_unique<Instance>("u", &component));
            break;
        case 2:
            if (!instances.empty()) {
                instances.back()->SortPinName();
            }
            break;
        case 3:
            if (auto* const scalar = dynamic_cast<ScalarPin*>(pin)) {
                *scalar = ScalarPin(name().c_str(), In);
            }
            break;
        default:
            if (pin != nullptr) {
                pin->SetName(name().c_str());
            }
        }
        for (int i = 0; i < 41; ++i) {
            const std::string wanted = "p" + std::to_string(i);
            RC_ASSERT(component.GetPin(wanted.c_str()) ==
                      FirstNamed(component.GetPinIterator(), wanted));
            for (const auto& instance : instances) {
                RC_ASSERT(instance->GetPin(wanted.c_str()) ==
                          FirstNamed(instance->GetPinIterator(), wanted));
            }
        }
    }
}

TEST(PinLists, AnInstanceKeepsItsLongListWithoutTheComponent) {
    auto component = std::make_unique<Component>("C");
    for (int i = 0; i < 20; ++i) {
        component->AddPin(("P" + std::to_string(i)).c_str(), In, "");
    }
    const Instance instance("u", component.get());
    component->AddPin("P20", In, "");
    component->GetPin("P3")->SetName("Q");
    EXPECT_NE(instance.GetPin("P3"), nullptr);
    EXPECT_EQ(instance.GetPin("P20"), nullptr);
    EXPECT_EQ(component->GetPin("P3"), nullptr);
    EXPECT_NE(component->GetPin("Q"), nullptr);
    component.reset();
    EXPECT_NE(instance.GetPin("P19"), nullptr);
    EXPECT_EQ(instance.GetPin("Q"), nullptr);
    EXPECT_EQ(instance.GetPin("P19")->GetObjectType(), ObjectTypePin);
}

} // namespace
