// Prefetching during a walk over the instances of a netlist.
#pragma once

#include "Orn_Hdl/Model/Netlist.h"
#include "Port/Prefetch.h"

namespace Orn_Hdl {

/// The signals of the pins are spread over the memory of a large design. A walk that looks at them
/// has them prefetched some instances ahead: a write takes a seventh longer when it waits for each.
class SignalsAhead {
public:
    /// \param lead how many instances ahead.
    SignalsAhead(const Netlist& netlist, int lead) noexcept
        : instances_(netlist.GetInstanceIterator()) {
        for (int i = 0; i < lead; ++i) {
            instances_.Next();
        }
    }

    /// To be called for each instance of the walk.
    void Step() noexcept {
        if (const Instance* const coming = instances_.GetCurrent()) {
            for (const Pin* pin : coming->GetPinIterator()) {
                Port::Prefetch(pin->GetSignal());
            }
            instances_.Next();
        }
    }

private:
    Iterator<Instance*> instances_;
};

} // namespace Orn_Hdl
