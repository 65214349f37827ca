// Definitions that a netlist may include; this one defines nothing.
