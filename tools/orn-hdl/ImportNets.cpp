#include "ImportNets.h"

#include <algorithm>

namespace Tool::Import {

namespace {

/// Names of the signals that carry constants.
constexpr std::string_view ConstantNames[] = {"const_0", "const_1"};

} // namespace

Nets::Nets(Context& context, const Components& components)
    : context_(context), top_(context.GetTop()), uses_(top_.netBits), homes_(top_.netBits),
      open_(top_.connections.size()) {
    for (const ModulePort& port : top_.ports) {
        portNets_.emplace(port.name, nullptr);
        CountPort(port);
    }
    for (const ModulePort& port : top_.ports) {
        ShareWholePort(port);
    }
    CountPins();
    FindCandidates();
    NeedPins(components);
    AddPorts();
    AddNets(publicNets_);
    AddSharedOutputs();
    AddNets(hiddenNets_);
    AddNamelessBits();
}

void Nets::CountPort(const ModulePort& port) {
    for (std::uint32_t i = 0; i < port.bits.count; ++i) {
        const Bit bit = context_.GetBit(port.bits, i);
        const auto fail = [&](const char* text) {
            Fail(context_.GetPath("ports", port.name).AddKey("bits").AddIndex(i), text);
        };
        if (!IsNet(bit)) {
            if (port.direction == Direction::Input) {
                fail("an input port cannot be a constant");
            }
            const bool open = port.direction == Direction::InOut && bit == HighImpedance;
            if (!open && context_.IsRefused(bit)) {
                Context::Refuse(bit,
                                context_.GetPath("ports", port.name).AddKey("bits").AddIndex(i));
            }
            continue;
        }
        Use& use = uses_[bit];
        switch (port.direction) {
        case Direction::Input:
            if (use.input) {
                fail("two input ports share this bit");
            }
            use.input = true;
            break;
        case Direction::Output:
            use.outputs |= use.output;
            use.output = true;
            break;
        default:
            if (use.inout) {
                fail("two inout ports share this bit");
            }
            use.inout = true;
        }
    }
}

void Nets::ShareWholePort(const ModulePort& port) {
    const auto isShared = [](const Use& use) { return use.outputs && !use.input && !use.inout; };
    bool shared = false;
    ForEachNetBit(port.bits, [&](Use& use) { shared = shared || isShared(use); });
    if (shared) {
        ForEachNetBit(port.bits, [&](Use& use) {
            use.outputs = true;
            use.needed = true;
        });
    }
}

void Nets::CountPins() {
    for (const Connection& connection : top_.connections) {
        ForEachNetBit(connection.bits, [](Use& use) {
            use.pins |= use.pin;
            use.pin = true;
        });
    }
}

void Nets::FindCandidates() {
    for (const Net& net : top_.nets) {
        const auto port = portNets_.find(net.name);
        if (port != portNets_.end()) {
            port->second = &net;
            continue;
        }
        (net.hidden ? hiddenNets_ : publicNets_).push_back({&net, !IsLegalName(net.name)});
        if (!net.hidden) {
            ForEachNetBit(net.bits, [](Use& use) { use.publicName = true; });
        }
    }
    // A name that can stay is best; a wide net keeps buses together.
    const auto isBetter = [](const Candidate& a, const Candidate& b) {
        return a.illegal != b.illegal ? b.illegal : a.net->bits.count > b.net->bits.count;
    };
    std::stable_sort(publicNets_.begin(), publicNets_.end(), isBetter);
    std::stable_sort(hiddenNets_.begin(), hiddenNets_.end(), isBetter);
}

bool Nets::HangsOnNothing(const Span& bits) const {
    for (std::uint32_t i = 0; i < bits.count; ++i) {
        const Bit bit = context_.GetBit(bits, i);
        if (!IsNet(bit)) {
            return false;
        }
        const Use& use = uses_[bit];
        if (use.inout || use.input || use.output || use.pins || use.publicName) {
            return false;
        }
    }
    return true;
}

void Nets::NeedPins(const Components& components) {
    for (std::size_t c = 0; c < top_.cells.size(); ++c) {
        const Cell& cell = top_.cells[c];
        for (std::uint32_t k = 0; k < cell.connections.count; ++k) {
            const std::uint32_t index = cell.connections.start + k;
            const Connection& connection = top_.connections[index];
            const ComponentPin& pin = components.GetOf(c).pins[connection.pin];
            // An input keeps its net, which says that something is read there.
            if (connection.bits.count == 0 ||
                (pin.direction != Direction::Input && HangsOnNothing(connection.bits))) {
                open_[index] = true;
                continue;
            }
            for (std::uint32_t i = 0; i < connection.bits.count; ++i) {
                const Bit bit = context_.GetBit(connection.bits, i);
                if (IsNet(bit)) {
                    uses_[bit].needed = true;
                } else if (context_.IsRefused(bit)) {
                    Context::Refuse(bit, context_.GetPinPath(cell, pin.oldName).AddIndex(i));
                }
            }
        }
    }
}

bool Nets::IsHomeOf(const ModulePort& port, const Use& use) const noexcept {
    switch (port.direction) {
    case Direction::Input:
        return !use.inout;
    case Direction::Output:
        return !use.inout && !use.input && !use.outputs;
    default:
        return true;
    }
}

void Nets::Settle(std::uint32_t index, Bit bit, std::uint32_t position) {
    homes_[bit] = Home{index, position};
    Signal& signal = signals_[index];
    signal.lowest = std::min(signal.lowest, position);
    signal.highest = std::max(signal.highest, position);
}

void Nets::AddPorts() {
    for (const ModulePort& port : top_.ports) {
        const auto index = static_cast<std::uint32_t>(signals_.size());
        Signal& signal = signals_.emplace_back();
        signal.name = port.name;
        signal.port = &port;
        signal.net = portNets_.find(port.name)->second;
        signal.width = port.bits.count;
        Range range = port.range;
        if (range.offset == 0 && !range.upto && signal.net != nullptr) {
            // Older files tell it of the net only.
            range = signal.net->range;
        }
        signal.range = Normalize(range, signal.width);
        if (signal.range.offset != range.offset) {
            context_.Warn(context_.GetPath("ports", port.name),
                          "indices below 0, or beyond 32 bits, cannot be written; counted from 0");
        }
        for (std::uint32_t i = 0; i < port.bits.count; ++i) {
            const Bit bit = context_.GetBit(port.bits, i);
            if (IsNet(bit) && IsHomeOf(port, uses_[bit])) {
                Settle(index, bit, i);
            }
        }
        signal.lowest = 0;
        signal.highest = signal.width - 1;
    }
}

void Nets::AddSignal(Signal signal, const Span& bits) {
    const auto index = static_cast<std::uint32_t>(signals_.size());
    signals_.push_back(std::move(signal));
    Bit last = Zero;
    for (std::uint32_t i = 0; i < bits.count; ++i) {
        const Bit bit = context_.GetBit(bits, i);
        if (IsNet(bit) && uses_[bit].needed && homes_[bit].signal == NoIndex) {
            Settle(index, bit, i);
            last = bit;
        }
    }
    Signal& added = signals_.back();
    if (last == Zero) {
        signals_.pop_back();
    } else if (added.lowest == added.highest && added.width > 1) {
        // One bit is left of the bus.
        added.name.append("_").append(
            std::to_string(GetIndex(added.range, added.width, added.lowest)));
        added.range = Range();
        added.width = 1;
        added.lowest = 0;
        added.highest = 0;
        homes_[last].position = 0;
    }
}

void Nets::AddNets(const std::vector<Candidate>& candidates) {
    for (const Candidate& candidate : candidates) {
        Signal signal;
        signal.name = candidate.net->name;
        signal.net = candidate.net;
        signal.width = candidate.net->bits.count;
        signal.range = Normalize(candidate.net->range, signal.width);
        AddSignal(std::move(signal), candidate.net->bits);
    }
}

void Nets::AddSharedOutputs() {
    // Ports are the first signals.
    for (std::size_t p = 0; p < top_.ports.size(); ++p) {
        Signal signal;
        signal.name.append(top_.ports[p].name).append("_net");
        signal.width = signals_[p].width;
        signal.range = signals_[p].range;
        AddSignal(std::move(signal), top_.ports[p].bits);
    }
}

std::uint32_t Nets::AddScalar(std::string_view name) {
    Signal& signal = signals_.emplace_back();
    signal.name = name;
    signal.lowest = 0;
    return static_cast<std::uint32_t>(signals_.size() - 1);
}

void Nets::AddNamelessBits() {
    for (Bit bit = 0; bit < top_.netBits; ++bit) {
        if (uses_[bit].needed && homes_[bit].signal == NoIndex) {
            homes_[bit] = Home{AddScalar("net_" + std::to_string(bit)), 0};
        }
    }
}

void Nets::ClaimLegalNames(NameTable& names) {
    for (Signal& signal : signals_) {
        signal.named = IsLegalName(signal.name) && names.Claim(signal.name);
    }
}

void Nets::ClaimOtherNames(NameTable& names) {
    for (Signal& signal : signals_) {
        if (!signal.named) {
            signal.name = names.ClaimSimilar(signal.name, 'n');
        }
    }
}

void Nets::NeedConstants(const Span& bits, NameTable& names) {
    for (std::uint32_t i = 0; i < bits.count; ++i) {
        const Bit bit = GetBit(bits, i);
        if (!IsNet(bit) && constants_[bit - Zero] == NoIndex) {
            constants_[bit - Zero] = AddScalar(names.ClaimSimilar(ConstantNames[bit - Zero], 'n'));
        }
    }
}

bool Nets::IsConstant(const Span& bits) const {
    for (std::uint32_t i = 0; i < bits.count; ++i) {
        if (IsNet(GetBit(bits, i))) {
            return false;
        }
    }
    return true;
}

std::string Nets::GetDigits(const Span& bits) const {
    std::string digits;
    for (std::uint32_t i = bits.count; i-- > 0;) {
        digits += GetBit(bits, i) == One ? '1' : '0';
    }
    return digits;
}

std::string Nets::GetText(const Signal& signal, std::uint32_t left, std::uint32_t right) {
    if (signal.IsScalar()) {
        return signal.name;
    }
    const std::int64_t leftIndex = GetIndex(signal.range, signal.width, left);
    if (left == right && signal.lowest != signal.highest) {
        return MakeBitName(signal.name, leftIndex);
    }
    return MakeBusName(signal.name, leftIndex, GetIndex(signal.range, signal.width, right));
}

std::string Nets::GetReference(const Span& bits) const {
    std::string text;
    for (std::uint32_t i = bits.count; i-- > 0;) {
        text.append(text.empty() ? "" : ",");
        const Bit bit = GetBit(bits, i);
        if (bit == Zero || bit == One) {
            const std::uint32_t constant = constants_[bit - Zero];
            text +=
                constant == NoIndex ? std::string(bit == One ? "1" : "0") : signals_[constant].name;
            continue;
        }
        if (!IsNet(bit) || homes_[bit].signal == NoIndex) {
            return "-";
        }
        // The longest run of neighbours of one signal, in either direction.
        const Home first = homes_[bit];
        const Signal& signal = signals_[first.signal];
        std::uint32_t last = first.position;
        std::int64_t step = 0;
        const std::uint32_t start = i;
        for (; i > 0; --i) {
            const Bit next = GetBit(bits, i - 1);
            if (!IsNet(next) || homes_[next].signal != first.signal) {
                break;
            }
            const std::int64_t distance = std::int64_t(homes_[next].position) - last;
            if ((distance != 1 && distance != -1) || (step != 0 && distance != step)) {
                break;
            }
            step = distance;
            last = homes_[next].position;
        }
        if (step == 1 && last - first.position == signal.highest - signal.lowest) {
            // Reversed as a whole, the bus's name would declare it anew: leave the first bit alone.
            i = start;
            last = first.position;
        }
        text += GetText(signal, first.position, last);
    }
    return text;
}

std::vector<std::string_view> Nets::GetNetNames() const {
    std::vector<std::string_view> names(top_.nets.size());
    for (const Signal& signal : signals_) {
        if (signal.net != nullptr) {
            names[static_cast<std::size_t>(signal.net - top_.nets.data())] = signal.name;
        }
    }
    return names;
}

void Nets::Emit(Sink& sink) const {
    sink.BeginGroup();
    for (const Signal& signal : signals_) {
        if (signal.port != nullptr) {
            sink.AddPort(GetFullName(signal), GetDirectionName(signal.port->direction));
        }
    }
    sink.BeginGroup();
    for (const Signal& signal : signals_) {
        if (signal.port == nullptr) {
            sink.AddSignal(GetFullName(signal));
        }
    }
    for (std::size_t digit = 0; digit < 2; ++digit) {
        if (constants_[digit] != NoIndex) {
            sink.AssignSignal(signals_[constants_[digit]].name, digit == 0 ? "0" : "1");
        }
    }
    for (std::uint32_t index = 0; index < top_.ports.size(); ++index) {
        EmitPortBits(sink, signals_[index], index);
    }
}

void Nets::EmitPortBits(Sink& sink, const Signal& signal, std::uint32_t index) const {
    for (std::uint32_t left = signal.width; left-- > 0;) {
        const Bit bit = GetBit(signal.port->bits, left);
        if (bit == Zero || bit == One) {
            EmitConstant(sink, signal, left);
        } else if (IsNet(bit) && (homes_[bit].signal != index || homes_[bit].position != left)) {
            EmitAlias(sink, signal, left);
        }
    }
}

void Nets::EmitConstant(Sink& sink, const Signal& signal, std::uint32_t& left) const {
    const Span& bits = signal.port->bits;
    const std::uint32_t start = left;
    while (left > 0 && (GetBit(bits, left - 1) == Zero || GetBit(bits, left - 1) == One)) {
        --left;
    }
    const Span run{bits.start + left, start - left + 1};
    const bool bare = run.count == 1 && (signal.IsScalar() || signal.width > 1);
    sink.AssignSignal(GetText(signal, start, left), MakeConstant(GetDigits(run), bare));
}

void Nets::EmitAlias(Sink& sink, const Signal& signal, std::uint32_t& left) const {
    const Span& bits = signal.port->bits;
    const std::uint32_t start = left;
    const Home first = homes_[GetBit(bits, left)];
    Home last = first;
    while (left > 0) {
        const Bit next = GetBit(bits, left - 1);
        if (!IsNet(next) || homes_[next].signal != first.signal ||
            homes_[next].position + 1 != last.position) {
            break;
        }
        last = homes_[next];
        --left;
    }
    const std::string own = GetText(signal, start, left);
    const std::string home = GetText(signals_[first.signal], first.position, last.position);
    // A bit of an input port has its home elsewhere only when an inout port follows it.
    const bool drives = signal.port->direction == Direction::Input;
    sink.Alias(drives ? home : own, drives ? own : home);
}

} // namespace Tool::Import
