#include "Readers/Vhdl/Types.h"

#include "Port/Ascii.h"
#include "Readers/Limits.h"
#include "Readers/Vhdl/Design.h"
#include "Readers/Vhdl/Literals.h"

#include <algorithm>
#include <cstddef>
#include <limits>

namespace Orn_Hdl::Readers::Vhdl {

namespace {

template <std::size_t Count>
bool IsOneOf(std::string_view name, const std::string_view (&words)[Count]) noexcept {
    for (const std::string_view word : words) {
        if (Port::EqualIgnoringCase(name, word)) {
            return true;
        }
    }
    return false;
}

constexpr std::string_view BitTypes[] = {"std_logic", "std_ulogic", "bit"};
constexpr std::string_view VectorTypes[] = {"std_logic_vector", "std_ulogic_vector", "bit_vector"};
constexpr std::string_view IntegerTypes[] = {"integer", "natural", "positive"};
constexpr std::string_view NumericVectors[] = {"unsigned", "signed"};

std::optional<Attribute::ValueType> TypeOf(std::string_view name) {
    if (Port::EqualIgnoringCase(name, "string")) {
        return Attribute::String;
    }
    if (IsOneOf(name, IntegerTypes)) {
        return Attribute::Integer;
    }
    if (Port::EqualIgnoringCase(name, "real")) {
        return Attribute::Float;
    }
    if (Port::EqualIgnoringCase(name, "boolean")) {
        return Attribute::Boolean;
    }
    if (IsBitType(name)) {
        return Attribute::Bit;
    }
    if (IsVectorType(name) || IsOneOf(name, NumericVectors)) {
        return Attribute::BitVector;
    }
    return std::nullopt;
}

bool IsBoolean(std::string_view text) {
    return Port::EqualIgnoringCase(text, "true") || Port::EqualIgnoringCase(text, "false");
}

bool IsBitString(std::string_view text) {
    return text.size() > 2 && text.back() == '"' && text.front() != '"' &&
           text.find('"') < text.size() - 1 && text.find_first_of(" &'") == std::string_view::npos;
}

/// The type that a value seems to have.
Attribute::ValueType GuessType(std::string_view text) {
    const std::string_view unsignedText =
        text.substr(!text.empty() && (text.front() == '-' || text.front() == '+') ? 1 : 0);
    if (!unsignedText.empty() && Port::IsDigit(unsignedText.front()) && !IsBitString(text)) {
        return GetInteger(unsignedText) ? Attribute::Integer
               : IsReal(unsignedText)   ? Attribute::Float
                                        : Attribute::User;
    }
    if (IsBitString(text)) {
        return Attribute::BitVector;
    }
    if (text.size() > 1 && text.front() == '"') {
        return Attribute::String;
    }
    if (text == "'0'" || text == "'1'") {
        return Attribute::Bit;
    }
    return IsBoolean(text) ? Attribute::Boolean : Attribute::User;
}

[[noreturn]] void RefuseValue(std::string_view text) {
    throw LiteralProblem{"the value " + Quoted(text) + " is no literal of its type"};
}

/// Takes a string literal, or the character of a code, off the front of a text.
std::string TakeCharacters(std::string_view& text) {
    constexpr std::string_view CharacterOf = "character'val(";
    if (Port::EqualIgnoringCase(text.substr(0, CharacterOf.size()), CharacterOf)) {
        const std::size_t end = std::min(text.find(')'), text.size());
        const std::optional<std::int64_t> code =
            GetInteger(text.substr(CharacterOf.size(), end - CharacterOf.size()));
        if (!code || *code > 255 || end == text.size()) {
            RefuseValue(text);
        }
        text.remove_prefix(end + 1);
        return std::string(1, static_cast<char>(*code));
    }
    std::size_t end = 1;
    while (end < text.size() && (text[end] != '"' || text.substr(end, 2) == "\"\"")) {
        end += text[end] == '"' ? 2 : 1;
    }
    if (text.empty() || text.front() != '"' || end >= text.size()) {
        RefuseValue(text);
    }
    std::string characters = ReadString(text.substr(1, end - 1));
    text.remove_prefix(end + 1);
    return characters;
}

/// The characters of a string literal, or of several that are concatenated.
std::string StringOf(std::string_view text) {
    std::string result;
    for (;;) {
        result += TakeCharacters(text);
        text.remove_prefix(std::min(text.find_first_not_of(' '), text.size()));
        if (text.empty()) {
            return result;
        }
        if (text.front() != '&') {
            RefuseValue(text);
        }
        text.remove_prefix(1);
        text.remove_prefix(std::min(text.find_first_not_of(' '), text.size()));
    }
}

std::string FloatOf(std::string_view text) {
    std::string digits;
    for (const char c : text) {
        if (c != '_' && c != ' ' && c != '+') {
            digits += c;
        }
    }
    const std::size_t first = !digits.empty() && digits.front() == '-' ? 1 : 0;
    if (digits.size() == first || !Port::IsDigit(digits[first]) ||
        digits.find_first_not_of("0123456789.eE-", first) != std::string::npos) {
        RefuseValue(text);
    }
    return digits.substr(0, first) + WithoutExponent(digits.substr(first));
}

std::string BitVectorOf(std::string_view text) {
    if (IsBitString(text)) {
        return BitString::Read(text).GetConstant();
    }
    const std::string bits = ReadBits(StringOf(text));
    return bits.empty() ? bits : MakeConstant(bits, false);
}

Value ValueOf(std::string_view text, Attribute::ValueType type, std::string_view typeName) {
    switch (type) {
    case Attribute::String:
        return {type, StringOf(text), {}};
    case Attribute::Float:
        return {type, FloatOf(text), {}};
    case Attribute::Boolean:
        if (!IsBoolean(text)) {
            RefuseValue(text);
        }
        return {type, std::string(text), {}};
    case Attribute::Bit:
        if (text.size() != 3 || text.front() != '\'') {
            RefuseValue(text);
        }
        return {type, std::string(1, ReadBit(text[1])), {}};
    case Attribute::BitVector:
        return {type, BitVectorOf(text), {}};
    default:
        if (text.empty()) {
            throw LiteralProblem{"a value is expected here"};
        }
        return {Attribute::User, std::string(text), std::string(typeName)};
    }
}

Value IntegerOf(std::int64_t value) {
    constexpr std::int64_t Smallest = std::numeric_limits<std::int32_t>::min();
    constexpr std::int64_t Largest = std::numeric_limits<std::int32_t>::max();
    if (value < Smallest || value > Largest) {
        throw LiteralProblem{"the number " + std::to_string(value) +
                             " does not fit in the 32 bits that a model's integers have"};
    }
    return {Attribute::Integer, std::to_string(value), {}};
}

} // namespace

bool IsVectorType(std::string_view name) noexcept {
    return IsOneOf(name, VectorTypes);
}

bool IsBitType(std::string_view name) noexcept {
    return IsOneOf(name, BitTypes);
}

bool IsKnownType(std::string_view name) {
    return TypeOf(name).has_value();
}

std::string GetTypeName(const Attribute& attribute) {
    switch (attribute.GetValueType()) {
    case Attribute::String:
        return "string";
    case Attribute::Integer:
        return "integer";
    case Attribute::Float:
        return "real";
    case Attribute::Boolean:
        return "boolean";
    case Attribute::Bit:
        return "bit";
    case Attribute::BitVector:
        return "bit_vector";
    default:
        return std::string(static_cast<const AttributeUser&>(attribute).GetUserType().GetView());
    }
}

std::optional<Range> ReadBounds(Parser& parser, const Parser::Resolve& resolve,
                                std::string& problem) {
    const std::optional<std::int64_t> left = parser.ReadInteger(resolve);
    const bool isDownto = parser.GetKeyword() == Keyword::Downto;
    std::optional<std::int64_t> right;
    if (left && (isDownto || parser.GetKeyword() == Keyword::To)) {
        parser.Next();
        right = parser.ReadInteger(resolve);
    }
    if (!right) {
        problem = "a range whose value cannot be told";
    } else if (*left < 0 || *right < 0) {
        problem = "a range with a negative index, which no name in a model can have";
    } else if (*left > LargestIndex || *right > LargestIndex) {
        problem = "a range with an index that no model has: from 0 to 2147483647 are possible";
    } else if (isDownto ? *left < *right : *left > *right) {
        problem = "a range without bits";
    } else {
        return Range{static_cast<int>(*left), static_cast<int>(*right)};
    }
    return std::nullopt;
}

SignalType ReadSignalType(Parser& parser, const Parser::Resolve& resolve,
                          const Subtypes* subtypes) {
    SignalType type;
    std::string name;
    parser.TakeSelectedName(name, "name of a type");
    const auto subtype =
        subtypes == nullptr ? Subtypes::const_iterator() : subtypes->find(KeyOf(name));
    if (subtypes != nullptr && subtype != subtypes->end() && !parser.IsSign('(')) {
        return subtype->second;
    }
    if (!IsVectorType(name)) {
        if (!IsBitType(name)) {
            type.problem = "the type " + Quoted(name) +
                           ": a model has bits and vectors of bits (std_logic, std_ulogic, bit and "
                           "their vectors)";
        } else if (parser.IsSign('(')) {
            type.problem = "a range of " + Quoted(name) + ", which is a type of one bit";
        }
    } else if (!parser.IsSign('(')) {
        type.problem = "a vector without a range";
    } else {
        parser.Next();
        type.range = ReadBounds(parser, resolve, type.problem);
        if (type.problem.empty() && !parser.IsSign(')')) {
            type.problem = "a range whose value cannot be told";
        }
        parser.SkipTo(')', ')');
        parser.Expect(')');
        if (parser.IsSign('(')) {
            type.problem = "an array of vectors";
        }
    }
    while (type.problem.empty() ? parser.GetKeyword() == Keyword::Bus
                                : !parser.IsEnd() && !parser.IsSign(';') && !parser.IsSign(')') &&
                                      !parser.IsSign(Becomes)) {
        if (parser.IsSign('(')) {
            parser.Next();
            parser.SkipTo(')', ')');
        }
        parser.Next();
    }
    return type;
}

std::string ReadTypeName(Parser& parser, char sign, char other) {
    std::string name;
    parser.TakeSelectedName(name, "name of a type");
    std::size_t depth = 0;
    for (; !parser.IsEnd() && !parser.IsSign(';'); parser.Next()) {
        if (depth == 0 && (parser.IsSign(sign) || parser.IsSign(other) || parser.IsSign(Becomes))) {
            break;
        }
        depth += parser.IsSign('(') ? 1 : 0;
        depth -= depth > 0 && parser.IsSign(')') ? 1 : 0;
    }
    return name;
}

Value ReadValue(Parser& parser, std::string_view typeName, char sign, char other,
                const Parser::Resolve& resolve) {
    const std::optional<Attribute::ValueType> type =
        typeName.empty() ? std::nullopt : TypeOf(typeName);
    if (type == Attribute::Integer) {
        const std::optional<std::int64_t> value = parser.ReadInteger(resolve);
        const std::string rest = parser.TakeSource(sign, other);
        if (!value || !rest.empty()) {
            throw LiteralProblem{"a value that is no number"};
        }
        return IntegerOf(*value);
    }
    const std::string text = parser.TakeSource(sign, other);
    if (type) {
        return ValueOf(text, *type, typeName);
    }
    if (!typeName.empty()) {
        return ValueOf(text, Attribute::User, typeName);
    }
    const Attribute::ValueType guessed = GuessType(text);
    if (guessed == Attribute::Integer) {
        const bool isNegative = text.front() == '-';
        const std::size_t first = isNegative || text.front() == '+' ? 1 : 0;
        const std::int64_t value = *GetInteger(std::string_view(text).substr(first));
        return IntegerOf(isNegative ? -value : value);
    }
    return ValueOf(text, guessed, typeName);
}

} // namespace Orn_Hdl::Readers::Vhdl
