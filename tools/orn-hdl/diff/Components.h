// The components of two designs, paired, with one numbering of their pins' bits.
#pragma once

#include "diff/IndexTable.h"

#include <cstddef>
#include <cstdint>
#include <string_view>
#include <vector>

namespace Orn_Hdl {
class Component;
class Netlist;
class Pin;
} // namespace Orn_Hdl

namespace Tool::Diff {

/// Which of the two designs.
enum Design : std::uint8_t { A = 0, B = 1 };

constexpr Design Other(Design design) noexcept {
    return design == A ? B : A;
}

/// A pin of a pair of components.
struct PairedPin {
    /// Null where a component has no such pin.
    const Orn_Hdl::Pin* pins[2] = {nullptr, nullptr};
    /// Its bits, numbered from left to right. The bits of the narrower one of two pins are the
    /// rightmost ones.
    std::uint32_t first = 0;
    std::uint32_t width = 0;
    /// Whether some instance has a net at it.
    bool isUsed[2] = {false, false};
};

/// A component of either design, or of both.
struct PairedComponent {
    const Orn_Hdl::Component* components[2] = {nullptr, nullptr};
    std::vector<PairedPin> pins;
    /// How many bits the pins have.
    std::uint32_t width = 0;
    std::uint32_t instances[2] = {0, 0};
    bool isRenamed = false;

    bool IsIn(Design design) const noexcept { return components[design] != nullptr; }
};

/// The number of bits of which each is compared by itself. A wider bus or pin is one net.
inline constexpr std::uint32_t MostBits = std::uint32_t(1) << 16;

/// The bits of a pin or a signal; 1 for what is wider than `MostBits`.
std::uint32_t CountBits(std::int64_t width) noexcept;

/// Pairs components by their names, and then those that are left and have the same pins.
class Components {
public:
    Components(const Orn_Hdl::Netlist& a, const Orn_Hdl::Netlist& b);

    /// The number of a component; that of `GetNone` for null.
    std::uint32_t Find(Design design, const Orn_Hdl::Component* component) const noexcept;
    /// The number of the pin of an instance. \param expected the one that it most likely is.
    /// \return None for a pin that the component does not have.
    std::uint32_t FindPin(std::uint32_t component, Design design, std::string_view name,
                          std::uint32_t expected) const noexcept;
    const std::vector<PairedComponent>& GetAll() const noexcept { return all_; }
    PairedComponent& Get(std::uint32_t component) noexcept { return all_[component]; }
    const PairedComponent& Get(std::uint32_t component) const noexcept { return all_[component]; }
    /// The number of the component without pins, which instances without a component have.
    std::uint32_t GetNone() const noexcept { return static_cast<std::uint32_t>(all_.size() - 1); }

private:
    void PairByName(const Orn_Hdl::Netlist& a, const Orn_Hdl::Netlist& b);
    void PairByPins();
    void PairPins(PairedComponent& component);
    void Enter(Design design);

    std::vector<PairedComponent> all_;
    IndexTable tables_[2];
    IndexTable pinTables_[2];
    /// For each entry of a table of pins, the component and the pin.
    std::vector<std::pair<std::uint32_t, std::uint32_t>> pinRows_[2];
};

} // namespace Tool::Diff
