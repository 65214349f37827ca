#include "Orn_Hdl/Model/Netlist.h"

#include "HdlModel/Names/NameIndex.h"
#include "HdlModel/Names/Names.h"
#include "HdlModel/Names/NaturalSort.h"
#include "HdlModel/Netlist/DummySignals.h"
#include "HdlModel/Netlist/FeedBack.h"
#include "HdlModel/Netlist/Foresight.h"
#include "HdlModel/Netlist/NetlistOwner.h"
#include "HdlModel/Netlist/NetlistSorting.h"
#include "HdlModel/Netlist/ObjectList.h"
#include "HdlModel/Netlist/PinBlock.h"
#include "HdlModel/Netlist/Primitives.h"
#include "HdlModel/Netlist/ReadAhead.h"
#include "HdlModel/Netlist/RememberedDummies.h"
#include "HdlModel/Netlist/Removals.h"
#include "HdlModel/Objects/NameListener.h"
#include "HdlModel/Objects/ObjectKey.h"
#include "HdlModel/Objects/OwnerLink.h"
#include "HdlModel/Signals/BusParts.h"
#include "HdlModel/Signals/PinLinks.h"
#include "HdlModel/Signals/References.h"
#include "HdlModel/Signals/SignalCast.h"
#include "Port/Ascii.h"

#include <algorithm>
#include <memory>
#include <string>
#include <utility>
#include <vector>

namespace Orn_Hdl {

namespace {

/// The name under which the netlist found an object when it took it.
struct KeyName {
    std::string_view operator()(const Object* object) const noexcept {
        return ObjectKey::Get(*object);
    }
};

struct KeyBaseName {
    std::string_view operator()(const Bus* bus) const noexcept {
        return Names::BaseName(ObjectKey::Get(*bus));
    }
};

/// Components, instances and signals are found in one index: the operations that keep their names
/// apart ask for all three at once.
enum NameGroup : unsigned { ComponentGroup, InstanceGroup, SignalGroup };

constexpr NameGroup GroupOf(const Component* /*component*/) noexcept {
    return ComponentGroup;
}
constexpr NameGroup GroupOf(const Instance* /*instance*/) noexcept {
    return InstanceGroup;
}
constexpr NameGroup GroupOf(const Signal* /*signal*/) noexcept {
    return SignalGroup;
}

int ToLength(std::size_t length) noexcept {
    return static_cast<int>(std::min<std::size_t>(length, INT32_MAX));
}

} // namespace

struct Netlist::Implementation {
    ObjectList<Component> components;
    ObjectList<Instance> instances;
    ObjectList<Signal> signals;
    NameIndex<Object, KeyName> byName;
    NameIndex<Bus, KeyBaseName> busesByBaseName;
    Foresight foresight;
    DummySignals dummies;
    /// The instance that was added last, unless something has been removed since: the lines that
    /// connect an instance often follow the one that adds it.
    Instance* latest = nullptr;
    std::string sourceFileName;
    NameListener* nameListener = nullptr;
    std::uint64_t removals = 0;

    ~Implementation() {
        dummies.Clear();
        // Signals are destroyed first, so that instances have no signals to leave.
        References::LeaveTogether(signals.GetArray());
        DestroyAll(signals);
        DestroyAll(instances);
        DestroyAll(components);
    }

    /// Each object stays owned until its turn, so that it leaves the list if another object
    /// destroys it.
    template <class T> static void DestroyAll(ObjectList<T>& objects) noexcept {
        while (T* const last = objects.TakeOutLast()) {
            OwnedFlag::Clear(*last);
            delete last;
        }
    }

    void TellName() const noexcept {
        if (nameListener != nullptr) {
            nameListener->NameChanged();
        }
    }

    /// Takes ownership of an object that has no owner, and of no other.
    template <class T> void Take(T* object, ObjectList<T>& objects) {
        if (object == nullptr || OwnedFlag::Get(*object)) {
            return;
        }
        // All allocation comes first, so that what the netlist holds can always be found.
        std::unique_ptr<T> taken(object);
        MakeRoomFor(object);
        objects.Add(object);
        OwnedFlag::Set(*taken.release());
        OwnerLink::Set(*object, this);
        byName.Add(object, GroupOf(object));
        Enter(object);
    }

    /// Gives an object another name, under which it is found. There is room for it.
    template <class T> void Rename(T* object, ObjectName& name) noexcept {
        ForgetBaseName(object);
        byName.Remove(object, GroupOf(object));
        ObjectKey::Replace(*object, name);
        byName.Add(object, GroupOf(object));
        Enter(object);
    }

    /// Removes an object without destroying it.
    /// \return the object; null if the netlist does not hold it.
    template <class T> std::unique_ptr<T> Detach(T* object, ObjectList<T>& objects) noexcept {
        const int place = object == nullptr ? -1 : objects.Find(object);
        if (place < 0) {
            return nullptr;
        }
        ForgetBaseName(object);
        LetGo(*object, objects, place);
        return std::unique_ptr<T>(object);
    }

    /// Removes the object at a position. Classes derived from `T` may already be destroyed.
    template <class T> void LetGo(T& object, ObjectList<T>& objects, int place) noexcept {
        ++removals;
        latest = nullptr;
        Forget(&object);
        byName.Remove(&object, GroupOf(&object));
        objects.TakeOut(place);
        OwnedFlag::Clear(object);
        ObjectKey::Drop(object);
        OwnerLink::Set(object, nullptr);
    }

    void MakeRoomFor(const Object* /*object*/) { byName.MakeRoom(); }
    void MakeRoomFor(const Signal* signal) {
        byName.MakeRoom();
        if (As<Bus>(signal) != nullptr) {
            busesByBaseName.MakeRoom();
        }
    }

    void Enter(Object* /*object*/) {}
    void Enter(Instance* instance) { latest = instance; }
    void Enter(Signal* signal) {
        if (Bus* const bus = As<Bus>(signal)) {
            busesByBaseName.Add(bus);
        }
    }

    void Forget(Object* /*object*/) noexcept {}
    void Forget(Signal* signal) noexcept { dummies.Forget(signal); }

    void ForgetBaseName(Object* /*object*/) noexcept {}
    void ForgetBaseName(Signal* signal) noexcept {
        if (Bus* const bus = As<Bus>(signal)) {
            busesByBaseName.Remove(bus);
        }
    }
};

void NetlistOwner::LetGo(Component& component) noexcept {
    auto& netlist = *OwnerLink::Get<Netlist::Implementation>(component);
    netlist.LetGo(component, netlist.components, netlist.components.Find(&component));
}

void NetlistOwner::LetGo(Instance& instance) noexcept {
    auto& netlist = *OwnerLink::Get<Netlist::Implementation>(instance);
    netlist.LetGo(instance, netlist.instances, netlist.instances.Find(&instance));
}

void NetlistOwner::LetGo(Signal& signal) noexcept {
    auto& netlist = *OwnerLink::Get<Netlist::Implementation>(signal);
    netlist.LetGo(signal, netlist.signals, netlist.signals.Find(&signal));
}

void NetlistOwner::LetGo(Bus& bus) noexcept {
    OwnerLink::Get<Netlist::Implementation>(bus)->busesByBaseName.Remove(&bus);
    LetGo(static_cast<Signal&>(bus));
}

Netlist::Netlist(const Port::TextArgument& name)
    : Object(ObjectTypeNetlist), implementation_(std::make_unique<Implementation>()) {
    SetNameVerbatim(name == nullptr ? "hdlNetlist" : name.Get());
}

// NOLINTNEXTLINE(performance-noexcept-move-constructor)
Netlist::Netlist(Netlist&& other) : Netlist() {
    Swap(other);
}

// NOLINTNEXTLINE(performance-noexcept-move-constructor)
Netlist& Netlist::operator=(Netlist&& other) {
    Netlist taken(std::move(other));
    Swap(taken);
    return *this;
}

Netlist::~Netlist() = default;

void Netlist::Swap(Netlist& other) noexcept {
    SwapDetails(other);
    SwapAttrs(other);
    std::swap(implementation_, other.implementation_);
    std::swap(implementation_->nameListener, other.implementation_->nameListener);
    // Neither netlist holds what it held before, and the numbers must not come again.
    const std::uint64_t removals =
        std::max(implementation_->removals, other.implementation_->removals) + 1;
    implementation_->removals = removals;
    other.implementation_->removals = removals;
    implementation_->TellName();
    other.implementation_->TellName();
}

void Netlist::AcceptObject(ObjectVisitor& visitor) {
    visitor.VisitNetlist(this);
}

void Netlist::SetName(const char* name) {
    SetNameVerbatim(Port::ViewOf(name));
    implementation_->TellName();
}

void Netlist::SetNameListener(NameListener* listener) noexcept {
    implementation_->nameListener = listener;
}

void Netlist::SetSourceFileName(const char* name) {
    implementation_->sourceFileName = Port::ViewOf(name);
}

Port::StringBase<char> Netlist::GetSourceFileName() const {
    return implementation_->sourceFileName;
}

void Netlist::Add(Signal* signal) {
    implementation_->Take(signal, implementation_->signals);
}

void Netlist::Add(Instance* instance) {
    implementation_->Take(instance, implementation_->instances);
}

void Netlist::Add(Component* component) {
    implementation_->Take(component, implementation_->components);
}

void Netlist::Remove(Signal* signal) {
    DetachSignal(signal).reset();
}

void Netlist::Remove(Instance* instance) {
    DetachInstance(instance).reset();
}

void Netlist::Remove(Component* component) {
    DetachComponent(component).reset();
}

std::unique_ptr<Signal> Netlist::DetachSignal(Signal* signal) noexcept {
    return implementation_->Detach(signal, implementation_->signals);
}

std::unique_ptr<Instance> Netlist::DetachInstance(Instance* instance) noexcept {
    return implementation_->Detach(instance, implementation_->instances);
}

std::unique_ptr<Component> Netlist::DetachComponent(Component* component) noexcept {
    return implementation_->Detach(component, implementation_->components);
}

bool Netlist::Holds(const AttributeHolder& object) const noexcept {
    return OwnerLink::Get<void>(object) == implementation_.get();
}

void Netlist::MakeRoomForNames(std::size_t count) {
    implementation_->byName.MakeRoom(count);
    implementation_->busesByBaseName.MakeRoom(count);
}

void Netlist::Rename(Object& object, ObjectName& name) noexcept {
    switch (object.GetObjectType()) {
    case ObjectTypeSignal:
        implementation_->Rename(static_cast<Signal*>(&object), name);
        break;
    case ObjectTypeInstance:
        implementation_->Rename(static_cast<Instance*>(&object), name);
        break;
    default:
        implementation_->Rename(static_cast<Component*>(&object), name);
        break;
    }
}

void Netlist::RemovePin(Component* component, Pin* pin) noexcept {
    if (component == nullptr || pin == nullptr || !PinBlock::Owns(*component, *pin)) {
        return;
    }
    const std::string_view name = pin->GetNameView();
    for (Instance* instance : GetInstanceIterator()) {
        if (instance->GetComponent() == component) {
            instance->RemovePin(instance->GetPin(name));
        }
    }
    component->RemovePin(pin);
}

Signal* Netlist::GetSignal(std::string_view name) const noexcept {
    return static_cast<Signal*>(implementation_->byName.Find(NameKey(name, SignalGroup)));
}

Instance* Netlist::GetInstance(std::string_view name) const noexcept {
    Instance* const latest = implementation_->latest;
    if (latest != nullptr && ObjectKey::Get(*latest) == name) {
        return latest;
    }
    return static_cast<Instance*>(implementation_->byName.Find(NameKey(name, InstanceGroup)));
}

Component* Netlist::GetComponent(std::string_view name) const noexcept {
    return static_cast<Component*>(implementation_->byName.Find(NameKey(name, ComponentGroup)));
}

bool Netlist::IsNameUsed(std::string_view name) const noexcept {
    return implementation_->byName.Contains(NameKey(name));
}

void ReadAhead::Note(Netlist& netlist, const StringArray& words) noexcept {
    Netlist::Implementation& own = *netlist.implementation_;
    if (Foresight::IsUseful(own.byName)) {
        own.foresight.Note(own.byName, Foresight::HashNames(words));
    }
}

void ReadAhead::Note(Netlist& netlist, const Foresight::Hashes& names) noexcept {
    Netlist::Implementation& own = *netlist.implementation_;
    if (Foresight::IsUseful(own.byName)) {
        own.foresight.Note(own.byName, names);
    }
}

const DummySignals& RememberedDummies::Of(const Netlist& netlist) noexcept {
    return netlist.implementation_->dummies;
}

std::uint64_t Removals::Count(const Netlist& netlist) noexcept {
    return netlist.implementation_->removals;
}

Bus* Netlist::GetParentBus(const char* name) const {
    const Names::NormalizedText normalized(Port::ViewOf(name));
    return implementation_->busesByBaseName.Find(NameKey(Names::BaseName(normalized.GetView())));
}

Iterator<Signal*> Netlist::GetSignalIterator() const noexcept {
    return implementation_->signals.GetIterator();
}

Iterator<Instance*> Netlist::GetInstanceIterator() const noexcept {
    return implementation_->instances.GetIterator();
}

Iterator<Component*> Netlist::GetComponentIterator() const noexcept {
    return implementation_->components.GetIterator();
}

void Netlist::GetInstances(const Component* component, PtrArray<Instance*>& instances) const {
    instances.Empty();
    for (Instance* instance : GetInstanceIterator()) {
        if (component != nullptr && instance->GetComponent() == component) {
            instances.Add(instance);
        }
    }
}

void Netlist::GetInstances(const char* componentName, PtrArray<Instance*>& instances) const {
    GetInstances(GetComponent(componentName), instances);
}

bool NetlistSorting::IsLong(const Netlist& netlist) noexcept {
    constexpr int LeastLength = 8000;
    const Netlist::Implementation& own = *netlist.implementation_;
    return std::min(own.signals.GetLength(), own.instances.GetLength()) >= LeastLength;
}

void NetlistSorting::SortPart(Netlist& netlist, std::size_t part) {
    Netlist::Implementation& own = *netlist.implementation_;
    if (part == 0) {
        own.signals.SortBy([](PtrArray<Signal*>& signals) {
            SortNaturally(signals, [](const Signal* s) { return s->GetPortPolarity().GetValue(); });
        });
        return;
    }
    // As long as the instances are not sorted they follow one another in memory, their pins behind
    // them.
    for (Instance* instance : netlist.GetInstanceIterator()) {
        instance->SortPinName();
    }
    own.components.SortBy([](PtrArray<Component*>& components) {
        SortNaturally(components, [](const Component*) { return 0; });
    });
    own.instances.SortBy([](PtrArray<Instance*>& instances) {
        SortNaturally(instances, [](const Instance*) { return 0; });
    });
}

void Netlist::SortNetlist() {
    for (std::size_t part = 0; part < NetlistSorting::Parts; ++part) {
        NetlistSorting::SortPart(*this, part);
    }
}

void Netlist::ConnectOpenPinToDummy() {
    for (Instance* instance : GetInstanceIterator()) {
        PtrArray<Pin*> open;
        instance->GetOpenPin(open, true);
        for (Pin* pin : Iterator<Pin*>(&open)) {
            if (pin->GetPinType() == PinTypeBusIndex) {
                continue;
            }
            // The range is the rest of the pin's name, exactly as spelled there.
            const std::string_view pinName = pin->GetNameView();
            const bool isBus = pin->GetPinType() == PinTypeBus;
            const std::string_view base = isBus ? Names::BeforeParenthesis(pinName) : pinName;
            std::string name(instance->GetNameView());
            name.append("_")
                .append(base)
                .append(Names::OpenSuffix)
                .append(pinName.substr(base.size()));
            Signal* signal = GetSignal(std::string_view(name));
            if (signal == nullptr) {
                signal = isBus ? static_cast<Signal*>(new Bus(name.c_str()))
                               : new ScalarSignal(name.c_str());
                Add(signal);
            }
            pin->Connect(signal);
        }
    }
}

void Netlist::SetBoxTypeAttribute() {
    for (Component* component : GetComponentIterator()) {
        if (IsPrimitive(*component) && component->GetAttr("BOX_TYPE") == nullptr) {
            std::unique_ptr<Attribute> boxType(AttributeFactory::GetCreators().Get(
                Attribute::DEFAULT_ATTRTYPE)("BOX_TYPE", "BLACK_BOX"));
            boxType->SetSynAttr("ASSIGN");
            component->AddAttr(boxType.release());
        }
    }
}

void Netlist::CreateVerilogDummySignals() {
    DummySignals& dummies = implementation_->dummies;
    dummies.Refresh(*this);
    StringSet names;
    FeedBack::AddSignals(*this, false, names);
    dummies.Make(*this, names, false);
}

void Netlist::CreateVhdlDummySignals() {
    DummySignals& dummies = implementation_->dummies;
    dummies.Refresh(*this);
    StringSet names;
    for (const bool outputPorts : {true, false}) {
        FeedBack::AddSignals(*this, outputPorts, names);
        dummies.Make(*this, names, outputPorts);
        names.Empty();
    }
    FeedBack::AddWiredOrOutputs(*this, names);
    dummies.Make(*this, names, true);
}

const Signal* Netlist::GetDummySignal(const Signal* signal) const noexcept {
    return implementation_->dummies.Find(signal);
}

namespace {

/// \param to has no comment yet.
void CopyComment(const Object& from, Object& to) {
    std::string_view comment = from.GetCommentView();
    if (!comment.empty()) {
        // AddComment appends the last line feed again.
        comment.remove_suffix(1);
        to.AddComment(std::string(comment).c_str());
    }
}

} // namespace

void Netlist::ReplaceBus(Bus* narrower, std::unique_ptr<Bus> wider,
                         std::unique_ptr<BusSlice> slice) {
    wider->SetPortPolarity(narrower->GetPortPolarity());
    static_cast<AttributeHolder&>(*wider) = *narrower;
    CopyComment(*narrower, *wider);
    slice->CloneConnection(narrower);
    if (!narrower->GetConstantValue().GetValue().IsEmpty()) {
        slice->AssignConstantValue(narrower->GetConstantValue());
    }
    PinLinks::MoveUnlisted(*narrower, *slice);
    References::ReplaceEverywhere(*narrower, *slice);
    BusParts::TakeOver(*wider, *narrower);
    Remove(narrower);
    Add(wider.release());
    Add(slice.release());
}

int Netlist::GetLongestPinName(const Iterator<Pin*>& pins) {
    std::size_t longest = 0;
    for (const Pin* pin : pins) {
        if (pin != nullptr) {
            longest = std::max(longest, pin->GetNameView().size());
        }
    }
    return ToLength(longest);
}

int Netlist::GetLongestPortName(const Iterator<Signal*>& signals) {
    std::size_t longest = 0;
    for (const Signal* signal : signals) {
        if (signal != nullptr && signal->IsPort()) {
            longest = std::max(longest, signal->GetNameView().size());
        }
    }
    return ToLength(longest);
}

int Netlist::GetLongestSignalName(const Iterator<Signal*>& signals) {
    std::size_t longest = 0;
    for (const Signal* signal : signals) {
        if (signal != nullptr && signal->IsNeededToDeclared()) {
            longest = std::max(longest, signal->GetNameView().size());
        }
    }
    return ToLength(longest);
}

int Netlist::GetLongestAttrName(const AttributeHolder* holder) {
    std::size_t longest = 0;
    if (holder != nullptr) {
        for (const Attribute* attribute : holder->GetAttrIterator()) {
            longest = std::max(longest, attribute->GetNameView().size());
        }
    }
    return ToLength(longest);
}

int Netlist::GetLongestAttrName(const Netlist* netlist) {
    if (netlist == nullptr) {
        return 0;
    }
    int longest = GetLongestAttrName(static_cast<const AttributeHolder*>(netlist));
    const auto consider = [&longest](const AttributeHolder* holder) {
        longest = std::max(longest, GetLongestAttrName(holder));
    };
    for (const Signal* signal : netlist->GetSignalIterator()) {
        consider(signal);
    }
    for (const Component* component : netlist->GetComponentIterator()) {
        consider(component);
    }
    for (const Instance* instance : netlist->GetInstanceIterator()) {
        consider(instance);
    }
    return longest;
}

} // namespace Orn_Hdl
