#include "diff/Places.h"

#include "check/Located.h"
#include "load/Load.h"

#include <cstdint>
#include <limits>

namespace Tool::Diff {

namespace {

void FindCommandLines(const std::vector<Side*>& sides, const LoadedDesign& design) {
    std::vector<Checking::Located> wanted(sides.size());
    for (std::size_t i = 0; i < sides.size(); ++i) {
        wanted[i].finding.cause = sides[i]->cause;
        wanted[i].checkedAt = std::numeric_limits<std::uint64_t>::max();
    }
    if (Checking::Locate(design.GetSystemName(), wanted)) {
        for (std::size_t i = 0; i < sides.size(); ++i) {
            sides[i]->line = wanted[i].line;
        }
    }
}

void FindLines(std::vector<Side*> sides, const LoadedDesign& design) {
    if (!sides.empty() && design.GetFormat() == DesignFormat::Commands) {
        FindCommandLines(sides, design);
    }
}

} // namespace

void FindLines(std::vector<Difference>& differences, const LoadedDesign& a, const LoadedDesign& b) {
    std::vector<Side*> inA;
    std::vector<Side*> inB;
    for (Difference& difference : differences) {
        if (!difference.a.name.empty()) {
            inA.push_back(&difference.a);
        }
        if (!difference.b.name.empty()) {
            inB.push_back(&difference.b);
        }
    }
    FindLines(std::move(inA), a);
    FindLines(std::move(inB), b);
}

} // namespace Tool::Diff
