#include "import/JsonErrors.h"

#include "diagnostics/Utf8.h"

#include <algorithm>
#include <cstdint>

namespace Tool::Import {

std::string DescribeJsonError(simdjson::error_code error) {
    switch (error) {
    case simdjson::EMPTY:
        return "the file is empty";
    case simdjson::SCALAR_DOCUMENT_AS_VALUE:
        return "the file does not begin with \"{\"";
    case simdjson::INCOMPLETE_ARRAY_OR_OBJECT:
        return "the file ends too early";
    case simdjson::UNCLOSED_STRING:
        return "a text is not closed by a double quote";
    case simdjson::UNESCAPED_CHARS:
        return "a line end or another control character in a text";
    case simdjson::STRING_ERROR:
        return "a backslash in a text is followed by a wrong character";
    case simdjson::T_ATOM_ERROR:
    case simdjson::F_ATOM_ERROR:
    case simdjson::N_ATOM_ERROR:
        return "a word that is not true, false or null";
    case simdjson::NUMBER_ERROR:
        return "a malformed number";
    case simdjson::NUMBER_OUT_OF_RANGE:
        return "a number is too large";
    case simdjson::UTF8_ERROR:
        return "a byte that is not UTF-8";
    case simdjson::INCORRECT_TYPE:
        return "a value of another kind is expected";
    case simdjson::CAPACITY:
        return "the file is too large";
    default:
        return "a comma, colon, quote or bracket is missing or superfluous";
    }
}

TextPlace FindPlace(std::string_view text, std::size_t byte) {
    const std::string_view before = text.substr(0, byte);
    const std::size_t start = before.rfind('\n') + 1; // 0 in the first line
    const std::size_t end = std::min(text.find('\n', start), text.size());
    TextPlace place;
    place.line = static_cast<std::uint64_t>(std::count(before.begin(), before.end(), '\n')) + 1;
    place.source = text.substr(start, end - start);
    place.column = byte - start;
    if (!place.source.empty() && place.source.back() == '\r') {
        place.source.pop_back();
    }
    return place;
}

std::size_t FindBadUtf8(std::string_view text) {
    std::size_t at = 0;
    while (at < text.size()) {
        const std::size_t size = GetCharacterSize(text.substr(at));
        if (size == 1 && static_cast<unsigned char>(text[at]) >= 0x80) {
            return at;
        }
        at += size;
    }
    return at;
}

} // namespace Tool::Import
