#include "import/JsonPath.h"

#include "Port/Ascii.h"

#include <algorithm>

namespace Tool::Import {

namespace {

bool IsPlainKey(std::string_view key) noexcept {
    const auto isPlain = [](char c) { return Port::IsLetter(c) || Port::IsDigit(c) || c == '_'; };
    return !key.empty() && std::all_of(key.begin(), key.end(), isPlain);
}

} // namespace

JsonPath& JsonPath::AddKey(std::string_view key) {
    if (IsPlainKey(key)) {
        text_.append(text_.empty() ? "" : ".").append(key);
        return *this;
    }
    text_.append("[").append(Quote(key)).append("]");
    return *this;
}

JsonPath& JsonPath::AddIndex(std::size_t index) {
    text_.append("[").append(std::to_string(index)).append("]");
    return *this;
}

JsonPath Place::ToPath() const {
    JsonPath path("modules");
    for (const std::string_view key : {module, table, object, part, name}) {
        if (!key.empty()) {
            path.AddKey(key);
        }
    }
    return path;
}

std::string Quote(std::string_view name) {
    std::string quoted("\"");
    for (const char c : name) {
        if (c == '"' || c == '\\') {
            quoted += '\\';
        }
        quoted += static_cast<unsigned char>(c) < ' ' ? '?' : c;
    }
    return quoted += '"';
}

void Fail(const JsonPath& path, std::string_view text) {
    throw Error(path.GetText() + ": " + std::string(text));
}

} // namespace Tool::Import
