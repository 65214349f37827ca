// Values of parameters and attributes: checks and conversion.
#pragma once

#include "import/ImportedDesign.h"
#include "import/Sink.h"
#include "import/UnknownValues.h"
#include "import/Warnings.h"

#include <string>

namespace Tool::Import {

/// Rejects a parameter's value that contains an x or z without a replacement, and warns about a
/// text that cannot be written as a text.
void CheckParameter(const Value& value, const Place& place, const UnknownValues& unknown,
                    Warnings& warnings);
/// A parameter's value as a generic.
TypedValue MakeGeneric(const std::string& name, const Value& value, const UnknownValues& unknown);

/// Warns about a text that cannot be written unchanged.
void CheckAttribute(const Value& value, const Place& place, Warnings& warnings);
TypedValue MakeAttribute(const std::string& name, const Value& value);

} // namespace Tool::Import
