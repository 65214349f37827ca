#include "stats/Count.h"

#include "Orn_Hdl/Model.h"
#include "stats/NetUses.h"

#include <algorithm>
#include <string_view>
#include <unordered_map>
#include <utility>

namespace Tool::Stats {

namespace {

using Orn_Hdl::Polarity;
using Orn_Hdl::Signal;

constexpr std::size_t MostFanOuts = 10;

/// Puts the greatest counts first, and of equal ones the first by name.
bool IsGreater(const NamedCount& a, const NamedCount& b) {
    return a.count != b.count ? a.count > b.count : a.name < b.name;
}

/// The most loaded nets that were seen so far. The name of a net is made when it is one of them.
class GreatestFanOuts {
public:
    void Take(const Signal& signal, std::size_t bit, std::int64_t loads) {
        const bool isFull = kept_.size() == MostFanOuts;
        if (loads < 2 || (isFull && static_cast<std::uint64_t>(loads) <= kept_.back().count)) {
            return;
        }
        if (isFull) {
            kept_.pop_back();
        }
        NamedCount net{GetBitName(signal, bit), static_cast<std::uint64_t>(loads)};
        const auto place =
            std::upper_bound(kept_.begin(), kept_.end(), net,
                             [](const auto& a, const auto& b) { return a.count > b.count; });
        kept_.insert(place, std::move(net));
    }
    std::vector<NamedCount> Get() && { return std::move(kept_); }

private:
    /// Of equal ones, the first in the netlist stands first.
    std::vector<NamedCount> kept_;
};

void Take(NetCount& nets, const Signal& signal, std::size_t bit) {
    ++nets.count;
    if (nets.names.size() < NetCount::MostNames) {
        nets.names.push_back(GetBitName(signal, bit));
    }
}

void CountNets(const Orn_Hdl::Netlist& netlist, DesignCounts& counts) {
    GreatestFanOuts greatest;
    NetUses(netlist).ForEach([&](const Signal& signal, std::size_t bit, const NetUse& use) {
        ++counts.nets;
        ++counts.netsByFanOut[use.loads];
        greatest.Take(signal, bit, use.loads);
        if (use.drivers == 0) {
            Take(use.loads == 0 ? counts.unconnected : counts.undriven, signal, bit);
        } else if (use.loads == 0) {
            Take(counts.unloaded, signal, bit);
        }
        if (use.drivers > 1) {
            Take(counts.multiplyDriven, signal, bit);
        }
    });
    counts.greatestFanOuts = std::move(greatest).Get();
}

void CountSignals(const Orn_Hdl::Netlist& netlist, DesignCounts& counts) {
    for (const int direction : {Polarity::Input, Polarity::Output, Polarity::BiDirectional}) {
        counts.ports.emplace_back(Polarity(direction).GetValueName(), SignalCount());
    }
    for (const Signal* signal : netlist.GetSignalIterator()) {
        for ([[maybe_unused]] const Signal* driver : signal->GetSignalIterator()) {
            ++counts.aliases;
        }
        counts.constants += signal->GetConstantValue().GetValue().IsEmpty() ? 0 : 1;
        if (!IsDeclared(*signal)) {
            continue;
        }
        const int width = signal->GetWidth();
        ++counts.signals.signals;
        counts.signals.bits += static_cast<std::uint64_t>(width);
        ++counts.signalsByWidth[width];
        if (signal->IsPort()) {
            SignalCount& ports =
                counts.ports[static_cast<std::size_t>(signal->GetPortPolarity().GetValue())].second;
            ++ports.signals;
            ports.bits += static_cast<std::uint64_t>(width);
        }
    }
}

void CountInstances(const Orn_Hdl::Netlist& netlist, DesignCounts& counts) {
    std::unordered_map<const Orn_Hdl::Component*, std::uint64_t> uses;
    for (const Orn_Hdl::Instance* instance : netlist.GetInstanceIterator()) {
        ++counts.instances;
        ++uses[instance->GetComponent()];
        for (const Orn_Hdl::Pin* pin : instance->GetPinIterator()) {
            ++counts.pins;
            counts.openPins += pin->GetSignal() == nullptr ? 1 : 0;
        }
    }
    for (const Orn_Hdl::Component* component : netlist.GetComponentIterator()) {
        const auto found = uses.find(component);
        counts.components.push_back(
            {std::string(component->GetNameView()), found == uses.end() ? 0 : found->second});
        if (found != uses.end()) {
            uses.erase(found);
        }
    }
    for (const auto& [component, count] : uses) {
        counts.instancesWithoutComponent += count;
    }
    std::sort(counts.components.begin(), counts.components.end(), IsGreater);
}

void Take(AttributeCount& counts, const Orn_Hdl::AttributeHolder& holder) {
    if (!holder.HasAttrs()) {
        return;
    }
    ++counts.holders;
    for ([[maybe_unused]] const Orn_Hdl::Attribute* attribute : holder.GetAttrIterator()) {
        ++counts.attributes;
    }
}

void CountAttributes(const Orn_Hdl::Netlist& netlist, DesignCounts& counts) {
    AttributeCount module{"module", 0, 0};
    AttributeCount components{"component", 0, 0};
    AttributeCount instances{"instance", 0, 0};
    AttributeCount signals{"signal", 0, 0};
    AttributeCount pins{"pin", 0, 0};
    Take(module, netlist);
    for (const Orn_Hdl::Component* component : netlist.GetComponentIterator()) {
        Take(components, *component);
        for (const Orn_Hdl::Pin* pin : component->GetPinIterator()) {
            Take(pins, *pin);
        }
    }
    for (const Orn_Hdl::Instance* instance : netlist.GetInstanceIterator()) {
        Take(instances, *instance);
        for (const Orn_Hdl::Pin* pin : instance->GetPinIterator()) {
            Take(pins, *pin);
        }
    }
    for (const Signal* signal : netlist.GetSignalIterator()) {
        Take(signals, *signal);
    }
    counts.attributes = {module, components, instances, signals, pins};
}

} // namespace

DesignCounts CountDesign(const Orn_Hdl::Netlist& netlist) {
    DesignCounts counts;
    counts.name = netlist.GetNameView();
    CountInstances(netlist, counts);
    CountSignals(netlist, counts);
    CountNets(netlist, counts);
    CountAttributes(netlist, counts);
    return counts;
}

} // namespace Tool::Stats
