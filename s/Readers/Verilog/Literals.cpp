#include "Readers/Verilog/Literals.h"

#include "Readers/Limits.h"
#include "Readers/Verilog/Characters.h"

#include <algorithm>
#include <charconv>
#include <limits>

namespace Orn_Hdl::Readers {

namespace {

constexpr std::uint32_t UnsizedWidth = 32;

std::string WithoutBlanks(std::string_view text) {
    std::string result;
    for (const char c : text) {
        if (!Characters::IsBlank(c) && c != '_') {
            result += c;
        }
    }
    return result;
}

int BaseOf(char letter) noexcept {
    switch (letter) {
    case 'b':
    case 'B':
        return 2;
    case 'o':
    case 'O':
        return 8;
    case 'h':
    case 'H':
        return 16;
    default:
        return 10;
    }
}

/// How many bits a digit of a base stands for; 0 for the decimal one.
std::uint32_t BitsOfDigit(int base) noexcept {
    return base == 2 ? 1 : base == 8 ? 3 : base == 16 ? 4 : 0;
}

int ValueOf(char digit) noexcept {
    if (Characters::IsDigit(digit)) {
        return digit - '0';
    }
    return (digit | 0x20) - 'a' + 10;
}

/// Whether a digit or a bit stands for x, z or a don't care.
bool IsUnknown(char c) noexcept {
    return c == '?' || c == '-' || (c | 0x20) == 'x' || (c | 0x20) == 'z';
}

void RefuseUnknown(std::string_view digits) {
    for (const char c : digits) {
        if (c != '-' && IsUnknown(c)) {
            throw LiteralProblem{std::string("the digit ") + c +
                                 ": a model has the values 0 and 1 alone"};
        }
    }
}

void RefuseDigitsOfOtherBases(std::string_view digits, int base) {
    // A decimal number can be x or z as a whole.
    const bool mayBeUnknown = base != 10 || digits.size() == 1;
    for (const char c : digits) {
        if (mayBeUnknown && IsUnknown(c)) {
            continue;
        }
        if (ValueOf(c) >= base) {
            throw LiteralProblem{std::string("the digit ") + c + " in a number of base " +
                                 std::to_string(base)};
        }
    }
}

std::uint32_t ReadSize(std::string_view text) {
    std::uint32_t size = 0;
    const auto result = std::from_chars(text.data(), text.data() + text.size(), size);
    if (result.ec != std::errc() || size == 0 || size > MostBits) {
        throw LiteralProblem{"a number of " + std::string(text) + " bits: from 1 to " +
                             std::to_string(MostBits) + " can be read"};
    }
    return size;
}

std::string DigitBits(const std::string& digits, int base) {
    const std::uint32_t count = BitsOfDigit(base);
    if (count == 0 && !IsUnknown(digits.front())) {
        return DecimalBits(digits);
    }
    if (digits.size() > MostBits) {
        throw LiteralProblem{"a number of too many digits"};
    }
    std::string bits;
    for (const char digit : digits) {
        if (IsUnknown(digit)) {
            const char bit = digit == '-' ? digit : (digit | 0x20) == 'x' ? 'x' : 'z';
            bits.append(std::max(count, 1U), bit);
            continue;
        }
        for (std::uint32_t bit = count; bit-- > 0;) {
            bits += (ValueOf(digit) >> bit & 1) != 0 ? '1' : '0';
        }
    }
    return bits;
}

Number ReadBased(std::string_view text, std::size_t apostrophe, Unknowns unknowns) {
    Number number;
    number.isBased = true;
    if (apostrophe > 0) {
        number.size = ReadSize(text.substr(0, apostrophe));
    }
    text.remove_prefix(apostrophe + 1);
    if (text.size() == 1) {
        number.kind = Number::Fill;
        number.base = 2;
    } else {
        if ((text.front() | 0x20) == 's') {
            number.isSigned = true;
            text.remove_prefix(1);
        }
        number.base = BaseOf(text.front());
        text.remove_prefix(1);
    }
    number.digits = text;
    if (unknowns == Unknowns::DontCare) {
        std::replace_if(
            number.digits.begin(), number.digits.end(), [](char c) { return (c | 0x20) == 'x'; },
            '-');
    }
    if (unknowns != Unknowns::Keep) {
        RefuseUnknown(number.digits);
    }
    RefuseDigitsOfOtherBases(number.digits, number.base);
    return number;
}

} // namespace

Number Number::Read(std::string_view withBlanks, Unknowns unknowns) {
    const std::string text = WithoutBlanks(withBlanks);
    const std::size_t apostrophe = text.find('\'');
    if (apostrophe != std::string::npos) {
        return ReadBased(text, apostrophe, unknowns);
    }
    Number number;
    number.digits = text;
    if (text.find_first_of(".eE") != std::string::npos) {
        number.kind = Real;
    } else {
        number.isSigned = true;
    }
    return number;
}

std::uint32_t Number::GetWidth() const {
    if (kind == Fill) {
        return 1;
    }
    if (size > 0) {
        return size;
    }
    if (kind == Real) {
        return UnsizedWidth;
    }
    const std::string bits = DigitBits(digits, base);
    const std::size_t first = std::min(bits.find('1'), bits.size());
    return static_cast<std::uint32_t>(std::max<std::size_t>(UnsizedWidth, bits.size() - first));
}

std::string Number::GetBits(std::uint32_t width) const {
    if (kind == Real) {
        throw LiteralProblem{"a real number is no value of a net"};
    }
    if (kind == Fill) {
        return std::string(width, DigitBits(digits, base).front());
    }
    std::string bits = DigitBits(digits, base);
    const auto fit = [&bits](std::size_t count, char filler) {
        if (bits.size() > count) {
            bits.erase(0, bits.size() - count);
        } else {
            bits.insert(0, count - bits.size(), filler);
        }
    };
    // A size or no size at all extends x and z (IEEE 1364-2005, clause 3.5.1).
    const char first = bits.empty() || !IsUnknown(bits.front()) ? '0' : bits.front();
    fit(GetWidth(), first);
    fit(width, size == 0 && first != '0'         ? first
               : isSigned && bits.front() != '0' ? bits.front()
                                                 : '0');
    return bits;
}

std::optional<std::int64_t> Number::GetValue() const {
    constexpr std::size_t MostValueBits = 62;
    if (kind != Integer) {
        return std::nullopt;
    }
    const std::string bits = GetBits(GetWidth());
    const std::size_t first = std::min(bits.find('1'), bits.size());
    if (std::any_of(bits.begin(), bits.end(), IsUnknown) || bits.size() - first > MostValueBits ||
        (size > 0 && isSigned && bits.front() == '1')) {
        return std::nullopt;
    }
    std::int64_t value = 0;
    for (std::size_t i = first; i < bits.size(); ++i) {
        value = value * 2 + (bits[i] - '0');
    }
    return value;
}

std::string MakeConstant(const Number& number, std::uint32_t width, bool isBare) {
    const std::uint32_t perDigit = BitsOfDigit(number.base);
    // A model writes the digits in a language in which each stands for as many bits.
    const bool keepsDigits = number.kind == Number::Integer && number.size == width &&
                             perDigit > 1 && width % perDigit == 0 &&
                             number.digits.size() <= width / perDigit;
    if (isBare || !keepsDigits) {
        return MakeConstant(number.GetBits(width), isBare);
    }
    std::string constant = std::to_string(width) + (number.base == 8 ? ":O:" : ":H:");
    return constant.append(width / perDigit - number.digits.size(), '0').append(number.digits);
}

Value ValueOf(const Number& number, bool isNegative) {
    if (number.kind == Number::Real) {
        return {Attribute::Float, (isNegative ? "-" : "") + WithoutExponent(number.digits), {}};
    }
    if (number.size == 0 && number.kind == Number::Integer) {
        const std::optional<std::int64_t> value = number.GetValue();
        constexpr std::int64_t Largest = std::numeric_limits<std::int32_t>::max();
        if (!value || *value > Largest + (isNegative ? 1 : 0)) {
            throw LiteralProblem{"the number " + number.digits +
                                 " does not fit in the 32 bits that a model's integers have"};
        }
        return {Attribute::Integer, std::to_string(isNegative ? -*value : *value), {}};
    }
    if (isNegative) {
        throw LiteralProblem{"a negative number with a size is no value that a model has"};
    }
    if (number.kind == Number::Fill || (number.size == 1 && number.base == 2)) {
        return {Attribute::Bit, number.GetBits(1), {}};
    }
    return {Attribute::BitVector, MakeConstant(number, number.size, false), {}};
}

Value ValueOfString(std::string_view text) {
    return {Attribute::String, ReadString(text), {}};
}

std::string ReadString(std::string_view text) {
    std::string result;
    for (std::size_t i = 0; i < text.size(); ++i) {
        if (text[i] != '\\' || i + 1 == text.size()) {
            result += text[i];
            continue;
        }
        const char escaped = text[++i];
        if (escaped == 'n') {
            result += '\n';
        } else if (escaped == 't') {
            result += '\t';
        } else if (escaped >= '0' && escaped <= '7') {
            int code = 0;
            std::size_t length = 0;
            for (; length < 3 && i + length < text.size() && text[i + length] >= '0' &&
                   text[i + length] <= '7';
                 ++length) {
                code = code * 8 + (text[i + length] - '0');
            }
            i += length - 1;
            result += static_cast<char>(code);
        } else {
            result += escaped;
        }
    }
    return result;
}

} // namespace Orn_Hdl::Readers
