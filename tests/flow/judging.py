"""All judges over one netlist in both languages, with a tally of what passed."""

from __future__ import annotations

import argparse
import re
import shutil
import subprocess
import sys
import tempfile
from collections.abc import Callable, Sequence
from dataclasses import dataclass, field
from pathlib import Path
from typing import Any, TypeVar

# Whoever imports from the judges' folder imports this module first.
sys.path.insert(0, str(Path(__file__).resolve().parents[1] / "judges"))

import judges  # noqa: E402
from equivalence import OWN_CELLS, Netlist, prove_equivalent, same_names  # noqa: E402
from judges import CELL_BODIES, Ghdl, Rejected  # noqa: E402
from vectors import Bench, Stimulus, ports_of, refuse_difference  # noqa: E402

Result = TypeVar("Result")


class Tally:
    """Counts checks; a failed one is reported at once and does not stop the others."""

    def __init__(self) -> None:
        self.passed = 0
        self.failed = 0
        self.refused = 0

    def check(self, what: str, judge_: Callable[..., Result],
              *arguments: Any) -> Result | bool:
        """The judge's answer, True when it gives none, False when it rejects."""
        try:
            answer = judge_(*arguments)
        except (Rejected, subprocess.TimeoutExpired, OSError) as failure:
            self.failed += 1
            print(f"FAIL {what}: {failure}", flush=True)
            return False
        self.passed += 1
        return True if answer is None else answer

    def refuse(self, what: str, message: str) -> None:
        """Counts what cannot be checked because orn-hdl refuses it with the right message."""
        self.refused += 1
        print(f"refused {what}: {message}", flush=True)

    def close(self) -> int:
        """Prints the closing line; returns the exit status."""
        refused = f", {self.refused} refused with a reason" if self.refused else ""
        print(f"{self.passed} passed, {self.failed} failed{refused}")
        return 1 if self.failed else 0


@dataclass(frozen=True)
class Design:
    """A design to be judged: its name is that of its top module and entity."""

    name: str
    stimulus: Stimulus = Stimulus()
    source: Path | None = None  # RTL or command file
    rtl: Path | None = None  # what the netlist must behave like
    rtl_top: str | None = None  # when it is not the name
    iverilog_allows: tuple[str, ...] = ()
    yosys_allows: tuple[str, ...] = ()


@dataclass
class Forms:
    """The written netlists of a design, and what its ports are called there."""

    verilog: Path
    vhdl: Path
    port_names: dict[str, str] = field(default_factory=dict)  # of the RTL to that of the netlist

    def name_of(self, port: str) -> str:
        return self.port_names.get(port, port)


def judge(tally: Tally, label: str, design: Design, forms: Forms, work: Path) -> None:
    """Every tool on both languages, then their equivalence, then simulation with vectors."""
    top = design.name

    def check(what: str, *arguments: Any) -> Any:
        return tally.check(f"{label}: {what}", *arguments)

    check("iverilog", judges.iverilog, forms.verilog, top, design.iverilog_allows)
    check("verilator", judges.verilator, forms.verilog, top)
    check("yosys", judges.yosys, forms.verilog, top, design.yosys_allows)
    editions = {}
    for standard in ("93", "08"):
        ghdl = Ghdl(standard, _new_folder(work / f"vhdl{standard}"))
        if check(f"ghdl {standard} analysis", ghdl.analyse, forms.vhdl) and \
                check(f"ghdl {standard} elaboration", ghdl.elaborate, top):
            editions[standard] = ghdl
    if "93" in editions:
        check("VHDL equivalent to Verilog", prove_languages_agree, top, forms, work)
    check("simulation", simulate, design, forms, editions, work)


def _new_folder(folder: Path) -> Path:
    folder.mkdir(parents=True)
    return folder


def prove_languages_agree(top: str, forms: Forms, work: Path) -> None:
    """Proves the VHDL, as GHDL synthesises it, equivalent to the Verilog.

    Attributes are left out, since they are no part of the circuit and GHDL 2.0 stumbles over
    those of ports.
    """
    bare = work / "bare.vhd"
    attribute = r'^ *attribute \w+ *(?:of|:)(?:"[^"]*"|[^";])*;'
    bare.write_text(re.sub(attribute, "", forms.vhdl.read_text(), flags=re.MULTILINE))
    ghdl = Ghdl("93", _new_folder(work / "synthesis"))
    ghdl.analyse(bare)
    synthesised = work / "synthesised.v"
    ghdl.synthesise(top, synthesised)
    gold = Netlist.read(forms.verilog, top, work)
    gate = Netlist.read(synthesised, top, work, OWN_CELLS)
    prove_equivalent(gold, gate, same_names(gold, gate), work, outer_pins=False)


def simulate(design: Design, forms: Forms, editions: dict[str, Ghdl], work: Path) -> None:
    """Same vectors, same results; the RTL says which, or without one the Verilog netlist."""
    source, top = design.rtl or forms.verilog, design.rtl_top or design.name
    bench = Bench(design.name, ports_of(source, top, work), design.stimulus, work)
    netlist = bench.run_verilog([forms.verilog, CELL_BODIES], design.name, forms.name_of)
    expected = netlist
    if design.rtl:
        expected = bench.run_verilog([design.rtl, CELL_BODIES], top)
        if any("x" in line for line in expected):
            raise Rejected(f"the RTL of {design.name} has unknown outputs: no use as a measure")
    refuse_difference(expected, netlist, "Verilog netlist")
    for standard, ghdl in editions.items():
        refuse_difference(expected,
                          bench.run_vhdl(ghdl, forms.vhdl, design.name, forms.name_of),
                          f"VHDL-{standard} netlist")


def main(description: str, designs: Sequence[Design],
         run: Callable[[Tally, Path, Design, Path], None]) -> int:
    """The command line of a flow: `run` takes the tally, the tool, a design and a fresh folder."""
    parser = argparse.ArgumentParser(description=description)
    parser.add_argument("--tool", type=Path, required=True, help="the orn-hdl to be judged")
    parser.add_argument("--design", choices=[design.name for design in designs],
                        metavar="NAME", help="only this one")
    parser.add_argument("--work", type=Path, help="keep all files in this folder")
    options = parser.parse_args()
    tally = Tally()
    with tempfile.TemporaryDirectory() as scratch:
        for design in designs:
            if options.design in (None, design.name):
                work = (options.work or Path(scratch)).resolve() / design.name
                shutil.rmtree(work, ignore_errors=True)
                work.mkdir(parents=True)
                run(tally, options.tool, design, work)
    return tally.close()
