#include "import/NetlistNames.h"

#include "import/LegalNames.h"
#include "import/Values.h"

#include "Port/Ascii.h"

#include <algorithm>
#include <cstddef>
#include <string>
#include <string_view>

namespace Tool::Import {

namespace {

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

void NameDesign(ImportedNetlist& netlist, UniqueNames& names, Warnings& warnings) {
    const Module& top = netlist.top;
    // Modules and entities share their names with the components only.
    UniqueNames units;
    for (const ImportedComponent& component : netlist.components.GetAll()) {
        units.Claim(component.name);
    }
    if (IsLegalName(top.name) && units.Claim(top.name)) {
        netlist.name = top.name;
    } else {
        netlist.name = units.ClaimSimilar(top.name, 'm');
        warnings.Add(JsonPath("modules").AddKey(top.name),
                     (IsLegalName(top.name) ? "a component has the name " + Quote(top.name)
                                            : Quote(top.name) + NotLegal) +
                         "; the netlist is renamed to " + netlist.name);
    }
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
        if (IsLegalName(cells[c].name) && names.Claim(cells[c].name)) {
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

void NameAttributes(ImportedNetlist& netlist, UniqueNames& names, Warnings& warnings) {
    // VHDL declares attributes beside the signals; on an instance they stand beside its generics.
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
