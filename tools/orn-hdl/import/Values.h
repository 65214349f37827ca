// Values of parameters and attributes: checks and conversion.
#pragma once

#include "import/ImportedDesign.h"
#include "import/Sink.h"
#include "import/UnknownValues.h"
#include "import/Warnings.h"

#include <cstddef>
#include <cstdint>
#include <string>

namespace Tool::Import {

/// Whether a parameter's value contains an x, or z where this is a don't care, that is not replaced
/// by 0 or 1: any value will do there.
bool MeansAny(const Value& value, const UnknownValues& unknown) noexcept;
/// Rejects a parameter's value that contains a z without a replacement, and warns about a text that
/// cannot be written as a text.
void CheckParameter(const Value& value, const Place& place, const UnknownValues& unknown,
                    Warnings& warnings);
/// Warns about a parameter for which `MeansAny` is true.
void WarnOfAny(const Place& place, Warnings& warnings);
/// A parameter's value as a generic. An x that is not replaced by 1 becomes 0.
TypedValue MakeGeneric(const std::string& name, const Value& value, const UnknownValues& unknown);
/// The bits of an integer, the leftmost first.
std::string MakeIntegerBits(std::int32_t integer, std::size_t width);
/// A generic without a name, with the type of a value, that is 0 or empty.
TypedValue MakeNeutralGeneric(const Value& value);

/// Warns about a text that cannot be written unchanged.
void CheckAttribute(const Value& value, const Place& place, Warnings& warnings);
TypedValue MakeAttribute(const std::string& name, const Value& value);

} // namespace Tool::Import
