// Prefetching during a walk over the instances of a netlist.
#pragma once

#include "Orn_Hdl/Model/Netlist.h"
#include "Port/Prefetch.h"

#include <cstddef>

namespace Orn_Hdl {

/// The instances of a large design, and the signals of their pins, are spread over its memory. A
/// walk has an instance and its pins prefetched first, and some instances later their signals: a
/// write takes a fifth longer when it waits for each.
class SignalsAhead {
public:
    /// \param lead how many instances ahead.
    SignalsAhead(const Netlist& netlist, int lead) noexcept
        : SignalsAhead(netlist.GetInstanceIterator().begin(), lead) {}
    /// \param first the instance with which the walk begins.
    SignalsAhead(Iterator<Instance*>::Cursor first, int lead) noexcept
        : coming_(first), far_(first) {
        for (int i = 0; i < lead; ++i) {
            ++coming_;
        }
        for (int i = 0; i < FarLeads * lead; ++i) {
            ++far_;
        }
    }

    /// To be called for each instance of the walk.
    void Step() noexcept {
        if (const Instance* const far = *far_) {
            // The pins were usually made right after it, and stand behind it.
            for (std::size_t line = 0; line < Lines; ++line) {
                Port::Prefetch(reinterpret_cast<const char*>(far) + line * Port::CacheLine);
            }
            ++far_;
        }
        if (const Instance* const coming = *coming_) {
            for (const Pin* pin : coming->GetPinIterator()) {
                Port::Prefetch(pin->GetSignal());
            }
            ++coming_;
        }
    }

private:
    /// How many leads ahead instances are prefetched.
    static constexpr int FarLeads = 3;
    static constexpr std::size_t Lines = 4;

    Iterator<Instance*>::Cursor coming_;
    Iterator<Instance*>::Cursor far_;
};

} // namespace Orn_Hdl
