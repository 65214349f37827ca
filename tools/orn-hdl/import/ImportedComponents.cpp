#include "import/ImportedComponents.h"

#include "import/LegalNames.h"
#include "import/Spelling.h"
#include "import/Values.h"

#include <algorithm>
#include <map>
#include <utility>

namespace Tool::Import {

namespace {

/// What tells the component of a cell from others of its type: the width of each pin, then for each
/// parameter whether the cell has it. Empty when the type has one component only.
using Variant = std::vector<std::uint32_t>;

class ComponentFinder {
public:
    ComponentFinder(const ImportedDesign& design, const Module& top,
                    const std::vector<TypeUse>& types, const UnknownValues& unknown,
                    Warnings& warnings)
        : design_(design), top_(top), types_(types), unknown_(unknown), warnings_(warnings),
          variants_(types.size()) {}

    std::uint32_t GetOrAdd(const Cell& cell);
    std::vector<ImportedComponent>& GetComponents() noexcept { return components_; }

private:
    Variant GetVariant(const TypeUse& type, const Cell& cell) const;
    void Add(std::uint32_t index, const Variant& variant, const Cell& cell);
    void AddPin(ImportedComponent& component, const TypePin& typePin, std::uint32_t width);
    void AddGenerics(ImportedComponent& component, const TypeUse& type, const Variant& variant);
    void NameParts(ImportedComponent& component, const TypeUse& type);
    void ClaimSimilar(UniqueNames& scope, const ImportedComponent& component, std::string_view part,
                      std::string_view oldName, std::string& name);

    const ImportedDesign& design_;
    const Module& top_;
    const std::vector<TypeUse>& types_;
    const UnknownValues& unknown_;
    Warnings& warnings_;
    std::vector<ImportedComponent> components_;
    /// The components of each type.
    std::vector<std::map<Variant, std::uint32_t>> variants_;
};

std::uint32_t ComponentFinder::GetOrAdd(const Cell& cell) {
    const Variant variant = GetVariant(types_[cell.type], cell);
    const auto [place, isNew] =
        variants_[cell.type].try_emplace(variant, static_cast<std::uint32_t>(components_.size()));
    if (isNew) {
        Add(cell.type, variant, cell);
    }
    return place->second;
}

Variant ComponentFinder::GetVariant(const TypeUse& type, const Cell& cell) const {
    Variant variant;
    if (!type.varies) {
        return variant;
    }
    for (const TypeUse::Pin& pin : type.pins) {
        variant.push_back(pin.width);
    }
    for (std::uint32_t i = 0; i < cell.connections.count; ++i) {
        const Connection& connection = top_.connections[cell.connections.start + i];
        if (connection.bits.count > 0) {
            variant[connection.pin] = connection.bits.count;
        }
    }
    variant.resize(type.pins.size() + type.parameters.size());
    for (std::uint32_t i = 0; i < cell.parameters.count; ++i) {
        const std::string_view name = top_.values[cell.parameters.start + i].name;
        const std::uint32_t index = type.parameterIndex.find(name)->second;
        variant[type.pins.size() + index] = type.IsPartial(type.parameters[index]) ? 1 : 0;
    }
    return variant;
}

void ComponentFinder::Add(std::uint32_t index, const Variant& variant, const Cell& cell) {
    const TypeUse& type = types_[index];
    const CellType& cellType = design_.types[index];
    ImportedComponent& component = components_.emplace_back();
    component.oldName = cellType.name;
    component.firstCell = &cell;
    for (std::size_t i = 0; i < cellType.pins.size(); ++i) {
        AddPin(component, cellType.pins[i], variant.empty() ? type.pins[i].width : variant[i]);
    }
    AddGenerics(component, type, variant);
    NameParts(component, type);
}

void ComponentFinder::AddPin(ImportedComponent& component, const TypePin& typePin,
                             std::uint32_t width) {
    ImportedPin& pin = component.pins.emplace_back();
    pin.oldName = typePin.name;
    pin.direction = typePin.direction;
    pin.width = width;
    if (pin.direction == Direction::Unspecified) {
        warnings_.Add(top_.GetPath("cells", component.firstCell->name).AddKey("port_directions"),
                      "nothing tells the direction of pin \"" + std::string(pin.oldName) +
                          "\"; taken for inout");
        pin.direction = Direction::InOut;
    }
}

void ComponentFinder::AddGenerics(ImportedComponent& component, const TypeUse& type,
                                  const Variant& variant) {
    for (std::size_t i = 0; i < type.parameters.size(); ++i) {
        const TypeUse::Parameter& parameter = type.parameters[i];
        const bool has = parameter.cells > 0 &&
                         (!type.IsPartial(parameter) || variant[type.pins.size() + i] != 0);
        if (!has) {
            continue;
        }
        ImportedGeneric& generic = component.generics.emplace_back();
        generic.oldName = parameter.name;
        Place place = top_.GetPlace(*component.firstCell, "parameters", parameter.name);
        const Value* value = parameter.first;
        if (type.NeedsDefault(parameter) && parameter.defaultValue != nullptr) {
            value = parameter.defaultValue;
            place = Place{type.leaf->name, "parameter_default_values", "", "", parameter.name};
        }
        CheckParameter(*value, place, unknown_, warnings_);
        generic.value = MakeGeneric("", *value, unknown_);
    }
}

void ComponentFinder::NameParts(ImportedComponent& component, const TypeUse& type) {
    // In VHDL, pins and generics share the scope of the component.
    UniqueNames scope;
    const auto claimUnchanged = [&](std::string_view oldName, std::string& name) {
        if (IsLegalName(oldName) && scope.Claim(oldName)) {
            name = oldName;
        }
    };
    for (ImportedPin& pin : component.pins) {
        claimUnchanged(pin.oldName, pin.baseName);
    }
    for (ImportedGeneric& generic : component.generics) {
        claimUnchanged(generic.oldName, generic.value.name);
    }
    for (ImportedPin& pin : component.pins) {
        ClaimSimilar(scope, component, "connections", pin.oldName, pin.baseName);
    }
    for (ImportedGeneric& generic : component.generics) {
        ClaimSimilar(scope, component, "parameters", generic.oldName, generic.value.name);
    }
    for (std::size_t i = 0; i < component.pins.size(); ++i) {
        ImportedPin& pin = component.pins[i];
        const ModulePort* port = type.pins[i].port;
        const BitRange range = Normalize(port == nullptr ? BitRange() : port->range, pin.width);
        pin.scalar = pin.width == 1 && range.offset == 0;
        pin.name = pin.scalar ? pin.baseName
                              : MakeBusName(pin.baseName, GetIndex(range, pin.width, pin.width - 1),
                                            GetIndex(range, pin.width, 0));
    }
}

/// Gives a pin or generic that could not keep its name another one.
void ComponentFinder::ClaimSimilar(UniqueNames& scope, const ImportedComponent& component,
                                   std::string_view part, std::string_view oldName,
                                   std::string& name) {
    if (name.empty()) {
        name = scope.ClaimSimilar(oldName, 'p');
        warnings_.Add(top_.GetPlace(*component.firstCell, part, oldName).ToPath(),
                      "no name in both languages; of component \"" +
                          std::string(component.oldName) + "\" called " + name);
    }
}

void NameComponents(std::vector<ImportedComponent>& components, const Module& top,
                    UniqueNames& names, Warnings& warnings) {
    for (ImportedComponent& component : components) {
        if (IsLegalName(component.oldName) && names.Claim(component.oldName)) {
            component.name = component.oldName;
        }
    }
    for (ImportedComponent& component : components) {
        if (!component.name.empty()) {
            continue;
        }
        component.name = names.ClaimSimilar(component.oldName, 'c');
        warnings.Add(top.GetPath("cells", component.firstCell->name).AddKey("type"),
                     (IsLegalName(component.oldName)
                          ? "other cells of the type have pins of other widths, or parameters "
                            "whose default is not told; this component is called "
                          : "no name in both languages; this component is called ") +
                         component.name);
    }
}

} // namespace

const ImportedGeneric& ImportedComponents::GetGeneric(std::size_t cell,
                                                      std::string_view parameter) const {
    const std::vector<ImportedGeneric>& generics = GetOf(cell).generics;
    return *std::find_if(generics.begin(), generics.end(), [&](const ImportedGeneric& generic) {
        return generic.oldName == parameter;
    });
}

ImportedComponents FindComponents(ImportedDesign& design, const Module& top,
                                  const UnknownValues& unknown, UniqueNames& names,
                                  Warnings& warnings) {
    const std::vector<TypeUse> types = CountTypeUses(design, top, warnings);
    ComponentFinder finder(design, top, types, unknown, warnings);
    std::vector<std::uint32_t> componentOf;
    componentOf.reserve(top.cells.size());
    for (const Cell& cell : top.cells) {
        componentOf.push_back(finder.GetOrAdd(cell));
    }
    NameComponents(finder.GetComponents(), top, names, warnings);
    return ImportedComponents(std::move(finder.GetComponents()), std::move(componentOf));
}

} // namespace Tool::Import
