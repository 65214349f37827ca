#include "Legal/Namer.h"

#include "Check/Identifier.h"
#include "Check/ReservedWords.h"
#include "HdlModel/Names/Names.h"
#include "Legal/Identifiers.h"
#include "Port/Ascii.h"
#include "Writers/Text.h"

#include <algorithm>
#include <tuple>

namespace Orn_Hdl::Legal {

using Checking::Lower;
using std::string_view;

namespace {

/// The lower number keeps a name that two have.
enum Rank { OfComponent, OfPort, OfModuleAttribute, OfAttribute, OfSignal, OfInstance };

string_view BaseOf(const Object& object) {
    const string_view name = object.GetNameView();
    return object.GetObjectType() == ObjectTypeSignal ? Names::BaseName(name) : name;
}

/// Whether the language takes the name as it stands.
bool IsFine(string_view name, Language language) {
    const Checking::Identifier form(name);
    const bool isVhdl = language == Language::Vhdl;
    const Check::Verdicts reserved =
        Checking::FindReserved(isVhdl ? string_view() : name, isVhdl ? name : string_view());
    return (isVhdl ? form.isVhdl && form.hasProperUnderscores : form.isVerilog) &&
           reserved.GetWorst() <= Check::Verdict::Warns;
}

/// Whether the attribute of primitives that the VHDL writer makes, whose name cannot change, is
/// the one of a declared name.
bool IsBoxType(const std::string& name, const Check::Cause& cause) {
    return name == "box_type" && !Port::EqualIgnoringCase(cause.second, name);
}

} // namespace

void Namer::NameAll() {
    ClaimBoxType();
    ClaimComponents();
    ClaimSignals(true, false);
    ClaimSignals(true, true);
    ClaimModuleAttributes();
    ClaimAttributes();
    ClaimSignals(false, false);
    ClaimSignals(false, true);
    ClaimInstances();
    FindTakenGenerics();
    BlockNames();
    NameChanging();
    NameDesign();
    NamePins();
    NameAttributes();
    NameInner();
    NameOpen();
    NameMade();
}

void Namer::ClaimOrChange(int rank, string_view whole, const Object& object, char initial) {
    const string_view name = BaseOf(object);
    if (faulty_.objects.count(&object) != 0 || !scope_.Claim(name)) {
        changing_.push_back({rank, name, whole, &object, initial});
    }
}

void Namer::ClaimBoxType() {
    const auto boxType = context_.declaredAttributes.find("box_type");
    if (boxType != context_.declaredAttributes.end() &&
        IsBoxType(boxType->first, boxType->second)) {
        scope_.Claim(boxType->first);
    }
}

void Namer::ClaimComponents() {
    for (const Component* component : context_.netlist.GetComponentIterator()) {
        if (plan_.IsUsed(*component)) {
            ClaimOrChange(OfComponent, component->GetNameView(), *component, 'c');
        }
    }
}

void Namer::ClaimSignals(bool ports, bool buses) {
    for (const Signal* signal : context_.netlist.GetSignalIterator()) {
        const bool isBus = signal->GetSignalType() == SignalTypeBus;
        if (signal->IsNeededToDeclared() && signal->IsPort() == ports && isBus == buses &&
            !plan_.IsNothing(*signal)) {
            ClaimOrChange(ports ? OfPort : OfSignal, signal->GetNameView(), *signal,
                          ports ? 'p' : 'n');
        }
    }
}

void Namer::ClaimModuleAttributes() {
    for (const Attribute* attribute : context_.netlist.GetAttrIterator()) {
        if (IsGeneric(*attribute)) {
            ClaimOrChange(OfModuleAttribute, attribute->GetNameView(), *attribute, 'g');
        }
    }
}

/// Only attributes that VHDL declares share a scope with the rest.
void Namer::ClaimAttributes() {
    for (const auto& [name, cause] : context_.declaredAttributes) {
        if (!IsBoxType(name, cause) && faulty_.attributes.count(name) == 0 && !scope_.Claim(name)) {
            faulty_.attributes.insert(name);
        }
    }
}

void Namer::ClaimInstances() {
    for (const Instance* instance : context_.netlist.GetInstanceIterator()) {
        ClaimOrChange(OfInstance, instance->GetNameView(), *instance, 'u');
    }
}

/// A generic cannot bear the name of a pin of its component.
void Namer::FindTakenGenerics() {
    const auto find = [this](const AttributeHolder& holder, const Component& component) {
        for (const Attribute* attribute : holder.GetAttrIterator()) {
            if (!IsGeneric(*attribute)) {
                continue;
            }
            for (const Pin* pin : component.GetPinIterator()) {
                if (Port::EqualIgnoringCase(Writers::GetBaseName(*pin), attribute->GetNameView())) {
                    faulty_.generics.insert(Lower(attribute->GetNameView()));
                }
            }
        }
    };
    for (const Component* component : context_.netlist.GetComponentIterator()) {
        if (plan_.IsUsed(*component)) {
            find(*component, *component);
        }
    }
    for (const Instance* instance : context_.netlist.GetInstanceIterator()) {
        if (instance->HasAttrs() && instance->GetComponent() != nullptr) {
            find(*instance, *instance->GetComponent());
        }
    }
}

/// What changes gets none of these names.
void Namer::BlockNames() {
    scope_.Claim(context_.netlist.GetNameView());
    for (const std::string& type : context_.usedTypes) {
        scope_.Claim(type);
    }
    for (const Changing& changing : changing_) {
        if (changing.object == nullptr || faulty_.escapable.count(changing.object) == 0 ||
            !context_.options.escapeNames) {
            scope_.Claim(changing.name);
        }
    }
    for (const Attribute* attribute : context_.netlist.GetAttrIterator()) {
        pinsAndAttributes_.Claim(attribute->GetNameView());
    }
    const auto claimAll = [this](const AttributeHolder& holder) {
        for (const Attribute* attribute : holder.GetAttrIterator()) {
            pinsAndAttributes_.Claim(attribute->GetNameView());
        }
    };
    for (const Signal* signal : context_.netlist.GetSignalIterator()) {
        claimAll(*signal);
    }
    for (const Instance* instance : context_.netlist.GetInstanceIterator()) {
        claimAll(*instance);
    }
    for (const Component* component : context_.netlist.GetComponentIterator()) {
        claimAll(*component);
        for (const Pin* pin : component->GetPinIterator()) {
            pinsAndAttributes_.Claim(Writers::GetBaseName(*pin));
        }
    }
}

/// Whether the name is escaped instead of changed. The configuration joins the names of the
/// components and of the design with others, so they cannot be escaped there.
bool Namer::Escapes(const Changing& changing) {
    const Object& object = *changing.object;
    const bool isJoined = object.GetObjectType() == ObjectTypeComponent &&
                          !context_.options.vhdl.suppressConfiguration;
    const bool isBus = object.GetObjectType() == ObjectTypeSignal &&
                       static_cast<const Signal&>(object).GetSignalType() == SignalTypeBus;
    NewName escaped;
    if (!context_.options.escapeNames || isJoined || isBus ||
        faulty_.escapable.count(&object) == 0 ||
        !Escape(changing.name, escaped.verilog, escaped.vhdl) || !scope_.Claim(changing.name)) {
        return false;
    }
    for (std::string* name : {&escaped.verilog, &escaped.vhdl}) {
        const bool isVhdl = name == &escaped.vhdl;
        if (IsFine(changing.name, isVhdl ? Language::Vhdl : Language::Verilog)) {
            *name = changing.name;
        }
    }
    names_.objects[&object] = std::move(escaped);
    return true;
}

void Namer::NameChanging() {
    std::sort(changing_.begin(), changing_.end(), [](const Changing& a, const Changing& b) {
        return std::tie(a.rank, a.name, a.whole) < std::tie(b.rank, b.name, b.whole);
    });
    for (const Changing& changing : changing_) {
        if (!Escapes(changing)) {
            const std::string name =
                scope_.ClaimSimilar(MakeSimilar(changing.name, changing.initial, LongestName));
            names_.objects[changing.object] = {name, name};
        }
    }
}

void Namer::NameDesign() {
    if (faulty_.objects.count(&context_.netlist) != 0) {
        const std::string name = scope_.ClaimSimilar(
            MakeSimilar(context_.netlist.GetNameView(), 'm', LongestDesignName));
        names_.objects[&context_.netlist] = {name, name};
    }
}

void Namer::NamePins() {
    for (const Component* component : context_.netlist.GetComponentIterator()) {
        if (plan_.IsUsed(*component)) {
            NamePinsOf(*component);
        }
    }
}

/// Of pins with one name, buses and then whole pins keep it rather than bits.
void Namer::NamePinsOf(const Component& component) {
    std::vector<const Pin*> pins;
    for (const Pin* pin : component.GetPinIterator()) {
        pins.push_back(pin);
    }
    const auto rank = [](const Pin& pin) {
        return pin.GetPinType() == PinTypeBus ? 0 : pin.GetPinType() == PinTypeScalar ? 1 : 2;
    };
    std::sort(pins.begin(), pins.end(), [&](const Pin* a, const Pin* b) {
        return std::make_tuple(rank(*a), a->GetNameView()) <
               std::make_tuple(rank(*b), b->GetNameView());
    });
    Scope scope;
    std::vector<const Pin*> changing;
    for (const Pin* pin : pins) {
        if (faulty_.objects.count(pin) != 0 || !scope.Claim(Writers::GetBaseName(*pin))) {
            changing.push_back(pin);
        }
    }
    for (const Attribute* attribute : component.GetAttrIterator()) {
        scope.Claim(attribute->GetNameView());
    }
    for (const Pin* pin : changing) {
        const string_view base = Writers::GetBaseName(*pin);
        NewName escaped;
        const bool isEscaped = context_.options.escapeNames && faulty_.escapable.count(pin) != 0 &&
                               pin->GetPinType() != PinTypeBus &&
                               Escape(base, escaped.verilog, escaped.vhdl) && scope.Claim(base);
        if (!isEscaped) {
            scope.Claim(base);
            escaped.verilog = scope.ClaimSimilar(MakeSimilar(base, 'p', LongestName));
            escaped.vhdl = escaped.verilog;
        } else {
            escaped.verilog = IsFine(base, Language::Verilog) ? std::string(base) : escaped.verilog;
            escaped.vhdl = IsFine(base, Language::Vhdl) ? std::string(base) : escaped.vhdl;
        }
        names_.objects[pin] = std::move(escaped);
    }
}

void Namer::NameAttributes() {
    const auto nameAll = [this](const std::unordered_set<std::string>& faulty,
                                std::unordered_map<std::string, NewName>& names) {
        std::vector<string_view> sorted(faulty.begin(), faulty.end());
        std::sort(sorted.begin(), sorted.end());
        for (const string_view old : sorted) {
            const std::string name =
                scope_.ClaimSimilar(MakeSimilar(old, 'a', LongestName), &pinsAndAttributes_);
            names[std::string(old)] = {name, name};
        }
    };
    nameAll(faulty_.attributes, names_.attributes);
    nameAll(faulty_.generics, names_.generics);
}

/// The new name of an object, or its old one, as a part of another name.
std::string Namer::SpellNew(const Object& object, string_view old) const {
    const auto found = names_.objects.find(&object);
    const string_view name = found == names_.objects.end() || found->second.verilog.front() == '\\'
                                 ? old
                                 : string_view(found->second.verilog);
    return std::string(name);
}

void Namer::NameInner() {
    for (auto& [signal, name] : names_.inner) {
        made_.push_back({Names::DummyOf(SpellNew(*signal, BaseOf(*signal))), &name});
    }
}

void Namer::NameOpen() {
    const auto want = [this](const Instance& instance, const Pin& pin, std::string& name) {
        // The pins that were named are the component's.
        const Component* const component = instance.GetComponent();
        const Pin* const named =
            component == nullptr ? nullptr : component->GetPin(pin.GetNameView());
        made_.push_back({SpellNew(instance, instance.GetNameView()) + "_" +
                             SpellNew(named == nullptr ? pin : *named, Writers::GetBaseName(pin)) +
                             "_openSignal",
                         &name});
    };
    if (!names_.open.empty()) {
        for (const Instance* instance : context_.netlist.GetInstanceIterator()) {
            for (const Pin* pin : instance->GetPinIterator()) {
                const auto found = names_.open.find(pin);
                if (found != names_.open.end()) {
                    want(*instance, *pin, found->second);
                }
            }
        }
    }
    for (auto& [instance, pins] : names_.late) {
        for (auto& [pin, name] : pins) {
            want(*instance, *pin, name);
        }
    }
    std::vector<std::pair<string_view, std::vector<std::string>*>> compounds;
    for (auto& [compound, parts] : names_.parts) {
        compounds.emplace_back(compound->GetNameView(), &parts);
    }
    std::sort(compounds.begin(), compounds.end());
    for (const auto& [name, parts] : compounds) {
        for (std::string& part : *parts) {
            part = scope_.ClaimSimilar("openSignal");
        }
    }
}

void Namer::NameMade() {
    std::stable_sort(made_.begin(), made_.end(),
                     [](const Made& a, const Made& b) { return a.wanted < b.wanted; });
    for (const Made& made : made_) {
        *made.name = scope_.ClaimSimilar(MakeSimilar(made.wanted, 'n', LongestName));
    }
}

} // namespace Orn_Hdl::Legal
