// How the cells of the top module use their types: widths of pins, and parameters.
#pragma once

#include "import/ImportedDesign.h"
#include "import/Warnings.h"

#include <cstdint>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace Tool::Import {

/// The use of one cell type.
struct TypeUse {
    struct Pin {
        /// The port of the leaf module; null without a leaf module.
        const ModulePort* port = nullptr;
        /// The leaf module's width, else that of the first cell that connects the pin.
        std::uint32_t width = 0;
    };
    struct Parameter {
        std::string_view name;
        /// The value of the first cell that has it.
        const Value* first = nullptr;
        /// The value that the leaf module gives; null without one.
        const Value* defaultValue = nullptr;
        /// The number of cells that have it.
        std::uint32_t cells = 0;
        /// Whether the values of the cells are of different kinds.
        bool kindVaries = false;
    };

    /// The module that describes the type; null when the file has none.
    const Module* leaf = nullptr;
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
    /// Whether each set of pins needs a component of its own: with a component that has the pins of
    /// all cells, instances would consist of open pins almost entirely.
    bool splitsByPins = false;

    /// Whether some cells take the default of a parameter.
    bool NeedsDefault(const Parameter& parameter) const noexcept { return parameter.cells < cells; }
    /// Whether some cells take a default that the file does not contain.
    bool IsPartial(const Parameter& parameter) const noexcept {
        return NeedsDefault(parameter) && parameter.defaultValue == nullptr;
    }
};

/// The uses of the types of a design, by the index of the type. Adds the ports of leaf modules to
/// the pins of their types. Warns of values whose type the file does not contain. \throws Error
/// when a cell has contents, or does not fit its leaf module.
std::vector<TypeUse> CountTypeUses(ImportedDesign& design, const Module& top, Warnings& warnings);

} // namespace Tool::Import
