#include "HdlModel/Signals/PinLinks.h"

#include "Containers/PlaceOf.h"
#include "HdlModel/Objects/ObjectDetails.h"
#include "HdlModel/Signals/SignalLinks.h"

#include <algorithm>
#include <vector>

namespace Orn_Hdl {

PinLinks::State PinLinks::GetState(const Pin& pin, const Signal& signal) noexcept {
    if (pin.signal_ == &signal) {
        return pin.HasFlag(Pin::ListedFlag) ? State::Listed : State::Unlisted;
    }
    return IsFormer(pin, signal) ? State::Former : State::Apart;
}

bool PinLinks::IsFormer(const Pin& pin, const Signal& signal) noexcept {
    const ObjectDetails* const details = pin.GetDetails();
    if (details == nullptr) {
        return false;
    }
    // The shorter list is searched.
    const std::vector<Signal*>& former = details->formerSignals;
    if (former.size() <= static_cast<std::size_t>(signal.pins_.GetSize())) {
        return std::find(former.begin(), former.end(), &signal) != former.end();
    }
    for (const Pin* listed : signal.GetPinIterator()) {
        if (listed == &pin) {
            return true;
        }
    }
    return false;
}

/// Makes room for remembering the signal at which a pin points, if that goes on listing it.
void PinLinks::PrepareToOpen(Pin& pin) {
    if (pin.signal_ != nullptr && pin.HasFlag(Pin::ListedFlag)) {
        std::vector<Signal*>& former = pin.MakeDetails().formerSignals;
        if (former.size() == former.capacity()) {
            former.reserve(std::max<std::size_t>(1, former.size() * 2));
        }
    }
}

/// Opens a pin for which `PrepareToOpen` was called.
void PinLinks::Open(Pin& pin) noexcept {
    if (pin.signal_ == nullptr) {
        return;
    }
    if (pin.HasFlag(Pin::ListedFlag)) {
        pin.GetDetails()->formerSignals.push_back(pin.signal_);
    } else {
        DropUnlisted(*pin.signal_, pin);
    }
    Point(pin, nullptr, false);
}

void PinLinks::Point(Pin& pin, Signal* signal, bool isListed) noexcept {
    pin.signal_ = signal;
    pin.SetFlag(Pin::ListedFlag, isListed);
}

void PinLinks::DropFormer(Pin& pin, const Signal& signal) noexcept {
    EraseOne(pin.GetDetails()->formerSignals, &signal);
}

void PinLinks::DropListed(Signal& signal, const Pin& pin) noexcept {
    signal.pins_.RemoveAt(PlaceOf<Pin>(signal.pins_, &pin));
}

void PinLinks::DropUnlisted(Signal& signal, const Pin& pin) noexcept {
    EraseOne(signal.links_->unlistedPins, &pin);
}

void PinLinks::Connect(Signal& signal, Pin& pin) {
    switch (GetState(pin, signal)) {
    case State::Apart:
        PrepareToOpen(pin);
        signal.pins_.Add(&pin);
        Open(pin);
        Point(pin, &signal, true);
        break;
    case State::Unlisted:
        signal.pins_.Add(&pin);
        DropUnlisted(signal, pin);
        Point(pin, &signal, true);
        break;
    case State::Listed:
        break;
    case State::Former:
        PointAt(pin, &signal);
        break;
    }
}

void PinLinks::PointAt(Pin& pin, Signal* signal) {
    if (signal == pin.signal_) {
        return;
    }
    const bool isFormer = signal != nullptr && IsFormer(pin, *signal);
    PrepareToOpen(pin);
    if (signal != nullptr && !isFormer) {
        signal->MakeLinks().unlistedPins.push_back(&pin);
    }
    Open(pin);
    if (isFormer) {
        DropFormer(pin, *signal);
    }
    Point(pin, signal, isFormer);
}

void PinLinks::Disconnect(Signal& signal, Pin& pin) noexcept {
    switch (GetState(pin, signal)) {
    case State::Apart:
        break;
    case State::Unlisted:
        DropUnlisted(signal, pin);
        Point(pin, nullptr, false);
        break;
    case State::Listed:
        DropListed(signal, pin);
        Point(pin, nullptr, false);
        break;
    case State::Former:
        DropListed(signal, pin);
        DropFormer(pin, signal);
        break;
    }
}

void PinLinks::DisconnectAll(Signal& signal) noexcept {
    for (Pin* pin : signal.GetPinIterator()) {
        if (pin->signal_ == &signal) {
            Point(*pin, nullptr, false);
        } else {
            DropFormer(*pin, signal);
        }
    }
    signal.pins_.Empty();
    if (signal.links_ != nullptr) {
        for (Pin* pin : signal.links_->unlistedPins) {
            Point(*pin, nullptr, false);
        }
        signal.links_->unlistedPins.clear();
    }
}

void PinLinks::Leave(Pin& pin) noexcept {
    if (ObjectDetails* const details = pin.GetDetails()) {
        for (Signal* former : details->formerSignals) {
            DropListed(*former, pin);
        }
        details->formerSignals.clear();
    }
    if (pin.signal_ != nullptr) {
        Disconnect(*pin.signal_, pin);
    }
}

void PinLinks::MoveUnlisted(Signal& from, Signal& to) {
    if (from.links_ == nullptr) {
        return;
    }
    const std::vector<Pin*> pins = from.links_->unlistedPins;
    for (Pin* pin : pins) {
        PointAt(*pin, &to);
    }
}

bool PinLinks::HasPinOf(const Signal& signal, int polarity) noexcept {
    const auto matches = [&signal, polarity](const Pin* pin) {
        const int value = pin->GetPolarity().GetValue();
        return pin->signal_ == &signal && (value == polarity || value == Polarity::BiDirectional);
    };
    for (const Pin* pin : signal.GetPinIterator()) {
        if (matches(pin)) {
            return true;
        }
    }
    return signal.links_ != nullptr && std::any_of(signal.links_->unlistedPins.begin(),
                                                   signal.links_->unlistedPins.end(), matches);
}

bool PinLinks::IsListed(const Pin& pin) noexcept {
    return pin.signal_ != nullptr && pin.HasFlag(Pin::ListedFlag);
}

const std::vector<Pin*>& PinLinks::GetUnlisted(const Signal& signal) noexcept {
    static const std::vector<Pin*> none;
    return signal.links_ == nullptr ? none : signal.links_->unlistedPins;
}

} // namespace Orn_Hdl
