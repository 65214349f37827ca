#include "Readers/Vhdl/Literals.h"

#include "Port/Ascii.h"
#include "Readers/Limits.h"
#include "Readers/Place.h"

#include <algorithm>
#include <charconv>
#include <cstddef>

namespace Orn_Hdl::Readers::Vhdl {

namespace {

std::string WithoutUnderscores(std::string_view text) {
    std::string result(text);
    result.erase(std::remove(result.begin(), result.end(), '_'), result.end());
    return result;
}

int ValueOf(char digit) noexcept {
    return Port::IsDigit(digit) ? digit - '0' : Port::ToLower(digit) - 'a' + 10;
}

[[noreturn]] void RefuseValue(char character) {
    throw LiteralProblem{std::string("the value '") + character +
                         "': a model has the values 0 and 1 alone"};
}

/// The bits of binary, octal or hexadecimal digits.
std::string DigitBits(const std::string& digits, int base) {
    const int perDigit = base == 2 ? 1 : base == 8 ? 3 : 4;
    if (digits.size() > MostBits) {
        throw LiteralProblem{"a bit string literal of too many digits"};
    }
    std::string bits;
    for (const char digit : digits) {
        const bool isDigit = Port::IsDigit(digit) || Port::IsLetter(digit);
        if (!isDigit || ValueOf(digit) >= base) {
            if (std::string_view("UXZWLH-").find(Port::ToUpper(digit)) != std::string_view::npos) {
                RefuseValue(digit);
            }
            throw LiteralProblem{std::string("the digit ") + digit + " in a number of base " +
                                 std::to_string(base)};
        }
        for (int bit = perDigit; bit-- > 0;) {
            bits += (ValueOf(digit) >> bit & 1) != 0 ? '1' : '0';
        }
    }
    return bits;
}

/// Makes the bits as many as the literal says (IEEE 1076-2008, 15.8).
void Fit(std::string& bits, std::size_t length, bool isSigned) {
    const char filler = isSigned && !bits.empty() ? bits.front() : '0';
    if (bits.size() < length) {
        bits.insert(0, length - bits.size(), filler);
        return;
    }
    const std::size_t extra = bits.size() - length;
    const char wanted = isSigned && length > 0 ? bits[extra] : '0';
    if (bits.find_first_not_of(wanted) < extra) {
        throw LiteralProblem{"a bit string literal whose digits do not fit in " +
                             std::to_string(length) + " bits"};
    }
    bits.erase(0, extra);
}

} // namespace

std::optional<std::int64_t> GetInteger(std::string_view source) {
    const std::string text = WithoutUnderscores(source);
    constexpr std::uint64_t Largest = std::uint64_t(1) << 62;
    const char* const end = text.data() + text.size();
    unsigned base = 10;
    std::uint64_t value = 0;
    auto result = std::from_chars(text.data(), end, value);
    if (result.ec != std::errc()) {
        return std::nullopt;
    }
    if (result.ptr != end && *result.ptr == '#') {
        constexpr unsigned LargestBase = 16;
        base = static_cast<unsigned>(std::min<std::uint64_t>(value, LargestBase + 1));
        if (base < 2 || base > LargestBase) {
            return std::nullopt;
        }
        const char* const first = result.ptr + 1;
        result = std::from_chars(first, end, value, static_cast<int>(base));
        if (result.ec != std::errc() || result.ptr == first || result.ptr == end ||
            *result.ptr != '#') {
            return std::nullopt;
        }
        ++result.ptr;
    }
    if (result.ptr != end && (*result.ptr | 0x20) == 'e') {
        const char* first = result.ptr + 1;
        first += first != end && *first == '+' ? 1 : 0;
        unsigned exponent = 0;
        result = std::from_chars(first, end, exponent);
        if (result.ec != std::errc()) {
            return std::nullopt;
        }
        for (; exponent > 0 && value > 0; --exponent) {
            if (value > Largest / base) {
                return std::nullopt;
            }
            value *= base;
        }
    }
    if (result.ptr != end || value > Largest) {
        return std::nullopt;
    }
    return static_cast<std::int64_t>(value);
}

bool IsReal(std::string_view text) noexcept {
    return text.find('.') != std::string_view::npos && text.find('#') == std::string_view::npos;
}

std::string ReadString(std::string_view text) {
    std::string result;
    for (std::size_t i = 0; i < text.size(); ++i) {
        result += text[i];
        i += text[i] == '"' ? 1 : 0;
    }
    return result;
}

char ReadBit(char character, Unknowns unknowns) {
    if (unknowns == Unknowns::Keep && (character == 'X' || character == 'Z' || character == '-')) {
        return Port::ToLower(character);
    }
    if (unknowns == Unknowns::DontCare && (character == 'X' || character == '-')) {
        return '-';
    }
    if (character != '0' && character != '1') {
        RefuseValue(character);
    }
    return character;
}

std::string ReadBits(std::string_view text, Unknowns unknowns) {
    if (text.size() > MostBits) {
        throw LiteralProblem{"a string of more than " + std::to_string(MostBits) + " bits"};
    }
    std::string bits(text);
    for (char& bit : bits) {
        bit = ReadBit(bit, unknowns);
    }
    return bits;
}

BitString BitString::Read(std::string_view text) {
    const std::size_t quote = text.find('"');
    const std::size_t letter = std::min(text.find_first_not_of("0123456789_"), quote);
    const std::string digits = WithoutUnderscores(text.substr(quote + 1, text.size() - quote - 2));
    std::string_view base = text.substr(letter, quote - letter);
    const bool isSigned = base.size() > 1 && Port::ToLower(base.front()) == 's';
    base.remove_prefix(base.size() > 1 ? 1 : 0);
    std::optional<std::size_t> length;
    if (letter > 0) {
        const std::optional<std::int64_t> number = GetInteger(text.substr(0, letter));
        if (!number || *number > static_cast<std::int64_t>(MostBits)) {
            throw LiteralProblem{"a bit string literal of more than " + std::to_string(MostBits) +
                                 " bits"};
        }
        length = static_cast<std::size_t>(*number);
    }
    BitString literal;
    switch (base.empty() ? '\0' : Port::ToLower(base.front())) {
    case 'b':
        literal.bits = DigitBits(digits, 2);
        break;
    case 'o':
        literal.bits = DigitBits(digits, 8);
        break;
    case 'x':
        literal.bits = DigitBits(digits, 16);
        break;
    case 'd':
        literal.bits = DecimalBits(digits);
        break;
    default:
        throw LiteralProblem{"a bit string literal with the base " + Quoted(base)};
    }
    const std::size_t natural = literal.bits.size();
    if (length) {
        Fit(literal.bits, *length, isSigned);
    }
    const char letterOfBase = Port::ToUpper(base.front());
    if (literal.bits.size() == natural && natural > 0 &&
        (letterOfBase == 'X' || letterOfBase == 'O')) {
        literal.constant = std::to_string(natural) + (letterOfBase == 'X' ? ":H:" : ":O:") + digits;
    }
    return literal;
}

} // namespace Orn_Hdl::Readers::Vhdl
