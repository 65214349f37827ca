#!/usr/bin/env python3
"""Random designs, written and read back by real tools: every connection must be the one that was made.

Yosys reads the Verilog; GHDL reads the VHDL and makes Verilog of it, which Yosys reads. Each bit of
each port and pin must be on the same net as in the generator's own account, or be the same
constant; in Verilog each range and generic must be the same too. The VHDL of designs with two-way
ports is analysed only: GHDL makes two nets of such a port.
"""

from __future__ import annotations

import argparse
import json
import random
import re
import shutil
import sys
import tempfile
from collections.abc import Callable, Iterator
from pathlib import Path
from typing import Any

from judging import Tally
from judges import Ghdl, Rejected, quoted, run_yosys
from random_designs import ONE, ZERO, Bit, Leaf, Pin, RandomDesign, random_leaves
from tool import Tool

BATCH = 50  # designs over the same leaf cells, read by one run of each tool
DIRECTIONS = {"i": "input", "o": "output", "b": "inout"}

Module = dict[str, Any]


# The leaf cells.

def leaf_modules(leaves: list[Leaf]) -> str:
    return "".join(
        f"(* blackbox *) module {leaf.name}({', '.join(map(_verilog_port, leaf.pins))});"
        + "".join(f" parameter {name} = {len(digits)}'b{digits};"
                  for name, digits in leaf.generics.items())
        + " endmodule\n" for leaf in leaves)


def _verilog_port(pin: Pin) -> str:
    bounds = "" if pin.left is None else f"[{pin.left}:{pin.right}] "
    return f"{DIRECTIONS[pin.direction]} {bounds}{pin.name}"


# What must agree.

class Wiring:
    """Pairs each net of a design with one that was read; no net may have two partners."""

    def __init__(self) -> None:
        self._partners: dict[Any, Any] = {ZERO: "0", ONE: "1"}
        self._back: dict[Any, Any] = {"0": ZERO, "1": ONE}

    def meet(self, place: str, told: Bit, read: int | str) -> None:
        if (self._partners.setdefault(told, read) != read or
                self._back.setdefault(read, told) != told):
            raise Rejected(f"{place}: {told} is on {self._partners[told]}, "
                           f"{read} on {self._back.get(read)}")


class Comparison:
    """A design and the module that was read of it, both without letter case."""

    def __init__(self, design: RandomDesign, modules: dict[str, Module]) -> None:
        self.design = design
        module = modules[design.name]
        self.ports = _lower(module["ports"])
        self.cells = _lower(module["cells"])
        self.wiring = Wiring()
        _refuse_other_names("ports", {signal.name for signal in design.ports()}, self.ports)
        _refuse_other_names("instances", set(design.instances), self.cells)

    def refuse_other_wiring(self) -> None:
        for signal in self.design.ports():
            port = self.ports[signal.name.lower()]
            if not DIRECTIONS[signal.direction[0]] == port["direction"]:
                raise Rejected(f"port {signal.name}: {port}")
            self._meet(f"port {signal.name}", self.design.bits_of(signal), port["bits"])
        for instance, leaf in self.design.instances.items():
            connections = _lower(self.cells[instance.lower()]["connections"])
            for pin in leaf.pins:
                self._meet(f"pin {instance}.{pin.name}", self.design.bits_at(instance, pin),
                           connections.get(pin.name.lower(), []))

    def _meet(self, place: str, told: list[Bit], read: list[int | str]) -> None:
        """Reads from the left. What nothing drives or reads may be an open pin or of any value."""
        if not told and self.design.closes_open_pins:
            return
        read = read[::-1] or [f"nothing at {place}, {position}" for position in range(len(told))]
        if len(told) != len(read):
            raise Rejected(f"{place}: {len(read)} bits in place of {len(told)}")
        for position, (one, other) in enumerate(zip(told, read)):
            bit_place = f"{place}, bit {position} from the left"
            if other not in ("x", "z"):
                self.wiring.meet(bit_place, one, other)
            elif self.design.is_driven(one):
                raise Rejected(f"{bit_place}: {other} in place of {one}")

    def refuse_other_details(self) -> None:
        """Ranges, types and generics, which GHDL does not keep."""
        for signal in self.design.ports():
            _refuse_other_range(signal.name, signal.left, signal.right,
                                self.ports[signal.name.lower()])
        for instance, leaf in self.design.instances.items():
            cell = self.cells[instance.lower()]
            if (cell["type"], cell["parameters"]) != (leaf.name, self.design.generics[instance]):
                raise Rejected(f"instance {instance}: {cell}")


def refuse_other_verilog(design: RandomDesign, modules: dict[str, Module]) -> None:
    comparison = Comparison(design, modules)
    comparison.refuse_other_wiring()
    comparison.refuse_other_details()


def refuse_other_vhdl(design: RandomDesign, modules: dict[str, Module]) -> None:
    Comparison(design, modules).refuse_other_wiring()


def _lower(table: dict[str, Any]) -> dict[str, Any]:
    return {name.lower(): value for name, value in table.items()}


def _refuse_other_names(what: str, told: set[str], read: dict[str, Any]) -> None:
    different = {name.lower() for name in told} ^ read.keys()
    if different:
        raise Rejected(f"{what} differ: {sorted(different)}")


def _refuse_other_range(name: str, left: int | None, right: int | None, port: Module) -> None:
    told = (0, 0) if left is None else (left, right)
    low, upto = port.get("offset", 0), port.get("upto", 0)
    high = low + len(port["bits"]) - 1
    if told != ((low, high) if upto else (high, low)):
        raise Rejected(f"port {name}: {told} has become {low} to {high}, upto {upto}")


# The flow.

class Batch:
    """Designs over the same leaf cells, read by one run of Yosys for each language."""

    def __init__(self, tally: Tally, tool: Tool, seeds: list[int], work: Path) -> None:
        work.mkdir(parents=True)
        self.tally = tally
        self.tool = tool
        self.work = work
        self.leaves = random_leaves(random.Random(f"leaves {seeds[0] // BATCH}"))
        self.designs = [RandomDesign(f"d{seed}", seed, self.leaves) for seed in seeds]

    def check(self) -> None:
        self.designs = [design for design in self.designs
                        if self.tally.check(f"{design.name}: written", self._write, design)]
        (self.work / "leaves.v").write_text(leaf_modules(self.leaves))
        self._compare("Verilog", self.designs, refuse_other_verilog, 
                      "read_verilog -lib leaves.v; read_verilog",
                      [self.work / f"{design.name}.v" for design in self.designs])
        ghdl = Ghdl("08", self._folder("ghdl"))
        analysed = [design for design in self.designs
                    if self.tally.check(f"{design.name}: VHDL analysis", ghdl.analyse,
                                        self.work / f"{design.name}.vhd")]
        one_way = [design for design in analysed if not design.has_two_way_ports]
        synthesised = self._folder("synthesised")
        for design in one_way:
            ghdl.synthesise(design.name, synthesised / f"{design.name}.v")
        # The leaf cells are in every file.
        self._compare("VHDL", one_way, refuse_other_vhdl, "read_verilog -sv -nooverwrite",
                      [synthesised / f"{design.name}.v" for design in one_way])

    def _folder(self, name: str) -> Path:
        (self.work / name).mkdir()
        return self.work / name

    def _write(self, design: RandomDesign) -> None:
        source = self.work / f"{design.name}.cmd"
        source.write_text("\n".join(design.commands) + "\n")
        self.tool.run(self.work, "run", "--quiet", source)

    def _compare(self, language: str, designs: list[RandomDesign],
                 refuse: Callable[[RandomDesign, dict[str, Module]], None],
                 script: str, files: list[Path]) -> None:
        modules = designs and self.tally.check(f"{designs[0].name} and following: {language}",
                                               self._read, script, files)
        for design in designs if modules else ():
            self.tally.check(f"{design.name}: {language}", refuse, design, modules)

    def _read(self, script: str, files: list[Path]) -> dict[str, Module]:
        run_yosys(f"{script} {' '.join(map(quoted, files))}; hierarchy -check; proc; "
                  f"write_json read.json", self.work)
        return json.loads((self.work / "read.json").read_text())["modules"]


def batches(first: int, last: int) -> Iterator[list[int]]:
    for start in range(first - first % BATCH, last + 1, BATCH):
        yield [seed for seed in range(start, start + BATCH) if first <= seed <= last]


def parse_seeds(text: str) -> tuple[int, int]:
    first, _, last = text.partition("-")
    return int(first), int(last or first)


def main() -> int:
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("--tool", type=Path, required=True, help="the orn-hdl to be judged")
    parser.add_argument("--seeds", type=parse_seeds, default=(1, 100), metavar="FIRST-LAST")
    parser.add_argument("--work", type=Path, help="keep all files in this folder")
    options = parser.parse_args()
    first, last = options.seeds
    print(f"seeds {first} to {last}", flush=True)
    tally = Tally()
    with tempfile.TemporaryDirectory() as scratch:
        for seeds in batches(first, last):
            work = (options.work or Path(scratch)).resolve() / f"from_{seeds[0]}"
            shutil.rmtree(work, ignore_errors=True)
            Batch(tally, Tool(options.tool), seeds, work).check()
            if not options.work:
                shutil.rmtree(work)
    return tally.close()


if __name__ == "__main__":
    sys.exit(main())
