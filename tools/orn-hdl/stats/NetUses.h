// What drives and reads each net of a design, bit by bit.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <unordered_map>
#include <vector>

namespace Orn_Hdl {
class Netlist;
class Signal;
} // namespace Orn_Hdl

namespace Tool::Stats {

/// Whether a signal is declared by itself: no part of a bus and no compound.
bool IsDeclared(const Orn_Hdl::Signal& signal);

/// How often one bit is driven and read.
struct NetUse {
    std::int32_t drivers = 0;
    std::int32_t loads = 0;

    NetUse& operator+=(const NetUse& other) noexcept {
        drivers += other.drivers;
        loads += other.loads;
        return *this;
    }
    NetUse& operator-=(const NetUse& other) noexcept {
        drivers -= other.drivers;
        loads -= other.loads;
        return *this;
    }
};

/// The declared signals of a netlist with the uses of their bits. Drivers are output pins, input
/// ports, constants and the second signal of an alias; loads are input pins, output ports and the
/// first signal of an alias. A bidirectional pin or port is both.
class NetUses {
public:
    /// A wider bus is one net: nobody wires each of its bits.
    static constexpr std::int64_t MostBits = std::int64_t(1) << 20;
    /// What uses a bit once.
    static constexpr NetUse Driver{1, 0};
    static constexpr NetUse Load{0, 1};

    explicit NetUses(const Orn_Hdl::Netlist& netlist);

    /// Calls `visit(signal, index, use)` for every bit of every declared signal, the leftmost bit
    /// of a bus being 0, in the order of the netlist.
    template <class Visit> void ForEach(const Visit& visit) const {
        for (const Declared& declared : declared_) {
            for (std::size_t bit = 0; bit < declared.count; ++bit) {
                visit(*declared.signal, bit, uses_[declared.first + bit]);
            }
        }
    }

private:
    /// A declared signal, and where its bits stand in `uses_`.
    struct Declared {
        const Orn_Hdl::Signal* signal = nullptr;
        std::size_t first = 0;
        std::size_t count = 1;
        /// The indices at both ends of its range.
        std::int64_t left = 0;
        std::int64_t right = 0;
    };

    void Declare(const Orn_Hdl::Signal& signal);
    void TakePort(const Orn_Hdl::Signal& signal);
    void TakePins(const Orn_Hdl::Netlist& netlist);
    /// Takes the constant of a signal and its aliases.
    void TakeAssignments(const Orn_Hdl::Signal& signal);

    /// Adds a use to each bit that a signal stands for.
    void Add(const Orn_Hdl::Signal& signal, const NetUse& use);
    /// Adds a use to the bits of a declared signal between two indices. However many bits these
    /// are, it is entered at the first one and behind the last one; `SumUp` carries it along.
    void Add(const Declared& declared, std::int64_t left, std::int64_t right, const NetUse& use);
    void SumUp();
    /// Null if the signal is not in the netlist.
    const Declared* Find(const Orn_Hdl::Signal* signal) const;

    std::vector<Declared> declared_;
    std::unordered_map<const Orn_Hdl::Signal*, std::size_t> indices_;
    /// One for each bit, and one behind the bits of a bus.
    std::vector<NetUse> uses_;
};

/// The name of a bit of a declared signal: D(3) for a bit of a bus, the signal's name otherwise.
std::string GetBitName(const Orn_Hdl::Signal& signal, std::size_t index);

} // namespace Tool::Stats
