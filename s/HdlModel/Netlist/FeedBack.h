// The ports that are used against their direction, which need dummy signals: output ports that are
// read inside or have several drivers, and input ports that are driven inside.
#pragma once

#include "Orn_Hdl/Containers/StringSet.h"
#include "Orn_Hdl/Model/Netlist.h"

namespace Orn_Hdl::FeedBack {

/// Adds the base names of the signals by which an output port is read inside or, with
/// `outputPorts` false, an input port is driven inside.
void AddSignals(const Netlist& netlist, bool outputPorts, StringSet& names);

/// Whether the writers have to look for such ports: false when there are none, and when no dummy
/// signals were made before. The order of the netlist makes no difference.
bool MayNeedDummies(const Netlist& netlist);

/// Adds the base names of the output ports that have several drivers.
void AddWiredOrOutputs(const Netlist& netlist, StringSet& names);

} // namespace Orn_Hdl::FeedBack
