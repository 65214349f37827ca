#include "diff/SignalPairs.h"

#include <algorithm>
#include <unordered_map>

namespace Tool::Diff {

namespace {

class Pairing {
public:
    Pairing(const Graph& a, const Graph& b, const Matching& matching, bool byNames, bool mergesNets)
        : graphs_{&a, &b}, matching_(matching), byNames_(byNames), mergesNets_(mergesNets) {
        partner_[A].assign(a.GetSignals().size(), None);
        partner_[B].assign(b.GetSignals().size(), None);
    }

    SignalPairs Run() {
        PairByName();
        PairByNets();
        PairUnwired();
        for (std::uint32_t row = 0; row < partner_[A].size(); ++row) {
            Split(row);
        }
        for (std::uint32_t row = 0; row < partner_[B].size(); ++row) {
            ListAdded(row);
        }
        return std::move(result_);
    }

private:
    const SignalRow& Row(Design design, std::uint32_t row) const {
        return graphs_[design]->GetSignals()[row];
    }
    std::uint32_t Net(Design design, std::uint32_t row, std::uint32_t index) const {
        return graphs_[design]->GetNet(Row(design, row).first + index);
    }
    /// Whether a signal has to be paired.
    bool Counts(Design design, std::uint32_t row) const;
    bool IsFree(Design design, std::uint32_t row) const {
        return partner_[design][row] == None && Counts(design, row) && !Row(design, row).isPort;
    }
    bool IsWired(Design design, std::uint32_t row) const;
    void Pair(std::uint32_t rowA, std::uint32_t rowB, bool isRenamed);
    void PairByName();
    void PairByNets();
    std::uint32_t FindByNets(std::uint32_t rowA) const;
    void PairUnwired();
    std::uint64_t HashUnwired(Design design, std::uint32_t row) const;
    std::uint32_t FindFreeRow(std::uint32_t netB, std::uint32_t& index) const;
    void Split(std::uint32_t rowA);
    void ListAdded(std::uint32_t rowB);

    const Graph* graphs_[2];
    const Matching& matching_;
    const bool byNames_;
    const bool mergesNets_;
    std::vector<std::uint32_t> partner_[2];
    SignalPairs result_;
};

/// Where constants are no nets, the name of one says nothing.
bool Pairing::Counts(Design design, std::uint32_t row) const {
    const SignalRow& signal = Row(design, row);
    if (signal.isGenerated) {
        return false;
    }
    if (!mergesNets_ || signal.isPort) {
        return true;
    }
    for (std::uint32_t i = 0; i < signal.count; ++i) {
        const std::uint32_t net = Net(design, row, i);
        if (net == Open || net >= Graph::FirstNet) {
            return true;
        }
    }
    return false;
}

bool Pairing::IsWired(Design design, std::uint32_t row) const {
    for (std::uint32_t i = 0; i < Row(design, row).count; ++i) {
        const std::uint32_t net = Net(design, row, i);
        if (net != Open && graphs_[design]->IsWired(net)) {
            return true;
        }
    }
    return false;
}

void Pairing::Pair(std::uint32_t rowA, std::uint32_t rowB, bool isRenamed) {
    partner_[A][rowA] = rowB;
    partner_[B][rowB] = rowA;
    result_.pairs.push_back({{rowA, rowB}, isRenamed});
}

void Pairing::PairByName() {
    for (std::uint32_t row = 0; row < partner_[A].size(); ++row) {
        const std::uint32_t other = matching_.signals[A][row];
        if (other != None && Counts(A, row) && Counts(B, other) &&
            (byNames_ || Row(A, row).isPort || Row(B, other).isPort)) {
            Pair(row, other, false);
        }
    }
}

void Pairing::PairByNets() {
    for (std::uint32_t row = 0; row < partner_[A].size(); ++row) {
        if (!IsFree(A, row)) {
            continue;
        }
        const std::uint32_t other = FindByNets(row);
        if (other != None) {
            Pair(row, other, matching_.signals[A][row] != other);
        }
    }
}

/// The signal whose bits are the nets of another signal, in this order.
std::uint32_t Pairing::FindByNets(std::uint32_t rowA) const {
    const std::uint32_t count = Row(A, rowA).count;
    std::uint32_t found = None;
    for (std::uint32_t i = 0; i < count && found == None; ++i) {
        const std::uint32_t net = Net(A, rowA, i);
        if (net != Open && net >= Graph::FirstNet && matching_.nets[A][net] != None) {
            std::uint32_t index = 0;
            found = FindFreeRow(matching_.nets[A][net], index);
            if (found == None || index != i) {
                return None;
            }
        }
    }
    if (found == None || Row(B, found).count != count) {
        return None;
    }
    for (std::uint32_t i = 0; i < count; ++i) {
        const std::uint32_t netA = Net(A, rowA, i);
        const std::uint32_t netB = Net(B, found, i);
        const bool areUnwired = netA != Open && netB != Open && !graphs_[A]->IsWired(netA) &&
                                !graphs_[B]->IsWired(netB);
        if (!matching_.AreMatched(netA, netB) && !areUnwired) {
            return None;
        }
    }
    return found;
}

/// The signal without a partner that has a net, and which of its bits the net is.
std::uint32_t Pairing::FindFreeRow(std::uint32_t netB, std::uint32_t& index) const {
    const std::uint32_t bit = graphs_[B]->GetBit(netB);
    if (bit == None) {
        return None;
    }
    const SignalRow& signal = graphs_[B]->GetSignalOfBit(bit);
    const auto row = static_cast<std::uint32_t>(&signal - graphs_[B]->GetSignals().data());
    index = bit - signal.first;
    return IsFree(B, row) ? row : None;
}

std::uint64_t Pairing::HashUnwired(Design design, std::uint32_t row) const {
    std::uint64_t hash = Row(design, row).count;
    for (std::uint32_t i = 0; i < Row(design, row).count; ++i) {
        const std::uint32_t net = Net(design, row, i);
        hash = Mix(hash, net == Open ? None : graphs_[design]->GetTie(net));
    }
    return hash;
}

void Pairing::PairUnwired() {
    std::unordered_map<std::uint64_t, std::vector<std::uint32_t>> rowsB;
    for (std::uint32_t row = 0; row < partner_[B].size(); ++row) {
        if (IsFree(B, row) && !IsWired(B, row)) {
            rowsB[HashUnwired(B, row)].push_back(row);
        }
    }
    if (rowsB.empty()) {
        return;
    }
    std::unordered_map<std::uint64_t, std::size_t> next;
    for (std::uint32_t row = 0; row < partner_[A].size(); ++row) {
        if (!IsFree(A, row) || IsWired(A, row)) {
            continue;
        }
        const std::uint64_t hash = HashUnwired(A, row);
        const auto found = rowsB.find(hash);
        if (found != rowsB.end() && next[hash] < found->second.size()) {
            Pair(row, found->second[next[hash]++], true);
        }
    }
}

/// Tells what became of the bits of a signal without a partner.
void Pairing::Split(std::uint32_t rowA) {
    if (partner_[A][rowA] != None || !Counts(A, rowA)) {
        return;
    }
    const SignalRow& signal = Row(A, rowA);
    const std::size_t before = result_.bits.size();
    std::vector<SignalPairs::Part> lost;
    for (std::uint32_t i = 0; i < signal.count; ++i) {
        const std::uint32_t net = Net(A, rowA, i);
        std::uint32_t index = 0;
        const bool isMatched =
            net != Open && net >= Graph::FirstNet && matching_.nets[A][net] != None;
        const std::uint32_t other = isMatched ? FindFreeRow(matching_.nets[A][net], index) : None;
        if (other != None) {
            result_.bits.push_back({{{rowA, i}, {other, index}}});
        } else if (net != Open && graphs_[A]->IsWired(net)) {
            lost.push_back({rowA, i});
        }
    }
    if (result_.bits.size() == before) {
        result_.left[A].push_back({rowA, SignalPairs::Part::Whole});
    } else {
        result_.left[A].insert(result_.left[A].end(), lost.begin(), lost.end());
    }
}

void Pairing::ListAdded(std::uint32_t rowB) {
    if (partner_[B][rowB] != None || !Counts(B, rowB)) {
        return;
    }
    std::vector<SignalPairs::Part> lost;
    bool isPartly = false;
    for (std::uint32_t i = 0; i < Row(B, rowB).count; ++i) {
        const std::uint32_t net = Net(B, rowB, i);
        const std::uint32_t netA =
            net == Open || net < Graph::FirstNet ? None : matching_.nets[B][net];
        std::uint32_t bit = netA == None ? None : graphs_[A]->GetBit(netA);
        if (bit != None) {
            const SignalRow& signal = graphs_[A]->GetSignalOfBit(bit);
            const auto row = static_cast<std::uint32_t>(&signal - graphs_[A]->GetSignals().data());
            bit = IsFree(A, row) ? bit : None;
        }
        if (bit != None) {
            isPartly = true;
        } else if (net != Open && graphs_[B]->IsWired(net)) {
            lost.push_back({rowB, i});
        }
    }
    if (isPartly && !Row(B, rowB).isPort) {
        result_.left[B].insert(result_.left[B].end(), lost.begin(), lost.end());
    } else {
        result_.left[B].push_back({rowB, SignalPairs::Part::Whole});
    }
}

} // namespace

SignalPairs PairSignals(const Graph& a, const Graph& b, const Matching& matching, bool byNames,
                        bool mergesNets) {
    return Pairing(a, b, matching, byNames, mergesNets).Run();
}

} // namespace Tool::Diff
