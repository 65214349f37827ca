#include "Orn_Hdl/Model/Signals/Bus.h"

#include "HdlModel/Names/Names.h"
#include "HdlModel/Netlist/NetlistOwner.h"
#include "HdlModel/Signals/BusParts.h"
#include "HdlModel/Signals/SignalBits.h"
#include "Orn_Hdl/Model/Signals/SignalVisitor.h"

#include <cstdint>

namespace Orn_Hdl {

Bus::Bus(const Port::TextArgument& name)
    : Signal(name), parts_(std::make_unique<BusParts>(*this)) {}

Bus::~Bus() {
    NetlistOwner::Leave(*this);
    Bus::LeaveAll();
}

void Bus::LeaveAll() noexcept {
    parts_->RemoveAll();
    Signal::LeaveAll();
}

void Bus::AcceptSignal(SignalVisitor& visitor) {
    visitor.VisitBus(this);
    visitor.VisitSignal(this);
}

int Bus::GetWidth() const {
    return Names::GetWidth(GetNameView());
}

Port::StringBase<char> Bus::GetDummySignalName() const {
    return Names::IsDummy(Names::BeforeParenthesis(GetNameView()))
               ? std::string(GetNameView())
               : Names::DummyOfPart(GetNameView());
}

void Bus::GetBaseName(StringSet& names) const {
    names.Add(Names::BeforeParenthesis(GetNameView()));
}

Bus* Bus::CreateDummySignal() const {
    return new Bus(GetDummySignalName().CStr());
}

Port::StringBase<char> Bus::GetBaseName() const {
    return Names::BeforeParenthesis(GetNameView());
}

bool Bus::GetIndex(Port::StringBase<char>& left, Port::StringBase<char>& right) const {
    return Names::GetIndexTexts(GetNameView(), left, right);
}

bool Bus::GetIndex(int& left, int& right) const noexcept {
    Names::BusName parsed;
    if (!Names::ParseBus(GetNameView(), parsed)) {
        return false;
    }
    left = parsed.leftIndex;
    right = parsed.rightIndex;
    return true;
}

bool Bus::IsDownTo() const noexcept {
    return Names::IsDownTo(GetNameView());
}

void Bus::AddBusSlice(Signal* slice) {
    if (slice != nullptr) {
        parts_->AddAny(*slice);
    }
}

void Bus::RemoveBusSlice(Signal* slice) {
    parts_->RemoveAny(slice);
}

void Bus::EmptyBusSlice() {
    parts_->RemoveAll();
}

Iterator<Signal*> Bus::GetBusSliceIterator() const noexcept {
    return Iterator<Signal*>(&parts_->GetSignals());
}

void Bus::Forget(Signal* signal) noexcept {
    Signal::Forget(signal);
    parts_->Forget(*signal);
}

void Bus::ReplaceReference(Signal* from, Signal* to) {
    Signal::ReplaceReference(from, to);
    if (parts_->GetSignals().Contains(from)) {
        parts_->RemoveAny(from);
        parts_->AddAny(*to);
    }
}

bool Bus::IsBusName(const char* name) noexcept {
    Names::BusName parsed;
    return Names::ParseBus(Port::ViewOf(name), parsed);
}

bool Bus::ParseBusName(const char* name, Port::StringBase<char>& base, Port::StringBase<char>& left,
                       Port::StringBase<char>& right) {
    // Copies first: the results may be put where the name stands.
    const Port::StringBase<char> text = name;
    Names::BusName parsed;
    if (!Names::ParseBus(text, parsed)) {
        return false;
    }
    base = parsed.base;
    left = parsed.left;
    right = parsed.right;
    return true;
}

bool Bus::ParseBusName(const char* name, Port::StringBase<char>& base, int& left, int& right) {
    const Port::StringBase<char> text = name;
    Names::BusName parsed;
    if (!Names::ParseBus(text, parsed)) {
        return false;
    }
    base = parsed.base;
    left = parsed.leftIndex;
    right = parsed.rightIndex;
    return true;
}

bool Bus::ParseBusName(const char* name, StringArray& bits) {
    Names::BusName parsed;
    if (!Names::ParseBus(Port::ViewOf(name), parsed) || !parsed.IsExpandable()) {
        return false;
    }
    SignalBits::AppendTo(bits, parsed);
    return true;
}

Port::StringBase<char> Bus::GetBusSliceName(const char* name, int start, int count) {
    Names::BusName parsed;
    if (!Names::ParseBus(Port::ViewOf(name), parsed)) {
        return Names::WithRange(Port::ViewOf(name), start, count);
    }
    const std::int64_t last = std::int64_t(start) + count - 1;
    return Names::WithRange(parsed.base, parsed.IndexAt(start), parsed.IndexAt(last));
}

} // namespace Orn_Hdl
