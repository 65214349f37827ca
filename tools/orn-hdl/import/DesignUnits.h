// What the modules of a design with hierarchy have to agree on: their names, the names of their
// ports, and those of the leaf cells.
#pragma once

#include "import/BitOwners.h"
#include "import/Hierarchy.h"
#include "import/ImportedComponents.h"
#include "import/ImportedDesign.h"
#include "import/UniqueNames.h"
#include "import/Warnings.h"

#include <cstdint>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace Tool::Import {

/// A module that is imported, as the modules see it that use it.
struct DesignUnit {
    std::string name;
    /// The ports as pins, in the order of the file; empty until the module's names are known.
    std::vector<ImportedPin> pins;
};

class DesignUnits {
public:
    /// Names all modules with contents. Names that can stay do, whatever the order of the file.
    DesignUnits(const ImportedDesign& design, const Hierarchy& hierarchy, const NameRules& rules,
                Warnings& warnings);

    /// The unit that cells of a type are of; null for a leaf cell.
    const DesignUnit* Find(std::uint32_t type) const;
    /// The module of that name, with or without contents; null if there is none.
    const Module* FindModule(std::string_view name) const { return hierarchy_.Find(name); }
    const DesignUnit& Get(const Module& module) const { return units_.at(&module); }
    /// Takes over the names of a module's ports. \param owners those of the module.
    void SetPorts(const Module& module, const BitOwners& owners);

    /// Begins a module: each component of one module needs a name of its own.
    void StartModule() noexcept { ++module_; }
    /// The name of a component for leaf cells, whose pins have their names. Components of several
    /// modules share a name if their pins do not contradict each other.
    std::string NameComponent(const ImportedComponent& component);

private:
    /// A component that several modules may have.
    struct SharedComponent {
        std::string name;
        /// By the old name of the pin.
        std::unordered_map<std::string_view, ImportedPin> pins;
        /// The last module that has it.
        std::uint32_t module = 0;

        bool Matches(const ImportedComponent& component) const;
    };

    void NameUnits(const ImportedDesign& design, Warnings& warnings);

    const Hierarchy& hierarchy_;
    UniqueNames names_;
    std::unordered_map<const Module*, DesignUnit> units_;
    /// By the index of the type: the name of the first component; empty if it cannot be the type's.
    std::vector<std::string> typeNames_;
    std::unordered_map<std::uint32_t, std::vector<SharedComponent>> components_;
    std::uint32_t module_ = 0;
};

} // namespace Tool::Import
