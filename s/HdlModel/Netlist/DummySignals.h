// The dummy signals that a netlist gets for ports that are used against their direction: output
// ports that are read inside or have several drivers, and input ports that are driven inside.
#pragma once

#include "Containers/HashSlots.h"
#include "Orn_Hdl/Model/Netlist.h"

#include <cstddef>
#include <cstdint>
#include <string_view>
#include <vector>

namespace Orn_Hdl {

/// Remembers which dummy was made for which signal, so that a netlist can be written any number of
/// times. It owns nothing: the netlist owns the dummies, and the signals for which they were made,
/// but for slices and bits of its buses that were never added to it.
class DummySignals {
public:
    /// A signal and the dummy that was created for it.
    struct Entry {
        Signal* original;
        Signal* dummy;
        /// Whether the signal is an output port, or a part of one, which its dummy drives.
        bool forOutputs;
    };

    DummySignals() = default;
    DummySignals(const DummySignals&) = delete;
    DummySignals& operator=(const DummySignals&) = delete;

    /// Moves to each dummy what its signal has gained since the dummy was created.
    void Refresh(Netlist& netlist);
    /// Creates dummies for the named signals.
    /// \param forOutputs whether the signals are output ports, which their dummies drive, or input
    ///        ports, which drive their dummies.
    void Make(Netlist& netlist, const StringSet& names, bool forOutputs);
    /// The dummy that was created for a signal; null if there is none.
    Signal* Find(const Signal* original) const noexcept;
    /// The entry of the signal for which a dummy was created; null if there is none. It is valid
    /// until a dummy is created or forgotten.
    const Entry* FindByOriginal(const Signal* original) const noexcept;
    /// The entry of a dummy; null if the signal is none. It is valid until a dummy is created or
    /// forgotten.
    const Entry* FindByDummy(const Signal* dummy) const noexcept;
    /// Whether there is no entry.
    bool IsEmpty() const noexcept { return entries_.size() == emptyPlaces_; }
    /// The entry of the bus for whose slice or bit `Refresh` is going to make a dummy; null if it
    /// makes none.
    const Entry* FindPending(const Netlist& netlist, const Signal& part) const;
    /// Drops the entries of a signal that is about to be destroyed, whether or not it is a dummy.
    void Forget(const Signal* signal) noexcept;
    /// Drops all entries, before the signals of the netlist are destroyed.
    void Clear() noexcept;

private:
    void MakeForScalar(Netlist& netlist, ScalarSignal& signal, bool forOutputs);
    void MakeForBus(Netlist& netlist, Bus& bus, bool forOutputs);
    void MakeForParts(Netlist& netlist, Bus& bus, Bus& dummy, bool forOutputs);
    void MakeForCompound(Netlist& netlist, CompoundBus& compound, bool forOutputs);
    /// Adds a dummy to the netlist and to the memory, and lets it take over for the first time.
    void Adopt(Netlist& netlist, Signal& original, Signal* dummy, bool forOutputs);
    bool CanMakeForPart(const Netlist& netlist, const Signal& part) const;
    bool IsKeptAsOriginal(const Signal& signal) const noexcept;
    static void TakeOver(const Entry& entry);
    static void Link(const Entry& entry);
    enum class Members { All, NoCompounds };
    void ReplaceInCompounds(std::size_t firstEntry, Members which);
    void ReplaceMembers(CompoundBus& compound, Members which);

    /// For each signal that an entry names the index of the entry, plus one.
    using Places = HashSlots<std::uint32_t>;

    const Entry* FindBy(const Places& places, Signal* Entry::*side,
                        const Signal* signal) const noexcept;
    void Drop(const Entry& entry) noexcept;
    void DropEmptyPlaces() noexcept;

    /// In the order in which the dummies were created. A dropped entry leaves a slot without
    /// signals.
    std::vector<Entry> entries_;
    std::size_t emptyPlaces_ = 0;
    Places byOriginal_;
    Places byDummy_;
};

} // namespace Orn_Hdl
