#include "import/NameMap.h"

#include "import/SignalReferences.h"

#include "NameLine.h"
#include "Port/File.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace Tool::Import {

namespace {

void WriteComponent(const ImportedComponent& component, Port::Stream& out) {
    WriteNameLine(out, "component", component.oldName, component.name);
    for (const ImportedPin& pin : component.pins) {
        WriteNameLine(out, "pin", JoinNames(component.oldName, pin.oldName),
                      JoinNames(component.name, pin.name));
    }
    for (const ImportedGeneric& generic : component.generics) {
        WriteNameLine(out, "parameter", JoinNames(component.oldName, generic.oldName),
                      JoinNames(component.name, generic.value.name));
    }
}

/// The signal of each net, by the index of the net; null for a net that owns no bit.
std::vector<const ImportedSignal*> GetSignalsOfNets(const ImportedNetlist& netlist) {
    std::vector<const ImportedSignal*> result(netlist.top.nets.size());
    for (const ImportedSignal& signal : netlist.owners.GetSignals()) {
        if (signal.net != nullptr) {
            result[static_cast<std::size_t>(signal.net - netlist.top.nets.data())] = &signal;
        }
    }
    return result;
}

void WriteNets(const ImportedNetlist& netlist, Port::Stream& out) {
    const SignalReferences references(netlist.top, netlist.owners, netlist.unknown);
    const std::vector<const ImportedSignal*> signals = GetSignalsOfNets(netlist);
    for (std::size_t n = 0; n < signals.size(); ++n) {
        const Net& net = netlist.top.nets[n];
        WriteNameLine(out, "net", net.name,
                      signals[n] != nullptr ? signals[n]->name : references.GetReference(net.bits));
    }
}

} // namespace

void WriteNameMap(const ImportedNetlist& netlist, Port::Stream& out) {
    WriteNameLine(out, "module", netlist.top.name, netlist.name);
    for (const ImportedComponent& component : netlist.components.GetAll()) {
        WriteComponent(component, out);
    }
    for (const ImportedSignal& signal : netlist.owners.GetSignals()) {
        if (signal.port != nullptr) {
            WriteNameLine(out, "port", signal.port->name, signal.name);
        }
    }
    WriteNets(netlist, out);
    for (std::size_t c = 0; c < netlist.top.cells.size(); ++c) {
        WriteNameLine(out, "cell", netlist.top.cells[c].name, netlist.cellNames[c]);
    }
}

} // namespace Tool::Import
