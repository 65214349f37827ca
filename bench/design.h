/// \file
/// The flat benchmark design, as arithmetic: what any instance, pin or net of it is follows from
/// its number, the size and the seed, so that a design of any size is written without being held.
#pragma once

#include "text_io.h"

#include <cstddef>
#include <cstdint>
#include <span>
#include <string_view>

namespace bench {

/// A well-mixed number that depends on the seed and on two counters only.
constexpr std::uint64_t Random(std::uint64_t seed, std::uint64_t a, std::uint64_t b) {
    std::uint64_t mixed = seed + a * 0x9E3779B97F4A7C15u + b * 0xD1B54A32D192ED03u;
    mixed = (mixed ^ (mixed >> 30)) * 0xBF58476D1CE4E5B9u;
    mixed = (mixed ^ (mixed >> 27)) * 0x94D049BB133111EBu;
    return mixed ^ (mixed >> 31);
}

/// A cell type. Every pin has a name of one character; a flip-flop's first input is its clock.
struct Component {
    std::string_view name;
    std::string_view inputs;
    char output;
    bool isFlipFlop;
    std::string_view function; ///< of a gate, as genlib writes it
};

/// `size` instances of five kinds of gate and a flip-flop. Instance k drives net k; the last nets
/// are output ports, which no instance reads. Gates read nets of lower number only, so that there
/// is no combinational loop; every fourth instance is a flip-flop, on the one clock.
class Design {
public:
    static constexpr std::size_t InputPorts = 32;
    static constexpr std::size_t OutputPorts = 32;
    static constexpr std::size_t MinimumSize = 64;

    Design(std::size_t size, std::uint64_t seed) : size_(size), seed_(seed) {}

    std::size_t GetSize() const noexcept { return size_; }
    /// Nets from 0 on that are no ports; the output ports follow, then the input ports, the clock.
    std::size_t GetInnerNetCount() const noexcept { return size_ - OutputPorts; }
    std::size_t GetNetCount() const noexcept { return size_ + InputPorts + 1; }
    std::size_t GetClock() const noexcept { return size_ + InputPorts; }

    static std::span<const Component> GetComponents() noexcept;
    const Component& GetComponent(std::size_t instance) const noexcept;
    /// The net at an input pin, counted from 0 in the component's inputs.
    std::size_t GetInputNet(std::size_t instance, std::size_t pin) const noexcept;
    bool HasAttribute(std::size_t instance) const noexcept { return instance % 50 == 0; }

    void WriteNetName(Output& out, std::size_t net) const;
    void WriteInstanceName(Output& out, std::size_t instance) const;
    void WriteAttributeValue(Output& out, std::size_t instance) const;

private:
    std::size_t size_;
    std::uint64_t seed_;
};

} // namespace bench
