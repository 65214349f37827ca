// The values of attributes and generics, as each language reads them.
#pragma once

#include "Check/AttributeHolder.h"

#include <string_view>

namespace Orn_Hdl::Checking {

/// Where the value of an attribute is written.
struct Places {
    bool verilogNumber = false;
    bool verilogComment = false;
    bool vhdl = false;
    /// Whether VHDL gets a literal of the type, otherwise a string.
    bool typed = false;
    /// Whether a value of a user type has to be one of that type: in a generic, and in the
    /// attribute that declares its name.
    bool bound = false;
};

/// Checks the value of an attribute as it is written in the places.
void CheckValue(Context& context, const Holder& holder, const Attribute& attribute,
                const Places& places);

/// Whether every netlist can see a type.
bool IsVisibleType(std::string_view type);
/// Whether a text can be a value of one of the visible types; of other types any text can.
bool CanBeValueOf(std::string_view type, std::string_view text);

} // namespace Orn_Hdl::Checking
