#include "import/ReadableName.h"

#include "Port/Ascii.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>

namespace Tool::Import {

namespace {

constexpr std::string_view Mark = "$paramod";

/// How many digits of the number that stands for a long list are shown.
constexpr std::size_t ShownDigits = 8;
/// Values of more bits are shown as hexadecimal digits.
constexpr std::size_t LongestNumber = 63;
/// The longest name that is made of a module's parameters.
constexpr std::size_t LongestName = 48;
/// Of longer values, the name shows the beginning.
constexpr std::size_t LongestText = 16;

/// Takes the text before the next backslash off a name, and the backslash.
std::string_view TakePart(std::string_view& name) {
    const std::size_t end = std::min(name.find('\\'), name.size());
    const std::string_view part = name.substr(0, end);
    name.remove_prefix(std::min(end + 1, name.size()));
    return part;
}

bool IsBinary(std::string_view digits) noexcept {
    return !digits.empty() && digits.find_first_not_of("01") == std::string_view::npos;
}

std::uint64_t ToNumber(std::string_view bits) noexcept {
    std::uint64_t number = 0;
    for (const char bit : bits) {
        number = number << 1 | (bit == '1' ? 1 : 0);
    }
    return number;
}

/// The characters of a text whose bits are given, eight for each.
std::string ToText(std::string_view bits) {
    constexpr std::size_t BitsOfCharacter = 8;
    std::string text;
    for (std::size_t i = 0; i + BitsOfCharacter <= bits.size(); i += BitsOfCharacter) {
        text += static_cast<char>(ToNumber(bits.substr(i, BitsOfCharacter)));
    }
    return text.substr(0, LongestText);
}

std::string ToHex(std::string_view bits) {
    constexpr std::size_t BitsOfDigit = 4;
    std::string padded((BitsOfDigit - bits.size() % BitsOfDigit) % BitsOfDigit, '0');
    padded += bits;
    std::string text = "x";
    for (std::size_t i = 0; i < padded.size() && text.size() <= LongestText; i += BitsOfDigit) {
        text += "0123456789abcdef"[ToNumber(std::string_view(padded).substr(i, BitsOfDigit))];
    }
    return text;
}

std::string ShowBits(std::string_view bits, bool isSigned) {
    const bool isNegative = isSigned && bits.front() == '1';
    if (isNegative && bits.size() <= LongestNumber) {
        return "m" + std::to_string((std::uint64_t(1) << bits.size()) - ToNumber(bits));
    }
    const std::size_t first = bits.find('1');
    const std::string_view digits =
        first == std::string_view::npos ? bits.substr(bits.size() - 1) : bits.substr(first);
    return digits.size() <= LongestNumber ? std::to_string(ToNumber(digits)) : ToHex(bits);
}

/// A parameter's value, which Yosys writes as "s32'" and digits: "s" marks a signed number, "t" a
/// text.
std::string ShowValue(std::string_view value) {
    const std::size_t quote = value.find('\'');
    if (quote == std::string_view::npos || !IsBinary(value.substr(quote + 1))) {
        return std::string(value.substr(quote == std::string_view::npos ? 0 : quote + 1));
    }
    const std::string_view bits = value.substr(quote + 1);
    const std::string_view kind = value.substr(0, value.find_first_of("0123456789"));
    return kind.find('t') != std::string_view::npos
               ? ToText(bits)
               : ShowBits(bits, kind.find('s') != std::string_view::npos);
}

/// The value of a parameter of a module. One of 32 bits is most often an integer.
std::string ShowValue(const Value& value) {
    constexpr std::size_t IntegerWidth = 32;
    switch (value.kind) {
    case Value::Bits:
        return IsBinary(value.text) ? ShowBits(value.text, value.text.size() == IntegerWidth)
                                    : std::string(value.text);
    case Value::Integer:
        return std::to_string(value.integer);
    default:
        return std::string(value.text);
    }
}

/// The name of the module that was copied, and its parameters; empty if that is too long.
std::string JoinParameters(std::string_view copied, const Module& module) {
    std::string result(copied);
    for (const NamedValue& parameter : module.defaults) {
        result.append("_").append(parameter.name).append("_").append(ShowValue(parameter.value));
    }
    return module.defaults.empty() || result.size() > LongestName ? std::string() : result;
}
} // namespace

bool IsCopyOfModule(std::string_view name) noexcept {
    return name.substr(0, Mark.size()) == Mark && name.find('\\') != std::string_view::npos;
}

std::string MakeReadableName(const Module& module) {
    if (!IsCopyOfModule(module.name)) {
        return std::string(module.name);
    }
    std::string_view rest = module.name.substr(Mark.size());
    const std::string_view number = TakePart(rest);
    std::string result(TakePart(rest));
    if (std::string joined = JoinParameters(result, module); !number.empty() && !joined.empty()) {
        return joined;
    }
    if (!number.empty()) {
        return result.append("_").append(number.substr(1, ShownDigits));
    }
    while (!rest.empty()) {
        const std::string_view parameter = TakePart(rest);
        const std::size_t equals = std::min(parameter.find('='), parameter.size());
        result.append("_").append(parameter.substr(0, equals));
        if (equals < parameter.size()) {
            result.append("_").append(ShowValue(parameter.substr(equals + 1)));
        }
    }
    return result;
}

} // namespace Tool::Import
