#include "stats/Spelling.h"

#include "diagnostics/JsonWriter.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <string_view>
#include <utility>

namespace Tool::Stats {

namespace {

std::string FormatSeconds(double seconds) {
    char text[32];
    std::snprintf(text, sizeof text, "%.3f", seconds);
    return text;
}

std::string FormatMegabytes(std::uint64_t bytes) {
    char text[32];
    std::snprintf(text, sizeof text, "%.1f MB", static_cast<double>(bytes) / 1e6);
    return text;
}

/// Lines of a label and a number, the numbers in a column.
class Table {
public:
    void Heading(std::string_view heading) { text_.append("\n").append(heading).append("\n"); }
    void Row(std::string_view label, std::string_view value, std::string_view remark = {}) {
        std::string line = "  ";
        line.append(label);
        line.resize(std::max(line.size() + 1, LabelWidth), ' ');
        line.append(std::max<std::size_t>(value.size(), NumberWidth) - value.size(), ' ');
        line.append(value);
        if (!remark.empty()) {
            line.append("  ").append(remark);
        }
        text_.append(line).append("\n");
    }
    void Row(std::string_view label, std::uint64_t number, std::string_view remark = {}) {
        Row(label, std::to_string(number), remark);
    }
    std::string Take() { return std::move(text_); }

private:
    static constexpr std::size_t LabelWidth = 32;
    static constexpr std::size_t NumberWidth = 10;

    std::string text_;
};

std::string Bits(std::uint64_t bits) {
    return std::to_string(bits) + (bits == 1 ? " bit" : " bits");
}

/// The first names of a few nets; "..." if there are more.
std::string ListNames(const NetCount& nets) {
    std::string list;
    for (const std::string& name : nets.names) {
        list.append(list.empty() ? "" : " ").append(name);
    }
    return list.append(nets.count > nets.names.size() ? " ..." : "");
}

/// Numbers of loads in ranges that double: 0, 1, 2, 3-4, 5-8.
void AddFanOuts(Table& table, const DesignCounts& counts) {
    auto next = counts.netsByFanOut.begin();
    for (std::int64_t low = 0, high = 0; next != counts.netsByFanOut.end();) {
        std::uint64_t nets = 0;
        for (; next != counts.netsByFanOut.end() && next->first <= high; ++next) {
            nets += next->second;
        }
        if (nets > 0) {
            table.Row(low == high ? std::to_string(low)
                                  : std::to_string(low) + "-" + std::to_string(high),
                      nets);
        }
        low = high + 1;
        high = high == 0 ? 1 : 2 * high;
    }
}

void AddInstances(Table& table, const DesignCounts& counts) {
    table.Heading("Instances by component");
    for (const NamedCount& component : counts.components) {
        table.Row(component.name, component.count);
    }
    if (counts.instancesWithoutComponent > 0) {
        table.Row("(no component)", counts.instancesWithoutComponent);
    }
    table.Row("all", counts.instances);
    table.Row("pins", counts.pins);
    table.Row("open pins", counts.openPins);
}

void AddSignals(Table& table, const DesignCounts& counts) {
    table.Heading("Ports");
    for (const auto& [direction, ports] : counts.ports) {
        table.Row(direction, ports.signals, Bits(ports.bits));
    }
    table.Heading("Signals by width");
    for (const auto& [width, signals] : counts.signalsByWidth) {
        table.Row(std::to_string(width), signals);
    }
    table.Row("all", counts.signals.signals, Bits(counts.signals.bits));
    table.Row("aliases", counts.aliases);
    table.Row("constants", counts.constants);
}

void AddNets(Table& table, const DesignCounts& counts) {
    table.Heading("Nets by fan-out");
    AddFanOuts(table, counts);
    table.Row("all", counts.nets);
    if (!counts.greatestFanOuts.empty()) {
        table.Heading("Greatest fan-outs");
    }
    for (const NamedCount& net : counts.greatestFanOuts) {
        table.Row(net.name, net.count);
    }
    table.Heading("Nets to look at");
    table.Row("undriven", counts.undriven.count, ListNames(counts.undriven));
    table.Row("unloaded", counts.unloaded.count, ListNames(counts.unloaded));
    table.Row("unconnected", counts.unconnected.count, ListNames(counts.unconnected));
    table.Row("multiply driven", counts.multiplyDriven.count, ListNames(counts.multiplyDriven));
}

void WriteNumber(JsonWriter& json, std::string_view key, std::uint64_t number) {
    json.Key(key).Number(number);
}

void WriteNamed(JsonWriter& json, std::string_view key, std::string_view countKey,
                const std::vector<NamedCount>& counts) {
    json.Key(key).BeginArray();
    for (const NamedCount& each : counts) {
        json.BeginObject().Key("name").Text(each.name);
        json.Key(countKey).Number(each.count).EndObject();
    }
    json.EndArray();
}

void WriteHistogram(JsonWriter& json, std::string_view key, std::string_view valueKey,
                    std::string_view countKey,
                    const std::map<std::int64_t, std::uint64_t>& histogram) {
    json.Key(key).BeginArray();
    for (const auto& [value, count] : histogram) {
        json.BeginObject();
        json.Key(valueKey).Number(static_cast<std::uint64_t>(std::max<std::int64_t>(value, 0)));
        json.Key(countKey).Number(count).EndObject();
    }
    json.EndArray();
}

void WriteNets(JsonWriter& json, std::string_view key, const NetCount& nets) {
    json.Key(key).BeginObject().Key("count").Number(nets.count).Key("first").BeginArray();
    for (const std::string& name : nets.names) {
        json.Text(name);
    }
    json.EndArray().EndObject();
}

void WriteSignals(JsonWriter& json, const DesignCounts& counts) {
    json.Key("ports").BeginArray();
    for (const auto& [direction, ports] : counts.ports) {
        json.BeginObject().Key("direction").Text(direction);
        json.Key("ports").Number(ports.signals).Key("bits").Number(ports.bits).EndObject();
    }
    json.EndArray();
    json.Key("signals").BeginObject();
    WriteNumber(json, "count", counts.signals.signals);
    WriteNumber(json, "bits", counts.signals.bits);
    WriteNumber(json, "aliases", counts.aliases);
    WriteNumber(json, "constants", counts.constants);
    WriteHistogram(json, "by_width", "width", "signals", counts.signalsByWidth);
    json.EndObject();
}

void WriteAllNets(JsonWriter& json, const DesignCounts& counts) {
    json.Key("nets").BeginObject();
    WriteNumber(json, "count", counts.nets);
    WriteHistogram(json, "by_fan_out", "fan_out", "nets", counts.netsByFanOut);
    WriteNamed(json, "greatest_fan_outs", "fan_out", counts.greatestFanOuts);
    WriteNets(json, "undriven", counts.undriven);
    WriteNets(json, "unloaded", counts.unloaded);
    WriteNets(json, "unconnected", counts.unconnected);
    WriteNets(json, "multiply_driven", counts.multiplyDriven);
    json.EndObject();
}

std::uint64_t ToMilliseconds(double seconds) {
    return static_cast<std::uint64_t>(std::lround(seconds * 1000));
}

} // namespace

std::string SpellAsText(const DesignCounts& counts, const Cost& cost) {
    Table table;
    AddInstances(table, counts);
    AddSignals(table, counts);
    AddNets(table, counts);
    table.Heading("Attributes");
    for (const AttributeCount& each : counts.attributes) {
        table.Row(each.kind, each.attributes, "on " + std::to_string(each.holders));
    }
    table.Heading("Cost");
    table.Row("lines", cost.lines);
    table.Row("replay", FormatSeconds(cost.replaySeconds), "s");
    table.Row("counting", FormatSeconds(cost.countSeconds), "s");
    table.Row("memory of the design", FormatMegabytes(cost.designBytes));
    table.Row("greatest memory", FormatMegabytes(cost.peakBytes));
    return "Design " + counts.name + "\n" + table.Take();
}

std::string SpellAsJson(const DesignCounts& counts, const Cost& cost) {
    JsonWriter json;
    json.BeginObject().Key("design").Text(counts.name);
    WriteNamed(json, "components", "instances", counts.components);
    json.Key("instances").BeginObject();
    WriteNumber(json, "count", counts.instances);
    WriteNumber(json, "without_component", counts.instancesWithoutComponent);
    WriteNumber(json, "pins", counts.pins);
    WriteNumber(json, "open_pins", counts.openPins);
    json.EndObject();
    WriteSignals(json, counts);
    WriteAllNets(json, counts);
    json.Key("attributes").BeginArray();
    for (const AttributeCount& each : counts.attributes) {
        json.BeginObject().Key("of").Text(each.kind).Key("attributes").Number(each.attributes);
        json.Key("holders").Number(each.holders).EndObject();
    }
    json.EndArray().Key("cost").BeginObject();
    WriteNumber(json, "lines", cost.lines);
    WriteNumber(json, "replay_ms", ToMilliseconds(cost.replaySeconds));
    WriteNumber(json, "counting_ms", ToMilliseconds(cost.countSeconds));
    WriteNumber(json, "design_bytes", cost.designBytes);
    WriteNumber(json, "peak_bytes", cost.peakBytes);
    json.EndObject().EndObject();
    return json.Take();
}

} // namespace Tool::Stats
