// An index from names to the objects that bear them. It keeps no names: it asks the objects.
#pragma once

#include "Containers/Hash.h"
#include "HdlModel/Names.h"
#include "Port/Ascii.h"

#include <cstdint>
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
        if (hashes_.empty()) {
            return nullptr;
        }
        const std::uint32_t hash = HashFolded(name);
        for (std::size_t i = Home(hash); objects_[i] != nullptr; i = Next(i)) {
            if (hashes_[i] == hash && EqualFolded(KeyOf()(objects_[i]), name)) {
                return objects_[i];
            }
        }
        return nullptr;
    }

    /// Enters an object, in the place of another of its name.
    void Add(T* object) {
        Reserve(count_ + 1);
        const std::string_view name = KeyOf()(object);
        const std::uint32_t hash = HashFolded(name);
        std::size_t i = Home(hash);
        while (objects_[i] != nullptr &&
               !(hashes_[i] == hash && EqualFolded(KeyOf()(objects_[i]), name))) {
            i = Next(i);
        }
        count_ += objects_[i] == nullptr ? 1 : 0;
        hashes_[i] = hash;
        objects_[i] = object;
    }

    /// Takes an object out, unless another has taken its place.
    void Remove(const T* object) noexcept {
        if (hashes_.empty()) {
            return;
        }
        const std::uint32_t hash = HashFolded(KeyOf()(object));
        std::size_t hole = Home(hash);
        while (objects_[hole] != object) {
            if (objects_[hole] == nullptr) {
                return;
            }
            hole = Next(hole);
        }
        // What the freed place lets nearer to its home moves up.
        for (std::size_t i = Next(hole); objects_[i] != nullptr; i = Next(i)) {
            if (Distance(Home(hashes_[i]), i) >= Distance(hole, i)) {
                hashes_[hole] = hashes_[i];
                objects_[hole] = objects_[i];
                hole = i;
            }
        }
        objects_[hole] = nullptr;
        --count_;
    }

    void Clear() noexcept {
        hashes_.clear();
        objects_.clear();
        count_ = 0;
    }

    void Reserve(std::size_t count) {
        if (count * 4 <= objects_.size() * 3) {
            return;
        }
        const std::size_t size = objects_.size() < 16 ? 16 : objects_.size() + objects_.size() / 2;
        std::vector<std::uint32_t> hashes(size);
        std::vector<T*> objects(size);
        hashes.swap(hashes_);
        objects.swap(objects_);
        for (std::size_t from = 0; from < objects.size(); ++from) {
            if (objects[from] != nullptr) {
                std::size_t i = Home(hashes[from]);
                while (objects_[i] != nullptr) {
                    i = Next(i);
                }
                hashes_[i] = hashes[from];
                objects_[i] = objects[from];
            }
        }
    }

private:
    std::size_t Home(std::uint32_t hash) const noexcept {
        return static_cast<std::size_t>((std::uint64_t(hash) * objects_.size()) >> 32);
    }
    std::size_t Next(std::size_t i) const noexcept { return i + 1 == objects_.size() ? 0 : i + 1; }
    std::size_t Distance(std::size_t from, std::size_t to) const noexcept {
        return to >= from ? to - from : to + objects_.size() - from;
    }

    std::vector<std::uint32_t> hashes_;
    std::vector<T*> objects_;
    std::size_t count_ = 0;
};

} // namespace Orn_Hdl
