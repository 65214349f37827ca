// The texts from which values are read.
#pragma once

#include "Orn_Hdl/Attributes.h"

#include <string>

namespace Orn_Hdl::Script {

/// A text from which a bit-vector literal is read.
std::string GetText(const BitVectorValue& value);
/// A text from which the value of an attribute is read.
std::string GetText(const Attribute& attribute);

} // namespace Orn_Hdl::Script
