#include "Check/Uses.h"

#include "Port/Prefetch.h"

#include <algorithm>

namespace Orn_Hdl::Checking {

namespace {

constexpr std::size_t FirstSize = 64;

std::size_t Hash(const Signal* signal) noexcept {
    // Objects lie at multiples of eight; the high half of the product is spread well.
    const std::uint64_t mixed =
        (reinterpret_cast<std::uintptr_t>(signal) >> 3U) * std::uint64_t(0x9E3779B97F4A7C15U);
    return static_cast<std::size_t>(mixed >> 32U);
}

} // namespace

/// The place of a signal, or the free place where it would stand. The table is never full.
std::size_t Uses::Find(const Signal* signal) const noexcept {
    const std::size_t mask = keys_.size() - 1;
    std::size_t place = Hash(signal) & mask;
    while (keys_[place] != nullptr && keys_[place] != signal) {
        place = (place + 1) & mask;
    }
    return place;
}

void Uses::Grow() {
    Uses larger;
    larger.keys_.resize(std::max(FirstSize, keys_.size() * 2));
    larger.values_.resize(larger.keys_.size());
    for (std::size_t i = 0; i < keys_.size(); ++i) {
        if (keys_[i] != nullptr) {
            const std::size_t place = larger.Find(keys_[i]);
            larger.keys_[place] = keys_[i];
            larger.values_[place] = values_[i];
        }
    }
    keys_.swap(larger.keys_);
    values_.swap(larger.values_);
}

Use& Uses::OfScalar(const Signal* signal) {
    if (4 * (count_ + 1) > 3 * keys_.size()) {
        Grow();
    }
    const std::size_t place = Find(signal);
    if (keys_[place] == nullptr) {
        keys_[place] = signal;
        ++count_;
    }
    return values_[place];
}

void Uses::Prefetch(const Signal* signal) const noexcept {
    if (!keys_.empty() && signal != nullptr) {
        Port::Prefetch(&keys_[Hash(signal) & (keys_.size() - 1)]);
    }
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
        if (keys_.empty()) {
            return false;
        }
        const std::size_t place = Find(&declared);
        return keys_[place] != nullptr && test(values_[place]);
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
                             ? Any(declared, [](const Use&) { return true; })
                             : buses_.count(&declared) != 0;
    return !isKnown || Any(declared, [](const Use& use) { return !use.IsDriven(); });
}

} // namespace Orn_Hdl::Checking
