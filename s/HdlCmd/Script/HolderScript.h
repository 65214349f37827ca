// The comment and the attributes of one object in a script.
#pragma once

#include "HdlCmd/Script/Lines.h"
#include "Orn_Hdl/Attributes.h"
#include "Orn_Hdl/Model/Object.h"

#include <string_view>

namespace Orn_Hdl::Script {

/// An object as commands name it.
struct Holder {
    const HolderPhrases& phrases;
    const Object& object;
    const AttributeHolder& attributes;
    /// Whether the commands name the object at all, which they do not do for the module.
    bool isNamed = true;
    std::string_view name;
};

/// Writes the comment and the attributes of an object.
void WriteHolder(const Holder& holder, Lines& lines);

} // namespace Orn_Hdl::Script
