#include "diff/Graph.h"

#include "diff/Names.h"

#include "Orn_Hdl/Model.h"
#include "Orn_Hdl/Options.h"
#include "Port/Ascii.h"

#include <algorithm>
#include <charconv>
#include <new>
#include <string_view>

namespace Tool::Diff {

namespace {

using Orn_Hdl::Signal;

bool IsCompound(const Signal& signal) {
    return signal.GetSignalType() == Orn_Hdl::SignalTypeCompoundBus;
}

const Signal* GetParent(const Signal& signal) {
    const int type = signal.GetSignalType();
    return type == Orn_Hdl::SignalTypeBusSlice || type == Orn_Hdl::SignalTypeBusIndex
               ? static_cast<const Orn_Hdl::BusPart&>(signal).GetParentBus()
               : nullptr;
}

bool ReadNumber(std::string_view text, std::int64_t& number) {
    if (!text.empty() && text.front() == '+') {
        text.remove_prefix(1);
    }
    const auto read = std::from_chars(text.data(), text.data() + text.size(), number);
    return read.ec == std::errc() && read.ptr == text.data() + text.size();
}

/// The indices at the end of a name; of D(3), both are 3.
bool ReadRange(std::string_view name, std::int64_t& left, std::int64_t& right) {
    const std::size_t open = name.find('(');
    if (open == std::string_view::npos || name.back() != ')') {
        return false;
    }
    const std::string_view inside = name.substr(open + 1, name.size() - open - 2);
    const std::size_t colon = std::min(inside.find(':'), inside.size());
    std::int64_t from = 0;
    std::int64_t to = 0;
    if (!ReadNumber(inside.substr(0, colon), from) ||
        !ReadNumber(inside.substr(colon == inside.size() ? 0 : colon + 1), to)) {
        return false;
    }
    left = from;
    right = to;
    return true;
}

std::int64_t GetDistance(std::int64_t a, std::int64_t b) noexcept {
    return a < b ? b - a : a - b;
}

bool HasEnd(std::string_view name, std::string_view end) {
    return name.size() >= end.size() &&
           Port::EqualIgnoringCase(name.substr(name.size() - end.size()), end);
}

/// "const_0" and "const_1", perhaps with a number behind them, are nets that stand for constants
/// in concatenations of netlists that were read.
bool IsReadConstant(std::string_view base) {
    const std::string_view name = base.substr(0, 7);
    const std::string_view rest = base.substr(name.size());
    return (name == "const_0" || name == "const_1" || name == "const_x") &&
           (rest.empty() ||
            (rest.front() == '_' &&
             std::all_of(rest.begin() + 1, rest.end(), [](char c) { return Port::IsDigit(c); })));
}

bool IsDummyOf(const Signal& signal, const Signal& other) {
    return !IsCompound(signal) && other.GetPortPolarity().IsValid() &&
           !signal.GetPortPolarity().IsValid() &&
           Port::EqualIgnoringCase(other.GetDummySignalName().GetView(), signal.GetNameView());
}

/// The value of a digit; 99 for any other character.
unsigned GetDigit(char c) noexcept {
    const char small = Port::ToLower(c);
    return Port::IsDigit(c)               ? static_cast<unsigned>(c - '0')
           : small >= 'a' && small <= 'f' ? static_cast<unsigned>(small - 'a') + 10
                                          : 99U;
}

/// A digit of a constant, and each of its bits.
constexpr char DontCare = '-';

/// The bits of a literal; empty if a character is no digit of its base.
std::string ReadDigits(std::string_view digits, unsigned base) {
    const unsigned perDigit = base == 16 ? 4 : base == 8 ? 3 : 1;
    std::string bits;
    for (const char c : digits) {
        const unsigned digit = GetDigit(c);
        if (c == DontCare) {
            bits.append(perDigit, c);
            continue;
        }
        if (c == '_' && !bits.empty()) {
            continue;
        }
        if (digit >= base) {
            return {};
        }
        for (unsigned bit = perDigit; bit-- > 0;) {
            bits += ((digit >> bit) & 1U) != 0 ? '1' : '0';
        }
    }
    return bits;
}

/// The rightmost bits of a number.
std::string Resize(const std::string& bits, std::size_t width) {
    return bits.size() >= width ? bits.substr(bits.size() - width)
                                : std::string(width - bits.size(), '0') + bits;
}

} // namespace

std::vector<std::uint32_t> GetTies(const Orn_Hdl::BitVectorValue& value, std::size_t width) {
    const std::string_view digits = value.GetValue().GetView();
    std::string bits = ReadDigits(digits, static_cast<unsigned>(value.GetBase()));
    if (!value.HasBaseAndLength() && bits.size() != width) {
        bits.clear();
    }
    std::vector<std::uint32_t> ties;
    ties.reserve(width);
    if (!bits.empty()) {
        if (value.HasBaseAndLength() && value.GetLength() > 0 &&
            value.GetLength() < int(MostBits)) {
            bits = Resize(bits, static_cast<std::size_t>(value.GetLength()));
        }
        for (const char bit : Resize(bits, width)) {
            ties.push_back(bit == '1'        ? Graph::TiedToOne
                           : bit == DontCare ? Graph::TiedToDontCare
                                             : Graph::TiedToZero);
        }
        return ties;
    }
    const std::uint64_t whole = Mix(HashName(digits), static_cast<std::uint64_t>(value.GetBase()));
    for (std::size_t i = 0; i < width; ++i) {
        ties.push_back(static_cast<std::uint32_t>(Mix(whole, i)) | 4U);
    }
    return ties;
}

Graph::Graph(const Orn_Hdl::Netlist& netlist, Design design, Components& components,
             const Rules& rules)
    : design_(design), components_(components), rules_(rules) {
    AddSignals(netlist);
    ties_.assign(nets_.size(), Untied);
    for (const Signal* signal : netlist.GetSignalIterator()) {
        TakeConstant(*signal);
    }
    MarkGenerated();
    for (const Signal* signal : netlist.GetSignalIterator()) {
        JoinAliases(*signal);
    }
    MakeNets();
    for (const Orn_Hdl::Instance* instance : netlist.GetInstanceIterator()) {
        AddInstance(*instance);
    }
    instanceCount_ = static_cast<std::uint32_t>(instances_.size());
    if (!rules_.mergesNets) {
        for (const Signal* target : netlist.GetSignalIterator()) {
            for (const Signal* source : target->GetSignalIterator()) {
                AddAlias(*target, *source);
            }
        }
    }
    isWired_.assign(ties_.size(), 0);
    for (const std::uint32_t net : pinNets_) {
        if (net != Open) {
            isWired_[net] = 1;
        }
    }
    all_ = {};
    runs_ = {};
    table_ = IndexTable();
}

void Graph::AddSignals(const Orn_Hdl::Netlist& netlist) {
    std::size_t count = 0;
    for (const Signal* signal : netlist.GetSignalIterator()) {
        count += IsCompound(*signal) ? 0 : 1;
    }
    table_ = IndexTable(count);
    all_.reserve(count);
    runs_.reserve(count);
    for (const Signal* signal : netlist.GetSignalIterator()) {
        if (!IsCompound(*signal) && GetParent(*signal) == nullptr) {
            AddDeclared(*signal);
        }
    }
    for (const Signal* signal : netlist.GetSignalIterator()) {
        if (!IsCompound(*signal) && GetParent(*signal) != nullptr) {
            AddPart(*signal);
        }
    }
}

void Graph::Enter(const Signal& signal, const Run& run) {
    table_.Add(HashPointer(&signal), static_cast<std::uint32_t>(all_.size()));
    all_.push_back(&signal);
    runs_.push_back(run);
}

void Graph::AddDeclared(const Signal& signal) {
    SignalRow row;
    row.signal = &signal;
    row.first = static_cast<std::uint32_t>(nets_.size());
    row.isPort = signal.GetPortPolarity().IsValid();
    if (signal.GetSignalType() == Orn_Hdl::SignalTypeBus &&
        ReadRange(signal.GetNameView(), row.left, row.right)) {
        row.isBus = true;
        row.count = CountBits(GetDistance(row.left, row.right) + 1);
    }
    if (nets_.size() + row.count >= None) {
        throw std::bad_alloc();
    }
    for (std::uint32_t i = 0; i < row.count; ++i) {
        nets_.push_back(row.first + i);
    }
    signals_.push_back(row);
    Enter(signal, {row.first, row.count, false});
}

void Graph::AddPart(const Signal& signal) {
    const SignalRow* const parent = FindRow(*GetParent(signal));
    std::int64_t left = 0;
    std::int64_t right = 0;
    if (parent == nullptr || !ReadRange(signal.GetNameView(), left, right)) {
        AddDeclared(signal);
        return;
    }
    if (parent->count == 1) {
        // A bus of one bit, or one that is too wide to be told apart bit by bit.
        Enter(signal, {parent->first, 1, false});
        return;
    }
    const bool ascends = parent->left < parent->right;
    const std::int64_t from = ascends ? left - parent->left : parent->left - left;
    const std::int64_t to = ascends ? right - parent->left : parent->left - right;
    if (from < 0 || to < 0 || from >= parent->count || to >= parent->count) {
        AddDeclared(signal);
        return;
    }
    Enter(signal, {parent->first + static_cast<std::uint32_t>(from),
                   static_cast<std::uint32_t>(GetDistance(from, to)) + 1, to < from});
}

const Graph::Run* Graph::FindRun(const Signal& signal) const noexcept {
    const std::uint32_t found =
        table_.Find(HashPointer(&signal), [&](std::uint32_t at) { return all_[at] == &signal; });
    return found == None ? nullptr : &runs_[found];
}

/// Declared signals are entered before all others, so they have the numbers of their rows.
SignalRow* Graph::FindRow(const Signal& signal) {
    const std::uint32_t found =
        table_.Find(HashPointer(&signal), [&](std::uint32_t at) { return all_[at] == &signal; });
    return found >= signals_.size() || signals_[found].signal != &signal ? nullptr
                                                                         : &signals_[found];
}

void Graph::ListBits(const Signal& signal) {
    bits_.clear();
    AppendBits(signal);
}

void Graph::AppendBits(const Signal& signal) {
    if (IsCompound(signal)) {
        for (const Signal* member :
             static_cast<const Orn_Hdl::CompoundBus&>(signal).GetBusMemberIterator()) {
            AppendBits(*member);
        }
        return;
    }
    if (const Run* const run = FindRun(signal)) {
        for (std::uint32_t i = 0; i < run->count && bits_.size() < std::size_t(2) * MostBits; ++i) {
            bits_.push_back(run->isReversed ? run->first - i : run->first + i);
        }
    }
}

void Graph::TakeConstant(const Signal& signal) {
    const Orn_Hdl::BitVectorValue& value = signal.GetConstantValue();
    if (value.GetValue().IsEmpty()) {
        return;
    }
    ListBits(signal);
    const std::vector<std::uint32_t> ties = GetTies(value, bits_.size());
    for (std::size_t i = 0; i < bits_.size(); ++i) {
        ties_[bits_[i]] = ties[i];
    }
}

/// What the library, and what reads netlists, name themselves.
void Graph::MarkGenerated() {
    for (SignalRow& row : signals_) {
        if (row.isPort) {
            continue;
        }
        const std::string_view base = GetBase(row.signal->GetNameView());
        const bool isTied = ties_[row.first] != Untied;
        row.isGenerated = HasEnd(base, "_openSignal") || Port::EqualIgnoringCase(base, "open") ||
                          (isTied && (HasEnd(base, "_CONST_SIGNAL") || IsReadConstant(base)));
    }
}

std::uint32_t Graph::FindRoot(std::uint32_t bit) noexcept {
    while (nets_[bit] != bit) {
        nets_[bit] = nets_[nets_[bit]];
        bit = nets_[bit];
    }
    return bit;
}

void Graph::JoinAliases(const Signal& target) {
    for (const Signal* source : target.GetSignalIterator()) {
        const bool isDummy = IsDummyOf(*source, target) || IsDummyOf(target, *source);
        if (!isDummy && !rules_.mergesNets) {
            continue;
        }
        if (isDummy) {
            const Signal& dummy = IsDummyOf(*source, target) ? *source : target;
            const Signal* const parent = GetParent(dummy);
            if (SignalRow* const row = FindRow(parent != nullptr ? *parent : dummy)) {
                row->isGenerated = true;
            }
        }
        ListBits(*source);
        otherBits_.swap(bits_);
        ListBits(target);
        const std::size_t count = std::min(bits_.size(), otherBits_.size());
        for (std::size_t i = 1; i <= count; ++i) {
            const std::uint32_t a = FindRoot(bits_[bits_.size() - i]);
            const std::uint32_t b = FindRoot(otherBits_[otherBits_.size() - i]);
            const std::uint32_t root = std::min(a, b);
            const std::uint32_t tie = std::max(ties_[a], ties_[b]);
            nets_[std::max(a, b)] = root;
            ties_[root] = tie;
        }
    }
}

/// Whether a tied net is no net but the constant itself.
bool Graph::IsConstantNet(const SignalRow& row, std::uint32_t tie) const {
    return (row.isGenerated || rules_.mergesNets) && tie >= TiedToZero && tie <= TiedToDontCare;
}

void Graph::MakeNets() {
    std::vector<std::uint32_t> ties = {TiedToZero, TiedToOne, TiedToDontCare};
    std::vector<std::uint32_t> netOfRoot(nets_.size(), None);
    std::vector<std::uint8_t> hasPort(nets_.size(), 0);
    bitOfNet_ = {None, None, None};
    isPort_ = {0, 0, 0};
    for (const SignalRow& row : signals_) {
        for (std::uint32_t i = 0; row.isPort && i < row.count; ++i) {
            hasPort[FindRoot(row.first + i)] = 1;
        }
    }
    for (const SignalRow& row : signals_) {
        const std::string_view base = GetBase(row.signal->GetNameView());
        const bool isOpen = row.isGenerated &&
                            (HasEnd(base, "_openSignal") || Port::EqualIgnoringCase(base, "open"));
        for (std::uint32_t i = 0; i < row.count; ++i) {
            const std::uint32_t root = FindRoot(row.first + i);
            std::uint32_t& net = netOfRoot[root];
            if (net == None && isOpen) {
                continue;
            }
            if (net == None && (hasPort[root] == 0 || rules_.mergesNets) &&
                IsConstantNet(row, ties_[root])) {
                net = ties_[root] == TiedToOne    ? OneNet
                      : ties_[root] == TiedToZero ? ZeroNet
                                                  : DontCareNet;
            } else if (net == None) {
                net = static_cast<std::uint32_t>(ties.size());
                ties.push_back(ties_[root]);
                bitOfNet_.push_back(row.first + i);
                isPort_.push_back(hasPort[root]);
            }
        }
    }
    for (std::uint32_t bit = 0; bit < nets_.size(); ++bit) {
        nets_[bit] = FindRoot(bit);
    }
    for (std::uint32_t& net : nets_) {
        net = netOfRoot[net];
    }
    ties_ = std::move(ties);
}

void Graph::AddInstance(const Orn_Hdl::Instance& instance) {
    InstanceRow row;
    row.instance = &instance;
    row.component = components_.Find(design_, instance.GetComponent());
    row.first = static_cast<std::uint32_t>(pinNets_.size());
    PairedComponent& component = components_.Get(row.component);
    ++component.instances[design_];
    if (pinNets_.size() + component.width >= None) {
        throw std::bad_alloc();
    }
    pinNets_.resize(pinNets_.size() + component.width, Open);
    std::uint32_t expected = 0;
    for (const Orn_Hdl::Pin* pin : instance.GetPinIterator()) {
        const std::uint32_t at =
            components_.FindPin(row.component, design_, pin->GetNameView(), expected);
        if (at == None) {
            continue;
        }
        expected = at + 1;
        if (pin->GetSignal() == nullptr) {
            continue;
        }
        PairedPin& paired = component.pins[at];
        ListBits(*pin->GetSignal());
        const auto count = std::min<std::size_t>(bits_.size(), paired.width);
        for (std::size_t i = 1; i <= count; ++i) {
            const std::uint32_t net = nets_[bits_[bits_.size() - i]];
            pinNets_[row.first + paired.first + paired.width - i] = net;
            paired.isUsed[design_] = paired.isUsed[design_] || net != Open;
        }
    }
    instances_.push_back(row);
}

void Graph::AddAlias(const Signal& target, const Signal& source) {
    ListBits(source);
    otherBits_.swap(bits_);
    ListBits(target);
    const std::size_t count = std::min(bits_.size(), otherBits_.size());
    for (std::size_t i = 0; i < count; ++i) {
        const std::uint32_t driven = nets_[bits_[bits_.size() - count + i]];
        const std::uint32_t driving = nets_[otherBits_[otherBits_.size() - count + i]];
        if (driven == driving || driven == Open || driving == Open) {
            continue;
        }
        InstanceRow row;
        row.component = static_cast<std::uint32_t>(components_.GetAll().size());
        row.first = static_cast<std::uint32_t>(pinNets_.size());
        pinNets_.push_back(driven);
        pinNets_.push_back(driving);
        instances_.push_back(row);
        aliases_.push_back({&target, &source});
    }
}

std::uint32_t Graph::FindBit(const SignalRow& from, std::uint32_t index,
                             const SignalRow& to) noexcept {
    if (from.count == 1 && to.count == 1) {
        return to.first;
    }
    const std::int64_t bit = from.left < from.right ? from.left + index : from.left - index;
    const std::int64_t at = to.left < to.right ? bit - to.left : to.left - bit;
    return at >= 0 && at < to.count ? to.first + static_cast<std::uint32_t>(at) : None;
}

const SignalRow& Graph::GetSignalOfBit(std::uint32_t bit) const noexcept {
    const auto next = std::upper_bound(
        signals_.begin(), signals_.end(), bit,
        [](std::uint32_t wanted, const SignalRow& row) { return wanted < row.first; });
    return *(next - 1);
}

std::string Graph::GetBitName(const SignalRow& row, std::uint32_t index) {
    const std::string_view name = row.signal->GetNameView();
    if (!row.isBus || row.count == 1) {
        return std::string(name);
    }
    const std::int64_t bit = row.left < row.right ? row.left + index : row.left - index;
    return std::string(GetBase(name)).append("(").append(std::to_string(bit)).append(")");
}

} // namespace Tool::Diff
