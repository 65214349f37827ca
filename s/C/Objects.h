// Handles of objects of a design.
#pragma once

#include "C/Calls.h"

namespace Orn_Hdl::CInterface {

/// The handle of an object of a model. It is dead as soon as any object of the model is destroyed:
/// to know of each single object, a design would need memory for each.
orn_hdl_object_t ToHandle(const ModelEntity& entity, const Object& object) noexcept;

/// What the handle of an object leads to.
struct ResolvedObject {
    ModelEntity* entity = nullptr;
    Object* object = nullptr;
};

/// \param resolved receives what the handle leads to if the status is `ORN_HDL_OK`.
orn_hdl_status_t Resolve(const orn_hdl_object_t& handle, ResolvedObject& resolved) noexcept;

/// Runs an action that looks at an object, and remembers nothing.
template <class Action>
orn_hdl_status_t LookAt(const orn_hdl_object_t& handle, const Action& action) noexcept {
    ResolvedObject resolved;
    const orn_hdl_status_t status = Resolve(handle, resolved);
    return status != ORN_HDL_OK ? status : Attempt(nullptr, [&] { action(resolved); });
}

/// Writes the handle of an object.
/// \param object null gives `ORN_HDL_NOT_FOUND`.
inline void Give(const ModelEntity& entity, const Object* object, orn_hdl_object_t* handle) {
    Require(handle != nullptr);
    if (object == nullptr) {
        End(ORN_HDL_NOT_FOUND);
    }
    *handle = ToHandle(entity, *object);
}

/// The object as one of a class that has an `ObjectType` of its own.
template <class T> T& ToType(Object& object, ObjectType type) {
    if (object.GetObjectType() != type) {
        End(ORN_HDL_WRONG_KIND);
    }
    return static_cast<T&>(object);
}

/// The object as a signal; any other one ends the call.
inline Signal& ToSignal(Object& object) {
    return ToType<Signal>(object, ObjectTypeSignal);
}
/// The object as a pin; any other one ends the call.
inline Pin& ToPin(Object& object) {
    return ToType<Pin>(object, ObjectTypePin);
}
/// The object as an instance; any other one ends the call.
inline Instance& ToInstance(Object& object) {
    return ToType<Instance>(object, ObjectTypeInstance);
}
/// The object as a component; any other one ends the call.
inline Component& ToComponent(Object& object) {
    return ToType<Component>(object, ObjectTypeComponent);
}
/// The object as an attribute; any other one ends the call.
inline Attribute& ToAttribute(Object& object) {
    return ToType<Attribute>(object, ObjectTypeAttribute);
}
/// The object as a netlist; any other one ends the call.
inline Netlist& ToNetlist(Object& object) {
    return ToType<Netlist>(object, ObjectTypeNetlist);
}
/// The attributes of an object; an attribute, which has none, ends the call.
AttributeHolder& ToHolder(Object& object);

/// The constant `ORN_HDL_KIND_...` of an object.
std::int32_t KindOf(const Object& object) noexcept;

} // namespace Orn_Hdl::CInterface
