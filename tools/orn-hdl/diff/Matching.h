// Which nets and instances of two designs are the same.
#pragma once

#include "diff/Graph.h"

#include <array>
#include <cstdint>
#include <vector>

namespace Tool::Diff {

/// For each object of a design the one of the other design; None for none.
struct Matching {
    Matching(const Graph& a, const Graph& b);

    /// By design and row.
    std::array<std::vector<std::uint32_t>, 2> nets;
    std::array<std::vector<std::uint32_t>, 2> instances;
    /// By design and row: the signal of the same name.
    std::array<std::vector<std::uint32_t>, 2> signals;

    bool AreMatched(std::uint32_t netA, std::uint32_t netB) const noexcept {
        return netA == Open || netB == Open ? netA == netB : nets[A][netA] == netB;
    }
    void MatchNets(std::uint32_t netA, std::uint32_t netB) noexcept {
        nets[A][netA] = netB;
        nets[B][netB] = netA;
    }
    void MatchInstances(std::uint32_t rowA, std::uint32_t rowB) noexcept {
        instances[A][rowA] = rowB;
        instances[B][rowB] = rowA;
    }
};

/// What two instances of one component must have in common beside their connections, as a number;
/// by design and instance. Empty if nothing.
using Likeness = std::vector<std::uint64_t>;

/// Matches ports by their names. Then internal nets and instances: by their names first, and what
/// is left by its connections, or, without `byNames`, by their connections first.
///
/// By connections means: from what is matched to its only neighbours of their kind. What has
/// several such neighbours is told apart by numbers that describe its surroundings, refined in a
/// bounded number of rounds. What is alike then is matched in its order.
/// \param mergesNets as in `Rules`.
Matching Match(const Graph& a, const Graph& b, const Likeness (&likeness)[2], bool byNames,
               bool mergesNets);

} // namespace Tool::Diff
