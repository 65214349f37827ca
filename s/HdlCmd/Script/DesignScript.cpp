#include "HdlCmd/Script/DesignScript.h"

#include "HdlCmd/Script/HolderScript.h"
#include "HdlCmd/Script/PinConstants.h"
#include "HdlCmd/Script/Values.h"
#include "HdlModel/Names/Names.h"
#include "HdlModel/Objects/ObjectDetails.h"
#include "HdlModel/Signals/PinLinks.h"
#include "HdlModel/Signals/SignalCast.h"

#include <vector>

namespace Orn_Hdl::Script {

namespace {

bool IsBare(const Object& object, const AttributeHolder& attributes) {
    return object.GetCommentView().empty() && !attributes.HasAttrs();
}

/// The slices that are as wide as the bus. Each was the bus before a use of the next one's name put
/// that in its place; they stand first in the list of slices, the last one first.
std::vector<const Signal*> GetFormerBuses(const Bus& bus) {
    std::vector<const Signal*> former;
    for (const Signal* part : bus.GetBusSliceIterator()) {
        if (As<BusSlice>(part) == nullptr || part->GetWidth() != bus.GetWidth()) {
            break;
        }
        former.push_back(part);
    }
    return former;
}

/// The commands read what precedes the first point as the name of an instance.
void RequireNoPoint(std::string_view kind, std::string_view name) {
    if (name.find('.') != std::string_view::npos) {
        FailToExpress(kind, name, "its name has a point, so that a command takes it for a pin's");
    }
}

} // namespace

DesignScript::DesignScript(const Netlist& netlist, Lines& lines)
    : netlist_(netlist), lines_(lines), phrases_(Phrases::Get()), settled_(netlist),
      stages_(netlist, settled_), expressible_(netlist) {}

void DesignScript::Write() {
    WriteHolder({phrases_.module, netlist_, netlist_, false, {}}, lines_);
    for (const Component* component : netlist_.GetComponentIterator()) {
        WriteComponent(*component);
    }
    WriteSignals();
    if (stages_.HasEarly()) {
        for (const Component* component : netlist_.GetComponentIterator()) {
            for (const InstanceStages::Early& early : stages_.GetEarly(*component)) {
                WriteConnections(*early.instance);
            }
        }
    }
    for (const Instance* instance : netlist_.GetInstanceIterator()) {
        if (!stages_.IsEarly(*instance)) {
            AddInstance(*instance);
            WriteConnections(*instance);
        }
    }
    WriteAllAliases();
}

void DesignScript::WriteComponent(const Component& component) {
    if (lines_.IsTrial()) {
        expressible_.Check(component);
    }
    const std::string_view name = component.GetNameView();
    lines_.Write(phrases_.addComponent, {name});
    WriteHolder({phrases_.component, component, component, true, name}, lines_);
    const std::vector<InstanceStages::Early>& early = stages_.GetEarly(component);
    auto next = early.begin();
    int count = 0;
    for (const Pin* pin : component.GetPinIterator()) {
        for (; next != early.end() && next->pinCount == count; ++next) {
            AddInstance(*next->instance);
        }
        ++count;
        const char* const direction = pin->GetPolarityName();
        const BitVectorValue& value = pin->GetDefaultValue();
        if (value.GetValue().IsEmpty()) {
            lines_.Write(phrases_.addPin, {name, pin->GetNameView(), direction});
        } else {
            lines_.Write(phrases_.addPin, {name, pin->GetNameView(), direction, GetText(value)});
        }
        WritePinHolder(phrases_.componentPin, name, *pin);
    }
    for (; next != early.end(); ++next) {
        AddInstance(*next->instance);
    }
}

void DesignScript::AddInstance(const Instance& instance) {
    if (lines_.IsTrial()) {
        expressible_.Check(instance);
    }
    lines_.Write(phrases_.addInstance,
                 {instance.GetComponent()->GetNameView(), instance.GetNameView()});
}

void DesignScript::WriteConnections(const Instance& instance) {
    WriteHolder({phrases_.instance, instance, instance, true, instance.GetNameView()}, lines_);
    // A write sorts the pins of instances, but not those of components.
    Iterator<Pin*> own = instance.GetPinIterator();
    for (const Pin* declared : instance.GetComponent()->GetPinIterator()) {
        const Pin* pin = own.GetCurrent();
        if (pin == nullptr || pin->GetNameView() != declared->GetNameView()) {
            pin = instance.GetPin(declared->GetNameView());
        }
        own.Next();
        if (pin == nullptr) {
            break;
        }
        if (pin->GetSignal() != nullptr) {
            WritePin(instance, *pin);
        }
        WritePinHolder(phrases_.instancePin, instance.GetNameView(), *pin);
    }
}

void DesignScript::WritePin(const Instance& instance, const Pin& pin) {
    if (lines_.IsTrial()) {
        RequireNoPoint("instance", instance.GetNameView());
        expressible_.CheckHeld(*pin.GetSignal());
    }
    if (PinLinks::IsListed(pin)) {
        const std::string name = settled_.GetName(settled_.GetCarrier(*pin.GetSignal()));
        lines_.Write(phrases_.connectSignal, {name, PinPath(instance.GetNameView(), pin)});
    } else {
        WriteUnlisted(instance, pin);
    }
}

/// A constant at a pin makes such a connection. Any other is said as one that is listed, which
/// shows only at a port.
void DesignScript::WriteUnlisted(const Instance& instance, const Pin& pin) {
    const Signal& signal = *pin.GetSignal();
    const std::string& path = PinPath(instance.GetNameView(), pin);
    if (PinConstants::IsOf(instance, pin, signal)) {
        lines_.Write(phrases_.assignConstant, {path, GetText(settled_.GetConstant({&signal}))});
        return;
    }
    if (lines_.IsTrial()) {
        expressible_.CheckUnlisted(instance, pin);
    }
    lines_.Write(phrases_.connectSignal, {settled_.GetName({&signal}), path});
}

void DesignScript::WritePinHolder(const HolderPhrases& phrases, std::string_view owner,
                                  const Pin& pin) {
    if (!IsBare(pin, pin)) {
        RequireNoPoint("owner", owner);
        WriteHolder({phrases, pin, pin, true, PinPath(owner, pin)}, lines_);
    }
}

void DesignScript::WriteSignals() {
    for (const Signal* signal : netlist_.GetSignalIterator()) {
        if (signal->IsNeededToDeclared()) {
            if (lines_.IsTrial()) {
                expressible_.CheckDeclared(*signal);
            }
            if (!PinConstants::IsSaidByPin(netlist_, *signal)) {
                WriteDeclared(*signal);
            }
        } else if (lines_.IsTrial() && As<BusPart>(signal) != nullptr) {
            expressible_.CheckHasBus(*signal);
        }
    }
    for (const Signal* signal : netlist_.GetSignalIterator()) {
        if (const auto* compound = As<CompoundBus>(signal)) {
            WriteCompound(*compound);
        }
    }
}

void DesignScript::WriteDeclared(const Signal& signal) {
    if (const Bus* const bus = As<Bus>(&signal)) {
        WriteBus(*bus);
    } else {
        Declare(signal, signal.GetNameView());
        WriteConstant(signal);
        WriteSignalHolder(signal, signal.GetNameView());
    }
}

void DesignScript::WriteBus(const Bus& bus) {
    const std::vector<const Signal*> former = GetFormerBuses(bus);
    if (former.empty()) {
        Declare(bus, bus.GetNameView());
    } else {
        Declare(bus, former.back()->GetNameView());
        for (auto next = former.rbegin() + 1; next != former.rend(); ++next) {
            Use((*next)->GetNameView(), NoValue());
        }
        Use(bus.GetNameView(), NoValue());
    }
    WriteConstant(bus);
    WriteSignalHolder(bus, bus.GetNameView());
    std::size_t place = 0;
    settled_.ForEachPart(bus, [&](const SettledSignal& part) {
        const bool isFormer = place++ < former.size();
        if (lines_.IsTrial()) {
            if (!part.isDummyToCome) {
                expressible_.CheckPart(bus, *part.signal);
            }
            if (!isFormer && As<BusSlice>(part.signal) != nullptr &&
                part.signal->GetWidth() >= bus.GetWidth()) {
                FailToExpress("signal", part.signal->GetNameView(), "it is as wide as its bus");
            }
        }
        if (isFormer ? !settled_.GetConstant(part).GetValue().IsEmpty() ||
                           !IsBare(*part.signal, *part.signal)
                     : !AppearsByUse(part)) {
            WritePart(part);
        }
    });
}

/// \param name of the signal, or of the bus that it was first.
void DesignScript::Declare(const Signal& signal, std::string_view name) {
    const Polarity direction = signal.GetPortPolarity();
    if (direction.IsValid()) {
        lines_.Write(phrases_.addPort, {name, direction.GetValueName()});
    } else if (SpellsAnother(phrases_.addSignal, {name})) {
        Use(name, NoValue());
    } else {
        lines_.Write(phrases_.addSignal, {name});
    }
}

void DesignScript::WritePart(const SettledSignal& part) {
    const std::string name = settled_.GetName(part);
    Use(name, settled_.GetConstant(part));
    if (!part.isDummyToCome) {
        WriteSignalHolder(*part.signal, name);
    }
}

void DesignScript::WriteCompound(const CompoundBus& compound) {
    const SettledSignal settled{&compound};
    if (settled_.IsEmptied(compound)) {
        return;
    }
    const std::string name = settled_.GetName(settled);
    if (lines_.IsTrial()) {
        for (const Signal* member : compound.GetBusMemberIterator()) {
            expressible_.CheckHeld(*member);
        }
        if (name.empty() || !Names::IsCompound(name)) {
            FailToExpress("compound", compound.GetNameView(),
                          "no name of a compound names its members");
        }
        expressible_.CheckCompound(compound, name);
    }
    if (!AppearsByUse(settled)) {
        Use(name, settled_.GetConstant(settled));
        WriteSignalHolder(compound, name);
    }
}

/// Whether a slice, a bit or a compound is made by the connection of a pin, and nothing else is to
/// be said of it.
bool DesignScript::AppearsByUse(const SettledSignal& settled) const {
    const Signal& signal = *settled.signal;
    return settled_.HasListedPin(settled) && settled_.GetConstant(settled).GetValue().IsEmpty() &&
           (settled.isDummyToCome ||
            (IsBare(signal, signal) && PinLinks::GetUnlisted(signal).empty())) &&
           settled_.GetAliases(settled).empty();
}

/// A constant makes the signal that it is for, and an empty one is none.
void DesignScript::Use(std::string_view name, const BitVectorValue& constant) {
    RequireNoPoint("signal", name);
    lines_.Write(phrases_.assignConstant, {name, GetText(constant)});
}

void DesignScript::WriteConstant(const Signal& signal) {
    const BitVectorValue& constant = settled_.GetConstant({&signal});
    if (!constant.GetValue().IsEmpty()) {
        Use(signal.GetNameView(), constant);
    }
}

void DesignScript::WriteSignalHolder(const Signal& signal, std::string_view name) {
    WriteHolder({phrases_.signal, signal, signal, true, name}, lines_);
}

void DesignScript::WriteAllAliases() {
    for (const Signal* signal : netlist_.GetSignalIterator()) {
        if (signal->IsNeededToDeclared()) {
            WriteAliases({signal});
        }
        if (const Bus* const bus = As<Bus>(signal)) {
            settled_.ForEachPart(*bus, [this](const SettledSignal& part) { WriteAliases(part); });
        }
    }
    for (const Signal* signal : netlist_.GetSignalIterator()) {
        if (As<CompoundBus>(signal) != nullptr) {
            WriteAliases({signal});
        }
    }
}

void DesignScript::WriteAliases(const SettledSignal& settled) {
    for (const Signal* alias : settled_.GetAliases(settled)) {
        const std::string name = settled_.GetName({alias});
        if (lines_.IsTrial()) {
            expressible_.CheckHeld(*alias);
            RequireNoPoint("signal", name);
        }
        lines_.Write(phrases_.connectSignal, {settled_.GetName(settled), name});
    }
}

const std::string& DesignScript::PinPath(std::string_view owner, const Pin& pin) {
    pinPath_.assign(owner).append(".").append(pin.GetNameView());
    return pinPath_;
}

} // namespace Orn_Hdl::Script
