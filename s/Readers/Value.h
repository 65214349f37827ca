// The values of parameters, generics and attributes.
#pragma once

#include "Orn_Hdl/Attributes.h"
#include "Orn_Hdl/Model/Netlist.h"

#include <memory>
#include <string>
#include <string_view>

namespace Orn_Hdl::Readers {

/// Why a literal cannot be taken; the text is a message.
struct LiteralProblem {
    std::string text;
};

/// What becomes of a digit of the value x or z, or "-" in VHDL.
enum class Unknowns {
    /// It is an error.
    Refuse,
    /// It stays, for a sink that judges it by itself.
    Keep,
    /// X and "-" become don't cares, which are digits "-" of a model's constant; z is an error.
    DontCare
};

/// The value of a parameter, a generic or an attribute.
struct Value {
    Attribute::ValueType type = Attribute::String;
    /// As the attribute's `SetValue` reads it.
    std::string text;
    /// The name of the type of an `Attribute::User`.
    std::string userType;

    static Value OfBits(const std::string& bits);
    /// A value of the same type and width: 0, or an empty string.
    Value GetZero() const;

    /// Makes an attribute of the type that has the value.
    std::unique_ptr<Attribute> MakeAttribute(const char* name) const;
};

/// The constant of a model with these bits: "4:B:1010", or "1" for one bit when `isBare`.
std::string MakeConstant(const std::string& bits, bool isBare);

/// Whether a constant of a netlist that was read has a don't care.
bool HasDontCares(const Netlist& netlist);

/// The bits of a decimal number, leftmost first, without zeros in front.
/// \throws LiteralProblem for a character that is no digit, and for too many.
std::string DecimalBits(std::string digits);

/// A real number without an exponent: a model keeps as many decimals as the text has.
/// \throws LiteralProblem.
std::string WithoutExponent(const std::string& text);

/// Gives an object an attribute, or an attribute that it has another option.
/// \param generic, synthesis options as `Attribute` takes them; null for one that stays.
/// \return an empty text, or why the object cannot have it.
std::string SetAttribute(AttributeHolder& holder, const std::string& name, const Value& value,
                         const char* generic, const char* synthesis);

} // namespace Orn_Hdl::Readers
