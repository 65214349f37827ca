#include "Orn_Hdl/Attributes.h"

#include "HdlModel/Objects/AttributeTable.h"
#include "Orn_Hdl/Containers/StringArray.h"
#include "Port/Ascii.h"
#include "Port/Text.h"

#include <algorithm>
#include <charconv>
#include <iterator>
#include <string>

namespace Orn_Hdl {

namespace {

constexpr const char* ValueTypeNames[] = {"String", "Integer",   "Float", "Boolean",
                                          "Bit",    "BitVector", "User"};
constexpr const char* GenericNames[] = {"NONE", "NOSYN", "SYN"};
constexpr const char* SynAttrNames[] = {"NONE", "ASSIGN", "ASSIGNNODEC"};

/// The index of a text in a table of option names, ignoring case; -1 if it is not one of them.
int FindOption(const char* const (&names)[3], const char* text) noexcept {
    for (int i = 0; i < 3; ++i) {
        if (Port::EqualIgnoringCase(names[i], Port::ViewOf(text))) {
            return i;
        }
    }
    return -1;
}

} // namespace

Attribute::Attribute(const char* name) : Object(ObjectTypeAttribute) {
    Object::SetName(name);
}

Attribute::Attribute(const Attribute& other) : Object(other) {
    SetOption(GenericFlags, other.GetGenericOption());
    SetOption(SynAttrFlags, other.GetSynAttrOption());
}

Attribute& Attribute::operator=(const Attribute& other) {
    if (this != &other) {
        Object::operator=(other);
        SetOption(GenericFlags, other.GetGenericOption());
        SetOption(SynAttrFlags, other.GetSynAttrOption());
    }
    return *this;
}

void Attribute::SetOption(unsigned flags, int option) noexcept {
    SetFlag(flags * 3, false);
    SetFlag(flags * static_cast<unsigned>(option), true);
}

Attribute::~Attribute() {
    AttributeTable::Leave(*this);
}

void Attribute::AcceptObject(ObjectVisitor& visitor) {
    visitor.VisitAttribute(this);
}

void Attribute::AcceptAttribute(AttributeVisitor& visitor) {
    visitor.VisitAttribute(this);
}

Port::StringBase<char> Attribute::GetValueTypeName() const {
    const auto type = static_cast<std::size_t>(GetValueType());
    return type < std::size(ValueTypeNames) ? ValueTypeNames[type] : "";
}

bool Attribute::SetGeneric(const char* text) noexcept {
    const int option = FindOption(GenericNames, text);
    if (option >= 0) {
        SetOption(GenericFlags, option);
    }
    return option >= 0;
}

Port::StringBase<char> Attribute::GetGeneric() const {
    return GenericNames[GetGenericOption()];
}

bool Attribute::SetSynAttr(const char* text) noexcept {
    const int option = FindOption(SynAttrNames, text);
    if (option >= 0) {
        SetOption(SynAttrFlags, option);
    }
    return option >= 0;
}

Port::StringBase<char> Attribute::GetSynAttr() const {
    return SynAttrNames[GetSynAttrOption()];
}

bool Attribute::operator==(const Attribute& other) const {
    return Object::operator==(other) && GetGenericOption() == other.GetGenericOption() &&
           GetSynAttrOption() == other.GetSynAttrOption() &&
           Port::EqualIgnoringCase(GetValueString(), other.GetValueString());
}

AttributeString::AttributeString(const char* name, const char* value) : Attribute(name) {
    AttributeString::SetValue(value);
}

Attribute* AttributeString::CreateAttribute(const char* name, const char* value) {
    return new AttributeString(name, value);
}

void AttributeString::AcceptAttribute(AttributeVisitor& visitor) {
    visitor.VisitAttributeString(this);
}

Attribute* AttributeString::CloneAttribute() const {
    return new AttributeString(*this);
}

void AttributeString::SetValue(const char* text) {
    value_ = text;
}

Port::StringBase<char> AttributeString::GetValueString() const {
    return value_;
}

AttributeInteger::AttributeInteger(const char* name, const char* value) : Attribute(name) {
    AttributeInteger::SetValue(value);
}

Attribute* AttributeInteger::CreateAttribute(const char* name, const char* value) {
    return new AttributeInteger(name, value);
}

void AttributeInteger::AcceptAttribute(AttributeVisitor& visitor) {
    visitor.VisitAttributeInteger(this);
}

Attribute* AttributeInteger::CloneAttribute() const {
    return new AttributeInteger(*this);
}

void AttributeInteger::SetValue(const char* text) {
    value_ = Port::ToIntSaturated(Port::ViewOf(text));
}

Port::StringBase<char> AttributeInteger::GetValueString() const {
    return std::to_string(value_);
}

AttributeFloat::AttributeFloat(const char* name, const char* value) : Attribute(name) {
    AttributeFloat::SetValue(value);
}

Attribute* AttributeFloat::CreateAttribute(const char* name, const char* value) {
    return new AttributeFloat(name, value);
}

void AttributeFloat::AcceptAttribute(AttributeVisitor& visitor) {
    visitor.VisitAttributeFloat(this);
}

Attribute* AttributeFloat::CloneAttribute() const {
    return new AttributeFloat(*this);
}

void AttributeFloat::SetValue(const char* text) {
    // The number is written with as many decimals as its text has, but at least one.
    const StringArray parts(text, ".", true, nullptr);
    const auto length = [&parts](int i) {
        return static_cast<int>(std::max<std::size_t>(parts.GetView(i).size(), 1));
    };
    precision_ = length(1);
    width_ = parts.IsEmpty() ? 3 : length(0) + precision_ + 1;
    value_ = Port::ToDouble(text);
}

Port::StringBase<char> AttributeFloat::GetValueString() const {
    // Formats like printf's "%*.*f", but independent of the locale.
    constexpr std::size_t MostIntegerDigits = 320;
    std::string text(MostIntegerDigits + static_cast<std::size_t>(precision_), '\0');
    const auto result = std::to_chars(text.data(), text.data() + text.size(), value_,
                                      std::chars_format::fixed, precision_);
    text.resize(static_cast<std::size_t>(result.ptr - text.data()));
    const auto width = static_cast<std::size_t>(width_);
    return text.size() < width ? std::string(width - text.size(), ' ') + text : text;
}

AttributeBoolean::AttributeBoolean(const char* name, const char* value) : Attribute(name) {
    AttributeBoolean::SetValue(value);
}

Attribute* AttributeBoolean::CreateAttribute(const char* name, const char* value) {
    return new AttributeBoolean(name, value);
}

void AttributeBoolean::AcceptAttribute(AttributeVisitor& visitor) {
    visitor.VisitAttributeBoolean(this);
}

Attribute* AttributeBoolean::CloneAttribute() const {
    return new AttributeBoolean(*this);
}

void AttributeBoolean::SetValue(const char* text) {
    value_ = Port::EqualIgnoringCase(Port::ViewOf(text), "true");
}

Port::StringBase<char> AttributeBoolean::GetValueString() const {
    return value_ ? "TRUE" : "FALSE";
}

AttributeBit::AttributeBit(const char* name, const char* value) : Attribute(name) {
    AttributeBit::SetValue(value);
}

Attribute* AttributeBit::CreateAttribute(const char* name, const char* value) {
    return new AttributeBit(name, value);
}

void AttributeBit::AcceptAttribute(AttributeVisitor& visitor) {
    visitor.VisitAttributeBit(this);
}

Attribute* AttributeBit::CloneAttribute() const {
    return new AttributeBit(*this);
}

void AttributeBit::SetValue(const char* text) {
    value_ = Port::ViewOf(text) == "1";
}

Port::StringBase<char> AttributeBit::GetValueString() const {
    return value_ ? "1" : "0";
}

AttributeBitVector::AttributeBitVector(const char* name, const char* value) : Attribute(name) {
    AttributeBitVector::SetValue(value);
}

Attribute* AttributeBitVector::CreateAttribute(const char* name, const char* value) {
    return new AttributeBitVector(name, value);
}

void AttributeBitVector::AcceptAttribute(AttributeVisitor& visitor) {
    visitor.VisitAttributeBitVector(this);
}

Attribute* AttributeBitVector::CloneAttribute() const {
    return new AttributeBitVector(*this);
}

void AttributeBitVector::SetValue(const char* text) {
    value_.SetValue(text);
}

Port::StringBase<char> AttributeBitVector::GetValueString() const {
    return value_.GetValue();
}

AttributeUser::AttributeUser(const char* name, const char* value) : Attribute(name) {
    AttributeUser::SetValue(value);
}

Attribute* AttributeUser::CreateAttribute(const char* name, const char* value) {
    return new AttributeUser(name, value);
}

void AttributeUser::AcceptAttribute(AttributeVisitor& visitor) {
    visitor.VisitAttributeUser(this);
}

Attribute* AttributeUser::CloneAttribute() const {
    return new AttributeUser(*this);
}

void AttributeUser::SetValue(const char* text) {
    value_ = text;
}

Port::StringBase<char> AttributeUser::GetValueString() const {
    return value_;
}

AttributeVisitor::~AttributeVisitor() = default;
void AttributeVisitor::VisitAttribute(Attribute* /*attribute*/) {}
void AttributeVisitor::VisitAttributeString(AttributeString* /*attribute*/) {}
void AttributeVisitor::VisitAttributeInteger(AttributeInteger* /*attribute*/) {}
void AttributeVisitor::VisitAttributeFloat(AttributeFloat* /*attribute*/) {}
void AttributeVisitor::VisitAttributeBit(AttributeBit* /*attribute*/) {}
void AttributeVisitor::VisitAttributeBitVector(AttributeBitVector* /*attribute*/) {}
void AttributeVisitor::VisitAttributeBoolean(AttributeBoolean* /*attribute*/) {}
void AttributeVisitor::VisitAttributeUser(AttributeUser* /*attribute*/) {}

const IStringPtrMap<AttributeFactory::Creator>& AttributeFactory::GetCreators() {
    static const IStringPtrMap<Creator> creators = [] {
        IStringPtrMap<Creator> table;
        table.Add("String", &AttributeString::CreateAttribute);
        table.Add("Integer", &AttributeInteger::CreateAttribute);
        table.Add("Float", &AttributeFloat::CreateAttribute);
        table.Add("Boolean", &AttributeBoolean::CreateAttribute);
        table.Add("Bit", &AttributeBit::CreateAttribute);
        table.Add("BitVector", &AttributeBitVector::CreateAttribute);
        table.Add("User", &AttributeUser::CreateAttribute);
        return table;
    }();
    return creators;
}

} // namespace Orn_Hdl
