#include "Orn_Hdl/Containers/StringPtrMap.h"

#include "Containers/HashByEights.h"
#include "Port/Ascii.h"

#include <algorithm>
#include <cstdint>
#include <string>
#include <vector>

namespace Orn_Hdl {

/// The entries stand in a plain list. Up to a few they are compared one by one; beyond that an open
/// addressing table of their indices finds them by hash.
struct IStringPtrMapBase::Table {
    struct Entry {
        std::uint32_t hash;
        std::string name;
        void* pointer;
    };

    static constexpr std::size_t MostUnindexed = 8;
    static constexpr std::uint32_t None = UINT32_MAX;

    std::vector<Entry> entries;
    /// Indices into `entries`, `None` for a free place; a power of two long, at most half full.
    std::vector<std::uint32_t> places;

    bool Equal(std::size_t entry, std::uint32_t hash, std::string_view name) const noexcept {
        return entries[entry].hash == hash && Port::EqualIgnoringCase(entries[entry].name, name);
    }

    std::size_t Find(std::uint32_t hash, std::string_view name) const noexcept {
        if (places.empty()) {
            std::size_t i = 0;
            while (i < entries.size() && !Equal(i, hash, name)) {
                ++i;
            }
            return i;
        }
        const std::size_t mask = places.size() - 1;
        for (std::size_t i = hash & mask; places[i] != None; i = (i + 1) & mask) {
            if (Equal(places[i], hash, name)) {
                return places[i];
            }
        }
        return entries.size();
    }

    void Place(std::uint32_t entry) noexcept {
        const std::size_t mask = places.size() - 1;
        std::size_t i = entries[entry].hash & mask;
        while (places[i] != None) {
            i = (i + 1) & mask;
        }
        places[i] = entry;
    }

    void Rebuild(std::size_t size) {
        places.assign(size, None);
        for (std::uint32_t i = 0; i < entries.size(); ++i) {
            Place(i);
        }
    }

    void Insert(std::uint32_t hash, std::string_view name, void* pointer) {
        // The places come first: an entry that found none would be removed in vain.
        const std::size_t count = entries.size() + 1;
        if (count > MostUnindexed && count * 2 > places.size()) {
            Rebuild(std::max<std::size_t>(MostUnindexed * 4, places.size() * 2));
        }
        entries.push_back({hash, std::string(name), pointer});
        if (!places.empty()) {
            Place(static_cast<std::uint32_t>(entries.size() - 1));
        }
    }

    /// Frees the place of an entry and moves up the entries that the freed place lets nearer home.
    void Unplace(std::size_t entry) noexcept {
        const std::size_t mask = places.size() - 1;
        std::size_t hole = entries[entry].hash & mask;
        while (places[hole] != entry) {
            hole = (hole + 1) & mask;
        }
        for (std::size_t i = (hole + 1) & mask; places[i] != None; i = (i + 1) & mask) {
            const std::size_t home = entries[places[i]].hash & mask;
            if (((i - home) & mask) >= ((i - hole) & mask)) {
                places[hole] = places[i];
                hole = i;
            }
        }
        places[hole] = None;
    }

    void Erase(std::size_t entry) noexcept {
        const std::size_t last = entries.size() - 1;
        if (!places.empty()) {
            Unplace(entry);
            if (entry != last) {
                const std::size_t mask = places.size() - 1;
                std::size_t i = entries[last].hash & mask;
                while (places[i] != last) {
                    i = (i + 1) & mask;
                }
                places[i] = static_cast<std::uint32_t>(entry);
            }
        }
        if (entry != last) {
            entries[entry] = std::move(entries[last]);
        }
        entries.pop_back();
    }
};

IStringPtrMapBase::IStringPtrMapBase() noexcept = default;

IStringPtrMapBase::IStringPtrMapBase(const IStringPtrMapBase& other)
    : table_(other.table_ == nullptr ? nullptr : std::make_unique<Table>(*other.table_)) {}

IStringPtrMapBase& IStringPtrMapBase::operator=(const IStringPtrMapBase& other) {
    if (this != &other) {
        table_ = other.table_ == nullptr ? nullptr : std::make_unique<Table>(*other.table_);
    }
    return *this;
}

IStringPtrMapBase::~IStringPtrMapBase() = default;

void IStringPtrMapBase::Add(std::string_view name, void* pointer) {
    if (table_ == nullptr) {
        table_ = std::make_unique<Table>();
    }
    const std::uint32_t hash = HashUpperByEights(name);
    const std::size_t found = table_->Find(hash, name);
    if (found < table_->entries.size()) {
        table_->entries[found].pointer = pointer;
    } else {
        table_->Insert(hash, name, pointer);
    }
}

void* IStringPtrMapBase::Get(std::string_view name) const noexcept {
    if (table_ == nullptr) {
        return nullptr;
    }
    const std::size_t found = table_->Find(HashUpperByEights(name), name);
    return found < table_->entries.size() ? table_->entries[found].pointer : nullptr;
}

bool IStringPtrMapBase::Contains(std::string_view name) const noexcept {
    return table_ != nullptr &&
           table_->Find(HashUpperByEights(name), name) < table_->entries.size();
}

void IStringPtrMapBase::Remove(std::string_view name) noexcept {
    if (table_ != nullptr) {
        const std::size_t found = table_->Find(HashUpperByEights(name), name);
        if (found < table_->entries.size()) {
            table_->Erase(found);
        }
    }
}

bool IStringPtrMapBase::IsEmpty() const noexcept {
    return table_ == nullptr || table_->entries.empty();
}

void IStringPtrMapBase::Empty() noexcept {
    table_.reset();
}

} // namespace Orn_Hdl
