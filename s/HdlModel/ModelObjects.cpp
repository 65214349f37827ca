// Components, pins, instances and signals of a model: look-ups and declarations.
#include "HdlModel/ModelFailures.h"
#include "HdlModel/Names/Names.h"
#include "HdlModel/Objects/MakePacked.h"
#include "Orn_Hdl/Model.h"
#include "Port/Ascii.h"

#include <optional>

namespace Orn_Hdl {

using Port::ViewOf;

namespace {

Polarity RequireDirection(const Port::TextArgument& text) {
    const std::optional<Polarity> direction = Polarity::Parse(text.GetView());
    if (!direction) {
        FailInModel(__LINE__, "Invalid direction \"%s\".\n", {text.GetView()});
    }
    return *direction;
}

} // namespace

Component* Model::GetComponent(const Port::TextArgument& name) const {
    return GetNetlist()->GetComponent(name);
}

Instance* Model::GetInstance(const Port::TextArgument& name) const {
    return GetNetlist()->GetInstance(name);
}

Signal* Model::GetSignal(const Port::TextArgument& name) const {
    return GetNetlist()->GetSignal(name);
}

Pin* Model::GetPin(const Port::TextArgument& name, const Component* component) const {
    return component == nullptr ? nullptr : component->GetPin(name);
}

Pin* Model::GetPin(const Port::TextArgument& name, const Instance* instance) const {
    return instance == nullptr ? nullptr : instance->GetPin(name);
}

Attribute* Model::GetAttr(const Port::TextArgument& name, const AttributeHolder* holder) const {
    return holder == nullptr ? nullptr : holder->GetAttr(name);
}

bool Model::IsNamedUsed(const char* name) const {
    return GetNetlist()->IsNameUsed(ViewOf(name));
}

bool Model::AddComponent(const Port::TextArgument& name) {
    RequireName(__LINE__, name);
    if (IsNamedUsed(name)) {
        FailInModel(__LINE__, "Identifier \"%s\" already defined.\n", {name.GetView()});
    }
    GetNetlist()->Add(new Component(name));
    SetModifiedFlag(true);
    return true;
}

bool Model::AddPin(const Port::TextArgument& name, const Polarity& polarity,
                   const Port::TextArgument& componentName,
                   const Port::TextArgument& defaultValue) {
    RequireName(__LINE__, name);
    Component* const component = GetComponent(componentName);
    if (component == nullptr) {
        FailInModel(__LINE__, "Component \"%s\" not found.\n", {ViewOf(componentName)});
    }
    if (component->GetPin(name) != nullptr) {
        FailInModel(__LINE__, "Component \"%s\" already has pin \"%s\".\n",
                    {ViewOf(componentName), name.GetView()});
    }
    component->AddPin(name, polarity, defaultValue);
    SetModifiedFlag(true);
    return true;
}

bool Model::AddPin(const Port::TextArgument& name, const Port::TextArgument& direction,
                   const Port::TextArgument& componentName,
                   const Port::TextArgument& defaultValue) {
    return AddPin(name, RequireDirection(direction), componentName, defaultValue);
}

bool Model::AddInstance(const Port::TextArgument& name, const Port::TextArgument& componentName) {
    RequireName(__LINE__, name);
    if (IsNamedUsed(name)) {
        FailInModel(__LINE__, "Identifier \"%s\" already defined.\n", {name.GetView()});
    }
    const Component* const component = GetComponent(componentName);
    if (component == nullptr) {
        FailInModel(__LINE__, "Component \"%s\" not found.\n", {ViewOf(componentName)});
    }
    GetNetlist()->Add(MakePacked<Instance>(name, component).release());
    SetModifiedFlag(true);
    return true;
}

bool Model::AddSignal(const Port::TextArgument& name) {
    DeclareSignal(name);
    SetModifiedFlag(true);
    return true;
}

bool Model::AddPort(const Port::TextArgument& name, const Polarity& polarity) {
    if (!polarity.IsValid()) {
        FailInModel(__LINE__, "Invalid direction \"%s\".\n", {""});
    }
    DeclareSignal(name);
    GetSignal(name)->SetPortPolarity(polarity);
    SetModifiedFlag(true);
    return true;
}

bool Model::AddPort(const Port::TextArgument& name, const Port::TextArgument& direction) {
    return AddPort(name, RequireDirection(direction));
}

void Model::DeclareSignal(const char* name) {
    RequireName(__LINE__, name);
    if (IsNamedUsed(name)) {
        FailInModel(__LINE__, "Identifier \"%s\" already defined.\n", {name});
    }
    Netlist& netlist = *GetNetlist();
    const Names::NormalizedText normalized{std::string_view(name)};
    Names::BusName parsed;
    const bool isBus = Names::ParseBus(normalized.GetView(), parsed);
    if (isBus && netlist.GetParentBus(name) != nullptr) {
        FailInModel(__LINE__, "Signal \"%s\" already declared.\n", {name});
    }
    if (isBus) {
        netlist.Add(new Bus(name));
    } else {
        netlist.Add(MakePacked<ScalarSignal>(name).release());
    }
}

} // namespace Orn_Hdl
