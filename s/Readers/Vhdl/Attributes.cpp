#include "Readers/Vhdl/Attributes.h"

#include "Port/Ascii.h"
#include "Readers/Vhdl/Types.h"

#include <memory>
#include <utility>

namespace Orn_Hdl::Readers::Vhdl {

namespace {

constexpr const char* Assigned = "ASSIGN";
/// Of an attribute that the file does not declare.
constexpr const char* AssignedOnly = "ASSIGNNODEC";

/// The name that an object knows an attribute by.
std::string NameFor(const AttributeHolder& holder, const std::string& name) {
    const std::string plain = IsExtended(name) ? name.substr(1, name.size() - 2) : name;
    const Attribute* const present = holder.GetAttr(plain.c_str());
    const bool isSame = present != nullptr && !IsExtended(name) &&
                        Port::EqualIgnoringCase(present->GetNameView(), plain);
    return isSame ? std::string(present->GetNameView()) : plain;
}

} // namespace

std::string GiveAttribute(AttributeHolder& holder, const std::string& name, const Value& value,
                          const char* generic, const char* synthesis) {
    return SetAttribute(holder, NameFor(holder, name), value, generic, synthesis);
}

void AttributeReader::Read(const Parser::Resolve& resolve) {
    parser_.Next();
    std::string name;
    parser_.TakeName(name, "name of an attribute");
    if (parser_.Accept(':')) {
        types_[KeyOf(name)] = ReadTypeName(parser_, ';', ';');
    } else {
        parser_.Expect(Keyword::Of, "of");
        ReadSpecification(name, resolve);
    }
    parser_.Expect(';');
}

/// "U1, U2 : label is VALUE"
void AttributeReader::ReadSpecification(const std::string& name, const Parser::Resolve& resolve) {
    std::vector<std::pair<std::string, Place>> objects;
    do {
        if (parser_.GetKeyword() == Keyword::All || parser_.GetKeyword() == Keyword::Others) {
            parser_.Fail("an attribute of " + parser_.Show() + ": name the objects");
        }
        const Place place = parser_.Get().place;
        if (parser_.Get().kind == TokenKind::String || parser_.Get().kind == TokenKind::Character) {
            // An operator or an enumeration literal.
            parser_.Next();
            continue;
        }
        objects.emplace_back(std::string(), place);
        parser_.TakeName(objects.back().first, "name of an object");
        if (parser_.Accept('[')) {
            parser_.SkipTo(']', ']');
            parser_.Expect(']');
        }
    } while (parser_.Accept(','));
    parser_.Expect(':');
    const Keyword entityClass = parser_.GetKeyword();
    if (entityClass == Keyword::None) {
        parser_.FailExpected("a class such as \"signal\" or \"label\"");
    }
    parser_.Next();
    parser_.Expect(Keyword::Is, "is");
    const auto type = types_.find(KeyOf(name));
    Pending attribute;
    attribute.name = name;
    attribute.place = parser_.Get().place;
    attribute.isDeclared = type != types_.end();
    try {
        attribute.value = ReadValue(parser_, attribute.isDeclared ? type->second : std::string(),
                                    ';', ';', resolve);
    } catch (const LiteralProblem& problem) {
        parser_.Fail(attribute.place, "the attribute " + Quoted(name) + ": " + problem.text);
    }
    if (!keepsAttributes_) {
        return;
    }
    hasTypes_ = hasTypes_ || attribute.value.type != Attribute::String;
    for (const auto& [object, place] : objects) {
        const bool isLabel = entityClass == Keyword::Label;
        if (maker_.GetSink() != nullptr && (isLabel || entityClass == Keyword::Component)) {
            const Owner owner{isLabel ? Owner::Instance : Owner::Component, nullptr, object};
            maker_.GetSink()->TakeAttribute(owner, name, attribute.value, attribute.isDeclared,
                                            place);
            continue;
        }
        if (entityClass == Keyword::Label) {
            pending_[KeyOf(object)].push_back(attribute);
        } else if (AttributeHolder* const holder = FindHolder(entityClass, object, place)) {
            Set(*holder, attribute);
        }
    }
}

/// The object of that class; null for one that a model does not have.
AttributeHolder* AttributeReader::FindHolder(Keyword entityClass, const std::string& name,
                                             const Place& place) {
    switch (entityClass) {
    case Keyword::Signal: {
        Signal* const signal = maker_.FindSignal(name);
        if (signal == nullptr) {
            parser_.Fail(place, "the signal " + Quoted(name) + " is not declared");
        }
        return signal;
    }
    case Keyword::Component: {
        const ModuleHead* const head = design_.FindComponent(architecture_, name);
        if (head == nullptr) {
            parser_.Fail(place, "the component " + Quoted(name) + " is not declared");
        }
        return head->component;
    }
    case Keyword::Entity:
    case Keyword::Architecture:
        return &maker_.GetNetlist();
    default:
        return nullptr;
    }
}

void AttributeReader::Set(AttributeHolder& holder, const Pending& attribute) const {
    if (NetlistSink* const sink = maker_.GetSink()) {
        sink->TakeAttribute(maker_.GetOwner(holder), attribute.name, attribute.value,
                            attribute.isDeclared, attribute.place);
        return;
    }
    const std::string problem = GiveAttribute(holder, attribute.name, attribute.value, nullptr,
                                              attribute.isDeclared ? Assigned : AssignedOnly);
    if (!problem.empty()) {
        parser_.Fail(attribute.place, "the attribute " + Quoted(attribute.name) + ": " + problem);
    }
}

void AttributeReader::GiveTo(const std::string& label, Instance& instance) {
    if (pending_.empty()) {
        return;
    }
    const auto found = pending_.find(KeyOf(label));
    if (found == pending_.end()) {
        return;
    }
    const Component* const component = instance.GetComponent();
    for (const Pending& attribute : found->second) {
        const Attribute* const inherited =
            component == nullptr ? nullptr
                                 : component->GetAttr(NameFor(*component, attribute.name).c_str());
        // An attribute of the instance hides that of the component, which may be a generic too.
        if (inherited != nullptr && inherited->GetGenericOption() != Attribute::GenericNone &&
            instance.GetAttr(NameFor(instance, attribute.name).c_str()) == nullptr) {
            std::unique_ptr<Attribute> generic(inherited->CloneAttribute());
            generic->SetSynAttr(Attribute::SynAttrNone);
            instance.AddAttr(generic.release());
        }
        Set(instance, attribute);
    }
    pending_.erase(found);
}

void AttributeReader::RefuseUnused() const {
    const std::pair<const std::string, std::vector<Pending>>* first = nullptr;
    for (const auto& entry : pending_) {
        const Place& place = entry.second.front().place;
        if (first == nullptr || place.line < first->second.front().place.line ||
            (place.line == first->second.front().place.line &&
             place.column < first->second.front().place.column)) {
            first = &entry;
        }
    }
    if (first != nullptr) {
        parser_.Fail(first->second.front().place,
                     "the label " + Quoted(first->first) + " is not declared");
    }
}

} // namespace Orn_Hdl::Readers::Vhdl
