// How often each net is driven, and whether it is read.
#pragma once

#include "Check/Bits.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <unordered_map>
#include <vector>

namespace Orn_Hdl::Checking {

/// What is known of one bit.
class Use {
public:
    void AddDriver() noexcept {
        bits_ = static_cast<std::uint8_t>(bits_ + ((bits_ & Drivers) < Most ? 1 : 0));
    }
    void AddRead() noexcept { bits_ |= Read; }
    void AddMaybeDriven() noexcept { bits_ |= Maybe; }

    bool IsDrivenTwice() const noexcept { return (bits_ & Drivers) >= 2; }
    bool IsDriven() const noexcept { return (bits_ & (Drivers | Maybe)) != 0; }
    bool IsUndriven() const noexcept { return !IsDriven() && (bits_ & Read) != 0; }
    /// Whether anything at all uses the bit.
    bool IsKnown() const noexcept { return bits_ != 0; }

private:
    static constexpr std::uint8_t Drivers = 3;
    static constexpr std::uint8_t Read = 4;
    static constexpr std::uint8_t Maybe = 8;
    static constexpr std::uint8_t Most = 2;

    std::uint8_t bits_ = 0;
};

/// The uses of the bits of all declared signals. Millions of scalar signals are normal, and they
/// lie close together in memory: theirs stand in pages of bytes, found by the signal's address.
class Uses {
public:
    /// Calls `note(use)` for each bit of a run.
    template <class Note> void ForEach(const Run& run, const Note& note) {
        if (run.declared->GetSignalType() == SignalTypeScalar) {
            note(OfScalar(run.declared));
        } else if (std::vector<Use>* bits = OfBus(*run.declared)) {
            const std::size_t size = bits->size();
            const std::size_t first = static_cast<std::size_t>(run.first);
            const std::size_t count = static_cast<std::size_t>(run.count);
            for (std::size_t i = first; i < size && i - first < count; ++i) {
                note((*bits)[i]);
            }
        }
    }
    /// The use of a scalar signal.
    Use& OfScalar(const Signal* signal);

    /// Whether anything is known of a bus: nothing refers to one of which nothing is.
    bool IsKnown(const Signal& bus) const { return buses_.count(&bus) != 0; }
    /// \{
    /// Whether a bit of a declared signal is driven twice, or read and not driven.
    bool IsDrivenTwice(const Signal& declared) const;
    bool IsUndriven(const Signal& declared) const;
    /// Whether a bit of a declared signal is not driven, read or not.
    bool IsAnyUndriven(const Signal& declared) const;
    /// \}

private:
    /// Signals are larger than this, so that no two of them begin in one piece of it.
    static constexpr std::size_t Piece = 32;
    static constexpr std::size_t PageSize = 16384;
    using Page = std::array<Use, PageSize>;

    template <class Test> bool Any(const Signal& declared, const Test& test) const;
    /// Null for a bus that is too wide to be looked at bit by bit.
    std::vector<Use>* OfBus(const Signal& bus);
    const Use* Find(const Signal& scalar) const;

    std::unordered_map<std::uintptr_t, std::unique_ptr<Page>> pages_;
    std::unordered_map<const Signal*, std::vector<Use>> buses_;
};

} // namespace Orn_Hdl::Checking
