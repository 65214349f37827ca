#include "import/BitUses.h"

#include "import/NameRules.h"

namespace Tool::Import {

static_assert(sizeof(BitUse) == 1);

BitUses BitUses::Count(const Module& top, const ImportedComponents& components,
                       const UnknownValues& unknown, const std::vector<std::string>& portNames) {
    BitUses uses(top, unknown);
    for (const ModulePort& port : top.ports) {
        uses.CountPort(port);
    }
    for (const ModulePort& port : top.ports) {
        uses.ShareWholePort(port);
    }
    uses.CountPins();
    for (std::size_t p = 0; p < top.ports.size(); ++p) {
        if (NameRules::IsEscaped(portNames[p])) {
            uses.NeedBitsOf(top.ports[p]);
        }
    }
    uses.CountNames();
    uses.CountConnections(components);
    return uses;
}

void BitUses::CountPort(const ModulePort& port) {
    for (std::uint32_t i = 0; i < port.bits.count; ++i) {
        const Bit bit = top_.GetBit(port.bits, i);
        if (!IsNet(bit)) {
            CheckConstant(port, i);
            continue;
        }
        const auto failIf = [&](bool isShared, const char* text) {
            if (isShared) {
                Fail(top_.GetPath("ports", port.name).AddKey("bits").AddIndex(i), text);
            }
        };
        BitUse& use = uses_[bit];
        switch (port.direction) {
        case Direction::Input:
            failIf(use.input, "two input ports share this bit");
            use.input = true;
            break;
        case Direction::Output:
            use.outputs = CountOneMore(use.outputs);
            break;
        default:
            failIf(use.inout, "two inout ports share this bit");
            use.inout = true;
        }
    }
}

void BitUses::CheckConstant(const ModulePort& port, std::uint32_t i) const {
    const Bit bit = top_.GetBit(port.bits, i);
    const auto path = [&] { return top_.GetPath("ports", port.name).AddKey("bits").AddIndex(i); };
    if (port.direction == Direction::Input) {
        Fail(path(), "an input port cannot be a constant");
    }
    const bool isOpen = port.direction == Direction::InOut && bit == HighImpedance;
    if (!isOpen && unknown_.IsRefused(bit)) {
        UnknownValues::Refuse(bit, path());
    }
}

/// An output port that shares a bit with another one is driven by other signals in all its bits.
void BitUses::ShareWholePort(const ModulePort& port) {
    const auto isShared = [](const BitUse& use) {
        return use.outputs == UseCount::Many && !use.input && !use.inout;
    };
    bool shared = false;
    ForEachNetBit(port.bits, [&](BitUse& use) { shared = shared || isShared(use); });
    if (shared) {
        ForEachNetBit(port.bits, [](BitUse& use) {
            use.outputs = UseCount::Many;
            use.needed = true;
        });
    }
}

void BitUses::CountPins() {
    for (const Connection& connection : top_.connections) {
        ForEachNetBit(connection.bits, [](BitUse& use) { use.pins = CountOneMore(use.pins); });
    }
}

/// What else uses the bits of a port with an escaped name needs a signal for them.
void BitUses::NeedBitsOf(const ModulePort& escapedPort) {
    ForEachNetBit(escapedPort.bits, [&](BitUse& use) {
        const bool hasOtherPort =
            use.inout ||
            (escapedPort.direction == Direction::Input ? use.outputs != UseCount::None : use.input);
        use.needed = use.needed || hasOtherPort || use.pins != UseCount::None;
    });
}

void BitUses::CountNames() {
    std::unordered_set<std::string_view> ports;
    for (const ModulePort& port : top_.ports) {
        ports.insert(port.name);
    }
    for (const Net& net : top_.nets) {
        if (!net.hidden && ports.count(net.name) == 0) {
            ForEachNetBit(net.bits, [](BitUse& use) { use.publicName = true; });
        }
    }
}

void BitUses::CountConnections(const ImportedComponents& components) {
    for (std::size_t c = 0; c < top_.cells.size(); ++c) {
        const Cell& cell = top_.cells[c];
        for (std::uint32_t k = 0; k < cell.connections.count; ++k) {
            const std::uint32_t index = cell.connections.start + k;
            CountConnection(cell, index, components.GetOf(c).GetPin(top_.connections[index].pin));
        }
    }
}

void BitUses::CountConnection(const Cell& cell, std::uint32_t index, const ImportedPin& pin) {
    const Span& bits = top_.connections[index].bits;
    // An input pin keeps its net, which shows that it is a load of the net.
    if (bits.count == 0 || (pin.direction != Direction::Input && !IsUsedElsewhere(bits))) {
        open_[index] = true;
        return;
    }
    for (std::uint32_t i = 0; i < bits.count; ++i) {
        const Bit bit = top_.GetBit(bits, i);
        if (IsNet(bit)) {
            uses_[bit].needed = true;
        } else if (unknown_.IsRefused(bit)) {
            UnknownValues::Refuse(bit, top_.GetPinPath(cell, pin.oldName).AddIndex(i));
        }
    }
}

/// Whether anything but one pin uses a bit of a connection, or a bit is a constant.
bool BitUses::IsUsedElsewhere(const Span& bits) const {
    for (std::uint32_t i = 0; i < bits.count; ++i) {
        const Bit bit = top_.GetBit(bits, i);
        if (!IsNet(bit)) {
            return true;
        }
        const BitUse& use = uses_[bit];
        if (use.inout || use.input || use.outputs != UseCount::None || use.pins == UseCount::Many ||
            use.publicName) {
            return true;
        }
    }
    return false;
}

} // namespace Tool::Import
