#include "ImportDesign.h"

#include "Port/Ascii.h"

#include <algorithm>

namespace Tool::Import {

namespace {

bool IsPlainKey(std::string_view key) noexcept {
    const auto isPlain = [](char c) { return Port::IsLetter(c) || Port::IsDigit(c) || c == '_'; };
    return !key.empty() && std::all_of(key.begin(), key.end(), isPlain);
}

} // namespace

Path& Path::AddKey(std::string_view key) {
    if (IsPlainKey(key)) {
        text_.append(text_.empty() ? "" : ".").append(key);
        return *this;
    }
    text_ += "[\"";
    for (const char c : key) {
        if (c == '"' || c == '\\') {
            text_ += '\\';
        }
        // The path is part of a message of one line.
        text_ += static_cast<unsigned char>(c) < ' ' ? '?' : c;
    }
    text_ += "\"]";
    return *this;
}

Path& Path::AddIndex(std::size_t index) {
    text_.append("[").append(std::to_string(index)).append("]");
    return *this;
}

std::uint32_t CellType::GetOrAddPin(std::string_view pin) {
    const auto [place, isNew] = pinIndex.try_emplace(pin, static_cast<std::uint32_t>(pins.size()));
    if (isNew) {
        pins.push_back(TypePin{pin, Direction::Untold});
    }
    return place->second;
}

std::string_view Design::Keep(std::string_view text) {
    if (text.empty()) {
        return std::string_view();
    }
    char* copy = static_cast<char*>(texts_.allocate(text.size(), 1));
    std::memcpy(copy, text.data(), text.size());
    return std::string_view(copy, text.size());
}

} // namespace Tool::Import
