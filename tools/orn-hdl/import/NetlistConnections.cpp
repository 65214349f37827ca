#include "import/NetlistConnections.h"

#include "import/NameRules.h"
#include "import/SignalReferences.h"

#include "Orn_Hdl/Model/Pins.h"

#include <algorithm>
#include <cstddef>
#include <string>

namespace Tool::Import {

namespace {

bool HasOpenInput(const ImportedNetlist& netlist, std::size_t cell, const BitUses& uses) {
    const ImportedComponent& component = netlist.components.GetOf(cell);
    const auto isInput = [](const ImportedPin& pin) { return pin.direction == Direction::Input; };
    auto open = std::count_if(component.pins.begin(), component.pins.end(), isInput);
    const Span& connections = netlist.top.cells[cell].connections;
    for (std::uint32_t k = 0; k < connections.count; ++k) {
        const Connection& connection = netlist.top.connections[connections.start + k];
        open -= isInput(component.GetPin(connection.pin)) && !uses.IsOpen(connections.start + k)
                    ? 1
                    : 0;
    }
    return open > 0;
}

/// The name, without its range, that the library gives to the signal of a constant at a pin.
std::string GetConstantSignalName(const std::string& cell, const ImportedPin& pin) {
    Orn_Hdl::ScalarPin scalar(pin.baseName.c_str(), Orn_Hdl::Polarity());
    Orn_Hdl::PinConstantSignalVisitor visitor(cell.c_str());
    visitor.VisitScalarPin(&scalar);
    return std::string(visitor.GetName().GetView());
}

/// Adds the signals for the constants among the bits of a connection.
void NeedConstants(ImportedNetlist& netlist, const Span& bits, UniqueNames& names) {
    for (std::uint32_t i = 0; i < bits.count; ++i) {
        const Bit bit = netlist.unknown.Replace(netlist.top.GetBit(bits, i));
        if (!IsNet(bit)) {
            netlist.owners.NeedConstant(bit, names);
        }
    }
}

} // namespace

void DecideConnections(ImportedNetlist& netlist, const BitUses& uses, UniqueNames& names) {
    const Module& top = netlist.top;
    netlist.connections.assign(top.connections.size(), ConnectionKind::Open);
    for (std::size_t c = 0; c < top.cells.size(); ++c) {
        const Cell& cell = top.cells[c];
        netlist.hasOpenInputs = netlist.hasOpenInputs || HasOpenInput(netlist, c, uses);
        for (std::uint32_t k = 0; k < cell.connections.count; ++k) {
            const std::uint32_t index = cell.connections.start + k;
            const Connection& connection = top.connections[index];
            if (uses.IsOpen(index)) {
                continue;
            }
            const ImportedPin& pin = netlist.components.GetOf(c).GetPin(connection.pin);
            const SignalReferences references(top, netlist.owners, netlist.unknown);
            // If the constant signals of two pins would have the same name, or their name would
            // have an escaped name within it, the import adds a signal.
            if (references.IsConstant(connection.bits) && !NameRules::IsEscaped(pin.baseName) &&
                names.Claim(GetConstantSignalName(netlist.cellNames[c], pin))) {
                netlist.connections[index] = ConnectionKind::Constant;
                continue;
            }
            netlist.connections[index] = ConnectionKind::Signal;
            NeedConstants(netlist, connection.bits, names);
        }
    }
}

} // namespace Tool::Import
