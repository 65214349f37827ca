// Connections and constants of a model.
#include "HdlModel/ModelFailures.h"
#include "HdlModel/Objects/ObjectKey.h"
#include "Orn_Hdl/Model.h"
#include "Port/Ascii.h"

#include <string>

namespace Orn_Hdl {

using Port::ViewOf;

bool Model::Connect(Signal* signal, Pin* pin) {
    if (signal == nullptr || pin == nullptr) {
        return false;
    }
    signal->Connect(pin);
    SetModifiedFlag(true);
    return true;
}

bool Model::Connect(Signal* first, Signal* second) {
    if (first == nullptr || second == nullptr) {
        return false;
    }
    first->Connect(second);
    SetModifiedFlag(true);
    return true;
}

bool Model::ConnectSignalToPin(const Port::TextArgument& signalName,
                               const Port::TextArgument& instanceName,
                               const Port::TextArgument& pinName) {
    Signal* const signal = GetOrCreateSignal(signalName);
    if (signal == nullptr) {
        FailSignalNotFound(__LINE__, signalName);
    }
    const Instance* const instance = GetInstance(instanceName);
    if (instance == nullptr) {
        FailSignalNotFound(__LINE__, instanceName);
    }
    Pin* const pin = instance->GetPin(pinName);
    if (pin == nullptr) {
        FailPinNotFound(__LINE__,
                        std::string(ViewOf(instanceName)).append(".").append(ViewOf(pinName)));
    }
    return Connect(signal, pin);
}

bool Model::ConnectSignals(const Port::TextArgument& firstName,
                           const Port::TextArgument& secondName) {
    const Signal* const created = GetOrCreateSignal(firstName);
    if (created == nullptr) {
        FailSignalNotFound(__LINE__, firstName);
    }
    // The second name may widen the bus that the first one named, which is then a slice's name. The
    // netlist goes on finding a renamed signal by the name under which it took it.
    const std::string storedName(ObjectKey::Get(*created));
    Signal* const second = GetOrCreateSignal(secondName);
    if (second == nullptr) {
        FailSignalNotFound(__LINE__, secondName);
    }
    return Connect(GetNetlist()->GetSignal(std::string_view(storedName)), second);
}

bool Model::AssignConstant(Signal* signal, const char* value) {
    if (signal == nullptr) {
        return false;
    }
    signal->AssignConstantValue(value);
    SetModifiedFlag(true);
    return true;
}

bool Model::AssignConstant(Pin* pin, const char* value, const char* instanceName) {
    PinConstantSignalVisitor visitor(instanceName);
    pin->AcceptPin(visitor);
    const char* const name = visitor.GetName().CStr();
    if (GetSignal(name) == nullptr) {
        DeclareSignal(name);
    }
    Signal* const signal = GetSignal(name);
    AssignConstant(signal, value);
    pin->Connect(signal);
    return true;
}

bool Model::AssignConstantToSignal(const Port::TextArgument& signalName,
                                   const Port::TextArgument& value) {
    Signal* const signal = GetOrCreateSignal(signalName);
    if (signal == nullptr) {
        FailSignalNotFound(__LINE__, signalName);
    }
    return AssignConstant(signal, value);
}

bool Model::AssignConstantToPin(const Port::TextArgument& instanceName,
                                const Port::TextArgument& pinName,
                                const Port::TextArgument& value) {
    const Instance* const instance = GetInstance(instanceName);
    if (instance == nullptr) {
        FailSignalNotFound(__LINE__, instanceName);
    }
    Pin* const pin = instance->GetPin(pinName);
    if (pin == nullptr) {
        FailPinNotFound(__LINE__, ViewOf(pinName));
    }
    return AssignConstant(pin, value, instance->GetName().CStr());
}

} // namespace Orn_Hdl
