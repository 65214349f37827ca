#include "Objects.h"

#include <string>

namespace Python {

namespace {

[[noreturn]] void ThrowGone(const char* kind, const char* name) {
    throw Failure{"gone",
                  "The design has no " + std::string(kind) + " \"" + name + "\" any more.\n"};
}

} // namespace

Orn_Hdl::Component& FindComponent(const Orn_Hdl::Netlist& netlist, const char* name) {
    Orn_Hdl::Component* const component = netlist.GetComponent(name);
    if (component == nullptr) {
        ThrowGone("component", name);
    }
    return *component;
}

Orn_Hdl::Instance& FindInstance(const Orn_Hdl::Netlist& netlist, const char* name) {
    Orn_Hdl::Instance* const instance = netlist.GetInstance(name);
    if (instance == nullptr) {
        ThrowGone("instance", name);
    }
    return *instance;
}

Orn_Hdl::Bus& FindBus(const Orn_Hdl::Netlist& netlist, const char* name) {
    Orn_Hdl::Bus* const bus = netlist.GetParentBus(name);
    if (bus == nullptr) {
        ThrowGone("bus", name);
    }
    return *bus;
}

Orn_Hdl::Signal& FindSignal(const Orn_Hdl::Netlist& netlist, Kind kind, const char* name) {
    if (kind == Kind::Bus) {
        return FindBus(netlist, name);
    }
    Orn_Hdl::Signal* const signal = netlist.GetSignal(name);
    if (signal == nullptr) {
        ThrowGone("signal", name);
    }
    return *signal;
}

Orn_Hdl::Pin& FindPin(const Orn_Hdl::Netlist& netlist, Kind kind, const char* owner,
                      const char* name) {
    Orn_Hdl::Pin* const pin = kind == Kind::ComponentPin
                                  ? FindComponent(netlist, owner).GetPin(name)
                                  : FindInstance(netlist, owner).GetPin(name);
    if (pin == nullptr) {
        ThrowGone("pin", (std::string(owner) + "." + name).c_str());
    }
    return *pin;
}

Holder FindHolder(const ModelState& model, Arguments& arguments) {
    Orn_Hdl::Netlist& netlist = model.GetNetlist();
    const Kind kind = GetKind(arguments, 0);
    const char* const name = arguments.GetText(1);
    switch (kind) {
    case Kind::Module:
        return {netlist, netlist};
    case Kind::Component: {
        Orn_Hdl::Component& component = FindComponent(netlist, name);
        return {component, component};
    }
    case Kind::Instance: {
        Orn_Hdl::Instance& instance = FindInstance(netlist, name);
        return {instance, instance};
    }
    case Kind::Signal:
    case Kind::Bus: {
        Orn_Hdl::Signal& signal = FindSignal(netlist, kind, name);
        return {signal, signal};
    }
    case Kind::ComponentPin:
    case Kind::InstancePin:
        break;
    }
    Orn_Hdl::Pin& pin = FindPin(netlist, kind, name, arguments.GetText(2));
    return {pin, pin};
}

Kind GetKind(const Arguments& arguments, Py_ssize_t i) {
    const long kind = arguments.GetInt(i);
    if (kind < 0 || kind > static_cast<long>(Kind::InstancePin)) {
        PyErr_SetString(PyExc_ValueError, "no such kind");
        throw ErrorIsSet();
    }
    return static_cast<Kind>(kind);
}

std::string_view GetDirectionName(const Orn_Hdl::Polarity& polarity) noexcept {
    switch (polarity.GetValue()) {
    case Orn_Hdl::Polarity::Input:
        return "input";
    case Orn_Hdl::Polarity::Output:
        return "output";
    case Orn_Hdl::Polarity::BiDirectional:
        return "bidirectional";
    default:
        return "";
    }
}

std::string SpellBitVector(const Orn_Hdl::BitVectorValue& value) {
    std::string digits(value.GetValue().GetView());
    if (!value.HasBaseAndLength()) {
        return digits;
    }
    const char* const base = value.GetBase() == 2 ? "B" : value.GetBase() == 8 ? "O" : "H";
    return std::to_string(value.GetLength()) + ":" + base + ":" + digits;
}

Ref DescribeSignal(const Orn_Hdl::Signal& signal) {
    return MakeTuple(MakeInt(signal.GetSignalType()), MakeText(signal.GetNameView()));
}

} // namespace Python
