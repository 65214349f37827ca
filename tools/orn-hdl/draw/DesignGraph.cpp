#include "draw/DesignGraph.h"

#include "Orn_Hdl/Model.h"

#include <algorithm>

namespace Tool {

using namespace Orn_Hdl;

namespace {

/// Nets with more ends than this are not drawn as lines, which would hide the other lines.
constexpr std::size_t MostEndsDrawn = 32;

std::string GetConstantText(const BitVectorValue& value) {
    std::string text(value.GetValue().GetView());
    return value.HasBaseAndLength()
               ? std::to_string(value.GetLength()) + "'" +
                     std::string(HdlUtilities::ConvertVerilogBase(value.GetBase()).GetView()) + text
               : text;
}

DesignGraph::Role GetPinRole(const Pin& pin) {
    switch (pin.GetPolarity().GetValue()) {
    case Polarity::Input:
        return DesignGraph::Role::Reads;
    case Polarity::Output:
        return DesignGraph::Role::Drives;
    default:
        return DesignGraph::Role::Both;
    }
}

/// Within the design, an input port drives its net.
DesignGraph::Role GetPortRole(const Signal& signal) {
    switch (signal.GetPortPolarity().GetValue()) {
    case Polarity::Input:
        return DesignGraph::Role::Drives;
    case Polarity::Output:
        return DesignGraph::Role::Reads;
    default:
        return DesignGraph::Role::Both;
    }
}

} // namespace

const Signal& GetWholeSignal(const Signal& signal) {
    const Bus* parent = nullptr;
    if (signal.GetSignalType() == SignalTypeBusSlice) {
        parent = static_cast<const BusSlice&>(signal).GetParentBus();
    } else if (signal.GetSignalType() == SignalTypeBusIndex) {
        parent = static_cast<const BusIndex&>(signal).GetParentBus();
    }
    return parent == nullptr ? signal : *parent;
}

DesignGraph::DesignGraph(const Netlist& netlist) : netlist_(netlist) {
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

std::vector<DesignGraph::Piece> DesignGraph::GetPieces(const Signal& signal) {
    std::vector<Piece> pieces;
    AddPieces(signal, pieces);
    return pieces;
}

void DesignGraph::AddPieces(const Signal& signal, std::vector<Piece>& pieces) {
    if (signal.GetSignalType() == SignalTypeCompoundBus) {
        for (const Signal* member :
             static_cast<const CompoundBus&>(signal).GetBusMemberIterator()) {
            AddPieces(*member, pieces);
        }
        return;
    }
    const std::int64_t start = pieces.empty() ? 0 : pieces.back().end;
    pieces.push_back(
        Piece{&signal, GetOrAddNet(GetWholeSignal(signal)), start, start + signal.GetWidth()});
}

std::size_t DesignGraph::GetOrAddNet(const Signal& signal) {
    const auto [place, isNew] = netIndex_.try_emplace(&signal, nets_.size());
    if (isNew) {
        nets_.emplace_back().signal = &signal;
    }
    return place->second;
}

void DesignGraph::AddBox(const Instance& instance) {
    const std::size_t index = boxes_.size();
    boxIndex_.emplace(&instance, index);
    Box& box = boxes_.emplace_back();
    box.instance = &instance;
    std::size_t number = 0;
    for (const Pin* pin : instance.GetPinIterator()) {
        if (pin->GetSignal() != nullptr) {
            for (const Piece& piece : GetPieces(*pin->GetSignal())) {
                nets_[piece.net].ends.push_back(End{index, number, piece.signal, GetPinRole(*pin)});
                box.wires.push_back(Wire{number, piece.net, piece.signal});
            }
        }
        ++number;
    }
}

void DesignGraph::AddPort(const Signal& signal) {
    nets_[GetOrAddNet(signal)].ends.push_back(End{NoBox, 0, &signal, GetPortRole(signal)});
}

void DesignGraph::AddSources(Signal& signal) {
    const BitVectorValue& constant = signal.GetConstantValue();
    if (!constant.GetValue().IsEmpty()) {
        for (const Piece& piece : GetPieces(signal)) {
            nets_[piece.net].constants.push_back(Constant{GetConstantText(constant), piece.signal});
        }
    }
    for (const Signal* source : signal.GetSignalIterator()) {
        const std::vector<Piece> from = GetPieces(*source);
        AddSource(GetPieces(signal), from);
    }
}

/// Connects the pieces of two signals that share bits when both are counted from the left.
void DesignGraph::AddSource(const std::vector<Piece>& to, const std::vector<Piece>& from) {
    auto first = from.begin();
    for (const Piece& target : to) {
        first = std::find_if(first, from.end(),
                             [&](const Piece& source) { return target.start < source.end; });
        for (auto source = first; source != from.end() && source->start < target.end; ++source) {
            nets_[target.net].sources.push_back(Source{source->net, target.signal});
            nets_[source->net].aliases.push_back(target.net);
        }
    }
}

std::size_t DesignGraph::CountDrawnBoxes() const noexcept {
    return static_cast<std::size_t>(
        std::count_if(boxes_.begin(), boxes_.end(), [](const Box& box) { return box.drawn; }));
}

bool DesignGraph::KeepAround(const std::string& name, int depth) {
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
        for (const Piece& piece : GetPieces(*signal)) {
            Reach(piece.net, true, reached);
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

void DesignGraph::Reach(std::size_t start, bool always, std::vector<std::size_t>& boxes) {
    std::vector<std::size_t> open{start};
    while (!open.empty()) {
        Net& net = nets_[open.back()];
        open.pop_back();
        if (net.drawn || (!always && HasManyEnds(net))) {
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

bool DesignGraph::HasManyEnds(const Net& net) noexcept {
    return net.ends.size() > MostEndsDrawn;
}

DesignGraph::SortedEnds DesignGraph::SortEnds(const Net& net) const {
    SortedEnds sorted;
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
    // A net with only bidirectional ends is drawn from the first of them.
    if (sorted.drivers.empty() && !sorted.hasHiddenDriver && both != nullptr) {
        sorted.drivers.push_back(both);
        std::erase(sorted.readers, both);
    }
    return sorted;
}

bool DesignGraph::NeedsPoint(const Net& net, const SortedEnds& ends) {
    const std::size_t drivers = ends.drivers.size() + (ends.hasHiddenDriver ? 1 : 0) +
                                net.sources.size() + net.constants.size();
    if (drivers != 1 || ends.drivers.empty()) {
        return drivers != 1;
    }
    // The driver of one part of a bus does not drive the other parts.
    const Signal* driven = ends.drivers.front()->part;
    return driven != net.signal &&
           std::any_of(ends.readers.begin(), ends.readers.end(),
                       [&](const End* reader) { return reader->part != driven; });
}

} // namespace Tool
