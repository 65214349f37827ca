#include "import/NameMap.h"

#include "import/SignalReferences.h"

#include "Port/File.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace Tool::Import {

namespace {

/// A field of the table; characters that separate fields and lines are written as \t and \n, a
/// backslash as \\.
std::string Escape(std::string_view text) {
    std::string result;
    for (const char c : text) {
        switch (c) {
        case '\t':
            result += "\\t";
            break;
        case '\n':
            result += "\\n";
            break;
        case '\\':
            result += "\\\\";
            break;
        default:
            result += c;
        }
    }
    return result;
}

void WriteLine(Port::Stream& out, std::string_view kind, std::string_view oldName,
               std::string_view newName) {
    out << kind << "\t" << Escape(oldName) << "\t" << newName << "\n";
}

std::string Join(std::string_view owner, std::string_view name) {
    return std::string(owner).append(".").append(name);
}

void WriteComponent(const ImportedComponent& component, Port::Stream& out) {
    WriteLine(out, "component", component.oldName, component.name);
    for (const ImportedPin& pin : component.pins) {
        WriteLine(out, "pin", Join(component.oldName, pin.oldName), Join(component.name, pin.name));
    }
    for (const ImportedGeneric& generic : component.generics) {
        WriteLine(out, "parameter", Join(component.oldName, generic.oldName),
                  Join(component.name, generic.value.name));
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
        WriteLine(out, "net", net.name,
                  signals[n] != nullptr ? signals[n]->name : references.GetReference(net.bits));
    }
}

} // namespace

void WriteNameMap(const ImportedNetlist& netlist, Port::Stream& out) {
    WriteLine(out, "module", netlist.top.name, netlist.name);
    for (const ImportedComponent& component : netlist.components.GetAll()) {
        WriteComponent(component, out);
    }
    for (const ImportedSignal& signal : netlist.owners.GetSignals()) {
        if (signal.port != nullptr) {
            WriteLine(out, "port", signal.port->name, signal.name);
        }
    }
    WriteNets(netlist, out);
    for (std::size_t c = 0; c < netlist.top.cells.size(); ++c) {
        WriteLine(out, "cell", netlist.top.cells[c].name, netlist.cellNames[c]);
    }
}

} // namespace Tool::Import
