// The hash table of every look-up whose order does not show. `NameTable` is the other one: the
// order of its walk is part of the behaviour of `StringSet`.
#pragma once

#include "Port/Prefetch.h"

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <memory>
#include <type_traits>
#include <vector>

namespace Orn_Hdl {

/// Finds values by hash: open addressing with linear probing. It keeps no keys; the caller says
/// which of the values near the place of a hash is the wanted one. A value that is equal to
/// `Value()` marks a free slot and cannot be entered.
template <class Value, template <class> class Allocator = std::allocator> class HashSlots {
public:
    static_assert(std::is_trivially_copyable_v<Value>);

    /// The two lowest bits of a hash say little. They do not move a value, so that a caller can
    /// tell kinds of values apart by them and still find those of all kinds.
    static constexpr std::uint32_t PlaceBits = ~std::uint32_t(3);

    std::size_t GetSize() const noexcept { return count_; }

    /// The first value near the place of a hash for which `matches(hash, value)` holds; `Value()`
    /// when there is none.
    template <class Matches> Value Find(std::uint32_t hash, Matches matches) const noexcept {
        return slots_.empty() ? Value() : slots_[Probe(hash, matches)].Get();
    }

    /// Makes room for one more value, so that entering it allocates nothing. At most three quarters
    /// of the slots are taken.
    void MakeRoom() {
        if ((count_ + 1) * 4 <= slots_.size() * 3) {
            return;
        }
        Slots former(slots_.size() < 16 ? 16 : slots_.size() + slots_.size() / 2);
        former.swap(slots_);
        for (const Slot& slot : former) {
            if (!slot.IsFree()) {
                slots_[FreePlace(slot.hash)] = slot;
            }
        }
    }

    /// Enters a value beside those that are there.
    void Add(std::uint32_t hash, Value value) {
        MakeRoom();
        slots_[FreePlace(hash)].Set(hash, value);
        ++count_;
    }

    /// Enters a value in the place of the first one for which `matches(hash, value)` holds.
    template <class Matches> void AddOrReplace(std::uint32_t hash, Value value, Matches matches) {
        MakeRoom();
        Slot& slot = slots_[Probe(hash, matches)];
        count_ += slot.IsFree() ? 1 : 0;
        slot.Set(hash, value);
    }

    /// Gives a value that was entered with this hash another value's slot.
    void Replace(std::uint32_t hash, Value former, Value value) noexcept {
        slots_[PlaceOf(hash, former)].Set(hash, value);
    }

    /// Takes out a value that was entered with this hash; nothing happens when it is not there.
    void Remove(std::uint32_t hash, Value value) noexcept {
        if (slots_.empty()) {
            return;
        }
        std::size_t hole = PlaceOf(hash, value);
        if (slots_[hole].IsFree()) {
            return;
        }
        // A value that was entered behind the hole may have to be looked for in it: it moves up.
        for (std::size_t i = Next(hole); !slots_[i].IsFree(); i = Next(i)) {
            if (Distance(Home(slots_[i].hash), i) >= Distance(hole, i)) {
                slots_[hole] = slots_[i];
                hole = i;
            }
        }
        slots_[hole] = Slot();
        --count_;
    }

    void Clear() noexcept {
        slots_.clear();
        count_ = 0;
    }

    /// Hints that a hash is about to be looked for. There has to be at least one value.
    void PrefetchPlace(std::uint32_t hash) const noexcept { Port::Prefetch(&slots_[Home(hash)]); }

private:
    /// Without padding, so that a look-up mostly touches one cache line and a million names cost
    /// little.
    struct Slot {
        std::uint32_t hash = 0;
        unsigned char bytes[sizeof(Value)] = {};

        Value Get() const noexcept {
            Value value = Value();
            std::memcpy(&value, bytes, sizeof bytes);
            return value;
        }
        bool IsFree() const noexcept { return Get() == Value(); }
        void Set(std::uint32_t newHash, Value value) noexcept {
            hash = newHash;
            std::memcpy(bytes, &value, sizeof bytes);
        }
    };

    using Slots = std::vector<Slot, Allocator<Slot>>;

    /// The slot of the wanted value, or the free one behind all that it could be.
    template <class Matches> std::size_t Probe(std::uint32_t hash, Matches matches) const noexcept {
        std::size_t i = Home(hash);
        while (!slots_[i].IsFree() && !matches(slots_[i].hash, slots_[i].Get())) {
            i = Next(i);
        }
        return i;
    }
    std::size_t FreePlace(std::uint32_t hash) const noexcept {
        return Probe(hash, [](std::uint32_t, Value) { return false; });
    }
    std::size_t PlaceOf(std::uint32_t hash, Value wanted) const noexcept {
        return Probe(hash, [wanted](std::uint32_t, Value value) { return value == wanted; });
    }

    std::size_t Home(std::uint32_t hash) const noexcept {
        return static_cast<std::size_t>((std::uint64_t(hash & PlaceBits) * slots_.size()) >> 32);
    }
    std::size_t Next(std::size_t i) const noexcept { return i + 1 == slots_.size() ? 0 : i + 1; }
    std::size_t Distance(std::size_t from, std::size_t to) const noexcept {
        return to >= from ? to - from : to + slots_.size() - from;
    }

    Slots slots_;
    std::size_t count_ = 0;
};

} // namespace Orn_Hdl
