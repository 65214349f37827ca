#include "import/TypeUses.h"

#include "import/DesignUnits.h"
#include "import/TopModule.h"
#include "import/Values.h"

#include <algorithm>
#include <string>

namespace Tool::Import {

namespace {

bool LooksReal(const Value& value) noexcept {
    return value.kind == Value::Text && value.text.find('.') != std::string_view::npos &&
           value.text.find_first_not_of("0123456789.+-eE") == std::string_view::npos;
}

bool MayBeInteger(const Value& value) noexcept {
    return value.kind == Value::Bits && value.text.size() == 32;
}

/// Whether cells have so little in common that a common component would have many parts that its
/// instances leave open: too many in all, and too many for each part that is used.
/// \param parts the parts of the common component.
/// \param used the parts that the cells use, counted over all cells.
constexpr bool HaveLittleInCommon(std::uint64_t cells, std::uint64_t parts,
                                  std::uint64_t used) noexcept {
    constexpr std::uint64_t FewParts = 65536;
    constexpr std::uint64_t MostPartsForEachUsed = 8;
    return cells * parts > FewParts && cells * parts > used * MostPartsForEachUsed;
}

void AppendName(std::string& list, std::string_view name) {
    list.append(list.empty() ? "" : ", ").append(name);
}

class TypeUseCounter {
public:
    TypeUseCounter(ImportedDesign& design, const Module& top, const ImportRules& rules)
        : design_(design), top_(top), rules_(rules), uses_(design.types.size()) {
        // The modules of a design with hierarchy are indexed once.
        for (const Module& module : design.modules) {
            if (rules.units != nullptr) {
                break;
            }
            modules_.emplace(module.name, &module);
        }
    }

    void CountCell(const Cell& cell);
    TypeUses& GetUses() noexcept { return uses_; }

private:
    const Module* FindModule(std::string_view name) const;
    void FindLeaf(std::uint32_t index, const Cell& firstCell);
    static void AddLeaf(TypeUse& type, CellType& cellType, const Module& leaf);
    void CountPins(TypeUse& type, const Cell& cell);
    void CountParameters(TypeUse& type, const Cell& cell);

    ImportedDesign& design_;
    const Module& top_;
    const ImportRules& rules_;
    TypeUses uses_;
    std::unordered_map<std::string_view, const Module*> modules_;
};

void TypeUseCounter::CountCell(const Cell& cell) {
    if (!uses_.Has(cell.type)) {
        TypeUse& added = uses_.Add(cell.type);
        FindLeaf(cell.type, cell);
        added.pins.resize(design_.types[cell.type].pins.size());
    }
    TypeUse& type = uses_[cell.type];
    ++type.cells;
    CountPins(type, cell);
    CountParameters(type, cell);
}

const Module* TypeUseCounter::FindModule(std::string_view name) const {
    if (rules_.units != nullptr) {
        return rules_.units->FindModule(name);
    }
    const auto found = modules_.find(name);
    return found == modules_.end() ? nullptr : found->second;
}

void TypeUseCounter::FindLeaf(std::uint32_t index, const Cell& firstCell) {
    TypeUse& type = uses_[index];
    CellType& cellType = design_.types[index];
    type.firstCell = &firstCell;
    const Module* const module = FindModule(cellType.name);
    if (rules_.units != nullptr) {
        type.unit = rules_.units->Find(index);
    }
    if (type.unit != nullptr) {
        AddLeaf(type, cellType, *module);
        return;
    }
    if (module != nullptr && !IsLeaf(*module)) {
        Fail(top_.GetPath("cells", firstCell.name).AddKey("type"),
             "\"" + std::string(cellType.name) +
                 "\" is a module with contents; flatten the design first");
    }
    if (const Module* cell = rules_.library.Find(cellType.name)) {
        AddLeaf(type, cellType, *cell);
    } else if (module != nullptr) {
        AddLeaf(type, cellType, *module);
    }
}

void TypeUseCounter::AddLeaf(TypeUse& type, CellType& cellType, const Module& leaf) {
    type.leaf = &leaf;
    for (const ModulePort& port : leaf.ports) {
        if (port.isPower && cellType.pinIndex.count(port.name) == 0) {
            continue;
        }
        const std::uint32_t pin = cellType.GetOrAddPin(port.name);
        Direction& direction = cellType.pins[pin].direction;
        const bool isKnown = port.isPower ? direction != Direction::Unspecified
                                          : port.direction == Direction::Unspecified;
        direction = isKnown ? direction : port.direction;
        type.pins.resize(cellType.pins.size());
        type.pins[pin].port = &port;
        type.pins[pin].width = port.bits.count;
    }
    // The parameters of a module that is imported have their values.
    const std::vector<NamedValue> none;
    for (const NamedValue& value : type.unit != nullptr ? none : leaf.defaults) {
        TypeUse::Parameter& parameter = type.parameters.emplace_back();
        parameter.name = value.name;
        parameter.hasDefault = true;
        if (value.value.kind != Value::Expression) {
            parameter.defaultValue = value.value;
        }
        type.parameterIndex.emplace(value.name,
                                    static_cast<std::uint32_t>(type.parameters.size() - 1));
    }
}

void TypeUseCounter::CountPins(TypeUse& type, const Cell& cell) {
    type.connections += cell.connections.count;
    for (std::uint32_t i = 0; i < cell.connections.count; ++i) {
        const Connection& connection = top_.connections[cell.connections.start + i];
        TypeUse::Pin& pin = type.pins[connection.pin];
        const std::uint32_t width = connection.bits.count;
        if (type.leaf != nullptr && pin.port == nullptr) {
            const CellType& cellType = design_.types[cell.type];
            Fail(top_.GetPinPath(cell, cellType.pins[connection.pin].name),
                 "the module \"" + std::string(cellType.name) + "\" has no such port");
        }
        if (type.unit != nullptr && width != 0 && width != pin.width) {
            Fail(top_.GetPinPath(cell, pin.port->name),
                 std::to_string(width) + " bits are connected to a port of " +
                     std::to_string(pin.width) + " bits of the module " +
                     Quote(design_.types[cell.type].name));
        }
        if (pin.width == 0) {
            pin.width = width;
        }
    }
}

void TypeUseCounter::CountParameters(TypeUse& type, const Cell& cell) {
    if (type.unit != nullptr && cell.parameters.count > 0) {
        Fail(top_.GetPath("cells", cell.name).AddKey("parameters"),
             "the parameters of the module " + Quote(design_.types[cell.type].name) +
                 " have their values already; let Yosys copy the module for these (hierarchy)");
    }
    for (std::uint32_t i = 0; i < cell.parameters.count; ++i) {
        const NamedValue& value = top_.values[cell.parameters.start + i];
        const auto [place, isNew] = type.parameterIndex.try_emplace(
            value.name, static_cast<std::uint32_t>(type.parameters.size()));
        if (isNew) {
            type.parameters.emplace_back().name = value.name;
        }
        TypeUse::Parameter& parameter = type.parameters[place->second];
        if (parameter.hasDefault && MeansAny(value.value, rules_.unknown)) {
            continue;
        }
        ++parameter.cells;
        if (parameter.first == nullptr) {
            parameter.first = &value.value;
        }
        parameter.kindVaries |= parameter.first->kind != value.value.kind;
    }
}

/// Gives the defaults of a library the kind of the cells' values: the cells have integers as bits.
/// A default of another kind is unknown.
void AdaptDefaults(TypeUse& type, ImportedDesign& design) {
    if (type.leaf == nullptr || !type.leaf->isLibraryCell) {
        return;
    }
    for (TypeUse::Parameter& parameter : type.parameters) {
        if (parameter.first == nullptr || !parameter.defaultValue ||
            parameter.first->kind == parameter.defaultValue->kind) {
            continue;
        }
        if (parameter.first->kind == Value::Bits &&
            parameter.defaultValue->kind == Value::Integer) {
            const std::string bits =
                MakeIntegerBits(parameter.defaultValue->integer, parameter.first->text.size());
            parameter.defaultValue = Value{Value::Bits, design.Keep(bits), 0};
        } else {
            parameter.defaultValue.reset();
        }
    }
}

/// Cells of an imported module have its ports, and no others that only their directions name.
void CheckPorts(const TypeUse& type, const CellType& cellType, const Module& top) {
    for (std::size_t i = 0; type.unit != nullptr && i < type.pins.size(); ++i) {
        if (type.pins[i].port == nullptr) {
            Fail(top.GetPath("cells", type.firstCell->name).AddKey("type"),
                 "the module \"" + std::string(cellType.name) + "\" has no port " +
                     Quote(cellType.pins[i].name) + ", which the directions of a cell name");
        }
    }
}

/// Determines the common parameters of the components of a type, and how it is split.
void CompareCells(TypeUse& type) {
    for (TypeUse::Pin& pin : type.pins) {
        pin.width = std::max<std::uint32_t>(pin.width, 1);
    }
    std::uint64_t partialParameters = 0;
    std::uint64_t partialValues = 0;
    for (std::uint32_t i = 0; i < type.parameters.size(); ++i) {
        const TypeUse::Parameter& parameter = type.parameters[i];
        if (parameter.cells > 0 && !type.IsPartial(parameter)) {
            type.commonParameters.push_back(i);
        } else {
            partialParameters += parameter.cells > 0 ? 1 : 0;
            partialValues += parameter.cells;
        }
    }
    type.splitsByPins =
        type.leaf == nullptr && HaveLittleInCommon(type.cells, type.pins.size(), type.connections);
    type.splitsByParameters = HaveLittleInCommon(type.cells, partialParameters, partialValues);
}

void WarnOfAmbiguousValues(const TypeUse& type, const Module& top, Warnings& warnings) {
    std::string integers;
    std::string reals;
    std::string mixed;
    for (const TypeUse::Parameter& parameter : type.parameters) {
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
    const JsonPath path = top.GetPath("cells", type.firstCell->name).AddKey("parameters");
    if (!integers.empty()) {
        warnings.Add(path, "the JSON does not distinguish integers from 32-bit vectors; written "
                           "as bit vectors: " +
                               integers);
    }
    if (!reals.empty()) {
        warnings.Add(path, "the JSON does not distinguish real numbers from strings; written as "
                           "strings: " +
                               reals);
    }
    if (!mixed.empty()) {
        warnings.Add(path, "other cells of the type have values of another kind, which VHDL does "
                           "not allow: " +
                               mixed);
    }
}

} // namespace

TypeUses CountTypeUses(ImportedDesign& design, const Module& top, const ImportRules& rules,
                       Warnings& warnings) {
    TypeUseCounter counter(design, top, rules);
    for (const Cell& cell : top.cells) {
        counter.CountCell(cell);
    }
    for (std::uint32_t index = 0; index < counter.GetUses().CountTypes(); ++index) {
        if (!counter.GetUses().Has(index)) {
            continue;
        }
        TypeUse& type = counter.GetUses()[index];
        CheckPorts(type, design.types[index], top);
        AdaptDefaults(type, design);
        CompareCells(type);
        WarnOfAmbiguousValues(type, top, warnings);
    }
    return std::move(counter.GetUses());
}

} // namespace Tool::Import
