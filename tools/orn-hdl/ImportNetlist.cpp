#include "ImportNetlist.h"

#include "Port/Ascii.h"
#include "Port/File.h"

#include <algorithm>

namespace Tool::Import {

namespace {

/// A field of the name map: what would end it is written as \t, \n or \\.
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

void WriteMapping(Port::Stream& out, std::string_view kind, std::string_view oldName,
                  std::string_view newName) {
    out << kind << "\t" << Escape(oldName) << "\t" << newName << "\n";
}

std::string Join(std::string_view owner, std::string_view name) {
    return std::string(owner).append(".").append(name);
}

} // namespace

Netlist::Netlist(Design& design, Module& top, Context& context)
    : context_(context), top_(top), components_(design, context, names_),
      nets_(context, OpenConstantOutputs(top, context, components_)), cellNames_(top.cells.size()),
      sharesConstants_(top.connections.size()) {
    if (top.hasMemories) {
        context.Warn(Path("modules").AddKey(top.name).AddKey("memories"),
                     "memories are not imported; map them to cells first");
    }
    if (top.ports.empty()) {
        context.Warn(Path("modules").AddKey(top.name).AddKey("ports"),
                     "VHDL does not allow a design without ports");
    }
    CheckParameters();
    NameDesign();
    NameCells();
    SettleConnections();
    NameAttributes();
}

const Components& Netlist::OpenConstantOutputs(Module& top, Context& context,
                                               const Components& components) {
    for (std::size_t c = 0; c < top.cells.size(); ++c) {
        const Cell& cell = top.cells[c];
        for (std::uint32_t k = 0; k < cell.connections.count; ++k) {
            const Connection& connection = top.connections[cell.connections.start + k];
            const ComponentPin& pin = components.GetOf(c).pins[connection.pin];
            for (std::uint32_t i = 0; i < connection.bits.count; ++i) {
                Bit& bit = top.bits[connection.bits.start + i];
                const bool open = pin.direction == Direction::Output
                                      ? !IsNet(bit)
                                      : pin.direction == Direction::InOut && bit == HighImpedance;
                if (!open) {
                    continue;
                }
                if (bit < Unknown) {
                    context.Warn(context.GetPinPath(cell, pin.oldName).AddIndex(i),
                                 "an output pin stands at a constant; left open");
                }
                bit = top.netBits++;
            }
        }
    }
    return components;
}

void Netlist::CheckParameters() {
    for (const Cell& cell : top_.cells) {
        for (std::uint32_t i = 0; i < cell.parameters.count; ++i) {
            const NamedValue& value = top_.values[cell.parameters.start + i];
            context_.CheckParameter(value.value, context_.GetPlace(cell, "parameters", value.name));
        }
    }
}

void Netlist::NameDesign() {
    // Modules and entities share their names with the components only.
    NameTable units;
    for (const Component& component : components_.GetAll()) {
        units.Claim(component.name);
    }
    if (IsLegalName(top_.name) && units.Claim(top_.name)) {
        name_ = top_.name;
    } else {
        name_ = units.ClaimSimilar(top_.name, 'm');
        context_.Warn(Path("modules").AddKey(top_.name),
                      "no name in both languages; the netlist is called " + name_);
    }
    // A signal may hide its entity, but tools warn of it; a port keeps its name all the same.
    if (std::none_of(top_.ports.begin(), top_.ports.end(), [&](const ModulePort& port) {
            return Port::EqualIgnoringCase(port.name, name_);
        })) {
        names_.Claim(name_);
    }
}

void Netlist::NameCells() {
    names_.Reserve(top_.cells.size() + nets_.GetCount());
    nets_.ClaimLegalNames(names_);
    for (std::size_t c = 0; c < top_.cells.size(); ++c) {
        const std::string_view name = top_.cells[c].name;
        if (IsLegalName(name) && names_.Claim(name)) {
            cellNames_[c] = name;
        }
    }
    nets_.ClaimOtherNames(names_);
    for (std::size_t c = 0; c < top_.cells.size(); ++c) {
        if (cellNames_[c].empty()) {
            cellNames_[c] = names_.ClaimSimilar(GetWantedCellName(c), 'u');
        }
    }
}

std::string Netlist::GetWantedCellName(std::size_t cell) const {
    const std::string_view name = top_.cells[cell].name;
    const std::size_t number = name.find_last_not_of("0123456789") + 1;
    // Of a made-up name, what the cell is tells more than which program step made it.
    return top_.cells[cell].hidden && number < name.size()
               ? components_.GetOf(cell).name + "_" + std::string(name.substr(number))
               : std::string(name);
}

void Netlist::SettleConnections() {
    for (std::size_t c = 0; c < top_.cells.size(); ++c) {
        const Cell& cell = top_.cells[c];
        hasOpenInputs_ = hasOpenInputs_ || HasOpenInput(c);
        for (std::uint32_t k = 0; k < cell.connections.count; ++k) {
            const std::uint32_t index = cell.connections.start + k;
            const Connection& connection = top_.connections[index];
            if (nets_.IsOpen(index)) {
                continue;
            }
            const ComponentPin& pin = components_.GetOf(c).pins[connection.pin];
            if (nets_.IsConstant(connection.bits) &&
                names_.Claim(cellNames_[c] + "_" + pin.baseName + "_CONST_SIGNAL")) {
                continue;
            }
            sharesConstants_[index] = nets_.IsConstant(connection.bits);
            nets_.NeedConstants(connection.bits, names_);
        }
    }
}

bool Netlist::HasOpenInput(std::size_t cell) const {
    const std::vector<ComponentPin>& pins = components_.GetOf(cell).pins;
    const auto isInput = [](const ComponentPin& pin) { return pin.direction == Direction::Input; };
    auto open = std::count_if(pins.begin(), pins.end(), isInput);
    const Span& connections = top_.cells[cell].connections;
    for (std::uint32_t k = 0; k < connections.count; ++k) {
        const Connection& connection = top_.connections[connections.start + k];
        open -= isInput(pins[connection.pin]) && !nets_.IsOpen(connections.start + k) ? 1 : 0;
    }
    return open > 0;
}

void Netlist::NameAttributes() {
    // VHDL declares attributes beside the signals; on an instance they stand beside its generics.
    for (const Component& component : components_.GetAll()) {
        for (const Generic& generic : component.generics) {
            names_.Claim(generic.value.name);
        }
    }
    for (const Cell& cell : top_.cells) {
        NameAttributesOf("cells", cell.name, cell.attributes);
    }
    nets_.ForEachNet([&](const std::string&, const Net& net) {
        NameAttributesOf("netnames", net.name, net.attributes);
    });
}

void Netlist::NameAttributesOf(std::string_view table, std::string_view owner,
                               const Span& attributes) {
    for (std::uint32_t i = 0; i < attributes.count; ++i) {
        const NamedValue& value = top_.values[attributes.start + i];
        context_.CheckAttribute(value.value,
                                Place{top_.name, table, owner, "attributes", value.name});
        const auto [place, isNew] = attributeNames_.try_emplace(value.name);
        if (isNew) {
            place->second = names_.ClaimSimilar(value.name, 'a');
        }
    }
}

void Netlist::Emit(Sink& sink) const {
    sink.SetName(name_);
    // Nobody knows whether the leaf cells have configurations.
    sink.SuppressConfiguration();
    if (hasOpenInputs_) {
        sink.WireOpenPins();
    }
    components_.Emit(sink);
    nets_.Emit(sink);
    sink.BeginGroup();
    for (std::size_t c = 0; c < top_.cells.size(); ++c) {
        EmitCell(sink, c);
    }
    EmitAttributes(sink);
}

void Netlist::EmitCell(Sink& sink, std::size_t index) const {
    const Cell& cell = top_.cells[index];
    const Component& component = components_.GetOf(index);
    const std::string& name = cellNames_[index];
    sink.AddInstance(name, component.name);
    for (std::uint32_t k = 0; k < cell.connections.count; ++k) {
        const std::uint32_t place = cell.connections.start + k;
        const Connection& connection = top_.connections[place];
        const ComponentPin& pin = component.pins[connection.pin];
        if (nets_.IsOpen(place)) {
            continue;
        }
        if (nets_.IsConstant(connection.bits) && !sharesConstants_[place]) {
            sink.AssignPin(name, pin.name,
                           MakeConstant(nets_.GetDigits(connection.bits), pin.scalar));
        } else {
            sink.Connect(nets_.GetReference(connection.bits), name, pin.name);
        }
    }
    for (std::uint32_t i = 0; i < cell.parameters.count; ++i) {
        const NamedValue& value = top_.values[cell.parameters.start + i];
        const std::string& generic = components_.GetGeneric(index, value.name).value.name;
        sink.AddInstanceGeneric(name, context_.MakeGeneric(generic, value.value));
    }
}

void Netlist::EmitAttributes(Sink& sink) const {
    if (attributeNames_.empty()) {
        return;
    }
    sink.BeginGroup();
    const auto forEach = [&](const Span& attributes, auto add) {
        for (std::uint32_t i = 0; i < attributes.count; ++i) {
            const NamedValue& value = top_.values[attributes.start + i];
            add(Context::MakeAttribute(attributeNames_.at(value.name), value.value));
        }
    };
    nets_.ForEachNet([&](const std::string& name, const Net& net) {
        forEach(net.attributes,
                [&](const TypedValue& value) { sink.AddSignalAttribute(name, value); });
    });
    for (std::size_t c = 0; c < top_.cells.size(); ++c) {
        forEach(top_.cells[c].attributes,
                [&](const TypedValue& value) { sink.AddInstanceAttribute(cellNames_[c], value); });
    }
}

void Netlist::WriteNameMap(Port::Stream& out) const {
    WriteMapping(out, "module", top_.name, name_);
    for (const Component& component : components_.GetAll()) {
        WriteMapping(out, "component", component.oldName, component.name);
        for (const ComponentPin& pin : component.pins) {
            WriteMapping(out, "pin", Join(component.oldName, pin.oldName),
                         Join(component.name, pin.name));
        }
        for (const Generic& generic : component.generics) {
            WriteMapping(out, "parameter", Join(component.oldName, generic.oldName),
                         Join(component.name, generic.value.name));
        }
    }
    nets_.ForEachPort([&](const std::string& name, const ModulePort& port) {
        WriteMapping(out, "port", port.name, name);
    });
    const std::vector<std::string_view> netNames = nets_.GetNetNames();
    for (std::size_t n = 0; n < top_.nets.size(); ++n) {
        const Net& net = top_.nets[n];
        WriteMapping(out, "net", net.name,
                     netNames[n].empty() ? nets_.GetReference(net.bits) : std::string(netNames[n]));
    }
    for (std::size_t c = 0; c < top_.cells.size(); ++c) {
        WriteMapping(out, "cell", top_.cells[c].name, cellNames_[c]);
    }
}

} // namespace Tool::Import
