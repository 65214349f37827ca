#include "design.h"

#include <algorithm>
#include <array>

namespace bench {

namespace {

constexpr std::array<Component, 6> Components = {{
    {"DFF", "CD", 'Q', true, ""},
    {"INV", "A", 'O', false, "!A"},
    {"NAND2", "AB", 'O', false, "!(A*B)"},
    {"NOR2", "AB", 'O', false, "!(A+B)"},
    {"NAND3", "ABC", 'O', false, "!(A*B*C)"},
    {"AOI21", "ABC", 'O', false, "!(A*B+C)"},
}};

/// How often each gate is drawn, in 30 draws: 3.05 pins an instance with the flip-flops.
constexpr std::array<std::uint8_t, 6> GateShares = {0, 8, 6, 6, 5, 5};
constexpr std::uint64_t Draws = 30;

constexpr std::array<std::uint8_t, Draws> GateOfDraw = [] {
    std::array<std::uint8_t, Draws> gates{};
    auto* next = gates.begin();
    for (std::uint8_t gate = 0; gate < GateShares.size(); ++gate) {
        next = std::fill_n(next, GateShares[gate], gate);
    }
    return gates;
}();

/// A number below `limit`, from the upper half of a random one.
std::size_t Below(std::uint64_t random, std::size_t limit) {
    return static_cast<std::size_t>((random >> 32) * limit >> 32);
}

} // namespace

std::span<const Component> Design::GetComponents() noexcept {
    return Components;
}

const Component& Design::GetComponent(std::size_t instance) const noexcept {
    if (instance % 4 == 3) {
        return Components[0];
    }
    return Components[GateOfDraw[Random(seed_, instance, 0) % Draws]];
}

std::size_t Design::GetInputNet(std::size_t instance, std::size_t pin) const noexcept {
    const bool isFlipFlop = GetComponent(instance).isFlipFlop;
    if (isFlipFlop && pin == 0) {
        return GetClock();
    }
    const std::size_t readable =
        isFlipFlop ? GetInnerNetCount() : std::min(instance, GetInnerNetCount());
    const std::size_t drawn = Below(Random(seed_, instance, pin + 1), readable + InputPorts);
    return drawn < readable ? drawn : size_ + (drawn - readable);
}

void Design::WriteNetName(Output& out, std::size_t net) const {
    if (net < GetInnerNetCount()) {
        (out << 'n').WriteHex(net);
    } else if (net < size_) {
        out << 'q' << net - GetInnerNetCount();
    } else if (net < GetClock()) {
        out << "in" << net - size_;
    } else {
        out << "clk";
    }
}

void Design::WriteInstanceName(Output& out, std::size_t instance) const {
    out << (GetComponent(instance).isFlipFlop ? "u_r" : "u_g") << instance;
}

void Design::WriteAttributeValue(Output& out, std::size_t instance) const {
    out << 'R' << instance / 1000 << 'C' << instance % 1000;
}

} // namespace bench
