#include "Readers/Comments.h"

#include <algorithm>
#include <cstddef>

namespace Orn_Hdl::Readers {

namespace {

bool IsBlank(char c) noexcept {
    return c == ' ' || (c >= '\t' && c <= '\r');
}

/// Whether a line of a comment is a divider of a banner: nothing but the character.
bool IsDivider(const std::string& line, char character) {
    constexpr std::size_t Shortest = 40;
    return line.size() >= Shortest && line.find_first_not_of(character) == std::string::npos;
}

} // namespace

std::string_view Trim(std::string_view text) {
    while (!text.empty() && IsBlank(text.front())) {
        text.remove_prefix(1);
    }
    while (!text.empty() && IsBlank(text.back())) {
        text.remove_suffix(1);
    }
    return text;
}

std::string_view TakeWord(std::string_view& text) {
    text = Trim(text);
    std::size_t length = 0;
    while (length < text.size() && !IsBlank(text[length])) {
        ++length;
    }
    const std::string_view word = text.substr(0, length);
    text.remove_prefix(length);
    return word;
}

std::vector<std::string_view> FirstWords(std::string_view text) {
    constexpr std::size_t Most = 7;
    std::vector<std::string_view> words;
    while (words.size() < Most) {
        const std::string_view word = TakeWord(text);
        if (word.empty()) {
            break;
        }
        words.push_back(word);
    }
    return words;
}

bool TakeSwitch(std::string_view text, bool& isHidden, bool obeysAll) {
    const std::vector<std::string_view> words = FirstWords(text);
    if (words.size() != 2 || (words[1] != "translate_off" && words[1] != "translate_on")) {
        return false;
    }
    if (obeysAll || words.front() == "synopsys" || words.front() == "synthesis") {
        isHidden = words[1] == "translate_off";
    }
    return true;
}

void AddLines(const Comment& comment, std::vector<std::string>& lines) {
    std::string_view text = comment.text;
    for (;;) {
        const std::size_t end = std::min(text.find('\n'), text.size());
        std::string_view line = text.substr(0, end);
        if (comment.isBlock) {
            line = Trim(line);
        } else {
            line.remove_prefix(!line.empty() && line.front() == ' ' ? 1 : 0);
            line.remove_suffix(!line.empty() && line.back() == '\r' ? 1 : 0);
        }
        if (!line.empty()) {
            lines.emplace_back(line);
        }
        if (end == text.size()) {
            return;
        }
        text.remove_prefix(end + 1);
    }
}

void DropBanner(std::vector<std::string>& lines, char divider) {
    if (lines.empty() || !IsDivider(lines.front(), divider)) {
        return;
    }
    auto end = std::find(lines.begin(), lines.end(), "Reference");
    if (end == lines.end()) {
        return;
    }
    ++end;
    while (end != lines.end() && end->substr(0, 3) == "   ") {
        ++end;
    }
    lines.erase(lines.begin(), end);
}

} // namespace Orn_Hdl::Readers
