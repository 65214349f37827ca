#include "import/EmitNetlist.h"

#include "import/SignalReferences.h"
#include "import/Spelling.h"
#include "import/Values.h"

#include <cstddef>
#include <string>
#include <vector>

namespace Tool::Import {

namespace {

class NetlistEmitter {
public:
    NetlistEmitter(const ImportedNetlist& netlist, Sink& sink)
        : netlist_(netlist), top_(netlist.top), owners_(netlist.owners),
          references_(netlist.top, netlist.owners, netlist.unknown), sink_(sink),
          isScalar_(netlist.owners.GetSignals().size()) {}

    void Emit();

private:
    void EmitComponents();
    void EmitSignals();
    void EmitConstantSignal(Bit bit);
    bool IsTied(const ModulePort& port, std::uint32_t i) const;
    void EmitPortBits(const ImportedSignal& signal, std::uint32_t index);
    void EmitPortConstant(const ImportedSignal& signal, std::uint32_t& left);
    void EmitAlias(const ImportedSignal& signal, std::uint32_t& left);
    void EmitCell(std::size_t index);
    void LeaveOutGenerics(const std::string& name, const Cell& cell,
                          const ImportedComponent& component);
    void EmitConnection(const std::string& cell, const ImportedPin& pin, std::uint32_t index);
    void EmitSignal(const std::string& cell, const ImportedPin& pin, const Span& bits);
    void EmitAttributes();
    template <class Add> void ForEachAttribute(const Span& attributes, Add add) const;

    const ImportedNetlist& netlist_;
    const Module& top_;
    const BitOwners& owners_;
    const SignalReferences references_;
    Sink& sink_;
    /// Of each signal. Most pins are connected to such a signal, and these flags stay in the
    /// processor's caches, other than the signals.
    std::vector<bool> isScalar_;
};

void NetlistEmitter::Emit() {
    if (netlist_.hasDontCares) {
        sink_.KeepDontCares();
    }
    sink_.SetName(netlist_.name);
    if (!netlist_.vhdl.configuration) {
        // The leaf cells need not have configurations.
        sink_.SuppressConfiguration();
    }
    if (netlist_.vhdl.ieeeAlone) {
        sink_.NameIeeeAlone();
    }
    if (netlist_.hasOpenInputs) {
        sink_.WireOpenPins();
    }
    EmitComponents();
    EmitSignals();
    sink_.BeginGroup();
    for (std::size_t c = 0; c < top_.cells.size(); ++c) {
        EmitCell(c);
    }
    EmitAttributes();
}

void NetlistEmitter::EmitComponents() {
    for (const ImportedComponent& component : netlist_.components.GetAll()) {
        sink_.BeginGroup();
        sink_.AddComponent(component.name);
        if (netlist_.vhdl.configuration && !component.isUnit) {
            sink_.LeaveUnconfigured(component.name);
        }
        for (const ImportedPin& pin : component.pins) {
            sink_.AddPin(component.name, pin.name, GetDirectionName(pin.direction));
        }
        for (const ImportedGeneric& generic : component.generics) {
            // Verilog declares no components, and a default of theirs would apply to every
            // instance.
            if (!generic.isPartial || netlist_.hasVhdl) {
                sink_.AddComponentGeneric(component.name, generic.value);
            }
        }
    }
}

void NetlistEmitter::EmitSignals() {
    const std::vector<ImportedSignal>& signals = owners_.GetSignals();
    sink_.BeginGroup();
    for (const ImportedSignal& signal : signals) {
        if (signal.port != nullptr) {
            sink_.AddPort(GetFullName(signal), GetDirectionName(signal.port->direction));
        }
    }
    sink_.BeginGroup();
    for (std::size_t i = 0; i < signals.size(); ++i) {
        if (signals[i].port == nullptr) {
            sink_.AddSignal(GetFullName(signals[i]));
        }
        isScalar_[i] = signals[i].IsScalar();
    }
    for (const Bit bit : {Zero, One, Unknown}) {
        EmitConstantSignal(bit);
    }
    for (std::uint32_t index = 0; index < top_.ports.size(); ++index) {
        EmitPortBits(owners_.GetSignals()[index], index);
    }
}

void NetlistEmitter::EmitConstantSignal(Bit bit) {
    if (const ImportedSignal* signal = owners_.GetConstant(bit)) {
        sink_.AssignSignal(signal->name, std::string(1, GetDigit(bit)));
    }
}

/// Whether a bit of a port is a constant. A bit of an inout port that is z stays open.
bool NetlistEmitter::IsTied(const ModulePort& port, std::uint32_t i) const {
    const Bit bit = top_.GetBit(port.bits, i);
    return !IsNet(bit) && (bit != HighImpedance || port.direction != Direction::InOut);
}

/// Connects the bits of a port that the port does not own.
void NetlistEmitter::EmitPortBits(const ImportedSignal& signal, std::uint32_t index) {
    for (std::uint32_t left = signal.width; left-- > 0;) {
        const Bit bit = references_.GetBit(signal.port->bits, left);
        if (IsTied(*signal.port, left)) {
            EmitPortConstant(signal, left);
        } else if (IsNet(bit) && owners_.Get(bit).signal != BitOwner::NoSignal &&
                   (owners_.Get(bit).signal != index || owners_.Get(bit).position != left)) {
            EmitAlias(signal, left);
        }
    }
}

/// \param left the leftmost bit of a run of constants; becomes the rightmost one.
void NetlistEmitter::EmitPortConstant(const ImportedSignal& signal, std::uint32_t& left) {
    const Span& bits = signal.port->bits;
    const std::uint32_t start = left;
    while (left > 0 && IsTied(*signal.port, left - 1)) {
        --left;
    }
    const Span run{bits.start + left, start - left + 1};
    const bool bare = run.count == 1 && (signal.IsScalar() || signal.width > 1);
    sink_.AssignSignal(GetPartName(signal, start, left),
                       MakeConstant(references_.GetDigits(run), bare));
}

/// \param left the leftmost bit of a run with neighbouring owners; becomes the rightmost one.
void NetlistEmitter::EmitAlias(const ImportedSignal& signal, std::uint32_t& left) {
    const Span& bits = signal.port->bits;
    const std::uint32_t start = left;
    const BitOwner first = owners_.Get(references_.GetBit(bits, left));
    BitOwner last = first;
    while (left > 0) {
        const Bit next = references_.GetBit(bits, left - 1);
        if (!IsNet(next) || owners_.Get(next).signal != first.signal ||
            owners_.Get(next).position + 1 != last.position) {
            break;
        }
        last = owners_.Get(next);
        --left;
    }
    const std::string own = GetPartName(signal, start, left);
    const std::string owner =
        GetPartName(owners_.GetSignals()[first.signal], first.position, last.position);
    // An input port that does not own a bit drives the inout port, or the internal signal, that
    // owns it.
    const bool drives = signal.port->direction == Direction::Input;
    sink_.Alias(drives ? owner : own, drives ? own : owner);
}

void NetlistEmitter::EmitCell(std::size_t index) {
    const Cell& cell = top_.cells[index];
    const ImportedComponent& component = netlist_.components.GetOf(index);
    const std::string& name = netlist_.cellNames[index];
    sink_.AddInstance(name, component.name);
    for (std::uint32_t k = 0; k < cell.connections.count; ++k) {
        const std::uint32_t connection = cell.connections.start + k;
        EmitConnection(name, component.GetPin(top_.connections[connection].pin), connection);
    }
    for (std::uint32_t i = 0; i < cell.parameters.count; ++i) {
        const NamedValue& value = top_.values[cell.parameters.start + i];
        if (const ImportedGeneric* generic = component.FindGeneric(value, netlist_.unknown)) {
            sink_.AddInstanceGeneric(
                name, MakeGeneric(generic->value.name, value.value, netlist_.unknown));
        }
    }
    if (component.hasPartialGenerics && netlist_.hasVhdl) {
        LeaveOutGenerics(name, cell, component);
    }
}

/// Leaves out the generics of the component that the cell does not have.
void NetlistEmitter::LeaveOutGenerics(const std::string& name, const Cell& cell,
                                      const ImportedComponent& component) {
    std::vector<bool> isSet(component.generics.size());
    for (std::uint32_t i = 0; i < cell.parameters.count; ++i) {
        const NamedValue& value = top_.values[cell.parameters.start + i];
        if (const ImportedGeneric* generic = component.FindGeneric(value, netlist_.unknown)) {
            isSet[static_cast<std::size_t>(generic - component.generics.data())] = true;
        }
    }
    for (std::size_t i = 0; i < isSet.size(); ++i) {
        if (component.generics[i].isPartial && !isSet[i]) {
            sink_.LeaveOutInstanceGeneric(name, component.generics[i].value);
        }
    }
}

void NetlistEmitter::EmitConnection(const std::string& cell, const ImportedPin& pin,
                                    std::uint32_t index) {
    const Span& bits = top_.connections[index].bits;
    switch (netlist_.connections[index]) {
    case ConnectionKind::Open:
        break;
    case ConnectionKind::Constant:
        sink_.AssignPin(cell, pin.name, MakeConstant(references_.GetDigits(bits), pin.scalar));
        break;
    case ConnectionKind::Signal:
        EmitSignal(cell, pin, bits);
        break;
    }
}

void NetlistEmitter::EmitSignal(const std::string& cell, const ImportedPin& pin, const Span& bits) {
    if (bits.count == 1) {
        const Bit bit = references_.GetBit(bits, 0);
        const std::uint32_t owner = IsNet(bit) ? owners_.Get(bit).signal : BitOwner::NoSignal;
        if (owner != BitOwner::NoSignal && isScalar_[owner]) {
            sink_.ConnectScalar(owner, owners_.GetSignals()[owner].name, cell, pin.name);
            return;
        }
    }
    sink_.Connect(references_.GetReference(bits), cell, pin.name);
}

template <class Add> void NetlistEmitter::ForEachAttribute(const Span& attributes, Add add) const {
    for (std::uint32_t i = 0; i < attributes.count; ++i) {
        const NamedValue& value = top_.values[attributes.start + i];
        add(MakeAttribute(netlist_.attributeNames.at(value.name), value.value));
    }
}

void NetlistEmitter::EmitAttributes() {
    if (netlist_.attributeNames.empty()) {
        return;
    }
    sink_.BeginGroup();
    for (const ImportedSignal& signal : owners_.GetSignals()) {
        if (signal.net != nullptr) {
            const std::string name = GetFullName(signal);
            ForEachAttribute(signal.net->attributes, [&](const TypedValue& value) {
                sink_.AddSignalAttribute(name, value);
            });
        }
    }
    for (std::size_t c = 0; c < top_.cells.size(); ++c) {
        ForEachAttribute(top_.cells[c].attributes, [&](const TypedValue& value) {
            sink_.AddInstanceAttribute(netlist_.cellNames[c], value);
        });
    }
}

} // namespace

void EmitNetlist(const ImportedNetlist& netlist, Sink& sink) {
    NetlistEmitter(netlist, sink).Emit();
}

} // namespace Tool::Import
