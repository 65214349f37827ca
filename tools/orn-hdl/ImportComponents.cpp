#include "ImportComponents.h"

#include "ImportReader.h"

#include <algorithm>

namespace Tool::Import {

namespace {

bool LooksReal(const Value& value) noexcept {
    return value.kind == Value::Text && value.text.find('.') != std::string_view::npos &&
           value.text.find_first_not_of("0123456789.+-eE") == std::string_view::npos;
}

bool MayBeInteger(const Value& value) noexcept {
    return value.kind == Value::Bits && value.text.size() == 32;
}

void AppendName(std::string& list, std::string_view name) {
    list.append(list.empty() ? "" : ", ").append(name);
}

} // namespace

const char* GetDirectionName(Direction direction) noexcept {
    switch (direction) {
    case Direction::Input:
        return "Input";
    case Direction::Output:
        return "Output";
    default:
        return "BiDirectional";
    }
}

Components::Components(Design& design, Context& context, NameTable& names)
    : design_(design), context_(context), types_(design.types.size()) {
    for (const Module& module : design.modules) {
        modules_.emplace(module.name, &module);
    }
    const std::vector<Cell>& cells = context.GetTop().cells;
    for (const Cell& cell : cells) {
        CountCell(cell);
    }
    for (Type& type : types_) {
        Settle(type);
    }
    componentOf_.reserve(cells.size());
    for (const Cell& cell : cells) {
        componentOf_.push_back(GetOrAddComponent(cell));
    }
    NameComponents(names);
}

void Components::FindLeaf(std::uint32_t index, const Cell& firstCell) {
    Type& type = types_[index];
    CellType& cellType = design_.types[index];
    type.firstCell = &firstCell;
    const auto module = modules_.find(cellType.name);
    if (module == modules_.end()) {
        return;
    }
    if (!IsLeaf(*module->second)) {
        Fail(context_.GetPath("cells", firstCell.name).AddKey("type"),
             "\"" + std::string(cellType.name) +
                 "\" is a module with contents; flatten the design first");
    }
    type.leaf = module->second;
    for (const ModulePort& port : type.leaf->ports) {
        const std::uint32_t pin = cellType.GetOrAddPin(port.name);
        cellType.pins[pin].direction = port.direction;
        type.pins.resize(cellType.pins.size());
        type.pins[pin].port = &port;
        type.pins[pin].width = port.bits.count;
    }
    for (const NamedValue& value : type.leaf->defaults) {
        Parameter& parameter = type.parameters.emplace_back();
        parameter.name = value.name;
        parameter.defaultValue = &value.value;
        type.parameterIndex.emplace(value.name,
                                    static_cast<std::uint32_t>(type.parameters.size() - 1));
    }
}

void Components::CountCell(const Cell& cell) {
    Type& type = types_[cell.type];
    if (++type.cells == 1) {
        FindLeaf(cell.type, cell);
        type.pins.resize(design_.types[cell.type].pins.size());
    }
    const Module& top = context_.GetTop();
    for (std::uint32_t i = 0; i < cell.connections.count; ++i) {
        const Connection& connection = top.connections[cell.connections.start + i];
        Pin& pin = type.pins[connection.pin];
        const std::uint32_t width = connection.bits.count;
        if (type.leaf != nullptr && pin.port == nullptr) {
            const CellType& cellType = design_.types[cell.type];
            const std::string_view name = cellType.pins[connection.pin].name;
            Fail(context_.GetPinPath(cell, name),
                 "the module \"" + std::string(cellType.name) + "\" has no such port");
        }
        if (pin.width == 0) {
            pin.width = width;
        }
        pin.varies |= width != 0 && width != pin.width;
    }
    for (std::uint32_t i = 0; i < cell.parameters.count; ++i) {
        const NamedValue& value = top.values[cell.parameters.start + i];
        const auto [place, isNew] = type.parameterIndex.try_emplace(
            value.name, static_cast<std::uint32_t>(type.parameters.size()));
        if (isNew) {
            type.parameters.emplace_back().name = value.name;
        }
        Parameter& parameter = type.parameters[place->second];
        ++parameter.cells;
        if (parameter.first == nullptr) {
            parameter.first = &value.value;
        }
        parameter.kindVaries |= parameter.first->kind != value.value.kind;
    }
}

void Components::Settle(Type& type) {
    for (Pin& pin : type.pins) {
        pin.width = std::max<std::uint32_t>(pin.width, 1);
        type.varies |= pin.varies;
    }
    for (const Parameter& parameter : type.parameters) {
        type.varies |= parameter.cells > 0 && IsPartial(type, parameter);
    }
    if (type.cells > 0) {
        TellLosses(type);
    }
}

void Components::TellLosses(const Type& type) {
    std::string integers;
    std::string reals;
    std::string mixed;
    for (const Parameter& parameter : type.parameters) {
        if (parameter.cells == 0) {
            continue;
        }
        if (MayBeInteger(*parameter.first)) {
            AppendName(integers, parameter.name);
        }
        if (LooksReal(*parameter.first)) {
            AppendName(reals, parameter.name);
        }
        if (parameter.kindVaries) {
            AppendName(mixed, parameter.name);
        }
    }
    const Path path = context_.GetPath("cells", type.firstCell->name).AddKey("parameters");
    if (!integers.empty()) {
        context_.Warn(path, "the file does not tell integers from vectors of 32 bits; written as "
                            "bit vectors: " +
                                integers);
    }
    if (!reals.empty()) {
        context_.Warn(path,
                      "the file does not tell real numbers from texts; written as texts: " + reals);
    }
    if (!mixed.empty()) {
        context_.Warn(path, "other cells of the type have values of another kind, which VHDL does "
                            "not allow: " +
                                mixed);
    }
}

std::vector<std::uint32_t> Components::GetVariant(const Type& type, const Cell& cell) const {
    std::vector<std::uint32_t> variant;
    if (!type.varies) {
        return variant;
    }
    const Module& top = context_.GetTop();
    for (const Pin& pin : type.pins) {
        variant.push_back(pin.width);
    }
    for (std::uint32_t i = 0; i < cell.connections.count; ++i) {
        const Connection& connection = top.connections[cell.connections.start + i];
        if (connection.bits.count > 0) {
            variant[connection.pin] = connection.bits.count;
        }
    }
    variant.resize(type.pins.size() + type.parameters.size());
    for (std::uint32_t i = 0; i < cell.parameters.count; ++i) {
        const std::string_view name = top.values[cell.parameters.start + i].name;
        const std::uint32_t index = type.parameterIndex.find(name)->second;
        variant[type.pins.size() + index] = IsPartial(type, type.parameters[index]) ? 1 : 0;
    }
    return variant;
}

std::uint32_t Components::GetOrAddComponent(const Cell& cell) {
    Type& type = types_[cell.type];
    const std::vector<std::uint32_t> variant = GetVariant(type, cell);
    const auto [place, isNew] =
        type.components.try_emplace(variant, static_cast<std::uint32_t>(components_.size()));
    if (isNew) {
        AddComponent(cell.type, variant, cell);
    }
    return place->second;
}

void Components::AddComponent(std::uint32_t index, const std::vector<std::uint32_t>& variant,
                              const Cell& cell) {
    const Type& type = types_[index];
    const CellType& cellType = design_.types[index];
    Component& component = components_.emplace_back();
    component.oldName = cellType.name;
    component.firstCell = &cell;
    for (std::size_t i = 0; i < cellType.pins.size(); ++i) {
        AddPin(component, cellType.pins[i], variant.empty() ? type.pins[i].width : variant[i],
               cell);
    }
    AddGenerics(component, type, variant);
    NameParts(component, type);
}

void Components::AddPin(Component& component, const TypePin& typePin, std::uint32_t width,
                        const Cell& cell) {
    ComponentPin& pin = component.pins.emplace_back();
    pin.oldName = typePin.name;
    pin.direction = typePin.direction;
    pin.width = width;
    if (pin.direction == Direction::Untold) {
        context_.Warn(context_.GetPath("cells", cell.name).AddKey("port_directions"),
                      "nothing tells the direction of pin \"" + std::string(pin.oldName) +
                          "\"; taken for inout");
        pin.direction = Direction::InOut;
    }
}

void Components::AddGenerics(Component& component, const Type& type,
                             const std::vector<std::uint32_t>& variant) {
    for (std::size_t i = 0; i < type.parameters.size(); ++i) {
        const Parameter& parameter = type.parameters[i];
        const bool has = parameter.cells > 0 &&
                         (!IsPartial(type, parameter) || variant[type.pins.size() + i] != 0);
        if (!has) {
            continue;
        }
        Generic& generic = component.generics.emplace_back();
        generic.oldName = parameter.name;
        Place place = context_.GetPlace(*component.firstCell, "parameters", parameter.name);
        const Value* value = parameter.first;
        if (NeedsDefault(type, parameter) && parameter.defaultValue != nullptr) {
            value = parameter.defaultValue;
            place = Place{type.leaf->name, "parameter_default_values", "", "", parameter.name};
        }
        context_.CheckParameter(*value, place);
        generic.value = context_.MakeGeneric("", *value);
    }
}

void Components::NameParts(Component& component, const Type& type) {
    // In VHDL, pins and generics share the scope of the component.
    NameTable scope;
    const auto claimAsIs = [&](std::string_view oldName, std::string& name) {
        if (IsLegalName(oldName) && scope.Claim(oldName)) {
            name = oldName;
        }
    };
    const auto claimSimilar = [&](std::string_view part, std::string_view oldName,
                                  std::string& name) {
        if (name.empty()) {
            name = scope.ClaimSimilar(oldName, 'p');
            context_.Warn(context_.GetPlace(*component.firstCell, part, oldName).ToPath(),
                          "no name in both languages; of component \"" +
                              std::string(component.oldName) + "\" called " + name);
        }
    };
    for (ComponentPin& pin : component.pins) {
        claimAsIs(pin.oldName, pin.baseName);
    }
    for (Generic& generic : component.generics) {
        claimAsIs(generic.oldName, generic.value.name);
    }
    for (ComponentPin& pin : component.pins) {
        claimSimilar("connections", pin.oldName, pin.baseName);
    }
    for (Generic& generic : component.generics) {
        claimSimilar("parameters", generic.oldName, generic.value.name);
    }
    for (std::size_t i = 0; i < component.pins.size(); ++i) {
        ComponentPin& pin = component.pins[i];
        const ModulePort* port = type.pins[i].port;
        const Range range = Normalize(port == nullptr ? Range() : port->range, pin.width);
        pin.scalar = pin.width == 1 && range.offset == 0;
        pin.name = pin.scalar ? pin.baseName
                              : MakeBusName(pin.baseName, GetIndex(range, pin.width, pin.width - 1),
                                            GetIndex(range, pin.width, 0));
    }
}

void Components::NameComponents(NameTable& names) {
    for (Component& component : components_) {
        if (IsLegalName(component.oldName) && names.Claim(component.oldName)) {
            component.name = component.oldName;
        }
    }
    for (Component& component : components_) {
        if (!component.name.empty()) {
            continue;
        }
        component.name = names.ClaimSimilar(component.oldName, 'c');
        context_.Warn(context_.GetPath("cells", component.firstCell->name).AddKey("type"),
                      (IsLegalName(component.oldName)
                           ? "other cells of the type have pins of other widths, or parameters "
                             "whose default is not told; this component is called "
                           : "no name in both languages; this component is called ") +
                          component.name);
    }
}

const Generic& Components::GetGeneric(std::size_t cell, std::string_view parameter) const {
    const std::vector<Generic>& generics = GetOf(cell).generics;
    return *std::find_if(generics.begin(), generics.end(),
                         [&](const Generic& generic) { return generic.oldName == parameter; });
}

void Components::Emit(Sink& sink) const {
    for (const Component& component : components_) {
        sink.BeginGroup();
        sink.AddComponent(component.name);
        for (const ComponentPin& pin : component.pins) {
            sink.AddPin(component.name, pin.name, GetDirectionName(pin.direction));
        }
        for (const Generic& generic : component.generics) {
            sink.AddComponentGeneric(component.name, generic.value);
        }
    }
}

} // namespace Tool::Import
