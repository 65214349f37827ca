#include "diff/Matching.h"

#include "diff/Names.h"
#include "diff/Structure.h"

#include "Orn_Hdl/Model.h"
#include "Port/Ascii.h"

#include <string_view>

namespace Tool::Diff {

namespace {

std::string_view PlainName(const SignalRow& row) noexcept {
    return WithoutEscape(row.signal->GetNameView());
}

/// Finds the rows of a table by name. \param count the number of rows. \param nameOf the name of a
/// row.
template <class NameOf> class RowsByName {
public:
    RowsByName(std::size_t count, const NameOf& nameOf) : nameOf_(nameOf), table_(count) {
        for (std::uint32_t row = 0; row < count; ++row) {
            table_.Add(HashName(nameOf_(row)), row);
        }
    }
    std::uint32_t Find(std::string_view name) const {
        return table_.Find(HashName(name), [&](std::uint32_t row) {
            return Port::EqualIgnoringCase(nameOf_(row), name);
        });
    }

private:
    const NameOf nameOf_;
    IndexTable table_;
};

/// Pairs the rows of two tables by the same name; what has a pair already stays as it is.
template <class NameA, class NameB>
void PairByName(std::array<std::vector<std::uint32_t>, 2>& pairs, std::size_t countA,
                const NameA& nameA, std::size_t countB, const NameB& nameB) {
    const RowsByName<NameB> rows(countB, nameB);
    for (std::uint32_t row = 0; row < countA; ++row) {
        if (pairs[A][row] == None) {
            const std::uint32_t found = rows.Find(nameA(row));
            if (found != None && pairs[B][found] == None) {
                pairs[A][row] = found;
                pairs[B][found] = row;
            }
        }
    }
}

/// Signals have the same name if the whole of it is the same, or else its part before the range.
void PairSignals(const Graph& a, const Graph& b, Matching& matching) {
    const std::vector<SignalRow>& rowsA = a.GetSignals();
    const std::vector<SignalRow>& rowsB = b.GetSignals();
    const auto whole = [](const std::vector<SignalRow>& rows) {
        return [&rows](std::uint32_t row) { return PlainName(rows[row]); };
    };
    const auto base = [](const std::vector<SignalRow>& rows) {
        return [&rows](std::uint32_t row) { return GetBase(PlainName(rows[row])); };
    };
    PairByName(matching.signals, rowsA.size(), whole(rowsA), rowsB.size(), whole(rowsB));
    PairByName(matching.signals, rowsA.size(), base(rowsA), rowsB.size(), base(rowsB));
}

/// Matches the nets of signals of the same name, bit by bit. \param isPort whether of ports or of
/// others. \param onlyWired whether to match only nets to which something is wired: where nets have
/// several names, some of these may stand for nothing.
void MatchNets(const Graph& a, const Graph& b, bool isPort, bool onlyWired, Matching& matching) {
    for (std::uint32_t row = 0; row < a.GetSignals().size(); ++row) {
        const std::uint32_t other = matching.signals[A][row];
        if (other == None) {
            continue;
        }
        const SignalRow& inA = a.GetSignals()[row];
        const SignalRow& inB = b.GetSignals()[other];
        if ((inA.isPort && inB.isPort) != isPort || inA.isGenerated || inB.isGenerated) {
            continue;
        }
        for (std::uint32_t i = 0; i < inA.count; ++i) {
            const std::uint32_t bit = Graph::FindBit(inA, i, inB);
            const std::uint32_t netA = a.GetNet(inA.first + i);
            const std::uint32_t netB = bit == None ? Open : b.GetNet(bit);
            if (netA != Open && netB != Open && matching.nets[A][netA] == None &&
                matching.nets[B][netB] == None &&
                (!onlyWired || (a.IsWired(netA) && b.IsWired(netB)))) {
                matching.MatchNets(netA, netB);
            }
        }
    }
}

void MatchInstances(const Graph& a, const Graph& b, Matching& matching) {
    const auto nameOf = [](const Graph& graph) {
        return [&graph](std::uint32_t row) {
            return WithoutEscape(graph.GetInstances()[row].instance->GetNameView());
        };
    };
    PairByName(matching.instances, a.GetInstanceCount(), nameOf(a), b.GetInstanceCount(),
               nameOf(b));
}

/// Matches the bits of aliases whose nets are matched.
void MatchAliases(const Graph& a, const Graph& b, Matching& matching) {
    const std::vector<InstanceRow>& rowsB = b.GetInstances();
    const auto netsOf = [](const Graph& graph, std::uint32_t row) {
        const std::uint32_t first = graph.GetInstances()[row].first;
        return std::pair(graph.GetPinNets()[first], graph.GetPinNets()[first + 1]);
    };
    IndexTable table(rowsB.size() - b.GetInstanceCount());
    for (std::uint32_t row = b.GetInstanceCount(); row < rowsB.size(); ++row) {
        const auto nets = netsOf(b, row);
        table.Add(Mix(nets.first, nets.second), row);
    }
    for (std::uint32_t row = a.GetInstanceCount(); row < a.GetInstances().size(); ++row) {
        const auto nets = netsOf(a, row);
        const std::pair wanted(matching.nets[A][nets.first], matching.nets[A][nets.second]);
        const std::uint32_t found =
            table.Find(Mix(wanted.first, wanted.second), [&](std::uint32_t at) {
                return matching.instances[B][at] == None && netsOf(b, at) == wanted;
            });
        if (found != None) {
            matching.MatchInstances(row, found);
        }
    }
}

} // namespace

Matching::Matching(const Graph& a, const Graph& b) {
    for (const Design design : {A, B}) {
        const Graph& graph = design == A ? a : b;
        nets[design].assign(graph.GetNetCount(), None);
        instances[design].assign(graph.GetInstances().size(), None);
        signals[design].assign(graph.GetSignals().size(), None);
    }
    for (std::uint32_t net = 0; net < Graph::FirstNet; ++net) {
        MatchNets(net, net);
    }
}

Matching Match(const Graph& a, const Graph& b, const Likeness (&likeness)[2], bool byNames,
               bool mergesNets) {
    Matching matching(a, b);
    PairSignals(a, b, matching);
    MatchNets(a, b, true, false, matching);
    if (!byNames) {
        Structure(a, b, likeness, matching).Run();
    }
    MatchNets(a, b, false, mergesNets, matching);
    MatchInstances(a, b, matching);
    MatchAliases(a, b, matching);
    Structure(a, b, likeness, matching).Run();
    return matching;
}

} // namespace Tool::Diff
