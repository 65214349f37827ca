"""Proof by Yosys that two netlists over the same leaf cells are the same circuit.

The cells of both netlists are given common names first, so that every cell output is a point
where the proof may meet; a wrong pairing can only make the proof fail. Pads, which are two-way, are
cut out: their inner pins become ports, and they must sit at the same outer port.
"""

from __future__ import annotations

import itertools
import json
from collections.abc import Callable
from pathlib import Path
from typing import Any

from judges import CELL_BLACK_BOXES, CELL_BODIES, Rejected, quoted, run_yosys
from structure import Graph, match_cells

Module = dict[str, Any]

# Where the leaf cells of a netlist come from: Yosys commands to run before it is read.
BODIES = f"read_verilog {quoted(CELL_BODIES)}; "
BLACK_BOXES = f"read_verilog -lib {quoted(CELL_BLACK_BOXES)}; "
OWN_CELLS = ""


class Netlist:
    """A flat module over leaf cells, as Yosys understands it, without letter case in its ports
    and pins: VHDL has none."""

    def __init__(self, top: str, modules: dict[str, Module]) -> None:
        self.top = top
        self.modules = modules

    @classmethod
    def read(cls, source: Path, top: str, work: Path, cells: str = BODIES,
             port_names: Callable[[str], str] = str) -> Netlist:
        """Reads a Verilog netlist whose ports are known by what `port_names` makes of them."""
        target = work / f"{source.stem}.read.json"
        run_yosys(f"{cells}read_verilog {quoted(source)}; hierarchy -check -top {top}; proc; "
                  f"write_json {quoted(target)}")
        modules = json.loads(target.read_text())["modules"]
        modules[top]["ports"] = {port_names(name): port
                                 for name, port in modules[top]["ports"].items()}
        for module in modules.values():
            for table in ("ports", "netnames"):
                module[table] = _lower(module[table])
        for cell in modules[top]["cells"].values():
            if cell["type"] in modules:
                cell["connections"] = _lower(cell["connections"])
                cell["port_directions"] = _lower(cell["port_directions"])
        return cls(top, modules)

    @property
    def module(self) -> Module:
        return self.modules[self.top]

    def leaf_cells(self) -> dict[str, Module]:
        return {name: cell for name, cell in self.module["cells"].items()
                if cell["type"] in self.modules}

    def write(self, target: Path, cell_names: dict[str, str]) -> dict[str, list[tuple[str, int]]]:
        """Writes the module with new cell names and without its pads; returns where they sit."""
        ports = {name: _bare_port(port["direction"], port["bits"])
                 for name, port in self.module["ports"].items() if port["direction"] != "inout"}
        cells = {name: cell for name, cell in self.module["cells"].items()
                 if name not in cell_names}
        pads = {}
        for name, cell in self.leaf_cells().items():
            pins = self.modules[cell["type"]]["ports"]
            if any(pin["direction"] == "inout" for pin in pins.values()):
                pads[cell_names[name]] = self._cut_pad(cell_names[name], cell, pins, ports)
            else:
                cells[cell_names[name]] = cell
        leaves = {name: leaf for name, leaf in self.modules.items() if name != self.top}
        top = {"ports": ports, "cells": cells, "netnames": {}}
        target.write_text(json.dumps({"modules": {**leaves, self.top: top}}))
        return pads

    def _cut_pad(self, name: str, cell: Module, pins: Module,
                 ports: dict[str, Module]) -> list[tuple[str, int]]:
        """Makes ports of a pad's inner pins; returns the places of its outer ones."""
        places = {bit: (port, position) for port, its in self.module["ports"].items()
                  for position, bit in enumerate(its["bits"])}
        outer = []
        for pin, its in pins.items():
            bits = cell["connections"].get(pin) or list(itertools.islice(_unused_bits, 1))
            if its["direction"] == "inout":
                outer += [places.get(bit, ("inside", 0)) for bit in bits]
            else:
                inward = its["direction"] == "output"
                ports[f"{name}_{pin}"] = _bare_port("input" if inward else "output", bits)
        return outer


_unused_bits = itertools.count(1 << 30)  # net numbers that no netlist has


def _lower(table: dict[str, Any]) -> dict[str, Any]:
    return {name.lower(): value for name, value in table.items()}


def _bare_port(direction: str, bits: list[int | str]) -> Module:
    """A port without its range, which is no part of the circuit."""
    return {"direction": direction, "bits": bits}


def same_structure(gold: Netlist, gate: Netlist) -> dict[str, str]:
    """Pairs the cells by their place in the circuit; refuses any difference in structure.

    Both netlists are read over black boxes, which keep type and parameters apart.
    """
    return match_cells(Graph(gold.modules, gold.top), Graph(gate.modules, gate.top))


def same_names(gold: Netlist, gate: Netlist) -> dict[str, str]:
    """Pairs the cells by their names, letter case aside."""
    known = {name.lower(): name for name in gold.leaf_cells()}
    cells = gate.leaf_cells()
    different = known.keys() ^ {name.lower() for name in cells}
    if different:
        raise Rejected(f"cells differ: {sorted(different)[:6]}")
    return {name: known[name.lower()] for name in cells}


def prove_equivalent(gold: Netlist, gate: Netlist, pairs: dict[str, str], work: Path,
                     outer_pins: bool = True) -> None:
    """Rejects unless Yosys proves that the two netlists agree.

    Both are read with bodies for their leaf cells; `pairs` has the cell of `gold` for each of
    `gate`. Without `outer_pins` it does not matter where the pads sit: GHDL leaves two-way pins of
    instances open in the Verilog that it synthesises.
    """
    _same_ports(gold.module, gate.module)
    names = {cell: f"c{number}" for number, cell in enumerate(gold.leaf_cells())}
    gold_file, gate_file = work / "gold.json", work / "gate.json"
    pads = gold.write(gold_file, names)
    gate_pads = gate.write(gate_file, {cell: names[other] for cell, other in pairs.items()})
    if outer_pins and pads != gate_pads:
        raise Rejected("pads sit at different ports")
    script = "".join(
        f"read_json {quoted(file)}; hierarchy -check -top {netlist.top}; flatten; async2sync; "
        f"opt_clean; rename {netlist.top} {role}; design -stash {role}; "
        for role, file, netlist in (("gold", gold_file, gold), ("gate", gate_file, gate)))
    script += ("design -copy-from gold -as gold gold; design -copy-from gate -as gate gate; "
               "equiv_make gold gate equiv; hierarchy -top equiv; equiv_simple; equiv_induct; "
               "tee -q -o unproven.txt equiv_status; equiv_status -assert")
    unproven = work / "unproven.txt"
    unproven.write_text("")
    try:
        run_yosys(script, work)
    except Rejected as rejection:
        raise Rejected(f"{rejection}{unproven.read_text()}") from None


def _same_ports(gold: Module, gate: Module) -> None:
    shapes = [{(name, port["direction"], len(port["bits"]))
               for name, port in module["ports"].items()} for module in (gold, gate)]
    if shapes[0] != shapes[1]:
        raise Rejected(f"ports differ: {sorted(shapes[0] ^ shapes[1])[:6]}")
