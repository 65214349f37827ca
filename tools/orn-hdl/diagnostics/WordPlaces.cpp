#include "diagnostics/WordPlaces.h"

#include <algorithm>
#include <utility>

namespace Tool {

using std::string_view;

namespace {

/// Reads a quoted word. `at` is the place of the opening quote.
WordPlace FindQuoted(string_view line, std::size_t at) {
    const char quote = line[at];
    WordPlace word;
    word.columns.first = at;
    word.textFirst = at + 1;
    for (std::size_t i = at + 1; i < line.size(); ++i) {
        const bool isLast = i + 1 == line.size();
        if (line[i] == quote) {
            if (isLast || line[i + 1] == ' ') {
                word.columns.count = i + 1 - at;
                return word;
            }
            word.isPlain = false;
            continue;
        }
        if (line[i] == '\\' && !isLast && line[i + 1] == quote) {
            word.isPlain = false;
            ++i;
        }
        word.text += line[i];
    }
    word.columns.count = line.size() - at;
    return word;
}

WordPlace FindUnquoted(string_view line, std::size_t at) {
    const std::size_t end = std::min(line.find(' ', at), line.size());
    return WordPlace{std::string(line.substr(at, end - at)), Columns{at, end - at}, true, at};
}

std::string Quote(string_view word) {
    const bool needsQuotes = word.empty() || word.find(' ') != string_view::npos ||
                             word.front() == '"' || word.front() == '\'';
    if (!needsQuotes) {
        return std::string(word);
    }
    const char quote = word.find('"') == string_view::npos ? '"' : '\'';
    std::string quoted(1, quote);
    for (const char c : word) {
        quoted.append(c == quote ? "\\" : "") += c;
    }
    return quoted += quote;
}

} // namespace

std::vector<WordPlace> FindWords(string_view line) {
    std::vector<WordPlace> words;
    std::size_t at = 0;
    while ((at = line.find_first_not_of(' ', at)) != string_view::npos) {
        const bool isQuoted = line[at] == '"' || line[at] == '\'';
        WordPlace word = isQuoted ? FindQuoted(line, at) : FindUnquoted(line, at);
        at += word.columns.count;
        // An empty word at the end of a line is dropped.
        if (at < line.size() || !word.text.empty()) {
            words.push_back(std::move(word));
        }
    }
    return words;
}

Columns GetColumns(const Mark& mark, const std::vector<WordPlace>& words) {
    if (words.empty()) {
        return {};
    }
    const auto getWord = [&](int index) -> const WordPlace& {
        return words[static_cast<std::size_t>(index)];
    };
    const int count = static_cast<int>(words.size());
    if (mark.first >= count) {
        const Columns& last = words.back().columns;
        return Columns{last.first + last.count, 1};
    }
    const WordPlace& first = getWord(std::max(mark.first, 0));
    const bool isPart = mark.offset != 0 || mark.length != Mark::ToEnd;
    if (isPart && first.isPlain) {
        const std::size_t offset = std::min(mark.offset, first.text.size());
        return Columns{first.textFirst + offset, std::min(mark.length, first.text.size() - offset)};
    }
    const Columns& last = getWord(std::clamp(mark.last, 0, count - 1)).columns;
    return Columns{first.columns.first, last.first + last.count - first.columns.first};
}

std::string JoinWords(const Orn_Hdl::StringArray& words) {
    std::string line;
    for (const string_view word : words) {
        line.append(line.empty() ? "" : " ").append(Quote(word));
    }
    return line;
}

} // namespace Tool
