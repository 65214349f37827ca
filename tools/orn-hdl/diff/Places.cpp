#include "diff/Places.h"

#include "check/Located.h"
#include "diagnostics/NameKey.h"
#include "diff/Names.h"
#include "diff/PlaceFinder.h"
#include "load/Load.h"

#include <cstdint>
#include <limits>
#include <string>
#include <unordered_map>

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

/// Gives the names of causes back what reading has changed of them.
void RestoreNames(const std::vector<Side*>& sides, const LoadedDesign& design) {
    std::unordered_map<std::string, std::string> names;
    for (const auto& renaming : design.GetRenamings()) {
        names.emplace(GetNameKey(renaming.newName), renaming.name);
    }
    const auto restore = [&](std::string& name) {
        const auto found = names.find(GetNameKey(GetBase(name)));
        if (found != names.end()) {
            name = found->second;
        }
    };
    for (Side* side : sides) {
        restore(side->cause.first);
        restore(side->cause.second);
    }
}

void FindLines(const std::vector<Side*>& sides, const LoadedDesign& design) {
    if (sides.empty()) {
        return;
    }
    if (design.GetFormat() == DesignFormat::Commands) {
        FindCommandLines(sides, design);
        return;
    }
    if (!design.GetRenamings().empty()) {
        RestoreNames(sides, design);
    }
    PlaceFinder finder(sides, std::string(WithoutEscape(design.GetNetlist().GetNameView())));
    switch (design.GetFormat()) {
    case DesignFormat::Verilog:
        return FindVerilogPlaces(design.GetSystemName(), finder);
    case DesignFormat::Vhdl:
        return FindVhdlPlaces(design.GetSystemName(), finder);
    default:
        return FindJsonPlaces(design.GetSystemName(), finder);
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
    FindLines(inA, a);
    FindLines(inB, b);
}

} // namespace Tool::Diff
