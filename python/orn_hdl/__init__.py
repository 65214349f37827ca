"""Structural Verilog and VHDL netlists from Python.

A `Design` holds components, instances and nets. It is built by calls, by lines of commands, or by reading a
netlist, in any mix:

    import orn_hdl

    d = orn_hdl.Design("top")
    a = d.port("A", "in", 8)
    and2 = d.component("AND2", I0="in", I1="in", O="out")
    u1 = d.instance("U1", and2, I0=a[0], I1=a[1], O=d.port("Y", "out"))
    d.execute("ADD INSTANCE COMMENT U1 'the only gate'")
    print(d.to_verilog())

Names are those of the library: letter case does not count, "D(7:0)" is a bus, "D(3:0)" a slice of it and "D(2)"
a bit. All exceptions are an `Error`. An object that has been removed from its design raises a `DeletedError`.
"""

from typing import List, Tuple

from . import _errors, _orn_hdl
from ._attributes import Attribute, Attributes, Holder
from ._bulk import Connections
from ._design import Counts, Design, Engine, Finding, Objects
from ._errors import (BusyError, ChangedError, ClosedError, CommandSyntaxError, DeletedError, Difference, Error,
                      InexpressibleError, InvalidValueError, LegalError, NameTakenError, NetlistError,
                      NotFoundError, ProofError)
from ._objects import Bit, Bus, Component, Compound, Constant, Instance, Net, Pin, Slice
from ._options import Options
from ._tool import find_tool, run_tool

__version__ = _orn_hdl.VERSION
__all__ = [
    "Attribute", "Attributes", "Bit", "Bus", "BusyError", "ChangedError", "ClosedError", "CommandSyntaxError",
    "Component", "Compound", "Connections", "Constant", "Counts", "DeletedError", "Design", "Difference",
    "Engine", "Error", "Finding", "Holder", "InexpressibleError", "Instance", "InvalidValueError", "LegalError",
    "NameTakenError", "Net", "NetlistError", "NotFoundError", "Objects", "Options", "Pin", "ProofError", "Slice",
    "catalogue", "find_tool", "run_tool"]

_orn_hdl.set_error_maker(_errors.make)


def catalogue() -> List[Tuple[str, str, str]]:
    """The commands: the phrase, the arguments and one line of help for each."""
    return _orn_hdl.catalogue()
