// The walk over the instances of a large netlist.
#pragma once

#include "Orn_Hdl/Model/Netlist.h"
#include "Port/Prefetch.h"

namespace Orn_Hdl::Writers {

/// Walks ahead of a reader of instances.
class InstanceLookahead {
public:
    InstanceLookahead(const Netlist& netlist, int distance) noexcept
        : instances_(netlist.GetInstanceIterator()) {
        for (int i = 0; i < distance; ++i) {
            instances_.Next();
        }
    }
    /// The next instance; null at the end.
    const Instance* Next() noexcept {
        const Instance* const instance = instances_.GetCurrent();
        instances_.Next();
        return instance;
    }

private:
    Iterator<Instance*> instances_;
};

/// Calls `visit` with each instance, in order.
///
/// The instances, their pins and above all the signals of the pins are spread over the memory of a
/// large design, and waiting for them takes longer than writing them. So they are asked for early:
/// first the instances, then their pins, then the signals.
template <class Visit> void ForEachInstance(const Netlist& netlist, const Visit& visit) {
    InstanceLookahead far(netlist, 12);
    InstanceLookahead middle(netlist, 8);
    InstanceLookahead near(netlist, 4);
    for (const Instance* instance : netlist.GetInstanceIterator()) {
        Port::Prefetch(far.Next());
        if (const Instance* const coming = middle.Next()) {
            Port::Prefetch(coming->GetPinIterator().GetCurrent());
        }
        if (const Instance* const coming = near.Next()) {
            for (const Pin* pin : coming->GetPinIterator()) {
                Port::Prefetch(pin->GetSignal());
            }
        }
        visit(*instance);
    }
}

} // namespace Orn_Hdl::Writers
