// The names that several objects of a design have in common.
#pragma once

#include "Orn_Hdl/Language.h"
#include "Orn_Hdl/Model/Netlist.h"

#include <string>
#include <string_view>
#include <unordered_set>

namespace Orn_Hdl::Proving {

/// The names of signals and instances that mean more than one of them in a netlist: only these have
/// to be looked up in the design. Found in a walk over the design, which is left alone.
class SharedNames {
public:
    SharedNames(const Netlist& design, Language language);

    /// \param name as it stands in the netlist, a bus without its range.
    bool Contains(std::string_view name) const;

private:
    std::string Folded(std::string_view name) const;

    const Language language_;
    std::unordered_set<std::string> names_;
};

} // namespace Orn_Hdl::Proving
