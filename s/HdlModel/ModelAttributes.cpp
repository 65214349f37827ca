// Attributes and comments of a model's objects. Which object is meant, and which message is thrown
// when it is not there, is decided in `Require`; what happens to it stands in one function for each
// operation.
#include "HdlModel/ModelFailures.h"
#include "Orn_Hdl/Model.h"
#include "Port/Ascii.h"

namespace Orn_Hdl {

namespace {

using Port::ViewOf;

enum class Kind { Module, Component, Instance, Signal, ComponentPin, InstancePin };

/// An object as an operation names it.
struct ObjectPath {
    Kind kind;
    /// Of the component, instance or signal; of the owner of a pin.
    const char* name = nullptr;
    const char* pin = nullptr;
};

/// An object with its attributes.
struct Holder {
    Object* object = nullptr;
    AttributeHolder* attributes = nullptr;
};

template <class T> Holder HolderOf(T* object) noexcept {
    return {object, object};
}

template <class Owner> Holder PinOf(const Owner* owner, const char* pin) {
    return owner == nullptr ? Holder() : HolderOf(owner->GetPin(pin));
}

Holder Find(Netlist& netlist, const ObjectPath& path) {
    switch (path.kind) {
    case Kind::Component:
        return HolderOf(netlist.GetComponent(path.name));
    case Kind::Instance:
        return HolderOf(netlist.GetInstance(path.name));
    case Kind::Signal:
        return HolderOf(netlist.GetSignal(path.name));
    case Kind::ComponentPin:
        return PinOf(netlist.GetComponent(path.name), path.pin);
    case Kind::InstancePin:
        return PinOf(netlist.GetInstance(path.name), path.pin);
    default:
        return HolderOf(&netlist);
    }
}

Holder Require(Model& model, const ObjectPath& path) {
    const Holder found = Find(*model.GetNetlist(), path);
    if (found.object == nullptr) {
        if (path.kind == Kind::ComponentPin || path.kind == Kind::InstancePin) {
            FailPinNotFound(__LINE__, ViewOf(path.pin));
        }
        FailNotFound(__LINE__, path.name);
    }
    return found;
}

Attribute& RequireAttr(Attribute* attribute, const char* name) {
    if (attribute == nullptr) {
        FailInModel(__LINE__, "Attribute \"%s\" not found.\n", {ViewOf(name)});
    }
    return *attribute;
}

/// An attribute that an instance does not have is looked for on its component.
Attribute& RequireAttr(Model& model, const ObjectPath& path, const char* name) {
    const Holder holder = Require(model, path);
    Attribute* attribute = holder.attributes->GetAttr(name);
    if (attribute == nullptr && path.kind == Kind::Instance) {
        attribute = static_cast<Instance*>(holder.object)->GetComponentAttr(name);
    }
    return RequireAttr(attribute, name);
}

/// Changes an attribute by a text, or throws.
using Operation = void (*)(Attribute& attribute, const char* text);

void SetValue(Attribute& attribute, const char* value) {
    attribute.SetValue(value);
}

void SetGeneric(Attribute& attribute, const char* option) {
    if (!attribute.SetGeneric(option)) {
        FailInModel(__LINE__, "Invalid generic value.\n");
    }
}

void SetSynAttr(Attribute& attribute, const char* option) {
    if (!attribute.SetSynAttr(option)) {
        FailInModel(__LINE__, "Invalid generic value.\n");
    }
}

void SetType(Attribute& attribute, const char* type) {
    auto* const user = dynamic_cast<AttributeUser*>(&attribute);
    if (user == nullptr) {
        FailInModel(__LINE__, "Invalid attribute type.\n");
    }
    user->SetUserType(type);
}

bool Change(Model& model, Operation operation, const ObjectPath& path, const char* attribute,
            const char* text) {
    operation(RequireAttr(model, path, attribute), text);
    model.SetModifiedFlag(true);
    return true;
}

bool Change(Model& model, Operation operation, const AttributeHolder* holder, const char* attribute,
            const char* text) {
    if (holder == nullptr) {
        return false;
    }
    operation(RequireAttr(holder->GetAttr(attribute), attribute), text);
    model.SetModifiedFlag(true);
    return true;
}

bool Add(Model& model, const ObjectPath& path, const char* name, const char* value,
         const char* type) {
    RequireName(__LINE__, name);
    return model.AddAttr(Require(model, path).attributes, name, value, type);
}

bool Comment(Model& model, const ObjectPath& path, const char* text) {
    Require(model, path).object->AddComment(text);
    model.SetModifiedFlag(true);
    return true;
}

} // namespace

bool Model::AddAttr(AttributeHolder* holder, const Port::TextArgument& name,
                    const Port::TextArgument& value, const Port::TextArgument& type) {
    if (holder == nullptr) {
        return false;
    }
    if (Attribute* present = holder->GetAttr(name)) {
        present->SetValue(value);
    } else {
        const auto creator = AttributeFactory::GetCreators().Get(
            type == nullptr ? Attribute::DEFAULT_ATTRTYPE : type.Get());
        if (creator == nullptr) {
            FailInModel(__LINE__, "Invalid attribute type.\n");
        }
        holder->AddAttr(creator(name, value));
    }
    SetModifiedFlag(true);
    return true;
}

bool Model::AddAttr(AttributeHolder* holder, const Port::TextArgument& name,
                    const Port::TextArgument& value, const Port::TextArgument& type,
                    Attribute::GenericOption generic, Attribute::SynAttrOption synAttr) {
    if (!AddAttr(holder, name, value, type)) {
        return false;
    }
    Attribute& attribute = *holder->GetAttr(name);
    attribute.SetGeneric(generic);
    attribute.SetSynAttr(synAttr);
    return true;
}

bool Model::AddModuleAttr(const Port::TextArgument& name, const Port::TextArgument& value,
                          const Port::TextArgument& type) {
    return Add(*this, {Kind::Module}, name, value, type);
}

bool Model::AddComponentAttr(const Port::TextArgument& component, const Port::TextArgument& name,
                             const Port::TextArgument& value, const Port::TextArgument& type) {
    return Add(*this, {Kind::Component, component}, name, value, type);
}

bool Model::AddInstanceAttr(const Port::TextArgument& instance, const Port::TextArgument& name,
                            const Port::TextArgument& value, const Port::TextArgument& type) {
    return Add(*this, {Kind::Instance, instance}, name, value, type);
}

bool Model::AddSignalAttr(const Port::TextArgument& signal, const Port::TextArgument& name,
                          const Port::TextArgument& value, const Port::TextArgument& type) {
    return Add(*this, {Kind::Signal, signal}, name, value, type);
}

bool Model::AddComponentPinAttr(const Port::TextArgument& component, const Port::TextArgument& pin,
                                const Port::TextArgument& name, const Port::TextArgument& value,
                                const Port::TextArgument& type) {
    return Add(*this, {Kind::ComponentPin, component, pin}, name, value, type);
}

bool Model::AddInstancePinAttr(const Port::TextArgument& instance, const Port::TextArgument& pin,
                               const Port::TextArgument& name, const Port::TextArgument& value,
                               const Port::TextArgument& type) {
    return Add(*this, {Kind::InstancePin, instance, pin}, name, value, type);
}

bool Model::SetAttrValue(AttributeHolder* holder, const Port::TextArgument& attribute,
                         const Port::TextArgument& value) {
    return Change(*this, SetValue, holder, attribute, value);
}

bool Model::SetModuleAttrValue(const Port::TextArgument& attribute,
                               const Port::TextArgument& value) {
    return Change(*this, SetValue, {Kind::Module}, attribute, value);
}

bool Model::SetComponentAttrValue(const Port::TextArgument& component,
                                  const Port::TextArgument& attribute,
                                  const Port::TextArgument& value) {
    return Change(*this, SetValue, {Kind::Component, component}, attribute, value);
}

bool Model::SetInstanceAttrValue(const Port::TextArgument& instance,
                                 const Port::TextArgument& attribute,
                                 const Port::TextArgument& value) {
    return Change(*this, SetValue, {Kind::Instance, instance}, attribute, value);
}

bool Model::SetSignalAttrValue(const Port::TextArgument& signal,
                               const Port::TextArgument& attribute,
                               const Port::TextArgument& value) {
    return Change(*this, SetValue, {Kind::Signal, signal}, attribute, value);
}

bool Model::SetComponentPinAttrValue(const Port::TextArgument& component,
                                     const Port::TextArgument& pin,
                                     const Port::TextArgument& attribute,
                                     const Port::TextArgument& value) {
    return Change(*this, SetValue, {Kind::ComponentPin, component, pin}, attribute, value);
}

bool Model::SetInstancePinAttrValue(const Port::TextArgument& instance,
                                    const Port::TextArgument& pin,
                                    const Port::TextArgument& attribute,
                                    const Port::TextArgument& value) {
    return Change(*this, SetValue, {Kind::InstancePin, instance, pin}, attribute, value);
}

bool Model::SetGenericAttrValue(AttributeHolder* holder, const Port::TextArgument& attribute,
                                const Port::TextArgument& value) {
    return Change(*this, SetGeneric, holder, attribute, value);
}

bool Model::SetModuleGenericAttrValue(const Port::TextArgument& attribute,
                                      const Port::TextArgument& value) {
    return Change(*this, SetGeneric, {Kind::Module}, attribute, value);
}

bool Model::SetComponentGenericAttrValue(const Port::TextArgument& component,
                                         const Port::TextArgument& attribute,
                                         const Port::TextArgument& value) {
    return Change(*this, SetGeneric, {Kind::Component, component}, attribute, value);
}

bool Model::SetInstanceGenericAttrValue(const Port::TextArgument& instance,
                                        const Port::TextArgument& attribute,
                                        const Port::TextArgument& value) {
    return Change(*this, SetGeneric, {Kind::Instance, instance}, attribute, value);
}

bool Model::SetSignalGenericAttrValue(const Port::TextArgument& signal,
                                      const Port::TextArgument& attribute,
                                      const Port::TextArgument& value) {
    return Change(*this, SetGeneric, {Kind::Signal, signal}, attribute, value);
}

bool Model::SetComponentPinGenericAttrValue(const Port::TextArgument& component,
                                            const Port::TextArgument& pin,
                                            const Port::TextArgument& attribute,
                                            const Port::TextArgument& value) {
    return Change(*this, SetGeneric, {Kind::ComponentPin, component, pin}, attribute, value);
}

bool Model::SetInstancePinGenericAttrValue(const Port::TextArgument& instance,
                                           const Port::TextArgument& pin,
                                           const Port::TextArgument& attribute,
                                           const Port::TextArgument& value) {
    return Change(*this, SetGeneric, {Kind::InstancePin, instance, pin}, attribute, value);
}

bool Model::SetSynAttrValue(AttributeHolder* holder, const Port::TextArgument& attribute,
                            const Port::TextArgument& value) {
    return Change(*this, SetSynAttr, holder, attribute, value);
}

bool Model::SetModuleSynAttrValue(const Port::TextArgument& attribute,
                                  const Port::TextArgument& value) {
    return Change(*this, SetSynAttr, {Kind::Module}, attribute, value);
}

bool Model::SetComponentSynAttrValue(const Port::TextArgument& component,
                                     const Port::TextArgument& attribute,
                                     const Port::TextArgument& value) {
    return Change(*this, SetSynAttr, {Kind::Component, component}, attribute, value);
}

bool Model::SetInstanceSynAttrValue(const Port::TextArgument& instance,
                                    const Port::TextArgument& attribute,
                                    const Port::TextArgument& value) {
    return Change(*this, SetSynAttr, {Kind::Instance, instance}, attribute, value);
}

bool Model::SetSignalSynAttrValue(const Port::TextArgument& signal,
                                  const Port::TextArgument& attribute,
                                  const Port::TextArgument& value) {
    return Change(*this, SetSynAttr, {Kind::Signal, signal}, attribute, value);
}

bool Model::SetComponentPinSynAttrValue(const Port::TextArgument& component,
                                        const Port::TextArgument& pin,
                                        const Port::TextArgument& attribute,
                                        const Port::TextArgument& value) {
    return Change(*this, SetSynAttr, {Kind::ComponentPin, component, pin}, attribute, value);
}

bool Model::SetInstancePinSynAttrValue(const Port::TextArgument& instance,
                                       const Port::TextArgument& pin,
                                       const Port::TextArgument& attribute,
                                       const Port::TextArgument& value) {
    return Change(*this, SetSynAttr, {Kind::InstancePin, instance, pin}, attribute, value);
}

bool Model::SetUserType(AttributeHolder* holder, const Port::TextArgument& attribute,
                        const Port::TextArgument& type) {
    return Change(*this, SetType, holder, attribute, type);
}

bool Model::SetModuleUserType(const Port::TextArgument& attribute, const Port::TextArgument& type) {
    return Change(*this, SetType, {Kind::Module}, attribute, type);
}

bool Model::SetComponentUserType(const Port::TextArgument& component,
                                 const Port::TextArgument& attribute,
                                 const Port::TextArgument& type) {
    return Change(*this, SetType, {Kind::Component, component}, attribute, type);
}

bool Model::SetInstanceUserType(const Port::TextArgument& instance,
                                const Port::TextArgument& attribute,
                                const Port::TextArgument& type) {
    return Change(*this, SetType, {Kind::Instance, instance}, attribute, type);
}

bool Model::SetSignalUserType(const Port::TextArgument& signal, const Port::TextArgument& attribute,
                              const Port::TextArgument& type) {
    return Change(*this, SetType, {Kind::Signal, signal}, attribute, type);
}

bool Model::SetComponentPinUserType(const Port::TextArgument& component,
                                    const Port::TextArgument& pin,
                                    const Port::TextArgument& attribute,
                                    const Port::TextArgument& type) {
    return Change(*this, SetType, {Kind::ComponentPin, component, pin}, attribute, type);
}

bool Model::SetInstancePinUserType(const Port::TextArgument& instance,
                                   const Port::TextArgument& pin,
                                   const Port::TextArgument& attribute,
                                   const Port::TextArgument& type) {
    return Change(*this, SetType, {Kind::InstancePin, instance, pin}, attribute, type);
}

bool Model::AddNotes(const Port::TextArgument& text) {
    return text == nullptr || Comment(*this, {Kind::Module}, text);
}

bool Model::AddComponentComment(const Port::TextArgument& component,
                                const Port::TextArgument& text) {
    return Comment(*this, {Kind::Component, component}, text);
}

bool Model::AddInstanceComment(const Port::TextArgument& instance, const Port::TextArgument& text) {
    return Comment(*this, {Kind::Instance, instance}, text);
}

bool Model::AddSignalComment(const Port::TextArgument& signal, const Port::TextArgument& text) {
    return Comment(*this, {Kind::Signal, signal}, text);
}

bool Model::AddComponentPinComment(const Port::TextArgument& component,
                                   const Port::TextArgument& pin, const Port::TextArgument& text) {
    return text == nullptr || Comment(*this, {Kind::ComponentPin, component, pin}, text);
}

bool Model::AddInstancePinComment(const Port::TextArgument& instance, const Port::TextArgument& pin,
                                  const Port::TextArgument& text) {
    return text == nullptr || Comment(*this, {Kind::InstancePin, instance, pin}, text);
}

} // namespace Orn_Hdl
