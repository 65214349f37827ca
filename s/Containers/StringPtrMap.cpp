#include "Orn_Hdl/Containers/StringPtrMap.h"

#include "Containers/HashByEights.h"
#include "Containers/HashSlots.h"
#include "Port/Ascii.h"

#include <algorithm>
#include <cstdint>
#include <string>
#include <utility>
#include <vector>

namespace Orn_Hdl {

/// The entries are in a list. A few entries are compared one by one; more are found by a hash table
/// of their indices.
struct IStringPtrMapBase::Table {
    struct Entry {
        std::string name;
        void* pointer;
    };

    static constexpr std::size_t MostUnindexed = 8;

    std::vector<Entry> entries;
    /// The index plus 1 of each entry; empty as long as there are few entries.
    HashSlots<std::uint32_t> places;

    static std::uint32_t PlaceValue(std::size_t entry) noexcept {
        return static_cast<std::uint32_t>(entry + 1);
    }

    /// The entry of a name; null if there is none.
    Entry* Find(std::string_view name) noexcept {
        const auto isNamed = [name](const Entry& entry) {
            return Port::EqualIgnoringCase(entry.name, name);
        };
        if (places.GetSize() == 0) {
            const auto found = std::find_if(entries.begin(), entries.end(), isNamed);
            return found == entries.end() ? nullptr : &*found;
        }
        const std::uint32_t hash = HashUpperByEights(name);
        const std::uint32_t place =
            places.Find(hash, [this, hash, &isNamed](std::uint32_t other, std::uint32_t value) {
                return other == hash && isNamed(entries[value - 1]);
            });
        return place == 0 ? nullptr : &entries[place - 1];
    }

    void Insert(std::string_view name, void* pointer) {
        // Allocation comes first, so that no entry lacks its slot if it fails.
        if (places.GetSize() == 0 && entries.size() >= MostUnindexed) {
            HashSlots<std::uint32_t> all;
            for (std::size_t i = 0; i < entries.size(); ++i) {
                all.Add(HashUpperByEights(entries[i].name), PlaceValue(i));
            }
            places = std::move(all);
        }
        if (places.GetSize() > 0) {
            places.MakeRoom();
        }
        entries.push_back({std::string(name), pointer});
        if (places.GetSize() > 0) {
            places.Add(HashUpperByEights(name), PlaceValue(entries.size() - 1));
        }
    }

    void Erase(Entry& entry) noexcept {
        Entry& last = entries.back();
        if (places.GetSize() > 0) {
            const auto placeOf = [this](const Entry& any) {
                return PlaceValue(static_cast<std::size_t>(&any - entries.data()));
            };
            places.Remove(HashUpperByEights(entry.name), placeOf(entry));
            if (&entry != &last) {
                places.Replace(HashUpperByEights(last.name), placeOf(last), placeOf(entry));
            }
        }
        if (&entry != &last) {
            entry = std::move(last);
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
    if (Table::Entry* found = table_->Find(name)) {
        found->pointer = pointer;
    } else {
        table_->Insert(name, pointer);
    }
}

void* IStringPtrMapBase::Get(std::string_view name) const noexcept {
    const Table::Entry* const found = table_ == nullptr ? nullptr : table_->Find(name);
    return found == nullptr ? nullptr : found->pointer;
}

bool IStringPtrMapBase::Contains(std::string_view name) const noexcept {
    return table_ != nullptr && table_->Find(name) != nullptr;
}

void IStringPtrMapBase::Remove(std::string_view name) noexcept {
    if (table_ != nullptr) {
        if (Table::Entry* found = table_->Find(name)) {
            table_->Erase(*found);
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
