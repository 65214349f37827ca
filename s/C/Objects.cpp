#include "C/Objects.h"

#include "HdlModel/Netlist/Removals.h"

namespace Orn_Hdl::CInterface {

namespace {

/// Tells the present objects of a model from former ones that had the same addresses, and the
/// handles of the library from memory that was never set.
std::uint64_t StampOf(const ModelEntity& entity, std::uint64_t place) noexcept {
    constexpr std::uint64_t Factor = 0x9E3779B97F4A7C15U;
    const std::uint64_t removals =
        Removals::Count(*entity.model.GetNetlist()) + entity.removedParts;
    const std::uint64_t mixed = ((place ^ entity.GetId()) + removals) * Factor;
    return (removals << 16U) | (mixed >> 48U);
}

} // namespace

orn_hdl_object_t ToHandle(const ModelEntity& entity, const Object& object) noexcept {
    const std::uint64_t place = reinterpret_cast<std::uintptr_t>(&object);
    return {entity.GetId(), place, StampOf(entity, place)};
}

orn_hdl_status_t Resolve(const orn_hdl_object_t& handle, ResolvedObject& resolved) noexcept {
    if (handle.place == 0) {
        return ORN_HDL_NULL_HANDLE;
    }
    ModelEntity* entity = nullptr;
    const orn_hdl_status_t status = Resolve(handle.model, entity);
    if (status != ORN_HDL_OK) {
        return status;
    }
    if (handle.stamp != StampOf(*entity, handle.place)) {
        return ORN_HDL_DEAD_HANDLE;
    }
    resolved = {entity, reinterpret_cast<Object*>(static_cast<std::uintptr_t>(handle.place))};
    return ORN_HDL_OK;
}

AttributeHolder& ToHolder(Object& object) {
    switch (object.GetObjectType()) {
    case ObjectTypeNetlist:
        return static_cast<Netlist&>(object);
    case ObjectTypeComponent:
        return static_cast<Component&>(object);
    case ObjectTypeInstance:
        return static_cast<Instance&>(object);
    case ObjectTypeSignal:
        return static_cast<Signal&>(object);
    case ObjectTypePin:
        return static_cast<Pin&>(object);
    default:
        End(ORN_HDL_WRONG_KIND);
    }
}

std::int32_t KindOf(const Object& object) noexcept {
    switch (object.GetObjectType()) {
    case ObjectTypeNetlist:
        return ORN_HDL_KIND_NETLIST;
    case ObjectTypeComponent:
        return ORN_HDL_KIND_COMPONENT;
    case ObjectTypeInstance:
        return ORN_HDL_KIND_INSTANCE;
    case ObjectTypePin:
        return ORN_HDL_KIND_SCALAR_PIN + static_cast<const Pin&>(object).GetPinType() -
               PinTypeScalar;
    case ObjectTypeSignal:
        return ORN_HDL_KIND_SCALAR + static_cast<const Signal&>(object).GetSignalType() -
               SignalTypeScalar;
    default:
        return ORN_HDL_KIND_ATTRIBUTE;
    }
}

} // namespace Orn_Hdl::CInterface
