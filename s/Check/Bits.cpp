#include "Check/Bits.h"

#include <algorithm>

namespace Orn_Hdl::Checking {

namespace {

/// The position of an index within a bus, counted from the left; negative or too great outside.
std::int64_t PositionOf(const Names::BusName& bus, int index) {
    return bus.leftIndex >= bus.rightIndex ? std::int64_t(bus.leftIndex) - index
                                           : std::int64_t(index) - bus.leftIndex;
}

void SetRun(const Names::BusName& bus, int oneEnd, int otherEnd, Run& run) {
    const std::int64_t a = PositionOf(bus, oneEnd);
    const std::int64_t b = PositionOf(bus, otherEnd);
    const std::int64_t first = std::min(a, b);
    const std::int64_t end = std::max(a, b) + 1;
    const std::int64_t width = bus.GetBits();
    run.isOutside = first < 0 || end > width;
    run.isFarOutside = end <= 0 || first >= width;
    run.isBeyondRight = end > width && !run.isFarOutside;
    run.first = std::clamp<std::int64_t>(first, 0, width);
    run.count = std::clamp<std::int64_t>(end, 0, width) - run.first;
}

bool SetPart(const Signal& part, const Bus* parent, Run& run) {
    Names::BusName bus;
    if (parent == nullptr || !Names::ParseBus(parent->GetNameView(), bus)) {
        return false;
    }
    run.declared = parent;
    Names::BusName slice;
    Names::BitName bit;
    if (Names::ParseBus(part.GetNameView(), slice)) {
        SetRun(bus, slice.leftIndex, slice.rightIndex, run);
    } else if (Names::ParseBit(part.GetNameView(), bit)) {
        SetRun(bus, bit.value, bit.value, run);
    } else {
        return false;
    }
    return true;
}

const Bus* GetParent(const Signal& part) {
    return part.GetSignalType() == SignalTypeBusSlice
               ? static_cast<const BusSlice&>(part).GetParentBus()
               : static_cast<const BusIndex&>(part).GetParentBus();
}

} // namespace

bool GetRun(const Signal& signal, Run& run) {
    run = Run();
    run.reference = &signal;
    switch (signal.GetSignalType()) {
    case SignalTypeScalar:
        run.declared = &signal;
        return true;
    case SignalTypeBus: {
        Names::BusName bus;
        run.declared = &signal;
        run.count = Names::ParseBus(signal.GetNameView(), bus) ? bus.GetBits() : 1;
        return true;
    }
    case SignalTypeBusSlice:
    case SignalTypeBusIndex:
        return SetPart(signal, GetParent(signal), run);
    default:
        return false;
    }
}

} // namespace Orn_Hdl::Checking
