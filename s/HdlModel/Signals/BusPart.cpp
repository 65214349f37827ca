#include "Orn_Hdl/Model/Signals/BusPart.h"

#include "HdlModel/Names/Names.h"
#include "HdlModel/Signals/BusParts.h"
#include "HdlModel/Signals/References.h"
#include "Orn_Hdl/Model/Signals/SignalVisitor.h"

namespace Orn_Hdl {

BusPart::BusPart(const char* name, Bus* parent) : Signal(name) {
    if (parent != nullptr) {
        BusParts::Of(*parent).Add(*this);
    }
}

BusPart::~BusPart() {
    BusPart::LeaveAll();
}

void BusPart::LeaveAll() noexcept {
    if (parts_ != nullptr && !References::AreDestroyedTogether(*this, parts_->GetBus())) {
        parts_->Remove(*this);
    }
    parts_ = nullptr;
    Signal::LeaveAll();
}

Bus* BusPart::GetParentBus() const noexcept {
    return parts_ == nullptr ? nullptr : &parts_->GetBus();
}

Polarity BusPart::GetPortPolarity() const {
    return parts_ == nullptr ? Polarity(GetDirection()) : parts_->GetBus().GetPortPolarity();
}

Port::StringBase<char> BusPart::GetDummySignalName() const {
    return Names::DummyOfPart(GetNameView());
}

void BusPart::GetBaseName(StringSet& names) const {
    names.Add(Names::BeforeParenthesis(GetNameView()));
}

Port::StringBase<char> BusPart::GetBaseName() const {
    return Names::BeforeParenthesis(GetNameView());
}

void BusSlice::SetPortPolarity(const Polarity& /*polarity*/) {}

void BusSlice::AcceptSignal(SignalVisitor& visitor) {
    visitor.VisitBusSlice(this);
    visitor.VisitSignal(this);
}

int BusSlice::GetWidth() const {
    return Names::GetWidth(GetNameView());
}

BusSlice* BusSlice::CreateDummySignal(Bus* parent) const {
    return new BusSlice(GetDummySignalName().CStr(), parent);
}

bool BusSlice::GetIndex(Port::StringBase<char>& left, Port::StringBase<char>& right) const {
    return Names::GetIndexTexts(GetNameView(), left, right);
}

bool BusSlice::IsDownTo() const noexcept {
    return Names::IsDownTo(GetNameView());
}

bool BusSlice::IsSameDirectionAsParent() const noexcept {
    const Bus* const parent = GetParentBus();
    if (parent == nullptr) {
        return true;
    }
    Names::BusName parsed;
    const bool isBus = Names::ParseBus(GetNameView(), parsed);
    const bool isOneBit = isBus && parsed.IsOneBit();
    return !isOneBit && (isBus && parsed.IsDownTo()) == parent->IsDownTo();
}

void BusIndex::AcceptSignal(SignalVisitor& visitor) {
    visitor.VisitBusIndex(this);
    visitor.VisitSignal(this);
}

BusIndex* BusIndex::CreateDummySignal(Bus* parent) const {
    return new BusIndex(GetDummySignalName().CStr(), parent);
}

Port::StringBase<char> BusIndex::GetIndex() const {
    Names::BitName parsed;
    return Names::ParseBit(GetNameView(), parsed) ? parsed.index : std::string_view();
}

bool BusIndex::IsBusIndexName(const char* name) noexcept {
    Names::BitName parsed;
    return Names::ParseBit(Port::ViewOf(name), parsed);
}

bool BusIndex::ParseBusIndexName(const char* name, Port::StringBase<char>& base,
                                 Port::StringBase<char>& index) {
    const Port::StringBase<char> text = name;
    Names::BitName parsed;
    if (!Names::ParseBit(text, parsed)) {
        return false;
    }
    base = parsed.base;
    index = parsed.index;
    return true;
}

bool BusIndex::ParseBusIndexName(const char* name, Port::StringBase<char>& base, int& index) {
    const Port::StringBase<char> text = name;
    Names::BitName parsed;
    if (!Names::ParseBit(text, parsed)) {
        return false;
    }
    base = parsed.base;
    index = parsed.value;
    return true;
}

} // namespace Orn_Hdl
