// How the counts of a design are printed.
#pragma once

#include "stats/Count.h"

#include <cstdint>
#include <string>

namespace Tool::Stats {

/// What a replay took.
struct Cost {
    std::uint64_t lines = 0;
    /// The bytes that the design took, as the memory of the process grew.
    std::uint64_t designBytes = 0;
    /// The most memory that the process had at a time, in bytes.
    std::uint64_t peakBytes = 0;
    double replaySeconds = 0;
    double countSeconds = 0;
};

/// A page for people.
std::string SpellAsText(const DesignCounts& counts, const Cost& cost);
/// An object of JSON.
std::string SpellAsJson(const DesignCounts& counts, const Cost& cost);

} // namespace Tool::Stats
