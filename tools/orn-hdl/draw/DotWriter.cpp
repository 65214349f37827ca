#include "draw/DotWriter.h"

#include "Orn_Hdl/Model.h"

#include <algorithm>

namespace Tool {

using namespace Orn_Hdl;

namespace {

/// With more boxes than this, Graphviz needs minutes unless its limits are lowered.
constexpr std::size_t MostBoxesDrawnWell = 150;
/// With more boxes than this, the limits have to be lower still.
constexpr std::size_t MostBoxesDrawnFairly = 1500;

// Prefixes of node names, followed by the number of the net.
constexpr std::string_view PortNode = "s";
constexpr std::string_view PointNode = "n";
/// The name of a net, drawn instead of lines.
constexpr std::string_view StubNode = "h";
constexpr std::string_view ConstantNode = "c";

/// Graphviz reads at most 16384 characters of a string at once, and ignores this between them.
constexpr std::string_view Break = "\\\n";

/// A text for a Graphviz string, or, with `record`, for a field of a box. Bytes that no picture can
/// show become "?".
std::string Escape(std::string_view text, bool record = false) {
    constexpr std::size_t AtOnce = 4096;
    const std::string_view special = record ? "\"\\{}|<> " : "\"\\";
    std::string result;
    for (std::size_t i = 0; i < text.size(); ++i) {
        const char c = text[i];
        if (i % AtOnce == AtOnce - 1) {
            result += Break;
        }
        if (special.find(c) != std::string_view::npos) {
            result += '\\';
        }
        const auto byte = static_cast<unsigned char>(c);
        result += byte < ' ' || (byte >= 0x7F && byte < 0xA0) ? '?' : c;
    }
    return result;
}

} // namespace

std::string DotWriter::GetNode(std::string_view kind, const Net& net) const {
    return std::string(kind) + std::to_string(&net - graph_.GetNets().data());
}

std::string DotWriter::GetConstantNode(const Net& net, std::size_t index) const {
    return GetNode(ConstantNode, net) + "_" + std::to_string(index);
}

std::string DotWriter::GetEndNode(const Net& net, const End& end) const {
    std::string node;
    if (end.box == DesignGraph::NoBox) {
        node = GetNode(PortNode, net);
    } else {
        node.append("i").append(std::to_string(end.box));
        node.append(":p").append(std::to_string(end.pin));
    }
    return node.append(end.role == DesignGraph::Role::Reads ? ":w" : ":e");
}

std::string DotWriter::GetStart(const Net& net, const SortedEnds& ends) const {
    if (DesignGraph::NeedsPoint(net, ends) || !net.sources.empty()) {
        return GetNode(PointNode, net);
    }
    if (ends.hasHiddenDriver) {
        return GetNode(StubNode, net);
    }
    return ends.drivers.empty() ? GetConstantNode(net, 0) : GetEndNode(net, *ends.drivers.front());
}

void DotWriter::WriteLine(std::string_view from, std::string_view to, const Signal& part,
                          std::string_view more) {
    text_.append("  ").append(from).append(" -> ").append(to).append(" [");
    if (part.GetWidth() != 1) {
        text_ += "penwidth=3, ";
    }
    if (&GetWholeSignal(part) != &part) {
        text_.append("label=\"").append(Escape(part.GetNameView())).append("\", ");
    }
    text_.append(more).append("];\n");
}

std::string DotWriter::GetPinText(const Box& box, const Pin& pin, std::size_t number) const {
    std::string text = Escape(pin.GetNameView(), true);
    const char* separator = "\\ =\\ ";
    auto wire = std::lower_bound(
        box.wires.begin(), box.wires.end(), number,
        [](const DesignGraph::Wire& w, std::size_t wanted) { return w.pin < wanted; });
    for (; wire != box.wires.end() && wire->pin == number; ++wire) {
        if (DesignGraph::HasManyEnds(graph_.GetNets()[wire->net])) {
            text.append(separator).append(Escape(wire->part->GetNameView(), true));
            separator = ",\\ ";
        }
    }
    return text;
}

void DotWriter::WriteBox(std::size_t index) {
    const Box& box = graph_.GetBoxes()[index];
    const Instance& instance = *box.instance;
    std::string left;
    std::string right;
    std::size_t number = 0;
    for (const Pin* pin : instance.GetPinIterator()) {
        const bool reads = pin->GetPolarity().GetValue() == Polarity::Input;
        std::string& side = reads ? left : right;
        side.append(side.empty() ? "" : "|").append(Break);
        side.append("<p").append(std::to_string(number)).append("> ");
        side += GetPinText(box, *pin, number++);
    }
    text_.append("  i").append(std::to_string(index)).append(" [shape=record, label=\"{");
    if (!left.empty()) {
        text_.append("{").append(left).append("}|");
    }
    text_.append(Escape(instance.GetNameView(), true)).append("\\n");
    text_.append(Escape(instance.GetComponentName().GetView(), true));
    if (!right.empty()) {
        text_.append("|{").append(right).append("}");
    }
    text_ += "}\"];\n";
}

void DotWriter::WritePort(const Net& net) {
    const bool thick = net.signal->GetWidth() != 1;
    const bool both = net.signal->GetPortPolarity().GetValue() == Polarity::BiDirectional;
    text_.append("  ").append(GetNode(PortNode, net));
    text_.append(both ? " [shape=hexagon" : " [shape=cds");
    text_.append(thick ? ", penwidth=3" : "").append(", label=\"");
    text_.append(Escape(net.signal->GetNameView())).append("\"];\n");
}

void DotWriter::WriteStub(const Net& net) {
    text_.append("  ").append(GetNode(StubNode, net));
    text_.append(" [shape=plaintext, fontcolor=gray40, label=\"");
    text_.append(Escape(net.signal->GetNameView())).append(" ...\"];\n");
}

void DotWriter::WriteSources(const Net& net, const std::string& to) {
    for (std::size_t i = 0; i < net.constants.size(); ++i) {
        WriteLine(GetConstantNode(net, i), to, *net.constants[i].part, "");
    }
    for (const DesignGraph::Source& source : net.sources) {
        const Net& from = graph_.GetNets()[source.net];
        if (from.drawn) {
            // The ends of a net with very many would be sorted again for each alias.
            const std::string start = DesignGraph::HasManyEnds(from)
                                          ? GetNode(StubNode, from)
                                          : GetStart(from, graph_.SortEnds(from));
            WriteLine(start, to, *source.part, "");
        }
    }
}

void DotWriter::WriteNetByName(const Net& net) {
    if (!net.sources.empty() || !net.aliases.empty() || !net.constants.empty()) {
        WriteStub(net);
        WriteSources(net, GetNode(StubNode, net));
    }
}

void DotWriter::WritePoint(const Net& net, const SortedEnds& ends) {
    const std::string point = GetNode(PointNode, net);
    text_.append("  ").append(point).append(" [shape=point, width=0.06, height=0.06, xlabel=\"");
    text_.append(Escape(net.signal->GetNameView())).append("\"];\n");
    for (const End* driver : ends.drivers) {
        WriteLine(GetEndNode(net, *driver), point, *driver->part, "");
    }
    WriteSources(net, point);
    if (ends.hasHiddenDriver) {
        WriteLine(GetNode(StubNode, net), point, *net.signal, "");
    }
}

void DotWriter::WriteNet(const Net& net) {
    if (net.signal->IsPort()) {
        WritePort(net);
    }
    for (std::size_t i = 0; i < net.constants.size(); ++i) {
        text_.append("  ").append(GetConstantNode(net, i)).append(" [shape=plaintext, label=\"");
        text_.append(Escape(net.constants[i].value)).append("\"];\n");
    }
    if (DesignGraph::HasManyEnds(net)) {
        WriteNetByName(net);
        return;
    }
    const SortedEnds ends = graph_.SortEnds(net);
    const std::string start = GetStart(net, ends);
    if (ends.hasHiddenDriver || ends.hasHiddenReader) {
        WriteStub(net);
    }
    if (start == GetNode(PointNode, net)) {
        WritePoint(net, ends);
    }
    for (const End* reader : ends.readers) {
        WriteLine(start, GetEndNode(net, *reader), *reader->part,
                  reader->role == DesignGraph::Role::Both ? "dir=both" : "");
    }
    if (ends.hasHiddenReader && start != GetNode(StubNode, net)) {
        WriteLine(start, GetNode(StubNode, net), *net.signal, "style=dashed");
    }
}

void DotWriter::WriteSettings() {
    text_ += "  graph [rankdir=LR, charset=latin1, ranksep=1];\n"
             "  node [fontname=Helvetica, fontsize=11, height=0.3];\n"
             "  edge [fontname=Helvetica, fontsize=8, arrowsize=0.5];\n";
    if (graph_.CountDrawnBoxes() > MostBoxesDrawnFairly) {
        text_ += "  graph [nslimit=0.1, nslimit1=0.1, mclimit=0.02];\n";
    } else if (graph_.CountDrawnBoxes() > MostBoxesDrawnWell) {
        text_ += "  graph [nslimit=0.5, nslimit1=0.5, mclimit=0.1];\n";
    }
}

std::string DotWriter::Write() {
    text_ = "digraph design {\n";
    WriteSettings();
    for (std::size_t i = 0; i < graph_.GetBoxes().size(); ++i) {
        if (graph_.GetBoxes()[i].drawn) {
            WriteBox(i);
        }
    }
    for (const Net& net : graph_.GetNets()) {
        if (net.drawn) {
            WriteNet(net);
        }
    }
    return text_ += "}\n";
}

} // namespace Tool
