#include "import/Values.h"

#include "import/Spelling.h"

#include <algorithm>
#include <cstddef>
#include <optional>
#include <string_view>

namespace Tool::Import {

namespace {

/// Whether a text can be written unchanged between double quotes in both languages, and is not
/// itself enclosed in quotes.
bool IsPlainText(std::string_view text) noexcept {
    const auto isPlain = [](char c) { return c >= ' ' && c <= '~' && c != '"' && c != '\\'; };
    const bool isQuoted = !text.empty() && text.front() == '\'' && text.back() == '\'';
    return !isQuoted && std::all_of(text.begin(), text.end(), isPlain);
}

/// The bits of a text's characters, the first character leftmost.
std::string MakeTextBits(std::string_view text) {
    std::string digits;
    for (const char c : text) {
        for (int bit = 7; bit >= 0; --bit) {
            digits += ((static_cast<unsigned char>(c) >> bit) & 1) != 0 ? '1' : '0';
        }
    }
    return digits;
}

std::int32_t ToInteger(std::string_view digits) noexcept {
    std::uint32_t number = 0;
    for (const char digit : digits) {
        number = number * 2 + (digit == '1' ? 1 : 0);
    }
    return static_cast<std::int32_t>(number);
}

} // namespace

bool MeansAny(const Value& value, const UnknownValues& unknown) noexcept {
    return value.kind == Value::Bits && !unknown.HasDigit() &&
           value.text.find_first_of(unknown.AreDontCares() ? "xz" : "x") != std::string_view::npos;
}

void CheckParameter(const Value& value, const Place& place, const UnknownValues& unknown,
                    Warnings& warnings) {
    if (value.kind == Value::Text && !IsPlainText(value.text)) {
        warnings.Add(place.ToPath(),
                     "a text with quotes, backslashes or special characters becomes a bit vector");
    }
    if (value.kind != Value::Bits || unknown.HasReplacement()) {
        return;
    }
    if (value.text.find('z') != std::string_view::npos) {
        UnknownValues::Refuse(HighImpedance, place.ToPath());
    }
}

void WarnOfAny(const Place& place, Warnings& warnings) {
    warnings.Add(place.ToPath(),
                 "x means any value in a parameter; the parameter is left out if its "
                 "default is known, otherwise x becomes 0");
}

TypedValue MakeGeneric(const std::string& name, const Value& value, const UnknownValues& unknown) {
    if (value.kind == Value::Integer) {
        return TypedValue{name, "Integer", std::to_string(value.integer)};
    }
    if (value.kind == Value::Text) {
        return IsPlainText(value.text)
                   ? TypedValue{name, "String", std::string(value.text)}
                   : TypedValue{name, "BitVector", MakeConstant(MakeTextBits(value.text), false)};
    }
    std::string digits(value.text);
    std::replace_if(
        digits.begin(), digits.end(), [](char c) { return c == 'x' || c == 'z'; },
        unknown.Replace(Unknown) == One ? '1' : '0');
    return TypedValue{name, "BitVector", MakeConstant(digits, false)};
}

std::string MakeIntegerBits(std::int32_t integer, std::size_t width) {
    constexpr std::size_t IntegerWidth = 32;
    std::string bits(width, integer < 0 ? '1' : '0');
    for (std::size_t i = 0; i < std::min(width, IntegerWidth); ++i) {
        bits[width - 1 - i] = ((static_cast<std::uint32_t>(integer) >> i) & 1) != 0 ? '1' : '0';
    }
    return bits;
}

TypedValue MakeNeutralGeneric(const Value& value) {
    Value neutral;
    neutral.kind = value.kind;
    if (value.kind == Value::Text && !IsPlainText(value.text)) {
        // Its other values are bit vectors, too.
        return TypedValue{"", "BitVector", MakeConstant("0", false)};
    }
    const std::string zeros(value.kind == Value::Bits ? value.text.size() : 0, '0');
    neutral.text = zeros;
    return MakeGeneric("", neutral, UnknownValues(std::nullopt));
}

void CheckAttribute(const Value& value, const Place& place, Warnings& warnings) {
    if (value.kind == Value::Text && !IsPlainText(value.text)) {
        warnings.Add(place.ToPath(),
                     "quotes, backslashes and special characters are replaced by \"_\"");
    }
}

TypedValue MakeAttribute(const std::string& name, const Value& value) {
    constexpr std::size_t IntegerWidth = 32;
    if (value.kind == Value::Integer) {
        return TypedValue{name, "Integer", std::to_string(value.integer)};
    }
    std::string text(value.text);
    if (value.kind == Value::Bits && text.find_first_of("xz") == std::string::npos) {
        return text.size() == IntegerWidth
                   ? TypedValue{name, "Integer", std::to_string(ToInteger(text))}
                   : TypedValue{name, "BitVector", MakeConstant(text, false)};
    }
    if (!IsPlainText(text)) {
        std::replace_if(
            text.begin(), text.end(),
            [](char c) { return c == '\'' || !IsPlainText(std::string_view(&c, 1)); }, '_');
    }
    return TypedValue{name, "String", text};
}

} // namespace Tool::Import
