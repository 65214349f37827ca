// Hints to a netlist about the command lines to come.
#pragma once

#include "HdlModel/Netlist/Foresight.h"
#include "Orn_Hdl/Containers/StringArray.h"
#include "Orn_Hdl/Model/Netlist.h"

#include <cstddef>

namespace Orn_Hdl {

/// Gives the reader of command files access to the `Foresight` of a netlist.
class ReadAhead {
public:
    /// How many lines before its execution a line is noted.
    static constexpr std::size_t Distance = Foresight::Distance;
    /// Hints that a line, split into words, will be executed `Distance` lines later, so that what
    /// it names is fetched in the meantime. Changes nothing.
    static void Note(Netlist& netlist, const StringArray& words) noexcept;
    /// Like the overload with words, for a line whose names have been hashed by
    /// `Foresight::HashNames`.
    static void Note(Netlist& netlist, const Foresight::Hashes& names) noexcept;
};

} // namespace Orn_Hdl
