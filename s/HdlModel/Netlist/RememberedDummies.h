// The dummy signals that earlier writes made.
#pragma once

#include "HdlModel/Netlist/DummySignals.h"

namespace Orn_Hdl {

/// Gives those who look at a netlist, and change nothing, access to its dummy signals.
class RememberedDummies {
public:
    static const DummySignals& Of(const Netlist& netlist) noexcept;
};

} // namespace Orn_Hdl
