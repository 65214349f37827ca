// Instances that a script adds right behind their components.
#pragma once

#include "HdlCmd/Script/SettledSignals.h"
#include "Orn_Hdl/Model/Netlist.h"

#include <unordered_map>
#include <vector>

namespace Orn_Hdl::Script {

/// A component can get pins when it has instances already, which do not get them. A script adds
/// such an instance before the first pin that it has not. An instance can also have the name of a
/// slice, a bit or a compound, but only if it was there first.
class InstanceStages {
public:
    /// \param netlist, settled have to outlive this object.
    InstanceStages(const Netlist& netlist, const SettledSignals& settled);

    struct Early {
        const Instance* instance;
        int pinCount;
    };

    /// The instances that are added with a component, those with fewest pins first.
    const std::vector<Early>& GetEarly(const Component& component) const;
    /// Whether an instance is added with its component.
    bool IsEarly(const Instance& instance) const;
    bool HasEarly() const noexcept { return !early_.empty(); }

private:
    static constexpr int NotEarly = -1;

    bool HasNameOfSignal(const Instance& instance) const;
    /// The number of pins of an instance that is added with its component.
    int GetPinCountIfEarly(const Instance& instance) const;

    const Netlist& netlist_;
    const SettledSignals& settled_;
    std::unordered_map<const Component*, int> pinCounts_;
    std::unordered_map<const Component*, std::vector<Early>> early_;
};

int CountPins(const Iterator<Pin*>& pins);

} // namespace Orn_Hdl::Script
