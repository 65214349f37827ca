// Which signals of two designs are the same.
#pragma once

#include "diff/Matching.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <vector>

namespace Tool::Diff {

/// What became of the signals, in terms of rows of `Graph::GetSignals`. Generated signals are left
/// out.
struct SignalPairs {
    /// A signal of each design.
    struct Pair {
        std::uint32_t rows[2] = {None, None};
        bool isRenamed = false;
    };
    /// A bit of a signal, or all of it.
    struct Part {
        static constexpr std::uint32_t Whole = None;
        std::uint32_t row = None;
        std::uint32_t index = Whole;
    };
    /// A bit of each design: the signals do not correspond, but their nets do.
    struct BitPair {
        Part parts[2];
    };

    std::vector<Pair> pairs;
    std::vector<BitPair> bits;
    /// What the other design does not have, by design.
    std::array<std::vector<Part>, 2> left;
};

/// Ports are paired by name. Other signals are paired by name, too, or, without `byNames`, by their
/// nets; what is left is paired by its nets, as a whole where that is possible, else bit by bit.
/// Signals to which nothing is connected are paired by their widths.
SignalPairs PairSignals(const Graph& a, const Graph& b, const Matching& matching, bool byNames,
                        bool mergesNets);

} // namespace Tool::Diff
