#include "Orn_Hdl/Model/Signals.h"

#include "Containers/PlaceOf.h"
#include "HdlModel/Names/Names.h"
#include "HdlModel/Netlist/DummySignals.h"
#include "HdlModel/Objects/ObjectDetails.h"
#include "HdlModel/Objects/ObjectKey.h"
#include "HdlModel/Signals/SignalBits.h"
#include "HdlModel/Signals/SignalLinks.h"
#include "Port/Ascii.h"
#include "Port/Pool.h"

#include <algorithm>
#include <memory>
#include <unordered_set>

namespace Orn_Hdl {

namespace {

/// The last occurrence is looked for first: what ends was mostly added last.
template <class T> void EraseOne(std::vector<T*>& list, const T* element) noexcept {
    const auto found = std::find(list.rbegin(), list.rend(), element);
    if (found != list.rend()) {
        *found = list.back();
        list.pop_back();
    }
}

} // namespace

Signal::Signal(const char* name) : Object(ObjectTypeSignal) {
    Object::SetName(name);
}

Signal::~Signal() {
    Signal::LeaveAll();
}

void Signal::LeaveAll() noexcept {
    OpenPins();
    for (Pin* pin : Iterator<Pin*>(&pins_)) {
        pin->NoteUnlisted(this);
    }
    pins_.Empty();
    if (links_ == nullptr) {
        return;
    }
    if (links_->keeper != nullptr) {
        links_->keeper->Forget(this);
    }
    for (Signal* alias : Iterator<Signal*>(&links_->signals)) {
        if (!EndTogether(*this, *alias)) {
            alias->DropReferrer(this);
        }
    }
    for (Signal* referrer : links_->referrers) {
        if (!EndTogether(*this, *referrer)) {
            referrer->Forget(this);
        }
    }
    links_.reset();
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
    if (links_ != nullptr) {
        links_->signals.Remove(signal);
    }
}

void Signal::NoteReferrer(Signal* by) {
    MakeLinks().referrers.push_back(by);
}

void Signal::DropReferrer(const Signal* by) noexcept {
    if (links_ != nullptr) {
        EraseOne(links_->referrers, by);
    }
}

void Signal::AddReference(PtrArray<Signal*>& list, Signal* signal) {
    signal->NoteReferrer(this);
    try {
        list.Add(signal);
    } catch (...) {
        signal->DropReferrer(this);
        throw;
    }
}

void Signal::AddUnlistedPin(Pin* pin) {
    MakeLinks().unlistedPins.push_back(pin);
}

void Signal::RemoveUnlistedPin(const Pin* pin) noexcept {
    if (links_ != nullptr) {
        EraseOne(links_->unlistedPins, pin);
    }
}

void Signal::Unlist(Pin* pin) noexcept {
    pins_.RemoveAt(PlaceOf<Pin>(pins_, pin));
}

void Signal::Connect(Pin* pin) {
    if (pin == nullptr) {
        return;
    }
    if (pin->IsListedBy(this)) {
        pin->Connect(this);
    } else if (pin->signal_ == this) {
        pins_.Add(pin);
        RemoveUnlistedPin(pin);
        pin->SetFlag(Pin::ListedFlag, true);
    } else {
        pin->PrepareToLeave();
        pins_.Add(pin);
        pin->PointAt(this, true);
    }
}

void Signal::Connect(Signal* other) {
    if (other == nullptr || other == this) {
        return;
    }
    Links& links = MakeLinks();
    // Whichever side has fewer links tells whether the two are linked already.
    const std::vector<Signal*>& referrers = other->MakeLinks().referrers;
    const bool lookHere = static_cast<std::size_t>(links.signals.GetSize()) <= referrers.size();
    const bool isListed =
        lookHere ? links.signals.Contains(other)
                 : std::find(referrers.begin(), referrers.end(), this) != referrers.end() &&
                       links.signals.Contains(other);
    if (!isListed) {
        AddReference(links.signals, other);
    }
}

void Signal::Disconnect(Pin* pin) {
    if (pin == nullptr) {
        return;
    }
    if (pin->IsListedBy(this)) {
        Unlist(pin);
        if (pin->signal_ == this) {
            pin->SetFlag(Pin::ListedFlag, false);
            pin->signal_ = nullptr;
        } else {
            pin->NoteUnlisted(this);
        }
    } else if (pin->signal_ == this) {
        pin->Disconnect();
    }
}

void Signal::Disconnect(Signal* other) {
    if (other != nullptr && links_ != nullptr && links_->signals.Remove(other)) {
        other->DropReferrer(this);
    }
}

void Signal::OpenPins() noexcept {
    for (Pin* pin : Iterator<Pin*>(&pins_)) {
        if (pin->signal_ == this) {
            pin->SetFlag(Pin::ListedFlag, false);
            pin->signal_ = nullptr;
        }
    }
    if (links_ != nullptr) {
        for (Pin* pin : links_->unlistedPins) {
            pin->signal_ = nullptr;
        }
        links_->unlistedPins.clear();
    }
}

void Signal::DisconnectAll() {
    OpenPins();
    for (Pin* pin : Iterator<Pin*>(&pins_)) {
        pin->NoteUnlisted(this);
    }
    pins_.Empty();
    if (links_ != nullptr) {
        for (Signal* alias : Iterator<Signal*>(&links_->signals)) {
            alias->DropReferrer(this);
        }
        links_->signals.Empty();
    }
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
    return Iterator<Signal*>(links_ == nullptr ? nullptr : &links_->signals);
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

void Signal::TakeCommentOf(const Signal& other) {
    if (!other.GetCommentView().empty()) {
        MakeDetails().comment = other.GetCommentView();
    }
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

bool Signal::HasPinOf(int polarity) const noexcept {
    const auto matches = [this, polarity](const Pin* pin) {
        const int value = pin->GetPolarity().GetValue();
        return pin->GetSignal() == this && (value == polarity || value == Polarity::BiDirectional);
    };
    for (const Pin* pin : GetPinIterator()) {
        if (matches(pin)) {
            return true;
        }
    }
    return links_ != nullptr &&
           std::any_of(links_->unlistedPins.begin(), links_->unlistedPins.end(), matches);
}

bool Signal::HasLooseCompound() const noexcept {
    const auto isLooseCompound = [](const Signal* referrer) {
        return referrer->GetSignalType() == SignalTypeCompoundBus && !OwnedFlag::Get(*referrer);
    };
    return links_ != nullptr &&
           std::any_of(links_->referrers.begin(), links_->referrers.end(), isLooseCompound);
}

void Signal::ReplaceReference(Signal* from, Signal* to) {
    const int index = links_ == nullptr ? -1 : links_->signals.GetIndex(from);
    if (index < 0) {
        return;
    }
    Links& links = *links_;
    if (to == this || links.signals.Contains(to)) {
        links.signals.RemoveAt(index);
    } else {
        to->NoteReferrer(this);
        links.signals.SetAt(index, to);
    }
    from->DropReferrer(this);
}

void Signal::ReplaceEverywhereBy(Signal* other) {
    if (links_ == nullptr) {
        return;
    }
    const std::vector<Pin*> pins = links_->unlistedPins;
    for (Pin* pin : pins) {
        pin->Connect(other);
    }
    // The last first: that is where this signal, which forgets each of them, looks first.
    const std::vector<Signal*> referrers = links_->referrers;
    for (auto referrer = referrers.rbegin(); referrer != referrers.rend(); ++referrer) {
        (*referrer)->ReplaceReference(this, other);
    }
}

void ScalarSignal::AcceptSignal(SignalVisitor& visitor) {
    visitor.VisitScalarSignal(this);
    visitor.VisitSignal(this);
}

namespace {

using Names::DummySuffix;

bool EndsInDummySuffix(std::string_view name) noexcept {
    return name.size() >= DummySuffix.size() &&
           Port::EqualIgnoringCase(name.substr(name.size() - DummySuffix.size()), DummySuffix);
}

/// A base name with the suffix behind it.
std::string DummyBase(std::string_view base) {
    return std::string(base).append(DummySuffix);
}

/// The dummy name of a name with a range or index: the suffix goes before it.
std::string DummyOfPart(std::string_view name) {
    const std::string_view base = Names::BeforeParenthesis(name);
    return DummyBase(base).append(name.substr(base.size()));
}

} // namespace

Port::StringBase<char> ScalarSignal::GetDummySignalName() const {
    return EndsInDummySuffix(GetNameView()) ? std::string(GetNameView()) : DummyBase(GetNameView());
}

void ScalarSignal::GetBaseName(StringSet& names) const {
    names.Add(GetNameView());
}

ScalarSignal* ScalarSignal::CreateDummySignal() const {
    return new ScalarSignal(GetDummySignalName().CStr());
}

/// The slices and bits of a bus. They know these parts, not the bus: when a wider bus takes its
/// place, they all get their new parent at once.
struct Bus::Parts {
    Bus* bus;
    PtrArray<Signal*> slices;
    /// How many of them are signals of other classes, which know no parent.
    int strangers = 0;

    explicit Parts(Bus* owner) noexcept : bus(owner) {}
    static void* operator new(std::size_t size) {
        return Port::Pool::Allocate(size, Port::Pool::DesignObjects);
    }
    static void operator delete(void* memory) noexcept { Port::Pool::Free(memory); }
};

Bus::Bus(const char* name) : Signal(name), parts_(std::make_unique<Parts>(this)) {}

Iterator<Signal*> Bus::GetBusSliceIterator() const noexcept {
    return Iterator<Signal*>(&parts_->slices);
}

Bus::Parts** Bus::PartsLink(Signal* signal) noexcept {
    switch (signal->GetSignalType()) {
    case SignalTypeBusSlice:
        return &static_cast<BusSlice*>(signal)->parts_;
    case SignalTypeBusIndex:
        return &static_cast<BusIndex*>(signal)->parts_;
    default:
        return nullptr;
    }
}

Bus::~Bus() {
    Bus::LeaveAll();
}

void Bus::LeaveAll() noexcept {
    PtrArray<Signal*>& slices = parts_->slices;
    for (int i = slices.GetSize(); i > 0; --i) {
        Signal* const slice = slices.GetAt(i - 1);
        if (Parts** parts = PartsLink(slice)) {
            *parts = nullptr;
        } else if (!EndTogether(*this, *slice)) {
            slice->DropReferrer(this);
        }
    }
    slices.Empty();
    parts_->strangers = 0;
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
    return EndsInDummySuffix(Names::BeforeParenthesis(GetNameView())) ? std::string(GetNameView())
                                                                      : DummyOfPart(GetNameView());
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
    if (slice == nullptr) {
        return;
    }
    PtrArray<Signal*>& slices = parts_->slices;
    Parts** const link = PartsLink(slice);
    // A slice or bit knows its parent, so the list need not be searched; anything else that is put
    // here may be listed already.
    if (link != nullptr ? *link == parts_.get() : slices.Contains(slice)) {
        return;
    }
    if (link == nullptr) {
        AddReference(slices, slice);
        ++parts_->strangers;
        return;
    }
    slices.Add(slice);
    if (*link != nullptr) {
        (*link)->bus->RemoveBusSlice(slice);
    }
    *link = parts_.get();
}

void Bus::TakeParts(Bus& other) {
    // The other's list changes hands as it is, however long it is; what this one has goes before
    // it. What can fail for want of memory comes first.
    auto own = std::make_unique<Parts>(this);
    PtrArray<Signal*>& slices = other.parts_->slices;
    int inserted = 0;
    try {
        for (; inserted < parts_->slices.GetSize(); ++inserted) {
            slices.InsertAt(inserted, parts_->slices.GetAt(inserted));
        }
    } catch (...) {
        for (; inserted > 0; --inserted) {
            slices.RemoveAt(0);
        }
        throw;
    }
    own.swap(parts_);
    parts_.swap(other.parts_);
    parts_->bus = this;
    other.parts_->bus = &other;
    for (Signal* slice : Iterator<Signal*>(&own->slices)) {
        if (Parts** link = PartsLink(slice)) {
            *link = parts_.get();
        }
    }
    for (int i = inserted; parts_->strangers > 0 && i < slices.GetSize(); ++i) {
        if (PartsLink(slices.GetAt(i)) == nullptr) {
            slices.GetAt(i)->NoteReferrer(this);
            slices.GetAt(i)->DropReferrer(&other);
        }
    }
    parts_->strangers += own->strangers;
}

void Bus::RemoveBusSlice(Signal* slice) {
    PtrArray<Signal*>& slices = parts_->slices;
    const int place = PlaceOf<Signal>(slices, slice);
    if (place < 0) {
        return;
    }
    slices.RemoveAt(place);
    if (Parts** link = PartsLink(slice)) {
        *link = nullptr;
    } else {
        --parts_->strangers;
        slice->DropReferrer(this);
    }
}

void Bus::EmptyBusSlice() {
    while (!parts_->slices.IsEmpty()) {
        RemoveBusSlice(parts_->slices.GetTail());
    }
}

void Bus::Forget(Signal* signal) noexcept {
    Signal::Forget(signal);
    // Only a stranger tells the bus of its end in this way.
    parts_->strangers -= parts_->slices.Remove(signal) ? 1 : 0;
}

void Bus::ReplaceReference(Signal* from, Signal* to) {
    Signal::ReplaceReference(from, to);
    if (parts_->slices.Contains(from)) {
        RemoveBusSlice(from);
        AddBusSlice(to);
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

namespace {

void AddBits(const Names::BusName& bus, StringArray& bits) {
    SignalBits::ForEach(bus, bus.GetBits(), [&bits](std::string_view bit) { bits.Add(bit); });
}

} // namespace

bool Bus::ParseBusName(const char* name, StringArray& bits) {
    Names::BusName parsed;
    if (!Names::ParseBus(Port::ViewOf(name), parsed) || !parsed.IsExpandable()) {
        return false;
    }
    AddBits(parsed, bits);
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

BusSlice::BusSlice(const char* name, Bus* parent) : Signal(name) {
    if (parent != nullptr) {
        parent->AddBusSlice(this);
    }
}

BusSlice::~BusSlice() {
    BusSlice::LeaveAll();
}

Bus* BusSlice::GetParentBus() const noexcept {
    return parts_ == nullptr ? nullptr : parts_->bus;
}

void BusSlice::LeaveAll() noexcept {
    if (parts_ != nullptr && !EndTogether(*this, *parts_->bus)) {
        parts_->bus->RemoveBusSlice(this);
    }
    parts_ = nullptr;
    Signal::LeaveAll();
}

void BusSlice::SetPortPolarity(const Polarity& /*polarity*/) {}

void BusSlice::AcceptSignal(SignalVisitor& visitor) {
    visitor.VisitBusSlice(this);
    visitor.VisitSignal(this);
}

Polarity BusSlice::GetPortPolarity() const {
    return parts_ == nullptr ? Polarity() : parts_->bus->GetPortPolarity();
}

int BusSlice::GetWidth() const {
    return Names::GetWidth(GetNameView());
}

Port::StringBase<char> BusSlice::GetDummySignalName() const {
    return DummyOfPart(GetNameView());
}

void BusSlice::GetBaseName(StringSet& names) const {
    names.Add(Names::BeforeParenthesis(GetNameView()));
}

BusSlice* BusSlice::CreateDummySignal(Bus* parent) const {
    return new BusSlice(GetDummySignalName().CStr(), parent);
}

Port::StringBase<char> BusSlice::GetBaseName() const {
    return Names::BeforeParenthesis(GetNameView());
}

bool BusSlice::GetIndex(Port::StringBase<char>& left, Port::StringBase<char>& right) const {
    return Names::GetIndexTexts(GetNameView(), left, right);
}

bool BusSlice::IsDownTo() const noexcept {
    return Names::IsDownTo(GetNameView());
}

bool BusSlice::IsSameDirectionAsParent() const noexcept {
    if (parts_ == nullptr) {
        return true;
    }
    Names::BusName parsed;
    const bool isOneBit = Names::ParseBus(GetNameView(), parsed) && parsed.IsOneBit();
    return !isOneBit && IsDownTo() == parts_->bus->IsDownTo();
}

BusIndex::BusIndex(const char* name, Bus* parent) : Signal(name) {
    if (parent != nullptr) {
        parent->AddBusSlice(this);
    }
}

BusIndex::~BusIndex() {
    BusIndex::LeaveAll();
}

Bus* BusIndex::GetParentBus() const noexcept {
    return parts_ == nullptr ? nullptr : parts_->bus;
}

void BusIndex::LeaveAll() noexcept {
    if (parts_ != nullptr && !EndTogether(*this, *parts_->bus)) {
        parts_->bus->RemoveBusSlice(this);
    }
    parts_ = nullptr;
    Signal::LeaveAll();
}

void BusIndex::AcceptSignal(SignalVisitor& visitor) {
    visitor.VisitBusIndex(this);
    visitor.VisitSignal(this);
}

Polarity BusIndex::GetPortPolarity() const {
    return parts_ == nullptr ? Polarity(GetDirection()) : parts_->bus->GetPortPolarity();
}

Port::StringBase<char> BusIndex::GetDummySignalName() const {
    return DummyOfPart(GetNameView());
}

void BusIndex::GetBaseName(StringSet& names) const {
    names.Add(Names::BeforeParenthesis(GetNameView()));
}

BusIndex* BusIndex::CreateDummySignal(Bus* parent) const {
    return new BusIndex(GetDummySignalName().CStr(), parent);
}

Port::StringBase<char> BusIndex::GetBaseName() const {
    return Names::BeforeParenthesis(GetNameView());
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

// The members are added to a compound that is whole: when one of them finds no memory, it ends as
// any other does, and leaves those that it has.
CompoundBus::CompoundBus(const char* name, const PtrArray<Signal*>& members) : CompoundBus(name) {
    for (int i = 0; i < members.GetSize(); ++i) {
        AddBusMember(members.GetAt(i));
    }
}

CompoundBus::~CompoundBus() {
    CompoundBus::LeaveAll();
}

void CompoundBus::LeaveAll() noexcept {
    for (Signal* member : GetBusMemberIterator()) {
        if (!EndTogether(*this, *member)) {
            member->DropReferrer(this);
        }
    }
    members_.Empty();
    Signal::LeaveAll();
}

void CompoundBus::SetPortPolarity(const Polarity& polarity) {
    for (Signal* member : GetBusMemberIterator()) {
        member->SetPortPolarity(polarity);
    }
}

void CompoundBus::AcceptSignal(SignalVisitor& visitor) {
    visitor.VisitCompoundBus(this);
    visitor.VisitSignal(this);
}

Polarity CompoundBus::GetPortPolarity() const {
    if (members_.IsEmpty()) {
        return Polarity();
    }
    const Polarity first = members_.GetAt(0)->GetPortPolarity();
    for (int i = 1; i < members_.GetSize(); ++i) {
        if (members_.GetAt(i)->GetPortPolarity() != first) {
            return Polarity();
        }
    }
    return first;
}

int CompoundBus::GetWidth() const {
    std::int64_t width = 0;
    for (const Signal* member : GetBusMemberIterator()) {
        width += member->GetWidth();
    }
    return static_cast<int>(std::min<std::int64_t>(width, INT32_MAX));
}

Port::StringBase<char> CompoundBus::GetDummySignalName() const {
    Port::StringBase<char> name;
    for (const Signal* member : GetBusMemberIterator()) {
        if (!name.IsEmpty()) {
            name += ',';
        }
        name += member->GetDummySignalName();
    }
    return name;
}

void CompoundBus::GetBaseName(StringSet& names) const {
    for (const Signal* member : GetBusMemberIterator()) {
        member->GetBaseName(names);
    }
    names.Add(GetNameView());
}

CompoundBus* CompoundBus::CreateDummySignal() const {
    return new CompoundBus(GetDummySignalName().CStr());
}

/// Whether this compound is `from` or is reached through the members of `from`.
bool CompoundBus::Reaches(const Signal* from) const {
    if (from == this) {
        return true;
    }
    if (from->GetSignalType() != SignalTypeCompoundBus || links_ == nullptr ||
        links_->referrers.empty()) {
        return false;
    }
    std::vector<const CompoundBus*> rest{static_cast<const CompoundBus*>(from)};
    std::unordered_set<const Signal*> met;
    while (!rest.empty()) {
        const CompoundBus& next = *rest.back();
        rest.pop_back();
        for (const Signal* member : next.GetBusMemberIterator()) {
            if (member == this) {
                return true;
            }
            if (member->GetSignalType() == SignalTypeCompoundBus && met.insert(member).second) {
                rest.push_back(static_cast<const CompoundBus*>(member));
            }
        }
    }
    return false;
}

/// Whether the compounds that this one contains are few and not nested too deep.
bool CompoundBus::IsWithinLimits() const {
    struct Place {
        const CompoundBus* compound;
        int level;
    };
    int count = 0;
    std::vector<Place> rest{{this, 1}};
    while (!rest.empty()) {
        const Place place = rest.back();
        rest.pop_back();
        for (const Signal* member : place.compound->GetBusMemberIterator()) {
            if (member->GetSignalType() != SignalTypeCompoundBus) {
                continue;
            }
            if (++count > MostCompounds || place.level == MostLevels) {
                return false;
            }
            rest.push_back({static_cast<const CompoundBus*>(member), place.level + 1});
        }
    }
    return true;
}

/// Appends the compounds that have this one as a member.
void CompoundBus::GetHolders(std::vector<const CompoundBus*>& holders) const {
    if (links_ == nullptr) {
        return;
    }
    for (const Signal* referrer : links_->referrers) {
        if (referrer->GetSignalType() == SignalTypeCompoundBus &&
            static_cast<const CompoundBus*>(referrer)->members_.Contains(
                const_cast<CompoundBus*>(this))) {
            holders.push_back(static_cast<const CompoundBus*>(referrer));
        }
    }
}

/// Whether a compound among the members takes an outermost compound beyond its limits. Only there
/// need it be asked: what an outermost one contains has less in it.
bool CompoundBus::LeavesLimits() const {
    std::vector<const CompoundBus*> rest{this};
    std::unordered_set<const CompoundBus*> met;
    while (!rest.empty()) {
        const CompoundBus* const next = rest.back();
        rest.pop_back();
        if (!met.insert(next).second) {
            continue;
        }
        const std::size_t before = rest.size();
        next->GetHolders(rest);
        if (rest.size() == before && !next->IsWithinLimits()) {
            return true;
        }
    }
    return false;
}

/// Takes a member that is listed already out again, by `takeOut`, when it exceeds a limit or that
/// cannot be told. \return whether it stays.
template <class TakeOut>
bool CompoundBus::KeepWithinLimits(Signal& member, const TakeOut& takeOut) {
    const auto undo = [&] {
        takeOut();
        member.DropReferrer(this);
    };
    bool stays = member.GetSignalType() != SignalTypeCompoundBus;
    try {
        stays = stays || !LeavesLimits();
    } catch (...) {
        undo();
        throw;
    }
    if (!stays) {
        undo();
    }
    return stays;
}

void CompoundBus::AddBusMember(Signal* member) {
    if (member == nullptr || Reaches(member)) {
        return;
    }
    AddReference(members_, member);
    KeepWithinLimits(*member, [this] { members_.RemoveAt(members_.GetSize() - 1); });
}

void CompoundBus::SetAt(int index, Signal* member) {
    if (member == nullptr || index < 0 || index >= members_.GetSize() || Reaches(member)) {
        return;
    }
    Signal* const former = members_.GetAt(index);
    member->NoteReferrer(this);
    members_.SetAt(index, member);
    if (KeepWithinLimits(*member, [&] { members_.SetAt(index, former); })) {
        former->DropReferrer(this);
    }
}

void CompoundBus::Forget(Signal* signal) noexcept {
    Signal::Forget(signal);
    members_.Remove(signal);
}

void CompoundBus::ReplaceReference(Signal* from, Signal* to) {
    Signal::ReplaceReference(from, to);
    const int index = members_.GetIndex(from);
    if (index >= 0) {
        SetAt(index, to);
    }
}

bool CompoundBus::IsCompoundBusName(const char* name) noexcept {
    return Names::IsCompound(Port::ViewOf(name));
}

bool CompoundBus::ParseCompoundBusName(const char* name, StringArray& names, bool expand) {
    const std::string_view text = Port::ViewOf(name);
    std::string_view piece;
    Names::BusName bus;
    for (Names::CompoundPieces pieces(text); expand && pieces.Next(piece);) {
        if (Names::ParseBus(piece, bus) && !bus.IsExpandable()) {
            return false;
        }
    }
    for (Names::CompoundPieces pieces(text); pieces.Next(piece);) {
        if (expand && Names::ParseBus(piece, bus)) {
            AddBits(bus, names);
        } else {
            names.Add(piece);
        }
    }
    return true;
}

SignalVisitor::~SignalVisitor() = default;
void SignalVisitor::VisitSignal(Signal* /*signal*/) {}
void SignalVisitor::VisitScalarSignal(ScalarSignal* /*signal*/) {}
void SignalVisitor::VisitBus(Bus* /*bus*/) {}
void SignalVisitor::VisitBusSlice(BusSlice* /*slice*/) {}
void SignalVisitor::VisitBusIndex(BusIndex* /*bit*/) {}
void SignalVisitor::VisitCompoundBus(CompoundBus* /*compound*/) {}

} // namespace Orn_Hdl
