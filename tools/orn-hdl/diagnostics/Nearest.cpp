#include "diagnostics/Nearest.h"

#include "Port/Ascii.h"

#include <algorithm>
#include <cstddef>
#include <utility>

namespace Tool {

namespace {

bool AreEqual(char a, char b) {
    return Port::EqualIgnoringCase(std::string_view(&a, 1), std::string_view(&b, 1));
}

/// The least number of insertions, removals, replacements and swaps of neighbours that turn one
/// word into the other.
std::size_t GetDistance(std::string_view from, std::string_view to) {
    std::vector<std::size_t> beforeLast(to.size() + 1);
    std::vector<std::size_t> last(to.size() + 1);
    std::vector<std::size_t> row(to.size() + 1);
    for (std::size_t j = 0; j <= to.size(); ++j) {
        row[j] = j;
    }
    for (std::size_t i = 1; i <= from.size(); ++i) {
        std::swap(beforeLast, last);
        std::swap(last, row);
        row[0] = i;
        for (std::size_t j = 1; j <= to.size(); ++j) {
            const std::size_t replaced = last[j - 1] + (AreEqual(from[i - 1], to[j - 1]) ? 0 : 1);
            row[j] = std::min({last[j] + 1, row[j - 1] + 1, replaced});
            if (i > 1 && j > 1 && AreEqual(from[i - 1], to[j - 2]) &&
                AreEqual(from[i - 2], to[j - 1])) {
                row[j] = std::min(row[j], beforeLast[j - 2] + 1);
            }
        }
    }
    return row[to.size()];
}

} // namespace

std::string GetNearest(std::string_view word, const std::vector<std::string>& candidates) {
    std::string nearest;
    // A third of the characters may be wrong: with more, the suggestion would be a guess.
    std::size_t limit = (word.size() + 1) / 3;
    for (const std::string& candidate : candidates) {
        const std::size_t distance = GetDistance(word, candidate);
        if (distance < limit || (distance == limit && distance > 0 && nearest.empty())) {
            nearest = candidate;
            limit = distance;
        }
    }
    return nearest;
}

} // namespace Tool
