// The signals that a writer declares or assigns.
#pragma once

#include "Orn_Hdl/Language.h"
#include "Orn_Hdl/Model/Netlist.h"

#include <string_view>
#include <vector>

namespace Orn_Hdl::Writers {

/// The signals that are declared or assigned, collected in one walk, each list in the order of the
/// netlist.
struct SignalLists {
    /// \param language signals that cannot be written in it are omitted.
    SignalLists(const Netlist& netlist, Language language);

    std::vector<Signal*> ports;
    /// The declared signals that are not ports.
    std::vector<Signal*> internals;
    std::vector<Signal*> constants;
    /// The signals with aliases; each alias is assigned to its signal.
    std::vector<Signal*> aliased;
    /// The `internals` with attributes.
    std::vector<Signal*> attributed;

    /// \{
    /// The lengths of the longest names in the netlist, omitted signals included: of its ports and
    /// their parts, of its declared signals, and of the attributes of its signals.
    int longestPort = 0;
    int longestDeclared = 0;
    int longestAttr = 0;
    /// \}

private:
    void Measure(const Signal& signal) noexcept;
    void Add(Signal& signal);
};

/// Whether a signal of that name can be written: the name must not be empty and, in VHDL, not the
/// reserved word "open".
bool IsWritable(Language language, std::string_view name);

/// Whether a slice of more than one bit is against its bus: one range descends, the other ascends.
bool RunsAgainstParent(const Signal& signal);

} // namespace Orn_Hdl::Writers
