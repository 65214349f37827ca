#include "HdlModel/Signals/CompoundLimits.h"

#include "HdlModel/Signals/References.h"
#include "HdlModel/Signals/SignalCast.h"

#include <unordered_set>
#include <vector>

namespace Orn_Hdl::CompoundLimits {

namespace {

bool HasMember(const CompoundBus& compound, const Signal& signal) noexcept {
    for (const Signal* member : compound.GetBusMemberIterator()) {
        if (member == &signal) {
            return true;
        }
    }
    return false;
}

/// Appends the compounds that have this one as a member.
void AddHolders(const CompoundBus& compound, std::vector<const CompoundBus*>& holders) {
    for (const Signal* referrer : References::GetReferrers(compound)) {
        const CompoundBus* const holder = As<CompoundBus>(referrer);
        if (holder != nullptr && HasMember(*holder, compound)) {
            holders.push_back(holder);
        }
    }
}

/// Whether the compounds that this one contains are few and not nested too deep.
bool IsWithin(const CompoundBus& compound) {
    struct Place {
        const CompoundBus* compound;
        int level;
    };
    int count = 0;
    std::vector<Place> rest{{&compound, 1}};
    while (!rest.empty()) {
        const Place place = rest.back();
        rest.pop_back();
        for (const Signal* member : place.compound->GetBusMemberIterator()) {
            const CompoundBus* const inner = As<CompoundBus>(member);
            if (inner == nullptr) {
                continue;
            }
            if (++count > CompoundBus::MostCompounds || place.level == CompoundBus::MostLevels) {
                return false;
            }
            rest.push_back({inner, place.level + 1});
        }
    }
    return true;
}

} // namespace

bool Contains(const Signal& signal, const CompoundBus& compound) {
    if (&signal == &compound) {
        return true;
    }
    const CompoundBus* const outermost = As<CompoundBus>(&signal);
    if (outermost == nullptr || References::GetReferrers(compound).empty()) {
        return false;
    }
    std::vector<const CompoundBus*> rest{outermost};
    std::unordered_set<const Signal*> met;
    while (!rest.empty()) {
        const CompoundBus& next = *rest.back();
        rest.pop_back();
        for (const Signal* member : next.GetBusMemberIterator()) {
            if (member == &compound) {
                return true;
            }
            const CompoundBus* const inner = As<CompoundBus>(member);
            if (inner != nullptr && met.insert(inner).second) {
                rest.push_back(inner);
            }
        }
    }
    return false;
}

bool AreExceededBy(const CompoundBus& compound) {
    // Only the outermost compounds need be looked at: what they contain has less in it.
    std::vector<const CompoundBus*> rest{&compound};
    std::unordered_set<const CompoundBus*> met;
    while (!rest.empty()) {
        const CompoundBus* const next = rest.back();
        rest.pop_back();
        if (!met.insert(next).second) {
            continue;
        }
        const std::size_t before = rest.size();
        AddHolders(*next, rest);
        if (rest.size() == before && !IsWithin(*next)) {
            return true;
        }
    }
    return false;
}

} // namespace Orn_Hdl::CompoundLimits
