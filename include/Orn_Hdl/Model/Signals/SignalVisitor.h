/// \file
/// `SignalVisitor`, which tells the signal classes apart.
#pragma once

#include "Port/Export.h"

namespace Orn_Hdl {

class Bus;
class BusIndex;
class BusSlice;
class CompoundBus;
class ScalarSignal;
class Signal;

/// Visits signals by class; every operation of the base does nothing.
class ORN_HDL_API SignalVisitor {
public:
    SignalVisitor() = default;
    SignalVisitor(const SignalVisitor&) = default;
    SignalVisitor& operator=(const SignalVisitor&) = default;
    virtual ~SignalVisitor();
    /// Called for a signal of any class, after the operation of its class.
    virtual void VisitSignal(Signal* signal);
    /// Called for a scalar signal.
    virtual void VisitScalarSignal(ScalarSignal* signal);
    /// Called for a bus.
    virtual void VisitBus(Bus* bus);
    /// Called for a slice of a bus.
    virtual void VisitBusSlice(BusSlice* slice);
    /// Called for a bit of a bus.
    virtual void VisitBusIndex(BusIndex* bit);
    /// Called for a compound.
    virtual void VisitCompoundBus(CompoundBus* compound);
};

} // namespace Orn_Hdl
