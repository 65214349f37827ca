#include "Orn_Hdl/Model/Object.h"

#include "HdlModel/Names/Names.h"
#include "HdlModel/Objects/ObjectDetails.h"
#include "HdlModel/Objects/ObjectKey.h"
#include "HdlModel/Objects/ObjectName.h"
#include "Port/Ascii.h"

#include <new>

namespace Orn_Hdl {

inline ObjectName& Object::Name() noexcept {
    return *std::launder(reinterpret_cast<ObjectName*>(nameStorage_));
}

inline const ObjectName& Object::Name() const noexcept {
    return *std::launder(reinterpret_cast<const ObjectName*>(nameStorage_));
}

Object::Object(ObjectType type) noexcept {
    static_assert(sizeof(ObjectName) == sizeof nameStorage_ && alignof(ObjectName) == 1);
    ::new (nameStorage_) ObjectName();
    SetFlag(static_cast<unsigned>(type - ObjectTypeAttribute), true);
}

Object::Object(const Object& other)
    : Object(static_cast<ObjectType>(ObjectTypeAttribute + other.GetTypeBits())) {
    Name() = other.Name();
    if (!other.GetCommentView().empty()) {
        MakeDetails().comment = other.GetCommentView();
    }
}

Object& Object::operator=(const Object& other) {
    if (this != &other) {
        CopyNameFrom(other);
        SetFlag(TypeMask, false);
        SetFlag(other.GetTypeBits(), true);
        if (GetDetails() != nullptr || !other.GetCommentView().empty()) {
            MakeDetails().comment = other.GetCommentView();
        }
    }
    return *this;
}

Object::~Object() {
    Name().~ObjectName();
}

std::string_view Object::GetNameView() const noexcept {
    return Name().GetView();
}

ObjectDetails& Object::MakeDetails() {
    return Name().MakeDetails();
}

ObjectDetails* Object::GetDetails() const noexcept {
    return Name().GetDetails();
}

void Object::SetFlag(unsigned flag, bool on) noexcept {
    bits_ = static_cast<std::uint8_t>(on ? bits_ | flag : bits_ & ~flag);
}

void Object::SetDirection(int direction) {
    const bool isOdd = direction < -1 || direction > 2;
    if (isOdd) {
        MakeDetails().oddDirection = direction;
    }
    SetFlag(DirectionMask, false);
    SetFlag(isOdd ? 0 : static_cast<unsigned>(direction + 1) << 5U, true);
    SetFlag(OddDirectionBit, isOdd);
}

int Object::GetOddDirection() const noexcept {
    return GetDetails()->oddDirection;
}

int Object::GetObjectType() const {
    return ObjectTypeAttribute + static_cast<int>(GetTypeBits());
}

void Object::SetName(const char* name) {
    SetNameVerbatim(Names::NormalizedText(Port::ViewOf(name)).GetView());
}

void Object::SetNameVerbatim(std::string_view name) {
    KeepKeyName(name);
    Name().Assign(name);
}

void Object::CopyNameFrom(const Object& other) {
    if (HasFlag(OwnedFlagBit)) {
        KeepKeyName(other.GetNameView());
    }
    Name() = other.Name();
}

void Object::SwapDetails(Object& other) noexcept {
    Name().Swap(other.Name());
}

void Object::KeepKeyName(std::string_view newName) {
    if (!HasFlag(OwnedFlagBit) || Names::IsNamed(GetNameView(), newName)) {
        return;
    }
    ObjectDetails& details = MakeDetails();
    if (details.keyName == nullptr) {
        details.keyName = std::make_unique<std::string>(GetNameView());
    }
}

std::string_view Object::GetKeyName() const noexcept {
    const ObjectDetails* const details = GetDetails();
    return details != nullptr && details->keyName != nullptr ? std::string_view(*details->keyName)
                                                             : GetNameView();
}

void Object::DropKeyName() noexcept {
    if (ObjectDetails* const details = GetDetails()) {
        details->keyName.reset();
    }
}

void Object::SwapName(ObjectName& name) noexcept {
    Name().SwapText(name);
    DropKeyName();
}

bool Object::IsNamed(const char* name) const noexcept {
    return Names::IsNamed(GetNameView(), Port::ViewOf(name));
}

void Object::AddComment(const char* text) {
    std::string& comment = MakeDetails().comment;
    comment += Port::ViewOf(text);
    comment += '\n';
}

Port::StringBase<char> Object::GetComment() const {
    return GetCommentView();
}

std::string_view Object::GetCommentView() const noexcept {
    const ObjectDetails* const details = GetDetails();
    return details == nullptr ? std::string_view() : std::string_view(details->comment);
}

bool Object::operator==(const Object& other) const noexcept {
    return GetCommentView() == other.GetCommentView() && GetNameView() == other.GetNameView() &&
           GetTypeBits() == other.GetTypeBits();
}

void Object::NormalizeName(Port::StringBase<char>& name) {
    name = Names::NormalizedText(name).GetView();
}

Port::StringBase<char> Object::GetBaseName(const char* name) {
    return Names::BaseName(Names::NormalizedText(Port::ViewOf(name)).GetView());
}

bool Object::IsValidBaseName(const char* name) noexcept {
    return Names::IsBase(Port::ViewOf(name));
}

bool Object::IsValidIntegerString(const Port::StringBase<char>& text) noexcept {
    return Names::IsInteger(text);
}

ObjectVisitor::~ObjectVisitor() = default;
void ObjectVisitor::VisitAttribute(Attribute* /*attribute*/) {}
void ObjectVisitor::VisitSignal(Signal* /*signal*/) {}
void ObjectVisitor::VisitComponent(Component* /*component*/) {}
void ObjectVisitor::VisitPin(Pin* /*pin*/) {}
void ObjectVisitor::VisitInstance(Instance* /*instance*/) {}
void ObjectVisitor::VisitNetlist(Netlist* /*netlist*/) {}

} // namespace Orn_Hdl
