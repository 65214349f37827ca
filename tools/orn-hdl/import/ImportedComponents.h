// The components of an imported design, whose instances are its cells.
#pragma once

#include "import/ImportRules.h"
#include "import/ImportedDesign.h"
#include "import/Sink.h"
#include "import/TypeUses.h"
#include "import/UniqueNames.h"
#include "import/UnknownValues.h"
#include "import/Warnings.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <unordered_map>
#include <utility>
#include <vector>

namespace Tool::Import {

struct ImportedPin {
    std::string_view oldName;
    /// Its index in the pins of the type.
    std::uint32_t typePin = 0;
    /// The name without the range.
    std::string baseName;
    /// The name with the range, if the pin has one.
    std::string name;
    Direction direction = Direction::InOut;
    std::uint32_t width = 1;
    bool scalar = true;
};

struct ImportedGeneric {
    std::string_view oldName;
    /// The name, and the value for cells without a value of their own.
    TypedValue value;
    /// Whether the value is the default that the cell type has.
    bool hasDefault = false;
    /// Whether some cells leave it out, although nothing tells the default of the cell type.
    bool isPartial = false;
};

struct ImportedComponent {
    std::string_view oldName;
    /// The index of the type.
    std::uint32_t type = 0;
    /// The first cell that needs it.
    const Cell* firstCell = nullptr;
    std::string name;
    /// Whether it is a module that is imported with the one that has the cells.
    bool isUnit = false;
    /// Whether it only has the pins of the cells that need it.
    bool splitByPins = false;
    /// Whether it only has the parameters of the cells that need it.
    bool splitByParameters = false;
    /// In the order of the type's pins.
    std::vector<ImportedPin> pins;
    std::vector<ImportedGeneric> generics;
    std::unordered_map<std::string_view, std::uint32_t> genericIndex;
    bool hasPartialGenerics = false;

    /// A pin, by its index in the pins of the type.
    const ImportedPin& GetPin(std::uint32_t typePin) const;
    /// The generic for a parameter of a cell; null if the cell leaves the parameter out.
    const ImportedGeneric* FindGeneric(const NamedValue& parameter,
                                       const UnknownValues& unknown) const;
};

/// One component for each type of cell, and further ones where cells of one type differ in the
/// widths of their pins, or have few pins or parameters in common.
class ImportedComponents {
public:
    /// \param components those that the cells need, in the order of the first cell that needs them.
    /// \param componentOf the component of each cell, by its index.
    ImportedComponents(std::vector<ImportedComponent> components,
                       std::vector<std::uint32_t> componentOf) noexcept
        : components_(std::move(components)), componentOf_(std::move(componentOf)) {}

    const std::vector<ImportedComponent>& GetAll() const noexcept { return components_; }
    const ImportedComponent& GetOf(std::size_t cell) const {
        return components_[componentOf_[cell]];
    }

private:
    std::vector<ImportedComponent> components_;
    std::vector<std::uint32_t> componentOf_;
};

/// Checks the cells of a module against the leaf modules of the library and the design, and against
/// the modules that are imported with it, and makes and names their components.
/// \param names the scope that components share with instances and signals.
/// \throws Error if a cell has contents that are not imported, or does not match its module.
ImportedComponents FindComponents(ImportedDesign& design, const Module& top,
                                  const ImportRules& rules, UniqueNames& names, Warnings& warnings);

} // namespace Tool::Import
