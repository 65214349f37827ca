"""Netlists as Yosys reads them, under the names that they had before an import."""

from __future__ import annotations

import itertools
import json
import re
from pathlib import Path
from typing import Any

from judges import Rejected

Json = dict[str, Any]


class ModuleNames:
    """What the import has called the parts of one module: new names, to the old ones."""

    def __init__(self, old: str) -> None:
        self.old = old
        self.components: dict[str, str] = {}
        self.pins: dict[tuple[str, str], str] = {}
        self.ports: dict[str, str] = {}
        # With the number of bits, since a net may have become a slice.
        self.nets: dict[tuple[str, int], str] = {}
        self.cells: dict[str, str] = {}


def base_of(name: str) -> str:
    return re.sub(r"\([^()]*\)$", "", name)


def width_of(name: str) -> int:
    """The width of a part of a net; 0 for a whole one."""
    found = re.search(r"\((\d+)(?::(\d+))?\)$", name)
    return abs(int(found[1]) - int(found[2] or found[1])) + 1 if found else 0


def read_name_map(file: Path, fold: bool = False) -> dict[str, ModuleNames]:
    """The tables of all modules, by their new names; `fold` puts these in small letters."""
    tables: dict[str, ModuleNames] = {}
    for line in file.read_text().splitlines():
        kind, old, new = line.split("\t")
        old = old.replace("\\\\", "\\")
        width = width_of(new)
        new = base_of(new.lower() if fold else new)
        if kind == "module":
            table = tables[new] = ModuleNames(old)
        elif kind == "component":
            table.components[new] = old
        elif kind == "pin":
            component, _, pin = new.partition(".")
            table.pins[component, pin] = old.rpartition(".")[2]
        elif kind == "port":
            table.ports[new] = old
        elif kind == "net":
            table.nets[new, width] = old
        elif kind == "cell":
            table.cells[new] = old
    return tables


def public(name: str) -> str:
    """A name that Yosys does not take for one of its own."""
    return "hidden" + name if name.startswith("$") else name


def zero_unknown(design: Json) -> None:
    """Puts 0 in the place of every x, as the import does when it is told so."""
    for module in design["modules"].values():
        for cell in module["cells"].values():
            for bits in cell["connections"].values():
                bits[:] = ["0" if bit == "x" else bit for bit in bits]
            cell["parameters"] = {name: value.replace("x", "0") if set(value) <= set("01xz") else value
                                  for name, value in cell["parameters"].items()}
        for port in module["ports"].values():
            port["bits"] = ["0" if bit == "x" else bit for bit in port["bits"]]


def split_nets(design: Json) -> None:
    """Gives every bit of every net a name that Yosys matches: that of the net, and the bit's index."""
    for module in design["modules"].values():
        nets = {}
        for name, net in module["netnames"].items():
            for index, bit in enumerate(net["bits"], net.get("offset", 0)):
                nets[f"{public(name)}.{index}"] = {"hide_name": 0, "bits": [bit], "attributes": {}}
        ports = {name: {"hide_name": 0, "bits": port["bits"], "attributes": {}}
                 for name, port in module["ports"].items()}
        module["netnames"] = {**nets, **ports}
        module["cells"] = {public(name): cell for name, cell in module["cells"].items()}


def align_nets(gold: Json, gate: Json, ranged: Json) -> None:
    """Gives the nets of one netlist the indices that they have in another.

    A net has kept the indices of its bits, though not all of its bits, or has as many bits as it had.
    `ranged` has the nets with the ranges of the import; GHDL counts from 0.
    """
    for name, module in gate["modules"].items():
        if name not in gold["modules"]:
            continue
        known = gold["modules"][name]["netnames"]
        ranges = ranged["modules"][name]["netnames"]
        for old, net in module["netnames"].items():
            if old in known and old in ranges:
                is_whole = len(net["bits"]) == len(known[old]["bits"])
                net["offset"] = (known[old] if is_whole else ranges[old]).get("offset", 0)


def restore(design: Json, tables: dict[str, ModuleNames]) -> Json:
    """The design with the names that its modules, ports, nets and cells had."""
    known = design["modules"]
    modules = {}
    for new, module in known.items():
        table = tables.get(new)
        if table is None:
            modules[new] = module
            continue
        module["ports"] = {table.ports.get(name, name): port for name, port in module["ports"].items()}
        module["netnames"] = {
            table.ports.get(name) or table.nets.get((name, 0)) or
            table.nets.get((name, len(net["bits"])), f"new.{name}"): net
            for name, net in module["netnames"].items()}
        module["cells"] = {table.cells.get(name, f"new.{name}"): cell
                           for name, cell in module["cells"].items()}
        for cell in module["cells"].values():
            restore_cell(cell, table, tables, known)
        modules[table.old] = module
    return {**design, "modules": modules}


def restore_cell(cell: Json, table: ModuleNames, tables: dict[str, ModuleNames], known: Json) -> None:
    kind = cell["type"]
    # A cell whose model the design contains keeps its type.
    if kind in table.components and (kind in tables or kind not in known):
        cell["type"] = table.components[kind]
        cell["connections"] = {table.pins.get((kind, pin), pin): bits
                               for pin, bits in cell["connections"].items()}
        cell.pop("port_directions", None)


def refuse_other_wiring(gold: Json, gate: Json) -> None:
    """Rejects unless both designs have the same modules, with the same cells wired in the same way.

    Nets have numbers alone: those of one design stand for those of the other one by one.
    """
    for name, module in gold["modules"].items():
        other = gate["modules"].get(name)
        if other is None:
            raise Rejected(f"there is no module {name}")
        if module["ports"].keys() != other["ports"].keys():
            raise Rejected(f"{name}: ports {sorted(module['ports'].keys() ^ other['ports'].keys())}")
        if module["cells"].keys() != other["cells"].keys():
            raise Rejected(f"{name}: cells {sorted(module['cells'].keys() ^ other['cells'].keys())[:6]}")
        pairs = Pairs(name)
        for port, its in module["ports"].items():
            pairs.meet(port, its["bits"], other["ports"][port]["bits"])
        for cell, its in module["cells"].items():
            compare_cells(f"{name}.{cell}", its, other["cells"][cell], pairs)


def compare_cells(place: str, cell: Json, other: Json, pairs: "Pairs") -> None:
    if cell["type"] != other["type"]:
        raise Rejected(f"{place}: {other['type']} and not {cell['type']}")
    for name, value in cell["parameters"].items():
        # A text may have become the bits of its letters.
        if set(value) <= {"0", "1"} and other["parameters"].get(name) != value:
            raise Rejected(f"{place}: {name} is {other['parameters'].get(name)} and not {value}")
    for pin, bits in cell["connections"].items():
        pairs.meet(f"{place}.{pin}", bits, other["connections"].get(pin, []))


class Pairs:
    """Which bit of one module is which of the other."""

    def __init__(self, module: str) -> None:
        self.module = module
        self.there: dict[Any, Any] = {}
        self.back: dict[Any, Any] = {}

    def meet(self, place: str, bits: list[Any], others: list[Any]) -> None:
        for number, (bit, other) in enumerate(itertools.zip_longest(bits, others)):
            if bit is None and len(others) == 1:
                continue  # a port of no bits is an open pin of one bit
            if isinstance(bit, str) or isinstance(other, str):
                is_same = bit == other
            else:
                is_same = (self.there.setdefault(bit, other) == other and
                           self.back.setdefault(other, bit) == bit)
            if not is_same:
                raise Rejected(f"{place}[{number}] of {self.module} is {other} and not {bit}")


def load(file: Path) -> Json:
    return json.loads(file.read_text())
