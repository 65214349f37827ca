#include "Orn_Hdl/Model.h"

#include "Support/Names.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace {

using namespace Orn_Hdl;

using Calls = std::vector<std::string>;

std::string Call(const char* operation, const Object* object) {
    return std::string(operation) + " " + std::string(object->GetNameView());
}

class ObjectRecorder : public ObjectVisitor {
public:
    void VisitAttribute(Attribute* object) override { calls.push_back(Call("attribute", object)); }
    void VisitSignal(Signal* object) override { calls.push_back(Call("signal", object)); }
    void VisitComponent(Component* object) override { calls.push_back(Call("component", object)); }
    void VisitPin(Pin* object) override { calls.push_back(Call("pin", object)); }
    void VisitInstance(Instance* object) override { calls.push_back(Call("instance", object)); }
    void VisitNetlist(Netlist* object) override { calls.push_back(Call("netlist", object)); }

    Calls calls;
};

class SignalRecorder : public SignalVisitor {
public:
    void VisitSignal(Signal* signal) override { calls.push_back(Call("signal", signal)); }
    void VisitScalarSignal(ScalarSignal* signal) override {
        calls.push_back(Call("scalar", signal));
    }
    void VisitBus(Bus* bus) override { calls.push_back(Call("bus", bus)); }
    void VisitBusSlice(BusSlice* slice) override { calls.push_back(Call("slice", slice)); }
    void VisitBusIndex(BusIndex* bit) override { calls.push_back(Call("bit", bit)); }
    void VisitCompoundBus(CompoundBus* compound) override {
        calls.push_back(Call("compound", compound));
    }

    Calls calls;
};

class PinRecorder : public PinVisitor {
public:
    void VisitPin(Pin* pin) override { calls.push_back(Call("pin", pin)); }
    void VisitScalarPin(ScalarPin* pin) override { calls.push_back(Call("scalar", pin)); }
    void VisitBusPin(BusPin* pin) override { calls.push_back(Call("bus", pin)); }
    void VisitBusIndexPin(BusIndexPin* pin) override { calls.push_back(Call("bit", pin)); }

    Calls calls;
};

TEST(ObjectVisitor, MeetsEachObjectByItsKind) {
    AttributeInteger attribute("a", "1");
    ScalarSignal scalar("s");
    Bus bus("b(1:0)");
    BusSlice slice("b(1:1)", &bus);
    BusIndex bit("b(0)", &bus);
    CompoundBus compound("s,b(0)");
    Component component("c");
    ScalarPin pin("p", Polarity("in"));
    BusPin busPin("q(1:0)", Polarity("in"));
    BusIndexPin bitPin("q(0)", Polarity("in"));
    Instance instance("i", &component);
    Netlist netlist("n");
    ObjectRecorder recorder;
    Object* const objects[] = {&attribute, &scalar, &bus,    &slice,  &bit,      &compound,
                               &component, &pin,    &busPin, &bitPin, &instance, &netlist};
    for (Object* object : objects) {
        object->AcceptObject(recorder);
    }
    EXPECT_EQ(recorder.calls, (Calls{"attribute a", "signal s", "signal b(1:0)", "signal b(1:1)",
                                     "signal b(0)", "signal s,b(0)", "component c", "pin p",
                                     "pin q(1:0)", "pin q(0)", "instance i", "netlist n"}));
}

TEST(SignalVisitor, MeetsEachSignalTwiceTheSpecificCallFirst) {
    ScalarSignal scalar("s");
    Bus bus("b(1:0)");
    BusSlice slice("b(1:1)", &bus);
    BusIndex bit("b(0)", &bus);
    CompoundBus compound("s,b(0)");
    SignalRecorder recorder;
    Signal* const signals[] = {&scalar, &bus, &slice, &bit, &compound};
    for (Signal* signal : signals) {
        signal->AcceptSignal(recorder);
    }
    EXPECT_EQ(recorder.calls, (Calls{"scalar s", "signal s", "bus b(1:0)", "signal b(1:0)",
                                     "slice b(1:1)", "signal b(1:1)", "bit b(0)", "signal b(0)",
                                     "compound s,b(0)", "signal s,b(0)"}));
}

TEST(PinVisitor, MeetsEachPinOnce) {
    ScalarPin pin("p", Polarity("in"));
    BusPin busPin("q(1:0)", Polarity("in"));
    BusIndexPin bitPin("q(0)", Polarity("in"));
    PinRecorder recorder;
    Pin* const pins[] = {&pin, &busPin, &bitPin};
    for (Pin* each : pins) {
        each->AcceptPin(recorder);
    }
    EXPECT_EQ(recorder.calls, (Calls{"scalar p", "bus q(1:0)", "bit q(0)"}))
        << "the general operation is never called";
}

TEST(Visitors, OfTheBaseChangeNothing) {
    ObjectVisitor objects;
    SignalVisitor signals;
    PinVisitor pins;
    const ObjectVisitor objectsCopy(objects);
    const SignalVisitor signalsCopy(signals);
    const PinVisitor pinsCopy(pins);
    objects = objectsCopy;
    signals = signalsCopy;
    pins = pinsCopy;
    ScalarSignal signal("s");
    BusPin pin("p(1:0)", Polarity("in"));
    signal.Connect(&pin);
    signal.AcceptObject(objects);
    signal.AcceptSignal(signals);
    pin.AcceptObject(objects);
    pin.AcceptPin(pins);
    pins.VisitPin(&pin);
    signals.VisitSignal(nullptr);
    objects.VisitNetlist(nullptr);
    EXPECT_EQ(Support::NamesOf(signal.GetPinIterator()), Support::Names{"p(1:0)"});
    EXPECT_EQ(pin.GetSignal(), &signal);
    EXPECT_EQ(signal.GetName(), "s");
}

TEST(Visitors, AnOperationLeftOutIsNoOther) {
    class OnlyBuses : public SignalVisitor {
    public:
        void VisitBus(Bus* bus) override { calls.push_back(Call("bus", bus)); }

        Calls calls;
    };
    ScalarSignal scalar("s");
    Bus bus("b(1:0)");
    OnlyBuses visitor;
    scalar.AcceptSignal(visitor);
    bus.AcceptSignal(visitor);
    EXPECT_EQ(visitor.calls, Calls{"bus b(1:0)"});
}

} // namespace
