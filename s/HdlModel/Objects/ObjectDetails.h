// The parts of an object that few objects have. They are created when first needed, so that they
// cost the millions of other objects no memory.
#pragma once

#include "HdlModel/Objects/ObjectName.h"
#include "Orn_Hdl/Attributes.h"

#include <memory>
#include <string>
#include <vector>

namespace Orn_Hdl {

struct ObjectDetails {
    /// The name of the object. It has no details of its own.
    ObjectName name;
    std::string comment;
    /// The name under which a netlist finds the object, when it was renamed afterwards.
    std::unique_ptr<std::string> keyName;
    /// A pin's default value, or a signal's constant.
    std::unique_ptr<BitVectorValue> value;
    /// The direction, if it is not input, output, bidirectional or invalid.
    int oddDirection = 0;
    /// For a pin: the signals that list it although it points at another signal or at none.
    std::vector<Signal*> formerSignals;
};

/// The constant or default value of an object that has none.
inline const BitVectorValue& NoValue() {
    static const BitVectorValue none;
    return none;
}

} // namespace Orn_Hdl
