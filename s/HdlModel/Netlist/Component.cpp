#include "Orn_Hdl/Model/Component.h"

#include "Containers/Reordering.h"
#include "HdlModel/Names/NaturalSort.h"
#include "HdlModel/Netlist/PinIndex.h"
#include "HdlModel/Signals/SignalCast.h"
#include "Port/Ascii.h"
#include "Port/Pool.h"

#include <algorithm>
#include <functional>
#include <memory>
#include <new>
#include <unordered_set>
#include <vector>

namespace Orn_Hdl {

PinList::PinList() noexcept = default;

PinList::~PinList() {
    DropIndex();
}

Pin* PinList::GetPin(const char* name) const {
    return GetPin(Port::ViewOf(name));
}

Pin* PinList::GetPin(std::string_view name) const {
    return index_ == nullptr ? FindOneByOne(name) : index_->Find(*this, name);
}

Pin* PinList::FindOneByOne(std::string_view name) const noexcept {
    for (Pin* pin : Iterator<Pin*>(this)) {
        // The wanted name is normalised for the comparison; the pin's is already.
        if (EqualFolded(pin->GetNameView(), name)) {
            return pin;
        }
    }
    return nullptr;
}

void PinList::IndexLast() noexcept {
    const int size = GetSize();
    if (size == LongestUnindexed + 1) {
        index_ = new (std::nothrow) PinIndex();
        for (std::uint32_t i = 0; i < LongestUnindexed; ++i) {
            Enter(i);
        }
    }
    Enter(static_cast<std::uint32_t>(size - 1));
}

void PinList::Enter(std::uint32_t place) noexcept {
    if (index_ != nullptr) {
        try {
            index_->Enter(*this, place);
        } catch (const std::bad_alloc&) {
            DropIndex();
        }
    }
}

bool PinList::MakeOwnIndex() noexcept {
    if (index_ != nullptr && index_->IsShared()) {
        PinIndex* own = nullptr;
        try {
            own = index_->Clone();
        } catch (const std::bad_alloc&) {
            own = nullptr;
        }
        index_->Leave();
        index_ = own;
    }
    return index_ != nullptr;
}

void PinList::DropIndex() noexcept {
    if (index_ != nullptr) {
        index_->Leave();
        index_ = nullptr;
    }
}

void PinList::SortByPolarityAndName() {
    SortNaturally(*this, [](const Pin* pin) { return pin->GetPolarity().GetValue(); });
}

/// What the instances of a component hold in place of a pointer to it, so that the component can
/// end before them.
struct ComponentAnchor {
    const Component* component;
    std::size_t users;

    void Leave() noexcept {
        if (--users == 0) {
            delete this;
        }
    }
};

Component::Component(const char* name) : Object(ObjectTypeComponent), anchor_(nullptr) {
    Object::SetName(name);
    // Last: nobody would give it back if the name found no memory.
    anchor_ = new ComponentAnchor{this, 1};
}

Component::~Component() {
    anchor_->component = nullptr;
    anchor_->Leave();
    for (int i = pins_.GetSize(); i > 0; --i) {
        delete pins_.GetAt(i - 1);
    }
}

void Component::AcceptObject(ObjectVisitor& visitor) {
    visitor.VisitComponent(this);
}

void Component::AddClone(const Pin& pin) {
    void* const memory =
        Port::Pool::Allocate(sizeof(Pin) + PinHome::Size, Port::Pool::DesignObjects);
    Pin* clone = nullptr;
    try {
        clone = pin.CloneInto(memory);
        pins_.Add(clone);
    } catch (...) {
        if (clone != nullptr) {
            clone->~Pin();
        }
        Port::Pool::Free(memory);
        throw;
    }
    PinHome::Set(*clone, &pins_);
    pins_.IndexLast();
}

void Component::AddPin(const char* name, const Polarity& polarity,
                       const BitVectorValue& defaultValue) {
    std::unique_ptr<Pin> pin(Pin::Create(name, polarity));
    if (!defaultValue.GetValue().IsEmpty()) {
        pin->SetDefaultValue(defaultValue);
    }
    AddClone(*pin);
}

void Component::AddPin(const char* name, const Polarity& polarity, const char* defaultValue) {
    AddPin(name, polarity, BitVectorValue(defaultValue));
}

void Component::AddPin(const Pin& pin) {
    AddClone(pin);
}

/// The pins of an instance stand in one block of memory, in the order of the component's pins, and
/// behind them the array of pointers to them. Behind each pin of a long list stands its home.
class PinBlock {
public:
    static void CloneAll(const PinList& from, PinList& to) {
        const auto count = static_cast<std::size_t>(from.GetSize());
        if (count == 0) {
            return;
        }
        const std::size_t placeSize = PlaceSizeFor(from.GetSize());
        auto* const block = static_cast<char*>(Port::Pool::AllocatePacked(
            count * (placeSize + sizeof(void*)), Port::Pool::DesignObjects));
        void** const pointers = reinterpret_cast<void**>(block + count * placeSize);
        std::size_t made = 0;
        try {
            for (; made < count; ++made) {
                const Pin* const pin = from.GetAt(static_cast<int>(made));
                pointers[made] = pin->CloneInto(block + made * placeSize);
            }
        } catch (...) {
            to.Borrow(pointers, static_cast<int>(made), static_cast<int>(made));
            Destroy(to, block);
            throw;
        }
        to.Borrow(pointers, from.GetSize(), from.GetSize());
        if (placeSize > sizeof(Pin)) {
            SettleAll(to);
            to.index_ = from.index_;
            if (to.index_ != nullptr) {
                to.index_->Join();
            }
        }
    }

    static void DestroyAll(PinList& pins) noexcept {
        if (!pins.IsEmpty()) {
            // The pins may have been sorted since: the block begins at the lowest of them.
            Pin* first = pins.GetAt(0);
            for (Pin* pin : Iterator<Pin*>(&pins)) {
                first = std::min(first, pin, std::less<>());
            }
            Destroy(pins, first);
        }
    }

    /// The pin that stood at a place of the list before it was sorted.
    static Pin* GetAtPlace(const PinList& pins, std::uint32_t place) noexcept {
        const auto count = static_cast<std::size_t>(pins.GetSize());
        char* const end = reinterpret_cast<char*>(Reordering::GetPlaces(pins));
        return reinterpret_cast<Pin*>(end - (count - place) * PlaceSizeFor(pins.GetSize()));
    }

private:
    static_assert(sizeof(ScalarPin) == sizeof(Pin) && sizeof(BusPin) == sizeof(Pin) &&
                  sizeof(BusIndexPin) == sizeof(Pin));
    static_assert(alignof(Pin) <= 8);

    static std::size_t PlaceSizeFor(int count) noexcept {
        return sizeof(Pin) + (count > PinList::LongestUnindexed ? PinHome::Size : 0);
    }

    static void SettleAll(PinList& pins) noexcept {
        for (Pin* pin : Iterator<Pin*>(&pins)) {
            PinHome::Set(*pin, &pins);
        }
    }

    static void Destroy(PinList& pins, void* block) noexcept {
        for (int i = pins.GetSize(); i > 0; --i) {
            pins.GetAt(i - 1)->~Pin();
        }
        pins.Empty();
        Port::Pool::Free(block);
    }
};

Pin* PinList::GetAtPlace(std::uint32_t place) const noexcept {
    if (place >= static_cast<std::uint32_t>(GetSize())) {
        return nullptr;
    }
    return Reordering::IsInBorrowedPlaces(*this) ? PinBlock::GetAtPlace(*this, place)
                                                 : GetAt(static_cast<int>(place));
}

Instance::Instance(const char* name, const Component* component)
    : Object(ObjectTypeInstance), anchor_(component == nullptr ? nullptr : component->anchor_) {
    Object::SetName(name);
    if (component != nullptr) {
        PinBlock::CloneAll(component->pins_, pins_);
        ++anchor_->users;
    }
}

Instance::~Instance() {
    PinBlock::DestroyAll(pins_);
    if (anchor_ != nullptr) {
        anchor_->Leave();
    }
}

void Instance::AcceptObject(ObjectVisitor& visitor) {
    visitor.VisitInstance(this);
}

Component* Instance::GetComponent() const noexcept {
    return anchor_ == nullptr ? nullptr : const_cast<Component*>(anchor_->component);
}

Port::StringBase<char> Instance::GetComponentName() const {
    const Component* const component = GetComponent();
    return component == nullptr ? std::string_view() : component->GetNameView();
}

Attribute* Instance::GetComponentAttr(const char* name) const {
    const Component* const component = GetComponent();
    return component == nullptr ? nullptr : component->GetAttr(name);
}

bool Instance::GetOpenPin(PtrArray<Pin*>& pins, bool inputsOnly) const {
    for (Pin* pin : GetPinIterator()) {
        if (pin->GetSignal() == nullptr &&
            (!inputsOnly || pin->GetPolarity().GetValue() == Polarity::Input)) {
            pins.Add(pin);
        }
    }
    return !pins.IsEmpty();
}

namespace {

/// Whether a signal, or a signal of which it is made up, has a port polarity.
bool IsOnPort(Signal* signal, int portPolarity) {
    if (As<CompoundBus>(signal) == nullptr) {
        return signal->GetPortPolarity().GetValue() == portPolarity;
    }
    std::vector<const Signal*> rest{signal};
    std::unordered_set<const Signal*> met;
    while (!rest.empty()) {
        const Signal* const next = rest.back();
        rest.pop_back();
        const CompoundBus* const compound = As<CompoundBus>(next);
        if (compound == nullptr) {
            if (next->GetPortPolarity().GetValue() == portPolarity) {
                return true;
            }
        } else if (met.insert(compound).second) {
            for (const Signal* member : compound->GetBusMemberIterator()) {
                rest.push_back(member);
            }
        }
    }
    return false;
}

} // namespace

void Instance::GetPinsOnPort(int pinPolarity, int portPolarity, PtrArray<Pin*>& pins) const {
    for (Pin* pin : GetPinIterator()) {
        const int polarity = pin->GetPolarity().GetValue();
        if ((polarity == pinPolarity || polarity == Polarity::BiDirectional) &&
            pin->GetSignal() != nullptr && IsOnPort(pin->GetSignal(), portPolarity)) {
            pins.Add(pin);
        }
    }
}

void Instance::GetOutPortConnectedToInPin(PtrArray<Pin*>& pins) const {
    GetPinsOnPort(Polarity::Input, Polarity::Output, pins);
}

void Instance::GetInPortConnectedToOutPin(PtrArray<Pin*>& pins) const {
    GetPinsOnPort(Polarity::Output, Polarity::Input, pins);
}

} // namespace Orn_Hdl
