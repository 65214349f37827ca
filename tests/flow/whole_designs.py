#!/usr/bin/env python3
"""Designs with hierarchy, from Yosys to both languages, with models for all cells.

Yosys writes each design of rtl/hierarchy as JSON twice: as word-level cells, and as gates after synth.
orn-hdl imports it with its modules. The Verilog has the same modules, cells and wires, and Yosys proves
each module equal; GHDL analyses the VHDL with the models that the import writes, and simulates it,
Icarus the Verilog with Yosys' own models: both show the same in every cycle, and what the RTL shows,
where that is known. What GHDL can synthesise of the VHDL is proven equal, too.
"""

from __future__ import annotations

import argparse
import itertools
import json
import tempfile
from collections.abc import Callable
from dataclasses import dataclass
from pathlib import Path

from judging import Tally
from judges import TRISTATE, Ghdl, Rejected, quoted, refuse_warnings, run_tool, run_yosys
from renaming import (Json, align_nets, load, read_name_map, refuse_other_wiring, restore,
                      split_nets, zero_unknown)
from tool import Tool, read_port_names
from vectors import CYCLES, Bench, Port, Stimulus

RTL = Path(__file__).resolve().parent / "rtl" / "hierarchy"
YOSYS = Path("/usr/share/yosys")

# The first cycles, in which registers without a reset may be unknown.
SETTLING = 60

FORMS = {
    "words": "proc; tribuf; opt; memory -nomap; opt; opt_clean",
    "gates": "proc; tribuf; synth",
}


@dataclass(frozen=True)
class Use:
    """A design used as it is meant to be used, and what it is to do then."""

    stimulus: Stimulus
    # Looks at the levels of all ports, cycle by cycle.
    check: Callable[[list[dict[str, str]]], None]


@dataclass(frozen=True)
class WholeDesign:
    name: str
    stimulus: Stimulus
    suffix: str = ".v"
    # Whether modules that nothing uses stay.
    keeps_all: bool = False
    # Whether word-level cells are memories, whose model GHDL cannot synthesise.
    has_memory: bool = False
    use: Use | None = None

    @property
    def source(self) -> Path:
        return RTL / f"{self.name}{self.suffix}"


def expect_sent_bytes(cycles: list[dict[str, str]]) -> None:
    """What the sender takes over comes out of the receiver."""
    sent = [cycle["send"] for cycle in cycles
            if cycle["start"] == "1" and cycle["busy"] == "0" and cycle["reset"] == "0"]
    got = [cycle["got"] for cycle in cycles if cycle["ready"] == "1"]
    if len(got) < 8 or got != sent[:len(got)] or len(sent) > len(got) + 1:
        raise Rejected(f"received {got} where {sent} was sent")


SERIAL_LINE = Use(Stimulus("clk", steady={"reset": (1, 0), "cut": (0, 0)}), expect_sent_bytes)

CLOCKED = Stimulus("clk")
RESET = Stimulus("clk", {"reset": 1})

DESIGNS = [
    WholeDesign("processor", RESET, has_memory=True),
    WholeDesign("queue", RESET, has_memory=True),
    WholeDesign("cipher_round", RESET),
    WholeDesign("serial_line", RESET, use=SERIAL_LINE),
    WholeDesign("sorting", CLOCKED),
    WholeDesign("sizes", Stimulus("clk", {"reset": 0})),
    WholeDesign("two_way", Stimulus("clk", {}, {"data": ("write", 1), "strobe": ("write", 1)})),
    WholeDesign("records", RESET, ".sv"),
    WholeDesign("odd_names", CLOCKED),
    WholeDesign("shared", CLOCKED, keeps_all=True),
    WholeDesign("levels", CLOCKED),
    WholeDesign("gated", RESET),
]


class Whole:
    """One design in one form, and what the import makes of it."""

    def __init__(self, tool: Tool, design: WholeDesign, form: str, work: Path) -> None:
        self.design, self.work = design, work
        work.mkdir(parents=True)
        # Without a top module, Yosys keeps what nothing uses.
        hierarchy = "-check" if design.keeps_all else f"-check -top {design.name}"
        self.source = work / "design.json"
        said = run_yosys(f"read_verilog -sv {quoted(design.source)}; hierarchy {hierarchy}; "
                         f"{FORMS[form]}; check -assert; write_json {quoted(self.source)}")
        refuse_warnings("yosys", said, [TRISTATE])
        tool.run(work, "import", "design.json", "--top", design.name, "--names", "both", "--x-as", "0",
                 "--legal", "--verify", "--no-kestra", "--verilog", "X.v", "--vhdl", "X.vhd",
                 "--write-cells", "cells.vhd", "--name-map", "X.map")
        self.verilog, self.vhdl = work / "X.v", work / "X.vhd"

    def gold(self) -> Json:
        """The design as Yosys wrote it, without the modules that the top module does not need."""
        target = self.work / "used.json"
        run_yosys(f"read_json {quoted(self.source)}; hierarchy -check -top {self.design.name}; "
                  f"write_json {quoted(target)}")
        gold = load(target)
        zero_unknown(gold)
        return gold

    def gate(self, file: Path, fold: bool = False) -> Json:
        """A netlist in Verilog under the old names."""
        target = self.work / f"{file.stem}.json"
        options = "-auto-top" if fold else f"-top {self.top}"
        run_yosys(f"read_verilog {quoted(file)}; hierarchy {options}; proc; "
                  f"write_json {quoted(target)}")
        return restore(load(target), read_name_map(self.work / "X.map", fold))

    @property
    def top(self) -> str:
        tables = read_name_map(self.work / "X.map")
        return next(new for new, table in tables.items() if table.old == self.design.name)

    def compare_wiring(self) -> None:
        refuse_other_wiring(self.gold(), self.gate(self.verilog))

    def prove_verilog(self) -> None:
        self.prove(self.gate(self.verilog))

    def prove_vhdl(self) -> None:
        synthesised = self.work / "synthesised.v"
        ghdl = self.ghdl()
        synthesised.write_text(run_tool(["ghdl", "--synth", *ghdl.flags, "--latches", "--out=verilog",
                                         self.top], ghdl.work).stdout)
        self.prove(self.gate(synthesised, fold=True))

    def prove(self, gate: Json) -> None:
        """Has Yosys prove that a netlist is the design, module by module."""
        gold = self.gold()
        align_nets(gold, gate, self.gate(self.verilog))
        split_nets(gold)
        split_nets(gate)
        for name in gold["modules"]:
            self.prove_module(name, {"gold": alone(gold, name, gold), "gate": alone(gate, name, gold)})

    def prove_module(self, name: str, roles: dict[str, Json]) -> None:
        """Proves a module: nets of the same name carry the same, and so do the pins of instances."""
        script = ""
        for role, design in roles.items():
            file = self.work / f"{role}.json"
            file.write_text(json.dumps(design))
            script += (f"read_json {quoted(file)}; hierarchy -check -top top; flatten; memory_map; "
                       f"proc; async2sync; opt_clean; rename top {role}; design -stash {role}; ")
        try:
            run_yosys(script + "design -copy-from gold -as gold gold; "
                      "design -copy-from gate -as gate gate; equiv_make gold gate equiv; "
                      "hierarchy -top equiv; opt -share_all; equiv_simple; equiv_induct; "
                      "equiv_status -assert", self.work)
        except Rejected as rejection:
            raise Rejected(f"module {name}: {rejection}") from None

    # Simulation.

    def bench(self, stimulus: Stimulus) -> Bench:
        ports = load(self.source)["modules"][self.design.name]["ports"]
        return Bench(self.design.name, [Port(name, port["direction"], len(port["bits"]))
                                        for name, port in ports.items()],
                     stimulus, self.work)

    def ghdl(self) -> Ghdl:
        folder = self.work / "ghdl"
        folder.mkdir(exist_ok=True)
        ghdl = Ghdl("93", folder, has_leaf_cells=False)
        ghdl.analyse(self.work / "cells.vhd")
        ghdl.analyse(self.vhdl)
        ghdl.elaborate(self.top)
        return ghdl

    def simulate(self) -> None:
        rtl, verilog, vhdl = self.traces(self.bench(self.design.stimulus))
        refuse_difference(rtl, verilog, "Verilog")
        refuse_difference(verilog, vhdl, "VHDL")

    def use(self, use: Use) -> None:
        bench = self.bench(use.stimulus)
        for shown in self.traces(bench):
            use.check(bench.name_levels(shown))

    def traces(self, bench: Bench) -> tuple[list[str], list[str], list[str]]:
        """What the RTL shows, and the netlists in Verilog and VHDL."""
        names = read_port_names(self.work / "X.map")
        cells = self.work / "cells.v"
        cells.write_text(self.cells_of_icarus())
        models = [YOSYS / "simlib.v", YOSYS / "simcells.v"]
        return (bench.run_verilog([self.design.source], self.design.name),
                bench.run_verilog([self.verilog, cells, *models], self.top, names.__getitem__),
                bench.run_vhdl(self.ghdl(), self.vhdl, self.top, names.__getitem__))

    def cells_of_icarus(self) -> str:
        """Modules of the components' names that consist of a cell of Yosys each."""
        target = self.work / "cells.json"
        run_yosys(f"read_verilog {quoted(self.verilog)}; write_json {quoted(target)}")
        tables = read_name_map(self.work / "X.map")
        outputs = {(cell["type"], pin) for module in self.gold()["modules"].values()
                   for cell in module["cells"].values()
                   for pin, direction in cell["port_directions"].items() if direction == "output"}
        modules = {}
        for new, module in load(target)["modules"].items():
            for cell in module["cells"].values():
                old = tables[new].components.get(cell["type"], "")
                if old.startswith("$") and cell["type"] not in tables:
                    modules[cell["type"]] = icarus_cell(old, cell, outputs)
        return "\n".join(modules.values())


def alone(design: Json, name: str, gold: Json) -> Json:
    """A module under the name top. The instances of other modules of `gold` are cut out: what they drive
    becomes an input, what they read an output."""
    module = design["modules"][name]
    whole = gold["modules"][name]["cells"]
    cells, ports, fresh = {}, dict(module["ports"]), itertools.count(1 << 30)
    for instance, cell in module["cells"].items():
        if cell["type"] not in gold["modules"]:
            cells[instance] = cell
            continue
        for pin, port in gold["modules"][cell["type"]]["ports"].items():
            wanted = len(whole[instance]["connections"].get(pin, []))
            bits = cell["connections"].get(pin) or list(itertools.islice(fresh, wanted))
            if wanted:
                turned = "input" if port["direction"] == "output" else "output"
                ports[f"{instance}.{pin}"] = {"direction": turned, "bits": bits}
    models = {other: its for other, its in design["modules"].items() if other not in gold["modules"]}
    return {"modules": {**models, "top": {**module, "ports": ports, "cells": cells}}}


def refuse_difference(expected: list[str], found: list[str], what: str) -> None:
    """Rejects a bit that differs, and one that is unknown although it is expected to be known.

    Icarus takes the first level of a clock for an edge, so a register may be known to it at once.
    """
    if len(expected) != CYCLES or len(found) != CYCLES:
        raise Rejected(f"{what}: {len(found)} cycles and not {len(expected)}:\n" + "\n".join(found[-5:]))
    for cycle, (known, shown) in enumerate(zip(expected, found)):
        if any(want not in ("x", have) and (have != "x" or cycle >= SETTLING)
               for want, have in zip(known, shown, strict=True)):
            raise Rejected(f"{what}: cycle {cycle}: {shown} where {known} is expected")


def icarus_cell(old: str, cell: Json, outputs: set[tuple[str, str]]) -> str:
    pins = [f"{'output' if (old, pin) in outputs else 'input'} [{max(len(bits), 1) - 1}:0] {pin}"
            for pin, bits in cell["connections"].items()]
    parameters = [f"  parameter {name} = {len(value)}'b{value};"
                  for name, value in cell["parameters"].items() if set(value) <= {"0", "1"}]
    values = ", ".join(f".{line.split()[1]}({line.split()[1]})" for line in parameters)
    wires = ", ".join(f".{pin}({pin})" for pin in cell["connections"])
    return "\n".join([f"module {cell['type']}({', '.join(pins)});", *parameters,
                      f"  \\{old} {f'#({values}) ' if values else ''}c({wires});", "endmodule", ""])


def check_design(tally: Tally, tool: Tool, design: WholeDesign, form: str, work: Path) -> None:
    label = f"{design.name}, {form}"
    whole = tally.check(f"{label}: imported", Whole, tool, design, form, work)
    if not whole:
        return
    tally.check(f"{label}: same wiring", whole.compare_wiring)
    tally.check(f"{label}: same traces", whole.simulate)
    if design.use is not None:
        tally.check(f"{label}: works", whole.use, design.use)
    # Yosys has no proof for nets that several cells drive.
    if not design.stimulus.driven_when:
        tally.check(f"{label}: Verilog proved", whole.prove_verilog)
        if form == "gates" or not design.has_memory:
            tally.check(f"{label}: VHDL proved", whole.prove_vhdl)


def main() -> int:
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("--tool", type=Path, required=True, help="the orn-hdl to be judged")
    parser.add_argument("--work", type=Path, help="a folder for all files, which are kept")
    parser.add_argument("designs", nargs="*", help="designs, or NAME:FORM; all when none is named")
    options = parser.parse_args()
    tool = Tool(options.tool)
    tally = Tally()
    for design in DESIGNS:
        for form in FORMS:
            if options.designs and not {design.name, f"{design.name}:{form}"} & set(options.designs):
                continue
            with tempfile.TemporaryDirectory() as scratch:
                work = (options.work or Path(scratch)) / f"{design.name}-{form}"
                check_design(tally, tool, design, form, work)
    return tally.close()


if __name__ == "__main__":
    raise SystemExit(main())
