#include "Orn_Hdl/Model/Signals/CompoundBus.h"

#include "HdlModel/Names/Names.h"
#include "HdlModel/Signals/CompoundLimits.h"
#include "HdlModel/Signals/References.h"
#include "HdlModel/Signals/SignalBits.h"
#include "HdlModel/Signals/SignalCast.h"
#include "Port/Ascii.h"

#include <algorithm>
#include <climits>
#include <cstdint>

namespace Orn_Hdl {

// The members are added to a compound that is whole: if allocation fails, it is destroyed as any
// other, and leaves those that it has.
CompoundBus::CompoundBus(const Port::TextArgument& name, const PtrArray<Signal*>& members)
    : CompoundBus(name) {
    for (int i = 0; i < members.GetSize(); ++i) {
        AddBusMember(members.GetAt(i));
    }
}

CompoundBus::~CompoundBus() {
    CompoundBus::LeaveAll();
}

void CompoundBus::LeaveAll() noexcept {
    for (Signal* member : GetBusMemberIterator()) {
        References::Drop(*member, *this);
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
    return static_cast<int>(std::min<std::int64_t>(width, INT_MAX));
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

/// Takes a member that is listed already out again, by `takeOut`, when it exceeds a limit or that
/// cannot be told. \return whether it stays.
template <class TakeOut>
bool CompoundBus::KeepWithinLimits(Signal& member, const TakeOut& takeOut) {
    const auto undo = [&] {
        takeOut();
        References::Drop(member, *this);
    };
    bool stays = As<CompoundBus>(&member) == nullptr;
    try {
        stays = stays || !CompoundLimits::AreExceededBy(*this);
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
    if (member == nullptr || CompoundLimits::Contains(*member, *this)) {
        return;
    }
    References::Add(*this, members_, *member);
    KeepWithinLimits(*member, [this] { members_.RemoveTail(); });
}

void CompoundBus::SetAt(int index, Signal* member) {
    if (member == nullptr || index < 0 || index >= members_.GetSize() ||
        CompoundLimits::Contains(*member, *this)) {
        return;
    }
    Signal* const former = members_.GetAt(index);
    References::Note(*member, *this);
    members_.SetAt(index, member);
    if (KeepWithinLimits(*member, [&] { members_.SetAt(index, former); })) {
        References::Drop(*former, *this);
    }
}

void CompoundBus::Forget(Signal* signal) noexcept {
    Signal::Forget(signal);
    int kept = 0;
    for (Signal* member : GetBusMemberIterator()) {
        if (member != signal) {
            members_.SetAt(kept, member);
            ++kept;
        }
    }
    while (members_.GetSize() > kept) {
        members_.RemoveTail();
    }
}

void CompoundBus::ReplaceReference(Signal* from, Signal* to) {
    Signal::ReplaceReference(from, to);
    // From the end: that is where the notes of the members are looked for first.
    for (int i = members_.GetSize() - 1; i >= 0; --i) {
        if (members_.GetAt(i) == from) {
            SetAt(i, to);
        }
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
            SignalBits::AppendTo(names, bus);
        } else {
            names.Add(piece);
        }
    }
    return true;
}

} // namespace Orn_Hdl
