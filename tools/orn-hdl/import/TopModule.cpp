#include "import/TopModule.h"

#include "import/Hierarchy.h"

#include <algorithm>
#include <string>
#include <vector>

namespace Tool::Import {

namespace {

Module& FindModule(ImportedDesign& design, std::string_view name) {
    for (Module& module : design.modules) {
        if (module.name == name) {
            return module;
        }
    }
    throw Error(std::string("modules: there is no module \"").append(name).append("\""));
}

} // namespace

Module& FindTop(ImportedDesign& design, std::string_view name) {
    if (!name.empty()) {
        return FindModule(design, name);
    }
    std::vector<Module*> marked;
    std::vector<Module*> full;
    for (Module& module : design.modules) {
        if (module.top) {
            marked.push_back(&module);
        }
        if (!module.blackBox) {
            full.push_back(&module);
        }
    }
    if (marked.empty() && full.size() > 1) {
        if (const std::vector<Module*> roots = Hierarchy(design).FindRoots(); roots.size() == 1) {
            return *roots.front();
        }
    }
    const std::vector<Module*>& candidates = marked.empty() ? full : marked;
    if (candidates.size() != 1) {
        throw Error(candidates.empty()
                        ? "modules: there is no module with contents"
                        : "modules: several modules could be the top one; name it with --top");
    }
    return *candidates.front();
}

bool IsLeaf(const Module& module) {
    if (module.blackBox) {
        return true;
    }
    // In a module without cells, an output that shares a bit with another port, or is a constant,
    // is driven by the module.
    std::vector<bool> taken(module.netBits);
    const auto isFree = [&](Bit bit) {
        const bool result = IsNet(bit) && !taken[bit];
        if (result) {
            taken[bit] = true;
        }
        return result;
    };
    return module.cells.empty() &&
           std::all_of(module.ports.begin(), module.ports.end(), [&](const ModulePort& port) {
               const auto first = module.bits.begin() + port.bits.start;
               return std::all_of(first, first + port.bits.count, isFree);
           });
}

} // namespace Tool::Import
