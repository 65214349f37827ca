#include "import/Hierarchy.h"

#include "import/JsonPath.h"
#include "import/TopModule.h"

#include <algorithm>
#include <cstddef>
#include <string>
#include <unordered_set>

namespace Tool::Import {

namespace {

enum class State : std::uint8_t { New, Open, Done };

} // namespace

Hierarchy::Hierarchy(ImportedDesign& design) : ofType_(design.types.size()) {
    for (Module& module : design.modules) {
        byName_.emplace(module.name, &module);
        if (!IsLeaf(module)) {
            modules_.push_back(&module);
        }
    }
    const std::unordered_set<const Module*> withContents(modules_.begin(), modules_.end());
    for (std::size_t type = 0; type < ofType_.size(); ++type) {
        Module* const module = Find(design.types[type].name);
        ofType_[type] = withContents.count(module) != 0 ? module : nullptr;
    }
}

Module* Hierarchy::Find(std::string_view name) const {
    const auto found = byName_.find(name);
    return found == byName_.end() ? nullptr : found->second;
}

/// The modules with contents that a module uses, each once.
std::vector<Hierarchy::Use> Hierarchy::GetUses(const Module& module) const {
    std::vector<Use> uses;
    std::unordered_set<const Module*> known;
    for (const Cell& cell : module.cells) {
        if (Module* const used = Find(cell.type); used != nullptr && known.insert(used).second) {
            uses.push_back({used, &cell});
        }
    }
    return uses;
}

std::vector<Module*> Hierarchy::FindRoots() const {
    std::unordered_set<const Module*> used;
    for (const Module* module : modules_) {
        for (const Use& use : GetUses(*module)) {
            used.insert(use.module);
        }
    }
    std::vector<Module*> roots;
    std::copy_if(modules_.begin(), modules_.end(), std::back_inserter(roots),
                 [&used](const Module* module) { return used.count(module) == 0; });
    return roots;
}

std::vector<Module*> Hierarchy::Order(const std::vector<Module*>& roots) const {
    /// A module on the way from a root to the present one, and what it uses.
    struct Step {
        Module* module = nullptr;
        std::vector<Use> uses;
        std::size_t next = 0;
    };
    std::vector<Module*> order;
    std::unordered_map<const Module*, State> states;
    std::vector<Step> steps;
    const auto enter = [&](Module* module) {
        states[module] = State::Open;
        steps.push_back({module, GetUses(*module)});
    };
    const auto fail = [&steps](const Use& use) {
        std::string chain;
        bool isInside = false;
        for (const Step& step : steps) {
            isInside |= step.module == use.module;
            chain += isInside ? Quote(step.module->name) + " > " : "";
        }
        Fail(steps.back().module->GetPath("cells", use.cell->name).AddKey("type"),
             "the module contains itself: " + chain + Quote(use.module->name));
    };
    for (Module* root : roots) {
        if (states[root] == State::New) {
            enter(root);
        }
        while (!steps.empty()) {
            Step& step = steps.back();
            if (step.next == step.uses.size()) {
                states[step.module] = State::Done;
                order.push_back(step.module);
                steps.pop_back();
                continue;
            }
            const Use use = step.uses[step.next++];
            const State state = states[use.module];
            if (state == State::Open) {
                fail(use);
            } else if (state == State::New) {
                enter(use.module);
            }
        }
    }
    return order;
}

} // namespace Tool::Import
