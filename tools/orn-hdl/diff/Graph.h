// A design as nets of one bit and what is wired to them.
#pragma once

#include "diff/Components.h"
#include "diff/Rules.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace Orn_Hdl {
class BitVectorValue;
class Instance;
class Netlist;
class Signal;
} // namespace Orn_Hdl

namespace Tool::Diff {

/// The net of an open pin.
inline constexpr std::uint32_t Open = None;

/// A scalar signal or a bus.
struct SignalRow {
    const Orn_Hdl::Signal* signal = nullptr;
    /// Its leftmost bit among the bits of the design, and their number.
    std::uint32_t first = 0;
    std::uint32_t count = 1;
    /// The indices at both ends of its range.
    std::int64_t left = 0;
    std::int64_t right = 0;
    bool isBus = false;
    bool isPort = false;
    /// Whether it was made for a pin or a port: the carrier of a pin's constant, a dummy signal, or
    /// the signal of an open pin. Such a signal stands for what it was made for.
    bool isGenerated = false;
};

/// An instance, or one bit of an alias.
struct InstanceRow {
    /// Null for an alias.
    const Orn_Hdl::Instance* instance = nullptr;
    /// The component, as `Components` numbers it; its number behind all of them for an alias.
    std::uint32_t component = 0;
    /// The first of its bits among those of all pins.
    std::uint32_t first = 0;
};

/// The signals of an alias: the second one drives the first.
struct AliasRow {
    const Orn_Hdl::Signal* target = nullptr;
    const Orn_Hdl::Signal* source = nullptr;
};

/// A bit of a bus is a net as a scalar signal is, so a bus that is wired as a whole is the same as
/// one that is wired bit by bit.
///
/// An alias of two nets is like an instance of one component with two pins, the driven net and the
/// driving one; where `Rules::mergesNets` is true, it makes one net of them. A dummy signal is
/// always one net with its port.
class Graph {
public:
    /// \{
    /// The nets of pins that are tied to 0, to 1 or to a don't care without a net that somebody
    /// named.
    static constexpr std::uint32_t ZeroNet = 0;
    static constexpr std::uint32_t OneNet = 1;
    static constexpr std::uint32_t DontCareNet = 2;
    static constexpr std::uint32_t FirstNet = 3;
    /// \}

    /// \{
    /// What a net is tied to. Other values stand for what is none of these.
    static constexpr std::uint32_t Untied = 0;
    static constexpr std::uint32_t TiedToZero = 1;
    static constexpr std::uint32_t TiedToOne = 2;
    static constexpr std::uint32_t TiedToDontCare = 3;
    /// \}

    /// \param components notes which pins are wired.
    Graph(const Orn_Hdl::Netlist& netlist, Design design, Components& components,
          const Rules& rules);

    const std::vector<SignalRow>& GetSignals() const noexcept { return signals_; }
    /// The instances, and behind them the bits of aliases.
    const std::vector<InstanceRow>& GetInstances() const noexcept { return instances_; }
    std::uint32_t GetInstanceCount() const noexcept { return instanceCount_; }
    const AliasRow& GetAlias(std::uint32_t row) const noexcept {
        return aliases_[row - instanceCount_];
    }
    /// The net of each bit of each pin of each instance; `Open` for none.
    const std::vector<std::uint32_t>& GetPinNets() const noexcept { return pinNets_; }
    /// How many bits the pins of an instance have.
    std::uint32_t GetWidth(std::uint32_t row) const noexcept {
        return (row + 1 < instances_.size() ? instances_[row + 1].first
                                            : static_cast<std::uint32_t>(pinNets_.size())) -
               instances_[row].first;
    }
    std::uint32_t GetNetCount() const noexcept { return static_cast<std::uint32_t>(ties_.size()); }
    /// The net of a bit.
    std::uint32_t GetNet(std::uint32_t bit) const noexcept { return nets_[bit]; }
    /// What a net is tied to.
    std::uint32_t GetTie(std::uint32_t net) const noexcept { return ties_[net]; }
    /// Whether a net has a bit of a port.
    bool IsPort(std::uint32_t net) const noexcept { return isPort_[net] != 0; }
    /// Whether a pin or an alias is at a net.
    bool IsWired(std::uint32_t net) const noexcept { return isWired_[net] != 0; }
    /// The name of a bit of a signal.
    static std::string GetBitName(const SignalRow& row, std::uint32_t index);
    /// The bit of a signal that has the same index as a bit of another signal; None if there is
    /// none.
    static std::uint32_t FindBit(const SignalRow& from, std::uint32_t index,
                                 const SignalRow& to) noexcept;
    /// The signal that has a bit.
    const SignalRow& GetSignalOfBit(std::uint32_t bit) const noexcept;
    /// A bit of a net; None for the nets of constants.
    std::uint32_t GetBit(std::uint32_t net) const noexcept { return bitOfNet_[net]; }

private:
    /// The bits of a signal other than a compound: so many from the first one on, or down from it.
    struct Run {
        std::uint32_t first = 0;
        std::uint32_t count = 0;
        bool isReversed = false;
    };

    void AddSignals(const Orn_Hdl::Netlist& netlist);
    void AddDeclared(const Orn_Hdl::Signal& signal);
    void AddPart(const Orn_Hdl::Signal& signal);
    void Enter(const Orn_Hdl::Signal& signal, const Run& run);
    const Run* FindRun(const Orn_Hdl::Signal& signal) const noexcept;
    SignalRow* FindRow(const Orn_Hdl::Signal& signal);
    /// Lists the bits of a signal in `bits_`, leftmost first.
    void ListBits(const Orn_Hdl::Signal& signal);
    void AppendBits(const Orn_Hdl::Signal& signal);
    void TakeConstant(const Orn_Hdl::Signal& signal);
    void MarkGenerated();
    void JoinAliases(const Orn_Hdl::Signal& target);
    std::uint32_t FindRoot(std::uint32_t bit) noexcept;
    void MakeNets();
    bool IsConstantNet(const SignalRow& row, std::uint32_t tie) const;
    void AddInstance(const Orn_Hdl::Instance& instance);
    void AddAlias(const Orn_Hdl::Signal& target, const Orn_Hdl::Signal& source);

    const Design design_;
    Components& components_;
    const Rules rules_;
    std::vector<SignalRow> signals_;
    std::vector<InstanceRow> instances_;
    std::vector<AliasRow> aliases_;
    std::uint32_t instanceCount_ = 0;
    std::vector<std::uint32_t> pinNets_;
    /// By bit: while aliases are joined, another bit of the same net; then the net.
    std::vector<std::uint32_t> nets_;
    /// By bit while constants are taken, then by net.
    std::vector<std::uint32_t> ties_;
    std::vector<std::uint8_t> isPort_;
    std::vector<std::uint8_t> isWired_;
    std::vector<std::uint32_t> bitOfNet_;

    /// \{
    /// Only while the graph is made: the signals, their bits, and a table of them.
    std::vector<const Orn_Hdl::Signal*> all_;
    std::vector<Run> runs_;
    IndexTable table_;
    std::vector<std::uint32_t> bits_;
    std::vector<std::uint32_t> otherBits_;
    /// \}
};

/// What each bit of a constant ties its net to, leftmost first.
std::vector<std::uint32_t> GetTies(const Orn_Hdl::BitVectorValue& value, std::size_t width);

} // namespace Tool::Diff
