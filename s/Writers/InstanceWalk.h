// The walk over the instances of a large netlist.
#pragma once

#include "Orn_Hdl/Model/Netlist.h"
#include "Port/Prefetch.h"

namespace Orn_Hdl::Writers {

/// Calls `visit` with each instance, in order.
///
/// The signals of the pins are spread over the memory of a large design. They are asked for a few
/// instances ahead, since waiting for them takes a seventh of the time of a Verilog write.
template <class Visit> void ForEachInstance(const Netlist& netlist, const Visit& visit) {
    constexpr int lead = 4;
    Iterator<Instance*> ahead = netlist.GetInstanceIterator();
    for (int i = 0; i < lead; ++i) {
        ahead.Next();
    }
    for (const Instance* instance : netlist.GetInstanceIterator()) {
        if (const Instance* const coming = ahead.GetCurrent()) {
            for (const Pin* pin : coming->GetPinIterator()) {
                Port::Prefetch(pin->GetSignal());
            }
            ahead.Next();
        }
        visit(*instance);
    }
}

} // namespace Orn_Hdl::Writers
