#include "HdlModel/Netlist/FeedBack.h"

#include "HdlModel/Netlist/RememberedDummies.h"
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

/// Whether a signal, or a part of it, may be a port that is used against its direction.
bool MayBeUsedAgainst(const Signal& signal, bool outputPorts) {
    const int portPolarity = outputPorts ? Polarity::Output : Polarity::Input;
    const int pinPolarity = outputPorts ? Polarity::Input : Polarity::Output;
    // A compound has a polarity of its own only when its members agree; any member counts here.
    const bool isCandidate =
        As<CompoundBus>(&signal) != nullptr || signal.GetPortPolarity().GetValue() == portPolarity;
    if ((isCandidate && PinLinks::HasPinOf(signal, pinPolarity)) || IsInLooseCompound(signal)) {
        return true;
    }
    const Bus* const bus = isCandidate ? As<Bus>(&signal) : nullptr;
    if (bus == nullptr) {
        return false;
    }
    // The netlist need not hold the parts of its buses.
    const Iterator<Signal*> parts = bus->GetBusSliceIterator();
    return std::any_of(parts.begin(), parts.end(), [pinPolarity](const Signal* part) {
        return PinLinks::HasPinOf(*part, pinPolarity) || IsInLooseCompound(*part);
    });
}

/// Whether a port may be used against its direction. Most designs have no such port, and checking
/// the ports is faster than checking all pins.
bool MayHaveAny(const Netlist& netlist, bool outputPorts) {
    const Iterator<Signal*> signals = netlist.GetSignalIterator();
    return std::any_of(signals.begin(), signals.end(), [outputPorts](const Signal* signal) {
        return MayBeUsedAgainst(*signal, outputPorts);
    });
}

bool IsWiredOrOutput(const Signal& signal) {
    return signal.GetPortPolarity().GetValue() == Polarity::Output && signal.HasMultiDriver();
}

/// Whether a signal is an internal net, which no compound names: most signals are.
bool IsPlainNet(const Signal& signal) {
    const ScalarSignal* const scalar = As<ScalarSignal>(&signal);
    return scalar != nullptr && !scalar->IsPort() && References::GetReferrers(signal).empty();
}

} // namespace

bool MayNeedDummies(const Netlist& netlist) {
    if (!RememberedDummies::Of(netlist).IsEmpty()) {
        return true;
    }
    const Iterator<Signal*> signals = netlist.GetSignalIterator();
    return std::any_of(signals.begin(), signals.end(), [](const Signal* signal) {
        return !IsPlainNet(*signal) &&
               (MayBeUsedAgainst(*signal, true) || MayBeUsedAgainst(*signal, false) ||
                IsWiredOrOutput(*signal));
    });
}

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
        if (IsWiredOrOutput(*signal)) {
            signal->GetBaseName(names);
        }
    }
}

} // namespace Orn_Hdl::FeedBack
