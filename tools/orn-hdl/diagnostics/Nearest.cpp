#include "diagnostics/Nearest.h"

#include "Port/Ascii.h"

#include <algorithm>
#include <numeric>
#include <utility>

namespace Tool {

namespace {

bool AreEqual(char a, char b) {
    return Port::ToUpper(a) == Port::ToUpper(b);
}

} // namespace

// A third of the characters may be wrong: with more, the suggestion would be a guess.
NearestWord::NearestWord(std::string_view word) : word_(word), limit_((word.size() + 1) / 3) {}

void NearestWord::Consider(std::string_view candidate) {
    if (IsNear(candidate)) {
        nearest_ = candidate;
    }
}

/// Whether a candidate is nearer than the nearest one so far. If so, its distance is the new limit.
bool NearestWord::IsNear(std::string_view candidate) {
    const std::size_t longer = std::max(word_.size(), candidate.size());
    if (longer - std::min(word_.size(), candidate.size()) > limit_) {
        return false;
    }
    beforeLast_.resize(candidate.size() + 1);
    last_.resize(candidate.size() + 1);
    row_.resize(candidate.size() + 1);
    std::iota(row_.begin(), row_.end(), std::size_t(0));
    for (std::size_t i = 1; i <= word_.size(); ++i) {
        std::swap(beforeLast_, last_);
        std::swap(last_, row_);
        row_[0] = i;
        std::size_t least = i;
        for (std::size_t j = 1; j <= candidate.size(); ++j) {
            const std::size_t replaced =
                last_[j - 1] + (AreEqual(word_[i - 1], candidate[j - 1]) ? 0 : 1);
            row_[j] = std::min({last_[j] + 1, row_[j - 1] + 1, replaced});
            if (i > 1 && j > 1 && AreEqual(word_[i - 1], candidate[j - 2]) &&
                AreEqual(word_[i - 2], candidate[j - 1])) {
                row_[j] = std::min(row_[j], beforeLast_[j - 2] + 1);
            }
            least = std::min(least, row_[j]);
        }
        // No number of a later row is smaller.
        if (least > limit_) {
            return false;
        }
    }
    const std::size_t distance = row_[candidate.size()];
    const bool isNear =
        distance < limit_ || (distance == limit_ && distance > 0 && nearest_.empty());
    limit_ = isNear ? distance : limit_;
    return isNear;
}

std::string GetNearest(std::string_view word, const std::vector<std::string>& candidates) {
    NearestWord nearest(word);
    for (const std::string& candidate : candidates) {
        nearest.Consider(candidate);
    }
    return nearest.Get();
}

} // namespace Tool
