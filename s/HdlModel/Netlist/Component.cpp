#include "Orn_Hdl/Model/Component.h"

#include "HdlModel/Names/NaturalSort.h"
#include "HdlModel/Netlist/NetlistOwner.h"
#include "HdlModel/Netlist/PinBlock.h"
#include "HdlModel/Netlist/PinIndex.h"
#include "HdlModel/Signals/SignalCast.h"
#include "Port/Ascii.h"

#include <new>
#include <unordered_set>
#include <utility>
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
        // The wanted name is normalised for the comparison; the pin's name already is.
        if (EqualFolded(pin->GetNameView(), name)) {
            return pin;
        }
    }
    return nullptr;
}

Pin* PinList::GetAtPlace(std::uint32_t place) const noexcept {
    return IsBorrowed() ? PinBlock::GetAtPlace(*this, place) : GetAt(static_cast<int>(place));
}

void PinList::IndexLast() noexcept {
    if (index_ == nullptr && GetSize() == LongestUnindexed + 1) {
        IndexAll();
    } else {
        Enter(static_cast<std::uint32_t>(GetSize() - 1));
    }
}

void PinList::IndexAll() noexcept {
    DropIndex();
    if (GetSize() > LongestUnindexed) {
        index_ = new (std::nothrow) PinIndex();
        for (int i = 0; i < GetSize(); ++i) {
            Enter(static_cast<std::uint32_t>(i));
        }
    }
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

/// Instances refer to their component through this anchor, so that the component can be destroyed
/// before them.
struct ComponentAnchor {
    const Component* component;
    std::size_t users;

    void Leave() noexcept {
        if (--users == 0) {
            delete this;
        }
    }
};

Component::Component(const Port::TextArgument& name)
    : Object(ObjectTypeComponent), anchor_(nullptr) {
    Object::SetName(name);
    // Allocated last: if allocating the name failed, nobody would free the anchor.
    anchor_ = new ComponentAnchor{this, 1};
}

Component::~Component() {
    NetlistOwner::Leave(*this);
    anchor_->component = nullptr;
    anchor_->Leave();
    PinBlock::DeleteAll(pins_);
}

void Component::AcceptObject(ObjectVisitor& visitor) {
    visitor.VisitComponent(this);
}

void Component::AddPin(const Port::TextArgument& name, const Polarity& polarity,
                       const BitVectorValue& defaultValue) {
    std::unique_ptr<Pin> pin(Pin::Create(name, polarity));
    if (!defaultValue.GetValue().IsEmpty()) {
        pin->SetDefaultValue(defaultValue);
    }
    PinBlock::Add(pins_, std::move(pin));
}

void Component::AddPin(const Port::TextArgument& name, const Polarity& polarity,
                       const Port::TextArgument& defaultValue) {
    AddPin(name, polarity, BitVectorValue(defaultValue));
}

void Component::AddPin(const Pin& pin) {
    PinBlock::Add(pins_, std::unique_ptr<Pin>(pin.ClonePin()));
}

void Component::RemovePin(Pin* pin) noexcept {
    PinBlock::Remove(pins_, pin);
}

Instance::Instance(const Port::TextArgument& name, const Component* component)
    : Object(ObjectTypeInstance), anchor_(component == nullptr ? nullptr : component->anchor_) {
    Object::SetName(name);
    if (component != nullptr) {
        PinBlock::CloneAll(component->pins_, pins_);
        ++anchor_->users;
    }
}

Instance::~Instance() {
    NetlistOwner::Leave(*this);
    PinBlock::DestroyAll(pins_);
    if (anchor_ != nullptr) {
        anchor_->Leave();
    }
}

void Instance::AcceptObject(ObjectVisitor& visitor) {
    visitor.VisitInstance(this);
}

void Instance::RemovePin(Pin* pin) noexcept {
    PinBlock::Remove(pins_, pin);
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
