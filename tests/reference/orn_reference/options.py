"""The settings that commands change and the writers read."""

from __future__ import annotations

from dataclasses import dataclass, field
from enum import Enum


class Case(Enum):
    AS_ENTERED = 10
    UPPER = 11
    LOWER = 12


SYNTHESIS_TYPES = (b"QSN", b"EXEMPLAR", b"SYNPLICITY", b"SYNOPSYS", b"VERILOG2001", b"PRECISION")


@dataclass
class Options:
    # VHDL
    suppress_configuration: bool = False
    flatten_bus: bool = False
    use_default_library: bool = True
    libraries: list[bytes] = field(default_factory=list)
    use_clauses: list[bytes] = field(default_factory=list)
    typed_attributes: bool = False
    open_pin: bool = True
    suppress_component: bool = False
    # Verilog
    synthesis_type: bytes = b"QSN"
    signal_case: Case = Case.AS_ENTERED
    instance_case: Case = Case.AS_ENTERED
    component_case: Case = Case.AS_ENTERED
    includes: list[bytes] = field(default_factory=list)
    # Both
    write_header: bool = True
    one_port_per_line: bool = True
    application: bytes = b""
    command: bytes = b""
    device: bytes = b""
    purpose: bytes = b""
    reference: bytes = b""

    def set_synthesis_type(self, text: bytes) -> None:
        known = text.upper() in SYNTHESIS_TYPES
        self.synthesis_type = text.upper() if known else b"QSN"
