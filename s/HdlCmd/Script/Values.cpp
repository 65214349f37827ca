#include "HdlCmd/Script/Values.h"

#include "Port/Ascii.h"
#include <charconv>
#include <string_view>

#include <algorithm>

namespace Orn_Hdl::Script {

namespace {

std::string_view BaseLetter(int base) noexcept {
    switch (base) {
    case 8:
        return "O";
    case 16:
        return "H";
    default:
        return "B";
    }
}

bool IsReadFrom(const std::string& text, const AttributeFloat& attribute) {
    const AttributeFloat read("", text.c_str());
    return read.GetValue() == attribute.GetValue() &&
           read.GetValueString() == attribute.GetValueString();
}

/// The shortest text that gives the number.
std::string Shortest(double value, std::chars_format format) {
    char digits[512];
    const auto result = std::to_chars(digits, digits + sizeof digits, value, format);
    return std::string(digits, result.ptr);
}

/// How many characters stand before and behind the point of the text decides how the number is
/// written. The written form has as many decimals as the text had; what it is padded with gives
/// zeros before the number.
std::string WithLeadingZeros(std::string_view written) {
    const std::size_t blanks = written.find_first_not_of(' ');
    std::string_view number = written.substr(blanks);
    std::string text;
    if (number.front() == '-') {
        text = '-';
        number.remove_prefix(1);
    }
    return text.append(blanks, '0').append(number);
}

std::string GetFloatText(const AttributeFloat& attribute) {
    const Port::StringBase<char> written = attribute.GetValueString();
    std::string padded = WithLeadingZeros(written.GetView());
    if (IsReadFrom(padded, attribute)) {
        return padded;
    }
    // The written form has fewer digits than the number.
    for (const auto format : {std::chars_format::general, std::chars_format::scientific}) {
        std::string text = Shortest(attribute.GetValue(), format);
        if (IsReadFrom(text, attribute)) {
            return text;
        }
    }
    return padded;
}

} // namespace

std::string GetText(const BitVectorValue& value) {
    const Port::StringBase<char>& digits = value.GetValue();
    if (!value.HasBaseAndLength()) {
        return std::string(digits.GetView());
    }
    std::string text = std::to_string(value.GetLength());
    return text.append(":")
        .append(BaseLetter(value.GetBase()))
        .append(":")
        .append(digits.GetView());
}

std::string GetText(const Attribute& attribute) {
    if (const auto* vector = dynamic_cast<const AttributeBitVector*>(&attribute)) {
        return GetText(vector->GetBitVectorValue());
    }
    if (const auto* number = dynamic_cast<const AttributeFloat*>(&attribute)) {
        return GetFloatText(*number);
    }
    return std::string(attribute.GetValueString().GetView());
}

std::string Folded(std::string_view name) {
    std::string folded(name);
    std::transform(folded.begin(), folded.end(), folded.begin(), Port::ToUpper);
    return folded;
}

} // namespace Orn_Hdl::Script
