// Suggestions for misspelt words.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace Tool {

/// Finds the candidate that a misspelt word most likely stands for. A word resembles a candidate if
/// few characters must be inserted, removed, replaced or swapped with their neighbour; letter case
/// is ignored. Of several candidates that are equally near, the first one counts.
class NearestWord {
public:
    explicit NearestWord(std::string_view word);

    void Consider(std::string_view candidate);
    /// The nearest candidate; empty if none resembles the word.
    const std::string& Get() const noexcept { return nearest_; }
    /// How many changes turn the word into the nearest candidate, if there is one.
    std::size_t GetDistance() const noexcept { return limit_; }

private:
    bool IsNear(std::string_view candidate);

    const std::string word_;
    std::string nearest_;
    /// The greatest distance that is near.
    std::size_t limit_;
    /// Three rows of the table of distances.
    std::vector<std::size_t> beforeLast_;
    std::vector<std::size_t> last_;
    std::vector<std::size_t> row_;
};

/// The candidate that a misspelt word most likely stands for, or the empty text if none resembles
/// it.
std::string GetNearest(std::string_view word, const std::vector<std::string>& candidates);

} // namespace Tool
