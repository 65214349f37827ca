#include "Orn_Hdl/Model/Pins.h"

#include "HdlModel/Names/Names.h"
#include "HdlModel/Netlist/PinBlock.h"
#include "HdlModel/Netlist/PinIndex.h"
#include "HdlModel/Objects/ObjectDetails.h"
#include "HdlModel/Objects/OwnerLink.h"
#include "HdlModel/Signals/PinLinks.h"
#include "Port/Ascii.h"
#include "Port/Text.h"

namespace Orn_Hdl {

namespace {

constexpr const char* PolarityNames[] = {"Input", "Output", "BiDirectional"};

int FindPolarity(std::string_view start) noexcept {
    for (int value = Polarity::Input; !start.empty() && value <= Polarity::BiDirectional; ++value) {
        if (Port::strnicmp(PolarityNames[value], start, start.size()) == 0) {
            return value;
        }
    }
    return Polarity::Invalid;
}

/// A pin in the block of an instance. Deleting the pin does not free its memory, which belongs to
/// the block.
template <class T> class Placed final : public T {
public:
    explicit Placed(const T& other) : T(other) { static_assert(sizeof(Placed) == sizeof(T)); }

    static void operator delete(void* /*memory*/) noexcept {}
    static void operator delete(void* /*memory*/, void* /*place*/) noexcept {}
};

} // namespace

int Polarity::GetValue(const char* text) noexcept {
    return FindPolarity(Port::ViewOf(text));
}

std::optional<Polarity> Polarity::Parse(Port::TextView text) noexcept {
    const int value = Port::EqualIgnoringCase(text, "inout") ? BiDirectional : FindPolarity(text);
    return IsValidValue(value) ? std::optional<Polarity>(Polarity(value)) : std::nullopt;
}

const char* Polarity::GetValueName() const noexcept {
    return PolarityNames[IsValid() ? value_ : Output];
}

Pin::Pin(const char* name, const Polarity& polarity) : Object(ObjectTypePin) {
    Object::SetName(name);
    SetPolarity(polarity);
}

// A copy has neither attributes nor comment.
// NOLINTNEXTLINE(bugprone-copy-constructor-init,readability-redundant-member-init)
Pin::Pin(const Pin& other) : Object(ObjectTypePin), AttributeHolder() {
    CopyNameFrom(other);
    SetPolarity(other.GetPolarity());
    if (!other.GetDefaultValue().GetValue().IsEmpty()) {
        SetDefaultValue(other.GetDefaultValue());
    }
}

Pin& Pin::operator=(const Pin& other) {
    if (this != &other) {
        {
            const PinRenaming renaming(*this);
            CopyNameFrom(other);
        }
        SetPolarity(other.GetPolarity());
        const bool hasValue = !GetDefaultValue().GetValue().IsEmpty();
        if (hasValue || !other.GetDefaultValue().GetValue().IsEmpty()) {
            SetDefaultValue(other.GetDefaultValue());
        }
    }
    return *this;
}

Pin::~Pin() {
    if (PinList* const list = OwnerLink::Get<PinList>(*this)) {
        PinBlock::LetGo(*list, *this);
    }
    PinLinks::Leave(*this);
}

int Pin::GetObjectType() const {
    return ObjectTypePin;
}

void Pin::AcceptObject(ObjectVisitor& visitor) {
    visitor.VisitPin(this);
}

void Pin::SetName(const char* name) {
    const PinRenaming renaming(*this);
    Object::SetName(name);
}

void Pin::Connect(Signal* signal) {
    PinLinks::PointAt(*this, signal);
}

void Pin::SetDefaultValue(const BitVectorValue& value) {
    MakeDetails().value = std::make_unique<BitVectorValue>(value);
}

void Pin::SetDefaultValue(const char* value) {
    SetDefaultValue(BitVectorValue(value));
}

const BitVectorValue& Pin::GetDefaultValue() const noexcept {
    const ObjectDetails* const details = GetDetails();
    return details == nullptr || details->value == nullptr ? NoValue() : *details->value;
}

Pin* Pin::Create(const char* name, const Polarity& polarity) {
    const Names::NormalizedText normalized(Port::ViewOf(name));
    Names::BusName bus;
    Names::BitName bit;
    if (Names::ParseBus(normalized.GetView(), bus)) {
        return new BusPin(name, polarity);
    }
    if (Names::ParseBit(normalized.GetView(), bit)) {
        return new BusIndexPin(name, polarity);
    }
    return new ScalarPin(name, polarity);
}

Pin* ScalarPin::ClonePin() const {
    return new ScalarPin(*this);
}

Pin* ScalarPin::CloneInto(void* place) const {
    return ::new (place) Placed<ScalarPin>(*this);
}

void ScalarPin::AcceptPin(PinVisitor& visitor) {
    visitor.VisitScalarPin(this);
}

Pin* BusPin::ClonePin() const {
    return new BusPin(*this);
}

Pin* BusPin::CloneInto(void* place) const {
    return ::new (place) Placed<BusPin>(*this);
}

void BusPin::AcceptPin(PinVisitor& visitor) {
    visitor.VisitBusPin(this);
}

Port::StringBase<char> BusPin::GetBaseName() const {
    return Names::BeforeParenthesis(GetNameView());
}

bool BusPin::GetIndex(Port::StringBase<char>& left, Port::StringBase<char>& right) const {
    return Names::GetIndexTexts(GetNameView(), left, right);
}

bool BusPin::IsDownTo() const noexcept {
    return Names::IsDownTo(GetNameView());
}

int BusPin::GetWidth() const noexcept {
    return Names::GetWidth(GetNameView());
}

Pin* BusIndexPin::ClonePin() const {
    return new BusIndexPin(*this);
}

Pin* BusIndexPin::CloneInto(void* place) const {
    return ::new (place) Placed<BusIndexPin>(*this);
}

void BusIndexPin::AcceptPin(PinVisitor& visitor) {
    visitor.VisitBusIndexPin(this);
}

Port::StringBase<char> BusIndexPin::GetBaseName() const {
    return Names::BeforeParenthesis(GetNameView());
}

Port::StringBase<char> BusIndexPin::GetIndex() const {
    Names::BitName parsed;
    return Names::ParseBit(GetNameView(), parsed) ? parsed.index : std::string_view();
}

PinVisitor::~PinVisitor() = default;
void PinVisitor::VisitPin(Pin* /*pin*/) {}
void PinVisitor::VisitScalarPin(ScalarPin* /*pin*/) {}
void PinVisitor::VisitBusPin(BusPin* /*pin*/) {}
void PinVisitor::VisitBusIndexPin(BusIndexPin* /*pin*/) {}

void PinConstantSignalVisitor::SetResult(std::string_view baseName, std::string_view index) {
    name_ = instanceName_;
    name_ += '_';
    name_ += baseName;
    name_ += Names::ConstantSuffix;
    name_ += index;
}

void PinConstantSignalVisitor::VisitScalarPin(ScalarPin* pin) {
    if (pin != nullptr) {
        SetResult(pin->GetNameView(), "");
    }
}

// The index or range is the rest of the pin's name, exactly as spelled there.
void PinConstantSignalVisitor::VisitBusPin(BusPin* pin) {
    if (pin != nullptr) {
        const std::string_view base = Names::BeforeParenthesis(pin->GetNameView());
        SetResult(base, pin->GetNameView().substr(base.size()));
    }
}

void PinConstantSignalVisitor::VisitBusIndexPin(BusIndexPin* pin) {
    if (pin != nullptr) {
        const std::string_view base = Names::BeforeParenthesis(pin->GetNameView());
        SetResult(base, pin->GetNameView().substr(base.size()));
    }
}

} // namespace Orn_Hdl
