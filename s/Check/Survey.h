// Which objects of a large design are worth more than a glance.
#pragma once

#include "Orn_Hdl/Model/Netlist.h"
#include "Orn_Hdl/Options.h"

#include <vector>

namespace Orn_Hdl::Checking {

/// Most objects of a large design are scalar nets and instances with a plain name, and nothing else
/// about them could be wrong. The survey lists the others once, and the topics look at these alone.
class Survey {
public:
    explicit Survey(const HdlOptions& options) : options_(options) {}

    /// \{
    /// Takes an object in, in the order of the netlist.
    void Look(const Signal& signal);
    void Look(const Instance& instance);
    /// \}

    /// Signals that are buses, ports or open, or have attributes, a comment, a constant, an alias,
    /// a name that a target may reject, or one that the library gives to signals of its own.
    const std::vector<const Signal*>& GetSignals() const noexcept { return signals_; }
    /// Instances with attributes, their component's included, with a comment, or with a name that a
    /// target may reject.
    const std::vector<const Instance*>& GetInstances() const noexcept { return instances_; }

private:
    const HdlOptions& options_;
    std::vector<const Signal*> signals_;
    std::vector<const Instance*> instances_;
};

} // namespace Orn_Hdl::Checking
