// The functions of the C interface for the operations of a model.
#include "C/Objects.h"

namespace CInterface = Orn_Hdl::CInterface;

using CInterface::Change;
using CInterface::ModelEntity;
using CInterface::Require;
using Orn_Hdl::Model;

namespace {

using Text = const Port::TextArgument&;

/// One operation of a model on the attribute or the comment of each kind of holder.
template <class... Texts> struct HolderOperation {
    bool (Model::*ofModule)(Texts...);
    bool (Model::*ofOwner[3])(Text, Texts...);
    bool (Model::*ofPin[2])(Text, Text, Texts...);
};

constexpr HolderOperation<Text, Text, Text> AddAttribute = {
    &Model::AddModuleAttr,
    {&Model::AddComponentAttr, &Model::AddInstanceAttr, &Model::AddSignalAttr},
    {&Model::AddComponentPinAttr, &Model::AddInstancePinAttr}};
constexpr HolderOperation<Text, Text> SetValue = {
    &Model::SetModuleAttrValue,
    {&Model::SetComponentAttrValue, &Model::SetInstanceAttrValue, &Model::SetSignalAttrValue},
    {&Model::SetComponentPinAttrValue, &Model::SetInstancePinAttrValue}};
constexpr HolderOperation<Text, Text> SetGeneric = {
    &Model::SetModuleGenericAttrValue,
    {&Model::SetComponentGenericAttrValue, &Model::SetInstanceGenericAttrValue,
     &Model::SetSignalGenericAttrValue},
    {&Model::SetComponentPinGenericAttrValue, &Model::SetInstancePinGenericAttrValue}};
constexpr HolderOperation<Text, Text> SetSynthesis = {
    &Model::SetModuleSynAttrValue,
    {&Model::SetComponentSynAttrValue, &Model::SetInstanceSynAttrValue,
     &Model::SetSignalSynAttrValue},
    {&Model::SetComponentPinSynAttrValue, &Model::SetInstancePinSynAttrValue}};
constexpr HolderOperation<Text, Text> SetUserType = {
    &Model::SetModuleUserType,
    {&Model::SetComponentUserType, &Model::SetInstanceUserType, &Model::SetSignalUserType},
    {&Model::SetComponentPinUserType, &Model::SetInstancePinUserType}};
constexpr HolderOperation<Text> AddComment = {
    &Model::AddNotes,
    {&Model::AddComponentComment, &Model::AddInstanceComment, &Model::AddSignalComment},
    {&Model::AddComponentPinComment, &Model::AddInstancePinComment}};

struct HolderPlace {
    orn_hdl_holder_t holder;
    const char* owner;
    const char* pin;
};

/// Carries out an operation for the holder that is meant.
template <class... Texts, class... Arguments>
orn_hdl_status_t ChangeHolder(orn_hdl_model_t model, const HolderPlace& place,
                              const HolderOperation<Texts...>& operation,
                              const Arguments*... arguments) {
    return Change(model, [&](Model& target) {
        switch (place.holder) {
        case ORN_HDL_OF_MODULE:
            (target.*operation.ofModule)(arguments...);
            break;
        case ORN_HDL_OF_COMPONENT:
        case ORN_HDL_OF_INSTANCE:
        case ORN_HDL_OF_SIGNAL:
            (target.*operation.ofOwner[place.holder - ORN_HDL_OF_COMPONENT])(place.owner,
                                                                             arguments...);
            break;
        case ORN_HDL_OF_COMPONENT_PIN:
        case ORN_HDL_OF_INSTANCE_PIN:
            (target.*operation.ofPin[place.holder - ORN_HDL_OF_COMPONENT_PIN])(
                place.owner, place.pin, arguments...);
            break;
        default:
            CInterface::End(ORN_HDL_INVALID_ARGUMENT);
        }
    });
}

/// Carries out an action for each index, and counts those that succeed.
template <class Action>
orn_hdl_status_t ChangeMany(orn_hdl_model_t model, size_t count, size_t* done,
                            const Action& action) {
    size_t counted = 0;
    const orn_hdl_status_t status = Change(model, [&](Model& target) {
        for (; counted < count; ++counted) {
            action(target, counted);
        }
    });
    if (done != nullptr) {
        *done = counted;
    }
    return status;
}

} // namespace

extern "C" {

orn_hdl_status_t orn_hdl_model_add_component(orn_hdl_model_t model, const char* name) {
    return Change(model, [&](Model& target) { target.AddComponent(name); });
}

orn_hdl_status_t orn_hdl_model_add_pin(orn_hdl_model_t model, const char* component,
                                       const char* name, const char* direction,
                                       const char* defaultValue) {
    return Change(model, [&](Model& target) {
        target.AddPin(name, Port::TextArgument(direction), component, defaultValue);
    });
}

orn_hdl_status_t orn_hdl_model_add_instance(orn_hdl_model_t model, const char* name,
                                            const char* component) {
    return Change(model, [&](Model& target) { target.AddInstance(name, component); });
}

orn_hdl_status_t orn_hdl_model_add_instances(orn_hdl_model_t model, const char* component,
                                             const char* const* names, size_t count, size_t* done) {
    return ChangeMany(model, count, done, [&](Model& target, size_t index) {
        Require(names != nullptr);
        target.AddInstance(names[index], component);
    });
}

orn_hdl_status_t orn_hdl_model_add_signal(orn_hdl_model_t model, const char* name) {
    return Change(model, [&](Model& target) { target.AddSignal(name); });
}

orn_hdl_status_t orn_hdl_model_add_port(orn_hdl_model_t model, const char* name,
                                        const char* direction) {
    return Change(model,
                  [&](Model& target) { target.AddPort(name, Port::TextArgument(direction)); });
}

orn_hdl_status_t orn_hdl_model_bit(orn_hdl_model_t model, const char* bus, int index,
                                   orn_hdl_object_t* bit) {
    return CInterface::Call<ModelEntity>(model.id, [&](ModelEntity& entity) {
        Require(bit != nullptr);
        const CInterface::Changing changing(entity);
        const Orn_Hdl::BusIndex* const found = entity.model.Bit(bus, index);
        CInterface::Give(entity, found, bit);
    });
}

orn_hdl_status_t orn_hdl_model_rename_component(orn_hdl_model_t model, const char* name,
                                                const char* newName) {
    return Change(model, [&](Model& target) { target.RenameComponent(name, newName); });
}

orn_hdl_status_t orn_hdl_model_rename_instance(orn_hdl_model_t model, const char* name,
                                               const char* newName) {
    return Change(model, [&](Model& target) { target.RenameInstance(name, newName); });
}

orn_hdl_status_t orn_hdl_model_rename_signal(orn_hdl_model_t model, const char* name,
                                             const char* newName) {
    return Change(model, [&](Model& target) { target.RenameSignal(name, newName); });
}

orn_hdl_status_t orn_hdl_model_connect(orn_hdl_model_t model, const char* signal,
                                       const char* instance, const char* pin) {
    return Change(model, [&](Model& target) { target.ConnectSignalToPin(signal, instance, pin); });
}

orn_hdl_status_t orn_hdl_model_connect_many(orn_hdl_model_t model,
                                            const orn_hdl_connection_t* connections, size_t count,
                                            size_t* done) {
    return ChangeMany(model, count, done, [&](Model& target, size_t index) {
        Require(connections != nullptr);
        const orn_hdl_connection_t& connection = connections[index];
        target.ConnectSignalToPin(connection.signal, connection.instance, connection.pin);
    });
}

orn_hdl_status_t orn_hdl_model_connect_signals(orn_hdl_model_t model, const char* first,
                                               const char* second) {
    return Change(model, [&](Model& target) { target.ConnectSignals(first, second); });
}

orn_hdl_status_t orn_hdl_model_assign_signal(orn_hdl_model_t model, const char* signal,
                                             const char* value) {
    return Change(model, [&](Model& target) { target.AssignConstantToSignal(signal, value); });
}

orn_hdl_status_t orn_hdl_model_assign_pin(orn_hdl_model_t model, const char* instance,
                                          const char* pin, const char* value) {
    return Change(model, [&](Model& target) { target.AssignConstantToPin(instance, pin, value); });
}

orn_hdl_status_t orn_hdl_model_add_attribute(orn_hdl_model_t model, orn_hdl_holder_t holder,
                                             const char* owner, const char* pin, const char* name,
                                             const char* value, const char* type) {
    return ChangeHolder(model, {holder, owner, pin}, AddAttribute, name, value, type);
}

orn_hdl_status_t orn_hdl_model_set_attribute(orn_hdl_model_t model, orn_hdl_holder_t holder,
                                             const char* owner, const char* pin, const char* name,
                                             const char* value) {
    return ChangeHolder(model, {holder, owner, pin}, SetValue, name, value);
}

orn_hdl_status_t orn_hdl_model_set_generic(orn_hdl_model_t model, orn_hdl_holder_t holder,
                                           const char* owner, const char* pin, const char* name,
                                           const char* value) {
    return ChangeHolder(model, {holder, owner, pin}, SetGeneric, name, value);
}

orn_hdl_status_t orn_hdl_model_set_synthesis(orn_hdl_model_t model, orn_hdl_holder_t holder,
                                             const char* owner, const char* pin, const char* name,
                                             const char* value) {
    return ChangeHolder(model, {holder, owner, pin}, SetSynthesis, name, value);
}

orn_hdl_status_t orn_hdl_model_set_user_type(orn_hdl_model_t model, orn_hdl_holder_t holder,
                                             const char* owner, const char* pin, const char* name,
                                             const char* type) {
    return ChangeHolder(model, {holder, owner, pin}, SetUserType, name, type);
}

orn_hdl_status_t orn_hdl_model_add_comment(orn_hdl_model_t model, orn_hdl_holder_t holder,
                                           const char* owner, const char* pin, const char* text) {
    return ChangeHolder(model, {holder, owner, pin}, AddComment, text);
}

} // extern "C"
