// Cells of the primitive library, which are marked by an attribute.
#pragma once

#include "HdlModel/Names/Names.h"
#include "Orn_Hdl/Model/Component.h"

namespace Orn_Hdl {

/// Whether a component is a cell of the primitive library: its attribute LEVEL says HALVEX.
inline bool IsPrimitive(const Component& component) {
    const Attribute* const level = component.GetAttr("Level");
    return level != nullptr && Names::IsNamed(level->GetValueString().GetView(), "HALVEX");
}

} // namespace Orn_Hdl
