// Functions that read a design.
#include "Objects.h"
#include "Walks.h"

#include "Port/Text.h"

namespace Python {

namespace {

using Orn_Hdl::Netlist;
using Orn_Hdl::Signal;

Ref GetName(ModelState& state, Arguments& /*arguments*/) {
    return MakeText(state.Get().GetName());
}

Ref GetSourceFile(ModelState& state, Arguments& /*arguments*/) {
    return MakeText(state.Get().GetSourceFileName());
}

Ref IsModified(ModelState& state, Arguments& /*arguments*/) {
    return MakeBool(state.Get().IsModified());
}

/// How many components, instances, signals, ports, pins and connected pins there are.
Ref Count(ModelState& state, Arguments& /*arguments*/) {
    const Netlist& netlist = state.GetNetlist();
    long long components = 0;
    for (const Orn_Hdl::Component* component : netlist.GetComponentIterator()) {
        components += component != nullptr ? 1 : 0;
    }
    long long instances = 0;
    long long pins = 0;
    long long connected = 0;
    for (const Orn_Hdl::Instance* instance : netlist.GetInstanceIterator()) {
        ++instances;
        for (const Orn_Hdl::Pin* pin : instance->GetPinIterator()) {
            ++pins;
            connected += pin->GetSignal() != nullptr ? 1 : 0;
        }
    }
    long long signals = 0;
    long long ports = 0;
    for (const Signal* signal : netlist.GetSignalIterator()) {
        const bool isDeclared = signal->IsNeededToDeclared();
        signals += isDeclared ? 1 : 0;
        ports += isDeclared && signal->IsPort() ? 1 : 0;
    }
    return MakeTuple(MakeInt(components), MakeInt(instances), MakeInt(signals), MakeInt(ports),
                     MakeInt(pins), MakeInt(connected));
}

/// How many objects of a kind there are.
Ref CountKind(ModelState& state, Arguments& arguments) {
    const Netlist& netlist = state.GetNetlist();
    const Kind kind = GetKind(arguments, 0);
    const bool portsOnly = arguments.GetBool(1);
    long long count = 0;
    if (kind == Kind::Component) {
        for ([[maybe_unused]] const auto* object : netlist.GetComponentIterator()) {
            ++count;
        }
    } else if (kind == Kind::Instance) {
        for ([[maybe_unused]] const auto* object : netlist.GetInstanceIterator()) {
            ++count;
        }
    } else {
        for (const Signal* signal : netlist.GetSignalIterator()) {
            count += signal->IsNeededToDeclared() && (!portsOnly || signal->IsPort()) ? 1 : 0;
        }
    }
    return MakeInt(count);
}

/// A signal by its name, or a bus by its base name; null when there is none.
const Signal* LookUpSignal(const Netlist& netlist, const char* name) {
    const Signal* const signal = netlist.GetSignal(name);
    return signal != nullptr ||
                   std::string_view(name).find_first_of("([{<") != std::string_view::npos
               ? signal
               : netlist.GetParentBus(name);
}

/// The name of the object of a kind as the design has it, and of a signal its class; None when
/// there is none.
Ref Find(ModelState& state, Arguments& arguments) {
    const Netlist& netlist = state.GetNetlist();
    const Kind kind = GetKind(arguments, 0);
    const char* const name = arguments.GetText(1);
    const Orn_Hdl::Object* object = nullptr;
    if (kind == Kind::Component) {
        object = netlist.GetComponent(name);
    } else if (kind == Kind::Instance) {
        object = netlist.GetInstance(name);
    } else if (const Signal* const signal = LookUpSignal(netlist, name)) {
        return DescribeSignal(*signal);
    }
    return object == nullptr ? Ref::None() : MakeTuple(MakeInt(0), MakeText(object->GetNameView()));
}

Ref GetComponentOf(ModelState& state, Arguments& arguments) {
    const Orn_Hdl::Instance& instance = FindInstance(state.GetNetlist(), arguments.GetText(0));
    const Orn_Hdl::Component* const component = instance.GetComponent();
    return component == nullptr ? Ref::None() : MakeText(component->GetNameView());
}

Ref MakePinNames(const Orn_Hdl::Iterator<Orn_Hdl::Pin*>& pins) {
    Ref list = MakeList();
    for (const Orn_Hdl::Pin* const pin : pins) {
        Append(list, MakeText(pin->GetNameView()));
    }
    return list;
}

/// Kind of pins, owner.
Ref GetPins(ModelState& state, Arguments& arguments) {
    const Netlist& netlist = state.GetNetlist();
    const char* const owner = arguments.GetText(1);
    return GetKind(arguments, 0) == Kind::ComponentPin
               ? MakePinNames(FindComponent(netlist, owner).GetPinIterator())
               : MakePinNames(FindInstance(netlist, owner).GetPinIterator());
}

/// The name of the pin that is found by a name, by its base name too; None when there is none.
/// Kind, owner, name.
Ref FindPinName(ModelState& state, Arguments& arguments) {
    const Netlist& netlist = state.GetNetlist();
    const char* const owner = arguments.GetText(1);
    const Port::String name(arguments.GetText(2));
    const bool isOfComponent = GetKind(arguments, 0) == Kind::ComponentPin;
    const auto find = [&](auto& holder) -> Ref {
        if (const Orn_Hdl::Pin* const pin = holder.GetPin(name.CStr())) {
            return MakeText(pin->GetNameView());
        }
        for (const Orn_Hdl::Pin* const pin : holder.GetPinIterator()) {
            if (pin->GetPinType() == Orn_Hdl::PinTypeBus &&
                Port::stricmp(pin->GetBaseName(), name) == 0) {
                return MakeText(pin->GetNameView());
            }
        }
        return Ref::None();
    };
    return isOfComponent ? find(FindComponent(netlist, owner)) : find(FindInstance(netlist, owner));
}

int GetWidthOf(const Orn_Hdl::Pin& pin) noexcept {
    const auto* const bus = dynamic_cast<const Orn_Hdl::BusPin*>(&pin);
    return bus == nullptr ? 1 : bus->GetWidth();
}

/// Name, direction, width, default value, and the signal or None. Kind, owner, name.
Ref DescribePin(ModelState& state, Arguments& arguments) {
    const Orn_Hdl::Pin& pin = FindPin(state.GetNetlist(), GetKind(arguments, 0),
                                      arguments.GetText(1), arguments.GetText(2));
    const Signal* const signal = pin.GetSignal();
    return MakeTuple(MakeText(pin.GetNameView()), MakeText(GetDirectionName(pin.GetPolarity())),
                     MakeInt(GetWidthOf(pin)), MakeText(pin.GetDefaultValue().GetValue()),
                     signal == nullptr ? Ref::None() : DescribeSignal(*signal));
}

Ref MakeRange(const Signal& signal) {
    const auto* const bus = dynamic_cast<const Orn_Hdl::Bus*>(&signal);
    int left = 0;
    int right = 0;
    if (bus == nullptr || !bus->GetIndex(left, right)) {
        return Ref::None();
    }
    return MakeTuple(MakeInt(left), MakeInt(right));
}

/// Class, name, width, direction, constant, and a bus's range or None. Kind, name.
Ref DescribeSignalFully(ModelState& state, Arguments& arguments) {
    const Signal& signal =
        FindSignal(state.GetNetlist(), GetKind(arguments, 0), arguments.GetText(1));
    return MakeTuple(MakeInt(signal.GetSignalType()), MakeText(signal.GetNameView()),
                     MakeInt(signal.GetWidth()),
                     MakeText(GetDirectionName(signal.GetPortPolarity())),
                     MakeText(SpellBitVector(signal.GetConstantValue())), MakeRange(signal));
}

/// Whether there is a signal. Kind, name.
Ref HasSignal(ModelState& state, Arguments& arguments) {
    const Netlist& netlist = state.GetNetlist();
    const char* const name = arguments.GetText(1);
    return MakeBool(GetKind(arguments, 0) == Kind::Bus ? netlist.GetParentBus(name) != nullptr
                                                       : netlist.GetSignal(name) != nullptr);
}

void EnterAllPins(PinOwners& owners, const Netlist& netlist) {
    for (const Orn_Hdl::Instance* const instance : netlist.GetInstanceIterator()) {
        for (const Orn_Hdl::Pin* const pin : instance->GetPinIterator()) {
            owners.emplace(pin, instance);
        }
    }
}

/// The pins at a signal as pairs of instance and pin. Kind, name.
Ref GetPinsOfSignal(ModelState& state, Arguments& arguments) {
    const Netlist& netlist = state.GetNetlist();
    const Signal& signal = FindSignal(netlist, GetKind(arguments, 0), arguments.GetText(1));
    Ref list = MakeList();
    for (const Orn_Hdl::Pin* const pin : signal.GetPinIterator()) {
        if (pin->GetSignal() != &signal) {
            continue;
        }
        auto owner = state.pinOwners.find(pin);
        if (owner == state.pinOwners.end()) {
            EnterAllPins(state.pinOwners, netlist);
            owner = state.pinOwners.find(pin);
        }
        if (owner != state.pinOwners.end()) {
            Append(list,
                   MakeTuple(MakeText(owner->second->GetNameView()), MakeText(pin->GetNameView())));
        }
    }
    return list;
}

Ref MakeSignalList(const Orn_Hdl::Iterator<Signal*>& signals) {
    Ref list = MakeList();
    for (const Signal* const signal : signals) {
        Append(list, DescribeSignal(*signal));
    }
    return list;
}

/// The signals that a signal lists: its aliases. Kind, name.
Ref GetAliases(ModelState& state, Arguments& arguments) {
    return MakeSignalList(
        FindSignal(state.GetNetlist(), GetKind(arguments, 0), arguments.GetText(1))
            .GetSignalIterator());
}

/// The slices and bits of a bus, or the members of a compound. Kind, name.
Ref GetParts(ModelState& state, Arguments& arguments) {
    const Signal& signal =
        FindSignal(state.GetNetlist(), GetKind(arguments, 0), arguments.GetText(1));
    if (const auto* const bus = dynamic_cast<const Orn_Hdl::Bus*>(&signal)) {
        return MakeSignalList(bus->GetBusSliceIterator());
    }
    if (const auto* const compound = dynamic_cast<const Orn_Hdl::CompoundBus*>(&signal)) {
        return MakeSignalList(compound->GetBusMemberIterator());
    }
    return MakeList();
}

/// Kind.
Ref WalkObjects(ModelState& state, Arguments& arguments) {
    return MakeWalk(state, GetKind(arguments, 0));
}

Ref WalkConnections(ModelState& state, Arguments& /*arguments*/) {
    return MakeConnectionWalk(state);
}

} // namespace

const std::vector<PyMethodDef> ReadingMethods = {
    Row<GetName, 0>("name"),
    Row<GetSourceFile, 0>("source_file"),
    Row<IsModified, 0>("is_modified"),
    Row<Count, 0>("counts"),
    Row<CountKind, 2>("count"),
    Row<Find, 2>("find"),
    Row<GetComponentOf, 1>("component_of"),
    Row<GetPins, 2>("pins"),
    Row<FindPinName, 3>("find_pin"),
    Row<DescribePin, 3>("pin"),
    Row<DescribeSignalFully, 2>("signal"),
    Row<HasSignal, 2>("has_signal"),
    Row<GetPinsOfSignal, 2>("pins_of_signal"),
    Row<GetAliases, 2>("aliases"),
    Row<GetParts, 2>("parts"),
    Row<WalkObjects, 1>("walk"),
    Row<WalkConnections, 0>("walk_connections"),
};

} // namespace Python
