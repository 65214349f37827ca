#include "design/LegalDesign.h"

#include "Orn_Hdl/LegalNetlist.h"
#include "Orn_Hdl/Model.h"
#include "Orn_Hdl/Model/Netlist.h"
#include "diagnostics/NameKey.h"
#include "import/NameRules.h"

#include <algorithm>
#include <string_view>
#include <utility>

namespace Tool {

namespace {

/// The range of a bus, with its parentheses; empty for a scalar.
std::string_view GetRange(std::string_view name) {
    return name.substr(std::min(name.find('('), name.size()));
}

} // namespace

LegalDesign::LegalDesign(const std::vector<Orn_Hdl::Model*>& models) : models_(models) {
    for (Orn_Hdl::Model* model : models_) {
        Plan(*model);
    }
    FindProblem();
}

LegalDesign::~LegalDesign() = default;

void LegalDesign::Plan(Orn_Hdl::Model& model) {
    const std::string name(model.GetNetlist()->GetNameView());
    RenameComponents(model);
    const auto plan = [&model] {
        return std::make_unique<Orn_Hdl::LegalNetlist>(*model.GetNetlist(), *model.GetOptions());
    };
    std::unique_ptr<Orn_Hdl::LegalNetlist> legal = plan();
    const std::string wanted = legal->GetName(*model.GetNetlist());
    const std::string given =
        names_.ClaimNumbered(wanted, true, [](std::string_view) { return true; });
    if (given != wanted) {
        model.SetName(given);
        legal = plan();
    }
    planned_.emplace(Import::NameRules::WithoutEscape(name), netlists_.size());
    plannedKeys_.emplace(GetNameKey(name), netlists_.size());
    netlists_.push_back(std::move(legal));
}

/// The index of the model that a component is; null if it is none.
const std::size_t* LegalDesign::FindPlanned(const Orn_Hdl::Component& component) const {
    const std::string_view name = component.GetNameView();
    auto found = planned_.find(std::string(Import::NameRules::WithoutEscape(name)));
    if (found != planned_.end()) {
        return &found->second;
    }
    found = plannedKeys_.find(GetNameKey(name));
    return found == plannedKeys_.end() ? nullptr : &found->second;
}

/// Gives the components that are models of the design their names and the names of their ports.
void LegalDesign::RenameComponents(Orn_Hdl::Model& model) {
    std::vector<std::pair<Orn_Hdl::Component*, std::string>> renamed;
    for (Orn_Hdl::Component* component : model.GetNetlist()->GetComponentIterator()) {
        const std::size_t* const used = FindPlanned(*component);
        if (used == nullptr) {
            continue;
        }
        RenamePins(model, *component, *used);
        const std::string name = netlists_[*used]->GetName(*models_[*used]->GetNetlist());
        if (name != component->GetNameView()) {
            renamed.emplace_back(component, name);
        }
    }
    for (const auto& [component, name] : renamed) {
        // The netlist finds a component by the name under which it was added.
        std::unique_ptr<Orn_Hdl::Component> taken = model.GetNetlist()->DetachComponent(component);
        taken->SetName(name);
        model.GetNetlist()->Add(taken.release());
    }
}

void LegalDesign::RenamePins(Orn_Hdl::Model& model, Orn_Hdl::Component& component,
                             std::size_t used) const {
    std::unordered_map<std::string, std::string> names;
    for (const Orn_Hdl::Signal* port : models_[used]->GetNetlist()->GetSignalIterator()) {
        const std::string_view old = port->GetNameView();
        if (port->IsPort()) {
            std::string name = netlists_[used]->GetName(*port).append(GetRange(old));
            if (name != old) {
                names.emplace(GetNameKey(old), std::move(name));
            }
        }
    }
    const auto rename = [&names](const Orn_Hdl::Iterator<Orn_Hdl::Pin*>& pins) {
        for (Orn_Hdl::Pin* pin : pins) {
            const auto changed = names.find(GetNameKey(pin->GetNameView()));
            if (changed != names.end()) {
                pin->SetName(changed->second);
            }
        }
    };
    if (names.empty()) {
        return;
    }
    rename(component.GetPinIterator());
    for (Orn_Hdl::Instance* instance : model.GetNetlist()->GetInstanceIterator()) {
        if (instance->GetComponent() == &component) {
            rename(instance->GetPinIterator());
        }
    }
}

/// A component that is no model of the design, but gets the name of one, would be taken for it.
void LegalDesign::FindProblem() {
    for (std::size_t i = 0; i < models_.size(); ++i) {
        for (const Orn_Hdl::Component* component :
             models_[i]->GetNetlist()->GetComponentIterator()) {
            const std::string name = netlists_[i]->GetName(*component);
            if (name != component->GetNameView() && names_.IsTaken(name)) {
                problem_ = "the component \"" + std::string(component->GetNameView()) +
                           "\" would get the name of the module \"" + name + "\"";
                return;
            }
        }
    }
}

} // namespace Tool
