// How a name becomes a signal when it is first used.
#include "HdlModel/ModelFailures.h"
#include "HdlModel/Names/Names.h"
#include "HdlModel/Signals/SignalCast.h"
#include "Orn_Hdl/Model.h"
#include "Port/Ascii.h"

#include <algorithm>
#include <memory>
#include <string>
#include <utility>

namespace Orn_Hdl {

namespace {

using Port::ViewOf;

/// Whether a text, and its normalised form too, has a shape; `parse` tells for one of them.
template <class Parse> bool HasShape(std::string_view text, Parse parse) {
    return parse(text) &&
           (Names::IsNormalized(text) || parse(Names::NormalizedText(text).GetView()));
}

bool IsBitName(std::string_view text) {
    Names::BitName bit;
    return HasShape(text, [&bit](std::string_view name) { return Names::ParseBit(name, bit); });
}

bool IsBusName(std::string_view text) {
    Names::BusName bus;
    return HasShape(text, [&bus](std::string_view name) { return Names::ParseBus(name, bus); });
}

bool IsCompoundName(std::string_view text) {
    return HasShape(text, Names::IsCompound);
}

/// Whether a text names a bus as a whole, with or without its range.
bool IsNameOf(const Bus& bus, std::string_view text) {
    const Names::NormalizedText name(text);
    return Port::EqualIgnoringCase(name.GetView(), bus.GetNameView()) ||
           Port::EqualIgnoringCase(name.GetView(), Names::BeforeParenthesis(bus.GetNameView()));
}

bool HasIndex(const Bus& bus, int index) {
    Names::BusName range;
    return Names::ParseBus(bus.GetNameView(), range) &&
           index >= std::min(range.leftIndex, range.rightIndex) &&
           index <= std::max(range.leftIndex, range.rightIndex);
}

std::string BitName(std::string_view base, int index) {
    return std::string(base).append("(").append(std::to_string(index)).append(")");
}

/// A name with its base name spelled as the bus spells it.
std::string SpelledAs(const Bus& bus, std::string_view name) {
    std::string spelled(Names::BeforeParenthesis(bus.GetNameView()));
    return spelled.append(name.substr(Names::BeforeParenthesis(name).size()));
}

} // namespace

Signal* Model::GetOrCreateSignal(const char* text) {
    const std::string_view name = ViewOf(text);
    if (Signal* signal = GetNetlist()->GetSignal(name)) {
        return signal;
    }
    if (IsBitName(name)) {
        return CreateAndAddBusIndexSignal(name);
    }
    if (IsBusName(name)) {
        return CreateAndAddBusSliceSignal(name);
    }
    if (IsCompoundName(name)) {
        return CreateAndAddCompundSignal(name);
    }
    DeclareSignal(text == nullptr ? "" : text);
    return GetNetlist()->GetSignal(name);
}

Signal* Model::CreateAndAddBusIndexSignal(std::string_view name) {
    Bus* const parent = GetNetlist()->GetParentBus(std::string(name).c_str());
    if (parent == nullptr) {
        return nullptr;
    }
    Signal* const bit = new BusIndex(SpelledAs(*parent, name).c_str(), parent);
    GetNetlist()->Add(bit);
    return bit;
}

Signal* Model::CreateAndAddBusSliceSignal(std::string_view name) {
    Netlist& netlist = *GetNetlist();
    Bus* const present = netlist.GetParentBus(std::string(name).c_str());
    if (present == nullptr) {
        DeclareSignal(std::string(name).c_str());
        return netlist.GetSignal(name);
    }
    const std::string spelled = SpelledAs(*present, name);
    Names::BusName parsed;
    Names::ParseBus(spelled, parsed);
    if (present->GetWidth() > parsed.GetWidth()) {
        Signal* const slice = new BusSlice(spelled.c_str(), present);
        netlist.Add(slice);
        return slice;
    }
    auto wider = std::make_unique<Bus>(spelled.c_str());
    Bus* const result = wider.get();
    auto slice = std::make_unique<BusSlice>(present->GetName().CStr(), result);
    netlist.ReplaceBus(present, std::move(wider), std::move(slice));
    return result;
}

BusIndex* Model::Bit(const Port::TextArgument& bus, int index) {
    const Bus* const parent = GetNetlist()->GetParentBus(bus);
    if (parent == nullptr || !IsNameOf(*parent, bus.GetView()) || !HasIndex(*parent, index)) {
        FailSignalNotFound(__LINE__,
                           BitName(Names::BeforeParenthesis(bus.GetView()), index).c_str());
    }
    const std::string name = BitName(Names::BeforeParenthesis(parent->GetNameView()), index);
    Signal* signal = GetNetlist()->GetSignal(std::string_view(name));
    if (signal == nullptr) {
        signal = CreateAndAddBusIndexSignal(name);
        SetModifiedFlag(true);
    }
    auto* const bit = As<BusIndex>(signal);
    if (bit == nullptr) {
        FailSignalNotFound(__LINE__, name.c_str());
    }
    return bit;
}

Signal* Model::GetOrCreateMember(std::string_view name) {
    Netlist& netlist = *GetNetlist();
    Signal* member = netlist.GetSignal(name);
    if (member == nullptr && IsBitName(name)) {
        member = CreateAndAddBusIndexSignal(name);
    } else if (member == nullptr && IsBusName(name)) {
        member = CreateAndAddBusSliceSignal(name);
    }
    if (member == nullptr) {
        DeclareSignal(std::string(name).c_str());
        member = netlist.GetSignal(name);
    }
    return member;
}

Signal* Model::CreateAndAddCompundSignal(std::string_view name) {
    const Names::NormalizedText normalized(name);
    std::string_view piece;
    for (Names::CompoundPieces pieces(normalized.GetView()); pieces.Next(piece);) {
        GetOrCreateMember(piece);
    }
    // A later member may have put a wider bus in the place of an earlier one, so the members are
    // looked up when all of them are there.
    auto compound = std::make_unique<CompoundBus>(std::string(normalized.GetView()).c_str());
    for (Names::CompoundPieces pieces(normalized.GetView()); pieces.Next(piece);) {
        compound->AddBusMember(GetNetlist()->GetSignal(piece));
    }
    Signal* const result = compound.get();
    GetNetlist()->Add(compound.release());
    return result;
}

} // namespace Orn_Hdl
