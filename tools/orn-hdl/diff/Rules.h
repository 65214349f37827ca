// What counts in a comparison of two designs.
#pragma once

namespace Tool::Diff {

struct Rules {
    /// \{
    /// What the user wants compared.
    bool names = true;
    bool attributes = true;
    bool comments = true;
    bool order = true;
    /// \}

    /// \{
    /// What the formats of both files tell.
    /// Whether an alias makes one net of two, a constant is no net, and internal nets have names
    /// that say nothing: they are compared by what is wired to them.
    bool mergesNets = false;
    /// Whether attributes are compared with type and options, and on all objects. Otherwise only
    /// what a netlist states is: generics and synthesis attributes of ports, signals and instances.
    bool hasExactAttributes = true;
    /// Whether attributes other than generics are told.
    bool hasSynthesisAttributes = true;
    /// Whether components are told that no instance is of, and pins that nothing is wired to.
    bool hasUnusedParts = true;
    /// Whether the indices of the pins of components are told, and ranges of one bit.
    bool hasPinRanges = true;
    /// Whether one of the files tells the order of the ports. What commands make has the ports
    /// sorted.
    bool hasPortOrder = true;
    /// Whether both files name the design.
    bool hasDesignName = true;
    /// \}
};

} // namespace Tool::Diff
