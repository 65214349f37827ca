#include "diagnostics/JsonWriter.h"

#include "diagnostics/Utf8.h"

#include <utility>

namespace Tool {

using std::string_view;

namespace {

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
        const std::size_t taken = GetCharacterSize(text);
        if (taken > 1) {
            text_.append(text.substr(0, taken));
        } else if (byte < 0x20 || byte >= 0x7F) {
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

} // namespace Tool
