// The keywords that begin a statement or are no names.
#pragma once

#include <cstdint>
#include <string_view>

namespace Orn_Hdl::Readers {

enum class Keyword : std::uint8_t {
    /// No keyword.
    None,
    Module,
    Endmodule,
    Primitive,
    Input,
    Output,
    Inout,
    /// "wire" and what reads like it.
    Wire,
    Supply0,
    Supply1,
    /// A kind of net that no model has.
    OtherNet,
    /// "logic", "var" and "reg": a net when it is a port without a procedure.
    Logic,
    Reg,
    Signed,
    /// "scalared" and "vectored".
    Vectored,
    Parameter,
    Localparam,
    Specparam,
    Assign,
    Defparam,
    Specify,
    Generate,
    Endgenerate,
    Function,
    Task,
    /// A gate or switch.
    Gate,
    /// "integer", "real" and other types of a parameter.
    Type,
    /// Begins or belongs to a description of behaviour.
    Behaviour,
    /// A word of IEEE 1364 that has no meaning of its own in a netlist.
    Other
};

/// The keyword of IEEE 1364-2005, or of IEEE 1800 where a netlist may have it.
Keyword FindKeyword(std::string_view word) noexcept;
/// Whether a keyword begins the declaration of a port.
bool IsDirection(Keyword keyword) noexcept;

} // namespace Orn_Hdl::Readers
