// An index from names to the objects that bear them. It keeps no names: it asks the objects.
#pragma once

#include "Containers/Hash.h"
#include "HdlModel/Names.h"
#include "Port/Ascii.h"

#include <cstdint>
#include <cstring>
#include <string_view>
#include <vector>

namespace Orn_Hdl {

/// One character of a name as look-ups compare it: normalised, letter case ignored.
constexpr char FoldedNameChar(char c) noexcept {
    return Port::ToUpper(Names::Normalized(c));
}

inline std::uint32_t HashFolded(std::string_view name) noexcept {
    NameHash hash;
    for (const char c : name) {
        hash.Add(FoldedNameChar(c));
    }
    // Names that differ in their last digits alone must not fall into neighbouring places.
    return hash.GetValue() * 0x9E3779B1U;
}

inline bool EqualFolded(std::string_view a, std::string_view b) noexcept {
    if (a.size() != b.size()) {
        return false;
    }
    for (std::size_t i = 0; i < a.size(); ++i) {
        if (FoldedNameChar(a[i]) != FoldedNameChar(b[i])) {
            return false;
        }
    }
    return true;
}

/// Open addressing with linear probing. `KeyOf` gives an object's name, which must stay equal
/// (normalised, letter case ignored) as long as the object is in the index.
template <class T, class KeyOf> class NameIndex {
public:
    /// The object of that name; null when there is none.
    T* Find(std::string_view name) const noexcept {
        return slots_.empty() ? nullptr : slots_[Probe(HashFolded(name), name)].GetObject();
    }

    /// Enters an object, in the place of another of its name.
    void Add(T* object) {
        Reserve(count_ + 1);
        const std::string_view name = KeyOf()(object);
        const std::uint32_t hash = HashFolded(name);
        Slot& slot = slots_[Probe(hash, name)];
        count_ += slot.IsFree() ? 1 : 0;
        slot.Set(hash, object);
    }

    /// Takes an object out, unless another has taken its place.
    void Remove(const T* object) noexcept {
        const std::string_view name = KeyOf()(object);
        std::size_t hole = slots_.empty() ? 0 : Probe(HashFolded(name), name);
        if (slots_.empty() || slots_[hole].GetObject() != object) {
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
            std::memcpy(&pointer, object, sizeof pointer);
            return pointer;
        }
        bool IsFree() const noexcept { return GetObject() == nullptr; }
        void Set(std::uint32_t newHash, T* newObject) noexcept {
            hash = newHash;
            std::memcpy(object, &newObject, sizeof newObject);
        }
    };

    /// The place of a name, or the free place where it would go.
    std::size_t Probe(std::uint32_t hash, std::string_view name) const noexcept {
        std::size_t i = Home(hash);
        while (!slots_[i].IsFree() &&
               !(slots_[i].hash == hash && EqualFolded(KeyOf()(slots_[i].GetObject()), name))) {
            i = Next(i);
        }
        return i;
    }

    /// At most three quarters of the places are taken.
    void Reserve(std::size_t count) {
        if (count * 4 <= slots_.size() * 3) {
            return;
        }
        std::vector<Slot> former(slots_.size() < 16 ? 16 : slots_.size() + slots_.size() / 2);
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

    std::size_t Home(std::uint32_t hash) const noexcept {
        return static_cast<std::size_t>((std::uint64_t(hash) * slots_.size()) >> 32);
    }
    std::size_t Next(std::size_t i) const noexcept { return i + 1 == slots_.size() ? 0 : i + 1; }
    std::size_t Distance(std::size_t from, std::size_t to) const noexcept {
        return to >= from ? to - from : to + slots_.size() - from;
    }

    std::vector<Slot> slots_;
    std::size_t count_ = 0;
};

} // namespace Orn_Hdl
