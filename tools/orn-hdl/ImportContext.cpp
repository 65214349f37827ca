#include "ImportContext.h"

#include <algorithm>
#include <limits>

namespace Tool::Import {

namespace {

/// Whether a text can stand between double quotes in both languages and mean itself, and is not
/// taken for one that brought its own quotes.
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

Path Place::ToPath() const {
    Path path("modules");
    for (const std::string_view key : {module, table, object, part, name}) {
        if (!key.empty()) {
            path.AddKey(key);
        }
    }
    return path;
}

Path Context::GetPath(std::string_view table, std::string_view name) const {
    return Path("modules").AddKey(top_.name).AddKey(table).AddKey(name);
}

Path Context::GetPinPath(const Cell& cell, std::string_view pin) const {
    return GetPath("cells", cell.name).AddKey("connections").AddKey(pin);
}

void Context::Refuse(Bit bit, const Path& path) {
    Fail(path, bit == Unknown ? "the value x cannot be written; choose another one with --x-as"
                              : "the value z cannot be written; choose another one with --x-as");
}

void Context::CheckParameter(const Value& value, const Place& place) {
    if (value.kind == Value::Text && !IsPlainText(value.text)) {
        Warn(place.ToPath(),
             "a text with quotes, backslashes or special characters becomes a bit vector");
    }
    if (value.kind != Value::Bits || unknownAs_) {
        return;
    }
    const std::size_t unknown = value.text.find_first_of("xz");
    if (unknown != std::string_view::npos) {
        Refuse(value.text[unknown] == 'x' ? Unknown : HighImpedance, place.ToPath());
    }
}

TypedValue Context::MakeGeneric(const std::string& name, const Value& value) const {
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
        Settle(Unknown) == One ? '1' : '0');
    return TypedValue{name, "BitVector", MakeConstant(digits, false)};
}

void Context::CheckAttribute(const Value& value, const Place& place) {
    if (value.kind == Value::Text && !IsPlainText(value.text)) {
        Warn(place.ToPath(), "quotes, backslashes and special characters are replaced by \"_\"");
    }
}

TypedValue Context::MakeAttribute(const std::string& name, const Value& value) {
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

void Context::Warn(const Path& path, std::string_view text) {
    const auto [place, isNew] = warningIndex_.try_emplace(std::string(text), warnings_.size());
    if (isNew) {
        warnings_.push_back(Warning{path.GetText(), std::string(text), 0});
    }
    ++warnings_[place->second].count;
}

std::vector<std::string> Context::GetWarnings() const {
    std::vector<std::string> lines;
    for (const Warning& warning : warnings_) {
        std::string& line = lines.emplace_back(warning.path);
        line.append(": ").append(warning.text);
        if (warning.count > 1) {
            line.append(" (and ").append(std::to_string(warning.count - 1)).append(" more places)");
        }
    }
    return lines;
}

void Fail(const Path& path, std::string_view text) {
    throw Error(path.GetText() + ": " + std::string(text));
}

Range Normalize(Range range, std::uint32_t width) noexcept {
    constexpr std::int64_t Greatest = std::numeric_limits<std::int32_t>::max();
    if (range.offset < 0 || range.offset > Greatest - width + 1) {
        range.offset = 0;
    }
    return range;
}

std::int64_t GetIndex(Range range, std::uint32_t width, std::uint32_t position) noexcept {
    return range.offset + (range.upto ? width - 1 - position : position);
}

std::string MakeBitName(std::string_view base, std::int64_t index) {
    return std::string(base).append("(").append(std::to_string(index)).append(")");
}

std::string MakeBusName(std::string_view base, std::int64_t left, std::int64_t right) {
    std::string name(base);
    name.append("(").append(std::to_string(left)).append(":");
    return name.append(std::to_string(right)).append(")");
}

std::string MakeConstant(const std::string& digits, bool scalar) {
    return scalar ? digits : std::to_string(digits.size()) + ":B:" + digits;
}

} // namespace Tool::Import
