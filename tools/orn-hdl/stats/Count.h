// Counts what a design is made of.
#pragma once

#include <cstddef>
#include <cstdint>
#include <map>
#include <string>
#include <vector>

namespace Orn_Hdl {
class Netlist;
}

namespace Tool::Stats {

/// How often something with a name occurs.
struct NamedCount {
    std::string name;
    std::uint64_t count = 0;
};

/// Signals of one kind, and their bits.
struct SignalCount {
    std::uint64_t signals = 0;
    std::uint64_t bits = 0;
};

/// How many nets have a property, and the first names of them.
struct NetCount {
    /// The number of names that are kept.
    static constexpr std::size_t MostNames = 10;

    std::uint64_t count = 0;
    std::vector<std::string> names;
};

/// Of how many holders has a kind attributes, and how many attributes these have.
struct AttributeCount {
    std::string kind;
    std::uint64_t holders = 0;
    std::uint64_t attributes = 0;
};

/// What a design is made of. A net is a scalar signal or one bit of a bus.
struct DesignCounts {
    std::string name;
    std::uint64_t instances = 0;
    std::uint64_t pins = 0;
    std::uint64_t openPins = 0;
    /// The instances by component: the most frequent component first. Components that are never
    /// used stand at the end.
    std::vector<NamedCount> components;
    /// Instances whose component is not in the netlist.
    std::uint64_t instancesWithoutComponent = 0;
    /// The ports by direction: input, output, bidirectional.
    std::vector<std::pair<std::string, SignalCount>> ports;
    SignalCount signals;
    std::uint64_t aliases = 0;
    std::uint64_t constants = 0;
    std::uint64_t nets = 0;
    /// The number of scalar signals and buses by their width.
    std::map<std::int64_t, std::uint64_t> signalsByWidth;
    /// The number of nets by their number of loads.
    std::map<std::int64_t, std::uint64_t> netsByFanOut;
    /// The nets with most loads, in descending order.
    std::vector<NamedCount> greatestFanOuts;
    /// Nets that are read and not driven.
    NetCount undriven;
    /// Nets that are driven and not read.
    NetCount unloaded;
    /// Nets that are neither.
    NetCount unconnected;
    /// Nets with more than one driver.
    NetCount multiplyDriven;
    /// The attributes by the kind of their holder.
    std::vector<AttributeCount> attributes;
};

DesignCounts CountDesign(const Orn_Hdl::Netlist& netlist);

} // namespace Tool::Stats
