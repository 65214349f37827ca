/// \file
/// Visitors over objects that are not to be changed.
#pragma once

#include "Port/Export.h"

namespace Orn_Hdl {

class Attribute;
class AttributeBit;
class AttributeBitVector;
class AttributeBoolean;
class AttributeFloat;
class AttributeInteger;
class AttributeString;
class AttributeUser;
class Bus;
class BusIndex;
class BusIndexPin;
class BusPin;
class BusSlice;
class Component;
class CompoundBus;
class Instance;
class Netlist;
class Object;
class Pin;
class ScalarPin;
class ScalarSignal;
class Signal;

/// Visits constant objects by kind; every operation of the base does nothing.
class ORN_HDL_API ConstObjectVisitor {
public:
    ConstObjectVisitor() = default;
    ConstObjectVisitor(const ConstObjectVisitor&) = default;
    ConstObjectVisitor& operator=(const ConstObjectVisitor&) = default;
    virtual ~ConstObjectVisitor();
    /// Calls the operation of an object's kind, as `Object::AcceptObject` does.
    void Visit(const Object& object);
    /// Called for an attribute of any class.
    virtual void VisitAttribute(const Attribute* attribute);
    /// Called for a signal of any class.
    virtual void VisitSignal(const Signal* signal);
    /// Called for a component.
    virtual void VisitComponent(const Component* component);
    /// Called for a pin of any class.
    virtual void VisitPin(const Pin* pin);
    /// Called for an instance.
    virtual void VisitInstance(const Instance* instance);
    /// Called for a netlist.
    virtual void VisitNetlist(const Netlist* netlist);
};

/// Visits constant signals by class; every operation of the base does nothing.
class ORN_HDL_API ConstSignalVisitor {
public:
    ConstSignalVisitor() = default;
    ConstSignalVisitor(const ConstSignalVisitor&) = default;
    ConstSignalVisitor& operator=(const ConstSignalVisitor&) = default;
    virtual ~ConstSignalVisitor();
    /// Calls the operation of a signal's class, then `VisitSignal`, as `Signal::AcceptSignal` does.
    void Visit(const Signal& signal);
    /// Called for a signal of any class, after the operation of its class.
    virtual void VisitSignal(const Signal* signal);
    /// Called for a scalar signal.
    virtual void VisitScalarSignal(const ScalarSignal* signal);
    /// Called for a bus.
    virtual void VisitBus(const Bus* bus);
    /// Called for a slice of a bus.
    virtual void VisitBusSlice(const BusSlice* slice);
    /// Called for a bit of a bus.
    virtual void VisitBusIndex(const BusIndex* bit);
    /// Called for a compound.
    virtual void VisitCompoundBus(const CompoundBus* compound);
};

/// Visits constant pins by class; every operation of the base does nothing.
class ORN_HDL_API ConstPinVisitor {
public:
    ConstPinVisitor() = default;
    ConstPinVisitor(const ConstPinVisitor&) = default;
    ConstPinVisitor& operator=(const ConstPinVisitor&) = default;
    virtual ~ConstPinVisitor();
    /// Calls the operation of a pin's class, and only that, as `Pin::AcceptPin` does.
    void Visit(const Pin& pin);
    /// Called for a pin of one bit.
    virtual void VisitScalarPin(const ScalarPin* pin);
    /// Called for a pin with a range.
    virtual void VisitBusPin(const BusPin* pin);
    /// Called for a pin of one bit of a bus.
    virtual void VisitBusIndexPin(const BusIndexPin* pin);
};

/// Visits constant attributes by value type; every operation of the base does nothing.
class ORN_HDL_API ConstAttributeVisitor {
public:
    ConstAttributeVisitor() = default;
    ConstAttributeVisitor(const ConstAttributeVisitor&) = default;
    ConstAttributeVisitor& operator=(const ConstAttributeVisitor&) = default;
    virtual ~ConstAttributeVisitor();
    /// Calls the operation of an attribute's type, as `Attribute::AcceptAttribute` does.
    void Visit(const Attribute& attribute);
    /// Called for an attribute of a class that does not override `Attribute::AcceptAttribute`.
    virtual void VisitAttribute(const Attribute* attribute);
    /// Called for a text.
    virtual void VisitAttributeString(const AttributeString* attribute);
    /// Called for an integer.
    virtual void VisitAttributeInteger(const AttributeInteger* attribute);
    /// Called for a floating-point number.
    virtual void VisitAttributeFloat(const AttributeFloat* attribute);
    /// Called for a bit.
    virtual void VisitAttributeBit(const AttributeBit* attribute);
    /// Called for a bit-vector literal.
    virtual void VisitAttributeBitVector(const AttributeBitVector* attribute);
    /// Called for a truth value.
    virtual void VisitAttributeBoolean(const AttributeBoolean* attribute);
    /// Called for a text of a type that the user names.
    virtual void VisitAttributeUser(const AttributeUser* attribute);
};

} // namespace Orn_Hdl
