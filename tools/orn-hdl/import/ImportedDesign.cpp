#include "import/ImportedDesign.h"

namespace Tool::Import {

JsonPath Module::GetPath(std::string_view table, std::string_view object) const {
    return JsonPath("modules").AddKey(name).AddKey(table).AddKey(object);
}

JsonPath Module::GetPinPath(const Cell& cell, std::string_view pin) const {
    return GetPath("cells", cell.name).AddKey("connections").AddKey(pin);
}

std::uint32_t CellType::GetOrAddPin(std::string_view pin) {
    const auto [place, isNew] = pinIndex.try_emplace(pin, static_cast<std::uint32_t>(pins.size()));
    if (isNew) {
        pins.push_back(TypePin{pin, Direction::Unspecified});
    }
    return place->second;
}

std::string_view ImportedDesign::Keep(std::string_view text) {
    if (text.empty()) {
        return "";
    }
    char* copy = static_cast<char*>(texts_.allocate(text.size(), 1));
    text.copy(copy, text.size());
    return std::string_view(copy, text.size());
}

} // namespace Tool::Import
