#include "LegalDesign.h"

#include "Orn_Hdl/LegalNetlist.h"
#include "Orn_Hdl/Model.h"
#include "Orn_Hdl/Model/Netlist.h"
#include "import/NameRules.h"

#include <algorithm>
#include <string_view>

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
    planned_.emplace(name, netlists_.size());
    netlists_.push_back(std::move(legal));
}

/// Gives the components that are models of the design their names and the names of their ports.
void LegalDesign::RenameComponents(Orn_Hdl::Model& model) {
    for (Orn_Hdl::Component* component : model.GetNetlist()->GetComponentIterator()) {
        const auto used = planned_.find(std::string(component->GetNameView()));
        if (used == planned_.end()) {
            continue;
        }
        RenamePins(model, *component, used->second);
        const Orn_Hdl::Netlist& netlist = *models_[used->second]->GetNetlist();
        const std::string name = netlists_[used->second]->GetName(netlist);
        if (name != component->GetNameView()) {
            component->SetName(name);
        }
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
                names.emplace(old, std::move(name));
            }
        }
    }
    const auto rename = [&names](const Orn_Hdl::Iterator<Orn_Hdl::Pin*>& pins) {
        for (Orn_Hdl::Pin* pin : pins) {
            const auto changed = names.find(std::string(pin->GetNameView()));
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
