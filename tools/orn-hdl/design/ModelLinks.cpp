#include "design/ModelLinks.h"

#include "Orn_Hdl/Model.h"
#include "Orn_Hdl/Model/Netlist.h"
#include "diagnostics/NameKey.h"

#include <algorithm>
#include <unordered_set>

namespace Tool {

ModelLinks::ModelLinks(const std::vector<Orn_Hdl::Model*>& models)
    : models_(models), uses_(models.size()), states_(models.size(), State::New) {
    for (std::size_t i = 0; i < models_.size(); ++i) {
        byName_.emplace(GetNameKey(models_[i]->GetNetlist()->GetNameView()), i);
    }
    for (std::size_t i = 0; i < models_.size(); ++i) {
        FindUses(i);
    }
}

std::optional<std::size_t> ModelLinks::Find(std::string_view name) const {
    const auto found = byName_.find(GetNameKey(name));
    return found == byName_.end() ? std::nullopt : std::optional<std::size_t>(found->second);
}

/// A component without instances is not used.
void ModelLinks::FindUses(std::size_t model) {
    std::unordered_set<const Orn_Hdl::Component*> placed;
    for (const Orn_Hdl::Instance* instance : models_[model]->GetNetlist()->GetInstanceIterator()) {
        placed.insert(instance->GetComponent());
    }
    for (const Orn_Hdl::Component* component :
         models_[model]->GetNetlist()->GetComponentIterator()) {
        if (placed.count(component) == 0) {
            continue;
        }
        if (const std::optional<std::size_t> used = Find(component->GetNameView())) {
            uses_[model].push_back(*used);
        }
    }
}

std::vector<std::size_t> ModelLinks::Order() {
    std::vector<std::size_t> order;
    for (std::size_t i = 0; i < models_.size(); ++i) {
        if (!Visit(i, order)) {
            return {};
        }
    }
    return order;
}

/// Recursion is as deep as the command line is long.
bool ModelLinks::Visit(std::size_t model, std::vector<std::size_t>& order) {
    if (states_[model] == State::Done) {
        return true;
    }
    chain_.push_back(model);
    if (states_[model] == State::Open) {
        chain_.erase(chain_.begin(), std::find(chain_.begin(), chain_.end(), model));
        return false;
    }
    states_[model] = State::Open;
    for (const std::size_t used : uses_[model]) {
        if (!Visit(used, order)) {
            return false;
        }
    }
    states_[model] = State::Done;
    chain_.pop_back();
    order.push_back(model);
    return true;
}

} // namespace Tool
