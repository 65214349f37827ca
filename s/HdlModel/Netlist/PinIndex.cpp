#include "HdlModel/Netlist/PinIndex.h"

#include "HdlModel/Objects/OwnerLink.h"

#include <new>

namespace Orn_Hdl {

/// The value of the slot for a pin's name; zero if there is none.
std::uint32_t PinIndex::FindValue(const PinList& pins, const NameKey& key) const noexcept {
    return slots_.Find(key.GetHash(), [&](std::uint32_t hash, std::uint32_t value) {
        // The component may have got more pins since the instance was created.
        const Pin* const pin = hash == key.GetHash() ? pins.GetAtPlace(value - 1) : nullptr;
        return pin != nullptr && EqualFolded(pin->GetNameView(), key.GetName());
    });
}

Pin* PinIndex::Find(const PinList& pins, std::string_view name) const noexcept {
    const NameKey key(name);
    const std::uint32_t value = FindValue(pins, key);
    if (!others_.empty()) {
        const auto other = others_.lower_bound({key.GetHash(), 0});
        if (other != others_.end() && other->first == key.GetHash()) {
            // Which of several pins with one name comes first depends on how the list was sorted.
            return pins.FindOneByOne(name);
        }
    }
    return value == 0 ? nullptr : pins.GetAtPlace(value - 1);
}

void PinIndex::Enter(const PinList& pins, std::uint32_t place) {
    const NameKey key(pins.GetAtPlace(place)->GetNameView());
    if (FindValue(pins, key) != 0) {
        others_.insert({key.GetHash(), place});
    } else {
        slots_.Add(key.GetHash(), place + 1);
    }
}

std::uint32_t PinIndex::TakeOut(const PinList& pins, const Pin& pin) noexcept {
    const NameKey key(pin.GetNameView());
    const std::uint32_t value = FindValue(pins, key);
    const bool isInSlot = pins.GetAtPlace(value - 1) == &pin;
    for (auto other = others_.lower_bound({key.GetHash(), 0});
         other != others_.end() && other->first == key.GetHash(); ++other) {
        const std::uint32_t place = other->second;
        const Pin* const found = pins.GetAtPlace(place);
        const bool isWanted =
            isInSlot ? found != nullptr && EqualFolded(found->GetNameView(), key.GetName())
                     : found == &pin;
        if (isWanted) {
            others_.erase(other);
            if (!isInSlot) {
                return place;
            }
            slots_.Replace(key.GetHash(), value, place + 1);
            return value - 1;
        }
    }
    slots_.Remove(key.GetHash(), value);
    return value - 1;
}

PinRenaming::PinRenaming(const Pin& pin) noexcept : list_(OwnerLink::Get<PinList>(pin)) {
    if (list_ != nullptr && list_->MakeOwnIndex()) {
        place_ = list_->index_->TakeOut(*list_, pin);
    } else {
        list_ = nullptr;
    }
}

PinRenaming::~PinRenaming() {
    if (list_ != nullptr) {
        list_->Enter(place_);
    }
}

} // namespace Orn_Hdl
