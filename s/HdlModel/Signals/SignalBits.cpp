#include "HdlModel/Signals/SignalBits.h"

namespace Orn_Hdl::SignalBits {

bool IsSingle(const Signal& signal) noexcept {
    const int type = signal.GetSignalType();
    return type == SignalTypeScalar || type == SignalTypeBusIndex;
}

std::optional<std::int64_t> Count(const Signal& signal) {
    if (IsSingle(signal)) {
        return 1;
    }
    const CompoundBus* const compound = As<CompoundBus>(&signal);
    if (compound == nullptr) {
        Names::BusName bus;
        const bool isListable = Names::ParseBus(signal.GetNameView(), bus) && bus.IsExpandable();
        return isListable ? std::optional(bus.GetBits()) : std::nullopt;
    }
    std::int64_t count = 0;
    for (const Signal* member : compound->GetBusMemberIterator()) {
        const std::optional<std::int64_t> ofMember = Count(*member);
        if (!ofMember) {
            return std::nullopt;
        }
        count += *ofMember;
    }
    return count;
}

void AppendTo(StringArray& names, const Names::BusName& bus) {
    ForEach(bus, bus.GetBits(), [&names](std::string_view bit) { names.Add(bit); });
}

} // namespace Orn_Hdl::SignalBits
