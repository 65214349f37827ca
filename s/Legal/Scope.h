// The names of one scope.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <unordered_map>
#include <unordered_set>

namespace Orn_Hdl::Legal {

/// The names of one scope. Names that differ only in letter case are the same.
class Scope {
public:
    /// Makes room for a number of names.
    void Reserve(std::size_t count) { taken_.reserve(count); }
    /// Claims a name. \return false if it is claimed already.
    bool Claim(std::string_view name);
    bool IsTaken(std::string_view name) const { return taken_.count(name) != 0; }
    /// Claims the wanted name, or else the first of it with _1, _2 and so on that is free here and
    /// in the other scope. What is claimed is legal.
    /// \param other may be null.
    std::string ClaimSimilar(std::string_view wanted, const Scope* other = nullptr);

private:
    struct Hash {
        using is_transparent = void;
        std::size_t operator()(std::string_view name) const noexcept;
    };
    struct Equal {
        using is_transparent = void;
        bool operator()(std::string_view a, std::string_view b) const noexcept;
    };

    std::unordered_set<std::string, Hash, Equal> taken_;
    /// The last number of each wanted name that was numbered.
    std::unordered_map<std::string, std::size_t, Hash, Equal> numbers_;
};

} // namespace Orn_Hdl::Legal
