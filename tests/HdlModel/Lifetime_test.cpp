// Objects that end, move and change in every order: no list, pin or map may ever name a dead one.
#include "Orn_Hdl/Commands.h"
#include "Orn_Hdl/Model.h"

#include "Support/Names.h"
#include "Support/Parts.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <algorithm>
#include <array>
#include <functional>
#include <memory>
#include <set>
#include <string>
#include <vector>

namespace {

using namespace Orn_Hdl;
using Support::In;
using Support::MakeBuffer;
using Support::Names;
using Support::NamesOf;
using Support::Out;

TEST(Lifetime, APinThatEndsLeavesEverySignalThatListsIt) {
    ScalarSignal first("N1");
    ScalarSignal second("N2");
    {
        ScalarPin pin("A", In);
        first.Connect(&pin);
        second.Connect(&pin);
        first.Connect(&pin);
    }
    EXPECT_EQ(NamesOf(first.GetPinIterator()), Names());
    EXPECT_EQ(NamesOf(second.GetPinIterator()), Names());
    EXPECT_FALSE(first.HasMultiDriver());
}

TEST(Lifetime, APinThatOnlyPointsAtASignalMayEndBeforeOrAfterIt) {
    auto signal = std::make_unique<ScalarSignal>("N");
    auto early = std::make_unique<ScalarPin>("A", In);
    ScalarPin late("B", In);
    early->Connect(signal.get());
    late.Connect(signal.get());
    early.reset();
    signal.reset();
    EXPECT_EQ(late.GetSignal(), nullptr);
}

TEST(Lifetime, APinThatMovedOnIsNotOpenedByAnyFormerSignal) {
    const auto pointedAt = [](Signal& signal, Pin& pin) { pin.Connect(&signal); };
    const auto listed = [](Signal& signal, Pin& pin) { signal.Connect(&pin); };
    const auto pointedAtThenListed = [](Signal& signal, Pin& pin) {
        pin.Connect(&signal);
        signal.Connect(&pin);
    };
    const auto listedThenPointedAt = [](Signal& signal, Pin& pin) {
        signal.Connect(&pin);
        signal.Disconnect(&pin);
        pin.Connect(&signal);
    };
    const std::function<void(Signal&, Pin&)> ways[] = {pointedAt, listed, pointedAtThenListed,
                                                       listedThenPointedAt};
    for (const auto& before : ways) {
        for (const auto& after : ways) {
            ScalarPin pin("A", In);
            ScalarSignal last("M");
            auto former = std::make_unique<ScalarSignal>("N");
            before(*former, pin);
            after(last, pin);
            former->DisconnectAll();
            EXPECT_EQ(pin.GetSignal(), &last);
            before(*former, pin);
            after(last, pin);
            former.reset();
            EXPECT_EQ(pin.GetSignal(), &last);
        }
    }
}

TEST(Lifetime, ASignalThatEndsOpensItsPins) {
    ScalarPin listed("A", In);
    ScalarPin unlisted("B", In);
    ScalarPin moved("C", In);
    ScalarSignal other("M");
    {
        ScalarSignal signal("N");
        signal.Connect(&listed);
        unlisted.Connect(&signal);
        signal.Connect(&moved);
        other.Connect(&moved);
    }
    EXPECT_EQ(listed.GetSignal(), nullptr);
    EXPECT_EQ(unlisted.GetSignal(), nullptr);
    EXPECT_EQ(moved.GetSignal(), &other);
}

TEST(Lifetime, APinReturnsToASignalAfterMovingOn) {
    ScalarPin pin("A", In);
    auto first = std::make_unique<ScalarSignal>("N1");
    auto second = std::make_unique<ScalarSignal>("N2");
    pin.Connect(first.get());
    second->Connect(&pin);
    pin.Connect(first.get());
    second.reset();
    EXPECT_EQ(pin.GetSignal(), first.get());
    first.reset();
    EXPECT_EQ(pin.GetSignal(), nullptr);
}

TEST(Lifetime, AnAliasThatEndsLeavesTheLists) {
    ScalarSignal a("A");
    ScalarSignal b("B");
    {
        ScalarSignal alias("X");
        a.Connect(&alias);
        b.Connect(&alias);
        alias.Connect(&a);
    }
    EXPECT_EQ(NamesOf(a.GetSignalIterator()), Names());
    EXPECT_EQ(NamesOf(b.GetSignalIterator()), Names());
}

TEST(Lifetime, AnAliasThatWasTakenBackMayEnd) {
    ScalarSignal a("A");
    {
        ScalarSignal alias("X");
        a.Connect(&alias);
        a.Disconnect(&alias);
        a.Connect(&alias);
        a.DisconnectAll();
    }
    EXPECT_EQ(NamesOf(a.GetSignalIterator()), Names());
}

TEST(Lifetime, ABusAndItsPartsMayEndInAnyOrder) {
    for (int order = 0; order < 6; ++order) {
        std::array<int, 3> turns{0, 1, 2};
        for (int i = 0; i < order; ++i) {
            std::next_permutation(turns.begin(), turns.end());
        }
        auto bus = std::make_unique<Bus>("D(7:0)");
        auto slice = std::make_unique<BusSlice>("D(3:0)", bus.get());
        auto bit = std::make_unique<BusIndex>("D(5)", bus.get());
        for (const int turn : turns) {
            if (turn == 0) {
                bus.reset();
            } else if (turn == 1) {
                slice.reset();
            } else {
                bit.reset();
            }
            if (bus != nullptr) {
                EXPECT_EQ(NamesOf(bus->GetBusSliceIterator()).size(),
                          static_cast<std::size_t>((slice != nullptr) + (bit != nullptr)));
            }
            if (slice != nullptr) {
                EXPECT_EQ(slice->GetParentBus(), bus.get());
                EXPECT_EQ(slice->GetPortPolarity(), Polarity());
            }
            if (bit != nullptr) {
                EXPECT_EQ(bit->GetParentBus(), bus.get());
            }
        }
    }
}

TEST(Lifetime, AForeignSignalOnABusMayEndFirst) {
    Bus bus("D(7:0)");
    {
        ScalarSignal scalar("N");
        Bus other("E(7:0)");
        bus.AddBusSlice(&scalar);
        bus.AddBusSlice(&other);
    }
    for (Signal* part : bus.GetBusSliceIterator()) {
        ADD_FAILURE() << "a dead part, " << part;
    }
}

TEST(Lifetime, AForeignSignalOnABusThatWasWidenedMayEndFirst) {
    CommandFactory factory;
    Model model(&factory);
    model.ConnectSignals("A", "D(3:0)");
    const Bus* const narrow = model.GetNetlist()->GetParentBus("D");
    auto scalar = std::make_unique<ScalarSignal>("N");
    model.GetNetlist()->GetParentBus("D")->AddBusSlice(scalar.get());
    model.ConnectSignals("B", "D(7:0)");
    const Bus* const wide = model.GetNetlist()->GetParentBus("D");
    ASSERT_NE(wide, narrow);
    EXPECT_EQ(NamesOf(wide->GetBusSliceIterator()), (Names{"D(3:0)", "N"}));
    scalar.reset();
    EXPECT_EQ(NamesOf(wide->GetBusSliceIterator()), Names{"D(3:0)"});
}

TEST(Lifetime, ACompoundAndItsMembersMayEndInAnyOrder) {
    for (const bool compoundFirst : {true, false}) {
        auto member = std::make_unique<ScalarSignal>("A");
        Bus stays("D(3:0)");
        auto compound = std::make_unique<CompoundBus>("A,D(3:0),A");
        compound->AddBusMember(member.get());
        compound->AddBusMember(&stays);
        compound->AddBusMember(member.get());
        if (compoundFirst) {
            compound.reset();
            member.reset();
        } else {
            member.reset();
            EXPECT_EQ(NamesOf(compound->GetBusMemberIterator()), Names{"D(3:0)"});
            EXPECT_EQ(compound->GetWidth(), 4);
        }
    }
}

TEST(Lifetime, AReplacedMemberMayEnd) {
    CompoundBus compound("A,B");
    ScalarSignal b("B");
    auto a = std::make_unique<ScalarSignal>("A");
    compound.AddBusMember(a.get());
    compound.AddBusMember(a.get());
    compound.SetAt(0, &b);
    a.reset();
    EXPECT_EQ(NamesOf(compound.GetBusMemberIterator()), Names{"B"});
}

TEST(Lifetime, NestedCompoundsMayEndInsideOut) {
    CompoundBus outer("outer");
    {
        CompoundBus inner("inner");
        ScalarSignal a("A");
        inner.AddBusMember(&a);
        outer.AddBusMember(&inner);
        outer.AddBusMember(&a);
        EXPECT_EQ(outer.GetWidth(), 2);
    }
    EXPECT_EQ(outer.GetSize(), 0);
    EXPECT_EQ(outer.GetWidth(), 0);
}

TEST(Lifetime, AnInstanceThatEndsLeavesTheSignals) {
    const std::unique_ptr<Component> component = MakeBuffer("C");
    ScalarSignal signal("N");
    {
        Instance instance("U", component.get());
        for (Pin* pin : instance.GetPinIterator()) {
            signal.Connect(pin);
        }
    }
    EXPECT_EQ(NamesOf(signal.GetPinIterator()), Names());
}

TEST(Lifetime, AComponentAndItsInstancesMayEndInAnyOrder) {
    std::unique_ptr<Component> component = MakeBuffer("C");
    auto first = std::make_unique<Instance>("U1", component.get());
    auto second = std::make_unique<Instance>("U2", component.get());
    first.reset();
    component.reset();
    EXPECT_EQ(second->GetComponent(), nullptr);
    EXPECT_EQ(NamesOf(second->GetPinIterator()), (Names{"I", "O", "B", "D(3:0)"}));
    component = MakeBuffer("C");
    EXPECT_EQ(second->GetComponent(), nullptr);
}

TEST(Lifetime, AComponentWhosePinsAreWiredMayEnd) {
    ScalarSignal signal("N");
    {
        const std::unique_ptr<Component> component = MakeBuffer("C");
        signal.Connect(component->GetPin("I"));
        component->GetPin("O")->Connect(&signal);
    }
    EXPECT_EQ(NamesOf(signal.GetPinIterator()), Names());
}

TEST(Lifetime, ANetlistThatEndsLeavesForeignObjects) {
    const std::unique_ptr<Component> component = MakeBuffer("C");
    Instance foreign("U", component.get());
    ScalarSignal outside("OUT");
    CompoundBus compound("N,OUT");
    Bus bus("B(7:0)");
    std::unique_ptr<BusSlice> slice;
    ScalarPin pin("P", In);
    std::unique_ptr<Instance> orphan;
    {
        Netlist netlist("top");
        auto* signal = new ScalarSignal("N");
        netlist.Add(signal);
        auto* instance = new Instance("U1", component.get());
        netlist.Add(instance);
        auto* inside = new Bus("D(7:0)");
        netlist.Add(inside);
        netlist.Add(new BusIndex("B(3)", &bus));
        auto* ownComponent = new Component("OWN");
        netlist.Add(ownComponent);
        orphan = std::make_unique<Instance>("U2", ownComponent);
        slice = std::make_unique<BusSlice>("D(3:0)", inside);
        outside.Connect(instance->GetPin("I"));
        outside.Connect(signal);
        signal->Connect(foreign.GetPin("I"));
        foreign.GetPin("O")->Connect(signal);
        signal->Connect(&pin);
        compound.AddBusMember(signal);
        compound.AddBusMember(&outside);
    }
    EXPECT_EQ(NamesOf(outside.GetPinIterator()), Names());
    EXPECT_EQ(NamesOf(outside.GetSignalIterator()), Names());
    EXPECT_EQ(foreign.GetPin("I")->GetSignal(), nullptr);
    EXPECT_EQ(foreign.GetPin("O")->GetSignal(), nullptr);
    EXPECT_EQ(pin.GetSignal(), nullptr);
    EXPECT_EQ(NamesOf(compound.GetBusMemberIterator()), Names{"OUT"});
    EXPECT_EQ(slice->GetParentBus(), nullptr);
    EXPECT_TRUE(bus.GetBusSliceIterator().IsAtEnd());
    EXPECT_EQ(orphan->GetComponent(), nullptr);
}

TEST(Lifetime, ForeignObjectsThatEndLeaveANetlist) {
    Netlist netlist("top");
    auto* signal = new ScalarSignal("N");
    netlist.Add(signal);
    auto* compound = new CompoundBus("N,OUT");
    netlist.Add(compound);
    auto* bus = new Bus("D(7:0)");
    netlist.Add(bus);
    Instance* instance = nullptr;
    {
        const std::unique_ptr<Component> component = MakeBuffer("C");
        instance = new Instance("U1", component.get());
        netlist.Add(instance);
        ScalarSignal outside("OUT");
        BusSlice slice("D(3:0)", bus);
        ScalarPin pin("P", In);
        signal->Connect(&outside);
        signal->Connect(&pin);
        outside.Connect(instance->GetPin("I"));
        compound->AddBusMember(signal);
        compound->AddBusMember(&outside);
    }
    EXPECT_EQ(instance->GetComponent(), nullptr);
    EXPECT_EQ(instance->GetPin("I")->GetSignal(), nullptr);
    EXPECT_EQ(NamesOf(signal->GetSignalIterator()), Names());
    EXPECT_EQ(NamesOf(signal->GetPinIterator()), Names());
    EXPECT_EQ(NamesOf(compound->GetBusMemberIterator()), Names{"N"});
    EXPECT_TRUE(bus->GetBusSliceIterator().IsAtEnd());
}

TEST(Lifetime, TwoNetlistsMayBeWiredToOneAnother) {
    for (const bool firstEndsFirst : {true, false}) {
        auto first = std::make_unique<Netlist>("first");
        auto second = std::make_unique<Netlist>("second");
        const std::array<Netlist*, 2> netlists{first.get(), second.get()};
        for (Netlist* netlist : netlists) {
            netlist->Add(new ScalarSignal("N"));
            netlist->Add(new Bus("D(7:0)"));
            netlist->Add(MakeBuffer("C").release());
            netlist->Add(new Instance("U", netlist->GetComponent("C")));
        }
        for (std::size_t i = 0; i < 2; ++i) {
            Netlist* mine = netlists[i];
            Netlist* other = netlists[1 - i];
            mine->GetSignal("N")->Connect(other->GetInstance("U")->GetPin("I"));
            mine->GetSignal("N")->Connect(other->GetSignal("N"));
            mine->GetInstance("U")->GetPin("O")->Connect(other->GetSignal("N"));
            mine->Add(new BusIndex("D(1)", other->GetParentBus("D")));
            auto* compound = new CompoundBus("N,N");
            compound->AddBusMember(mine->GetSignal("N"));
            compound->AddBusMember(other->GetSignal("N"));
            mine->Add(compound);
            mine->Add(new Instance("V", other->GetComponent("C")));
        }
        (firstEndsFirst ? first : second).reset();
        Netlist* rest = firstEndsFirst ? second.get() : first.get();
        EXPECT_EQ(NamesOf(rest->GetSignal("N")->GetPinIterator()), Names());
        EXPECT_EQ(NamesOf(rest->GetSignal("N")->GetSignalIterator()), Names());
        EXPECT_EQ(rest->GetInstance("U")->GetPin("O")->GetSignal(), nullptr);
        EXPECT_TRUE(rest->GetParentBus("D")->GetBusSliceIterator().IsAtEnd());
        EXPECT_EQ(rest->GetInstance("V")->GetComponent(), nullptr);
        EXPECT_EQ(dynamic_cast<CompoundBus&>(*rest->GetSignal("N,N")).GetSize(), 1);
        rest->SortNetlist();
        rest->CreateVhdlDummySignals();
    }
}

TEST(Lifetime, ANetlistMayEndWithEverythingRenamed) {
    Netlist netlist("top");
    for (int i = 0; i < 40; ++i) {
        const std::string number = std::to_string(i);
        netlist.Add(new Bus(("D" + number + "(7:0)").c_str()));
        netlist.Add(MakeBuffer(("C" + number).c_str()).release());
        netlist.Add(new Instance(("U" + number).c_str(), netlist.GetComponent("C" + number)));
    }
    int number = 0;
    for (Signal* signal : netlist.GetSignalIterator()) {
        signal->SetName(
            ("a name that is too long for its object " + std::to_string(++number)).c_str());
    }
    for (Component* component : netlist.GetComponentIterator()) {
        component->SetName("same");
        component->GetPin("I")->SetName("D(3:0)");
    }
    for (Instance* instance : netlist.GetInstanceIterator()) {
        instance->SetName("");
        instance->GetPin("O")->SetName("I");
    }
    netlist.SortNetlist();
    netlist.Add(new Instance("U1", nullptr));
    EXPECT_EQ(netlist.GetInstance("U1")->GetComponent(), nullptr);
    netlist.Remove(netlist.GetInstance("U1"));
}

TEST(Lifetime, AttributesGoWithTheirHolders) {
    Netlist netlist("top");
    netlist.AddAttr(new AttributeUser("a", "v"));
    auto* signal = new ScalarSignal("N");
    signal->AddAttr(new AttributeBitVector("b", "8:H:A5"));
    netlist.Add(signal);
    netlist.Add(MakeBuffer("C").release());
    auto* instance = new Instance("U", netlist.GetComponent("C"));
    instance->AddAttr(new AttributeFloat("c", "1.5"));
    instance->GetPin("I")->AddAttr(new AttributeString("d", "v"));
    instance->GetPin("I")->AddComment("comment");
    netlist.Add(instance);
    netlist.Remove(instance);
    netlist.Remove(signal);
    EXPECT_TRUE(netlist.HasAttrs());
}

/// Two netlists and any number of objects that nobody owns, all tangled up by random steps.
class World {
public:
    World() {
        for (std::unique_ptr<Netlist>& netlist : netlists_) {
            netlist = std::make_unique<Netlist>("top");
        }
    }

    World(const World&) = delete;
    World& operator=(const World&) = delete;
    /// Either the netlists end first or the objects that nobody owns.
    ~World() {
        if (choice_[0] % 2 == 0) {
            for (std::unique_ptr<Netlist>& netlist : netlists_) {
                netlist.reset();
            }
        }
    }

    void Step(const std::array<unsigned, 4>& step) {
        choice_ = step;
        next_ = 1;
        using Action = void (World::*)();
        static const Action actions[] = {
            &World::MakeSignal,     &World::MakeSignal,  &World::MakePlacement,
            &World::MakePin,        &World::WirePin,     &World::WirePin,
            &World::WireSignals,    &World::ChangeBus,   &World::ChangeCompound,
            &World::DeleteFree,     &World::Remove,      &World::Adopt,
            &World::Rename,         &World::SetPolarity, &World::Prepare,
            &World::ReplaceNetlist, &World::CopyPin,     &World::Dress};
        (this->*actions[step[0] % std::size(actions)])();
    }

    /// Every pointer that can be reached points at a living object, and both sides agree.
    void ExpectConsistent() const {
        const std::vector<Signal*> signals = Signals();
        const std::vector<Pin*> pins = Pins();
        const std::vector<Component*> components = Components();
        const std::set<const Signal*> livingSignals(signals.begin(), signals.end());
        const std::set<const Pin*> livingPins(pins.begin(), pins.end());
        const std::set<const Component*> livingComponents(components.begin(), components.end());
        for (const Pin* pin : pins) {
            RC_ASSERT(pin->GetSignal() == nullptr || livingSignals.count(pin->GetSignal()) != 0);
        }
        for (Signal* signal : signals) {
            ExpectAliveAndDifferent(signal->GetPinIterator(), livingPins);
            ExpectAliveAndDifferent(signal->GetSignalIterator(), livingSignals);
            for (const Signal* alias : signal->GetSignalIterator()) {
                RC_ASSERT(alias != signal);
            }
            ExpectConsistentParts(*signal, livingSignals);
            RC_ASSERT(signal->GetWidth() >= 0);
        }
        for (const Instance* instance : Instances()) {
            RC_ASSERT(instance->GetComponent() == nullptr ||
                      livingComponents.count(instance->GetComponent()) != 0);
        }
        for (const std::unique_ptr<Netlist>& netlist : netlists_) {
            for (const char* name : SignalNames) {
                const Signal* found = netlist->GetSignal(name);
                RC_ASSERT(found == nullptr || livingSignals.count(found) != 0);
                const Bus* bus = netlist->GetParentBus(name);
                RC_ASSERT(bus == nullptr || livingSignals.count(bus) != 0);
            }
        }
    }

private:
    static constexpr const char* SignalNames[] = {"A",
                                                  "B",
                                                  "A_DUMMY",
                                                  "D(3:0)",
                                                  "D(7:0)",
                                                  "D(0:3)",
                                                  "D_DUMMY(3:0)",
                                                  "D(1:0)",
                                                  "D(3)",
                                                  "E(1)",
                                                  "A,B,D(3:0)",
                                                  "",
                                                  "a name that is long enough"};

    unsigned Next() {
        const unsigned value = choice_[next_ % 4] + next_;
        ++next_;
        return value;
    }

    template <class T> T Choose(const std::vector<T>& objects) {
        return objects.empty() ? nullptr : objects[Next() % objects.size()];
    }
    const char* ChooseName() { return SignalNames[Next() % std::size(SignalNames)]; }
    Netlist& ChooseNetlist() { return *netlists_[Next() % 2]; }

    template <class T>
    static void ExpectAliveAndDifferent(const Iterator<T*>& list,
                                        const std::set<const T*>& living) {
        std::set<const T*> seen;
        for (const T* object : list) {
            RC_ASSERT(living.count(object) != 0);
            RC_ASSERT(seen.insert(object).second);
        }
    }

    static void ExpectConsistentParts(const Signal& signal, const std::set<const Signal*>& living) {
        if (const auto* bus = dynamic_cast<const Bus*>(&signal)) {
            ExpectAliveAndDifferent(bus->GetBusSliceIterator(), living);
            for (Signal* part : bus->GetBusSliceIterator()) {
                RC_ASSERT(ParentOf(*part) == bus);
            }
        } else if (const auto* compound = dynamic_cast<const CompoundBus*>(&signal)) {
            for (const Signal* member : compound->GetBusMemberIterator()) {
                RC_ASSERT(living.count(member) != 0);
                RC_ASSERT(member != compound);
            }
        } else if (const Bus* parent = ParentOf(signal)) {
            RC_ASSERT(living.count(parent) != 0);
            bool listed = false;
            for (const Signal* part : parent->GetBusSliceIterator()) {
                listed = listed || part == &signal;
            }
            RC_ASSERT(listed);
        }
    }

    static const Bus* ParentOf(const Signal& signal) {
        if (const auto* slice = dynamic_cast<const BusSlice*>(&signal)) {
            return slice->GetParentBus();
        }
        const auto* bit = dynamic_cast<const BusIndex*>(&signal);
        return bit == nullptr ? nullptr : bit->GetParentBus();
    }

    template <class T> static void Append(std::vector<T*>& objects, const Iterator<T*>& more) {
        for (T* object : more) {
            objects.push_back(object);
        }
    }

    std::vector<Signal*> Signals() const {
        std::vector<Signal*> signals;
        for (const auto& signal : signals_) {
            signals.push_back(signal.get());
        }
        for (const auto& netlist : netlists_) {
            Append(signals, netlist->GetSignalIterator());
        }
        return signals;
    }
    std::vector<Component*> Components() const {
        std::vector<Component*> components;
        for (const auto& component : components_) {
            components.push_back(component.get());
        }
        for (const auto& netlist : netlists_) {
            Append(components, netlist->GetComponentIterator());
        }
        return components;
    }
    std::vector<Instance*> Instances() const {
        std::vector<Instance*> instances;
        for (const auto& instance : instances_) {
            instances.push_back(instance.get());
        }
        for (const auto& netlist : netlists_) {
            Append(instances, netlist->GetInstanceIterator());
        }
        return instances;
    }
    std::vector<Pin*> Pins() const {
        std::vector<Pin*> pins;
        for (const auto& pin : pins_) {
            pins.push_back(pin.get());
        }
        for (Component* component : Components()) {
            Append(pins, component->GetPinIterator());
        }
        for (Instance* instance : Instances()) {
            Append(pins, instance->GetPinIterator());
        }
        return pins;
    }
    template <class T> std::vector<T*> SignalsOfClass() const {
        std::vector<T*> chosen;
        for (Signal* signal : Signals()) {
            if (auto* typed = dynamic_cast<T*>(signal)) {
                chosen.push_back(typed);
            }
        }
        return chosen;
    }

    void MakeSignal() {
        std::unique_ptr<Signal> signal;
        const char* name = ChooseName();
        switch (Next() % 5) {
        case 0:
            signal = std::make_unique<ScalarSignal>(name);
            break;
        case 1:
            signal = std::make_unique<Bus>(name);
            break;
        case 2:
            signal = std::make_unique<BusSlice>(name, Choose(SignalsOfClass<Bus>()));
            break;
        case 3:
            signal = std::make_unique<BusIndex>(name, Choose(SignalsOfClass<Bus>()));
            break;
        default: {
            auto compound = std::make_unique<CompoundBus>(name);
            compound->AddBusMember(Choose(Signals()));
            compound->AddBusMember(Choose(Signals()));
            signal = std::move(compound);
            break;
        }
        }
        signals_.push_back(std::move(signal));
        if (Next() % 3 != 0) {
            AdoptSignal(signals_.size() - 1);
        }
    }

    void MakePlacement() {
        if (Next() % 2 == 0) {
            components_.push_back(MakeBuffer(ChooseName()));
        } else {
            instances_.push_back(std::make_unique<Instance>(ChooseName(), Choose(Components())));
        }
        if (Next() % 3 != 0) {
            Adopt();
        }
    }

    void MakePin() {
        const Pin* original = Choose(Pins());
        pins_.emplace_back(original != nullptr && Next() % 2 == 0
                               ? original->ClonePin()
                               : Pin::Create(ChooseName(), Polarity(static_cast<int>(Next() % 3))));
        if (!components_.empty()) {
            components_[Next() % components_.size()]->AddPin(*pins_.back());
        }
    }

    void WirePin() {
        Pin* pin = Choose(Pins());
        Signal* signal = Choose(Signals());
        if (pin == nullptr || signal == nullptr) {
            return;
        }
        switch (Next() % 7) {
        case 0:
        case 1:
        case 2:
            signal->Connect(pin);
            RC_ASSERT(pin->GetSignal() == signal);
            break;
        case 3:
            pin->Connect(signal);
            break;
        case 4:
            pin->Disconnect();
            break;
        case 5:
            signal->Disconnect(pin);
            RC_ASSERT(pin->GetSignal() != signal);
            break;
        default:
            signal->DisconnectAll();
            break;
        }
    }

    void WireSignals() {
        Signal* first = Choose(Signals());
        Signal* second = Choose(Signals());
        if (first == nullptr) {
            return;
        }
        switch (Next() % 3) {
        case 0:
            first->Connect(second);
            break;
        case 1:
            first->Disconnect(second);
            break;
        default:
            first->CloneConnection(second);
            break;
        }
    }

    void ChangeBus() {
        Bus* bus = Choose(SignalsOfClass<Bus>());
        if (bus == nullptr) {
            return;
        }
        Signal* part = Next() % 2 == 0 ? static_cast<Signal*>(Choose(SignalsOfClass<BusSlice>()))
                                       : Choose(SignalsOfClass<BusIndex>());
        switch (Next() % 5) {
        case 0:
            bus->EmptyBusSlice();
            break;
        case 1:
            bus->RemoveBusSlice(part);
            break;
        default:
            bus->AddBusSlice(part);
            break;
        }
    }

    void ChangeCompound() {
        CompoundBus* compound = Choose(SignalsOfClass<CompoundBus>());
        if (compound == nullptr) {
            return;
        }
        Signal* member = Choose(Signals());
        if (Next() % 2 == 0 && compound->GetSize() < 4) {
            compound->AddBusMember(member);
        } else {
            compound->SetAt(static_cast<int>(Next() % 4), member);
        }
    }

    template <class T> void DeleteOne(std::vector<std::unique_ptr<T>>& objects) {
        if (!objects.empty()) {
            objects.erase(objects.begin() + static_cast<std::ptrdiff_t>(Next() % objects.size()));
        }
    }

    void DeleteFree() {
        switch (Next() % 4) {
        case 0:
            DeleteOne(components_);
            break;
        case 1:
            DeleteOne(instances_);
            break;
        case 2:
            DeleteOne(pins_);
            break;
        default:
            DeleteOne(signals_);
            break;
        }
    }

    void Remove() {
        Netlist& netlist = ChooseNetlist();
        switch (Next() % 4) {
        case 0:
            netlist.Remove(Choose(Components()));
            break;
        case 1:
            netlist.Remove(Choose(Instances()));
            break;
        default:
            netlist.Remove(Choose(Signals()));
            break;
        }
    }

    void AdoptSignal(std::size_t index) {
        Netlist& netlist = ChooseNetlist();
        netlist.Add(signals_[index].get());
        netlist.Add(signals_[index].get());
        netlists_[0]->Add(signals_[index].get());
        static_cast<void>(signals_[index].release());
        signals_.erase(signals_.begin() + static_cast<std::ptrdiff_t>(index));
    }

    void Adopt() {
        if (!signals_.empty() && Next() % 2 == 0) {
            AdoptSignal(Next() % signals_.size());
        } else if (!components_.empty() && Next() % 2 == 0) {
            ChooseNetlist().Add(components_.back().release());
            components_.pop_back();
        } else if (!instances_.empty()) {
            ChooseNetlist().Add(instances_.back().release());
            instances_.pop_back();
        } else {
            std::vector<Signal*> owned;
            Append(owned, ChooseNetlist().GetSignalIterator());
            ChooseNetlist().Add(Choose(owned));
        }
    }

    void Rename() {
        Object* object = nullptr;
        switch (Next() % 4) {
        case 0:
            object = Choose(Components());
            break;
        case 1:
            object = Choose(Instances());
            break;
        case 2:
            object = Choose(Pins());
            break;
        default:
            object = Choose(Signals());
            break;
        }
        if (object != nullptr) {
            object->SetName(ChooseName());
        }
    }

    void SetPolarity() {
        if (Signal* signal = Choose(Signals())) {
            signal->SetPortPolarity(Polarity(static_cast<int>(Next() % 4) - 1));
        }
    }

    void Prepare() {
        Netlist& netlist = ChooseNetlist();
        switch (Next() % 6) {
        case 0:
            netlist.SortNetlist();
            break;
        case 1:
            netlist.ConnectOpenPinToDummy();
            break;
        case 2:
            netlist.SetBoxTypeAttribute();
            break;
        case 3:
            netlist.CreateVerilogDummySignals();
            break;
        default:
            netlist.CreateVhdlDummySignals();
            break;
        }
    }

    void ReplaceNetlist() {
        if (Next() % 4 == 0) {
            netlists_[Next() % 2] = std::make_unique<Netlist>("new");
        }
    }

    void CopyPin() {
        auto* target = dynamic_cast<ScalarPin*>(Choose(Pins()));
        const auto* source = dynamic_cast<ScalarPin*>(Choose(Pins()));
        if (target != nullptr && source != nullptr) {
            const Signal* before = target->GetSignal();
            *target = *source;
            RC_ASSERT(target->GetSignal() == before);
        }
    }

    void Dress() {
        if (Signal* signal = Choose(Signals())) {
            signal->AssignConstantValue(Next() % 2 == 0 ? "8:H:A5" : "");
            signal->AddAttr(new AttributeString(ChooseName(), "v"));
            signal->AddComment("comment");
        }
    }

    std::array<unsigned, 4> choice_{};
    unsigned next_ = 0;
    std::array<std::unique_ptr<Netlist>, 2> netlists_;
    std::vector<std::unique_ptr<Signal>> signals_;
    std::vector<std::unique_ptr<Component>> components_;
    std::vector<std::unique_ptr<Instance>> instances_;
    std::vector<std::unique_ptr<Pin>> pins_;
};

RC_GTEST_PROP(Lifetime, NothingEverNamesADeadObject, ()) {
    const auto steps = *rc::gen::scale(
        3.0, rc::gen::container<std::vector<std::array<unsigned, 4>>>(rc::gen::map(
                 rc::gen::tuple(rc::gen::inRange(0u, 1000u), rc::gen::inRange(0u, 1000u),
                                rc::gen::inRange(0u, 1000u), rc::gen::inRange(0u, 1000u)),
                 [](const std::tuple<unsigned, unsigned, unsigned, unsigned>& values) {
                     const auto [a, b, c, d] = values;
                     return std::array<unsigned, 4>{a, b, c, d};
                 })));
    World world;
    for (const std::array<unsigned, 4>& step : steps) {
        world.Step(step);
        world.ExpectConsistent();
    }
}

} // namespace
