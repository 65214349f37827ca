#include "Orn_Hdl/Model/ConstVisitors.h"

#include "Orn_Hdl/Model.h"
#include "Orn_Hdl/Model/Signals/SignalVisitor.h"

namespace Orn_Hdl {

// An object accepts visitors that may change it, and hands itself to them unchanged. So a visitor
// that passes it on as a constant changes nothing.
namespace {

class OnObject final : public ObjectVisitor {
public:
    explicit OnObject(ConstObjectVisitor& to) noexcept : to_(to) {}
    void VisitAttribute(Attribute* object) override { to_.VisitAttribute(object); }
    void VisitSignal(Signal* object) override { to_.VisitSignal(object); }
    void VisitComponent(Component* object) override { to_.VisitComponent(object); }
    void VisitPin(Pin* object) override { to_.VisitPin(object); }
    void VisitInstance(Instance* object) override { to_.VisitInstance(object); }
    void VisitNetlist(Netlist* object) override { to_.VisitNetlist(object); }

private:
    ConstObjectVisitor& to_;
};

class OnSignal final : public SignalVisitor {
public:
    explicit OnSignal(ConstSignalVisitor& to) noexcept : to_(to) {}
    void VisitSignal(Signal* signal) override { to_.VisitSignal(signal); }
    void VisitScalarSignal(ScalarSignal* signal) override { to_.VisitScalarSignal(signal); }
    void VisitBus(Bus* signal) override { to_.VisitBus(signal); }
    void VisitBusSlice(BusSlice* signal) override { to_.VisitBusSlice(signal); }
    void VisitBusIndex(BusIndex* signal) override { to_.VisitBusIndex(signal); }
    void VisitCompoundBus(CompoundBus* signal) override { to_.VisitCompoundBus(signal); }

private:
    ConstSignalVisitor& to_;
};

class OnPin final : public PinVisitor {
public:
    explicit OnPin(ConstPinVisitor& to) noexcept : to_(to) {}
    void VisitScalarPin(ScalarPin* pin) override { to_.VisitScalarPin(pin); }
    void VisitBusPin(BusPin* pin) override { to_.VisitBusPin(pin); }
    void VisitBusIndexPin(BusIndexPin* pin) override { to_.VisitBusIndexPin(pin); }

private:
    ConstPinVisitor& to_;
};

class OnAttribute final : public AttributeVisitor {
public:
    explicit OnAttribute(ConstAttributeVisitor& to) noexcept : to_(to) {}
    void VisitAttribute(Attribute* attribute) override { to_.VisitAttribute(attribute); }
    void VisitAttributeString(AttributeString* attribute) override {
        to_.VisitAttributeString(attribute);
    }
    void VisitAttributeInteger(AttributeInteger* attribute) override {
        to_.VisitAttributeInteger(attribute);
    }
    void VisitAttributeFloat(AttributeFloat* attribute) override {
        to_.VisitAttributeFloat(attribute);
    }
    void VisitAttributeBit(AttributeBit* attribute) override { to_.VisitAttributeBit(attribute); }
    void VisitAttributeBitVector(AttributeBitVector* attribute) override {
        to_.VisitAttributeBitVector(attribute);
    }
    void VisitAttributeBoolean(AttributeBoolean* attribute) override {
        to_.VisitAttributeBoolean(attribute);
    }
    void VisitAttributeUser(AttributeUser* attribute) override {
        to_.VisitAttributeUser(attribute);
    }

private:
    ConstAttributeVisitor& to_;
};

} // namespace

ConstObjectVisitor::~ConstObjectVisitor() = default;

void ConstObjectVisitor::Visit(const Object& object) {
    OnObject visitor(*this);
    const_cast<Object&>(object).AcceptObject(visitor);
}

void ConstObjectVisitor::VisitAttribute(const Attribute* /*object*/) {}
void ConstObjectVisitor::VisitSignal(const Signal* /*object*/) {}
void ConstObjectVisitor::VisitComponent(const Component* /*object*/) {}
void ConstObjectVisitor::VisitPin(const Pin* /*object*/) {}
void ConstObjectVisitor::VisitInstance(const Instance* /*object*/) {}
void ConstObjectVisitor::VisitNetlist(const Netlist* /*object*/) {}

ConstSignalVisitor::~ConstSignalVisitor() = default;

void ConstSignalVisitor::Visit(const Signal& signal) {
    OnSignal visitor(*this);
    const_cast<Signal&>(signal).AcceptSignal(visitor);
}

void ConstSignalVisitor::VisitSignal(const Signal* /*signal*/) {}
void ConstSignalVisitor::VisitScalarSignal(const ScalarSignal* /*signal*/) {}
void ConstSignalVisitor::VisitBus(const Bus* /*signal*/) {}
void ConstSignalVisitor::VisitBusSlice(const BusSlice* /*signal*/) {}
void ConstSignalVisitor::VisitBusIndex(const BusIndex* /*signal*/) {}
void ConstSignalVisitor::VisitCompoundBus(const CompoundBus* /*signal*/) {}

ConstPinVisitor::~ConstPinVisitor() = default;

void ConstPinVisitor::Visit(const Pin& pin) {
    OnPin visitor(*this);
    const_cast<Pin&>(pin).AcceptPin(visitor);
}

void ConstPinVisitor::VisitScalarPin(const ScalarPin* /*pin*/) {}
void ConstPinVisitor::VisitBusPin(const BusPin* /*pin*/) {}
void ConstPinVisitor::VisitBusIndexPin(const BusIndexPin* /*pin*/) {}

ConstAttributeVisitor::~ConstAttributeVisitor() = default;

void ConstAttributeVisitor::Visit(const Attribute& attribute) {
    OnAttribute visitor(*this);
    const_cast<Attribute&>(attribute).AcceptAttribute(visitor);
}

void ConstAttributeVisitor::VisitAttribute(const Attribute* /*attribute*/) {}
void ConstAttributeVisitor::VisitAttributeString(const AttributeString* /*attribute*/) {}
void ConstAttributeVisitor::VisitAttributeInteger(const AttributeInteger* /*attribute*/) {}
void ConstAttributeVisitor::VisitAttributeFloat(const AttributeFloat* /*attribute*/) {}
void ConstAttributeVisitor::VisitAttributeBit(const AttributeBit* /*attribute*/) {}
void ConstAttributeVisitor::VisitAttributeBitVector(const AttributeBitVector* /*attribute*/) {}
void ConstAttributeVisitor::VisitAttributeBoolean(const AttributeBoolean* /*attribute*/) {}
void ConstAttributeVisitor::VisitAttributeUser(const AttributeUser* /*attribute*/) {}

} // namespace Orn_Hdl
