// The objects of a design, found by what Python calls them.
#pragma once

#include "State.h"

namespace Python {

/// How an object is addressed; the package uses the same numbers.
enum class Kind { Module, Component, Instance, Signal, Bus, ComponentPin, InstancePin };

/// The component of that name. \throws Failure "gone" when there is none.
Orn_Hdl::Component& FindComponent(const Orn_Hdl::Netlist& netlist, const char* name);
/// The instance of that name. \throws Failure "gone" when there is none.
Orn_Hdl::Instance& FindInstance(const Orn_Hdl::Netlist& netlist, const char* name);
/// A signal by its name, or a bus by its base name. \throws Failure "gone" when there is none.
Orn_Hdl::Signal& FindSignal(const Orn_Hdl::Netlist& netlist, Kind kind, const char* name);
/// The bus with that base name. \throws Failure "gone" when there is none.
Orn_Hdl::Bus& FindBus(const Orn_Hdl::Netlist& netlist, const char* name);
/// A pin of a component or of an instance. \throws Failure "gone" when there is none.
Orn_Hdl::Pin& FindPin(const Orn_Hdl::Netlist& netlist, Kind kind, const char* owner,
                      const char* name);

/// An object with its attributes.
struct Holder {
    Orn_Hdl::Object& object;
    Orn_Hdl::AttributeHolder& attributes;
};
/// The object that the first three arguments address: kind, name, and name of a pin.
/// \throws Failure "gone" when there is none.
Holder FindHolder(const ModelState& model, Arguments& arguments);

/// The kind in an argument.
Kind GetKind(const Arguments& arguments, Py_ssize_t i);
/// A direction as Python has it: "input", "output", "bidirectional"; empty for none.
std::string_view GetDirectionName(const Orn_Hdl::Polarity& polarity) noexcept;
/// A bit-vector literal as the commands spell it.
std::string SpellBitVector(const Orn_Hdl::BitVectorValue& value);
/// The class and the name of a signal.
Ref DescribeSignal(const Orn_Hdl::Signal& signal);

} // namespace Python
