// The texts from which values are read.
#pragma once

#include "Orn_Hdl/Attributes.h"

#include <string>
#include <string_view>

namespace Orn_Hdl::Script {

/// A text from which a bit-vector literal is read.
std::string GetText(const BitVectorValue& value);
/// A text from which the value of an attribute is read.
std::string GetText(const Attribute& attribute);

/// A name with all its letters in one case: names that differ in nothing else have the same one.
std::string Folded(std::string_view name);

} // namespace Orn_Hdl::Script
