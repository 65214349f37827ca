/// \file
/// The design: objects, pins, signals, components, instances, the netlist, and `Model`, every
/// design operation by name.
#pragma once

#include "Orn_Hdl/Model/Component.h"
#include "Orn_Hdl/Model/Design.h"
#include "Orn_Hdl/Model/Netlist.h"
#include "Orn_Hdl/Model/Object.h"
#include "Orn_Hdl/Model/Pins.h"
#include "Orn_Hdl/Model/Signals.h"
