// The parts of an object that few objects have. They are made when first needed, so that the
// millions that do not need them do not pay for them.
#pragma once

#include "HdlModel/Objects/ObjectName.h"
#include "Orn_Hdl/Attributes.h"

#include <memory>
#include <string>
#include <vector>

namespace Orn_Hdl {

struct ObjectDetails {
    /// The object's name, without details of its own.
    ObjectName name;
    std::string comment;
    /// The name under which a netlist finds the object, when it was renamed afterwards.
    std::unique_ptr<std::string> keyName;
    /// A pin's default value, or a signal's constant.
    std::unique_ptr<BitVectorValue> value;
    /// A direction that is none of input, output, bidirectional and invalid.
    int oddDirection = 0;
    /// Of a pin: the signals that list it although it points at another, or at none.
    std::vector<Signal*> formerSignals;
};

/// The constant or default value of an object that has none.
inline const BitVectorValue& NoValue() {
    static const BitVectorValue none;
    return none;
}

} // namespace Orn_Hdl
