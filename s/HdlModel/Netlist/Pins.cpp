#include "Orn_Hdl/Model/Pins.h"

#include "HdlModel/Names/Names.h"
#include "HdlModel/Netlist/PinIndex.h"
#include "HdlModel/Objects/ObjectDetails.h"
#include "Orn_Hdl/Model/Signals.h"
#include "Port/Ascii.h"
#include "Port/Text.h"

#include <algorithm>

namespace Orn_Hdl {

namespace {

constexpr const char* PolarityNames[] = {"Input", "Output", "BiDirectional"};

} // namespace

int Polarity::GetValue(const char* text) noexcept {
    const std::string_view start = Port::ViewOf(text);
    for (int value = Input; !start.empty() && value <= BiDirectional; ++value) {
        if (Port::strnicmp(PolarityNames[value], text, start.size()) == 0) {
            return value;
        }
    }
    return Invalid;
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
        CopyNameFrom(other);
        PinIndex::NoteRenaming();
        SetPolarity(other.GetPolarity());
        const bool hasValue = !GetDefaultValue().GetValue().IsEmpty();
        if (hasValue || !other.GetDefaultValue().GetValue().IsEmpty()) {
            SetDefaultValue(other.GetDefaultValue());
        }
    }
    return *this;
}

Pin::~Pin() {
    // In this order: what still lists the pin lets go of it, then what it points at.
    if (const ObjectDetails* details = GetDetails()) {
        for (Signal* former : details->formerSignals) {
            former->Unlist(this);
        }
    }
    if (signal_ != nullptr) {
        if (HasFlag(ListedFlag)) {
            signal_->Unlist(this);
        } else {
            signal_->RemoveUnlistedPin(this);
        }
    }
}

int Pin::GetObjectType() const {
    return ObjectTypePin;
}

void Pin::AcceptObject(ObjectVisitor& visitor) {
    visitor.VisitPin(this);
}

void Pin::SetName(const char* name) {
    Object::SetName(name);
    PinIndex::NoteRenaming();
}

bool Pin::IsListedBy(const Signal* signal) const noexcept {
    if (signal == signal_) {
        return HasFlag(ListedFlag);
    }
    const ObjectDetails* const details = GetDetails();
    if (details == nullptr) {
        return false;
    }
    // Whichever side knows fewer of the other tells.
    const auto& former = details->formerSignals;
    if (former.size() <= static_cast<std::size_t>(signal->pins_.GetSize())) {
        return std::find(former.begin(), former.end(), signal) != former.end();
    }
    for (const Pin* pin : signal->GetPinIterator()) {
        if (pin == this) {
            return true;
        }
    }
    return false;
}

void Pin::NoteUnlisted(Signal* signal) noexcept {
    if (signal == signal_) {
        SetFlag(ListedFlag, false);
    } else if (ObjectDetails* details = GetDetails()) {
        auto& former = details->formerSignals;
        const auto found = std::find(former.begin(), former.end(), signal);
        if (found != former.end()) {
            *found = former.back();
            former.pop_back();
        }
    }
}

void Pin::Connect(Signal* signal) {
    if (signal == signal_) {
        return;
    }
    const bool isListed = signal != nullptr && IsListedBy(signal);
    // What can fail for want of memory comes first.
    PrepareToLeave();
    if (signal != nullptr && !isListed) {
        signal->AddUnlistedPin(this);
    }
    PointAt(signal, isListed);
}

/// Makes room for remembering the present signal, if that goes on listing the pin.
void Pin::PrepareToLeave() {
    if (signal_ != nullptr && HasFlag(ListedFlag)) {
        auto& former = MakeDetails().formerSignals;
        if (former.size() == former.capacity()) {
            former.reserve(std::max<std::size_t>(1, former.size() * 2));
        }
    }
}

void Pin::PointAt(Signal* signal, bool isListed) noexcept {
    if (signal_ != nullptr && HasFlag(ListedFlag)) {
        GetDetails()->formerSignals.push_back(signal_);
    } else if (signal_ != nullptr) {
        signal_->RemoveUnlistedPin(this);
    }
    if (isListed && GetDetails() != nullptr) {
        NoteUnlisted(signal);
    }
    signal_ = signal;
    SetFlag(ListedFlag, isListed);
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
    return ::new (place) ScalarPin(*this);
}

void ScalarPin::AcceptPin(PinVisitor& visitor) {
    visitor.VisitScalarPin(this);
}

Pin* BusPin::ClonePin() const {
    return new BusPin(*this);
}

Pin* BusPin::CloneInto(void* place) const {
    return ::new (place) BusPin(*this);
}

void BusPin::AcceptPin(PinVisitor& visitor) {
    visitor.VisitBusPin(this);
}

Port::StringBase<char> BusPin::GetBaseName() const {
    return Names::BeforeParenthesis(GetNameView());
}

bool BusPin::GetIndex(Port::StringBase<char>& left, Port::StringBase<char>& right) const {
    Names::BusName parsed;
    if (!Names::ParseBus(GetNameView(), parsed)) {
        return false;
    }
    left = parsed.left;
    right = parsed.right;
    return true;
}

bool BusPin::IsDownTo() const noexcept {
    Names::BusName parsed;
    return Names::ParseBus(GetNameView(), parsed) && parsed.IsDownTo();
}

int BusPin::GetWidth() const noexcept {
    Names::BusName parsed;
    return Names::ParseBus(GetNameView(), parsed) ? parsed.GetWidth() : 0;
}

Pin* BusIndexPin::ClonePin() const {
    return new BusIndexPin(*this);
}

Pin* BusIndexPin::CloneInto(void* place) const {
    return ::new (place) BusIndexPin(*this);
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

// The index or range is the rest of the pin's name, as it is spelled there.
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
