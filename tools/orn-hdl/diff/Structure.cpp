#include "diff/Structure.h"

#include <algorithm>

namespace Tool::Diff {

namespace {

/// How often the numbers of surroundings are refined at most, and how often between two attempts
/// to match what they tell apart.
constexpr int MostRefinements = 48;
constexpr int RefinementsPerStep = 3;
/// A colour for an open pin.
constexpr std::uint64_t OpenColor = 0x5bd1e995U;

/// \{
/// The colours of what is matched, by the rows in the first design.
constexpr std::uint64_t ColorOfNet(std::uint32_t net) noexcept {
    return Mix(1, net);
}
constexpr std::uint64_t ColorOfInstance(std::uint32_t row) noexcept {
    return Mix(4, row);
}
/// \}

} // namespace

Structure::Structure(const Graph& a, const Graph& b, const Likeness (&likeness)[2],
                     Matching& matching)
    : graphs_{&a, &b}, likeness_{&likeness[A], &likeness[B]}, matching_(matching) {}

/// A net whose match is not settled by its name: no port, no constant.
bool Structure::IsFree(Design design, std::uint32_t net) const noexcept {
    return net != Open && net >= Graph::FirstNet && matching_.nets[design][net] == None &&
           !graphs_[design]->IsPort(net);
}

bool Structure::CanMatch(std::uint32_t netA, std::uint32_t netB) const noexcept {
    return IsFree(A, netA) && IsFree(B, netB);
}

void Structure::LinkNets(Design design) {
    const Graph& graph = *graphs_[design];
    const std::vector<std::uint32_t>& nets = graph.GetPinNets();
    std::vector<std::uint32_t>& first = firstPin_[design];
    first.assign(graph.GetNetCount() + 1, 0);
    for (const std::uint32_t net : nets) {
        if (net != Open) {
            ++first[net + 1];
        }
    }
    for (std::size_t i = 1; i < first.size(); ++i) {
        first[i] += first[i - 1];
    }
    std::vector<std::uint32_t> next(first.begin(), first.end() - 1);
    pins_[design].resize(first.back());
    owners_[design].resize(nets.size());
    for (std::uint32_t row = 0; row < graph.GetInstances().size(); ++row) {
        const std::uint32_t begin = graph.GetInstances()[row].first;
        for (std::uint32_t pin = begin; pin < begin + graph.GetWidth(row); ++pin) {
            owners_[design][pin] = row;
            if (nets[pin] != Open) {
                pins_[design][next[nets[pin]]++] = pin;
            }
        }
    }
}

void Structure::TakeNets(std::uint32_t netA, std::uint32_t netB) {
    matching_.MatchNets(netA, netB);
    matchedNets_.push_back(netA);
    queue_.emplace_back(netA, true);
}

void Structure::TakeInstances(std::uint32_t rowA, std::uint32_t rowB) {
    matching_.MatchInstances(rowA, rowB);
    matchedInstances_.push_back(rowA);
    queue_.emplace_back(rowA, false);
}

/// Queues what is matched and has a neighbour in both designs that is not.
void Structure::QueueBorder() {
    const bool hasNets = !freeNets_[A].empty() && !freeNets_[B].empty();
    for (std::uint32_t row = 0; hasNets && row < graphs_[A]->GetInstances().size(); ++row) {
        if (matching_.instances[A][row] != None) {
            queue_.emplace_back(row, false);
        }
    }
    std::vector<std::uint8_t> isQueued(graphs_[A]->GetNetCount(), 0);
    const std::vector<std::uint32_t>& nets = graphs_[A]->GetPinNets();
    for (const std::uint32_t row : freeInstances_[A]) {
        const std::uint32_t begin = graphs_[A]->GetInstances()[row].first;
        for (std::uint32_t pin = begin; pin < begin + graphs_[A]->GetWidth(row); ++pin) {
            const std::uint32_t net = nets[pin];
            if (net != Open && matching_.nets[A][net] != None && isQueued[net] == 0) {
                isQueued[net] = 1;
                queue_.emplace_back(net, true);
            }
        }
    }
}

void Structure::Propagate() {
    while (!queue_.empty()) {
        const auto [row, isNet] = queue_.front();
        queue_.pop_front();
        if (isNet) {
            PropagateNet(row, matching_.nets[A][row]);
        } else {
            PropagateInstance(row, matching_.instances[A][row]);
        }
    }
}

/// The nets at the same pins of matched instances are the same.
void Structure::PropagateInstance(std::uint32_t rowA, std::uint32_t rowB) {
    const InstanceRow& a = graphs_[A]->GetInstances()[rowA];
    const InstanceRow& b = graphs_[B]->GetInstances()[rowB];
    if (a.component != b.component) {
        return;
    }
    for (std::uint32_t i = 0; i < graphs_[A]->GetWidth(rowA); ++i) {
        const std::uint32_t netA = graphs_[A]->GetPinNets()[a.first + i];
        const std::uint32_t netB = graphs_[B]->GetPinNets()[b.first + i];
        if (CanMatch(netA, netB)) {
            TakeNets(netA, netB);
        }
    }
}

/// The pins of a net whose instances are not matched, by their keys.
std::vector<Structure::Neighbour> Structure::ListNeighbours(Design design, std::uint32_t net,
                                                            bool byColor) const {
    std::vector<Neighbour> neighbours;
    const Graph& graph = *graphs_[design];
    for (std::uint32_t i = firstPin_[design][net]; i < firstPin_[design][net + 1]; ++i) {
        const std::uint32_t pin = pins_[design][i];
        const std::uint32_t row = owners_[design][pin];
        if (matching_.instances[design][row] == None) {
            const InstanceRow& instance = graph.GetInstances()[row];
            const std::uint64_t kind = Mix(instance.component, pin - instance.first);
            neighbours.push_back({byColor ? Mix(kind, instanceColors_[design][row]) : kind, row});
        }
    }
    std::sort(neighbours.begin(), neighbours.end(), [](const Neighbour& a, const Neighbour& b) {
        return a.key != b.key ? a.key < b.key : a.row < b.row;
    });
    return neighbours;
}

/// An instance at a net that is the only one of its kind there in both designs is the same.
void Structure::PropagateNet(std::uint32_t netA, std::uint32_t netB) {
    if (netA < Graph::FirstNet) {
        return;
    }
    Ambiguity found;
    found.neighbours[A] = ListNeighbours(A, netA, false);
    if (found.neighbours[A].empty()) {
        return;
    }
    found.neighbours[B] = ListNeighbours(B, netB, false);
    const std::vector<Neighbour>& a = found.neighbours[A];
    const std::vector<Neighbour>& b = found.neighbours[B];
    bool isAmbiguous = false;
    for (std::size_t i = 0, j = 0; i < a.size() && j < b.size();) {
        if (a[i].key != b[j].key) {
            a[i].key < b[j].key ? ++i : ++j;
            continue;
        }
        std::size_t endA = i;
        std::size_t endB = j;
        while (endA < a.size() && a[endA].key == a[i].key) {
            ++endA;
        }
        while (endB < b.size() && b[endB].key == b[j].key) {
            ++endB;
        }
        if (endA - i == 1 && endB - j == 1) {
            if (matching_.instances[A][a[i].row] == None &&
                matching_.instances[B][b[j].row] == None) {
                TakeInstances(a[i].row, b[j].row);
            }
        } else {
            isAmbiguous = true;
        }
        i = endA;
        j = endB;
    }
    if (isAmbiguous && keepsAmbiguities_) {
        if (usesColors_) {
            found.neighbours[A] = ListNeighbours(A, netA, true);
            found.neighbours[B] = ListNeighbours(B, netB, true);
        }
        ambiguities_.push_back(std::move(found));
    }
}

/// Matches the first two of a net's instances that are alike. \return whether there were any.
bool Structure::Resolve(Ambiguity& ambiguity) {
    const std::vector<Neighbour>& a = ambiguity.neighbours[A];
    const std::vector<Neighbour>& b = ambiguity.neighbours[B];
    std::size_t& i = ambiguity.at[A];
    std::size_t& j = ambiguity.at[B];
    while (i < a.size() && j < b.size()) {
        if (matching_.instances[A][a[i].row] != None) {
            ++i;
        } else if (matching_.instances[B][b[j].row] != None) {
            ++j;
        } else if (a[i].key != b[j].key) {
            a[i].key < b[j].key ? ++i : ++j;
        } else {
            TakeInstances(a[i++].row, b[j++].row);
            return true;
        }
    }
    return false;
}

/// One pair at a time, since each tells more of its surroundings.
void Structure::ResolveAll() {
    Propagate();
    while (!ambiguities_.empty()) {
        if (!Resolve(ambiguities_.front())) {
            ambiguities_.pop_front();
        }
        Propagate();
    }
}

/// The nets that are matched may have several neighbours of a kind that are alike.
void Structure::ResolveNets() {
    for (std::uint32_t net = Graph::FirstNet; net < graphs_[A]->GetNetCount(); ++net) {
        if (matching_.nets[A][net] != None) {
            queue_.emplace_back(net, true);
        }
    }
    ResolveAll();
}

void Structure::StartColors() {
    for (const Design design : {A, B}) {
        const Graph& graph = *graphs_[design];
        const auto matchOf = [&](const std::array<std::vector<std::uint32_t>, 2>& rows,
                                 std::uint32_t row) { return design == A ? row : rows[B][row]; };
        netColors_[design].assign(graph.GetNetCount(), 0);
        for (std::uint32_t net = 0; net < graph.GetNetCount(); ++net) {
            netColors_[design][net] = matching_.nets[design][net] != None
                                          ? ColorOfNet(matchOf(matching_.nets, net))
                                          : Mix(graph.IsPort(net) ? 2 : 3, graph.GetTie(net));
        }
        instanceColors_[design].assign(graph.GetInstances().size(), 0);
        for (std::uint32_t row = 0; row < graph.GetInstances().size(); ++row) {
            const std::uint64_t like =
                row < likeness_[design]->size() ? (*likeness_[design])[row] : 0;
            instanceColors_[design][row] =
                matching_.instances[design][row] != None
                    ? ColorOfInstance(matchOf(matching_.instances, row))
                    : Mix(5, Mix(graph.GetInstances()[row].component, like));
        }
    }
}

/// Gives what was matched since the last time a colour of its own.
void Structure::ColorMatched() {
    for (; coloredNets_ < matchedNets_.size(); ++coloredNets_) {
        const std::uint32_t net = matchedNets_[coloredNets_];
        netColors_[A][net] = netColors_[B][matching_.nets[A][net]] = ColorOfNet(net);
    }
    for (; coloredInstances_ < matchedInstances_.size(); ++coloredInstances_) {
        const std::uint32_t row = matchedInstances_[coloredInstances_];
        instanceColors_[A][row] = instanceColors_[B][matching_.instances[A][row]] =
            ColorOfInstance(row);
    }
}

void Structure::RefineInstances(Design design) {
    const Graph& graph = *graphs_[design];
    for (const std::uint32_t row : freeInstances_[design]) {
        std::uint64_t color = instanceColors_[design][row];
        const std::uint32_t begin = graph.GetInstances()[row].first;
        for (std::uint32_t pin = begin; pin < begin + graph.GetWidth(row); ++pin) {
            const std::uint32_t net = graph.GetPinNets()[pin];
            color = Mix(color, net == Open ? OpenColor : netColors_[design][net]);
        }
        instanceColors_[design][row] = color;
    }
}

void Structure::RefineNets(Design design) {
    const Graph& graph = *graphs_[design];
    for (const std::uint32_t net : freeNets_[design]) {
        std::uint64_t sum = 0;
        for (std::uint32_t i = firstPin_[design][net]; i < firstPin_[design][net + 1]; ++i) {
            const std::uint32_t pin = pins_[design][i];
            const std::uint32_t row = owners_[design][pin];
            sum += Mix(instanceColors_[design][row], pin - graph.GetInstances()[row].first);
        }
        netColors_[design][net] = Mix(netColors_[design][net], sum);
    }
}

void Structure::Refine() {
    ColorMatched();
    for (const Design design : {A, B}) {
        const auto drop = [](std::vector<std::uint32_t>& rows, const auto& isTaken) {
            rows.erase(std::remove_if(rows.begin(), rows.end(), isTaken), rows.end());
        };
        drop(freeInstances_[design],
             [&](std::uint32_t row) { return matching_.instances[design][row] != None; });
        drop(freeNets_[design], [&](std::uint32_t net) { return !IsFree(design, net); });
    }
    for (int i = 0; i < RefinementsPerStep; ++i) {
        for (const Design design : {A, B}) {
            RefineInstances(design);
            RefineNets(design);
        }
    }
}

/// What is not matched and has connections, by its colour.
std::vector<Structure::Colored> Structure::ListColored(Design design) const {
    std::vector<Colored> all;
    for (const std::uint32_t row : freeInstances_[design]) {
        if (matching_.instances[design][row] == None) {
            all.push_back({instanceColors_[design][row], row, false});
        }
    }
    for (const std::uint32_t net : freeNets_[design]) {
        if (IsFree(design, net) && firstPin_[design][net] != firstPin_[design][net + 1]) {
            all.push_back({netColors_[design][net], net, true});
        }
    }
    std::sort(all.begin(), all.end(), [](const Colored& a, const Colored& b) {
        return a.color != b.color ? a.color < b.color : a.row < b.row;
    });
    return all;
}

/// Matches what no other object resembles. \return whether the colours may tell more when they are
/// refined: some were matched, or there are more colours than before.
bool Structure::MatchUnique() {
    const std::vector<Colored> a = ListColored(A);
    const std::vector<Colored> b = ListColored(B);
    bool hasMatched = false;
    std::size_t colors = 0;
    for (std::size_t i = 0, j = 0; i < a.size(); ++colors) {
        std::size_t endA = i;
        while (endA < a.size() && a[endA].color == a[i].color) {
            ++endA;
        }
        while (j < b.size() && b[j].color < a[i].color) {
            ++j;
        }
        std::size_t endB = j;
        while (endB < b.size() && b[endB].color == a[i].color) {
            ++endB;
        }
        if (endA - i == 1 && endB - j == 1 && a[i].isNet == b[j].isNet) {
            hasMatched = true;
            if (a[i].isNet) {
                TakeNets(a[i].row, b[j].row);
            } else {
                TakeInstances(a[i].row, b[j].row);
            }
        }
        i = endA;
        j = endB;
    }
    const bool hasMore = colors > colorCount_;
    colorCount_ = hasMatched ? 0 : colors;
    return hasMatched || hasMore;
}

/// Matches what is alike: symmetrical parts of a design, in their order.
void Structure::MatchAlike() {
    keepsAmbiguities_ = true;
    ResolveNets();
    const std::vector<Colored> a = ListColored(A);
    const std::vector<Colored> b = ListColored(B);
    for (std::size_t i = 0, j = 0; i < a.size() && j < b.size();) {
        const auto isTaken = [&](Design design, const Colored& object) {
            return object.isNet ? !IsFree(design, object.row)
                                : matching_.instances[design][object.row] != None;
        };
        if (isTaken(A, a[i])) {
            ++i;
        } else if (isTaken(B, b[j])) {
            ++j;
        } else if (a[i].color != b[j].color) {
            a[i].color < b[j].color ? ++i : ++j;
        } else {
            if (a[i].isNet && b[j].isNet) {
                TakeNets(a[i].row, b[j].row);
            } else if (!a[i].isNet && !b[j].isNet) {
                TakeInstances(a[i].row, b[j].row);
            }
            ++i;
            ++j;
            ResolveAll();
        }
    }
}

bool Structure::AgreesInstance(std::uint32_t rowA, std::uint32_t rowB) const {
    const std::vector<std::uint32_t>& netsA = graphs_[A]->GetPinNets();
    const std::vector<std::uint32_t>& netsB = graphs_[B]->GetPinNets();
    const std::uint32_t beginA = graphs_[A]->GetInstances()[rowA].first;
    const std::uint32_t beginB = graphs_[B]->GetInstances()[rowB].first;
    std::uint32_t wiredA = 0;
    std::uint32_t wiredB = 0;
    std::uint32_t equal = 0;
    for (std::uint32_t i = 0; i < graphs_[A]->GetWidth(rowA); ++i) {
        const std::uint32_t netA = netsA[beginA + i];
        const std::uint32_t netB = netsB[beginB + i];
        wiredA += netA != Open ? 1 : 0;
        wiredB += netB != Open ? 1 : 0;
        equal += netA != Open && matching_.AreMatched(netA, netB) ? 1 : 0;
    }
    return 2 * equal >= std::max(wiredA, wiredB);
}

bool Structure::AgreesNet(std::uint32_t netA, std::uint32_t netB) const {
    const std::uint32_t pinsA = firstPin_[A][netA + 1] - firstPin_[A][netA];
    const std::uint32_t pinsB = firstPin_[B][netB + 1] - firstPin_[B][netB];
    std::uint32_t equal = 0;
    for (std::uint32_t i = firstPin_[A][netA]; i < firstPin_[A][netA + 1]; ++i) {
        const std::uint32_t pin = pins_[A][i];
        const std::uint32_t row = owners_[A][pin];
        const std::uint32_t other = matching_.instances[A][row];
        if (other != None && graphs_[B]->GetInstances()[other].component ==
                                 graphs_[A]->GetInstances()[row].component) {
            const std::uint32_t at = graphs_[B]->GetInstances()[other].first + pin -
                                     graphs_[A]->GetInstances()[row].first;
            equal += graphs_[B]->GetPinNets()[at] == netB ? 1 : 0;
        }
    }
    return 2 * equal >= std::max(pinsA, pinsB);
}

void Structure::DropUnlike() {
    std::vector<std::uint32_t> nets;
    std::vector<std::uint32_t> instances;
    for (const std::uint32_t net : matchedNets_) {
        if (!AgreesNet(net, matching_.nets[A][net])) {
            nets.push_back(net);
        }
    }
    for (const std::uint32_t row : matchedInstances_) {
        if (!AgreesInstance(row, matching_.instances[A][row])) {
            instances.push_back(row);
        }
    }
    for (const std::uint32_t net : nets) {
        matching_.nets[B][matching_.nets[A][net]] = None;
        matching_.nets[A][net] = None;
    }
    for (const std::uint32_t row : instances) {
        matching_.instances[B][matching_.instances[A][row]] = None;
        matching_.instances[A][row] = None;
    }
}

void Structure::Run() {
    bool hasInstances = true;
    bool hasNets = true;
    for (const Design design : {A, B}) {
        for (std::uint32_t row = 0; row < graphs_[design]->GetInstances().size(); ++row) {
            if (matching_.instances[design][row] == None) {
                freeInstances_[design].push_back(row);
            }
        }
        for (std::uint32_t net = 0; net < graphs_[design]->GetNetCount(); ++net) {
            if (IsFree(design, net)) {
                freeNets_[design].push_back(net);
            }
        }
        hasInstances = hasInstances && !freeInstances_[design].empty();
        hasNets = hasNets && !freeNets_[design].empty();
    }
    if (!hasInstances && !hasNets) {
        return;
    }
    LinkNets(A);
    LinkNets(B);
    StartColors();
    QueueBorder();
    Propagate();
    for (int done = 0; done < MostRefinements; done += RefinementsPerStep) {
        Refine();
        if (!MatchUnique()) {
            break;
        }
        Propagate();
    }
    MatchAlike();
    // Whatever is left at nets that are matched, though its surroundings differ.
    usesColors_ = false;
    ResolveNets();
    DropUnlike();
}

} // namespace Tool::Diff
