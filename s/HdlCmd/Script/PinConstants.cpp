#include "HdlCmd/Script/PinConstants.h"

#include "HdlModel/Names/Names.h"
#include "HdlModel/Signals/PinLinks.h"
#include "HdlModel/Signals/References.h"
#include "HdlModel/Signals/SignalCast.h"
#include "Orn_Hdl/Model/Pins.h"

#include <string>
#include <vector>

namespace Orn_Hdl::Script::PinConstants {

namespace {

/// The name of the signal that carries the constant of a pin.
std::string GetSignalName(std::string_view instance, const Pin& pin) {
    PinConstantSignalVisitor visitor(std::string(instance).c_str());
    // A visitor may change what it visits; this one only reads the name.
    const_cast<Pin&>(pin).AcceptPin(visitor);
    return std::string(visitor.GetName().GetView());
}

/// The instance that a pin belongs to, if the signal is named after both; null otherwise.
const Instance* FindInstance(const Netlist& netlist, const Signal& signal, const Pin& pin) {
    const std::string_view name = signal.GetNameView();
    const std::string rest = GetSignalName("", pin);
    if (name.size() < rest.size() || name.substr(name.size() - rest.size()) != rest) {
        return nullptr;
    }
    const std::string_view wanted = name.substr(0, name.size() - rest.size());
    const Instance* const instance = netlist.GetInstance(wanted);
    const bool isOwner = instance != nullptr && instance->GetNameView() == wanted &&
                         instance->GetPin(pin.GetNameView()) == &pin;
    return isOwner ? instance : nullptr;
}

} // namespace

bool IsOf(const Instance& instance, const Pin& pin, const Signal& signal) {
    return Names::IsNamed(signal.GetNameView(), GetSignalName(instance.GetNameView(), pin));
}

bool IsSaidByPin(const Netlist& netlist, const Signal& signal) {
    const std::vector<Pin*>& pins = PinLinks::GetUnlisted(signal);
    const Bus* const bus = As<Bus>(&signal);
    return pins.size() == 1 && signal.GetPinIterator().IsAtEnd() &&
           signal.GetPortPolarity() == Polarity() && !signal.HasAttrs() &&
           signal.GetCommentView().empty() && signal.GetSignalIterator().IsAtEnd() &&
           (bus == nullptr || bus->GetBusSliceIterator().IsAtEnd()) &&
           References::GetReferrers(signal).empty() && References::GetKeeper(signal) == nullptr &&
           FindInstance(netlist, signal, *pins.front()) != nullptr;
}

} // namespace Orn_Hdl::Script::PinConstants
