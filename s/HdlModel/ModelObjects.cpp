// Components, pins, instances and signals of a model: look-ups and declarations.
#include "HdlModel/ModelFailures.h"
#include "HdlModel/Names/Names.h"
#include "HdlModel/Objects/MakePacked.h"
#include "Orn_Hdl/Model.h"
#include "Port/Ascii.h"

namespace Orn_Hdl {

using Port::ViewOf;

Component* Model::GetComponent(const char* name) const {
    return GetNetlist()->GetComponent(name);
}

Instance* Model::GetInstance(const char* name) const {
    return GetNetlist()->GetInstance(name);
}

Signal* Model::GetSignal(const char* name) const {
    return GetNetlist()->GetSignal(name);
}

Pin* Model::GetPin(const char* name, const Component* component) const {
    return component == nullptr ? nullptr : component->GetPin(name);
}

Pin* Model::GetPin(const char* name, const Instance* instance) const {
    return instance == nullptr ? nullptr : instance->GetPin(name);
}

Attribute* Model::GetAttr(const char* name, const AttributeHolder* holder) const {
    return holder == nullptr ? nullptr : holder->GetAttr(name);
}

bool Model::IsNamedUsed(const char* name) const {
    return GetNetlist()->IsNameUsed(ViewOf(name));
}

bool Model::AddComponent(const char* name) {
    RequireName(__LINE__, name);
    if (IsNamedUsed(name)) {
        FailInModel(__LINE__, "Identifier \"%s\" already defined.\n", {name});
    }
    GetNetlist()->Add(new Component(name));
    SetModifiedFlag(true);
    return true;
}

bool Model::AddPin(const char* name, const Polarity& polarity, const char* componentName,
                   const char* defaultValue) {
    RequireName(__LINE__, name);
    Component* const component = GetComponent(componentName);
    if (component == nullptr) {
        FailInModel(__LINE__, "Component \"%s\" not found.\n", {ViewOf(componentName)});
    }
    if (component->GetPin(name) != nullptr) {
        FailInModel(__LINE__, "Component \"%s\" already has pin \"%s\".\n",
                    {ViewOf(componentName), name});
    }
    component->AddPin(name, polarity, defaultValue);
    SetModifiedFlag(true);
    return true;
}

bool Model::AddInstance(const char* name, const char* componentName) {
    RequireName(__LINE__, name);
    if (IsNamedUsed(name)) {
        FailInModel(__LINE__, "Identifier \"%s\" already defined.\n", {name});
    }
    const Component* const component = GetComponent(componentName);
    if (component == nullptr) {
        FailInModel(__LINE__, "Component \"%s\" not found.\n", {ViewOf(componentName)});
    }
    GetNetlist()->Add(MakePacked<Instance>(name, component).release());
    SetModifiedFlag(true);
    return true;
}

bool Model::AddSignal(const char* name) {
    DeclareSignal(name);
    SetModifiedFlag(true);
    return true;
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
