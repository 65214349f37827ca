#include "Check/Uses.h"

#include <algorithm>

namespace Orn_Hdl::Checking {

/// The use of a scalar signal, null when no page has it.
const Use* Uses::Find(const Signal& scalar) const {
    static_assert(sizeof(ScalarSignal) > Piece && alignof(ScalarSignal) <= Piece);
    const std::uintptr_t piece = reinterpret_cast<std::uintptr_t>(&scalar) / Piece;
    const auto found = pages_.find(piece / PageSize);
    return found == pages_.end() ? nullptr : &(*found->second)[piece % PageSize];
}

Use& Uses::OfScalar(const Signal* signal) {
    const std::uintptr_t piece = reinterpret_cast<std::uintptr_t>(signal) / Piece;
    std::unique_ptr<Page>& page = pages_[piece / PageSize];
    if (page == nullptr) {
        page = std::make_unique<Page>();
    }
    return (*page)[piece % PageSize];
}

std::vector<Use>* Uses::OfBus(const Signal& bus) {
    const auto found = buses_.find(&bus);
    if (found != buses_.end()) {
        return &found->second;
    }
    Names::BusName range;
    if (!Names::ParseBus(bus.GetNameView(), range) || range.GetBits() > Names::MostExpandedBits) {
        return nullptr;
    }
    return &buses_.emplace(&bus, std::vector<Use>(static_cast<std::size_t>(range.GetBits())))
                .first->second;
}

template <class Test> bool Uses::Any(const Signal& declared, const Test& test) const {
    if (declared.GetSignalType() == SignalTypeScalar) {
        const Use* const use = Find(declared);
        return use != nullptr && test(*use);
    }
    const auto found = buses_.find(&declared);
    return found != buses_.end() && std::any_of(found->second.begin(), found->second.end(), test);
}

bool Uses::IsDrivenTwice(const Signal& declared) const {
    return Any(declared, [](const Use& use) { return use.IsDrivenTwice(); });
}

bool Uses::IsUndriven(const Signal& declared) const {
    return Any(declared, [](const Use& use) { return use.IsUndriven(); });
}

bool Uses::IsAnyUndriven(const Signal& declared) const {
    const bool isKnown = declared.GetSignalType() == SignalTypeScalar
                             ? Any(declared, [](const Use& use) { return use.IsKnown(); })
                             : buses_.count(&declared) != 0;
    return !isKnown || Any(declared, [](const Use& use) { return !use.IsDriven(); });
}

} // namespace Orn_Hdl::Checking
