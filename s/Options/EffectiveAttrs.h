// The attributes that take effect on an instance.
#pragma once

#include "Orn_Hdl/Attributes.h"
#include "Orn_Hdl/Containers/PtrArray.h"
#include "Orn_Hdl/Model/Component.h"

namespace Orn_Hdl {

/// Replaces the list by the instance's attributes and those of its component that it does not hide
/// by one of the same name.
/// \return how many of them, from the first on, are the instance's own.
int GetEffectiveAttrs(const Instance& instance, PtrArray<Attribute*>& attributes);

} // namespace Orn_Hdl
