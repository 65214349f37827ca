// The names of one scope.
#pragma once

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
    UniqueNames() = default;
    UniqueNames(const UniqueNames&) = delete;
    UniqueNames& operator=(const UniqueNames&) = delete;

    /// Makes room for a number of names.
    void Reserve(std::size_t count) { taken_.reserve(count); }
    /// Claims a name. \return false if it is claimed already.
    bool Claim(std::string_view name);
    bool IsTaken(std::string_view name) const { return taken_.count(name) != 0; }
    /// Claims a legal name that resembles `name`, with a number if it is claimed already.
    std::string ClaimSimilar(std::string_view name, char initial);

private:
    struct Hash {
        std::size_t operator()(std::string_view name) const noexcept;
    };
    struct Equal {
        bool operator()(std::string_view a, std::string_view b) const noexcept;
    };

    std::string_view Keep(std::string_view name);

    std::pmr::monotonic_buffer_resource memory_;
    std::pmr::unordered_set<std::string_view, Hash, Equal> taken_{&memory_};
    /// The last number of each numbered name.
    std::pmr::unordered_map<std::string_view, std::size_t, Hash, Equal> numbers_{&memory_};
};

} // namespace Tool::Import
