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
    /// Who remembers this signal, as a dummy or as one for which a dummy stands in, and is told
    /// when it ends; null for nobody.
    DummySignals* keeper = nullptr;
    /// How often it does.
    int timesKept = 0;
};

} // namespace Orn_Hdl
