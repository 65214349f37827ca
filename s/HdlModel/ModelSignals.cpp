// How a name becomes a signal when it is first used.
#include "HdlModel/Names/Names.h"
#include "Orn_Hdl/Model.h"
#include "Port/Ascii.h"

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
