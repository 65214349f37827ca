// Attributes and comments of objects, as a comparison takes them.
#pragma once

#include "diff/Matching.h"
#include "diff/Rules.h"

#include <string>
#include <utility>
#include <vector>

namespace Orn_Hdl {
class Attribute;
class AttributeHolder;
class Instance;
} // namespace Orn_Hdl

namespace Tool::Diff {

/// The attributes of an object that count.
using AttributeList = std::vector<const Orn_Hdl::Attribute*>;

/// The attributes of a holder, or of an instance with those of its component that it inherits.
AttributeList ListAttributes(const Orn_Hdl::AttributeHolder& holder, const Rules& rules);
AttributeList ListEffective(const Orn_Hdl::Instance& instance, const Rules& rules);

/// An attribute of each design; null in the design that does not have it.
using AttributePair = std::pair<const Orn_Hdl::Attribute*, const Orn_Hdl::Attribute*>;

/// The attributes that only one list has, or that both have with another value.
std::vector<AttributePair> CompareAttributes(const AttributeList& a, const AttributeList& b,
                                             const Rules& rules);
/// The value of an attribute, and its type and options if these are compared.
std::string DescribeAttribute(const Orn_Hdl::Attribute& attribute, const Rules& rules);

/// The attributes of each instance as a number; empty if attributes do not count.
Likeness GetLikeness(const Graph& graph, const Rules& rules);

} // namespace Tool::Diff
