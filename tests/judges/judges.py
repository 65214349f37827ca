"""Real tools as judges of written netlists.

Every judge takes files and raises `Rejected` with the tool's own words when the tool does not
accept them. A warning is a rejection too, unless it matches one of the patterns that the caller
allows: a netlist has no business giving warnings that nobody expects.
"""

from __future__ import annotations

import re
import subprocess
from collections.abc import Iterable, Sequence
from pathlib import Path

CELLS = Path(__file__).resolve().parents[2] / "examples" / "cells"
CELL_BODIES = CELLS / "cells.v"
CELL_BLACK_BOXES = CELLS / "cells_bb.v"
CELL_ENTITIES = CELLS / "cells.vhd"
KESTRA_PACKAGE = CELLS / "kestra_vcomponents.vhd"

TIME_LIMIT = 120  # seconds; no judged file comes near it

# A netlist may read nets that it leaves open on purpose; callers that expect it allow this.
UNDRIVEN = r"is used but has no driver"
DANGLING_INPUT = r"with dangling input port"
# Said of every body that can drive "z"; the pads are meant to.
TRISTATE = r"limited support for tri-state"


class Rejected(Exception):
    """A tool did not accept what it was given."""


def run_tool(command: Sequence[str | Path],
             work: Path | None = None) -> subprocess.CompletedProcess[str]:
    """Runs a tool in the folder `work`; what it printed is in the result."""
    words = [str(word) for word in command]
    done = subprocess.run(words, cwd=work, text=True, errors="replace", capture_output=True,
                          stdin=subprocess.DEVNULL, timeout=TIME_LIMIT)
    if done.returncode != 0:
        raise Rejected(f"{' '.join(words)}\nexit status {done.returncode}\n"
                       f"{done.stdout}{done.stderr}")
    return done


def refuse_warnings(tool: str, output: str, allowed: Iterable[str]) -> None:
    """Rejects when a warning line of `output` matches none of the `allowed` patterns."""
    patterns = [re.compile(pattern) for pattern in allowed]
    unexpected = [line for line in output.splitlines()
                  if re.search(r"\bwarning\b", line, re.IGNORECASE)
                  and not any(pattern.search(line) for pattern in patterns)]
    if unexpected:
        raise Rejected(f"{tool} warns:\n" + "\n".join(unexpected))


# Verilog

def iverilog(netlist: Path, top: str, allowed: Iterable[str] = ()) -> None:
    """Icarus elaborates the netlist with the bodies of its leaf cells."""
    done = run_tool(["iverilog", "-g2005", "-Wall", "-tnull", "-s", top, netlist, CELL_BODIES])
    refuse_warnings("iverilog", done.stderr, allowed)


def verilator(netlist: Path, top: str, flags: Sequence[str] = ()) -> None:
    """Verilator lints the netlist; it fails on warnings by itself."""
    run_tool(["verilator", "--lint-only",
              # Buses that count upwards are legal and part of the output format.
              "-Wno-LITENDIAN",
              *flags, "--top-module", top, netlist, "-v", CELL_BODIES])


def yosys(netlist: Path, top: str, allowed: Iterable[str] = ()) -> None:
    """Yosys reads the netlist over black boxes and checks its nets: one driver each, no loops."""
    warnings = run_yosys(f"read_verilog -lib {quoted(CELL_BLACK_BOXES)}; "
                         f"read_verilog {quoted(netlist)}; hierarchy -check -top {top}; check")
    refuse_warnings("yosys", warnings, allowed)


def run_yosys(script: str, work: Path | None = None) -> str:
    """Runs a Yosys script; returns its warnings."""
    return run_tool(["yosys", "-q", "-p", script], work).stderr


def quoted(path: Path) -> str:
    """A path as one word of a Yosys script."""
    return f'"{path}"'


def simulate_verilog(sources: Sequence[Path], top: str, work: Path) -> str:
    """Compiles and runs a test bench with Icarus; returns what the test bench printed.

    A `$fatal` of the test bench is a rejection.
    """
    program = work / f"{top}.vvp"
    edition = "2012" if any(source.suffix == ".sv" for source in sources) else "2005"
    run_tool(["iverilog", f"-g{edition}", "-s", top, "-o", program, *sources])
    return run_tool(["vvp", "-n", program], work).stdout


# VHDL

class Ghdl:
    """GHDL for one edition of the language, with the leaf cells and the stub library analysed.

    Everything is analysed into a folder of the caller's; one netlist per `Ghdl`.
    """

    def __init__(self, standard: str, work: Path, has_leaf_cells: bool = True) -> None:
        self.work = work
        # Leaf cells index with signals, which are 'U' until time 0 is over.
        self.run_flags = ["--ieee-asserts=disable-at-0"]
        # VHDL-93 proper does not bind a component to the entity of its name in the same library;
        # every real tool does, and so do the later editions.
        self.flags = [f"--std={standard}", "--syn-binding", f"--workdir={work}", f"-P{work}"]
        if has_leaf_cells:
            self.analyse(KESTRA_PACKAGE, "KESTRA")
            self.analyse(CELL_ENTITIES)

    def analyse(self, source: Path, library: str = "work") -> None:
        run_tool(["ghdl", "-a", *self.flags, "--warn-error", f"--work={library}", source],
                 self.work)

    def elaborate(self, unit: str) -> None:
        """Elaborates an entity or a configuration; an unbound component is rejected."""
        run_tool(["ghdl", "-e", *self.flags, "--warn-error", unit], self.work)

    def run(self, unit: str) -> str:
        """Simulates a test bench until it stops by itself; a failed assertion is a rejection."""
        return run_tool(["ghdl", "-r", *self.flags, unit, *self.run_flags,
                         "--assert-level=error"], self.work).stdout

    def synthesise(self, unit: str, verilog: Path) -> None:
        """Writes the entity, and all that it instantiates, as Verilog, in small letters.

        Its warnings are no matter here: it mentions every bit of a bus that nothing drives.
        """
        done = run_tool(["ghdl", "--synth", *self.flags, "--out=verilog", unit], self.work)
        verilog.write_text(done.stdout)
