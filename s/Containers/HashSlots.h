// The hash table for look-ups whose order is not visible. The other hash table is `NameTable`,
// whose order is part of the behaviour of `StringSet`.
#pragma once

#include "Port/Prefetch.h"

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <memory>
#include <type_traits>
#include <vector>

namespace Orn_Hdl {

/// Finds values by hash: open addressing with linear probing. It stores no keys; the caller decides
/// which of the values that may have a hash is the wanted one. A value that is equal to `Value()`
/// marks a free slot and cannot be added.
template <class Value, template <class> class Allocator = std::allocator> class HashSlots {
public:
    static_assert(std::is_trivially_copyable_v<Value>);

    /// The two lowest bits of a hash do not affect the slot of a value, so that a caller can
    /// distinguish kinds of values by them and still find values of all kinds.
    static constexpr std::uint32_t PlaceBits = ~std::uint32_t(3);

    std::size_t GetSize() const noexcept { return count_; }

    /// The first value from the home slot of a hash on for which `matches(hash, value)` is true;
    /// `Value()` if there is none.
    template <class Matches> Value Find(std::uint32_t hash, Matches matches) const noexcept {
        if (slots_.empty()) {
            return Value();
        }
        return slots_[Probe(hash, matches)].Get();
    }

    /// Makes room for more values, so that adding them allocates nothing. At most three quarters of
    /// the slots are used.
    void MakeRoom(std::size_t more = 1) {
        if ((count_ + more) * 4 <= slots_.size() * 3) {
            return;
        }
        std::size_t size = slots_.size() < 16 ? 16 : slots_.size() + slots_.size() / 2;
        while ((count_ + more) * 4 > size * 3) {
            size += size / 2;
        }
        Slots former(size);
        former.swap(slots_);
        for (const Slot& slot : former) {
            if (!slot.IsFree()) {
                slots_[FreePlace(slot.hash)] = slot;
            }
        }
    }

    /// Adds a value.
    void Add(std::uint32_t hash, Value value) {
        MakeRoom();
        slots_[FreePlace(hash)].Set(hash, value);
        ++count_;
    }

    /// Adds a value, or replaces the first one for which `matches(hash, value)` is true.
    template <class Matches> void AddOrReplace(std::uint32_t hash, Value value, Matches matches) {
        MakeRoom();
        Slot& slot = slots_[Probe(hash, matches)];
        count_ += slot.IsFree() ? 1 : 0;
        slot.Set(hash, value);
    }

    /// Replaces a value that was added with this hash by another one.
    void Replace(std::uint32_t hash, Value former, Value value) noexcept {
        slots_[PlaceOf(hash, former)].Set(hash, value);
    }

    /// Removes a value that was added with this hash, if it is present.
    void Remove(std::uint32_t hash, Value value) noexcept {
        if (slots_.empty()) {
            return;
        }
        std::size_t hole = PlaceOf(hash, value);
        if (slots_[hole].IsFree()) {
            return;
        }
        // A value behind the hole whose search would stop at the hole moves into it.
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

    /// Prefetches the slots of a hash. The table must not be empty.
    void PrefetchPlace(std::uint32_t hash) const noexcept {
        // A search ends within four slots as a rule, which may stand in two lines of the cache.
        constexpr std::size_t Usual = 4;
        const Slot* const home = &slots_[Home(hash)];
        Port::Prefetch(home);
        Port::Prefetch(reinterpret_cast<const char*>(home) + Usual * sizeof(Slot) - 1);
    }

private:
    /// Without padding, so that most look-ups read one cache line and a million names need little
    /// memory.
    struct Slot {
        std::uint32_t hash = 0;
        // NOLINTNEXTLINE(bugprone-sizeof-expression): a value may be a pointer.
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

    /// The slot of the wanted value, or the free slot that ends the search.
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
