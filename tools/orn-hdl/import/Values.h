// Values of parameters and attributes: which of them can be imported, and as what.
#pragma once

#include "import/ImportedDesign.h"
#include "import/Sink.h"
#include "import/UnknownValues.h"
#include "import/Warnings.h"

#include <string>

namespace Tool::Import {

/// Refuses a parameter's value that holds an x or z without a replacement, and warns of a text that
/// cannot be written as a text.
void CheckParameter(const Value& value, const Place& place, const UnknownValues& unknown,
                    Warnings& warnings);
/// A parameter's value as a generic.
TypedValue MakeGeneric(const std::string& name, const Value& value, const UnknownValues& unknown);

/// Warns of a text that cannot be written unchanged.
void CheckAttribute(const Value& value, const Place& place, Warnings& warnings);
TypedValue MakeAttribute(const std::string& name, const Value& value);

} // namespace Tool::Import
