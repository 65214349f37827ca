// The links of a signal that most signals do not have.
#pragma once

#include "Orn_Hdl/Model/Signals.h"

#include <vector>

namespace Orn_Hdl {

class DummySignals;

struct Signal::Links {
    /// The aliases of this signal.
    PtrArray<Signal*> signals;
    /// Every signal that names this one, as an alias, a member or a slice, once each time.
    std::vector<Signal*> referrers;
    /// Pins that point at this signal without being listed.
    std::vector<Pin*> unlistedPins;
    /// Who remembers that a dummy stands in for this signal, and is told when it ends; null for
    /// nobody.
    DummySignals* keeper = nullptr;
};

} // namespace Orn_Hdl
