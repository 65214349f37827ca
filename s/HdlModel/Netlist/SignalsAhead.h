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
        : SignalsAhead(netlist.GetInstanceIterator().begin(), lead) {}
    /// \param first the instance with which the walk begins.
    SignalsAhead(Iterator<Instance*>::Cursor first, int lead) noexcept : coming_(first) {
        for (int i = 0; i < lead; ++i) {
            ++coming_;
        }
    }

    /// To be called for each instance of the walk.
    void Step() noexcept {
        if (const Instance* const coming = *coming_) {
            for (const Pin* pin : coming->GetPinIterator()) {
                Port::Prefetch(pin->GetSignal());
            }
            ++coming_;
        }
    }

private:
    Iterator<Instance*>::Cursor coming_;
};

} // namespace Orn_Hdl
