"""A slow and obvious second implementation of the netlist writer, used to check the real one."""
