#include "Legal/Copy.h"

#include "HdlModel/Names/Names.h"
#include "HdlModel/Objects/MakePacked.h"
#include "HdlModel/Signals/SignalCast.h"
#include "Legal/Values.h"
#include "Writers/Text.h"

#include <algorithm>
#include <memory>

namespace Orn_Hdl::Legal {

using std::string_view;

void Copier::CopyAll() {
    CopyDesign();
    CopyComponents();
    CopyDeclaredSignals();
    CopyParts();
    CopyCompounds();
    CopyConstants();
    CopyAliases();
    CopyInstances();
}

/// The name of what has no range.
std::string Copier::NameOf(const Object& object) const {
    const auto found = names_.objects.find(&object);
    return found != names_.objects.end() ? found->second.Get(language_)
                                         : std::string(object.GetNameView());
}

/// \param pin a component's pin. A single bit of a bus becomes a scalar pin.
std::string Copier::RenamedPin(const Pin& pin) const {
    const string_view base = Writers::GetBaseName(pin);
    const auto found = names_.objects.find(&pin);
    std::string name =
        found != names_.objects.end() ? found->second.Get(language_) : std::string(base);
    if (pin.GetPinType() == PinTypeBus) {
        name.append(pin.GetNameView().substr(base.size()));
    }
    return name;
}

void Copier::CopyComment(const Object& object, Object& copy) const {
    string_view comment = object.GetCommentView();
    while (!comment.empty()) {
        const std::size_t end = std::min(comment.find('\n'), comment.size());
        const string_view line = comment.substr(0, end);
        const std::string text = plan_.HasDirectives() ? WithoutDirective(line) : std::string(line);
        copy.AddComment(text.c_str());
        comment.remove_prefix(std::min(end + 1, comment.size()));
    }
}

void Copier::CopyAttribute(const Attribute& attribute, AttributeHolder& copy) const {
    std::unique_ptr<Attribute> made = Legal::CopyAttribute(attribute, plan_, language_);
    if (const NewName* const name = names_.Find(attribute)) {
        made->SetName(name->Get(language_).c_str());
    }
    copy.AddAttr(made.release());
}

void Copier::CopyAttributes(const AttributeHolder& holder, AttributeHolder& copy) const {
    for (const Attribute* attribute : holder.GetAttrIterator()) {
        CopyAttribute(*attribute, copy);
    }
}

void Copier::CopyDesign() {
    to_.SetName(NameOf(from_).c_str());
    to_.SetSourceFileName(from_.GetSourceFileName().CStr());
    CopyComment(from_, to_);
    CopyAttributes(from_, to_);
}

void Copier::CopyComponents() {
    for (const Component* component : from_.GetComponentIterator()) {
        if (!plan_.IsUsed(*component)) {
            continue;
        }
        auto copy = std::make_unique<Component>(NameOf(*component).c_str());
        CopyComment(*component, *copy);
        CopyAttributes(*component, *copy);
        for (const Attribute* generic : plan_.GetNewGenerics(*component)) {
            CopyAttribute(*generic, *copy);
        }
        for (const Pin* pin : component->GetPinIterator()) {
            copy->AddPin(RenamedPin(*pin).c_str(), pin->GetPolarity(), pin->GetDefaultValue());
        }
        components_.emplace(component, copy.get());
        to_.Add(copy.release());
    }
}

/// A signal or bus with the range of another one.
Signal* Copier::MakeDeclared(const Signal& like, const std::string& base) {
    if (like.GetSignalType() == SignalTypeBus) {
        const string_view name = like.GetNameView();
        const std::string whole = base + std::string(name.substr(Names::BaseName(name).size()));
        Signal* const bus = new Bus(whole.c_str());
        to_.Add(bus);
        return bus;
    }
    Signal* const scalar = MakePacked<ScalarSignal>(base.c_str()).release();
    to_.Add(scalar);
    return scalar;
}

void Copier::CopyDeclaredSignals() {
    for (const Signal* signal : from_.GetSignalIterator()) {
        if (!signal->IsNeededToDeclared() || plan_.IsNothing(*signal)) {
            continue;
        }
        const auto found = names_.objects.find(signal);
        const std::string base = found != names_.objects.end()
                                     ? found->second.Get(language_)
                                     : std::string(Names::BaseName(signal->GetNameView()));
        Signal* const copy = MakeDeclared(*signal, base);
        copy->SetPortPolarity(signal->GetPortPolarity());
        CopyComment(*signal, *copy);
        CopyAttributes(*signal, *copy);
        const auto inner = names_.inner.find(signal);
        if (inner == names_.inner.end()) {
            signals_.emplace(signal, copy);
            continue;
        }
        Signal* const inside = MakeDeclared(*signal, inner->second);
        signals_.emplace(signal, inside);
        if (signal->GetPortPolarity().GetValue() == Polarity::Input) {
            inside->Connect(copy);
        } else {
            copy->Connect(inside);
        }
    }
}

std::string Copier::NameOfPart(const BusPart& part) const {
    const Signal* const bus = Find(part.GetParentBus());
    const string_view name = part.GetNameView();
    const string_view base = Names::BeforeParenthesis(name);
    return std::string(bus == nullptr ? base : Names::BaseName(bus->GetNameView()))
        .append(name.substr(base.size()));
}

void Copier::CopyParts() {
    for (const Signal* signal : from_.GetSignalIterator()) {
        const BusPart* const part = As<BusPart>(signal);
        if (part == nullptr) {
            continue;
        }
        Bus* const bus = As<Bus>(Find(part->GetParentBus()));
        const std::string name = NameOfPart(*part);
        Signal* copy = nullptr;
        if (part->GetSignalType() == SignalTypeBusSlice) {
            copy = new BusSlice(name.c_str(), bus);
        } else {
            copy = new BusIndex(name.c_str(), bus);
        }
        to_.Add(copy);
        signals_.emplace(signal, copy);
    }
}

void Copier::CopyCompounds() {
    for (const Signal* signal : from_.GetSignalIterator()) {
        if (const CompoundBus* const compound = As<CompoundBus>(signal)) {
            CopyCompound(*compound);
        }
    }
}

Signal* Copier::CopyCompound(const CompoundBus& compound) {
    if (Signal* const known = Find(&compound)) {
        return known;
    }
    const auto open = names_.parts.find(&compound);
    std::size_t openCount = 0;
    PtrArray<Signal*> members;
    std::string name;
    for (const Signal* member : compound.GetBusMemberIterator()) {
        Signal* copy = nullptr;
        if (const CompoundBus* const inner = As<CompoundBus>(member)) {
            copy = CopyCompound(*inner);
        } else if (plan_.IsNothing(*member) && open != names_.parts.end()) {
            copy = MakeDeclared(*member, open->second[openCount++]);
        } else {
            copy = Find(member);
        }
        if (copy != nullptr) {
            members.Add(copy);
            name.append(name.empty() ? "" : ",").append(copy->GetNameView());
        }
    }
    Signal* const copy = new CompoundBus(name.c_str(), members);
    to_.Add(copy);
    signals_.emplace(&compound, copy);
    return copy;
}

Signal* Copier::Find(const Signal* signal) const {
    const auto found = signals_.find(signal);
    return found == signals_.end() ? nullptr : found->second;
}

void Copier::CopyConstants() {
    for (const Signal* signal : from_.GetSignalIterator()) {
        const BitVectorValue& value = signal->GetConstantValue();
        Signal* const copy = Find(signal);
        if (copy == nullptr || value.GetValue().IsEmpty()) {
            continue;
        }
        if (plan_.HasFaultyConstant(*signal)) {
            const auto width = static_cast<std::size_t>(signal->GetWidth());
            const std::string bits =
                FindBits(value, width, plan_.GetOptions().dontCares).value_or("");
            copy->AssignConstantValue(MakeConstant(bits, language_));
        } else {
            copy->AssignConstantValue(value);
        }
    }
}

void Copier::CopyAliases() {
    for (const Signal* signal : from_.GetSignalIterator()) {
        for (const Signal* alias : signal->GetSignalIterator()) {
            Signal* const copy = Find(signal);
            Signal* const copyOfAlias = Find(alias);
            if (copy != nullptr && copyOfAlias != nullptr) {
                copy->Connect(copyOfAlias);
            }
        }
    }
}

void Copier::CopyInstances() {
    for (const Instance* instance : from_.GetInstanceIterator()) {
        const auto component = components_.find(instance->GetComponent());
        if (component == components_.end()) {
            continue;
        }
        auto made = MakePacked<Instance>(NameOf(*instance).c_str(), component->second);
        Instance& copy = *made;
        to_.Add(made.release());
        CopyComment(*instance, copy);
        CopyAttributes(*instance, copy);
        CopyPins(*instance, copy);
        WireLatePins(*instance, copy);
    }
}

void Copier::CopyPins(const Instance& instance, Instance& copy) {
    for (const Pin* pin : instance.GetPinIterator()) {
        const Pin* const declared = instance.GetComponent()->GetPin(pin->GetNameView());
        Pin* const target =
            declared == nullptr ? nullptr : copy.GetPin(string_view(RenamedPin(*declared)));
        if (target == nullptr) {
            continue;
        }
        const auto open = names_.open.find(pin);
        if (open != names_.open.end()) {
            WireToOwnSignal(*target, open->second);
        } else if (Signal* const signal = Find(pin->GetSignal())) {
            signal->Connect(target);
        }
    }
}

/// The copy was made from the component, and so has the pins that the instance lacks.
void Copier::WireLatePins(const Instance& instance, Instance& copy) {
    const auto late = names_.late.find(&instance);
    if (late == names_.late.end()) {
        return;
    }
    for (const auto& [pin, name] : late->second) {
        if (Pin* const target = copy.GetPin(string_view(RenamedPin(*pin)))) {
            WireToOwnSignal(*target, name);
        }
    }
}

void Copier::WireToOwnSignal(Pin& pin, const std::string& name) {
    Signal* signal = nullptr;
    if (pin.GetPinType() == PinTypeBus) {
        const string_view whole = pin.GetNameView();
        const string_view range = whole.substr(Writers::GetBaseName(pin).size());
        signal = new Bus((name + std::string(range)).c_str());
    } else {
        signal = MakePacked<ScalarSignal>(name.c_str()).release();
    }
    to_.Add(signal);
    signal->Connect(&pin);
}

} // namespace Orn_Hdl::Legal
