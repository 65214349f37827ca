#include "import/NetlistNames.h"

#include "import/DesignUnits.h"
#include "import/NameRules.h"
#include "import/Values.h"

#include "Port/Ascii.h"

#include <algorithm>
#include <cstddef>
#include <string>
#include <string_view>
#include <unordered_set>

namespace Tool::Import {

namespace {

/// The names of nets of one bit that has an index. Older files give the range of a port with the
/// net of its name only.
std::unordered_set<std::string_view> GetOneBitBuses(const Module& top) {
    std::unordered_set<std::string_view> result;
    for (const Net& net : top.nets) {
        if (net.bits.count == 1 && net.range.offset != 0) {
            result.insert(net.name);
        }
    }
    return result;
}

std::string GetWantedCellName(const ImportedNetlist& netlist, std::size_t cell) {
    const std::string_view name = netlist.top.cells[cell].name;
    const std::size_t number = name.find_last_not_of("0123456789") + 1;
    // A generated name only contains the program's step that created the cell, so the component's
    // name is more useful.
    return netlist.top.cells[cell].hidden && number < name.size()
               ? netlist.components.GetOf(cell).name + "_" + std::string(name.substr(number))
               : std::string(name);
}

void NameAttributesOf(ImportedNetlist& netlist, std::string_view table, std::string_view owner,
                      const Span& attributes, UniqueNames& names, Warnings& warnings) {
    for (std::uint32_t i = 0; i < attributes.count; ++i) {
        const NamedValue& value = netlist.top.values[attributes.start + i];
        CheckAttribute(value.value, Place{netlist.top.name, table, owner, "attributes", value.name},
                       warnings);
        const auto [place, isNew] = netlist.attributeNames.try_emplace(value.name);
        if (isNew) {
            place->second = names.ClaimSimilar(value.name, 'a');
        }
    }
}

} // namespace

std::vector<std::string> ClaimPortNames(const Module& top, UniqueNames& names) {
    std::vector<std::string> result(top.ports.size());
    if (!names.GetRules().MayEscape()) {
        return result;
    }
    for (std::size_t p = 0; p < result.size(); ++p) {
        if (names.ClaimLegal(top.ports[p].name)) {
            result[p] = top.ports[p].name;
        }
    }
    const std::unordered_set<std::string_view> oneBitBuses = GetOneBitBuses(top);
    for (std::size_t p = 0; p < result.size(); ++p) {
        const ModulePort& port = top.ports[p];
        const bool isScalar =
            port.bits.count == 1 && port.range.offset == 0 && oneBitBuses.count(port.name) == 0;
        // An inout port cannot be connected to an internal signal by an assignment.
        if (result[p].empty() && isScalar && port.direction != Direction::InOut) {
            result[p] = names.ClaimSame(port.name);
        }
    }
    return result;
}

namespace {

std::string ChooseDesignName(const ImportedNetlist& netlist, const NameRules& rules,
                             Warnings& warnings) {
    const Module& top = netlist.top;
    // Modules and entities share their names with the components only.
    UniqueNames units(rules);
    for (const ImportedComponent& component : netlist.components.GetAll()) {
        units.Claim(component.name);
    }
    std::string name = units.ClaimSame(top.name);
    if (name.empty()) {
        name = units.ClaimSimilar(top.name, 'm');
        warnings.Add(JsonPath("modules").AddKey(top.name),
                     (rules.IsLegal(top.name) ? "a component has the name " + Quote(top.name)
                                              : Quote(top.name) + rules.GetComplaint()) +
                         "; the netlist is renamed to " + name);
    }
    return name;
}

} // namespace

void NameDesign(ImportedNetlist& netlist, const DesignUnits* units, UniqueNames& names,
                Warnings& warnings) {
    const Module& top = netlist.top;
    netlist.name = units != nullptr ? units->Get(top).name
                                    : ChooseDesignName(netlist, names.GetRules(), warnings);
    // A signal may hide its entity, but tools warn about it; a port keeps its name nevertheless.
    if (std::none_of(top.ports.begin(), top.ports.end(), [&](const ModulePort& port) {
            return Port::EqualIgnoringCase(port.name, netlist.name);
        })) {
        names.Claim(netlist.name);
    }
}

void NameCellsAndSignals(ImportedNetlist& netlist, UniqueNames& names) {
    const std::vector<Cell>& cells = netlist.top.cells;
    std::vector<std::string>& cellNames = netlist.cellNames;
    cellNames.resize(cells.size());
    names.Reserve(cells.size() + netlist.owners.GetSignals().size());
    netlist.owners.ClaimLegalNames(names);
    for (std::size_t c = 0; c < cells.size(); ++c) {
        if (names.ClaimLegal(cells[c].name)) {
            cellNames[c] = cells[c].name;
        }
    }
    netlist.owners.ClaimOtherNames(names);
    for (std::size_t c = 0; c < cells.size(); ++c) {
        if (cellNames[c].empty()) {
            cellNames[c] = names.ClaimSimilar(GetWantedCellName(netlist, c), 'u');
        }
    }
}

void ReportRenamedPorts(const ImportedNetlist& netlist, const NameRules& rules, bool keepPorts,
                        Warnings& warnings) {
    for (const ImportedSignal& signal : netlist.owners.GetSignals()) {
        if (signal.port == nullptr || NameRules::WithoutEscape(signal.name) == signal.port->name) {
            continue;
        }
        const std::string_view name = signal.port->name;
        const JsonPath path = netlist.top.GetPath("ports", name);
        const std::string reason = rules.IsLegal(name)
                                       ? "another object has the name " + Quote(name)
                                       : Quote(name) + rules.GetComplaint();
        if (keepPorts) {
            Fail(path, reason + ", and --keep-ports forbids renaming the port");
        }
        warnings.Add(path, reason + "; the port is renamed to " + signal.name);
    }
}

void NameAttributes(ImportedNetlist& netlist, UniqueNames& signalNames, Warnings& warnings) {
    // VHDL declares attributes beside the signals; on an instance they stand beside its generics.
    UniqueNames verilogNames(signalNames.GetRules());
    UniqueNames& names = signalNames.GetRules().MayEscape() ? verilogNames : signalNames;
    for (const ImportedComponent& component : netlist.components.GetAll()) {
        for (const ImportedGeneric& generic : component.generics) {
            names.Claim(generic.value.name);
        }
    }
    for (const Cell& cell : netlist.top.cells) {
        NameAttributesOf(netlist, "cells", cell.name, cell.attributes, names, warnings);
    }
    for (const ImportedSignal& signal : netlist.owners.GetSignals()) {
        if (const Net* net = signal.net) {
            NameAttributesOf(netlist, "netnames", net->name, net->attributes, names, warnings);
        }
    }
}

} // namespace Tool::Import
