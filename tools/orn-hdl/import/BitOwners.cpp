#include "import/BitOwners.h"

#include "import/NameRules.h"
#include "import/Spelling.h"

#include <algorithm>
#include <cstddef>
#include <utility>

namespace Tool::Import {

namespace {

/// Names of the signals that carry constants.
constexpr std::string_view ConstantNames[] = {"const_0", "const_1", "const_x"};

bool OwnsBit(const ModulePort& port, const BitUse& use) noexcept {
    switch (port.direction) {
    case Direction::Input:
        return !use.inout;
    case Direction::Output:
        return !use.inout && !use.input && use.outputs != UseCount::Many;
    default:
        return true;
    }
}

} // namespace

BitOwners BitOwners::Choose(const Module& top, const BitUses& uses,
                            const std::vector<std::string>& portNames, const NameRules& rules,
                            Warnings& warnings) {
    BitOwners owners(top);
    owners.FindCandidates(rules);
    for (std::size_t p = 0; p < top.ports.size(); ++p) {
        owners.AddPort(top.ports[p], portNames[p], uses, warnings);
    }
    owners.AddNets(owners.publicNets_, uses);
    owners.AddSharedOutputs(uses);
    owners.AddNets(owners.hiddenNets_, uses);
    owners.AddNamelessBits(uses);
    return owners;
}

void BitOwners::FindCandidates(const NameRules& rules) {
    for (const ModulePort& port : top_.ports) {
        portNets_.emplace(port.name, nullptr);
    }
    for (const Net& net : top_.nets) {
        const auto port = portNets_.find(net.name);
        if (port != portNets_.end()) {
            port->second = &net;
        } else {
            (net.hidden ? hiddenNets_ : publicNets_).push_back({&net, !rules.IsLegal(net.name)});
        }
    }
    // A name that can stay is best; a wide net keeps buses together.
    const auto isBetter = [](const Candidate& a, const Candidate& b) {
        return a.illegal != b.illegal ? b.illegal : a.net->bits.count > b.net->bits.count;
    };
    std::stable_sort(publicNets_.begin(), publicNets_.end(), isBetter);
    std::stable_sort(hiddenNets_.begin(), hiddenNets_.end(), isBetter);
}

void BitOwners::SetOwner(Bit bit, std::uint32_t index, std::uint32_t position) {
    owners_[bit] = BitOwner{index, position};
    ImportedSignal& signal = signals_[index];
    signal.lowest = std::min(signal.lowest, position);
    signal.highest = std::max(signal.highest, position);
}

void BitOwners::AddPort(const ModulePort& port, const std::string& name, const BitUses& uses,
                        Warnings& warnings) {
    const auto index = static_cast<std::uint32_t>(signals_.size());
    ImportedSignal& signal = signals_.emplace_back();
    signal.name = name.empty() ? port.name : name;
    named_.push_back(!name.empty());
    signal.port = &port;
    signal.net = portNets_.find(port.name)->second;
    signal.width = port.bits.count;
    BitRange range = port.range;
    if (range.offset == 0 && !range.upto && signal.net != nullptr) {
        // Older files give the range with the net only.
        range = signal.net->range;
    }
    signal.range = Normalize(range, signal.width);
    if (signal.range.offset != range.offset) {
        warnings.Add(top_.GetPath("ports", port.name),
                     "indices below 0, or beyond 32 bits, cannot be written; counted from 0");
    }
    const bool isOwner = !NameRules::IsEscaped(name);
    for (std::uint32_t i = 0; isOwner && i < port.bits.count; ++i) {
        const Bit bit = top_.GetBit(port.bits, i);
        if (IsNet(bit) && OwnsBit(port, uses.Get(bit))) {
            SetOwner(bit, index, i);
        }
    }
    signal.lowest = 0;
    signal.highest = signal.width - 1;
}

void BitOwners::AddSignal(ImportedSignal signal, const Span& bits, const BitUses& uses) {
    const auto index = static_cast<std::uint32_t>(signals_.size());
    signals_.push_back(std::move(signal));
    Bit last = Zero;
    for (std::uint32_t i = 0; i < bits.count; ++i) {
        const Bit bit = top_.GetBit(bits, i);
        if (IsNet(bit) && uses.Get(bit).needed && owners_[bit].signal == BitOwner::NoSignal) {
            SetOwner(bit, index, i);
            last = bit;
        }
    }
    ImportedSignal& added = signals_.back();
    if (last == Zero) {
        signals_.pop_back();
    } else if (added.lowest == added.highest && added.width > 1) {
        // One bit is left of the bus.
        added.name.append("_").append(
            std::to_string(GetIndex(added.range, added.width, added.lowest)));
        added.range = BitRange();
        added.width = 1;
        added.lowest = 0;
        added.highest = 0;
        owners_[last].position = 0;
    }
}

void BitOwners::AddNets(const std::vector<Candidate>& candidates, const BitUses& uses) {
    for (const Candidate& candidate : candidates) {
        ImportedSignal signal;
        signal.name = candidate.net->name;
        signal.net = candidate.net;
        signal.width = candidate.net->bits.count;
        signal.range = Normalize(candidate.net->range, signal.width);
        AddSignal(std::move(signal), candidate.net->bits, uses);
    }
}

void BitOwners::AddSharedOutputs(const BitUses& uses) {
    for (std::size_t p = 0; p < top_.ports.size(); ++p) {
        ImportedSignal signal;
        signal.name.append(top_.ports[p].name).append("_net");
        signal.width = signals_[p].width;
        signal.range = signals_[p].range;
        AddSignal(std::move(signal), top_.ports[p].bits, uses);
    }
}

std::uint32_t BitOwners::AddScalar(std::string_view name) {
    ImportedSignal& signal = signals_.emplace_back();
    signal.name = name;
    signal.lowest = 0;
    return static_cast<std::uint32_t>(signals_.size() - 1);
}

void BitOwners::AddNamelessBits(const BitUses& uses) {
    for (Bit bit = 0; bit < top_.netBits; ++bit) {
        if (uses.Get(bit).needed && owners_[bit].signal == BitOwner::NoSignal) {
            owners_[bit] = BitOwner{AddScalar("net_" + std::to_string(bit)), 0};
        }
    }
}

void BitOwners::ClaimLegalNames(UniqueNames& names) {
    named_.resize(signals_.size());
    for (std::size_t i = 0; i < signals_.size(); ++i) {
        named_[i] = named_[i] || names.ClaimLegal(signals_[i].name);
    }
}

void BitOwners::ClaimOtherNames(UniqueNames& names) {
    for (std::size_t i = 0; i < named_.size(); ++i) {
        if (!named_[i]) {
            signals_[i].name = names.ClaimSimilar(signals_[i].name, 'n');
        }
    }
}

void BitOwners::NeedConstant(Bit bit, UniqueNames& names) {
    std::uint32_t& constant = constants_[bit - Zero];
    if (constant == BitOwner::NoSignal) {
        constant = AddScalar(names.ClaimSimilar(ConstantNames[bit - Zero], 'n'));
    }
}

} // namespace Tool::Import
