#include "diff/PlaceFinder.h"

#include "diff/Names.h"

#include "diagnostics/NameKey.h"

#include <utility>

namespace Tool::Diff {

namespace {

using Kind = Orn_Hdl::Check::Cause::Kind;

std::string MakeKey(PlaceFinder::What what, std::string_view first, std::string_view second) {
    std::string key(1, static_cast<char>('A' + static_cast<int>(what)));
    return key.append(GetNameKey(first)).append("\n").append(GetNameKey(second));
}

/// The first name of a list, without its range.
std::string_view FirstBase(std::string_view name) {
    name = name.substr(0, name.find_first_of(",\\", 1));
    return name.substr(0, name.find('('));
}

} // namespace

PlaceFinder::PlaceFinder(const std::vector<Side*>& sides, std::string design)
    : design_(std::move(design)) {
    for (Side* side : sides) {
        Want(*side);
    }
}

void PlaceFinder::Want(Side& side) {
    const std::string& first = side.cause.first;
    const std::string_view base = FirstBase(first);
    switch (side.cause.kind) {
    case Kind::DesignName:
    case Kind::ModuleAttribute:
        return Want(What::Module, "", "", side, 0);
    case Kind::Component:
    case Kind::ComponentAttribute:
        return Want(What::Component, first, "", side, 0);
    case Kind::Pin:
        return Want(What::Pin, first, FirstBase(side.cause.second), side, 0);
    case Kind::Instance:
    case Kind::InstanceAttribute:
        return Want(What::Instance, first, "", side, 0);
    case Kind::Signal:
    case Kind::SignalAttribute:
        return Want(What::Signal, base, "", side, 0);
    case Kind::Connection:
        Want(What::Connection, first, FirstBase(side.cause.second), side, 0);
        return Want(What::Instance, first, "", side, 1);
    case Kind::Alias:
    case Kind::Constant:
        Want(What::Assignment, base, "", side, 0);
        return Want(What::Signal, base, "", side, 1);
    default:
        return;
    }
}

void PlaceFinder::Want(What what, std::string_view first, std::string_view second, Side& side,
                       int rank) {
    places_[MakeKey(what, first, second)].push_back({&side, rank});
    names_.emplace(HashName(first), true);
}

bool PlaceFinder::Wants(std::string_view name) const {
    return names_.find(HashName(name)) != names_.end();
}

void PlaceFinder::Found(What what, std::string_view first, std::string_view second,
                        std::uint64_t line) {
    const auto found = places_.find(MakeKey(what, first, second));
    if (found == places_.end()) {
        return;
    }
    for (const Place& place : found->second) {
        const auto [rank, isFirst] = ranks_.emplace(place.side, place.rank);
        if (isFirst || place.rank < rank->second) {
            rank->second = place.rank;
            place.side->line = line;
        }
    }
}

} // namespace Tool::Diff
