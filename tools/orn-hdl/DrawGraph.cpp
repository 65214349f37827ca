#include "DrawGraph.h"

#include "Orn_Hdl/Model.h"

#include <algorithm>

namespace Tool {

namespace {

using namespace Orn_Hdl;

/// Nets with more ends than this tell little of what belongs together, and hide the rest.
constexpr std::size_t MostEndsDrawn = 32;

/// With more boxes than this, Graphviz is told to take less care, or it takes minutes.
constexpr std::size_t MostBoxesDrawnWell = 150;
/// And with more than this, still less.
constexpr std::size_t MostBoxesDrawnFairly = 1500;

/// A text for a Graphviz string, or, with `record`, for a field of a box. Bytes that no picture can
/// show become "?".
std::string Quote(std::string_view text, bool record = false) {
    const std::string_view special = record ? "\"\\{}|<> " : "\"\\";
    std::string result;
    for (const char c : text) {
        if (special.find(c) != std::string_view::npos) {
            result += '\\';
        }
        const auto byte = static_cast<unsigned char>(c);
        result += byte < ' ' || (byte >= 0x7F && byte < 0xA0) ? '?' : c;
    }
    return result;
}

/// The bus that a slice or bit belongs to; any other signal itself.
const Signal& GetWhole(const Signal& signal) {
    const Bus* parent = nullptr;
    if (signal.GetSignalType() == SignalTypeBusSlice) {
        parent = static_cast<const BusSlice&>(signal).GetParentBus();
    } else if (signal.GetSignalType() == SignalTypeBusIndex) {
        parent = static_cast<const BusIndex&>(signal).GetParentBus();
    }
    return parent == nullptr ? signal : *parent;
}

std::string GetConstantText(const BitVectorValue& value) {
    std::string text(value.GetValue().GetView());
    return value.HasBaseAndLength()
               ? std::to_string(value.GetLength()) + "'" +
                     std::string(HdlUtilities::ConvertVerilogBase(value.GetBase()).GetView()) + text
               : text;
}

} // namespace

Graph::Graph(const Netlist& netlist) : netlist_(netlist) {
    for (const Instance* instance : netlist.GetInstanceIterator()) {
        AddBox(*instance);
    }
    for (Signal* signal : netlist.GetSignalIterator()) {
        if (signal->IsPort() && signal->IsNeededToDeclared()) {
            AddPort(*signal);
        }
        AddSources(*signal);
    }
}

std::vector<Graph::Part> Graph::GetParts(const Signal& signal) {
    std::vector<Part> parts;
    AddParts(signal, parts);
    return parts;
}

void Graph::AddParts(const Signal& signal, std::vector<Part>& parts) {
    if (signal.GetSignalType() == SignalTypeCompoundBus) {
        for (const Signal* member :
             static_cast<const CompoundBus&>(signal).GetBusMemberIterator()) {
            AddParts(*member, parts);
        }
        return;
    }
    const std::int64_t start = parts.empty() ? 0 : parts.back().end;
    parts.push_back(Part{&signal, GetOrAddNet(GetWhole(signal)), start, start + signal.GetWidth()});
}

std::size_t Graph::GetOrAddNet(const Signal& signal) {
    const auto [place, isNew] = netIndex_.try_emplace(&signal, nets_.size());
    if (isNew) {
        nets_.emplace_back().signal = &signal;
    }
    return place->second;
}

void Graph::AddBox(const Instance& instance) {
    const std::size_t index = boxes_.size();
    boxIndex_.emplace(&instance, index);
    Box& box = boxes_.emplace_back();
    box.instance = &instance;
    std::size_t number = 0;
    for (const Pin* pin : instance.GetPinIterator()) {
        const int polarity = pin->GetPolarity().GetValue();
        const std::size_t pinNumber = number++;
        End end;
        end.box = index;
        end.role = polarity == Polarity::Input    ? Role::Reads
                   : polarity == Polarity::Output ? Role::Drives
                                                  : Role::Both;
        end.point.append("i").append(std::to_string(index)).append(":p");
        end.point.append(std::to_string(pinNumber));
        end.point.append(end.role == Role::Reads ? ":w" : ":e");
        if (pin->GetSignal() != nullptr) {
            for (const Part& part : GetParts(*pin->GetSignal())) {
                end.part = part.signal;
                nets_[part.net].ends.push_back(end);
                box.wires.push_back(Wire{pinNumber, part.net, part.signal});
            }
        }
    }
}

void Graph::AddPort(const Signal& signal) {
    Net& net = nets_[GetOrAddNet(signal)];
    const int polarity = signal.GetPortPolarity().GetValue();
    End end;
    end.part = &signal;
    end.role = polarity == Polarity::Input    ? Role::Drives
               : polarity == Polarity::Output ? Role::Reads
                                              : Role::Both;
    end.point = GetNode("s", net) + (end.role == Role::Reads ? ":w" : ":e");
    net.ends.push_back(end);
}

void Graph::AddSources(Signal& signal) {
    const BitVectorValue& constant = signal.GetConstantValue();
    if (!constant.GetValue().IsEmpty()) {
        for (const Part& part : GetParts(signal)) {
            nets_[part.net].constants.push_back(Constant{GetConstantText(constant), part.signal});
        }
    }
    for (const Signal* source : signal.GetSignalIterator()) {
        const std::vector<Part> sources = GetParts(*source);
        for (const Part& to : GetParts(signal)) {
            for (const Part& from : sources) {
                if (from.start < to.end && to.start < from.end) {
                    nets_[to.net].sources.push_back(Source{from.net, to.signal});
                    nets_[from.net].aliases.push_back(to.net);
                }
            }
        }
    }
}

std::size_t Graph::CountBoxes() const noexcept {
    return static_cast<std::size_t>(
        std::count_if(boxes_.begin(), boxes_.end(), [](const Box& box) { return box.drawn; }));
}

bool Graph::KeepAround(const std::string& name, int depth) {
    std::vector<std::size_t> reached;
    const Instance* instance = netlist_.GetInstance(name.c_str());
    const Signal* signal = netlist_.GetSignal(name.c_str());
    if (instance == nullptr && signal == nullptr) {
        return false;
    }
    for (Box& box : boxes_) {
        box.drawn = false;
    }
    for (Net& net : nets_) {
        net.drawn = false;
    }
    if (instance != nullptr) {
        reached.push_back(boxIndex_.find(instance)->second);
        boxes_[reached.front()].drawn = true;
    } else {
        for (const Part& part : GetParts(*signal)) {
            Reach(part.net, true, reached);
        }
    }
    for (; depth > 0; --depth) {
        std::vector<std::size_t> next;
        for (const std::size_t box : reached) {
            for (const Wire& wire : boxes_[box].wires) {
                Reach(wire.net, false, next);
            }
        }
        reached.swap(next);
    }
    for (const Box& box : boxes_) {
        for (const Wire& wire : box.wires) {
            nets_[wire.net].drawn = nets_[wire.net].drawn || box.drawn;
        }
    }
    return true;
}

void Graph::Reach(std::size_t start, bool always, std::vector<std::size_t>& boxes) {
    std::vector<std::size_t> open{start};
    while (!open.empty()) {
        Net& net = nets_[open.back()];
        open.pop_back();
        if (net.drawn || (!always && IsWide(net))) {
            continue;
        }
        net.drawn = true;
        for (const End& end : net.ends) {
            if (end.box != NoBox && !boxes_[end.box].drawn) {
                boxes_[end.box].drawn = true;
                boxes.push_back(end.box);
            }
        }
        for (const Source& source : net.sources) {
            open.push_back(source.net);
        }
        open.insert(open.end(), net.aliases.begin(), net.aliases.end());
    }
}

std::string Graph::GetConstantNode(const Net& net, std::size_t index) const {
    return GetNode("c", net) + "_" + std::to_string(index);
}

bool Graph::IsWide(const Net& net) noexcept {
    return net.ends.size() > MostEndsDrawn;
}

std::string Graph::GetNode(std::string_view kind, const Net& net) const {
    return std::string(kind) + std::to_string(&net - nets_.data());
}

Graph::Sorted Graph::Sort(const Net& net) const {
    Sorted sorted;
    const End* both = nullptr;
    for (const End& end : net.ends) {
        if (!IsDrawn(end)) {
            sorted.hasHiddenDriver |= end.role != Role::Reads;
            sorted.hasHiddenReader |= end.role == Role::Reads;
        } else if (end.role == Role::Drives) {
            sorted.drivers.push_back(&end);
        } else {
            sorted.readers.push_back(&end);
            both = both == nullptr && end.role == Role::Both ? &end : both;
        }
    }
    // A net of bidirectional ends alone begins at the first of them.
    if (sorted.drivers.empty() && !sorted.hasHiddenDriver && both != nullptr) {
        sorted.drivers.push_back(both);
        std::erase(sorted.readers, both);
    }
    return sorted;
}

bool Graph::HasDot(const Net& net, const Sorted& sorted) const {
    const std::size_t drivers = sorted.drivers.size() + (sorted.hasHiddenDriver ? 1 : 0) +
                                net.sources.size() + net.constants.size();
    if (drivers != 1 || sorted.drivers.empty()) {
        return drivers != 1;
    }
    // What drives one part of a bus is not the start of the other parts.
    const Signal* driven = sorted.drivers.front()->part;
    return driven != net.signal &&
           std::any_of(sorted.readers.begin(), sorted.readers.end(),
                       [&](const End* reader) { return reader->part != driven; });
}

/// Where the lines of a net begin.
std::string Graph::GetStart(const Net& net, const Sorted& sorted) const {
    if (IsWide(net)) {
        return GetNode("h", net);
    }
    if (HasDot(net, sorted) || !net.sources.empty()) {
        return GetNode("n", net);
    }
    if (sorted.hasHiddenDriver) {
        return GetNode("h", net);
    }
    return sorted.drivers.empty() ? GetConstantNode(net, 0) : sorted.drivers.front()->point;
}

void Graph::WriteLine(std::string& text, std::string_view from, std::string_view to,
                      const Signal& part, const char* more) const {
    text.append("  ").append(from).append(" -> ").append(to).append(" [");
    if (part.GetWidth() != 1) {
        text += "penwidth=3, ";
    }
    if (&GetWhole(part) != &part) {
        text.append("label=\"").append(Quote(part.GetNameView())).append("\", ");
    }
    text.append(more).append("];\n");
}

std::string Graph::GetPinText(const Box& box, const Pin& pin, std::size_t number) const {
    std::string text = Quote(pin.GetNameView(), true);
    const char* separator = "\\ =\\ ";
    for (const Wire& wire : box.wires) {
        if (wire.pin == number && IsWide(nets_[wire.net])) {
            text.append(separator).append(Quote(wire.part->GetNameView(), true));
            separator = ",\\ ";
        }
    }
    return text;
}

void Graph::WriteBox(std::string& text, std::size_t index) const {
    const Instance& instance = *boxes_[index].instance;
    std::string left;
    std::string right;
    std::size_t number = 0;
    for (const Pin* pin : instance.GetPinIterator()) {
        const bool reads = pin->GetPolarity().GetValue() == Polarity::Input;
        std::string& side = reads ? left : right;
        side.append(side.empty() ? "<p" : "|<p").append(std::to_string(number)).append("> ");
        side += GetPinText(boxes_[index], *pin, number++);
    }
    text.append("  i").append(std::to_string(index)).append(" [shape=record, label=\"{");
    if (!left.empty()) {
        text.append("{").append(left).append("}|");
    }
    text.append(Quote(instance.GetNameView(), true)).append("\\n");
    text.append(Quote(instance.GetComponentName().GetView(), true));
    if (!right.empty()) {
        text.append("|{").append(right).append("}");
    }
    text += "}\"];\n";
}

void Graph::WritePort(std::string& text, const Net& net) const {
    const bool thick = net.signal->GetWidth() != 1;
    const bool both = net.signal->GetPortPolarity().GetValue() == Polarity::BiDirectional;
    text.append("  ").append(GetNode("s", net)).append(both ? " [shape=hexagon" : " [shape=cds");
    text.append(thick ? ", penwidth=3" : "").append(", label=\"");
    text.append(Quote(net.signal->GetNameView())).append("\"];\n");
}

void Graph::WriteStub(std::string& text, const Net& net) const {
    text.append("  ").append(GetNode("h", net));
    text.append(" [shape=plaintext, fontcolor=gray40, label=\"");
    text.append(Quote(net.signal->GetNameView())).append(" ...\"];\n");
}

void Graph::WriteSources(std::string& text, const Net& net, const std::string& to) const {
    for (std::size_t i = 0; i < net.constants.size(); ++i) {
        WriteLine(text, GetConstantNode(net, i), to, *net.constants[i].part, "");
    }
    for (const Source& source : net.sources) {
        const Net& from = nets_[source.net];
        if (from.drawn) {
            WriteLine(text, GetStart(from, Sort(from)), to, *source.part, "");
        }
    }
}

void Graph::WriteWideNet(std::string& text, const Net& net) const {
    if (!net.sources.empty() || !net.aliases.empty() || !net.constants.empty()) {
        WriteStub(text, net);
        WriteSources(text, net, GetNode("h", net));
    }
}

void Graph::WriteDot(std::string& text, const Net& net, const Sorted& sorted) const {
    const std::string dot = GetNode("n", net);
    text.append("  ").append(dot).append(" [shape=point, width=0.06, height=0.06, xlabel=\"");
    text.append(Quote(net.signal->GetNameView())).append("\"];\n");
    for (const End* driver : sorted.drivers) {
        WriteLine(text, driver->point, dot, *driver->part, "");
    }
    WriteSources(text, net, dot);
    if (sorted.hasHiddenDriver) {
        WriteLine(text, GetNode("h", net), dot, *net.signal, "");
    }
}

void Graph::WriteNet(std::string& text, const Net& net) const {
    if (net.signal->IsPort()) {
        WritePort(text, net);
    }
    for (std::size_t i = 0; i < net.constants.size(); ++i) {
        text.append("  ").append(GetConstantNode(net, i)).append(" [shape=plaintext, label=\"");
        text.append(Quote(net.constants[i].value)).append("\"];\n");
    }
    if (IsWide(net)) {
        WriteWideNet(text, net);
        return;
    }
    const Sorted sorted = Sort(net);
    const std::string start = GetStart(net, sorted);
    if (sorted.hasHiddenDriver || sorted.hasHiddenReader) {
        WriteStub(text, net);
    }
    if (start == GetNode("n", net)) {
        WriteDot(text, net, sorted);
    }
    for (const End* reader : sorted.readers) {
        WriteLine(text, start, reader->point, *reader->part,
                  reader->role == Role::Both ? "dir=both" : "");
    }
    if (sorted.hasHiddenReader && start != GetNode("h", net)) {
        WriteLine(text, start, GetNode("h", net), *net.signal, "style=dashed");
    }
}

std::string Graph::Write() const {
    std::string text("digraph design {\n"
                     "  graph [rankdir=LR, charset=latin1, ranksep=1];\n"
                     "  node [fontname=Helvetica, fontsize=11, height=0.3];\n"
                     "  edge [fontname=Helvetica, fontsize=8, arrowsize=0.5];\n");
    if (CountBoxes() > MostBoxesDrawnFairly) {
        text += "  graph [nslimit=0.1, nslimit1=0.1, mclimit=0.02];\n";
    } else if (CountBoxes() > MostBoxesDrawnWell) {
        text += "  graph [nslimit=0.5, nslimit1=0.5, mclimit=0.1];\n";
    }
    for (std::size_t i = 0; i < boxes_.size(); ++i) {
        if (boxes_[i].drawn) {
            WriteBox(text, i);
        }
    }
    for (const Net& net : nets_) {
        if (net.drawn) {
            WriteNet(text, net);
        }
    }
    return text += "}\n";
}

} // namespace Tool
