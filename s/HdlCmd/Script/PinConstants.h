// The signals that carry the constants of pins.
#pragma once

#include "Orn_Hdl/Model/Netlist.h"

namespace Orn_Hdl::Script::PinConstants {

/// Whether a signal has the name that a constant at the pin of an instance gives to its signal.
bool IsOf(const Instance& instance, const Pin& pin, const Signal& signal);
/// Whether a signal is there for the constant of one pin alone, so that the command for that makes
/// all of it.
bool IsSaidByPin(const Netlist& netlist, const Signal& signal);

} // namespace Orn_Hdl::Script::PinConstants
