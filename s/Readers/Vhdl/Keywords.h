// The reserved words of VHDL.
#pragma once

#include <cstdint>
#include <string_view>

namespace Orn_Hdl::Readers::Vhdl {

enum class Keyword : std::uint8_t {
    /// No reserved word of IEEE 1076-1993.
    None,
    After,
    Alias,
    All,
    Architecture,
    Attribute,
    Begin,
    Block,
    Body,
    Buffer,
    Bus,
    Case,
    Component,
    Configuration,
    Constant,
    Downto,
    End,
    Entity,
    For,
    Function,
    Generate,
    Generic,
    Group,
    If,
    In,
    Inout,
    Is,
    Label,
    Library,
    Linkage,
    Map,
    New,
    Of,
    Open,
    Others,
    Out,
    Package,
    Port,
    Postponed,
    Procedure,
    Process,
    Record,
    Signal,
    Subtype,
    To,
    Type,
    Units,
    Use,
    When,
    With,
    /// An operator that is a word.
    Operator,
    /// Begins or belongs to a description of behaviour.
    Behaviour,
    /// A reserved word that begins nothing in a netlist.
    Other
};

/// The reserved word of IEEE 1076-1993 that a word is, in any letter case.
Keyword FindKeyword(std::string_view word) noexcept;
/// Whether a name is a reserved word of IEEE 1076-1993 or of IEEE 1076-2008, in any letter case.
bool IsReserved(std::string_view name);

} // namespace Orn_Hdl::Readers::Vhdl
