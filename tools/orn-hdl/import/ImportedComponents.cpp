#include "import/ImportedComponents.h"

#include "import/DesignUnits.h"
#include "import/NameRules.h"
#include "import/Spelling.h"
#include "import/Values.h"

#include <algorithm>
#include <cstddef>
#include <iterator>
#include <map>
#include <unordered_set>
#include <utility>

namespace Tool::Import {

namespace {

/// The differences of a component from others of its type, as sorted numbers: `PinKey` for pins
/// whose width is not the type's (for all pins of a type that is split by pins), then
/// `ParameterKey` for parameters that other cells lack, in a type that is split by them. Only parts
/// of the cell itself are included, so that the cost of a cell depends only on its own size.
using Variant = std::vector<std::uint64_t>;

constexpr std::uint64_t PinKey(std::uint32_t pin, std::uint32_t width) noexcept {
    return std::uint64_t(pin) << 32 | width;
}

constexpr std::uint64_t ParameterBit = std::uint64_t(1) << 63;

constexpr std::uint64_t ParameterKey(std::uint32_t parameter) noexcept {
    return ParameterBit | parameter;
}

constexpr std::uint32_t GetPinOf(std::uint64_t key) noexcept {
    return static_cast<std::uint32_t>(key >> 32);
}

constexpr std::uint32_t GetWidthOf(std::uint64_t key) noexcept {
    return static_cast<std::uint32_t>(key);
}

/// What the cells of a component have in common.
struct ComponentUse {
    std::uint32_t type = 0;
    std::uint32_t cells = 0;
    /// For each parameter that other cells of the type lack and that has no known default, the
    /// number of cells that have it. Each set is no larger than what the component's own cells
    /// have, whatever others have.
    std::map<std::uint32_t, std::uint32_t> partialParameters;
};

class ComponentFinder {
public:
    ComponentFinder(const ImportedDesign& design, const Module& top, const TypeUses& types,
                    const UnknownValues& unknown, const NameRules& rules, Warnings& warnings)
        : design_(design), top_(top), types_(types), unknown_(unknown), rules_(rules),
          warnings_(warnings), variants_(types.CountUses()) {}

    /// The component of a cell. Its generics are added later.
    std::uint32_t GetOrAdd(const Cell& cell);
    /// Adds the generics and names the parts of all components.
    void Finish();
    std::vector<ImportedComponent>& GetComponents() noexcept { return components_; }

private:
    void CountParameters(ComponentUse& use, const Cell& cell) const;
    /// Whether a cell sets a parameter that others lack.
    bool IsPartial(const TypeUse& type, std::uint32_t parameter, const Value& value) const {
        const TypeUse::Parameter& use = type.parameters[parameter];
        return type.IsPartial(use) && !(use.hasDefault && MeansAny(value, unknown_));
    }
    Variant GetVariant(const TypeUse& type, const Cell& cell) const;
    void Add(std::uint32_t index, const Variant& variant, const Cell& cell);
    void AddPins(ImportedComponent& component, std::uint32_t type, const Variant& variant);
    void AddPin(ImportedComponent& component, const std::vector<TypePin>& pins,
                std::uint32_t typePin, std::uint32_t width);
    void AddGenerics(ImportedComponent& component, const ComponentUse& use);
    ImportedGeneric& AddGeneric(ImportedComponent& component, const TypeUse::Parameter& parameter);
    void SetCommonValue(ImportedGeneric& generic, const ImportedComponent& component,
                        const TypeUse& type, const TypeUse::Parameter& parameter);
    void SetFirstValue(ImportedGeneric& generic, const ImportedComponent& component,
                       const TypeUse::Parameter& parameter);
    void NameParts(ImportedComponent& component, const TypeUse& type);
    static void NamePins(ImportedComponent& component, const TypeUse& type);
    void ClaimSimilar(UniqueNames& scope, const ImportedComponent& component, std::string_view part,
                      std::string_view oldName, std::string& name);

    const ImportedDesign& design_;
    const Module& top_;
    const TypeUses& types_;
    const UnknownValues& unknown_;
    const NameRules& rules_;
    Warnings& warnings_;
    std::vector<ImportedComponent> components_;
    /// By the index of the component.
    std::vector<ComponentUse> uses_;
    /// The components of each type, by its place among the uses.
    std::vector<std::map<Variant, std::uint32_t>> variants_;
};

std::uint32_t ComponentFinder::GetOrAdd(const Cell& cell) {
    const Variant variant = GetVariant(types_[cell.type], cell);
    const auto [place, isNew] = variants_[types_.GetPlace(cell.type)].try_emplace(
        variant, static_cast<std::uint32_t>(components_.size()));
    if (isNew) {
        Add(cell.type, variant, cell);
    }
    CountParameters(uses_[place->second], cell);
    return place->second;
}

void ComponentFinder::CountParameters(ComponentUse& use, const Cell& cell) const {
    const TypeUse& type = types_[cell.type];
    ++use.cells;
    for (std::uint32_t i = 0; i < cell.parameters.count; ++i) {
        const NamedValue& value = top_.values[cell.parameters.start + i];
        const std::uint32_t index = type.parameterIndex.find(value.name)->second;
        if (IsPartial(type, index, value.value)) {
            ++use.partialParameters[index];
        }
    }
}

void ComponentFinder::Finish() {
    for (std::size_t c = 0; c < components_.size(); ++c) {
        AddGenerics(components_[c], uses_[c]);
        NameParts(components_[c], types_[uses_[c].type]);
    }
}

Variant ComponentFinder::GetVariant(const TypeUse& type, const Cell& cell) const {
    Variant variant;
    for (std::uint32_t i = 0; i < cell.connections.count; ++i) {
        const Connection& connection = top_.connections[cell.connections.start + i];
        const std::uint32_t usual = type.pins[connection.pin].width;
        const std::uint32_t width = connection.bits.count > 0 ? connection.bits.count : usual;
        if (type.splitsByPins || width != usual) {
            variant.push_back(PinKey(connection.pin, width));
        }
    }
    for (std::uint32_t i = 0; type.splitsByParameters && i < cell.parameters.count; ++i) {
        const NamedValue& value = top_.values[cell.parameters.start + i];
        const std::uint32_t index = type.parameterIndex.find(value.name)->second;
        if (IsPartial(type, index, value.value)) {
            variant.push_back(ParameterKey(index));
        }
    }
    std::sort(variant.begin(), variant.end());
    variant.erase(std::unique(variant.begin(), variant.end()), variant.end());
    return variant;
}

void ComponentFinder::Add(std::uint32_t index, const Variant& variant, const Cell& cell) {
    const TypeUse& type = types_[index];
    ImportedComponent& component = components_.emplace_back();
    component.oldName = design_.types[index].name;
    component.type = index;
    component.isUnit = type.unit != nullptr;
    component.firstCell = &cell;
    component.splitByPins = type.splitsByPins;
    component.splitByParameters = type.splitsByParameters;
    AddPins(component, index, variant);
    uses_.emplace_back().type = index;
}

void ComponentFinder::AddPins(ImportedComponent& component, std::uint32_t type,
                              const Variant& variant) {
    const std::vector<TypePin>& pins = design_.types[type].pins;
    auto key = variant.begin();
    const auto isPin = [&] { return key != variant.end() && *key < ParameterBit; };
    if (component.splitByPins) {
        for (; isPin(); ++key) {
            AddPin(component, pins, GetPinOf(*key), GetWidthOf(*key));
        }
        return;
    }
    for (std::uint32_t pin = 0; pin < pins.size(); ++pin) {
        const bool differs = isPin() && GetPinOf(*key) == pin;
        AddPin(component, pins, pin, differs ? GetWidthOf(*key++) : types_[type].pins[pin].width);
    }
}

void ComponentFinder::AddPin(ImportedComponent& component, const std::vector<TypePin>& pins,
                             std::uint32_t typePin, std::uint32_t width) {
    ImportedPin& pin = component.pins.emplace_back();
    pin.oldName = pins[typePin].name;
    pin.typePin = typePin;
    pin.direction = pins[typePin].direction;
    pin.width = width;
    if (pin.direction == Direction::Unspecified) {
        warnings_.Add(top_.GetPath("cells", component.firstCell->name).AddKey("port_directions"),
                      "the direction of pin " + Quote(pin.oldName) + " is unknown; taken as inout");
        pin.direction = Direction::InOut;
    }
}

void ComponentFinder::AddGenerics(ImportedComponent& component, const ComponentUse& use) {
    const TypeUse& type = types_[use.type];
    std::string unknownDefaults;
    auto partial = use.partialParameters.begin();
    const auto addPartialBefore = [&](std::uint32_t end) {
        for (; partial != use.partialParameters.end() && partial->first < end; ++partial) {
            const TypeUse::Parameter& parameter = type.parameters[partial->first];
            ImportedGeneric& generic = AddGeneric(component, parameter);
            if (partial->second < use.cells) {
                generic.value = MakeNeutralGeneric(*parameter.first);
                generic.isPartial = true;
                component.hasPartialGenerics = true;
                unknownDefaults.append(unknownDefaults.empty() ? "" : ", ").append(parameter.name);
            } else {
                SetFirstValue(generic, component, parameter);
            }
        }
    };
    for (const std::uint32_t index : type.commonParameters) {
        addPartialBefore(index);
        const TypeUse::Parameter& parameter = type.parameters[index];
        SetCommonValue(AddGeneric(component, parameter), component, type, parameter);
    }
    addPartialBefore(static_cast<std::uint32_t>(type.parameters.size()));
    if (!unknownDefaults.empty() && rules_.HasVhdl()) {
        warnings_.Add(top_.GetPath("cells", component.firstCell->name).AddKey("parameters"),
                      "other cells of the type have other parameters, and their defaults are "
                      "unknown; in VHDL they are 0 or empty: " +
                          unknownDefaults);
    }
}

ImportedGeneric& ComponentFinder::AddGeneric(ImportedComponent& component,
                                             const TypeUse::Parameter& parameter) {
    component.genericIndex.emplace(parameter.name,
                                   static_cast<std::uint32_t>(component.generics.size()));
    ImportedGeneric& generic = component.generics.emplace_back();
    generic.oldName = parameter.name;
    generic.hasDefault = parameter.hasDefault;
    return generic;
}

void ComponentFinder::SetCommonValue(ImportedGeneric& generic, const ImportedComponent& component,
                                     const TypeUse& type, const TypeUse::Parameter& parameter) {
    if (!type.NeedsDefault(parameter)) {
        SetFirstValue(generic, component, parameter);
        return;
    }
    const Place place =
        type.leaf->isLibraryCell
            ? top_.GetPlace(*component.firstCell, "parameters", parameter.name)
            : Place{type.leaf->name, "parameter_default_values", "", "", parameter.name};
    CheckParameter(*parameter.defaultValue, place, unknown_, warnings_);
    if (MeansAny(*parameter.defaultValue, unknown_)) {
        WarnOfAny(place, warnings_);
    }
    generic.value = MakeGeneric("", *parameter.defaultValue, unknown_);
}

void ComponentFinder::SetFirstValue(ImportedGeneric& generic, const ImportedComponent& component,
                                    const TypeUse::Parameter& parameter) {
    CheckParameter(*parameter.first,
                   top_.GetPlace(*component.firstCell, "parameters", parameter.name), unknown_,
                   warnings_);
    generic.value = MakeGeneric("", *parameter.first, unknown_);
}

BitRange GetRange(const TypeUse& type, const ImportedPin& pin) noexcept {
    const ModulePort* port = type.pins[pin.typePin].port;
    return Normalize(port == nullptr ? BitRange() : port->range, pin.width);
}

/// \param mayEscape whether an escaped name may be used: the library takes none for a bus.
void ClaimUnchanged(UniqueNames& scope, std::string_view oldName, bool mayEscape,
                    std::string& name) {
    if (scope.ClaimLegal(oldName)) {
        name = oldName;
    } else if (mayEscape) {
        name = scope.ClaimSame(oldName);
    }
}

/// Gives the pins of a module that is imported the names of its ports.
void ComponentFinder::NamePins(ImportedComponent& component, const TypeUse& type) {
    for (ImportedPin& pin : component.pins) {
        const ModulePort* const port = type.pins[pin.typePin].port;
        const ImportedPin& same =
            type.unit->pins[static_cast<std::size_t>(port - type.leaf->ports.data())];
        pin.baseName = same.baseName;
        pin.name = same.name;
        pin.scalar = same.scalar;
    }
}

void ComponentFinder::NameParts(ImportedComponent& component, const TypeUse& type) {
    if (type.unit != nullptr) {
        NamePins(component, type);
        return;
    }
    // In VHDL, pins and generics share the scope of the component.
    UniqueNames scope(rules_);
    UniqueNames verilogGenerics(rules_);
    UniqueNames& genericScope = rules_.MayEscape() ? verilogGenerics : scope;
    for (ImportedPin& pin : component.pins) {
        const BitRange range = GetRange(type, pin);
        pin.scalar = pin.width == 1 && range.offset == 0;
        ClaimUnchanged(scope, pin.oldName, pin.scalar, pin.baseName);
    }
    for (ImportedGeneric& generic : component.generics) {
        // Yosys reads no escaped name in a defparam statement.
        ClaimUnchanged(genericScope, generic.oldName, false, generic.value.name);
    }
    for (ImportedPin& pin : component.pins) {
        ClaimSimilar(scope, component, "connections", pin.oldName, pin.baseName);
    }
    for (ImportedGeneric& generic : component.generics) {
        ClaimSimilar(genericScope, component, "parameters", generic.oldName, generic.value.name);
    }
    for (ImportedPin& pin : component.pins) {
        const BitRange range = GetRange(type, pin);
        pin.name = pin.scalar ? pin.baseName
                              : MakeBusName(pin.baseName, GetIndex(range, pin.width, pin.width - 1),
                                            GetIndex(range, pin.width, 0));
    }
}

/// Renames a pin or generic that could not keep its name.
void ComponentFinder::ClaimSimilar(UniqueNames& scope, const ImportedComponent& component,
                                   std::string_view part, std::string_view oldName,
                                   std::string& name) {
    if (name.empty()) {
        name = scope.ClaimSimilar(oldName, 'p');
        warnings_.Add(top_.GetPlace(*component.firstCell, part, oldName).ToPath(),
                      (rules_.IsLegal(oldName)
                           ? "another pin or parameter has the name " + Quote(oldName)
                           : Quote(oldName) + rules_.GetComplaint()) +
                          "; renamed to " + name + " in component " + Quote(component.oldName));
    }
}

/// The warning for a component that could not keep the name of its type.
std::string MakeWarning(const ImportedComponent& component, const NameRules& rules) {
    if (!rules.IsLegal(component.oldName)) {
        return Quote(component.oldName) + rules.GetComplaint() + "; renamed to " + component.name;
    }
    std::string reason = "other cells of the type have other pin widths";
    if (component.splitByPins) {
        reason = "the cells of the type have few pins in common";
    } else if (component.splitByParameters) {
        reason = "the cells of the type have few parameters in common";
    }
    return reason + "; this component is named " + component.name;
}

void NameComponents(std::vector<ImportedComponent>& components, const Module& top,
                    UniqueNames& names, Warnings& warnings) {
    std::unordered_set<std::string_view> types;
    for (ImportedComponent& component : components) {
        if (types.insert(component.oldName).second) {
            component.name = names.ClaimModule(component.oldName);
        }
    }
    for (ImportedComponent& component : components) {
        if (component.name.empty()) {
            component.name = names.ClaimSimilar(component.oldName, 'c');
            warnings.Add(top.GetPath("cells", component.firstCell->name).AddKey("type"),
                         MakeWarning(component, names.GetRules()));
        }
    }
}

/// Names the components of a module as the other modules do.
void NameSharedComponents(std::vector<ImportedComponent>& components, const Module& top,
                          DesignUnits& units, UniqueNames& names, Warnings& warnings) {
    units.StartModule();
    for (ImportedComponent& component : components) {
        const DesignUnit* const unit = units.Find(component.type);
        const std::string name = unit != nullptr ? unit->name : units.NameComponent(component);
        const std::string_view identifier = NameRules::WithoutEscape(name);
        component.name = names.ClaimModule(identifier);
        const JsonPath path = top.GetPath("cells", component.firstCell->name).AddKey("type");
        if (component.name.empty()) {
            Fail(path, "other objects of the module have the name " + Quote(identifier));
        }
        if (unit == nullptr && identifier != component.oldName) {
            warnings.Add(path, MakeWarning(component, names.GetRules()));
        }
    }
}

} // namespace

const ImportedPin& ImportedComponent::GetPin(std::uint32_t typePin) const {
    if (!splitByPins) {
        return pins[typePin];
    }
    return *std::lower_bound(
        pins.begin(), pins.end(), typePin,
        [](const ImportedPin& pin, std::uint32_t wanted) { return pin.typePin < wanted; });
}

const ImportedGeneric* ImportedComponent::FindGeneric(const NamedValue& parameter,
                                                      const UnknownValues& unknown) const {
    const auto found = genericIndex.find(parameter.name);
    if (found == genericIndex.end()) {
        return nullptr;
    }
    const ImportedGeneric& generic = generics[found->second];
    return generic.hasDefault && MeansAny(parameter.value, unknown) ? nullptr : &generic;
}

ImportedComponents FindComponents(ImportedDesign& design, const Module& top,
                                  const ImportRules& rules, UniqueNames& names,
                                  Warnings& warnings) {
    const TypeUses types = CountTypeUses(design, top, rules, warnings);
    ComponentFinder finder(design, top, types, rules.unknown, names.GetRules(), warnings);
    std::vector<std::uint32_t> componentOf;
    componentOf.reserve(top.cells.size());
    for (const Cell& cell : top.cells) {
        componentOf.push_back(finder.GetOrAdd(cell));
    }
    finder.Finish();
    if (rules.units != nullptr) {
        NameSharedComponents(finder.GetComponents(), top, *rules.units, names, warnings);
    } else {
        NameComponents(finder.GetComponents(), top, names, warnings);
    }
    return ImportedComponents(std::move(finder.GetComponents()), std::move(componentOf));
}

} // namespace Tool::Import
