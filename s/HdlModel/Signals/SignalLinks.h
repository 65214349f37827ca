// The links of a signal that most signals do not have. PinLinks and References say what they mean.
#pragma once

#include "Orn_Hdl/Model/Signals/Signal.h"

#include <algorithm>
#include <vector>

namespace Orn_Hdl {

class DummySignals;

struct Signal::Links {
    /// Pins that point at this signal without being listed.
    std::vector<Pin*> unlistedPins;
    /// The aliases of this signal.
    PtrArray<Signal*> aliases;
    /// The signals that name this one as an alias, a member or a slice, once for each time.
    std::vector<Signal*> referrers;
    /// The dummy signals of a netlist that have this one as a port or as its dummy; null for none.
    DummySignals* keeper = nullptr;
    /// How many entries of the keeper name this signal.
    int timesKept = 0;
};

/// Takes one occurrence out of a list whose order does not matter. The last one is looked for
/// first: what is destroyed was mostly added last.
template <class T> void EraseOne(std::vector<T*>& list, const T* element) noexcept {
    const auto found = std::find(list.rbegin(), list.rend(), element);
    if (found != list.rend()) {
        *found = list.back();
        list.pop_back();
    }
}

} // namespace Orn_Hdl
