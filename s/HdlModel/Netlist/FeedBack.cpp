#include "HdlModel/Netlist/FeedBack.h"

#include "HdlModel/Objects/ObjectKey.h"
#include "HdlModel/Signals/PinLinks.h"
#include "HdlModel/Signals/References.h"
#include "HdlModel/Signals/SignalCast.h"

#include <algorithm>
#include <vector>

namespace Orn_Hdl::FeedBack {

namespace {

/// Whether a compound that no netlist holds has a signal as a member.
bool IsInLooseCompound(const Signal& signal) {
    const std::vector<Signal*>& referrers = References::GetReferrers(signal);
    return std::any_of(referrers.begin(), referrers.end(), [](const Signal* referrer) {
        return As<CompoundBus>(referrer) != nullptr && !OwnedFlag::Get(*referrer);
    });
}

/// Whether a port may be used against its direction. Most designs have no such port, and checking
/// the ports is faster than checking all pins.
bool MayHaveAny(const Netlist& netlist, bool outputPorts) {
    const int portPolarity = outputPorts ? Polarity::Output : Polarity::Input;
    const int pinPolarity = outputPorts ? Polarity::Input : Polarity::Output;
    for (const Signal* signal : netlist.GetSignalIterator()) {
        // A compound has a polarity of its own only when its members agree; any member counts here.
        const bool isCandidate = As<CompoundBus>(signal) != nullptr ||
                                 signal->GetPortPolarity().GetValue() == portPolarity;
        if ((isCandidate && PinLinks::HasPinOf(*signal, pinPolarity)) ||
            IsInLooseCompound(*signal)) {
            return true;
        }
        if (const Bus* const bus = isCandidate ? As<Bus>(signal) : nullptr) {
            // The netlist need not hold the parts of its buses.
            for (const Signal* part : bus->GetBusSliceIterator()) {
                if (PinLinks::HasPinOf(*part, pinPolarity) || IsInLooseCompound(*part)) {
                    return true;
                }
            }
        }
    }
    return false;
}

} // namespace

void AddSignals(const Netlist& netlist, bool outputPorts, StringSet& names) {
    if (!MayHaveAny(netlist, outputPorts)) {
        return;
    }
    for (const Instance* instance : netlist.GetInstanceIterator()) {
        PtrArray<Pin*> pins;
        if (outputPorts) {
            instance->GetOutPortConnectedToInPin(pins);
        } else {
            instance->GetInPortConnectedToOutPin(pins);
        }
        for (const Pin* pin : Iterator<Pin*>(&pins)) {
            if (pin->GetSignal() != nullptr) {
                pin->GetSignal()->GetBaseName(names);
            }
        }
    }
}

void AddWiredOrOutputs(const Netlist& netlist, StringSet& names) {
    for (const Signal* signal : netlist.GetSignalIterator()) {
        if (signal->GetPortPolarity().GetValue() == Polarity::Output && signal->HasMultiDriver()) {
            signal->GetBaseName(names);
        }
    }
}

} // namespace Orn_Hdl::FeedBack
