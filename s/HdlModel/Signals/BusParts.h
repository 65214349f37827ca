// The slices and bits of a bus. A slice or bit knows these parts, not the bus: when a wider bus
// takes over the parts of a narrower one, they all get their new parent at once. Signals of other
// classes that are listed among the slices know no parent; they are references (see References).
#pragma once

#include "Orn_Hdl/Containers/PtrArray.h"
#include "Orn_Hdl/Model/Signals/Bus.h"
#include "Orn_Hdl/Model/Signals/BusPart.h"
#include "Port/Pool.h"

namespace Orn_Hdl {

/// The list of the slices and bits of one bus, and the links back from them.
class BusParts {
public:
    explicit BusParts(Bus& bus) noexcept : bus_(&bus) {}
    BusParts(const BusParts&) = delete;
    BusParts& operator=(const BusParts&) = delete;
    static void* operator new(std::size_t size) {
        return Port::Pool::Allocate(size, Port::Pool::DesignObjects);
    }
    static void operator delete(void* memory) noexcept { Port::Pool::Free(memory); }

    /// The parts of a bus.
    static BusParts& Of(Bus& bus) noexcept { return *bus.parts_; }
    /// The parent of the slices and bits.
    Bus& GetBus() const noexcept { return *bus_; }
    /// The slices and bits, and what else is listed among them.
    const PtrArray<Signal*>& GetSignals() const noexcept { return signals_; }

    /// Lists a slice or bit, once; the bus to which it belonged drops it.
    void Add(BusPart& part);
    /// Lists a signal of any class, once.
    void AddAny(Signal& signal);
    /// Drops a slice or bit.
    void Remove(BusPart& part) noexcept;
    /// Drops a signal of any class; null, and one that is not listed, are ignored.
    void RemoveAny(Signal* signal) noexcept;
    /// Drops all signals.
    void RemoveAll() noexcept;
    /// Drops a signal that is about to be destroyed and is no slice or bit.
    void Forget(Signal& other) noexcept;
    /// Lets a bus take over all slices and bits of another one, behind its own. If allocation
    /// fails, nothing changes.
    static void TakeOver(Bus& bus, Bus& from);

private:
    void Unlink(Signal& signal) noexcept;

    Bus* bus_;
    PtrArray<Signal*> signals_;
    /// How many of the signals are neither slices nor bits.
    int others_ = 0;
};

} // namespace Orn_Hdl
