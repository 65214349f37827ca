#include "import/Warnings.h"

namespace Tool::Import {

void Warnings::Add(const JsonPath& path, std::string_view text) {
    const auto [place, isNew] = index_.try_emplace(std::string(text), warnings_.size());
    if (isNew) {
        warnings_.push_back(Warning{path.GetText(), std::string(text), 0});
    }
    ++warnings_[place->second].count;
}

std::vector<std::string> Warnings::GetLines() const {
    std::vector<std::string> lines;
    for (const Warning& warning : warnings_) {
        std::string& line = lines.emplace_back(warning.path);
        line.append(": ").append(warning.text);
        if (warning.count > 1) {
            line.append(" (and ").append(std::to_string(warning.count - 1));
            line.append(warning.count == 2 ? " more place)" : " more places)");
        }
    }
    return lines;
}

} // namespace Tool::Import
