// Functions that change a design: what the commands do, and taking things away.
#include "Objects.h"

namespace Python {

namespace {

using Orn_Hdl::Model;

Ref Execute(ModelState& state, Arguments& arguments) {
    Model& model = state.Get();
    const char* const line = arguments.GetText(0);
    try {
        const Unlocked unlocked;
        model.Execute(line);
    } catch (...) {
        RethrowForCommand(line, {}, 0);
    }
    return Ref::None();
}

Ref AddComponent(ModelState& state, Arguments& arguments) {
    state.Get().AddComponent(arguments.GetText(0));
    return Ref::None();
}

/// Component, name, direction, default value.
Ref AddPin(ModelState& state, Arguments& arguments) {
    state.Get().AddPin(arguments.GetText(1), arguments.GetText(2), arguments.GetText(0),
                       arguments.GetText(3));
    return Ref::None();
}

/// Enters the pins of an instance where such a table is in use, so that it need not be made again.
void EnterPins(ModelState& state, const Orn_Hdl::Instance* instance) {
    if (instance != nullptr && !state.pinOwners.empty()) {
        for (const Orn_Hdl::Pin* const pin : instance->GetPinIterator()) {
            state.pinOwners.emplace(pin, instance);
        }
    }
}

/// Name, component.
Ref AddInstance(ModelState& state, Arguments& arguments) {
    Model& model = state.Get();
    model.AddInstance(arguments.GetText(0), arguments.GetText(1));
    if (!state.pinOwners.empty()) {
        EnterPins(state, model.GetInstance(arguments.GetText(0)));
    }
    return Ref::None();
}

Ref AddSignal(ModelState& state, Arguments& arguments) {
    state.Get().AddSignal(arguments.GetText(0));
    return Ref::None();
}

Ref AddPort(ModelState& state, Arguments& arguments) {
    state.Get().AddPort(arguments.GetText(0), arguments.GetText(1));
    return Ref::None();
}

/// Signal, instance, pin.
Ref Connect(ModelState& state, Arguments& arguments) {
    state.Get().ConnectSignalToPin(arguments.GetText(0), arguments.GetText(1),
                                   arguments.GetText(2));
    return Ref::None();
}

Ref AddAlias(ModelState& state, Arguments& arguments) {
    state.Get().ConnectSignals(arguments.GetText(0), arguments.GetText(1));
    return Ref::None();
}

Ref TieSignal(ModelState& state, Arguments& arguments) {
    state.Get().AssignConstantToSignal(arguments.GetText(0), arguments.GetText(1));
    return Ref::None();
}

/// Instance, pin, value.
Ref TiePin(ModelState& state, Arguments& arguments) {
    state.Get().AssignConstantToPin(arguments.GetText(0), arguments.GetText(1),
                                    arguments.GetText(2));
    return Ref::None();
}

/// Kind, name, new name.
Ref Rename(ModelState& state, Arguments& arguments) {
    Model& model = state.Get();
    const Kind kind = GetKind(arguments, 0);
    const char* const name = arguments.GetText(1);
    const char* const newName = arguments.GetText(2);
    if (kind == Kind::Component) {
        model.RenameComponent(name, newName);
    } else if (kind == Kind::Instance) {
        model.RenameInstance(name, newName);
    } else {
        model.RenameSignal(FindSignal(*model.GetNetlist(), kind, name).GetName(), newName);
    }
    return Ref::None();
}

/// Kind, name.
Ref Remove(ModelState& state, Arguments& arguments) {
    Model& model = state.Get();
    Orn_Hdl::Netlist& netlist = *model.GetNetlist();
    const Kind kind = GetKind(arguments, 0);
    const char* const name = arguments.GetText(1);
    if (kind == Kind::Component) {
        netlist.Remove(&FindComponent(netlist, name));
    } else if (kind == Kind::Instance) {
        Orn_Hdl::Instance& instance = FindInstance(netlist, name);
        for (const Orn_Hdl::Pin* const pin : instance.GetPinIterator()) {
            state.pinOwners.erase(pin);
        }
        netlist.Remove(&instance);
    } else {
        netlist.Remove(&FindSignal(netlist, kind, name));
    }
    model.SetModifiedFlag(true);
    return Ref::None();
}

/// Kind, owner, pin. A pin of a component goes with those of its instances.
Ref RemovePin(ModelState& state, Arguments& arguments) {
    Model& model = state.Get();
    Orn_Hdl::Netlist& netlist = *model.GetNetlist();
    const Kind kind = GetKind(arguments, 0);
    const char* const owner = arguments.GetText(1);
    Orn_Hdl::Pin& pin = FindPin(netlist, kind, owner, arguments.GetText(2));
    if (kind == Kind::ComponentPin) {
        state.pinOwners.clear();
        netlist.RemovePin(&FindComponent(netlist, owner), &pin);
    } else {
        state.pinOwners.erase(&pin);
        FindInstance(netlist, owner).RemovePin(&pin);
    }
    model.SetModifiedFlag(true);
    return Ref::None();
}

/// Instance, pin.
Ref Disconnect(ModelState& state, Arguments& arguments) {
    Model& model = state.Get();
    Orn_Hdl::Pin& pin =
        FindPin(*model.GetNetlist(), Kind::InstancePin, arguments.GetText(0), arguments.GetText(1));
    if (Orn_Hdl::Signal* const signal = pin.GetSignal()) {
        signal->Disconnect(&pin);
        model.SetModifiedFlag(true);
    }
    return Ref::None();
}

/// Kind and name of the first signal, kind and name of its alias.
Ref RemoveAlias(ModelState& state, Arguments& arguments) {
    Model& model = state.Get();
    const Orn_Hdl::Netlist& netlist = *model.GetNetlist();
    Orn_Hdl::Signal& first = FindSignal(netlist, GetKind(arguments, 0), arguments.GetText(1));
    first.Disconnect(&FindSignal(netlist, GetKind(arguments, 2), arguments.GetText(3)));
    model.SetModifiedFlag(true);
    return Ref::None();
}

Ref SetName(ModelState& state, Arguments& arguments) {
    Model& model = state.Get();
    model.SetName(arguments.GetText(0));
    model.SetModifiedFlag(true);
    return Ref::None();
}

Ref SetSourceFile(ModelState& state, Arguments& arguments) {
    state.Get().SetSourceFileName(arguments.GetText(0));
    return Ref::None();
}

/// Makes the netlist an empty one. Name and options stay.
Ref Clear(ModelState& state, Arguments& /*arguments*/) {
    Model& model = state.Get();
    Orn_Hdl::Netlist empty(model.GetName());
    state.ForgetObjects();
    *model.GetNetlist() = std::move(empty);
    model.SetModifiedFlag(true);
    return Ref::None();
}

/// Kind, name, direction; an empty one makes a signal that is no port.
Ref SetDirection(ModelState& state, Arguments& arguments) {
    Model& model = state.Get();
    Orn_Hdl::Signal& signal =
        FindSignal(*model.GetNetlist(), GetKind(arguments, 0), arguments.GetText(1));
    const std::string_view word = arguments.GetText(2);
    const std::optional<Orn_Hdl::Polarity> polarity =
        word.empty() ? Orn_Hdl::Polarity() : Orn_Hdl::Polarity::Parse(word);
    if (!polarity) {
        throw Failure{"library", "Invalid direction \"" + std::string(word) + "\".\n"};
    }
    signal.SetPortPolarity(*polarity);
    model.SetModifiedFlag(true);
    return Ref::None();
}

} // namespace

const std::vector<PyMethodDef> BuildingMethods = {
    Row<Execute, 1>("execute"),
    Row<AddComponent, 1>("add_component"),
    Row<AddPin, 4>("add_pin"),
    Row<AddInstance, 2>("add_instance"),
    Row<AddSignal, 1>("add_signal"),
    Row<AddPort, 2>("add_port"),
    Row<Connect, 3>("connect"),
    Row<AddAlias, 2>("add_alias"),
    Row<TieSignal, 2>("tie_signal"),
    Row<TiePin, 3>("tie_pin"),
    Row<Rename, 3>("rename"),
    Row<Remove, 2>("remove"),
    Row<RemovePin, 3>("remove_pin"),
    Row<Disconnect, 2>("disconnect"),
    Row<RemoveAlias, 4>("remove_alias"),
    Row<Clear, 0>("clear"),
    Row<SetName, 1>("set_name"),
    Row<SetSourceFile, 1>("set_source_file"),
    Row<SetDirection, 3>("set_direction"),
};

} // namespace Python
