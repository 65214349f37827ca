#include "Orn_Hdl/Model/Component.h"

#include "HdlModel/Names/NaturalSort.h"
#include "HdlModel/Netlist/PinIndex.h"
#include "HdlModel/Signals/SignalCast.h"
#include "Port/Ascii.h"
#include "Port/Pool.h"

#include <algorithm>
#include <functional>
#include <unordered_set>
#include <vector>

namespace Orn_Hdl {

PinList::PinList() noexcept = default;
PinList::~PinList() = default;

Pin* PinList::GetPin(const char* name) const {
    return GetPin(Port::ViewOf(name));
}

Pin* PinList::GetPin(std::string_view name) const {
    if (GetSize() > LongestUnindexed) {
        if (index_ == nullptr) {
            index_ = std::make_unique<PinIndex>();
        }
        return index_->Find(*this, name);
    }
    for (Pin* pin : Iterator<Pin*>(this)) {
        // The wanted name is normalised for the comparison; the pin's is already.
        if (EqualFolded(pin->GetNameView(), name)) {
            return pin;
        }
    }
    return nullptr;
}

void PinList::SortByPolarityAndName() {
    SortNaturally(*this, [](const Pin* pin) { return pin->GetPolarity().GetValue(); });
    if (index_ != nullptr) {
        index_->Forget();
    }
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

void Component::AddNewPin(std::unique_ptr<Pin> pin) {
    pins_.Add(pin.get());
    pin.release();
}

void Component::AddPin(const char* name, const Polarity& polarity,
                       const BitVectorValue& defaultValue) {
    std::unique_ptr<Pin> pin(Pin::Create(name, polarity));
    if (!defaultValue.GetValue().IsEmpty()) {
        pin->SetDefaultValue(defaultValue);
    }
    AddNewPin(std::move(pin));
}

void Component::AddPin(const char* name, const Polarity& polarity, const char* defaultValue) {
    AddPin(name, polarity, BitVectorValue(defaultValue));
}

void Component::AddPin(const Pin& pin) {
    AddNewPin(std::unique_ptr<Pin>(pin.ClonePin()));
}

/// The pins of an instance stand in one block of memory, in the order of the component's pins, and
/// behind them the array of pointers to them.
class PinBlock {
public:
    static void CloneAll(const PinList& from, PinList& to) {
        const auto count = static_cast<std::size_t>(from.GetSize());
        if (count == 0) {
            return;
        }
        auto* const block = static_cast<char*>(Port::Pool::AllocatePacked(
            count * (PlaceSize + sizeof(void*)), Port::Pool::DesignObjects));
        void** const pointers = reinterpret_cast<void**>(block + count * PlaceSize);
        std::size_t made = 0;
        try {
            for (; made < count; ++made) {
                const Pin* const pin = from.GetAt(static_cast<int>(made));
                pointers[made] = pin->CloneInto(block + made * PlaceSize);
            }
        } catch (...) {
            to.Borrow(pointers, static_cast<int>(made), static_cast<int>(made));
            Destroy(to, block);
            throw;
        }
        to.Borrow(pointers, from.GetSize(), from.GetSize());
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

private:
    static constexpr std::size_t PlaceSize = sizeof(ScalarPin);
    static_assert(sizeof(BusPin) == PlaceSize && sizeof(BusIndexPin) == PlaceSize);
    static_assert(alignof(ScalarPin) <= 8);

    static void Destroy(PinList& pins, void* block) noexcept {
        for (int i = pins.GetSize(); i > 0; --i) {
            pins.GetAt(i - 1)->~Pin();
        }
        pins.Empty();
        Port::Pool::Free(block);
    }
};

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
