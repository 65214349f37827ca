/// \file
/// Signals: scalar signals, buses, slices and bits of buses, compounds of signals; `SignalVisitor`.
#pragma once

#include "Orn_Hdl/Model/Signals/Bus.h"
#include "Orn_Hdl/Model/Signals/BusPart.h"
#include "Orn_Hdl/Model/Signals/CompoundBus.h"
#include "Orn_Hdl/Model/Signals/ScalarSignal.h"
#include "Orn_Hdl/Model/Signals/Signal.h"
#include "Orn_Hdl/Model/Signals/SignalVisitor.h"
