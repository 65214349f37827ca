// The declared signals behind a reference, bit by bit.
#pragma once

#include "HdlModel/Names/Names.h"
#include "Orn_Hdl/Model/Signals.h"

#include <cstdint>
#include <vector>

namespace Orn_Hdl::Checking {

/// A run of bits of a declared signal: of a scalar signal its only bit.
struct Run {
    /// What is declared: a scalar signal or a bus.
    const Signal* declared = nullptr;
    /// The first bit, counted from the left of the declared range.
    std::int64_t first = 0;
    std::int64_t count = 1;
    /// Whether the bits, or some of them, lie outside what is declared.
    bool isOutside = false;
    /// Whether all of them do.
    bool isFarOutside = false;
    /// Whether only some do, beyond the right end.
    bool isBeyondRight = false;
    /// The reference itself: the declared signal, or a part of it.
    const Signal* reference = nullptr;
};

/// The bits that a scalar signal, a bus, a slice or a bit stands for.
/// \return false for a compound, and for what has no declared signal.
bool GetRun(const Signal& signal, Run& run);

/// Calls `visit(run)` for the parts of a signal, those of a compound from the left.
template <class Visit> void ForEachRun(const Signal& signal, const Visit& visit) {
    if (signal.GetSignalType() == SignalTypeCompoundBus) {
        for (const Signal* member :
             static_cast<const CompoundBus&>(signal).GetBusMemberIterator()) {
            ForEachRun(*member, visit);
        }
        return;
    }
    Run run;
    if (GetRun(signal, run)) {
        visit(run);
    }
}

} // namespace Orn_Hdl::Checking
