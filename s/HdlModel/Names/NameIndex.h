// An index from names to the objects that bear them. It keeps no names: it asks the objects.
#pragma once

#include "Containers/HashByEights.h"
#include "HdlModel/Names/Names.h"
#include "Port/Ascii.h"
#include "Port/Pool.h"
#include "Port/Prefetch.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string_view>
#include <vector>

namespace Orn_Hdl {

namespace FoldedDetail {

constexpr std::array<unsigned char, 256> MakeTable() noexcept {
    std::array<unsigned char, 256> table{};
    for (int c = 0; c < 256; ++c) {
        table[static_cast<std::size_t>(c)] =
            static_cast<unsigned char>(Port::ToUpper(Names::Normalized(static_cast<char>(c))));
    }
    return table;
}

inline constexpr std::array<unsigned char, 256> Table = MakeTable();

} // namespace FoldedDetail

/// One character of a name as look-ups compare it: normalised, letter case ignored.
inline unsigned char FoldedNameChar(char c) noexcept {
    return FoldedDetail::Table[static_cast<unsigned char>(c)];
}

inline bool EqualFolded(std::string_view a, std::string_view b) noexcept {
    if (a.size() != b.size()) {
        return false;
    }
    for (std::size_t i = 0; i < a.size(); ++i) {
        if (a[i] != b[i] && FoldedNameChar(a[i]) != FoldedNameChar(b[i])) {
            return false;
        }
    }
    return true;
}

/// Eight characters of a name as look-ups compare them.
inline std::uint64_t FoldEightNameChars(std::uint64_t text) noexcept {
    using namespace EightBytes;
    // Few names have characters that are normalised: brackets, which differ from braces in one bit,
    // angle brackets and the minus. The bit makes a few others look like these.
    const std::uint64_t alike = text | Each(0x20);
    const std::uint64_t marks =
        MarkRange(alike, '{', '}') | MarkRange(alike, '<', '>') | MarkRange(alike, '-', '-');
    if (marks == 0) {
        return ToUpper(text);
    }
    std::uint64_t folded = 0;
    for (unsigned shift = 0; shift < 64; shift += 8) {
        folded |= std::uint64_t(FoldedNameChar(static_cast<char>(text >> shift))) << shift;
    }
    return folded;
}

inline std::uint32_t HashName(std::string_view name) noexcept {
    return HashByEights(name, FoldEightNameChars);
}

/// A name to look up, hashed once. Its group sets apart what may bear the same name: it stands in
/// the two lowest bits of the hash, which say little.
class NameKey {
public:
    static constexpr std::uint32_t GroupMask = 3;

    explicit NameKey(std::string_view name, unsigned group = 0) noexcept
        : name_(name), hash_((HashName(name) & ~GroupMask) | group) {}

    std::string_view GetName() const noexcept { return name_; }
    std::uint32_t GetHash() const noexcept { return hash_; }

private:
    std::string_view name_;
    std::uint32_t hash_;
};

/// Open addressing with linear probing. `KeyOf` gives an object's name, which must stay equal
/// (normalised, letter case ignored) as long as the object is in the index.
template <class T, class KeyOf> class NameIndex {
public:
    /// The object of that name and group; null when there is none.
    T* Find(const NameKey& key) const noexcept {
        return slots_.empty() ? nullptr : slots_[Probe(key, GroupsApart)].GetObject();
    }
    /// Whether an object of any group has that name.
    bool Contains(const NameKey& key) const noexcept {
        return !slots_.empty() && !slots_[Probe(key, GroupsAlike)].IsFree();
    }

    /// Makes sure that the next object can be entered without taking memory.
    void MakeRoom() { Reserve(count_ + 1); }

    /// Enters an object, in the place of another of its name and group.
    void Add(T* object, unsigned group = 0) {
        Reserve(count_ + 1);
        const NameKey key(KeyOf()(object), group);
        Slot& slot = slots_[Probe(key, GroupsApart)];
        count_ += slot.IsFree() ? 1 : 0;
        slot.Set(key.GetHash(), object);
    }

    /// Takes an object out, unless another has taken its place.
    void Remove(const T* object, unsigned group = 0) noexcept {
        if (slots_.empty()) {
            return;
        }
        std::size_t hole = Probe(NameKey(KeyOf()(object), group), GroupsApart);
        if (slots_[hole].GetObject() != object) {
            return;
        }
        // What the freed place lets nearer to its home moves up.
        for (std::size_t i = Next(hole); !slots_[i].IsFree(); i = Next(i)) {
            if (Distance(Home(slots_[i].hash), i) >= Distance(hole, i)) {
                slots_[hole] = slots_[i];
                hole = i;
            }
        }
        slots_[hole] = Slot();
        --count_;
    }

    int GetSize() const noexcept { return static_cast<int>(count_); }

    /// \{
    /// For looking ahead: asks for the place of a hash, and guesses which object is there.
    void PrefetchPlace(std::uint32_t hash) const noexcept { Port::Prefetch(&slots_[Home(hash)]); }
    const T* GuessObject(std::uint32_t hash) const noexcept {
        std::size_t i = Home(hash);
        while (!slots_[i].IsFree() && ((slots_[i].hash ^ hash) & GroupsAlike) != 0) {
            i = Next(i);
        }
        return slots_[i].GetObject();
    }
    /// \}

    void Clear() noexcept {
        slots_.clear();
        count_ = 0;
    }

private:
    /// Twelve bytes, so that a look-up mostly touches one cache line and a million names cost
    /// little.
    struct Slot {
        std::uint32_t hash = 0;
        unsigned char object[sizeof(T*)] = {};

        T* GetObject() const noexcept {
            T* pointer = nullptr;
            // The pointer itself is copied. NOLINTNEXTLINE(bugprone-sizeof-expression)
            std::memcpy(&pointer, object, sizeof pointer);
            return pointer;
        }
        bool IsFree() const noexcept { return GetObject() == nullptr; }
        void Set(std::uint32_t newHash, T* newObject) noexcept {
            hash = newHash;
            // NOLINTNEXTLINE(bugprone-sizeof-expression)
            std::memcpy(object, &newObject, sizeof newObject);
        }
    };

    using Slots = std::vector<Slot, Port::Pool::Allocator<Slot>>;

    static constexpr std::uint32_t GroupsApart = ~std::uint32_t(0);
    static constexpr std::uint32_t GroupsAlike = ~NameKey::GroupMask;

    /// The place of a name, or the free place where it would go. `mask` says which bits of the hash
    /// must agree.
    std::size_t Probe(const NameKey& key, std::uint32_t mask) const noexcept {
        std::size_t i = Home(key.GetHash());
        while (!slots_[i].IsFree() &&
               !(((slots_[i].hash ^ key.GetHash()) & mask) == 0 &&
                 EqualFolded(KeyOf()(slots_[i].GetObject()), key.GetName()))) {
            i = Next(i);
        }
        return i;
    }

    /// At most three quarters of the places are taken.
    void Reserve(std::size_t count) {
        if (count * 4 <= slots_.size() * 3) {
            return;
        }
        Slots former(slots_.size() < 16 ? 16 : slots_.size() + slots_.size() / 2);
        former.swap(slots_);
        for (const Slot& slot : former) {
            if (!slot.IsFree()) {
                std::size_t i = Home(slot.hash);
                while (!slots_[i].IsFree()) {
                    i = Next(i);
                }
                slots_[i] = slot;
            }
        }
    }

    /// Tells nothing of the group: objects of one name share their home.
    std::size_t Home(std::uint32_t hash) const noexcept {
        hash &= ~NameKey::GroupMask;
        return static_cast<std::size_t>((std::uint64_t(hash) * slots_.size()) >> 32);
    }
    std::size_t Next(std::size_t i) const noexcept { return i + 1 == slots_.size() ? 0 : i + 1; }
    std::size_t Distance(std::size_t from, std::size_t to) const noexcept {
        return to >= from ? to - from : to + slots_.size() - from;
    }

    Slots slots_;
    std::size_t count_ = 0;
};

} // namespace Orn_Hdl
