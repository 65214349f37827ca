#include "import/ImportedNetlist.h"

#include "import/BitUses.h"
#include "import/DesignUnits.h"
#include "import/NetlistConnections.h"
#include "import/NetlistNames.h"
#include "import/ReplacedValues.h"
#include "import/UniqueNames.h"
#include "import/Values.h"

#include "Port/Ascii.h"

#include <cstddef>
#include <utility>

namespace Tool::Import {

namespace {

/// Whether a constant at a pin is neither a driver nor a load, so that the bit is open.
bool IsOpenConstant(const ImportedPin& pin, Bit bit) noexcept {
    return pin.direction == Direction::Output
               ? !IsNet(bit)
               : pin.direction == Direction::InOut && bit == HighImpedance;
}

void OpenConstants(Module& top, const Cell& cell, const ImportedPin& pin, const Span& bits,
                   Warnings& warnings) {
    for (std::uint32_t i = 0; i < bits.count; ++i) {
        Bit& bit = top.bits[bits.start + i];
        if (!IsOpenConstant(pin, bit)) {
            continue;
        }
        if (bit < Unknown) {
            warnings.Add(top.GetPinPath(cell, pin.oldName).AddIndex(i),
                         "an output pin is tied to a constant; left open");
        }
        bit = top.netBits++;
    }
}

/// Replaces each constant at an output pin, which has no effect, by a net bit of its own.
void OpenConstantOutputs(Module& top, const ImportedComponents& components, Warnings& warnings) {
    for (std::size_t c = 0; c < top.cells.size(); ++c) {
        const Cell& cell = top.cells[c];
        for (std::uint32_t k = 0; k < cell.connections.count; ++k) {
            const Connection& connection = top.connections[cell.connections.start + k];
            OpenConstants(top, cell, components.GetOf(c).GetPin(connection.pin), connection.bits,
                          warnings);
        }
    }
}

void WarnOfModule(const Module& top, Warnings& warnings) {
    if (top.hasMemories) {
        warnings.Add(JsonPath("modules").AddKey(top.name).AddKey("memories"),
                     "memories are not imported; map them to cells first");
    }
    for (const FirstValue& value : top.firstValues) {
        const std::string_view net = top.nets[value.net].name;
        warnings.Add(top.GetPath("netnames", net).AddKey("attributes").AddKey("init"),
                     "the first values of registers are not imported: a register is unknown until "
                     "it is reset or loaded");
    }
    if (top.ports.empty()) {
        warnings.Add(JsonPath("modules").AddKey(top.name).AddKey("ports"),
                     "VHDL does not allow a design without ports");
    }
}

void CheckParameters(const Module& top, const UnknownValues& unknown, Warnings& warnings) {
    for (const Cell& cell : top.cells) {
        for (std::uint32_t i = 0; i < cell.parameters.count; ++i) {
            const NamedValue& value = top.values[cell.parameters.start + i];
            const Place place = top.GetPlace(cell, "parameters", value.name);
            CheckParameter(value.value, place, unknown, warnings);
            if (MeansAny(value.value, unknown)) {
                WarnOfAny(place, warnings);
            }
        }
    }
}

/// In a configuration, the attribute LEVEL tells that a component has none of its own.
void CheckConfiguration(const ImportedNetlist& netlist) {
    for (const ImportedComponent& component : netlist.components.GetAll()) {
        for (const ImportedGeneric& generic : component.generics) {
            if (netlist.vhdl.configuration &&
                Port::EqualIgnoringCase(generic.value.name, "LEVEL")) {
                Fail(netlist.top.GetPath("cells", component.firstCell->name).AddKey("parameters"),
                     "a configuration needs the name LEVEL, which is that of a parameter");
            }
        }
    }
}

} // namespace

ImportedNetlist MakeNetlist(ImportedDesign& design, Module& top, const ImportRules& rules,
                            Warnings& warnings) {
    const UnknownValues& unknown = rules.unknown;
    UniqueNames names(rules.names);
    const std::vector<std::string> portNames = ClaimPortNames(top, names);
    ImportedComponents components = FindComponents(design, top, rules, names, warnings);
    OpenConstantOutputs(top, components, warnings);
    const bool hasReplaced = TellReplacedValues(top, components, unknown, warnings);
    const BitUses uses = BitUses::Count(top, components, unknown, portNames);
    BitOwners owners = BitOwners::Choose(top, uses, portNames, rules.names, warnings);
    WarnOfModule(top, warnings);
    CheckParameters(top, unknown, warnings);
    ImportedNetlist netlist{top, unknown, std::move(components), std::move(owners), {}, {}, {}, {}};
    netlist.hasDontCares = hasReplaced && unknown.AreDontCares();
    netlist.hasVhdl = rules.names.HasVhdl();
    netlist.vhdl = rules.vhdl;
    CheckConfiguration(netlist);
    NameDesign(netlist, rules.units, names, warnings);
    NameCellsAndSignals(netlist, names);
    ReportRenamedPorts(netlist, rules.names, rules.keepPorts, warnings);
    DecideConnections(netlist, uses, names);
    NameAttributes(netlist, names, warnings);
    if (rules.units != nullptr) {
        rules.units->SetPorts(top, netlist.owners);
    }
    return netlist;
}

} // namespace Tool::Import
