#include "diff/Names.h"

#include "diff/IndexTable.h"

#include "Port/Ascii.h"

#include <algorithm>

namespace Tool::Diff {

std::string_view WithoutEscape(std::string_view name) noexcept {
    if (name.empty() || name.front() != '\\') {
        return name;
    }
    name.remove_prefix(1);
    return name.substr(0, name.find_last_not_of(' ') + 1);
}

std::string_view GetBase(std::string_view name) noexcept {
    const bool hasRange = !name.empty() && name.back() == ')';
    return name.substr(0, hasRange ? std::min(name.find('('), name.size()) : name.size());
}

std::uint64_t HashName(std::string_view name) noexcept {
    std::uint64_t hash = 0xcbf29ce484222325U;
    for (const char c : name) {
        hash = (hash ^ static_cast<unsigned char>(Port::ToLower(c))) * 0x100000001b3U;
    }
    return Mix(hash);
}

} // namespace Tool::Diff
