// The bits that a name or a signal stands for, one by one.
//
// Whoever lists bits asks first how many there are. Nothing is expanded to tell that:
//
//     if (const std::optional<std::int64_t> count = SignalBits::Count(signal)) {
//         SignalBits::ForEach(signal, *count, [&](std::string_view name) { ... });
//     }
//
// The names come leftmost bit first. A bound below the count gives the leftmost bits only.
#pragma once

#include "HdlModel/Names/Names.h"
#include "HdlModel/Signals/SignalCast.h"
#include "Orn_Hdl/Containers/StringArray.h"
#include "Orn_Hdl/Model/Signals.h"

#include <algorithm>
#include <cstdint>
#include <optional>
#include <string_view>

namespace Orn_Hdl::SignalBits {

/// Whether the signal is a scalar signal or a bit of a bus. A bus or slice of one bit is neither:
/// its name has a range.
bool IsSingle(const Signal& signal) noexcept;

/// The number of bits of a signal. Nothing when they cannot be listed: a bus or slice, by itself or
/// in a compound, has a name that is no bus name, or more than `Names::MostExpandedBits` bits.
std::optional<std::int64_t> Count(const Signal& signal);

/// Calls `visit` with the name of each bit of a range, `most` times at most. The name is valid
/// during the call.
/// \return the number of calls.
template <class Visit>
std::int64_t ForEach(const Names::BusName& bus, std::int64_t most, const Visit& visit) {
    const std::int64_t count = std::min(bus.GetBits(), most);
    for (std::int64_t i = 0; i < count; ++i) {
        visit(std::string_view(Names::WithIndex(bus.base, bus.IndexAt(i))));
    }
    return std::max<std::int64_t>(count, 0);
}

/// Calls `visit` with the name of each bit of a signal, `most` times at most. The name is valid
/// during the call. A bus or slice whose name is no bus name has no bits.
/// \return the number of calls.
template <class Visit>
std::int64_t ForEach(const Signal& signal, std::int64_t most, const Visit& visit) {
    if (most <= 0) {
        return 0;
    }
    if (IsSingle(signal)) {
        visit(signal.GetNameView());
        return 1;
    }
    std::int64_t done = 0;
    Names::BusName bus;
    if (const CompoundBus* const compound = As<CompoundBus>(&signal)) {
        for (const Signal* member : compound->GetBusMemberIterator()) {
            done += ForEach(*member, most - done, visit);
        }
    } else if (Names::ParseBus(signal.GetNameView(), bus)) {
        done = ForEach(bus, most, visit);
    }
    return done;
}

/// Appends the names of all bits of a range.
void AppendTo(StringArray& names, const Names::BusName& bus);

} // namespace Orn_Hdl::SignalBits
