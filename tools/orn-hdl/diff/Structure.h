// Matches nets and instances of two designs by their connections.
#pragma once

#include "diff/Matching.h"

#include <cstddef>
#include <cstdint>
#include <deque>
#include <utility>
#include <vector>

namespace Tool::Diff {

/// Extends a matching. Every object is taken up once when it is matched, and the numbers of
/// surroundings are computed in a bounded number of rounds, so the work is linear in the designs.
class Structure {
public:
    Structure(const Graph& a, const Graph& b, const Likeness (&likeness)[2], Matching& matching);

    /// Matches what the connections tell.
    void Run();

private:
    /// A pin of an instance, as its net sees it.
    struct Neighbour {
        /// Equal for the same pin of alike instances.
        std::uint64_t key = 0;
        std::uint32_t row = 0;
    };
    /// A pair of nets with instances among which the nets do not tell.
    struct Ambiguity {
        std::vector<Neighbour> neighbours[2];
        std::size_t at[2] = {0, 0};
    };
    /// An object with the number of its surroundings.
    struct Colored {
        std::uint64_t color = 0;
        std::uint32_t row = 0;
        bool isNet = false;
    };

    void LinkNets(Design design);
    void QueueBorder();
    void Propagate();
    void PropagateInstance(std::uint32_t rowA, std::uint32_t rowB);
    void PropagateNet(std::uint32_t netA, std::uint32_t netB);
    std::vector<Neighbour> ListNeighbours(Design design, std::uint32_t net, bool byColor) const;
    bool Resolve(Ambiguity& ambiguity);
    void ResolveAll();
    void ResolveNets();

    void StartColors();
    void ColorMatched();
    void Refine();
    void RefineInstances(Design design);
    void RefineNets(Design design);
    bool MatchUnique();
    void MatchAlike();
    std::vector<Colored> ListColored(Design design) const;

    bool IsFree(Design design, std::uint32_t net) const noexcept;
    bool CanMatch(std::uint32_t netA, std::uint32_t netB) const noexcept;
    void TakeNets(std::uint32_t netA, std::uint32_t netB);
    void TakeInstances(std::uint32_t rowA, std::uint32_t rowB);
    /// Drops matches in which less than half of the connections agree.
    void DropUnlike();
    bool AgreesInstance(std::uint32_t rowA, std::uint32_t rowB) const;
    bool AgreesNet(std::uint32_t netA, std::uint32_t netB) const;

    const Graph* graphs_[2];
    const Likeness* likeness_[2];
    Matching& matching_;
    /// For each net the first of its pins in `pins_`, and behind the last net their number.
    std::vector<std::uint32_t> firstPin_[2];
    /// Bits of pins, by their numbers among all pins, and the instance of each.
    std::vector<std::uint32_t> pins_[2];
    std::vector<std::uint32_t> owners_[2];
    /// The numbers of the surroundings, of nets and instances.
    std::vector<std::uint64_t> netColors_[2];
    std::vector<std::uint64_t> instanceColors_[2];
    /// What is not matched.
    std::vector<std::uint32_t> freeNets_[2];
    std::vector<std::uint32_t> freeInstances_[2];
    /// What has been matched here and is to be taken up: the rows in the first design.
    std::deque<std::pair<std::uint32_t, bool>> queue_;
    std::deque<Ambiguity> ambiguities_;
    /// What was matched here.
    std::vector<std::uint32_t> matchedNets_;
    std::vector<std::uint32_t> matchedInstances_;
    /// How many of these have colours of their own.
    std::size_t coloredNets_ = 0;
    std::size_t coloredInstances_ = 0;
    /// How many colours there were at the last look.
    std::size_t colorCount_ = 0;
    bool keepsAmbiguities_ = false;
    bool usesColors_ = true;
};

} // namespace Tool::Diff
