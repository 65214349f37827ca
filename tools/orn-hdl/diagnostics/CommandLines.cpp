#include "diagnostics/CommandLines.h"

#include <algorithm>
#include <string_view>
#include <vector>

namespace Tool {

namespace {

/// Whether a line was split into these words. It may have been changed since.
bool AreWords(const std::vector<WordPlace>& places, const Orn_Hdl::StringArray& words) {
    return std::equal(places.begin(), places.end(), words.begin(), words.end(),
                      [](const WordPlace& a, std::string_view b) { return a.text == b; });
}

void SetColumns(Place& place, const std::optional<Mark>& mark,
                const std::vector<WordPlace>& words) {
    if (mark) {
        place.columns = GetColumns(*mark, words);
    }
}

} // namespace

Place CommandLines::GetPlace(std::uint64_t line, const Orn_Hdl::StringArray& words,
                             const std::optional<Mark>& mark) {
    Place place = GetPlace(line);
    std::vector<WordPlace> places = FindWords(place.source);
    if (!AreWords(places, words)) {
        place.source = JoinWords(words);
        place.isExact = false;
        places = FindWords(place.source);
    }
    SetColumns(place, mark, places);
    return place;
}

Place CommandLines::GetPlace(std::uint64_t line, const std::optional<Mark>& mark) {
    Place place;
    place.file = file_;
    place.line = line;
    std::string_view text;
    if (lines_.Get(line, text)) {
        // A command ends at its first NUL.
        place.source = text.substr(0, text.find('\0'));
    }
    SetColumns(place, mark, FindWords(place.source));
    return place;
}

} // namespace Tool
