// An index from names to objects. It stores no names but reads them from the objects.
#pragma once

#include "Containers/HashByEights.h"
#include "Containers/HashSlots.h"
#include "HdlModel/Names/Names.h"
#include "Port/Ascii.h"
#include "Port/Pool.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <string_view>

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

/// One character of a name as compared by look-ups: normalised and in one letter case.
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

/// Like `EqualFolded`, but faster for names that are spelled alike.
inline bool EqualAsARule(std::string_view a, std::string_view b) noexcept {
    return a.size() == b.size() &&
           (EightBytes::Equal(a.data(), b.data(), a.size()) || EqualFolded(a, b));
}

/// Eight characters of a name as compared by look-ups.
inline std::uint64_t FoldEightNameChars(std::uint64_t text) noexcept {
    if (Names::MarkUnusual(text) == 0) {
        return EightBytes::ToUpper(text);
    }
    std::uint64_t folded = 0;
    for (unsigned shift = 0; shift < 64; shift += 8) {
        folded |= std::uint64_t(FoldedNameChar(static_cast<char>(text >> shift))) << shift;
    }
    return folded;
}

/// Like `HashName`, but slower for short names without unusual characters.
std::uint32_t HashAnyName(std::string_view name) noexcept;

/// The hash of a name as compared by look-ups.
inline std::uint32_t HashName(std::string_view name) noexcept {
    constexpr std::size_t Short = 16;
    if (name.size() > Short) {
        return HashAnyName(name);
    }
    std::uint64_t unusual = 0;
    const std::uint64_t hash = WideHashByTwoEights(name, [&unusual](std::uint64_t text) {
        unusual |= Names::MarkUnusual(text);
        return EightBytes::ToUpper(text);
    });
    return unusual == 0 ? UpperHalf(hash) : HashAnyName(name);
}

/// A name to look up, hashed once. Objects of different groups may have the same name. The group is
/// stored in the two lowest bits of the hash, which do not affect the slot in the table.
class NameKey {
public:
    static constexpr std::uint32_t NameBits = HashSlots<void*>::PlaceBits;

    explicit NameKey(std::string_view name, unsigned group = 0) noexcept
        : name_(name), hash_((HashName(name) & NameBits) | group) {}

    std::string_view GetName() const noexcept { return name_; }
    std::uint32_t GetHash() const noexcept { return hash_; }

private:
    std::string_view name_;
    std::uint32_t hash_;
};

/// `KeyOf` returns the name of an object, which must stay equal (normalised, letter case ignored)
/// while the object is in the index.
template <class T, class KeyOf> class NameIndex {
public:
    /// The object of that name and group; null if there is none.
    T* Find(const NameKey& key) const noexcept {
        return slots_.Find(key.GetHash(), IsNamed{key, GroupsApart});
    }
    /// Whether an object of any group has that name.
    bool Contains(const NameKey& key) const noexcept {
        return slots_.Find(key.GetHash(), IsNamed{key, NameKey::NameBits}) != nullptr;
    }

    /// Makes room, so that adding the next objects allocates nothing.
    void MakeRoom(std::size_t count = 1) { slots_.MakeRoom(count); }

    /// Adds an object, or replaces another one of its name and group.
    void Add(T* object, unsigned group = 0) {
        const NameKey key(KeyOf()(object), group);
        slots_.AddOrReplace(key.GetHash(), object, IsNamed{key, GroupsApart});
    }

    /// Removes an object, unless another one has replaced it.
    void Remove(T* object, unsigned group = 0) noexcept {
        slots_.Remove(NameKey(KeyOf()(object), group).GetHash(), object);
    }

    int GetSize() const noexcept { return static_cast<int>(slots_.GetSize()); }
    void Clear() noexcept { slots_.Clear(); }

    /// Prefetches the slots of a hash. The index must not be empty.
    void PrefetchPlace(std::uint32_t hash) const noexcept { slots_.PrefetchPlace(hash); }
    /// An object whose name probably has this hash; null if there is none in the prefetched slots.
    /// The index must not be empty.
    const T* GuessObject(std::uint32_t hash) const noexcept {
        return slots_.FindInPlace(hash, [hash](std::uint32_t other, const T*) {
            return ((other ^ hash) & NameKey::NameBits) == 0;
        });
    }

private:
    static constexpr std::uint32_t GroupsApart = ~std::uint32_t(0);

    /// Whether an object has a name; `mask` selects the bits of the hash that must be equal.
    struct IsNamed {
        const NameKey& key;
        std::uint32_t mask;

        bool operator()(std::uint32_t hash, const T* object) const noexcept {
            return ((hash ^ key.GetHash()) & mask) == 0 &&
                   EqualAsARule(KeyOf()(object), key.GetName());
        }
    };

    HashSlots<T*, Port::Pool::Allocator> slots_;
};

} // namespace Orn_Hdl
