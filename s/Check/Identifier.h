// Whether a name can stand in a netlist of each language.
#pragma once

#include <string_view>

namespace Orn_Hdl::Checking {

/// The form of a name, found in one pass.
struct Identifier {
    explicit Identifier(std::string_view name) noexcept;

    /// Whether Verilog takes the characters.
    bool isVerilog = true;
    /// Whether VHDL takes them, underscores aside.
    bool isVhdl = true;
    /// Whether VHDL takes the places of the underscores.
    bool hasProperUnderscores = true;
};

} // namespace Orn_Hdl::Checking
