// Walks over a design as iterators of Python. A walk holds no object of the design from one step to
// the next but its place in the netlist's list, and ends with an exception when that list is
// replaced.
#pragma once

#include "Objects.h"

namespace Python {

/// A walk over the objects of a kind; each is a pair of a signal's class and the name. A signal
/// that nobody declares is left out.
Ref MakeWalk(ModelState& model, Kind kind);
/// A walk over the connected pins of all instances; each is the names of the signal, the instance
/// and the pin.
Ref MakeConnectionWalk(ModelState& model);

} // namespace Python
