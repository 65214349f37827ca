#include "Port/Range.h"

#include "Port/Ascii.h"

#include <algorithm>

namespace {

std::size_t Code(char c) noexcept {
    return static_cast<unsigned char>(c);
}

/// Reads a character class behind its "[". \return the index behind its "]".
std::size_t ReadClass(std::string_view pattern, std::size_t i, std::bitset<256>& accepted) {
    while (i < pattern.size() && pattern[i] != ']') {
        if (i + 2 < pattern.size() && pattern[i + 1] == '-' && pattern[i + 2] != ']') {
            for (std::size_t c = Code(pattern[i]); c <= Code(pattern[i + 2]); ++c) {
                accepted.set(c);
            }
            i += 3;
        } else {
            accepted.set(Code(pattern[i++]));
        }
    }
    return std::min(i + 1, pattern.size());
}

} // namespace

Port_Regexp::Port_Regexp(Port::TextView patternText) {
    const std::string_view pattern = patternText;
    for (std::size_t i = 0; i < pattern.size();) {
        Step step;
        if (pattern[i] == '[') {
            i = ReadClass(pattern, i + 1, step.accepted);
        } else if (pattern[i] == '.') {
            step.accepted.set();
            ++i;
        } else {
            step.accepted.set(Code(pattern[i++]));
        }
        if (i < pattern.size() && (pattern[i] == '*' || pattern[i] == '+' || pattern[i] == '?')) {
            step.optional = pattern[i] != '+';
            step.repeated = pattern[i] != '?';
            ++i;
        }
        steps_.push_back(step);
    }
}

// Follows all positions in the pattern that the text read so far can have reached.
bool Port_Regexp::MatchAt(std::string_view text, std::size_t start, std::size_t& length) const {
    std::vector<bool> reached(steps_.size() + 1);
    std::vector<bool> next(steps_.size() + 1);
    const auto skipOptional = [this](std::vector<bool>& places) {
        for (std::size_t i = 0; i < steps_.size(); ++i) {
            if (places[i] && steps_[i].optional) {
                places[i + 1] = true;
            }
        }
    };
    reached[0] = true;
    skipOptional(reached);
    bool matched = reached.back();
    length = 0;
    for (std::size_t t = start; t < text.size(); ++t) {
        std::fill(next.begin(), next.end(), false);
        bool alive = false;
        for (std::size_t i = 0; i < steps_.size(); ++i) {
            if (reached[i] && steps_[i].accepted.test(Code(text[t]))) {
                next[i + 1] = true;
                next[i] = next[i] || steps_[i].repeated;
                alive = true;
            }
        }
        if (!alive) {
            break;
        }
        skipOptional(next);
        reached.swap(next);
        if (reached.back()) {
            matched = true;
            length = t + 1 - start;
        }
    }
    return matched;
}

bool Port_Regexp::Search(Port::TextView searched, Port_Range& range) const {
    const std::string_view text = searched;
    for (std::size_t start = 0; start <= text.size(); ++start) {
        std::size_t length = 0;
        if (MatchAt(text, start, length)) {
            range = Port_Range(start, length);
            return true;
        }
    }
    return false;
}
