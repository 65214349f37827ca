// Finds the lines of a netlist that say what a comparison tells.
#pragma once

#include "diff/Difference.h"

#include <cstdint>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace Tool::Diff {

/// What is looked for in one file, by the kind of object and its names. A reader of the file, which
/// need not understand all of it, tells what it comes across; the first line counts.
class PlaceFinder {
public:
    enum class What : std::uint8_t {
        Module,
        Component,
        Pin,
        Instance,
        Signal,
        Connection,
        Assignment
    };

    /// \param design the name of the design in the file.
    PlaceFinder(const std::vector<Side*>& sides, std::string design);

    /// The name of the design in the file.
    const std::string& GetDesign() const noexcept { return design_; }
    /// Whether something of that name is looked for, letter case ignored.
    bool Wants(std::string_view name) const;
    /// Tells that a line says something. \param first the name of the object, without a range.
    /// \param second the name of a pin; empty for other objects.
    void Found(What what, std::string_view first, std::string_view second, std::uint64_t line);

private:
    void Want(Side& side);
    void Want(What what, std::string_view first, std::string_view second, Side& side, int rank);

    struct Place {
        Side* side = nullptr;
        /// How well it tells what is looked for; 0 is best.
        int rank = 0;
    };

    const std::string design_;
    std::unordered_map<std::string, std::vector<Place>> places_;
    std::unordered_map<std::uint64_t, bool> names_;
    /// The rank of the line that a side has.
    std::unordered_map<const Side*, int> ranks_;
};

/// Reads a Verilog netlist. \param systemName the name under which the system opens it.
void FindVerilogPlaces(const char* systemName, PlaceFinder& finder);
/// Reads a VHDL netlist.
void FindVhdlPlaces(const char* systemName, PlaceFinder& finder);
/// Reads JSON as Yosys writes it.
void FindJsonPlaces(const char* systemName, PlaceFinder& finder);

} // namespace Tool::Diff
