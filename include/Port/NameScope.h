/// \file
/// `NameScope`: the names of one scope, and names for what needs another one.
#pragma once

#include "Port/Ascii.h"
#include "Port/TextSet.h"

#include <cstddef>
#include <cstdint>
#include <memory_resource>
#include <string>
#include <string_view>
#include <unordered_map>

namespace Port {

/// The names of one scope. Names that differ only in letter case are the same. Millions of names
/// are stored in a few blocks of memory.
class NameScope {
public:
    /// A scope without names.
    NameScope() = default;
    NameScope(const NameScope&) = delete;
    NameScope& operator=(const NameScope&) = delete;

    /// Makes room for a number of names.
    void Reserve(std::size_t count) { taken_.Reserve(count); }
    /// Claims a name. \return false if it is claimed already.
    bool Claim(std::string_view name) {
        return taken_.Add(name, [this](std::string_view text) { return Keep(text); });
    }
    /// Whether a name is claimed.
    bool IsTaken(std::string_view name) const { return taken_.Find(name) != nullptr; }
    /// How a claimed name is spelled; empty for any other name.
    std::string_view GetSpelling(std::string_view name) const { return taken_.Get(name); }

    /// Claims the wanted name, or else the first of it with _1, _2 and so on that is free.
    /// \param isAllowed whether the wanted name itself may be had.
    /// \param isFree asked of each name that is free here: whether it may be had.
    template <class IsFree>
    std::string ClaimNumbered(const std::string& wanted, bool isAllowed, const IsFree& isFree) {
        if (isAllowed && !IsTaken(wanted) && isFree(wanted)) {
            Claim(wanted);
            return wanted;
        }
        auto number = numbers_.find(wanted);
        if (number == numbers_.end()) {
            number = numbers_.emplace(Keep(wanted), 0).first;
        }
        std::string numbered;
        do {
            numbered = wanted + "_" + std::to_string(++number->second);
        } while (IsTaken(numbered) || !isFree(numbered));
        Claim(numbered);
        return numbered;
    }

private:
    struct Hash {
        std::uint64_t operator()(std::string_view name) const noexcept {
            // FNV-1a over the letters in one case. What the last ones change of it reaches the
            // upper bits in the end.
            std::uint64_t hash = 14695981039346656037U;
            for (const char c : name) {
                hash = (hash ^ static_cast<unsigned char>(ToUpper(c))) * 1099511628211U;
            }
            return (hash ^ (hash >> 32U)) * 0x9E3779B97F4A7C15U;
        }
    };
    struct Equal {
        bool operator()(std::string_view a, std::string_view b) const noexcept {
            return EqualIgnoringCase(a, b);
        }
    };

    std::string_view Keep(std::string_view name) {
        char* const copy = static_cast<char*>(memory_.allocate(name.size(), 1));
        name.copy(copy, name.size());
        return std::string_view(copy, name.size());
    }

    std::pmr::monotonic_buffer_resource memory_;
    TextSet<Hash, Equal> taken_;
    /// The last number of each numbered name.
    std::pmr::unordered_map<std::string_view, std::size_t, Hash, Equal> numbers_{&memory_};
};

} // namespace Port
