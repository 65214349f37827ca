// Which modules of a design use which.
#pragma once

#include "import/ImportedDesign.h"

#include <cstdint>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace Tool::Import {

/// The modules with contents that the cells of a design are of.
class Hierarchy {
public:
    /// \param design must outlive this object.
    explicit Hierarchy(ImportedDesign& design);

    /// The modules with contents, in the order of the file.
    const std::vector<Module*>& GetModules() const noexcept { return modules_; }
    /// The module with contents that cells of a type are of; null if there is none.
    Module* Find(std::uint32_t type) const { return ofType_[type]; }
    /// The module of that name, with or without contents; null if there is none.
    Module* Find(std::string_view name) const;
    /// The modules with contents that no other module has a cell of.
    std::vector<Module*> FindRoots() const;
    /// The given modules and all modules with contents that they use, used ones first.
    /// \throws Error with the chain of modules if one contains itself.
    std::vector<Module*> Order(const std::vector<Module*>& roots) const;

private:
    /// A module that a cell is of.
    struct Use {
        Module* module = nullptr;
        const Cell* cell = nullptr;
    };

    std::vector<Use> GetUses(const Module& module) const;

    std::vector<Module*> modules_;
    std::unordered_map<std::string_view, Module*> byName_;
    /// By the index of the cell type.
    std::vector<Module*> ofType_;
};

} // namespace Tool::Import
