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
