// The names of one scope.
#pragma once

#include "import/NameRules.h"

#include <cstddef>
#include <memory_resource>
#include <string>
#include <string_view>
#include <unordered_map>
#include <unordered_set>

namespace Tool::Import {

/// The names of one scope. Names that differ only in letter case are the same. Millions of names
/// are stored in a few blocks of memory.
class UniqueNames {
public:
    explicit UniqueNames(const NameRules& rules) noexcept : rules_(rules) {}
    UniqueNames(const UniqueNames&) = delete;
    UniqueNames& operator=(const UniqueNames&) = delete;

    const NameRules& GetRules() const noexcept { return rules_; }
    /// Makes room for a number of names.
    void Reserve(std::size_t count) { taken_.reserve(count); }
    /// Claims a name. \return false if it is claimed already.
    bool Claim(std::string_view name);
    bool IsTaken(std::string_view name) const { return taken_.count(name) != 0; }
    /// Claims a name that needs no change. \return false if it is not legal or claimed already.
    bool ClaimLegal(std::string_view name) { return rules_.IsLegal(name) && Claim(name); }
    /// Claims a name that is the same identifier in the netlist: the name itself, or an escaped
    /// form of it. \return the empty text if there is none, or if the identifier is claimed.
    std::string ClaimSame(std::string_view name) { return ClaimForm(name, false); }
    /// Claims a name that is the same identifier in the netlist, for a module: other objects may
    /// have the same identifier, but the library needs different names.
    std::string ClaimModule(std::string_view name) { return ClaimForm(name, true); }
    /// Claims a legal name that resembles `name`, with a number if it is claimed already.
    std::string ClaimSimilar(std::string_view name, char initial);

private:
    struct Hash {
        std::size_t operator()(std::string_view name) const noexcept;
    };
    struct Equal {
        bool operator()(std::string_view a, std::string_view b) const noexcept;
    };

    std::string ClaimForm(std::string_view name, bool sharesIdentifier);
    std::string_view Keep(std::string_view name);

    const NameRules rules_;
    std::pmr::monotonic_buffer_resource memory_;
    std::pmr::unordered_set<std::string_view, Hash, Equal> taken_{&memory_};
    /// The last number of each numbered name.
    std::pmr::unordered_map<std::string_view, std::size_t, Hash, Equal> numbers_{&memory_};
};

} // namespace Tool::Import
