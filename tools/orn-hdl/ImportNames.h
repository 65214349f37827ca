// Names that both netlist languages can hold.
#pragma once

#include <cstddef>
#include <memory_resource>
#include <string>
#include <string_view>
#include <unordered_map>
#include <unordered_set>

namespace Tool::Import {

/// Whether a name can stand in both languages as it is: a VHDL basic identifier that is no word of
/// either language, no type that written VHDL mentions, and not of the form of the names that the
/// writers make themselves.
bool IsLegalName(std::string_view name);

/// A legal name that resembles `name`: what is not allowed becomes "_", never two in a row nor one
/// at either end. Of a name that a program made up, only the telling part is kept.
/// \param initial the letter put before a name that would begin with a digit or be empty.
std::string MakeLegalName(std::string_view name, char initial);

/// The names of one scope, unique but for letter case. Millions of them take one block of memory
/// after the other.
class NameTable {
public:
    NameTable() = default;
    NameTable(const NameTable&) = delete;
    NameTable& operator=(const NameTable&) = delete;

    /// Makes room for a number of names.
    void Reserve(std::size_t count) { taken_.reserve(count); }
    /// Takes a name. \return false when it is taken already.
    bool Claim(std::string_view name);
    bool IsTaken(std::string_view name) const { return taken_.count(name) != 0; }
    /// Takes a name that resembles `name`, numbered when that is not legal or not free.
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
    /// For each name that had to be numbered, the last number.
    std::pmr::unordered_map<std::string_view, std::size_t, Hash, Equal> numbers_{&memory_};
};

} // namespace Tool::Import
