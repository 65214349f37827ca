"""Netlists as graphs of leaf cells, and the search for the same cells in two of them.

A netlist is a module of Yosys' JSON. Its cells may bear other names than those of the netlist it
is compared with; they are recognised by what they are wired to, from the ports inwards: cells and
nets get colours, and each round gives the same new colour to what has equally coloured neighbours
on both sides, until every cell has a colour of its own.
"""

from __future__ import annotations

from collections import Counter, defaultdict
from collections.abc import Iterator
from typing import Any

from judges import Rejected

Module = dict[str, Any]
Endpoint = tuple[str, str, int]  # cell, pin, position from the right


class Graph:
    """The cells and nets of one module; pins that are open have a net of their own."""

    def __init__(self, design: dict[str, Module], top: str) -> None:
        module = design[top]
        self.ports = {(name, position): self._net(bit, (name, position))
                      for name, port in module["ports"].items()
                      for position, bit in enumerate(port["bits"])}
        self.types = {name: _type(cell, design[cell["type"]])
                      for name, cell in module["cells"].items()}
        self.pins: dict[str, list[tuple[str, int, Any]]] = {}
        for name, cell in module["cells"].items():
            leaf = design[cell["type"]]["ports"]
            self.pins[name] = [(pin, position, self._net(bit, (name, pin, position)))
                               for pin in sorted(leaf)
                               for position, bit in enumerate(_bits(cell, pin, leaf[pin]))]
        self.loads: dict[Any, list[Endpoint]] = defaultdict(list)
        for cell, pins in self.pins.items():
            for pin, position, net in pins:
                self.loads[net].append((cell, pin, position))
        for net in self.ports.values():
            self.loads.setdefault(net, [])

    @staticmethod
    def _net(bit: int | str, owner: tuple) -> Any:
        return owner if bit in ("x", "z") else bit


def _type(cell: Module, leaf: Module) -> str:
    """The type of a cell with the values of its parameters; leading zeros do not count."""
    parameters = {**leaf.get("parameter_default_values", {}), **cell["parameters"]}
    return " ".join([cell["type"], *(f"{name}={value.lstrip('0')}"
                                     for name, value in sorted(parameters.items()))])


def _bits(cell: Module, pin: str, leaf_port: Module) -> list[int | str]:
    """What a pin is connected to, "x" for each position that is open."""
    return cell["connections"].get(pin) or ["x"] * len(leaf_port["bits"])


def match_cells(gold: Graph, gate: Graph) -> dict[str, str]:
    """The cell of `gold` for each cell of `gate`; a difference in structure is a rejection."""
    if gold.ports.keys() != gate.ports.keys():
        raise Rejected(f"ports differ: {sorted(gold.ports.keys() ^ gate.ports.keys())[:6]}")
    colours = _Colours(gold, gate)
    while True:
        colours.refine()
        pair = colours.first_alike()
        if pair is None:
            break
        colours.single_out(*pair)
    matches = colours.matches()
    _check_nets(gold, gate, matches)
    return matches


class _Colours:
    """Colours of the cells and nets of two graphs, drawn from one palette."""

    def __init__(self, gold: Graph, gate: Graph) -> None:
        self.graphs = (gold, gate)
        self.cells: list[dict[str, Any]] = [dict(graph.types) for graph in self.graphs]
        self.nets: list[dict[Any, Any]] = [dict(_port_colours(graph)) for graph in self.graphs]

    def refine(self) -> None:
        """Colours by neighbourhood until no new distinction appears."""
        distinct = 0
        while True:
            palette: dict[Any, int] = {}
            for side, graph in enumerate(self.graphs):
                cells, nets = self.cells[side], self.nets[side]
                self.cells[side] = {
                    cell: palette.setdefault(
                        (cells[cell], tuple((pin, position, nets[net])
                                            for pin, position, net in pins)), len(palette))
                    for cell, pins in graph.pins.items()}
                cells = self.cells[side]
                self.nets[side] = {
                    net: palette.setdefault(
                        (nets[net], tuple(sorted((cells[cell], pin, position)
                                                 for cell, pin, position in loads))),
                        len(palette))
                    for net, loads in graph.loads.items()}
            self._refuse_difference()
            if len(palette) == distinct:
                return
            distinct = len(palette)

    def first_alike(self) -> tuple[str, str] | None:
        """A pair of one colour that others share; None if every cell has a colour of its own."""
        counts = Counter(self.cells[0].values())
        for cell, colour in self.cells[0].items():
            if counts[colour] > 1:
                return cell, next(other for other, its in self.cells[1].items() if its == colour)
        return None

    def single_out(self, gold_cell: str, gate_cell: str) -> None:
        """Declares two cells of one colour to be each other's match."""
        self.cells[0][gold_cell] = self.cells[1][gate_cell] = -1

    def matches(self) -> dict[str, str]:
        by_colour = {colour: cell for cell, colour in self.cells[0].items()}
        return {cell: by_colour[colour] for cell, colour in self.cells[1].items()}

    def _refuse_difference(self) -> None:
        counts = [Counter(side.values()) for side in self.cells]
        if counts[0] != counts[1]:
            colour = next(iter((counts[0] - counts[1]) + (counts[1] - counts[0])))
            shown = [f"{cell} ({graph.types[cell]})"
                     for side, graph in enumerate(self.graphs)
                     for cell, its in self.cells[side].items() if its == colour]
            raise Rejected(f"structure differs, for example at {', '.join(shown[:4])}")


def _port_colours(graph: Graph) -> Iterator[tuple[Any, Any]]:
    """Nets with the port bits they are wired to; a constant is its own colour."""
    ports: dict[Any, list[tuple[str, int]]] = defaultdict(list)
    for port, net in graph.ports.items():
        ports[net].append(port)
    for net in graph.loads:
        yield net, (net if net in ("0", "1") else "", tuple(sorted(ports[net])))


def _check_nets(gold: Graph, gate: Graph, matches: dict[str, str]) -> None:
    """Matching cells are wired alike: the nets of the two graphs pair up one to one."""
    gold_nets = {(cell, pin, position): net
                 for cell, pins in gold.pins.items() for pin, position, net in pins}
    pairs = {(gold.ports[port], net) for port, net in gate.ports.items()}
    pairs |= {(gold_nets[matches[cell], pin, position], net)
              for cell, pins in gate.pins.items() for pin, position, net in pins}
    for side in (0, 1):
        net, uses = Counter(pair[side] for pair in pairs).most_common(1)[0]
        if uses > 1:
            raise Rejected(f"net {net} stands for {uses} nets of the other netlist")
