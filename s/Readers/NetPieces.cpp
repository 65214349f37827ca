#include "Readers/NetPieces.h"

#include "HdlModel/Names/Names.h"
#include "Orn_Hdl/Model/Netlist.h"

#include <algorithm>
#include <cstdlib>

namespace Orn_Hdl::Readers {

namespace {

/// The bits of a slice or bit within its bus, counted from the left: the first one and the one
/// behind the last.
struct Extent {
    std::int64_t begin = 0;
    std::int64_t end = 0;
};

Extent GetExtent(const Names::BusName& bus, const Signal& part) {
    Names::Range range;
    Names::BitName bit;
    Names::BusName slice;
    if (Names::ParseBit(part.GetNameView(), bit)) {
        range = {bit.value, bit.value};
    } else if (Names::ParseBus(part.GetNameView(), slice)) {
        range = slice;
    } else {
        return {};
    }
    const std::int64_t a = std::abs(std::int64_t(bus.leftIndex) - range.leftIndex);
    const std::int64_t b = std::abs(std::int64_t(bus.leftIndex) - range.rightIndex);
    return {std::min(a, b), std::max(a, b) + 1};
}

} // namespace

NetPieces::NetPieces(const Netlist& netlist) {
    for (const Signal* signal : netlist.GetSignalIterator()) {
        if (signal == nullptr) {
            continue;
        }
        if (signal->GetSignalType() == SignalTypeScalar) {
            pieces_.emplace(signal, Pieces{count_++, 1});
        } else if (signal->GetSignalType() == SignalTypeBus) {
            Cut(static_cast<const Bus&>(*signal));
        }
    }
}

void NetPieces::Cut(const Bus& bus) {
    Names::BusName name;
    if (!Names::ParseBus(bus.GetNameView(), name)) {
        return;
    }
    cuts_.assign({0, name.GetBits()});
    for (const Signal* part : bus.GetBusSliceIterator()) {
        const Extent extent = GetExtent(name, *part);
        cuts_.push_back(extent.begin);
        cuts_.push_back(extent.end);
    }
    std::sort(cuts_.begin(), cuts_.end());
    cuts_.erase(std::unique(cuts_.begin(), cuts_.end()), cuts_.end());
    const auto numberAt = [this](std::int64_t cut) {
        const auto found = std::lower_bound(cuts_.begin(), cuts_.end(), cut);
        return count_ + static_cast<std::uint32_t>(found - cuts_.begin());
    };
    for (const Signal* part : bus.GetBusSliceIterator()) {
        const Extent extent = GetExtent(name, *part);
        const std::uint32_t first = numberAt(extent.begin);
        pieces_.emplace(part, Pieces{first, numberAt(extent.end) - first});
    }
    const auto all = static_cast<std::uint32_t>(cuts_.size() - 1);
    pieces_.emplace(&bus, Pieces{count_, all});
    count_ += all;
}

} // namespace Orn_Hdl::Readers
