#include "Orn_Hdl/Model/Signals/SignalVisitor.h"

namespace Orn_Hdl {

SignalVisitor::~SignalVisitor() = default;
void SignalVisitor::VisitSignal(Signal* /*signal*/) {}
void SignalVisitor::VisitScalarSignal(ScalarSignal* /*signal*/) {}
void SignalVisitor::VisitBus(Bus* /*bus*/) {}
void SignalVisitor::VisitBusSlice(BusSlice* /*slice*/) {}
void SignalVisitor::VisitBusIndex(BusIndex* /*bit*/) {}
void SignalVisitor::VisitCompoundBus(CompoundBus* /*compound*/) {}

} // namespace Orn_Hdl
