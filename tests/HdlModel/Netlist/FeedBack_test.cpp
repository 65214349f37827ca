#include "HdlModel/Netlist/FeedBack.h"

#include "Orn_Hdl/Model.h"
#include "Support/Parts.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>

namespace {

using namespace Orn_Hdl;
using Support::In;
using Support::Out;

/// A netlist of buffers with an input port, an output port and a net, used as they should be.
class MayNeedDummies : public testing::Test {
protected:
    MayNeedDummies() {
        netlist_.Add(component_);
        input_->Connect(AddPin("I"));
        output_->Connect(AddPin("O"));
        net_->Connect(AddPin("O"));
        net_->Connect(AddPin("O"));
        net_->Connect(AddPin("I"));
    }

    Pin* AddPin(const char* name) {
        auto* const instance = new Instance("U" + std::to_string(++instances_), component_);
        netlist_.Add(instance);
        return instance->GetPin(name);
    }

    template <class T> T* Add(T* signal, const Polarity& polarity = Polarity()) {
        signal->SetPortPolarity(polarity);
        netlist_.Add(signal);
        return signal;
    }

    bool Answer() const { return FeedBack::MayNeedDummies(netlist_); }

    Netlist netlist_{"top"};
    Component* const component_ = Support::MakeBuffer().release();
    int instances_ = 0;
    ScalarSignal* const input_ = Add(new ScalarSignal("A"), In);
    ScalarSignal* const output_ = Add(new ScalarSignal("Y"), Out);
    ScalarSignal* const net_ = Add(new ScalarSignal("N"));
};

TEST_F(MayNeedDummies, NotWherePortsAreUsedAsTheyShouldBe) {
    Bus* const bus = Add(new Bus("D(3:0)"), In);
    Add(new BusIndex("D(3)", bus))->Connect(AddPin("I"));
    EXPECT_FALSE(Answer());
}

TEST_F(MayNeedDummies, OfAnOutputPortThatIsReadInside) {
    output_->Connect(AddPin("I"));
    EXPECT_TRUE(Answer());
}

TEST_F(MayNeedDummies, OfAnOutputPortAtWhichAPinPointsWithoutBeingListed) {
    AddPin("I")->Connect(output_);
    EXPECT_TRUE(Answer());
}

TEST_F(MayNeedDummies, OfAnInputPortThatIsDrivenInside) {
    input_->Connect(AddPin("O"));
    EXPECT_TRUE(Answer());
}

TEST_F(MayNeedDummies, OfAnOutputPortWithSeveralDrivers) {
    output_->Connect(AddPin("O"));
    EXPECT_TRUE(Answer());
}

TEST_F(MayNeedDummies, OfAPartThatTheNetlistDoesNotHold) {
    Bus* const bus = Add(new Bus("D(3:0)"), Out);
    BusIndex bit("D(3)", bus);
    EXPECT_FALSE(Answer());
    bit.Connect(AddPin("I"));
    EXPECT_TRUE(Answer());
}

TEST_F(MayNeedDummies, OfACompoundThatIsConnected) {
    auto* const compound = new CompoundBus("N,Y");
    compound->AddBusMember(net_);
    compound->AddBusMember(output_);
    netlist_.Add(compound);
    EXPECT_FALSE(Answer());
    compound->Connect(AddPin("I"));
    EXPECT_TRUE(Answer());
}

TEST_F(MayNeedDummies, OfASignalInACompoundThatTheNetlistDoesNotHold) {
    CompoundBus compound("N,N");
    compound.AddBusMember(net_);
    EXPECT_TRUE(Answer());
}

TEST_F(MayNeedDummies, WhereThereAreSomeAlready) {
    Pin* const reader = AddPin("I");
    output_->Connect(reader);
    netlist_.CreateVhdlDummySignals();
    EXPECT_NE(reader->GetSignal(), output_);
    EXPECT_TRUE(Answer()) << "their signals may have got more pins";
    netlist_.Remove(netlist_.GetSignal("Y_DUMMY"));
    EXPECT_FALSE(Answer());
}

} // namespace
