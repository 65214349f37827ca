#include "Readers/Vhdl/InstanceReader.h"

#include "Port/Ascii.h"
#include "Readers/Vhdl/Types.h"

#include <algorithm>
#include <cstddef>
#include <memory>

namespace Orn_Hdl::Readers::Vhdl {

namespace {

constexpr const char* Seen = "SYN";
constexpr const char* Hidden = "NOSYN";
constexpr std::string_view InitName = "INIT";
constexpr std::string_view InitMark = "MHALVEX";

/// Whether a name can be a value of the type.
bool IsEnumeration(std::string_view typeName) {
    return !IsKnownType(typeName) || Port::EqualIgnoringCase(typeName, "boolean");
}

const char* OptionOf(bool isHidden) noexcept {
    return isHidden ? Hidden : Seen;
}

bool HaveSamePorts(const ModuleHead& a, const ModuleHead& b) {
    return std::equal(a.ports.begin(), a.ports.end(), b.ports.begin(), b.ports.end(),
                      [](const PortHead& one, const PortHead& other) {
                          return IsSameName(one.name, other.name, true) &&
                                 one.direction == other.direction && one.range == other.range;
                      });
}

/// Whether an attribute is a generic with that value.
bool IsSameGeneric(const Attribute& attribute, const Value& value, bool isHidden) {
    if (attribute.GetValueType() != value.type ||
        attribute.GetGenericOption() !=
            (isHidden ? Attribute::GenericNoSyn : Attribute::GenericSyn)) {
        return false;
    }
    // Most generics are bit vectors: no object is made to compare them.
    if (value.type == Attribute::BitVector) {
        const BitVectorValue present =
            static_cast<const AttributeBitVector&>(attribute).GetBitVectorValue();
        const BitVectorValue other(value.text.c_str());
        return present.GetValue() == other.GetValue() && present.GetBase() == other.GetBase();
    }
    return attribute.GetValueString() == value.MakeAttribute("")->GetValueString();
}

} // namespace

void InstanceReader::MakeComponents() {
    for (const Architecture::Use& use : architecture_.uses) {
        if (ModuleHead* const head = FindHead(use)) {
            MakeComponent(*head, use.place);
        }
    }
}

ModuleHead* InstanceReader::FindHead(const Architecture::Use& use) const {
    return use.isEntity ? design_.FindEntity(use.name)
                        : design_.FindComponent(architecture_, use.name);
}

/// What else is instantiated and not declared, so that one message tells of all: the names, each
/// behind a comma. Empty for nothing.
std::string InstanceReader::GetOtherMissing(const std::string& name) const {
    std::string names;
    for (const Architecture::Use& use : architecture_.uses) {
        if (!IsSameName(use.name, name, true) && FindHead(use) == nullptr) {
            names.append(", ").append(Quoted(use.name));
        }
    }
    return names;
}

/// Makes a component of a head and gives it the generics that have values.
void InstanceReader::MakeComponent(ModuleHead& head, const Place& place) {
    if (head.component != nullptr) {
        return;
    }
    const ModuleHead*& made = made_[KeyOf(head.name)];
    if (made != nullptr) {
        if (!HaveSamePorts(*made, head)) {
            parser_.Fail(place, "the component and the entity " + Quoted(head.name) +
                                    " have different ports, and a model has one of both");
        }
        head.component = made->component;
        return;
    }
    const std::string problem = maker_.MakeComponent(head);
    if (!problem.empty()) {
        parser_.Fail(place, Quoted(head.name) + " cannot be a component: " + problem);
    }
    made = &head;
    if (maker_.GetSink() != nullptr) {
        return;
    }
    for (const ParameterHead& parameter : head.parameters) {
        if (!parameter.value) {
            continue;
        }
        const std::string refusal = GiveAttribute(*head.component, parameter.name, *parameter.value,
                                                  OptionOf(parameter.isHidden), nullptr);
        if (!refusal.empty()) {
            parser_.Fail(place, "the generic " + Quoted(parameter.name) + " of " +
                                    Quoted(head.name) + ": " + refusal);
        }
    }
}

void InstanceReader::Read(const std::string& label, const Place& place) {
    switch (parser_.GetKeyword()) {
    case Keyword::Entity:
        parser_.Next();
        ReadEntity(label, place);
        return;
    case Keyword::Configuration:
        parser_.Next();
        ReadConfiguration(label, place);
        return;
    default:
        parser_.Accept(Keyword::Component);
    }
    const Place componentPlace = parser_.Get().place;
    std::string component;
    parser_.TakeSelectedName(component, "name of a component");
    ReadBehind(label, place, component, componentPlace);
}

void InstanceReader::ReadBehind(const std::string& label, const Place& place,
                                const std::string& component, const Place& componentPlace) {
    // Most instances are of the same few components.
    if (lastHead_ == nullptr || component != lastName_) {
        lastHead_ = design_.FindComponent(architecture_, component);
        lastName_ = component;
    }
    if (lastHead_ == nullptr) {
        const std::string others = GetOtherMissing(component);
        parser_.Fail(componentPlace,
                     others.empty()
                         ? "the component " + Quoted(component) +
                               " is not declared: declare it, or give a library file that does"
                         : "the cells " + Quoted(component) + others +
                               " are not declared: declare them, or give a library file that does");
    }
    MakeComponent(*lastHead_, componentPlace);
    ReadInstance(label, place, *lastHead_);
}

/// "work.NAME(ARCHITECTURE)", the word "entity" being read.
void InstanceReader::ReadEntity(const std::string& label, const Place& place) {
    const Place entityPlace = parser_.Get().place;
    std::string name;
    parser_.TakeSelectedName(name, "name of an entity");
    if (parser_.Accept('(')) {
        std::string architecture;
        parser_.TakeName(architecture, "name of an architecture");
        parser_.Expect(')');
    }
    ModuleHead* const head = design_.FindEntity(name);
    if (head == nullptr) {
        const std::string others = GetOtherMissing(name);
        parser_.Fail(
            entityPlace,
            others.empty()
                ? "the entity " + Quoted(name) +
                      " is not declared: a library file has to say which ports it has"
                : "the cells " + Quoted(name) + others +
                      " are not declared: a library file has to say which ports they have");
    }
    hasEntities_ = true;
    MakeComponent(*head, entityPlace);
    ReadInstance(label, place, *head);
}

void InstanceReader::ReadConfiguration(const std::string& label, const Place& place) {
    const Place namePlace = parser_.Get().place;
    std::string name;
    parser_.TakeSelectedName(name, "name of a configuration");
    for (const Configuration& configuration : design_.configurations) {
        ModuleHead* const head = IsSameName(configuration.name, name, true)
                                     ? design_.FindEntity(configuration.entity)
                                     : nullptr;
        if (head != nullptr) {
            hasEntities_ = true;
            MakeComponent(*head, namePlace);
            ReadInstance(label, place, *head);
            return;
        }
    }
    parser_.Fail(namePlace, "the configuration " + Quoted(name) +
                                " is not declared: instantiate its entity instead");
}

void InstanceReader::ReadInstance(const std::string& label, const Place& place, ModuleHead& head) {
    maker_.SetPlace(place);
    Instance* const instance = maker_.AddInstance(label, head);
    if (instance == nullptr || expressions_.IsDeclared(label)) {
        parser_.Fail(place, Quoted(label) + " is declared already");
    }
    notes_.GiveTo(*instance);
    if (parser_.GetKeyword() == Keyword::Generic) {
        ReadGenericMap(head, *instance);
    }
    attributes_.GiveTo(label, *instance);
    if (parser_.GetKeyword() == Keyword::Port) {
        portMap_.Read(head, *instance);
    }
    if (!parser_.IsSign(';')) {
        parser_.FailExpected("\"generic map\", \"port map\" or \";\"");
    }
}

/// "generic map (1, B => 2)"
void InstanceReader::ReadGenericMap(ModuleHead& head, Instance& instance) {
    parser_.Next();
    parser_.Expect(Keyword::Map, "map");
    parser_.Expect('(');
    inherited_.clear();
    std::size_t position = 0;
    do {
        notes_.TakeInside();
        const Place place = parser_.Get().place;
        // A value can begin with a name too.
        std::string name;
        bool hasName = false;
        if (parser_.IsName() && parser_.GetKeyword() == Keyword::None) {
            name = parser_.Get().text;
            hasName = head.FindParameter(name) != nullptr || !head.hasParameters ||
                      position >= head.parameters.size();
        }
        const ParameterHead* parameter = nullptr;
        if (hasName) {
            parser_.Next();
            if (parser_.IsSign('(')) {
                parser_.Fail(place, "a part of the generic " + Quoted(name) +
                                        ", which no attribute of a model can be");
            }
            parameter = head.FindParameter(name);
            if (head.hasParameters && parameter == nullptr) {
                parser_.Fail(place, "the component " + Quoted(head.name) + " has no generic " +
                                        Quoted(name));
            }
            parser_.Expect(Arrow);
        } else {
            if (position >= head.parameters.size()) {
                parser_.Fail(place, "the component " + Quoted(head.name) +
                                        " has no further generic that this could be the value of");
            }
            parameter = &head.parameters[position++];
            if (!name.empty() && entity_.FindParameter(name) == nullptr &&
                !expressions_.IsDeclared(name) && !IsEnumeration(parameter->typeName)) {
                parser_.Fail(place, "the component " + Quoted(head.name) + " has no generic " +
                                        Quoted(name));
            }
            name = parameter->name;
        }
        if (!parser_.Accept(Keyword::Open)) {
            Generic generic;
            generic.name = parameter == nullptr ? name : parameter->name;
            generic.place = place;
            generic.isHidden = notes_.IsHidden();
            generic.value = ReadGenericValue(name, parameter);
            SetGeneric(head, instance, generic);
        }
    } while (parser_.Accept(','));
    if (inherited_.size() > 1 && !IsInOrder(*head.component)) {
        GiveInherited(instance);
    }
    notes_.TakeInside();
    parser_.Expect(')');
}

/// The value of a generic: a literal, or the generic INIT of the entity itself, which the VHDL
/// writer passes on in modules of certain names.
Value InstanceReader::ReadGenericValue(const std::string& generic, const ParameterHead* parameter) {
    const Place place = parser_.Get().place;
    if (parser_.IsName() && parser_.GetKeyword() == Keyword::None) {
        const ParameterHead* const own = entity_.FindParameter(parser_.Get().text);
        if (own != nullptr) {
            if (entity_.name.find(InitMark) == std::string::npos || own->name != InitName ||
                generic != InitName || !own->value) {
                parser_.Fail(
                    "the generic " + Quoted(own->name) +
                    " as a value: a model passes no generic on but INIT in a design with " +
                    std::string(InitMark) + " in its name");
            }
            parser_.Next();
            return *own->value;
        }
    }
    try {
        return ReadValue(parser_, parameter == nullptr ? std::string() : parameter->typeName, ',',
                         ')', expressions_.GetResolve());
    } catch (const LiteralProblem& problem) {
        parser_.Fail(place, "the generic " + Quoted(generic) + ": " + problem.text);
    }
}

/// Gives an instance a generic. One that its component has with the same value is left out, as long
/// as that changes no order: the generics of a component come behind those of the instance.
void InstanceReader::SetGeneric(const ModuleHead& head, Instance& instance,
                                const Generic& generic) {
    for (const PortHead& port : head.ports) {
        for (const std::string& used : port.parameters) {
            const ParameterHead* const parameter = head.FindParameter(used);
            const bool isSame = parameter != nullptr && parameter->value &&
                                parameter->value->text == generic.value.text;
            if (IsSameName(used, generic.name, true) && !isSame) {
                parser_.Fail(generic.place,
                             "the port " + Quoted(port.name) + " of " + Quoted(head.name) +
                                 " depends on this generic, and a model's components have pins of "
                                 "fixed ranges");
            }
        }
    }
    if (NetlistSink* const sink = maker_.GetSink()) {
        sink->TakeParameter(maker_.GetOwner(instance), generic.name, generic.value,
                            generic.isHidden, generic.place);
        return;
    }
    Component& component = *head.component;
    const Attribute* present = component.GetAttr(generic.name.c_str());
    if (present == nullptr && head.hasParameters) {
        // The declaration of a component has to have a value.
        GiveAttribute(component, generic.name, generic.value, OptionOf(generic.isHidden), nullptr);
        present = component.GetAttr(generic.name.c_str());
    }
    if (present != nullptr && IsSameGeneric(*present, generic.value, generic.isHidden)) {
        inherited_.push_back(generic);
        return;
    }
    GiveInherited(instance);
    GiveGeneric(instance, generic);
}

void InstanceReader::GiveInherited(Instance& instance) {
    for (const Generic& inherited : inherited_) {
        GiveGeneric(instance, inherited);
    }
    inherited_.clear();
}

/// Whether the generics that are left out stand in the order in which the component has them.
bool InstanceReader::IsInOrder(const Component& component) const {
    auto next = inherited_.begin();
    for (const bool isHidden : {false, true}) {
        for (const Attribute* attribute : component.GetAttrIterator()) {
            if (next != inherited_.end() && next->isHidden == isHidden &&
                Port::EqualIgnoringCase(attribute->GetNameView(), next->name)) {
                ++next;
            }
        }
    }
    return next == inherited_.end();
}

void InstanceReader::GiveGeneric(Instance& instance, const Generic& generic) const {
    const std::string problem =
        GiveAttribute(instance, generic.name, generic.value, OptionOf(generic.isHidden), nullptr);
    if (!problem.empty()) {
        parser_.Fail(generic.place, "the generic " + Quoted(generic.name) + ": " + problem);
    }
}

} // namespace Orn_Hdl::Readers::Vhdl
