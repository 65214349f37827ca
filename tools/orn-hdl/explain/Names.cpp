// Names that are taken, and names of nothing.
#include "explain/Additions.h"
#include "explain/Failure.h"

#include "Port/Ascii.h"
#include "diagnostics/NameKey.h"
#include "diagnostics/Nearest.h"

#include <algorithm>
#include <cstddef>

namespace Tool::Explain {

using Orn_Hdl::Component;
using Orn_Hdl::Instance;
using Orn_Hdl::Netlist;
using Orn_Hdl::Pin;
using Orn_Hdl::Signal;
using std::string_view;

namespace {

/// A list of pins that is longer says little.
constexpr std::size_t MostPins = 8;

const Netlist& GetNetlist(const Failure& failure) {
    return *failure.model.GetNetlist();
}

string_view GetKindName(ObjectKind kind) {
    switch (kind) {
    case ObjectKind::Component:
        return "component";
    case ObjectKind::Instance:
        return "instance";
    case ObjectKind::Pin:
        return "pin";
    default:
        return "signal";
    }
}

std::string WithArticle(ObjectKind kind) {
    return std::string(kind == ObjectKind::Instance ? "an " : "a ").append(GetKindName(kind));
}

/// What has a name, if anything has.
std::optional<ObjectKind> FindKind(const Netlist& netlist, string_view name) {
    if (netlist.GetComponent(name) != nullptr) {
        return ObjectKind::Component;
    }
    if (netlist.GetInstance(name) != nullptr) {
        return ObjectKind::Instance;
    }
    if (netlist.GetSignal(name) != nullptr) {
        return ObjectKind::Signal;
    }
    return std::nullopt;
}

/// The name as it was added.
string_view GetStoredName(const Netlist& netlist, ObjectKind kind, string_view name) {
    switch (kind) {
    case ObjectKind::Component:
        return netlist.GetComponent(name)->GetNameView();
    case ObjectKind::Instance:
        return netlist.GetInstance(name)->GetNameView();
    default:
        return netlist.GetSignal(name)->GetNameView();
    }
}

template <class Objects> std::string GetNearestName(string_view name, const Objects& objects) {
    NearestWord nearest(name);
    for (const auto* object : objects) {
        nearest.Consider(object->GetNameView());
    }
    return nearest.Get();
}

/// The object of a kind whose name is most like a name; empty if there is none.
std::string FindNearest(const Failure& failure, ObjectKind kind, string_view name) {
    if (!failure.maySearch) {
        return {};
    }
    const Netlist& netlist = GetNetlist(failure);
    switch (kind) {
    case ObjectKind::Component:
        return GetNearestName(name, netlist.GetComponentIterator());
    case ObjectKind::Instance:
        return GetNearestName(name, netlist.GetInstanceIterator());
    default:
        return GetNearestName(name, netlist.GetSignalIterator());
    }
}

std::optional<Addition> Find(const Failure& failure, ObjectKind kind, string_view name,
                             string_view owner = {}) {
    return failure.maySearch ? FindAddition(failure.lines, kind, name, owner) : std::nullopt;
}

/// Says that something is a thing of that kind, and where it was added.
void SayWhatItIs(const Failure& failure, ObjectKind kind, string_view name,
                 Explanation& explanation) {
    std::string text = Show(name) + " is " + WithArticle(kind);
    const auto addition = Find(failure, kind, name);
    if (addition && addition->line < failure.line) {
        explanation.SayAt(text + (addition->isFirstUse ? ", first used here" : ", added here"),
                          addition->line, addition->mark);
        if (addition->isFirstUse) {
            explanation.Say("the first use of a signal adds it; declare it before");
        }
    } else {
        explanation.Say(text);
    }
}

/// Says of something that does not exist that a later line adds it. \return whether one does.
bool SayIfAddedLater(const Failure& failure, ObjectKind kind, string_view name,
                     Explanation& explanation) {
    const auto addition = Find(failure, kind, name);
    const bool isLater = addition && addition->line > failure.line && !addition->isFirstUse;
    if (isLater) {
        explanation.SayAt(Show(name) + " is added only here", addition->line, addition->mark);
    }
    return isLater;
}

void MarkArgument(const Failure& failure, string_view name, Explanation& explanation) {
    if (const int index = failure.FindArgument(name); index >= 0) {
        explanation.mark = Mark::Word(index);
    }
}

/// Says what has a name, or which line will add it, or what the user may have meant.
void SayMissing(const Failure& failure, ObjectKind kind, string_view name,
                Explanation& explanation) {
    const auto found = FindKind(GetNetlist(failure), name);
    if (found && *found != kind) {
        SayWhatItIs(failure, *found, name, explanation);
        return;
    }
    if (SayIfAddedLater(failure, kind, name, explanation)) {
        return;
    }
    const std::string nearest = FindNearest(failure, kind, name);
    std::string text = "there is no " + std::string(GetKindName(kind)) + " " + Show(name);
    if (!nearest.empty()) {
        text.append("; did you mean ").append(Show(nearest)).append("?");
    }
    explanation.Say(std::move(text));
}

/// "u1 (AND2)"
std::string ShowInstance(const Instance& instance) {
    return Show(instance.GetNameView()) + " (" + Show(instance.GetComponentName().GetView()) + ")";
}

std::string ShowOwner(const Instance& instance) {
    return ShowInstance(instance);
}

std::string ShowOwner(const Component& component) {
    return Show(component.GetNameView());
}

/// "u1 (AND2) has the pins A, B and Y"; empty for many pins.
template <class Owner> std::string DescribePins(const Owner& owner) {
    std::vector<std::string> names;
    for (const Pin* pin : owner.GetPinIterator()) {
        if (names.size() == MostPins) {
            return {};
        }
        names.push_back(Show(pin->GetNameView()));
    }
    return ShowOwner(owner) +
           (names.empty()       ? " has no pins"
            : names.size() == 1 ? " has the pin "
                                : " has the pins ") +
           JoinChoices(names, "and");
}

std::string GetBase(string_view name) {
    const std::string key = GetNameKey(name);
    return key.substr(0, key.find('('));
}

template <class Owner> const Pin* FindPinOfBase(const Owner& owner, string_view name) {
    const std::string base = GetBase(name);
    for (const Pin* pin : owner.GetPinIterator()) {
        if (GetBase(pin->GetNameView()) == base) {
            return pin;
        }
    }
    return nullptr;
}

/// Says which pin was meant, or which pins there are.
template <class Owner>
void SayPins(const Owner& owner, string_view name, Explanation& explanation) {
    if (const Pin* pin = FindPinOfBase(owner, name)) {
        explanation.Say(ShowOwner(owner) + " has the pin " + Show(pin->GetNameView()));
        return;
    }
    const std::string nearest = GetNearestName(name, owner.GetPinIterator());
    if (!nearest.empty()) {
        Suggest(nearest, explanation);
    } else if (std::string pins = DescribePins(owner); !pins.empty()) {
        explanation.Say(std::move(pins));
    }
}

/// Whether a pin was added to a component after the instance, which then does not have it.
bool SayIfPinIsNew(const Instance& instance, string_view name, Explanation& explanation) {
    const Component* const component = instance.GetComponent();
    if (component == nullptr || component->GetPin(name) == nullptr) {
        return false;
    }
    explanation.Say("the pin was added to " + Show(component->GetNameView()) + " after " +
                    Show(instance.GetNameView()) + ", which does not have it");
    return true;
}

/// The two parts of "owner.pin".
struct PinPath {
    string_view owner;
    string_view pin;
    bool isPath = false;

    explicit PinPath(string_view text) : owner(text) {
        if (const std::size_t dot = text.find('.'); dot != string_view::npos) {
            owner = text.substr(0, dot);
            pin = text.substr(dot + 1);
            isPath = true;
        }
    }
};

/// The word that names a pin, by the catalogue; -1 if the phrase has none.
int FindPinWord(const Failure& failure) {
    for (const char* argument : {"<signal|instance.pin>", "<component.pin>", "<instance.pin>"}) {
        if (const int place = failure.phrase->FindArgument(argument); place >= 0) {
            return place;
        }
    }
    return -1;
}

/// Whether the pins of a phrase are those of components.
bool IsOfComponents(const Failure& failure) {
    return failure.phrase->FindArgument("<component.pin>") >= 0;
}

/// Says in which order the names of a line stand if the first two are in the other one.
void SayOrder(const Failure& failure, Explanation& explanation) {
    explanation.Say("the order is " + std::string(failure.phrase->info->phrase) + " " +
                    failure.phrase->info->arguments);
}

bool IsComponent(const Failure& failure, string_view name) {
    return GetNetlist(failure).GetComponent(name) != nullptr;
}

} // namespace

void ExplainTaken(string_view name, const Failure& failure, Explanation& explanation) {
    MarkArgument(failure, name, explanation);
    const Netlist& netlist = GetNetlist(failure);
    const auto kind = FindKind(netlist, name);
    if (!kind) {
        // The base name of a bus is taken.
        if (const Signal* bus = netlist.GetParentBus(std::string(name).c_str())) {
            SayWhatItIs(failure, ObjectKind::Signal, bus->GetNameView(), explanation);
        }
        return;
    }
    const int place = failure.phrase->CountWords();
    const string_view stored = GetStoredName(netlist, *kind, name);
    SayWhatItIs(failure, *kind, stored, explanation);
    if (stored != name && Port::EqualIgnoringCase(stored, name)) {
        explanation.Say("names are case-insensitive");
    }
    const bool isInstance = failure.phrase->FindArgument("<instance>") == place + 1;
    if (isInstance && *kind == ObjectKind::Component &&
        !IsComponent(failure, failure.GetWord(place))) {
        SayOrder(failure, explanation);
    }
    if (*kind == ObjectKind::Instance &&
        failure.phrase->FindArgument("<signal|instance.pin>") > 0) {
        explanation.Say("a pin is written as <instance.pin>");
        if (const std::string pins = DescribePins(*netlist.GetInstance(name)); !pins.empty()) {
            explanation.Say(pins);
        }
    }
}

void ExplainTakenPin(const Failure& failure, Explanation& explanation) {
    const int place = failure.phrase->CountWords();
    const string_view component = failure.GetWord(place);
    const string_view pin = failure.GetWord(place + 1);
    explanation.mark = Mark::Word(place + 1);
    const auto addition = Find(failure, ObjectKind::Pin, pin, component);
    if (addition && addition->line < failure.line) {
        explanation.SayAt(Show(pin) + " was added here", addition->line, addition->mark);
    }
}

void ExplainComponent(string_view name, const Failure& failure, Explanation& explanation) {
    const int place = failure.phrase->CountWords();
    explanation.mark = Mark::Word(place);
    if (IsComponent(failure, failure.GetWord(place + 1))) {
        explanation.Say(Show(failure.GetWord(place + 1)) + " is a component");
        SayOrder(failure, explanation);
        return;
    }
    SayMissing(failure, ObjectKind::Component, name, explanation);
}

void ExplainSignal(string_view name, const Failure& failure, Explanation& explanation) {
    const int first = failure.phrase->CountWords();
    const int place = FindPinWord(failure);
    const PinPath path(failure.GetWord(place));
    if (!path.isPath || GetNameKey(path.owner) != GetNameKey(name)) {
        // A bit of a bus that does not exist.
        MarkArgument(failure, name, explanation);
        explanation.Say("there is no bus " + Show(GetBase(name)) +
                        " yet; add it first, with a range such as " + Show(GetBase(name)) +
                        "(7:0)");
        return;
    }
    explanation.mark = Mark::Part(place, 0, path.owner.size());
    const PinPath other(failure.GetWord(first));
    if (place > first && other.isPath && GetNetlist(failure).GetInstance(other.owner) != nullptr) {
        explanation.Say(Show(failure.GetWord(first)) + " is a pin");
        SayOrder(failure, explanation);
        return;
    }
    SayMissing(failure, ObjectKind::Instance, path.owner, explanation);
}

void ExplainPin(const Failure& failure, Explanation& explanation) {
    const int place = FindPinWord(failure);
    const PinPath path(failure.GetWord(place));
    const Netlist& netlist = GetNetlist(failure);
    const Component* const component =
        IsOfComponents(failure) ? netlist.GetComponent(path.owner) : nullptr;
    const Instance* const instance =
        IsOfComponents(failure) ? nullptr : netlist.GetInstance(path.owner);
    if (component == nullptr && instance == nullptr) {
        explanation.mark = Mark::Part(place, 0, path.owner.size());
        SayMissing(failure, IsOfComponents(failure) ? ObjectKind::Component : ObjectKind::Instance,
                   path.owner, explanation);
        return;
    }
    explanation.mark = Mark::Part(place, path.owner.size() + 1);
    if (component != nullptr) {
        SayPins(*component, path.pin, explanation);
    } else if (!SayIfPinIsNew(*instance, path.pin, explanation)) {
        SayPins(*instance, path.pin, explanation);
    }
}

void ExplainOwner(string_view name, const Failure& failure, Explanation& explanation) {
    explanation.mark = Mark::Word(failure.phrase->CountWords());
    const ObjectKind kind = failure.phrase->FindArgument("<component>") >= 0 ? ObjectKind::Component
                            : failure.phrase->FindArgument("<instance>") >= 0 ? ObjectKind::Instance
                                                                              : ObjectKind::Signal;
    SayMissing(failure, kind, name, explanation);
}

} // namespace Tool::Explain
