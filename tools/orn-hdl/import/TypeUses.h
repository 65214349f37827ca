// The uses of cell types in the top module: widths of pins, and parameters.
#pragma once

#include "import/ImportRules.h"
#include "import/ImportedDesign.h"
#include "import/Warnings.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace Tool::Import {

struct DesignUnit;

/// The use of one cell type.
struct TypeUse {
    struct Pin {
        /// The port of the leaf module; null without a leaf module.
        const ModulePort* port = nullptr;
        /// The width in the leaf module if it is known, otherwise that in the first cell that
        /// connects the pin.
        std::uint32_t width = 0;
    };
    struct Parameter {
        std::string_view name;
        /// The value in the first cell that has the parameter.
        const Value* first = nullptr;
        /// Whether the leaf module has a default.
        bool hasDefault = false;
        /// The default, if it is known.
        std::optional<Value> defaultValue;
        /// The number of cells that give the parameter a value.
        std::uint32_t cells = 0;
        /// Whether the values of the cells are of different kinds.
        bool kindVaries = false;
    };

    /// The module that describes the type; null if there is none.
    const Module* leaf = nullptr;
    /// The module, if it is imported with the one that has the cells.
    const DesignUnit* unit = nullptr;
    const Cell* firstCell = nullptr;
    std::uint32_t cells = 0;
    /// By the pin index of the type.
    std::vector<Pin> pins;
    std::vector<Parameter> parameters;
    std::unordered_map<std::string_view, std::uint32_t> parameterIndex;
    /// The number of connections of all cells together.
    std::uint64_t connections = 0;
    /// The indices of the parameters that every component of the type has.
    std::vector<std::uint32_t> commonParameters;
    /// Whether each set of pins needs a component of its own, because almost all pins of the
    /// instances of a common component would be open.
    bool splitsByPins = false;
    /// Whether each set of parameters needs a component of its own, because almost all generics of
    /// the instances of a common component would be left out.
    bool splitsByParameters = false;

    /// Whether some cells take the default of a parameter.
    bool NeedsDefault(const Parameter& parameter) const noexcept { return parameter.cells < cells; }
    /// Whether some cells take a default that the file does not contain.
    bool IsPartial(const Parameter& parameter) const noexcept {
        return NeedsDefault(parameter) && !parameter.defaultValue;
    }
};

/// The uses of the types that a module has cells of. A design has many modules and types, so only
/// those that are used take space.
class TypeUses {
public:
    /// \param types the number of types of the design.
    explicit TypeUses(std::size_t types) : places_(types, NoPlace) {}

    bool Has(std::uint32_t type) const { return places_[type] != NoPlace; }
    /// Adds the use of a type, which may move others.
    TypeUse& Add(std::uint32_t type) {
        places_[type] = static_cast<std::uint32_t>(uses_.size());
        return uses_.emplace_back();
    }
    /// The place of a type among those that are used.
    std::uint32_t GetPlace(std::uint32_t type) const { return places_[type]; }
    /// The use of a type that the module has cells of.
    TypeUse& operator[](std::uint32_t type) { return uses_[places_[type]]; }
    const TypeUse& operator[](std::uint32_t type) const { return uses_[places_[type]]; }
    std::uint32_t CountTypes() const noexcept { return static_cast<std::uint32_t>(places_.size()); }
    std::size_t CountUses() const noexcept { return uses_.size(); }

private:
    static constexpr std::uint32_t NoPlace = 0xFFFFFFFF;

    /// By the index of the type.
    std::vector<std::uint32_t> places_;
    std::vector<TypeUse> uses_;
};

/// The uses of the types that a module has cells of. Adds the ports of leaf modules to
/// the pins of their types. Warns of values whose type the file does not contain.
/// \param rules the cells of its library take the place of black boxes of the design.
/// \throws Error if a cell has contents that are not imported, or does not match its module.
TypeUses CountTypeUses(ImportedDesign& design, const Module& top, const ImportRules& rules,
                       Warnings& warnings);

} // namespace Tool::Import
