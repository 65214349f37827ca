// The functions of the C interface for the objects of a design.
#include "C/Objects.h"
#include "C/Texts.h"
#include "Containers/Reordering.h"
#include "HdlModel/Netlist/PinBlock.h"

#include <algorithm>

namespace CInterface = Orn_Hdl::CInterface;

using CInterface::End;
using CInterface::Give;
using CInterface::KindOf;
using CInterface::LookAt;
using CInterface::ModelEntity;
using CInterface::Require;
using CInterface::ResolvedObject;
using CInterface::Texts;
using namespace Orn_Hdl;

namespace {

/// Finds an object by name in a model.
template <class Find>
orn_hdl_status_t FindObject(orn_hdl_model_t model, orn_hdl_object_t* object, const Find& find) {
    return LookAt(model, [&](const ModelEntity& entity) {
        Give(entity, find(*entity.model.GetNetlist()), object);
    });
}

/// Finds an object that belongs to another one.
template <class Find>
orn_hdl_status_t FindRelated(const orn_hdl_object_t& object, orn_hdl_object_t* result,
                             const Find& find) {
    return LookAt(object, [&](const ResolvedObject& from) {
        Give(*from.entity, find(*from.object), result);
    });
}

/// Takes objects of a walk from an index on.
/// \return how many there were.
template <class T>
std::size_t TakeFrom(Iterator<T*> walk, const ModelEntity& entity, std::int32_t& index,
                     orn_hdl_object_t* objects, std::size_t capacity) {
    walk = Reordering::Continue(walk, index);
    std::size_t count = 0;
    for (; count < capacity && !walk.IsAtEnd(); walk.Next()) {
        index = Reordering::IndexOf(walk) + 1;
        if (const T* const object = walk.GetCurrent()) {
            objects[count++] = CInterface::ToHandle(entity, *object);
        }
    }
    return count;
}

/// Calls `action` with the walk over a list of an object.
template <class Action> void WithWalk(Object& owner, std::int32_t list, const Action& action) {
    switch (list) {
    case ORN_HDL_COMPONENTS:
        return action(CInterface::ToNetlist(owner).GetComponentIterator());
    case ORN_HDL_INSTANCES:
        return action(CInterface::ToNetlist(owner).GetInstanceIterator());
    case ORN_HDL_SIGNALS:
        return action(CInterface::ToNetlist(owner).GetSignalIterator());
    case ORN_HDL_PINS:
        if (owner.GetObjectType() == ObjectTypeSignal) {
            return action(CInterface::ToSignal(owner).GetPinIterator());
        }
        if (owner.GetObjectType() == ObjectTypeComponent) {
            return action(CInterface::ToComponent(owner).GetPinIterator());
        }
        return action(CInterface::ToInstance(owner).GetPinIterator());
    case ORN_HDL_ATTRIBUTES:
        return action(CInterface::ToHolder(owner).GetAttrIterator());
    case ORN_HDL_ALIASES:
        return action(CInterface::ToSignal(owner).GetSignalIterator());
    case ORN_HDL_PARTS:
        if (KindOf(owner) != ORN_HDL_KIND_BUS) {
            End(ORN_HDL_WRONG_KIND);
        }
        return action(static_cast<Bus&>(owner).GetBusSliceIterator());
    case ORN_HDL_MEMBERS:
        if (KindOf(owner) != ORN_HDL_KIND_COMPOUND) {
            End(ORN_HDL_WRONG_KIND);
        }
        return action(static_cast<CompoundBus&>(owner).GetBusMemberIterator());
    default:
        End(ORN_HDL_INVALID_ARGUMENT);
    }
}

int WidthOf(Object& object) {
    switch (KindOf(object)) {
    case ORN_HDL_KIND_BUS_PIN:
        return static_cast<const BusPin&>(object).GetWidth();
    case ORN_HDL_KIND_SCALAR_PIN:
    case ORN_HDL_KIND_BIT_PIN:
        return 1;
    default:
        return CInterface::ToSignal(object).GetWidth();
    }
}

void PutConstant(Texts& texts, const BitVectorValue& value, orn_hdl_constant_t& constant) {
    texts.Put(constant.digits, value.GetValue().GetView());
    constant.base = value.GetBase();
    constant.length = value.GetLength();
    constant.isSized = value.HasBaseAndLength() ? 1 : 0;
}

void PutWire(Texts& texts, const Pin& pin, orn_hdl_wire_t& wire) {
    const Signal* const signal = pin.GetSignal();
    texts.Put(wire.pin, pin.GetNameView());
    texts.Put(wire.signal, signal == nullptr ? std::string_view() : signal->GetNameView());
    wire.direction = pin.GetPolarity().GetValue();
}

/// Marks a model as one that is walked over.
class Walking {
public:
    explicit Walking(ModelEntity& entity) : entity_(entity) { ++entity_.walks; }
    Walking(const Walking&) = delete;
    Walking& operator=(const Walking&) = delete;
    ~Walking() { --entity_.walks; }

private:
    ModelEntity& entity_;
};

void VisitWire(const Instance& instance, const Pin& pin, orn_hdl_wire_visitor_t visitor,
               void* user) {
    orn_hdl_text_t name;
    orn_hdl_wire_t wire;
    Texts texts;
    texts.Put(name, instance.GetNameView());
    PutWire(texts, pin, wire);
    texts.HandOut();
    if (visitor(user, &name, &wire) != 0) {
        End(ORN_HDL_STOPPED);
    }
}

void RemovePin(Netlist& netlist, Pin& pin) {
    for (Component* component : netlist.GetComponentIterator()) {
        if (PinBlock::Owns(*component, pin)) {
            netlist.RemovePin(component, &pin);
            return;
        }
    }
    delete &pin;
}

void RemoveObject(ModelEntity& entity, Object& object) {
    Netlist& netlist = *entity.model.GetNetlist();
    switch (object.GetObjectType()) {
    case ObjectTypeComponent:
        netlist.Remove(&CInterface::ToComponent(object));
        break;
    case ObjectTypeInstance:
        netlist.Remove(&CInterface::ToInstance(object));
        break;
    case ObjectTypeSignal:
        netlist.Remove(&CInterface::ToSignal(object));
        break;
    case ObjectTypePin:
        ++entity.removedParts;
        RemovePin(netlist, CInterface::ToPin(object));
        break;
    case ObjectTypeAttribute:
        ++entity.removedParts;
        delete &object;
        break;
    default:
        End(ORN_HDL_WRONG_KIND);
    }
    entity.model.SetModifiedFlag(true);
}

} // namespace

extern "C" {

orn_hdl_status_t orn_hdl_model_get_netlist(orn_hdl_model_t model, orn_hdl_object_t* netlist) {
    return FindObject(model, netlist, [](Netlist& found) { return &found; });
}

orn_hdl_status_t orn_hdl_model_get_component(orn_hdl_model_t model, const char* name,
                                             orn_hdl_object_t* component) {
    return FindObject(model, component,
                      [&](const Netlist& netlist) { return netlist.GetComponent(name); });
}

orn_hdl_status_t orn_hdl_model_get_instance(orn_hdl_model_t model, const char* name,
                                            orn_hdl_object_t* instance) {
    return FindObject(model, instance,
                      [&](const Netlist& netlist) { return netlist.GetInstance(name); });
}

orn_hdl_status_t orn_hdl_model_get_signal(orn_hdl_model_t model, const char* name,
                                          orn_hdl_object_t* signal) {
    return FindObject(model, signal,
                      [&](const Netlist& netlist) { return netlist.GetSignal(name); });
}

orn_hdl_status_t orn_hdl_object_get_pin(orn_hdl_object_t owner, const char* name,
                                        orn_hdl_object_t* pin) {
    return FindRelated(owner, pin, [&](Object& object) {
        const std::string_view view = Port::ViewOf(name);
        return object.GetObjectType() == ObjectTypeComponent
                   ? CInterface::ToComponent(object).GetPin(view)
                   : CInterface::ToInstance(object).GetPin(view);
    });
}

orn_hdl_status_t orn_hdl_object_get_attribute(orn_hdl_object_t owner, const char* name,
                                              orn_hdl_object_t* attribute) {
    return FindRelated(owner, attribute, [&](Object& object) {
        return CInterface::ToHolder(object).GetAttr(name == nullptr ? "" : name);
    });
}

orn_hdl_status_t orn_hdl_object_walk(orn_hdl_object_t owner, int32_t list,
                                     orn_hdl_cursor_t* cursor) {
    return LookAt(owner, [&](const ResolvedObject& from) {
        Require(cursor != nullptr);
        WithWalk(*from.object, list, [](const auto&) {});
        *cursor = {owner, list, 0};
    });
}

orn_hdl_status_t orn_hdl_cursor_next(orn_hdl_cursor_t* cursor, orn_hdl_object_t* object) {
    size_t count = 0;
    return orn_hdl_cursor_next_many(cursor, object, 1, &count);
}

orn_hdl_status_t orn_hdl_cursor_next_many(orn_hdl_cursor_t* cursor, orn_hdl_object_t* objects,
                                          size_t capacity, size_t* count) {
    if (cursor == nullptr) {
        return ORN_HDL_INVALID_ARGUMENT;
    }
    return LookAt(cursor->owner, [&](const ResolvedObject& from) {
        Require(objects != nullptr && capacity > 0 && count != nullptr);
        std::size_t taken = 0;
        WithWalk(*from.object, cursor->list, [&](const auto& walk) {
            taken = TakeFrom(walk, *from.entity, cursor->index, objects, capacity);
        });
        if (taken == 0) {
            End(ORN_HDL_END);
        }
        *count = taken;
    });
}

orn_hdl_status_t orn_hdl_object_get_kind(orn_hdl_object_t object, int32_t* kind) {
    return LookAt(object, [&](const ResolvedObject& from) {
        Require(kind != nullptr);
        *kind = KindOf(*from.object);
    });
}

orn_hdl_status_t orn_hdl_object_get_name(orn_hdl_object_t object, orn_hdl_text_t* name) {
    return LookAt(object, [&](const ResolvedObject& from) {
        Require(name != nullptr);
        CInterface::HandOutText(*name, from.object->GetNameView());
    });
}

orn_hdl_status_t orn_hdl_object_get_comment(orn_hdl_object_t object, orn_hdl_text_t* comment) {
    return LookAt(object, [&](const ResolvedObject& from) {
        Require(comment != nullptr);
        CInterface::HandOutText(*comment, from.object->GetCommentView());
    });
}

orn_hdl_status_t orn_hdl_object_get_direction(orn_hdl_object_t object, int32_t* direction) {
    return LookAt(object, [&](const ResolvedObject& from) {
        Require(direction != nullptr);
        const Polarity polarity = from.object->GetObjectType() == ObjectTypePin
                                      ? CInterface::ToPin(*from.object).GetPolarity()
                                      : CInterface::ToSignal(*from.object).GetPortPolarity();
        *direction = polarity.IsValid() ? polarity.GetValue() : ORN_HDL_NO_DIRECTION;
    });
}

orn_hdl_status_t orn_hdl_object_get_width(orn_hdl_object_t object, int32_t* width) {
    return LookAt(object, [&](const ResolvedObject& from) {
        Require(width != nullptr);
        *width = WidthOf(*from.object);
    });
}

orn_hdl_status_t orn_hdl_object_get_range(orn_hdl_object_t object, orn_hdl_text_t* base,
                                          int32_t* left, int32_t* right) {
    return LookAt(object, [&](const ResolvedObject& from) {
        Require(left != nullptr && right != nullptr);
        const Port::String name = from.object->GetName();
        Port::String baseName;
        int first = 0;
        int last = 0;
        bool isParsed = false;
        switch (KindOf(*from.object)) {
        case ORN_HDL_KIND_BUS:
        case ORN_HDL_KIND_SLICE:
        case ORN_HDL_KIND_BUS_PIN:
            isParsed = Bus::ParseBusName(name.CStr(), baseName, first, last);
            break;
        case ORN_HDL_KIND_BIT:
        case ORN_HDL_KIND_BIT_PIN:
            isParsed = BusIndex::ParseBusIndexName(name.CStr(), baseName, first);
            last = first;
            break;
        default:
            break;
        }
        if (!isParsed) {
            End(ORN_HDL_WRONG_KIND);
        }
        if (base != nullptr) {
            CInterface::HandOutText(*base, baseName.GetView());
        }
        *left = first;
        *right = last;
    });
}

orn_hdl_status_t orn_hdl_object_get_constant(orn_hdl_object_t object,
                                             orn_hdl_constant_t* constant) {
    return LookAt(object, [&](const ResolvedObject& from) {
        Require(constant != nullptr);
        Texts texts;
        PutConstant(texts,
                    from.object->GetObjectType() == ObjectTypePin
                        ? CInterface::ToPin(*from.object).GetDefaultValue()
                        : CInterface::ToSignal(*from.object).GetConstantValue(),
                    *constant);
        texts.HandOut();
    });
}

orn_hdl_status_t orn_hdl_instance_get_component(orn_hdl_object_t instance,
                                                orn_hdl_object_t* component) {
    return FindRelated(instance, component, [](Object& object) {
        return CInterface::ToInstance(object).GetComponent();
    });
}

orn_hdl_status_t orn_hdl_pin_get_signal(orn_hdl_object_t pin, orn_hdl_object_t* signal) {
    return FindRelated(pin, signal,
                       [](Object& object) { return CInterface::ToPin(object).GetSignal(); });
}

orn_hdl_status_t orn_hdl_part_get_bus(orn_hdl_object_t part, orn_hdl_object_t* bus) {
    return FindRelated(part, bus, [](Object& object) {
        const std::int32_t kind = KindOf(object);
        if (kind != ORN_HDL_KIND_SLICE && kind != ORN_HDL_KIND_BIT) {
            End(ORN_HDL_WRONG_KIND);
        }
        return static_cast<BusPart&>(object).GetParentBus();
    });
}

orn_hdl_status_t orn_hdl_signal_get_dummy(orn_hdl_object_t signal, orn_hdl_object_t* dummy) {
    return LookAt(signal, [&](const ResolvedObject& from) {
        const Signal& original = CInterface::ToSignal(*from.object);
        Give(*from.entity, from.entity->model.GetNetlist()->GetDummySignal(&original), dummy);
    });
}

orn_hdl_status_t orn_hdl_attribute_get(orn_hdl_object_t attribute, orn_hdl_attribute_t* result) {
    return LookAt(attribute, [&](const ResolvedObject& from) {
        Require(result != nullptr);
        const Attribute& found = CInterface::ToAttribute(*from.object);
        Texts texts;
        texts.Put(result->name, found.GetNameView());
        texts.Put(result->type, found.GetValueTypeName().GetView());
        texts.Put(result->value, found.GetValueString().GetView());
        texts.Put(result->generic, found.GetGeneric().GetView());
        texts.Put(result->synthesis, found.GetSynAttr().GetView());
        const bool isUser = found.GetValueType() == Attribute::User;
        texts.Put(result->userType,
                  isUser ? static_cast<const AttributeUser&>(found).GetUserType().GetView()
                         : std::string_view());
        const bool isVector = found.GetValueType() == Attribute::BitVector;
        PutConstant(texts,
                    isVector ? static_cast<const AttributeBitVector&>(found).GetBitVectorValue()
                             : BitVectorValue(),
                    result->constant);
        texts.HandOut();
    });
}

orn_hdl_status_t orn_hdl_instance_get_wires(orn_hdl_object_t instance, orn_hdl_wire_t* wires,
                                            size_t capacity, size_t* count) {
    return LookAt(instance, [&](const ResolvedObject& from) {
        Require(count != nullptr && (wires != nullptr || capacity == 0));
        Texts texts;
        size_t found = 0;
        for (const Pin* pin : CInterface::ToInstance(*from.object).GetPinIterator()) {
            if (found < capacity) {
                PutWire(texts, *pin, wires[found]);
            }
            ++found;
        }
        texts.HandOut();
        *count = found;
    });
}

orn_hdl_status_t orn_hdl_model_visit_wires(orn_hdl_model_t model, orn_hdl_wire_visitor_t visitor,
                                           void* user) {
    return LookAt(model, [&](ModelEntity& entity) {
        Require(visitor != nullptr);
        const Walking walking(entity);
        for (const Instance* instance : entity.model.GetNetlist()->GetInstanceIterator()) {
            for (const Pin* pin : instance->GetPinIterator()) {
                VisitWire(*instance, *pin, visitor, user);
            }
        }
    });
}

orn_hdl_status_t orn_hdl_object_remove(orn_hdl_object_t object) {
    ResolvedObject resolved;
    const orn_hdl_status_t status = CInterface::Resolve(object, resolved);
    if (status != ORN_HDL_OK) {
        return status;
    }
    return CInterface::Attempt(&resolved.entity->error, [&] {
        const CInterface::Changing changing(*resolved.entity);
        RemoveObject(*resolved.entity, *resolved.object);
    });
}

} // extern "C"
