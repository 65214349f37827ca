// An index from names to the objects that bear them. It keeps no names: it asks the objects.
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
/// the two lowest bits of the hash, which do not move an object in the table.
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

/// `KeyOf` gives an object's name, which must stay equal (normalised, letter case ignored) as long
/// as the object is in the index.
template <class T, class KeyOf> class NameIndex {
public:
    /// The object of that name and group; null when there is none.
    T* Find(const NameKey& key) const noexcept {
        return slots_.Find(key.GetHash(), IsNamed{key, GroupsApart});
    }
    /// Whether an object of any group has that name.
    bool Contains(const NameKey& key) const noexcept {
        return slots_.Find(key.GetHash(), IsNamed{key, NameKey::NameBits}) != nullptr;
    }

    /// Makes sure that the next object can be entered without allocating memory.
    void MakeRoom() { slots_.MakeRoom(); }

    /// Enters an object, in the place of another of its name and group.
    void Add(T* object, unsigned group = 0) {
        const NameKey key(KeyOf()(object), group);
        slots_.AddOrReplace(key.GetHash(), object, IsNamed{key, GroupsApart});
    }

    /// Takes an object out, unless another has taken its place.
    void Remove(T* object, unsigned group = 0) noexcept {
        slots_.Remove(NameKey(KeyOf()(object), group).GetHash(), object);
    }

    int GetSize() const noexcept { return static_cast<int>(slots_.GetSize()); }
    void Clear() noexcept { slots_.Clear(); }

    /// Hints that a name of this hash is about to be looked up. The index must not be empty.
    void PrefetchPlace(std::uint32_t hash) const noexcept { slots_.PrefetchPlace(hash); }
    /// An object that probably has a name of this hash; null when there is none.
    const T* GuessObject(std::uint32_t hash) const noexcept {
        return slots_.Find(hash, [hash](std::uint32_t other, const T*) {
            return ((other ^ hash) & NameKey::NameBits) == 0;
        });
    }

private:
    static constexpr std::uint32_t GroupsApart = ~std::uint32_t(0);

    /// Whether an object has a name; `mask` says which bits of the hash must agree.
    struct IsNamed {
        const NameKey& key;
        std::uint32_t mask;

        bool operator()(std::uint32_t hash, const T* object) const noexcept {
            return ((hash ^ key.GetHash()) & mask) == 0 &&
                   EqualFolded(KeyOf()(object), key.GetName());
        }
    };

    HashSlots<T*, Port::Pool::Allocator> slots_;
};

} // namespace Orn_Hdl
