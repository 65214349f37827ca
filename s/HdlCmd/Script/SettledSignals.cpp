#include "HdlCmd/Script/SettledSignals.h"

#include "HdlCmd/Script/Values.h"
#include "HdlModel/Names/Names.h"
#include "HdlModel/Netlist/RememberedDummies.h"
#include "HdlModel/Objects/ObjectDetails.h"
#include "HdlModel/Signals/References.h"
#include "HdlModel/Signals/SignalCast.h"

#include <algorithm>

namespace Orn_Hdl::Script {

namespace {

bool Contains(const std::vector<const Signal*>& signals, const Signal* signal) {
    return std::find(signals.begin(), signals.end(), signal) != signals.end();
}

/// Whether the pieces of a compound's name are the given names.
bool NamesMembers(std::string_view name, const std::vector<std::string>& members) {
    std::size_t count = 0;
    std::string_view piece;
    for (Names::CompoundPieces pieces(name); pieces.Next(piece); ++count) {
        if (count == members.size() || !Names::IsNamed(piece, members[count])) {
            return false;
        }
    }
    return count == members.size() && Names::IsCompound(name);
}

std::string Join(const std::vector<std::string>& names, std::string_view separator) {
    std::string joined;
    for (const std::string& name : names) {
        joined.append(joined.empty() ? std::string_view() : separator).append(name);
    }
    return joined;
}

} // namespace

SettledSignals::SettledSignals(const Netlist& netlist)
    : netlist_(netlist), dummies_(RememberedDummies::Of(netlist)) {
    for (const Signal* signal : netlist.GetSignalIterator()) {
        const auto* const compound = As<CompoundBus>(signal);
        if (compound != nullptr && !IsEmptied(*compound)) {
            NameCompound(*compound);
        }
    }
}

/// Only members whose names are plain can be named.
void SettledSignals::NameCompound(const CompoundBus& compound) {
    const std::vector<std::string> members = GetMemberNames(compound);
    if (NamesMembers(compound.GetNameView(), members)) {
        return;
    }
    // Several compounds may have these members. Separators that follow each other count as one.
    std::string separator = ",";
    std::string name = Join(members, separator);
    if (!NamesMembers(name, members)) {
        compoundNames_[&compound] = "";
        return;
    }
    while ((netlist_.IsNameUsed(name) && netlist_.GetSignal(name) != &compound) ||
           givenNames_.count(Folded(name)) != 0) {
        name = Join(members, separator += ',');
    }
    givenNames_.insert(Folded(name));
    compoundNames_[&compound] = name;
}

std::vector<std::string> SettledSignals::GetMemberNames(const CompoundBus& compound) const {
    std::vector<std::string> names;
    for (const Signal* member : compound.GetBusMemberIterator()) {
        names.push_back(GetName(GetSuccessor(*member)));
    }
    return names;
}

const DummySignals::Entry* SettledSignals::FindSuccession(const Signal& signal) const {
    if (dummies_.IsEmpty()) {
        return nullptr;
    }
    const Entry* const entry = dummies_.FindByOriginal(&signal);
    return entry != nullptr ? entry : dummies_.FindPending(netlist_, signal);
}

SettledSignal SettledSignals::GetSuccessor(const Signal& signal) const {
    const Entry* const entry = FindSuccession(signal);
    if (entry == nullptr) {
        return {&signal};
    }
    return entry->original == &signal ? SettledSignal{entry->dummy} : SettledSignal{&signal, true};
}

SettledSignal SettledSignals::GetCarrier(const Signal& signal) const {
    // A dummy is younger than its signal, so this ends.
    SettledSignal carrier = GetSuccessor(signal);
    for (const Signal* former = &signal; !carrier.isDummyToCome && carrier.signal != former;) {
        former = carrier.signal;
        carrier = GetSuccessor(*former);
    }
    return carrier;
}

std::string SettledSignals::GetName(const SettledSignal& settled) const {
    if (settled.isDummyToCome) {
        return std::string(settled.signal->GetDummySignalName().GetView());
    }
    const auto found = compoundNames_.find(settled.signal);
    return found == compoundNames_.end() ? std::string(settled.signal->GetNameView())
                                         : found->second;
}

std::vector<const Signal*> SettledSignals::GetOwnAliases(const Signal& signal) const {
    std::vector<const Signal*> aliases;
    for (const Signal* alias : signal.GetSignalIterator()) {
        aliases.push_back(alias);
    }
    if (const Entry* const entry = dummies_.FindByDummy(&signal)) {
        for (const Signal* alias : GetOwnAliases(*entry->original)) {
            if (alias != &signal && !Contains(aliases, alias)) {
                aliases.push_back(alias);
            }
        }
    }
    return aliases;
}

std::vector<const Signal*> SettledSignals::GetAliases(const SettledSignal& settled) const {
    std::vector<const Signal*> aliases = GetOwnAliases(*settled.signal);
    const Entry* const entry =
        settled.isDummyToCome || aliases.empty() ? nullptr : FindSuccession(*settled.signal);
    if (entry != nullptr && entry->forOutputs) {
        const bool keepsDummy =
            entry->original == settled.signal && Contains(aliases, entry->dummy);
        aliases.clear();
        if (keepsDummy) {
            aliases.push_back(entry->dummy);
        }
    }
    return aliases;
}

const BitVectorValue& SettledSignals::GetOwnConstant(const Signal& signal) const {
    const Entry* const entry = dummies_.FindByDummy(&signal);
    if (entry != nullptr && entry->forOutputs) {
        const BitVectorValue& taken = GetOwnConstant(*entry->original);
        if (!taken.GetValue().IsEmpty()) {
            return taken;
        }
    }
    return signal.GetConstantValue();
}

const BitVectorValue& SettledSignals::GetConstant(const SettledSignal& settled) const {
    const BitVectorValue& own = GetOwnConstant(*settled.signal);
    if (own.GetValue().IsEmpty() || dummies_.IsEmpty()) {
        return own;
    }
    const Entry* const entry = FindSuccession(*settled.signal);
    const bool isHandedOver = entry != nullptr && entry->forOutputs;
    return isHandedOver == settled.isDummyToCome ? own : NoValue();
}

bool SettledSignals::HasOwnPin(const Signal& signal) const {
    for (const Pin* pin : signal.GetPinIterator()) {
        if (pin->GetSignal() == &signal) {
            return true;
        }
    }
    const Entry* const entry = dummies_.FindByDummy(&signal);
    return entry != nullptr && HasOwnPin(*entry->original);
}

bool SettledSignals::HasListedPin(const SettledSignal& settled) const {
    return (settled.isDummyToCome || FindSuccession(*settled.signal) == nullptr) &&
           HasOwnPin(*settled.signal);
}

bool SettledSignals::IsEmptied(const CompoundBus& compound) const {
    return FindSuccession(compound) != nullptr && GetAliases({&compound}).empty() &&
           GetConstant({&compound}).GetValue().IsEmpty() && !compound.HasAttrs() &&
           compound.GetCommentView().empty() && References::GetReferrers(compound).empty();
}

std::vector<const Signal*> SettledSignals::GetOriginalsOfPartsToCome(const Bus& bus) const {
    std::vector<const Signal*> parts;
    const Entry* const entry = dummies_.FindByDummy(&bus);
    const Bus* const original = entry == nullptr ? nullptr : As<Bus>(entry->original);
    if (original != nullptr) {
        for (const Signal* part : original->GetBusSliceIterator()) {
            if (dummies_.FindByOriginal(part) == nullptr &&
                dummies_.FindPending(netlist_, *part) == entry) {
                parts.push_back(part);
            }
        }
    }
    return parts;
}

} // namespace Orn_Hdl::Script
