// How compounds may contain each other: none itself, and none more than its limits allow.
#pragma once

#include "Orn_Hdl/Model/Signals/CompoundBus.h"

namespace Orn_Hdl::CompoundLimits {

/// Whether a signal is that compound, or contains it at any level.
bool Contains(const Signal& signal, const CompoundBus& compound);

/// Whether a compound, or one that contains it, has more in it than `CompoundBus::MostLevels` and
/// `CompoundBus::MostCompounds` allow.
bool AreExceededBy(const CompoundBus& compound);

} // namespace Orn_Hdl::CompoundLimits
