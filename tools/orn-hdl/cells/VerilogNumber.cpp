#include "cells/VerilogNumber.h"

#include "Port/Ascii.h"

#include <algorithm>
#include <charconv>
#include <limits>
#include <string>

namespace Tool::Cells {

namespace {

std::string Compact(std::string_view text) {
    std::string result;
    for (const char c : text) {
        if (Port::IsDigit(c) || Port::IsLetter(c) || c == '\'' || c == '?' || c == '.') {
            result += Port::IsLetter(c) ? Port::ToLower(c) : c;
        }
    }
    return result;
}

std::optional<std::int64_t> ParseDecimal(std::string_view digits) noexcept {
    std::int64_t number = 0;
    const char* const end = digits.data() + digits.size();
    const auto [parsed, error] = std::from_chars(digits.data(), end, number);
    const bool isWhole = error == std::errc() && parsed == end;
    return isWhole && number >= 0 ? std::optional(number) : std::nullopt;
}

std::string MakeBits(std::uint64_t number, std::size_t width) {
    std::string bits(width, '0');
    for (std::size_t i = 0; i < width && i < 64; ++i) {
        bits[width - 1 - i] = ((number >> i) & 1) != 0 ? '1' : '0';
    }
    return bits;
}

/// The bits of digits of a base of 2, 8 or 16; nothing if a digit is none of the base.
std::optional<std::string> ReadDigits(std::string_view digits, unsigned bitsOfDigit) {
    std::string bits;
    for (const char c : digits) {
        if (c == 'x' || c == 'z' || c == '?') {
            bits.append(bitsOfDigit, c == 'x' ? 'x' : 'z');
            continue;
        }
        const unsigned value = static_cast<unsigned>(Port::IsDigit(c) ? c - '0'
                                                     : c >= 'a'       ? c - 'a' + 10
                                                                      : 16);
        if (value >= 1U << bitsOfDigit) {
            return std::nullopt;
        }
        bits.append(MakeBits(value, bitsOfDigit));
    }
    return bits.empty() ? std::nullopt : std::optional(bits);
}

/// Cuts bits, or fills them on the left, with an x or z if they begin with one.
void Resize(std::string& bits, std::size_t width) {
    if (bits.size() > width) {
        bits.erase(0, bits.size() - width);
    } else {
        const char first = bits.front();
        bits.insert(0, width - bits.size(), first == 'x' || first == 'z' ? first : '0');
    }
}

unsigned GetBitsOfDigit(char base) noexcept {
    switch (base) {
    case 'b':
        return 1;
    case 'o':
        return 3;
    case 'h':
        return 4;
    default:
        return 0;
    }
}

std::optional<std::string> ReadBased(std::string_view text, std::size_t width) {
    if (text.substr(0, 1) == "s") {
        text.remove_prefix(1);
    }
    const char base = text.empty() ? '\0' : text.front();
    text.remove_prefix(text.empty() ? 0 : 1);
    std::optional<std::string> bits;
    if (const unsigned bitsOfDigit = GetBitsOfDigit(base); bitsOfDigit != 0) {
        bits = ReadDigits(text, bitsOfDigit);
    } else if (const auto number = ParseDecimal(text); base == 'd' && number) {
        bits = MakeBits(static_cast<std::uint64_t>(*number), 64);
    }
    if (bits) {
        Resize(*bits, width);
    }
    return bits;
}

} // namespace

void SetNumber(CellParameter& parameter, std::string_view text, bool isNegative,
               std::optional<std::int64_t> width) {
    // A short number must not stand for a huge text.
    const std::size_t widest = std::max<std::size_t>(1024, 4 * text.size());
    const std::string number = Compact(text);
    const std::size_t tick = number.find('\'');
    if (tick == std::string::npos) {
        const std::optional<std::int64_t> value = ParseDecimal(number);
        if (!value || *value > std::numeric_limits<std::int32_t>::max()) {
            return;
        }
        const std::int64_t integer = isNegative ? -*value : *value;
        if (width && *width <= static_cast<std::int64_t>(widest)) {
            parameter.kind = CellParameter::Bits;
            parameter.text =
                MakeBits(static_cast<std::uint64_t>(integer), static_cast<std::size_t>(*width));
        } else if (!width) {
            parameter.kind = CellParameter::Integer;
            parameter.integer = static_cast<std::int32_t>(integer);
        }
        return;
    }
    const std::string_view size = std::string_view(number).substr(0, tick);
    constexpr std::int64_t UnsizedWidth = 32;
    const std::optional<std::int64_t> ownWidth =
        size.empty() ? std::optional(UnsizedWidth) : ParseDecimal(size);
    const std::int64_t finalWidth = width.value_or(ownWidth.value_or(0));
    if (isNegative || !ownWidth || *ownWidth < 1 || finalWidth < 1 ||
        std::max(*ownWidth, finalWidth) > static_cast<std::int64_t>(widest)) {
        return;
    }
    std::optional<std::string> bits =
        ReadBased(std::string_view(number).substr(tick + 1), static_cast<std::size_t>(*ownWidth));
    if (bits) {
        Resize(*bits, static_cast<std::size_t>(finalWidth));
        parameter.kind = CellParameter::Bits;
        parameter.text = std::move(*bits);
    }
}

void ConstantSum::Add(std::string_view token) noexcept {
    constexpr std::int64_t Greatest = std::int64_t(1) << 40;
    if (token == "+" || token == "-") {
        isValid_ = isValid_ && (!needsNumber_ || token == "-");
        sign_ = token == "-" ? -1 : 1;
        needsNumber_ = true;
        return;
    }
    const std::optional<std::int64_t> number = ParseDecimal(token);
    isValid_ = isValid_ && needsNumber_ && number && *number < Greatest && sum_ < Greatest &&
               sum_ > -Greatest;
    if (isValid_) {
        sum_ += sign_ * *number;
    }
    needsNumber_ = false;
}

std::optional<std::int64_t> ConstantSum::Get() const noexcept {
    return isValid_ && !needsNumber_ ? std::optional(sum_) : std::nullopt;
}

} // namespace Tool::Cells
