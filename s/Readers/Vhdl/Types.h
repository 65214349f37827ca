// The types of ports, signals and generics.
#pragma once

#include "Readers/Range.h"
#include "Readers/Value.h"
#include "Readers/Vhdl/Parser.h"

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace Orn_Hdl::Readers::Vhdl {

/// The type of a port or a signal.
struct SignalType {
    /// Nothing for a type of one bit.
    std::optional<Range> range;
    /// Why no model can have a signal of the type; empty when one can.
    std::string problem;
};

/// Whether a name is that of a type of vectors of bits.
bool IsVectorType(std::string_view name) noexcept;
/// Whether a name is that of a type of one bit.
bool IsBitType(std::string_view name) noexcept;

/// The name of the type of a generic that an attribute is.
std::string GetTypeName(const Attribute& attribute);

/// Reads a subtype indication: "std_logic", "std_logic_vector(7 downto 0)".
SignalType ReadSignalType(Parser& parser, const Parser::Resolve& resolve);

/// Reads "7 downto 0". \return nothing when the range cannot be told; why is in `problem`.
std::optional<Range> ReadBounds(Parser& parser, const Parser::Resolve& resolve,
                                std::string& problem);

/// Reads a subtype indication of a generic, an attribute or a constant up to one of two signs, a
/// semicolon or ":=". \return the name of the type.
std::string ReadTypeName(Parser& parser, char sign, char other);

/// Reads the value of a generic or an attribute, up to one of two signs or a semicolon.
/// \param typeName the name of its type; the form of the value tells the type when it is empty.
/// \throws LiteralProblem, everything being read, when the value is none that a model has.
Value ReadValue(Parser& parser, std::string_view typeName, char sign, char other,
                const Parser::Resolve& resolve);

} // namespace Orn_Hdl::Readers::Vhdl
