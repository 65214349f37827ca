#include "diff/Difference.h"

#include <numeric>
#include <utility>

namespace Tool::Diff {

const char* GetName(Change change) noexcept {
    static constexpr const char* Names[] = {"removed", "added",  "renamed",
                                            "rewired", "retied", "changed"};
    return Names[static_cast<std::size_t>(change)];
}

const char* GetName(Thing thing) noexcept {
    static constexpr const char* Names[] = {"module",    "component", "component pin", "port",
                                            "signal",    "instance",  "pin",           "alias",
                                            "attribute", "comment"};
    return Names[static_cast<std::size_t>(thing)];
}

std::size_t Differences::GetTotal() const noexcept {
    return std::accumulate(counts_.begin(), counts_.end(), std::size_t(0));
}

void Differences::Flip() {
    constexpr auto Removed = static_cast<std::size_t>(Change::Removed);
    constexpr auto Added = static_cast<std::size_t>(Change::Added);
    std::swap(counts_[Removed], counts_[Added]);
    std::swap(kept_[Removed], kept_[Added]);
    for (std::size_t i = 0; i < ChangeCount; ++i) {
        for (Difference& difference : kept_[i]) {
            difference.change = static_cast<Change>(i);
            std::swap(difference.a, difference.b);
        }
    }
}

std::vector<Difference> Differences::Take() {
    std::vector<Difference> all;
    for (std::vector<Difference>& group : kept_) {
        for (Difference& difference : group) {
            if (most_ == 0 || all.size() < most_) {
                all.push_back(std::move(difference));
            }
        }
        group.clear();
    }
    return all;
}

} // namespace Tool::Diff
