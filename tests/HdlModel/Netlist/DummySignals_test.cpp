#include "Orn_Hdl/Model.h"

#include "Support/Names.h"
#include "Support/Parts.h"
#include "Support/SlowStringSet.h"

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

/// A netlist of buffers.
class DummySignals : public testing::Test {
protected:
    DummySignals() {
        component_ = Support::MakeBuffer().release();
        netlist_.Add(component_);
    }

    Instance* AddBuffer(const char* name) {
        auto* instance = new Instance(name, component_);
        netlist_.Add(instance);
        return instance;
    }

    ScalarSignal* AddScalar(const char* name, const Polarity& polarity = Polarity()) {
        auto* signal = new ScalarSignal(name);
        signal->SetPortPolarity(polarity);
        netlist_.Add(signal);
        return signal;
    }

    Bus* AddBus(const char* name, const Polarity& polarity = Polarity()) {
        auto* bus = new Bus(name);
        bus->SetPortPolarity(polarity);
        netlist_.Add(bus);
        return bus;
    }

    BusIndex* AddBit(const char* name, Bus* bus) {
        auto* bit = new BusIndex(name, bus);
        netlist_.Add(bit);
        return bit;
    }

    BusSlice* AddSlice(const char* name, Bus* bus) {
        auto* slice = new BusSlice(name, bus);
        netlist_.Add(slice);
        return slice;
    }

    CompoundBus* AddCompound(const char* name, const std::vector<Signal*>& members) {
        auto* compound = new CompoundBus(name);
        for (Signal* member : members) {
            compound->AddBusMember(member);
        }
        netlist_.Add(compound);
        return compound;
    }

    Names Signals() const { return NamesOf(netlist_.GetSignalIterator()); }
    Signal* Get(const char* name) const { return netlist_.GetSignal(name); }

    /// A port that is driven by the output of one buffer and read by the input of another.
    ScalarSignal* AddFeedback(const char* name, const Polarity& polarity) {
        ScalarSignal* signal = AddScalar(name, polarity);
        driver_ = AddBuffer((std::string("drive_") + name).c_str())->GetPin("O");
        reader_ = AddBuffer((std::string("read_") + name).c_str())->GetPin("I");
        signal->Connect(driver_);
        signal->Connect(reader_);
        return signal;
    }

    Netlist netlist_{"top"};
    Component* component_;
    Pin* driver_ = nullptr;
    Pin* reader_ = nullptr;
};

TEST_F(DummySignals, AnOutputPortThatIsReadInsideGetsOneForVhdl) {
    ScalarSignal* port = AddFeedback("Y", Out);
    netlist_.CreateVhdlDummySignals();
    EXPECT_EQ(Signals(), (Names{"Y", "Y_DUMMY"}));
    Signal* dummy = Get("Y_DUMMY");
    EXPECT_EQ(dummy->GetSignalType(), 50);
    EXPECT_FALSE(dummy->IsPort());
    EXPECT_EQ(driver_->GetSignal(), dummy);
    EXPECT_EQ(reader_->GetSignal(), dummy);
    EXPECT_EQ(NamesOf(dummy->GetPinIterator()), (Names{"O", "I"}));
    EXPECT_EQ(NamesOf(port->GetSignalIterator()), Names{"Y_DUMMY"});
    EXPECT_EQ(NamesOf(dummy->GetSignalIterator()), Names());
    EXPECT_FALSE(port->HasMultiDriver());
}

TEST_F(DummySignals, AnInputPortThatIsDrivenInsideGetsOneInBothLanguages) {
    for (const bool vhdl : {true, false}) {
        const char* name = vhdl ? "A" : "B";
        ScalarSignal* port = AddFeedback(name, In);
        if (vhdl) {
            netlist_.CreateVhdlDummySignals();
        } else {
            netlist_.CreateVerilogDummySignals();
        }
        Signal* dummy = Get((std::string(name) + "_DUMMY").c_str());
        ASSERT_NE(dummy, nullptr);
        EXPECT_EQ(driver_->GetSignal(), dummy);
        EXPECT_EQ(reader_->GetSignal(), dummy);
        EXPECT_EQ(NamesOf(dummy->GetSignalIterator()), Names{name});
        EXPECT_EQ(NamesOf(port->GetSignalIterator()), Names());
    }
    EXPECT_EQ(Signals(), (Names{"A", "A_DUMMY", "B", "B_DUMMY"}));
}

TEST_F(DummySignals, VerilogNeedsNoneForAnOutputPortThatIsRead) {
    AddFeedback("Y", Out);
    netlist_.CreateVerilogDummySignals();
    EXPECT_EQ(Signals(), Names{"Y"});
    EXPECT_EQ(driver_->GetSignal(), Get("Y"));
}

TEST_F(DummySignals, OnlyPortsOfTheWrongUseGetOne) {
    AddFeedback("internal", Polarity());
    AddFeedback("both", Polarity("bi"));
    ScalarSignal* driven = AddScalar("driven", Out);
    driven->Connect(AddBuffer("U1")->GetPin("O"));
    ScalarSignal* read = AddScalar("read", In);
    read->Connect(AddBuffer("U2")->GetPin("I"));
    const Names before = Signals();
    netlist_.CreateVhdlDummySignals();
    netlist_.CreateVerilogDummySignals();
    EXPECT_EQ(Signals(), before);
}

TEST_F(DummySignals, ABidirectionalPinReadsAndDrives) {
    Pin* const driver = AddBuffer("U1")->GetPin("B");
    Pin* const reader = AddBuffer("U2")->GetPin("B");
    AddScalar("Y", Out)->Connect(driver);
    AddScalar("A", In)->Connect(reader);
    netlist_.CreateVhdlDummySignals();
    EXPECT_EQ(Signals(), (Names{"Y", "A", "Y_DUMMY", "A_DUMMY"}));
    EXPECT_EQ(driver->GetSignal(), Get("Y_DUMMY"));
    EXPECT_EQ(reader->GetSignal(), Get("A_DUMMY"));
}

TEST_F(DummySignals, AnOutputPortWithSeveralDriversGetsOneForVhdl) {
    ScalarSignal* port = AddScalar("Y", Out);
    Pin* first = AddBuffer("U1")->GetPin("O");
    Pin* second = AddBuffer("U2")->GetPin("O");
    port->Connect(first);
    port->Connect(second);
    netlist_.CreateVerilogDummySignals();
    EXPECT_EQ(Signals(), Names{"Y"});
    netlist_.CreateVhdlDummySignals();
    EXPECT_EQ(Signals(), (Names{"Y", "Y_DUMMY"}));
    EXPECT_EQ(first->GetSignal(), Get("Y_DUMMY"));
    EXPECT_EQ(second->GetSignal(), Get("Y_DUMMY"));
    EXPECT_EQ(NamesOf(port->GetSignalIterator()), Names{"Y_DUMMY"});
}

TEST_F(DummySignals, TakeAliasesAndConstantOfAnOutputPortAway) {
    ScalarSignal* port = AddFeedback("Y", Out);
    port->Connect(AddScalar("X"));
    port->AssignConstantValue("1");
    netlist_.CreateVhdlDummySignals();
    Signal* dummy = Get("Y_DUMMY");
    ASSERT_NE(dummy, nullptr);
    EXPECT_EQ(NamesOf(dummy->GetSignalIterator()), Names{"X"});
    EXPECT_EQ(dummy->GetConstantValue().GetValue(), "1");
    EXPECT_EQ(NamesOf(port->GetSignalIterator()), Names{"Y_DUMMY"}) << "one driver only";
    EXPECT_EQ(port->GetConstantValue().GetValue(), "");
}

TEST_F(DummySignals, TakePinsAndAliasesOverInTheirOrder) {
    ScalarSignal* const port = AddScalar("Y", Out);
    const Names names{"c", "a", "d", "b"};
    std::vector<Pin*> pins;
    for (const std::string& name : names) {
        pins.push_back(AddBuffer(name.c_str())->GetPin("I"));
        port->Connect(pins.back());
        port->Connect(AddScalar(name.c_str()));
    }
    netlist_.CreateVhdlDummySignals();
    const Signal* const dummy = Get("Y_DUMMY");
    ASSERT_NE(dummy, nullptr);
    std::vector<Pin*> taken;
    for (Pin* pin : dummy->GetPinIterator()) {
        taken.push_back(pin);
    }
    EXPECT_EQ(taken, pins);
    EXPECT_EQ(NamesOf(dummy->GetSignalIterator()), names);
}

TEST_F(DummySignals, LeaveAliasesAndConstantOfAnInputPort) {
    ScalarSignal* port = AddFeedback("A", In);
    port->Connect(AddScalar("X"));
    port->AssignConstantValue("1");
    netlist_.CreateVerilogDummySignals();
    EXPECT_EQ(NamesOf(port->GetSignalIterator()), Names{"X"});
    EXPECT_EQ(port->GetConstantValue().GetValue(), "1");
    EXPECT_EQ(NamesOf(Get("A_DUMMY")->GetSignalIterator()), (Names{"X", "A"}));
    EXPECT_EQ(Get("A_DUMMY")->GetConstantValue().GetValue(), "");
}

TEST_F(DummySignals, OfABusComeWithThoseOfItsSlicesAndBits) {
    Bus* bus = AddBus("D(3:0)", Out);
    BusSlice* slice = AddSlice("D(1:0)", bus);
    BusIndex* bit = AddBit("D(3)", bus);
    Pin* driver = AddBuffer("U1")->GetPin("O");
    Pin* reader = AddBuffer("U2")->GetPin("I");
    Pin* sliceReader = AddBuffer("U3")->GetPin("I");
    bit->Connect(driver);
    bit->Connect(reader);
    slice->Connect(sliceReader);
    bit->AssignConstantValue("1");
    netlist_.CreateVhdlDummySignals();
    EXPECT_EQ(Signals(),
              (Names{"D(3:0)", "D(1:0)", "D(3)", "D_DUMMY(3:0)", "D_DUMMY(1:0)", "D_DUMMY(3)"}));
    EXPECT_EQ(Get("D_DUMMY(3:0)")->GetSignalType(), 51);
    EXPECT_EQ(Get("D_DUMMY(1:0)")->GetSignalType(), 52);
    EXPECT_EQ(Get("D_DUMMY(3)")->GetSignalType(), 53);
    EXPECT_EQ(NamesOf(netlist_.GetParentBus("D_DUMMY")->GetBusSliceIterator()),
              (Names{"D_DUMMY(1:0)", "D_DUMMY(3)"}));
    EXPECT_EQ(driver->GetSignal(), Get("D_DUMMY(3)"));
    EXPECT_EQ(reader->GetSignal(), Get("D_DUMMY(3)"));
    EXPECT_EQ(sliceReader->GetSignal(), Get("D_DUMMY(1:0)"));
    EXPECT_EQ(NamesOf(bus->GetSignalIterator()), Names{"D_DUMMY(3:0)"});
    EXPECT_EQ(NamesOf(slice->GetSignalIterator()), Names());
    EXPECT_EQ(NamesOf(bit->GetSignalIterator()), Names());
    EXPECT_EQ(bit->GetConstantValue().GetValue(), "") << "the port keeps one driver";
    EXPECT_EQ(Get("D_DUMMY(3)")->GetConstantValue().GetValue(), "1");
}

TEST_F(DummySignals, OfAnInputBusAreConnectedTheOtherWay) {
    Bus* bus = AddBus("D(3:0)", In);
    bus->Connect(AddBuffer("U1")->GetPin("O"));
    netlist_.CreateVerilogDummySignals();
    EXPECT_EQ(Signals(), (Names{"D(3:0)", "D_DUMMY(3:0)"}));
    EXPECT_EQ(NamesOf(Get("D_DUMMY(3:0)")->GetSignalIterator()), Names{"D(3:0)"});
    EXPECT_EQ(NamesOf(bus->GetSignalIterator()), Names());
}

TEST_F(DummySignals, ReplaceTheirSignalsInEveryCompound) {
    ScalarSignal* port = AddFeedback("Y", Out);
    ScalarSignal* other = AddScalar("N");
    Bus* bus = AddBus("D(3:0)", Out);
    BusIndex* bit = AddBit("D(3)", bus);
    BusSlice* slice = AddSlice("D(1:0)", bus);
    bit->Connect(AddBuffer("U1")->GetPin("I"));
    CompoundBus* compound =
        AddCompound("N,Y,D(3:0),D(3),D(1:0),Y", {other, port, bus, bit, slice, port});
    netlist_.CreateVhdlDummySignals();
    EXPECT_EQ(NamesOf(compound->GetBusMemberIterator()),
              (Names{"N", "Y_DUMMY", "D_DUMMY(3:0)", "D_DUMMY(3)", "D_DUMMY(1:0)", "Y_DUMMY"}));
}

TEST_F(DummySignals, OfACompoundHasTheMembersThatHaveNoneThemselves) {
    ScalarSignal* port = AddScalar("Y", Out);
    ScalarSignal* other = AddScalar("N");
    CompoundBus* compound = AddCompound("N,Y", {other, port});
    Pin* reader = AddBuffer("U1")->GetPin("I");
    compound->Connect(reader);
    netlist_.CreateVhdlDummySignals();
    EXPECT_EQ(Signals(), (Names{"Y", "N", "N,Y", "Y_DUMMY", "N_DUMMY,Y_DUMMY"}));
    EXPECT_EQ(NamesOf(compound->GetBusMemberIterator()), (Names{"N", "Y_DUMMY"}));
    Signal* dummy = Get("N_DUMMY,Y_DUMMY");
    ASSERT_NE(dummy, nullptr);
    EXPECT_EQ(dummy->GetSignalType(), 54);
    EXPECT_EQ(NamesOf(dynamic_cast<CompoundBus&>(*dummy).GetBusMemberIterator()),
              (Names{"N", "Y_DUMMY"}));
    EXPECT_EQ(reader->GetSignal(), dummy);
}

TEST_F(DummySignals, AreMadeOnceHoweverOftenAndInWhateverOrder) {
    AddFeedback("Y", Out);
    AddFeedback("A", In);
    Bus* bus = AddBus("D(3:0)", Out);
    BusIndex* bit = AddBit("D(3)", bus);
    bit->Connect(AddBuffer("U1")->GetPin("I"));
    CompoundBus* compound = AddCompound("Y,D(3)", {Get("Y"), bit});
    compound->Connect(AddBuffer("U2")->GetPin("I"));
    netlist_.CreateVhdlDummySignals();
    const Names once = Signals();
    std::vector<Names> aliases;
    for (Signal* signal : netlist_.GetSignalIterator()) {
        aliases.push_back(NamesOf(signal->GetSignalIterator()));
    }
    for (int i = 0; i < 3; ++i) {
        netlist_.CreateVerilogDummySignals();
        netlist_.CreateVhdlDummySignals();
        EXPECT_EQ(Signals(), once);
    }
    std::size_t at = 0;
    for (Signal* signal : netlist_.GetSignalIterator()) {
        EXPECT_EQ(NamesOf(signal->GetSignalIterator()), aliases[at]) << signal->GetNameView();
        ++at;
    }
}

TEST_F(DummySignals, TakeOverWhatTheirSignalsGainLater) {
    ScalarSignal* port = AddFeedback("Y", Out);
    netlist_.CreateVhdlDummySignals();
    Pin* late = AddBuffer("late")->GetPin("I");
    port->Connect(late);
    port->Connect(AddScalar("X"));
    port->AssignConstantValue("1");
    netlist_.CreateVerilogDummySignals();
    Signal* dummy = Get("Y_DUMMY");
    EXPECT_EQ(late->GetSignal(), dummy);
    EXPECT_EQ(NamesOf(port->GetSignalIterator()), Names{"Y_DUMMY"});
    EXPECT_EQ(NamesOf(dummy->GetSignalIterator()), Names{"X"});
    EXPECT_EQ(dummy->GetConstantValue().GetValue(), "1");
    port->AssignConstantValue("0");
    netlist_.CreateVhdlDummySignals();
    EXPECT_EQ(dummy->GetConstantValue().GetValue(), "0") << "the later constant replaces it";
    EXPECT_EQ(port->GetConstantValue().GetValue(), "");
}

TEST_F(DummySignals, OfABusComeLaterForSlicesAndBitsThatComeLater) {
    Bus* bus = AddBus("D(3:0)", Out);
    bus->Connect(AddBuffer("U1")->GetPin("I"));
    netlist_.CreateVhdlDummySignals();
    BusIndex* bit = AddBit("D(2)", bus);
    Pin* reader = AddBuffer("U2")->GetPin("I");
    bit->Connect(reader);
    netlist_.CreateVhdlDummySignals();
    ASSERT_NE(Get("D_DUMMY(2)"), nullptr);
    EXPECT_EQ(reader->GetSignal(), Get("D_DUMMY(2)"));
    EXPECT_EQ(NamesOf(netlist_.GetParentBus("D_DUMMY")->GetBusSliceIterator()),
              Names{"D_DUMMY(2)"});
}

TEST_F(DummySignals, ReplaceTheirSignalsInLaterCompoundsAtTheNextWrite) {
    ScalarSignal* port = AddFeedback("Y", Out);
    netlist_.CreateVhdlDummySignals();
    CompoundBus* compound = AddCompound("Y,N", {port, AddScalar("N")});
    netlist_.CreateVhdlDummySignals();
    EXPECT_EQ(NamesOf(compound->GetBusMemberIterator()), (Names{"Y_DUMMY", "N"}));
}

TEST_F(DummySignals, AreNotMadeWhereTheirNameIsTaken) {
    ScalarSignal* port = AddFeedback("Y", Out);
    ScalarSignal* taken = AddScalar("y_dummy");
    netlist_.CreateVhdlDummySignals();
    EXPECT_EQ(Signals(), (Names{"Y", "y_dummy"}));
    EXPECT_EQ(driver_->GetSignal(), port);
    EXPECT_EQ(NamesOf(port->GetSignalIterator()), Names());
    EXPECT_EQ(NamesOf(taken->GetPinIterator()), Names());
}

TEST_F(DummySignals, AreNotMadeForASignalThatBearsItsOwnDummyName) {
    AddFeedback("Y_DUMMY", Out);
    netlist_.CreateVhdlDummySignals();
    netlist_.CreateVhdlDummySignals();
    EXPECT_EQ(Signals(), Names{"Y_DUMMY"});
    EXPECT_EQ(driver_->GetSignal(), Get("Y_DUMMY"));
}

TEST_F(DummySignals, OfABusAreNotMadeWhereTheirBaseNameIsTaken) {
    Bus* bus = AddBus("D(3:0)", Out);
    BusIndex* bit = AddBit("D(3)", bus);
    Pin* reader = AddBuffer("U1")->GetPin("I");
    bit->Connect(reader);
    AddBus("D_DUMMY(7:0)");
    netlist_.CreateVhdlDummySignals();
    EXPECT_EQ(Signals(), (Names{"D(3:0)", "D(3)", "D_DUMMY(7:0)"}));
    EXPECT_EQ(reader->GetSignal(), bit);
}

TEST_F(DummySignals, AreForgottenWhenTheyAreRemoved) {
    ScalarSignal* port = AddFeedback("Y", Out);
    netlist_.CreateVhdlDummySignals();
    netlist_.Remove(Get("Y_DUMMY"));
    EXPECT_EQ(driver_->GetSignal(), nullptr);
    EXPECT_EQ(NamesOf(port->GetSignalIterator()), Names());
    netlist_.CreateVhdlDummySignals();
    EXPECT_EQ(Signals(), Names{"Y"});
    port->Connect(driver_);
    port->Connect(reader_);
    netlist_.CreateVhdlDummySignals();
    EXPECT_EQ(Signals(), (Names{"Y", "Y_DUMMY"}));
    EXPECT_EQ(reader_->GetSignal(), Get("Y_DUMMY"));
}

TEST_F(DummySignals, AreForgottenWithManyPortsAndMadeAnew) {
    std::vector<Signal*> ports;
    const auto addPort = [&](int i) {
        const std::string number = std::to_string(i);
        ports.push_back(new ScalarSignal(("P" + number).c_str()));
        ports.back()->SetPortPolarity(In);
        netlist_.Add(ports.back());
        ports.back()->Connect(AddBuffer(("U" + number).c_str())->GetPin("O"));
    };
    for (int i = 0; i < 20; ++i) {
        addPort(i);
    }
    netlist_.CreateVerilogDummySignals();
    // Every third port stays.
    for (int i = 0; i < 20; ++i) {
        if (i % 3 != 0) {
            netlist_.Remove(ports[static_cast<std::size_t>(i)]);
        }
    }
    addPort(20);
    netlist_.CreateVerilogDummySignals();
    for (int i = 0; i < 21; ++i) {
        const std::string name = "P" + std::to_string(i);
        const Signal* const port = netlist_.GetSignal(name.c_str());
        EXPECT_EQ(port != nullptr, i % 3 == 0 || i == 20) << name;
        if (port != nullptr) {
            Signal* const dummy = netlist_.GetSignal(port->GetDummySignalName().CStr());
            ASSERT_NE(dummy, nullptr) << name;
            EXPECT_EQ(
                netlist_.GetInstance(("U" + name.substr(1)).c_str())->GetPin("O")->GetSignal(),
                dummy);
            // Later gains are taken over still.
            const std::string later = "V" + name;
            netlist_.GetSignal(name.c_str())->Connect(AddBuffer(later.c_str())->GetPin("O"));
            netlist_.CreateVerilogDummySignals();
            EXPECT_EQ(netlist_.GetInstance(later.c_str())->GetPin("O")->GetSignal(), dummy);
        }
    }
}

TEST_F(DummySignals, OutliveTheirSignals) {
    ScalarSignal* port = AddFeedback("Y", Out);
    Bus* bus = AddBus("D(3:0)", Out);
    BusIndex* bit = AddBit("D(3)", bus);
    bit->Connect(AddBuffer("U1")->GetPin("I"));
    netlist_.CreateVhdlDummySignals();
    netlist_.Remove(port);
    netlist_.Remove(bit);
    netlist_.CreateVhdlDummySignals();
    netlist_.Remove(bus);
    netlist_.CreateVhdlDummySignals();
    netlist_.CreateVerilogDummySignals();
    EXPECT_EQ(driver_->GetSignal(), Get("Y_DUMMY"));
    EXPECT_EQ(Signals(), (Names{"D_DUMMY(3:0)", "D_DUMMY(3)", "Y_DUMMY"}));
}

TEST_F(DummySignals, FollowTheOrderOfTheNameSet) {
    // Enough names to let the set grow; then, in the set that has grown, those of the second step.
    Support::SlowStringSet set;
    Names expected;
    for (int i = 0; i < 300; ++i) {
        const std::string name = "P" + std::to_string(i * 7 % 300);
        AddFeedback(name.c_str(), Out);
        set.Add(name);
        expected.push_back(name);
    }
    for (int i = 0; i < 150; ++i) {
        const std::string name = "Q" + std::to_string(i);
        AddFeedback(name.c_str(), In);
        expected.push_back(name);
    }
    for (const std::string& name : set.Walk()) {
        expected.push_back(name + "_DUMMY");
    }
    set.Empty();
    for (int i = 0; i < 150; ++i) {
        set.Add("Q" + std::to_string(i));
    }
    for (const std::string& name : set.Walk()) {
        expected.push_back(name + "_DUMMY");
    }
    netlist_.CreateVhdlDummySignals();
    EXPECT_EQ(Signals(), expected);
}

TEST_F(DummySignals, OfCompoundsComeAfterAllOthers) {
    ScalarSignal* first = AddScalar("A", Out);
    ScalarSignal* second = AddScalar("B", Out);
    CompoundBus* compound = AddCompound("A,B", {first, second});
    compound->Connect(AddBuffer("U1")->GetPin("I"));
    second->Connect(AddBuffer("U2")->GetPin("I"));
    netlist_.CreateVhdlDummySignals();
    const Names signals = Signals();
    ASSERT_EQ(signals.size(), 6u);
    EXPECT_EQ(signals.back(), "A_DUMMY,B_DUMMY");
    EXPECT_EQ(NamesOf(dynamic_cast<CompoundBus&>(*Get("A_DUMMY,B_DUMMY")).GetBusMemberIterator()),
              (Names{"A_DUMMY", "B_DUMMY"}));
}

TEST_F(DummySignals, AreMadeForUsesThroughPartsAndCompoundsThatNoNetlistHolds) {
    Bus* const bus = AddBus("D(7:0)", Out);
    Bus* const driven = AddBus("E(7:0)", In);
    ScalarSignal* const scalar = AddScalar("Y", Out);
    {
        BusIndex bit("D(3)", bus);
        bit.Connect(AddBuffer("U1")->GetPin("I"));
        netlist_.CreateVhdlDummySignals();
        EXPECT_NE(Get("D_DUMMY(7:0)"), nullptr);
        EXPECT_NE(Get("D_DUMMY(3)"), nullptr);
    }
    {
        BusSlice slice("E(3:0)", driven);
        slice.Connect(AddBuffer("U2")->GetPin("O"));
        netlist_.CreateVerilogDummySignals();
        EXPECT_NE(Get("E_DUMMY(7:0)"), nullptr);
    }
    CompoundBus compound("Y,A");
    compound.AddBusMember(scalar);
    compound.AddBusMember(AddScalar("A"));
    compound.Connect(AddBuffer("U3")->GetPin("I"));
    netlist_.CreateVhdlDummySignals();
    EXPECT_NE(Get("Y_DUMMY"), nullptr);
    EXPECT_EQ(compound.GetAt(0), Get("Y_DUMMY"));
}

TEST_F(DummySignals, APartThatNoNetlistHoldsMayEnd) {
    Bus* const bus = AddBus("D(7:0)", Out);
    auto part = std::make_unique<BusIndex>("D(3)", bus);
    part->Connect(AddBuffer("U1")->GetPin("I"));
    part->Connect(AddBuffer("U2")->GetPin("O"));
    bus->Connect(AddBuffer("U3")->GetPin("I"));
    netlist_.CreateVhdlDummySignals();
    ASSERT_NE(netlist_.GetSignal("D_DUMMY(3)"), nullptr);
    part.reset();
    netlist_.CreateVhdlDummySignals();
    EXPECT_NE(netlist_.GetSignal("D_DUMMY(3)"), nullptr);
    // A new part of that name gets no second dummy, since the name is taken.
    const BusIndex again("D(3)", bus);
    netlist_.CreateVhdlDummySignals();
    EXPECT_EQ(NamesOf(bus->GetBusSliceIterator()), Names({"D(3)"}));
}

TEST_F(DummySignals, APartMayOutliveTheNetlist) {
    auto other = std::make_unique<Netlist>();
    auto* const bus = new Bus("D(7:0)");
    bus->SetPortPolarity(Out);
    other->Add(bus);
    BusSlice part("D(3:0)", bus);
    auto* const instance = new Instance("U1", component_);
    other->Add(instance);
    bus->Connect(instance->GetPin("I"));
    other->CreateVhdlDummySignals();
    ASSERT_NE(other->GetSignal("D_DUMMY(3:0)"), nullptr);
    other.reset();
    EXPECT_EQ(part.GetParentBus(), nullptr);
}

TEST_F(DummySignals, APartOfAnotherNetlistMayEndFirst) {
    Bus* const bus = AddBus("D(7:0)", Out);
    auto other = std::make_unique<Netlist>();
    auto* const otherBus = new Bus("D(7:0)");
    otherBus->SetPortPolarity(Out);
    other->Add(otherBus);
    auto* const instance = new Instance("U1", component_);
    netlist_.Add(instance);
    bus->Connect(instance->GetPin("I"));
    auto* const part = new BusSlice("D(3:0)", bus);
    other->Add(part);
    netlist_.CreateVhdlDummySignals();
    // Moved to the other bus it is remembered by the first netlist still.
    otherBus->AddBusSlice(part);
    Instance* const reader = AddBuffer("U2");
    otherBus->Connect(reader->GetPin("I"));
    other->CreateVhdlDummySignals();
    other.reset();
    netlist_.CreateVhdlDummySignals();
    EXPECT_EQ(reader->GetPin("I")->GetSignal(), nullptr);
}

} // namespace
