// The attributes that take effect on an instance.
#pragma once

#include "Orn_Hdl/Attributes.h"
#include "Orn_Hdl/Containers/PtrArray.h"
#include "Orn_Hdl/Model/Component.h"

namespace Orn_Hdl {

/// Replaces the list by the attributes of the instance, followed by those of its component, except
/// those that have the name of an attribute of the instance.
/// \return the number of the instance's own attributes.
int GetEffectiveAttrs(const Instance& instance, PtrArray<Attribute*>& attributes);

} // namespace Orn_Hdl
