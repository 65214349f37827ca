#include "Orn_Hdl/Model/Signals/Signal.h"

#include "HdlModel/Objects/ObjectDetails.h"
#include "HdlModel/Signals/PinLinks.h"
#include "HdlModel/Signals/References.h"
#include "HdlModel/Signals/SignalLinks.h"

namespace Orn_Hdl {

Signal::Signal(const char* name) : Object(ObjectTypeSignal) {
    Object::SetName(name);
}

Signal::~Signal() {
    Signal::LeaveAll();
}

void Signal::LeaveAll() noexcept {
    PinLinks::DisconnectAll(*this);
    References::Leave(*this);
}

void Signal::AcceptObject(ObjectVisitor& visitor) {
    visitor.VisitSignal(this);
}

Signal::Links& Signal::MakeLinks() {
    if (links_ == nullptr) {
        links_ = std::make_unique<Links>();
    }
    return *links_;
}

void Signal::Forget(Signal* signal) noexcept {
    References::ForgetAlias(*this, *signal);
}

void Signal::ReplaceReference(Signal* from, Signal* to) {
    References::ReplaceAlias(*this, *from, *to);
}

void Signal::Connect(Pin* pin) {
    if (pin != nullptr) {
        PinLinks::Connect(*this, *pin);
    }
}

void Signal::Connect(Signal* other) {
    if (other != nullptr && other != this) {
        References::AddAlias(*this, *other);
    }
}

void Signal::Disconnect(Pin* pin) {
    if (pin != nullptr) {
        PinLinks::Disconnect(*this, *pin);
    }
}

void Signal::Disconnect(Signal* other) {
    if (other != nullptr) {
        References::RemoveAlias(*this, *other);
    }
}

void Signal::DisconnectAll() {
    PinLinks::DisconnectAll(*this);
    References::RemoveAliases(*this);
}

void Signal::CloneConnection(Signal* other) {
    if (other == nullptr || other == this) {
        return;
    }
    for (Pin* pin : other->GetPinIterator()) {
        if (pin->GetSignal() == other) {
            Connect(pin);
        }
    }
    for (Signal* alias : other->GetSignalIterator()) {
        Connect(alias);
    }
}

Iterator<Signal*> Signal::GetSignalIterator() const noexcept {
    // The list is made with the first alias.
    return Iterator<Signal*>(this, [](const void* signal) {
        return References::GetAliases(*static_cast<const Signal*>(signal));
    });
}

void Signal::AssignConstantValue(const BitVectorValue& value) {
    MakeDetails().value = std::make_unique<BitVectorValue>(value);
}

void Signal::AssignConstantValue(const char* value) {
    AssignConstantValue(BitVectorValue(value));
}

const BitVectorValue& Signal::GetConstantValue() const noexcept {
    const ObjectDetails* const details = GetDetails();
    return details == nullptr || details->value == nullptr ? NoValue() : *details->value;
}

bool Signal::HasMultiDriver() const noexcept {
    int drivers = 0;
    for (const Pin* pin : GetPinIterator()) {
        if (pin->GetSignal() == this && pin->GetPolarity().GetValue() == Polarity::Output &&
            ++drivers > 1) {
            return true;
        }
    }
    return false;
}

} // namespace Orn_Hdl
