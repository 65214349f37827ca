#include "HdlModel/Netlist/Renaming.h"

#include "HdlModel/Names/Names.h"
#include "HdlModel/Objects/ObjectKey.h"
#include "HdlModel/Signals/References.h"
#include "HdlModel/Signals/SignalCast.h"
#include "Port/Ascii.h"

#include <algorithm>
#include <utility>

namespace Orn_Hdl {

namespace {

std::string UpperCase(std::string_view name) {
    std::string result(name);
    std::transform(result.begin(), result.end(), result.begin(), Port::ToUpper);
    return result;
}

} // namespace

void Renaming::Add(Object& object, bool isHeld, std::string_view name) {
    Entry entry{&object, isHeld, std::string(Names::NormalizedText(name).GetView()), ObjectName()};
    entry.stored.Assign(entry.name);
    byOldName_.emplace(UpperCase(object.GetNameView()), entries_.size());
    objects_.insert(&object);
    entries_.push_back(std::move(entry));
}

void Renaming::AddWithParts(Signal& signal, std::string_view name) {
    Add(signal, name);
    if (const Bus* const bus = As<Bus>(&signal)) {
        const std::string base(Names::BeforeParenthesis(entries_.back().name));
        for (Signal* part : bus->GetBusSliceIterator()) {
            if (As<BusPart>(part) != nullptr) {
                const std::string_view partName = part->GetNameView();
                Add(*part, std::string(base).append(
                               partName.substr(Names::BeforeParenthesis(partName).size())));
            }
        }
    }
    // By index, because a renamed compound, which is appended, may itself be a member.
    for (std::size_t i = 0; i < entries_.size(); ++i) {
        AddCompounds(static_cast<const Signal&>(*entries_[i].object));
    }
}

void Renaming::AddCompounds(const Signal& signal) {
    for (Signal* referrer : References::GetReferrers(signal)) {
        if (As<CompoundBus>(referrer) != nullptr && objects_.count(referrer) == 0) {
            Add(*referrer, NewCompoundName(referrer->GetNameView()));
        }
    }
}

/// The name of a compound with the new names of what it names in the places of the old ones.
std::string Renaming::NewCompoundName(std::string_view name) const {
    std::string result;
    std::size_t copied = 0;
    std::string_view piece;
    for (Names::CompoundPieces pieces(name); pieces.Next(piece);) {
        const auto found = byOldName_.find(UpperCase(piece));
        if (found != byOldName_.end()) {
            const auto place = static_cast<std::size_t>(piece.data() - name.data());
            result.append(name.substr(copied, place - copied)).append(entries_[found->second].name);
            copied = place + piece.size();
        }
    }
    return result.append(name.substr(copied));
}

const std::string* Renaming::FindTaken() const {
    for (const Entry& entry : entries_) {
        if (!Names::IsNamed(ObjectKey::Get(*entry.object), entry.name) &&
            netlist_.IsNameUsed(entry.name)) {
            return &entry.name;
        }
    }
    return nullptr;
}

void Renaming::Apply() {
    // All allocation comes first: an exchange that fails could not be undone, since an object that
    // was hidden by another one of its name would be found afterwards.
    netlist_.MakeRoomForNames(entries_.size());
    for (Entry& entry : entries_) {
        if (entry.isHeld) {
            netlist_.Rename(*entry.object, entry.stored);
        } else {
            ObjectKey::Replace(*entry.object, entry.stored);
        }
    }
}

} // namespace Orn_Hdl
