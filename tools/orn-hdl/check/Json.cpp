#include "check/Json.h"

#include <algorithm>
#include <utility>

namespace Tool::Checking {

using std::string_view;

namespace {

/// How many bytes at the front are one character of UTF-8 beyond ASCII; 0 when they are none.
std::size_t CountUtf8(string_view text) {
    const auto byte = [&](std::size_t i) { return static_cast<unsigned char>(text[i]); };
    const unsigned first = byte(0);
    const std::size_t size = first >= 0xF0 ? 4 : first >= 0xE0 ? 3 : 2;
    if (first < 0xC2 || first > 0xF4 || text.size() < size) {
        return 0;
    }
    for (std::size_t i = 1; i < size; ++i) {
        if ((byte(i) & 0xC0U) != 0x80U) {
            return 0;
        }
    }
    // Overlong forms, surrogates, and what lies beyond the last character.
    const unsigned second = byte(1);
    const bool isBad = (first == 0xE0 && second < 0xA0) || (first == 0xED && second > 0x9F) ||
                       (first == 0xF0 && second < 0x90) || (first == 0xF4 && second > 0x8F);
    return isBad ? 0 : size;
}

void AppendEscape(unsigned char byte, std::string& text) {
    constexpr string_view Digits = "0123456789abcdef";
    text.append("\\u00").append({Digits[byte >> 4U], Digits[byte & 15U]});
}

} // namespace

void JsonWriter::Separate() {
    if (needsComma_) {
        text_.push_back(',');
    }
    needsComma_ = true;
}

JsonWriter& JsonWriter::Begin(char bracket) {
    Separate();
    text_.push_back(bracket);
    needsComma_ = false;
    return *this;
}

JsonWriter& JsonWriter::End(char bracket) {
    text_.push_back(bracket);
    needsComma_ = true;
    return *this;
}

JsonWriter& JsonWriter::Key(string_view name) {
    Separate();
    Quote(name);
    text_.push_back(':');
    needsComma_ = false;
    return *this;
}

JsonWriter& JsonWriter::Text(string_view text) {
    Separate();
    Quote(text);
    return *this;
}

JsonWriter& JsonWriter::Number(std::uint64_t number) {
    Separate();
    text_.append(std::to_string(number));
    return *this;
}

void JsonWriter::Quote(string_view text) {
    text_.push_back('"');
    while (!text.empty()) {
        const auto byte = static_cast<unsigned char>(text.front());
        std::size_t taken = 1;
        if (byte >= 0x80 && (taken = CountUtf8(text)) > 0) {
            text_.append(text.substr(0, taken));
        } else if (byte < 0x20 || byte >= 0x7F) {
            taken = 1;
            AppendEscape(byte, text_);
        } else {
            if (byte == '"' || byte == '\\') {
                text_.push_back('\\');
            }
            text_.push_back(text.front());
        }
        text.remove_prefix(taken);
    }
    text_.push_back('"');
}

std::string JsonWriter::Take() {
    text_.push_back('\n');
    needsComma_ = false;
    return std::exchange(text_, {});
}

} // namespace Tool::Checking
