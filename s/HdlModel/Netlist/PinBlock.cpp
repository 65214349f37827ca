#include "HdlModel/Netlist/PinBlock.h"

#include "Containers/PlaceOf.h"
#include "HdlModel/Netlist/PinIndex.h"
#include "HdlModel/Objects/OwnerLink.h"
#include "Port/Pool.h"

namespace Orn_Hdl {

void PinBlock::Add(PinList& pins, std::unique_ptr<Pin> pin) {
    pins.Add(pin.get());
    OwnerLink::Set(*pin.release(), &pins);
    pins.IndexLast();
}

void PinBlock::LetGo(PinList& pins, Pin& pin) noexcept {
    const int index = PlaceOf<Pin>(pins, &pin);
    if (!pins.IsBorrowed()) {
        // The positions of the pins after this one change.
        pins.RemoveAt(index);
        if (pins.index_ != nullptr) {
            pins.IndexAll();
        }
    } else {
        if (pins.MakeOwnIndex()) {
            pins.index_->TakeOut(pins, pin);
        }
        pins.RemoveAt(index);
    }
    OwnerLink::Set(pin, nullptr);
}

bool PinBlock::Owns(const Component& component, const Pin& pin) noexcept {
    return OwnerLink::Get<PinList>(pin) == &component.pins_;
}

void PinBlock::Remove(PinList& pins, Pin* pin) noexcept {
    if (pin != nullptr && OwnerLink::Get<PinList>(*pin) == &pins) {
        delete pin;
    }
}

/// Removes the last pin from a list whose pins are all being destroyed.
Pin* PinBlock::TakeLast(PinList& pins) noexcept {
    Pin* const last = pins.GetTail();
    if (last != nullptr) {
        pins.RemoveTail();
        OwnerLink::Set(*last, nullptr);
    }
    return last;
}

void PinBlock::DeleteAll(PinList& pins) noexcept {
    while (Pin* const last = TakeLast(pins)) {
        delete last;
    }
}

void PinBlock::CloneAll(const PinList& from, PinList& to) {
    const auto count = static_cast<std::size_t>(from.GetSize());
    if (count == 0) {
        return;
    }
    auto* const block = static_cast<char*>(
        Port::Pool::AllocatePacked(count * (PlaceSize + sizeof(void*)), Port::Pool::DesignObjects));
    void** const pointers = reinterpret_cast<void**>(block + count * PlaceSize);
    std::size_t made = 0;
    try {
        for (; made < count; ++made) {
            Pin* const pin =
                from.GetAt(static_cast<int>(made))->CloneInto(block + made * PlaceSize);
            OwnerLink::Set(*pin, &to);
            pointers[made] = pin;
        }
    } catch (...) {
        to.Borrow(pointers, static_cast<int>(made), static_cast<int>(made));
        Destroy(to, block);
        throw;
    }
    to.Borrow(pointers, from.GetSize(), from.GetSize());
    if (from.index_ != nullptr) {
        to.index_ = from.index_;
        to.index_->Join();
    }
}

Pin* PinBlock::GetAtPlace(const PinList& pins, std::uint32_t place) noexcept {
    const auto count = static_cast<std::size_t>(pins.GetCapacity());
    char* const end = reinterpret_cast<char*>(pins.GetItems());
    return place < count ? reinterpret_cast<Pin*>(end - (count - place) * PlaceSize) : nullptr;
}

void PinBlock::DestroyAll(PinList& pins) noexcept {
    // Pins may have been sorted or removed since. The array still has room for those that were
    // made, whose places stand before it.
    const auto count = static_cast<std::size_t>(pins.GetCapacity());
    if (count > 0) {
        Destroy(pins, reinterpret_cast<char*>(pins.GetItems()) - count * PlaceSize);
    }
}

void PinBlock::Destroy(PinList& pins, void* block) noexcept {
    while (Pin* const last = TakeLast(pins)) {
        last->~Pin();
    }
    Port::Pool::Free(block);
}

} // namespace Orn_Hdl
