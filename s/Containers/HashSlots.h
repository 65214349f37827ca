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
        return GetTable().Probe(hash, matches)->Get();
    }

    /// Like `Find`, but only in the slots that `PrefetchPlace` fetches. The table must not be
    /// empty.
    template <class Matches> Value FindInPlace(std::uint32_t hash, Matches matches) const noexcept {
        const Table<const Slot> table = GetTable();
        const Slot* slot = table.GetHome(hash);
        for (std::size_t i = 0; i < Usual && !slot->IsFree(); ++i) {
            if (matches(slot->hash, slot->Get())) {
                return slot->Get();
            }
            slot = table.GetNext(slot);
        }
        return Value();
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
        Slots larger(size);
        const Table<Slot> table{larger.data(), size};
        for (const Slot& slot : slots_) {
            if (!slot.IsFree()) {
                *table.Probe(slot.hash, IsNone) = slot;
            }
        }
        slots_.swap(larger);
    }

    /// Adds a value.
    void Add(std::uint32_t hash, Value value) {
        MakeRoom();
        GetTable().Probe(hash, IsNone)->Set(hash, value);
        ++count_;
    }

    /// Adds a value, or replaces the first one for which `matches(hash, value)` is true. A value
    /// that is added is found faster than the others: the values in its way move on by one slot.
    template <class Matches> void AddOrReplace(std::uint32_t hash, Value value, Matches matches) {
        MakeRoom();
        const Table<Slot> table = GetTable();
        Slot* slot = table.Probe(hash, matches);
        if (slot->IsFree()) {
            ++count_;
            for (Slot* const home = table.GetHome(hash); slot != home;) {
                Slot* const before = table.GetBefore(slot);
                *slot = *before;
                slot = before;
            }
        }
        slot->Set(hash, value);
    }

    /// Replaces a value that was added with this hash by another one.
    void Replace(std::uint32_t hash, Value former, Value value) noexcept {
        GetTable().Probe(hash, Is{former})->Set(hash, value);
    }

    /// Removes a value that was added with this hash, if it is present.
    void Remove(std::uint32_t hash, Value value) noexcept {
        if (slots_.empty()) {
            return;
        }
        const Table<Slot> table = GetTable();
        Slot* hole = table.Probe(hash, Is{value});
        if (hole->IsFree()) {
            return;
        }
        // A value behind the hole whose search would stop at the hole moves into it.
        for (Slot* slot = table.GetNext(hole); !slot->IsFree(); slot = table.GetNext(slot)) {
            if (table.GetDistance(table.GetHome(slot->hash), slot) >=
                table.GetDistance(hole, slot)) {
                *hole = *slot;
                hole = slot;
            }
        }
        *hole = Slot();
        --count_;
    }

    void Clear() noexcept {
        slots_.clear();
        count_ = 0;
    }

    /// Prefetches the slots in which a search for a hash ends as a rule. The table must not be
    /// empty.
    void PrefetchPlace(std::uint32_t hash) const noexcept {
        // They may stand in two lines of the cache.
        const Slot* const home = GetTable().GetHome(hash);
        Port::Prefetch(home);
        Port::Prefetch(reinterpret_cast<const char*>(home) + Usual * sizeof(Slot) - 1);
    }

private:
    /// How many slots a search visits at most as a rule.
    static constexpr std::size_t Usual = 4;

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

    struct Is {
        Value wanted;

        bool operator()(std::uint32_t /*hash*/, Value value) const noexcept {
            return value == wanted;
        }
    };
    static bool IsNone(std::uint32_t /*hash*/, Value /*value*/) noexcept { return false; }

    /// Where the slots are and how many. A copy of it need not be read again after every slot that
    /// is written.
    template <class AnySlot> struct Table {
        AnySlot* begin;
        std::size_t size;

        AnySlot* GetHome(std::uint32_t hash) const noexcept {
            return begin + ((std::uint64_t(hash & PlaceBits) * size) >> 32);
        }
        AnySlot* GetNext(AnySlot* slot) const noexcept {
            return slot + 1 == begin + size ? begin : slot + 1;
        }
        AnySlot* GetBefore(AnySlot* slot) const noexcept {
            return (slot == begin ? begin + size : slot) - 1;
        }
        std::size_t GetDistance(const Slot* from, const Slot* to) const noexcept {
            return static_cast<std::size_t>(to - from) + (to >= from ? 0 : size);
        }
        /// The slot of the wanted value, or the free slot that ends the search.
        template <class Matches>
        AnySlot* Probe(std::uint32_t hash, Matches matches) const noexcept {
            AnySlot* slot = GetHome(hash);
            while (!slot->IsFree() && !matches(slot->hash, slot->Get())) {
                slot = GetNext(slot);
            }
            return slot;
        }
    };
    Table<Slot> GetTable() noexcept { return {slots_.data(), slots_.size()}; }
    Table<const Slot> GetTable() const noexcept { return {slots_.data(), slots_.size()}; }

    Slots slots_;
    std::size_t count_ = 0;
};

} // namespace Orn_Hdl
