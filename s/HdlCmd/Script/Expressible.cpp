#include "HdlCmd/Script/Expressible.h"

#include "HdlCmd/Script/InstanceStages.h"
#include "HdlCmd/Script/Lines.h"
#include "HdlCmd/Script/Values.h"
#include "HdlModel/Names/Names.h"
#include "HdlModel/Objects/OwnerLink.h"
#include "HdlModel/Signals/SignalCast.h"

#include <algorithm>

namespace Orn_Hdl::Script {

namespace {

constexpr std::string_view KindNames[] = {"component", "instance", "signal", "signal"};

bool IsBusName(std::string_view name) {
    Names::BusName parsed;
    return Names::ParseBus(name, parsed);
}

bool IsBitName(std::string_view name) {
    Names::BitName parsed;
    return Names::ParseBit(name, parsed);
}

int PinTypeOf(std::string_view name) {
    return IsBusName(name) ? PinTypeBus : IsBitName(name) ? PinTypeBusIndex : PinTypeScalar;
}

bool IsSame(const Pin& pin, const Pin& other) {
    return pin.GetNameView() == other.GetNameView() && pin.GetPolarity() == other.GetPolarity();
}

bool IsOnPort(const Signal& signal) {
    const auto* const compound = As<CompoundBus>(&signal);
    if (compound == nullptr) {
        return signal.GetPortPolarity().IsValid();
    }
    const Iterator<Signal*> members = compound->GetBusMemberIterator();
    return std::any_of(members.begin(), members.end(),
                       [](const Signal* member) { return IsOnPort(*member); });
}

} // namespace

/// An object that got its name by `SetName` is found by its former one. In the replayed design it
/// is found by its name, which must not belong to another.
void Expressible::CheckName(Kind kind, const Object& object, const Object* found) {
    const std::string_view name = object.GetNameView();
    if (found == &object) {
        // The name of a slice, a bit or a compound may be an instance's or a component's as well.
        const bool isTaken = (kind == KindInstance || kind == KindDeclared) &&
                             (netlist_.GetComponent(name) != nullptr ||
                              (kind == KindDeclared && netlist_.GetInstance(name) != nullptr));
        if (!isTaken) {
            return;
        }
    } else if (!netlist_.IsNameUsed(name) && otherNames_.insert(Folded(name)).second) {
        return;
    }
    FailToExpress(KindNames[kind], name, "another object has that name");
}

void Expressible::Check(const Component& component) {
    if (component.GetNameView().empty()) {
        FailToExpress("component", "", "it has no name");
    }
    CheckName(KindComponent, component, netlist_.GetComponent(component.GetNameView()));
    for (const Pin* pin : component.GetPinIterator()) {
        const std::string_view name = pin->GetNameView();
        if (component.GetPin(name) != pin) {
            FailToExpress("pin", name, "its component has another one of that name");
        }
        if (pin->GetPinType() != PinTypeOf(name)) {
            FailToExpress("pin", name, "its name is of another form");
        }
        if (!pin->GetPolarity().IsValid()) {
            FailToExpress("pin", name, "it has no direction");
        }
        if (pin->GetSignal() != nullptr) {
            FailToExpress("pin", name, "a pin of a component is connected");
        }
    }
}

void Expressible::Check(const Instance& instance) {
    const std::string_view name = instance.GetNameView();
    CheckName(KindInstance, instance, netlist_.GetInstance(name));
    const Component* const component = instance.GetComponent();
    if (component == nullptr) {
        FailToExpress("instance", name, "it has no component");
    }
    if (OwnerLink::Get<void>(*component) != OwnerLink::Get<void>(instance)) {
        FailToExpress("instance", name, "its component is not in the netlist");
    }
    int rest = CountPins(instance.GetPinIterator());
    for (const Pin* pin : component->GetPinIterator()) {
        if (rest == 0) {
            return;
        }
        const Pin* const own = instance.GetPin(pin->GetNameView());
        if (own == nullptr || !IsSame(*own, *pin)) {
            break;
        }
        --rest;
    }
    if (rest != 0) {
        FailToExpress("instance", name, "its pins are not those that its component had first");
    }
}

void Expressible::CheckDeclared(const Signal& signal) {
    const std::string_view name = signal.GetNameView();
    CheckName(KindDeclared, signal, netlist_.GetSignal(name));
    const Bus* const bus = As<Bus>(&signal);
    if (IsBusName(name) != (bus != nullptr)) {
        FailToExpress("signal", name, "its name is of another form");
    }
    const Bus* const namesake =
        bus == nullptr ? nullptr : netlist_.GetParentBus(std::string(name).c_str());
    if (bus != nullptr && namesake != nullptr && namesake != bus) {
        FailToExpress("signal", name, "another bus has that base name");
    }
    const int direction = signal.GetPortPolarity().GetValue();
    if (direction != Polarity::Invalid && !Polarity::IsValidValue(direction)) {
        FailToExpress("signal", name, "it has a direction that is none");
    }
}

void Expressible::CheckPart(const Bus& bus, const Signal& part) {
    const std::string_view name = part.GetNameView();
    if (As<BusPart>(&part) == nullptr) {
        FailToExpress("signal", name, "a bus lists it as its slice");
    }
    CheckHeld(part);
    CheckName(KindUsed, part, netlist_.GetSignal(name));
    if (Names::BeforeParenthesis(name) != Names::BeforeParenthesis(bus.GetNameView()) ||
        (As<BusSlice>(&part) != nullptr ? !IsBusName(name) : !IsBitName(name))) {
        FailToExpress("signal", name, "it is not named after its bus");
    }
}

void Expressible::CheckHasBus(const Signal& part) {
    const auto* const known = As<BusPart>(&part);
    const Bus* const bus = known == nullptr ? nullptr : known->GetParentBus();
    if (bus == nullptr || OwnerLink::Get<void>(*bus) != OwnerLink::Get<void>(part)) {
        FailToExpress("signal", part.GetNameView(), "its bus is not in the netlist");
    }
}

void Expressible::CheckCompound(const CompoundBus& compound, std::string_view name) {
    if (compound.GetNameView() == name) {
        CheckName(KindUsed, compound, netlist_.GetSignal(name));
    }
}

void Expressible::CheckHeld(const Signal& signal) const {
    const Signal* const any = netlist_.GetSignalIterator().GetCurrent();
    if (any == nullptr || OwnerLink::Get<void>(*any) != OwnerLink::Get<void>(signal)) {
        FailToExpress("signal", signal.GetNameView(), "it is not in the netlist");
    }
}

void Expressible::CheckUnlisted(const Instance& instance, const Pin& pin) const {
    if (IsOnPort(*pin.GetSignal())) {
        FailToExpress("pin",
                      std::string(instance.GetNameView()).append(".").append(pin.GetNameView()),
                      "a port to which it is connected does not list it");
    }
}

} // namespace Orn_Hdl::Script
