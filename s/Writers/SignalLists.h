// Which signals a writer has something to write for.
#pragma once

#include "Orn_Hdl/Language.h"
#include "Orn_Hdl/Model/Netlist.h"

#include <string_view>
#include <vector>

namespace Orn_Hdl::Writers {

/// The signals that are declared or assigned, gathered in one walk, each list in the netlist's
/// order.
struct SignalLists {
    /// \param language the signals that it cannot write are left out.
    SignalLists(const Netlist& netlist, Language language);

    std::vector<Signal*> ports;
    /// Declared, but no ports.
    std::vector<Signal*> internals;
    std::vector<Signal*> constants;
    /// Each is assigned each signal of its own list.
    std::vector<Signal*> aliased;
};

/// Whether a signal of that name can be written: it needs a name, and in VHDL another one than the
/// reserved word "open".
bool IsWritable(Language language, std::string_view name);

/// Whether a slice of more than one bit counts the other way than the bus that it is a part of.
bool RunsAgainstParent(const Signal& signal);

} // namespace Orn_Hdl::Writers
