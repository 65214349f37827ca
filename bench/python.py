#!/usr/bin/env python3
"""Times the Python package: a design is replayed from a command file, built by the calls for many objects, built by a
call a pin, and its connections are walked. bench/python.py [--instances N] [--repeat R], with the package on
PYTHONPATH or installed.

The design has N gates of two inputs and an output; inputs are connected at random over the whole design, as in
the design of bench/design.cpp, so the connections have no locality.
"""

from __future__ import annotations

import argparse
import gc
import random
import statistics
import tempfile
import time
from pathlib import Path
from typing import Any, Callable, Dict, List

import orn_hdl

try:
    import numpy
except ImportError:
    numpy = None  # type: ignore[assignment]

KINDS = ["AND2", "OR2", "XOR2", "NAND2"]
PINS = {"I0": "in", "I1": "in", "O": "out"}


class Made:
    """The columns of a design, as lists and as arrays."""

    def __init__(self, count: int) -> None:
        chance = random.Random(1)
        self.count = count
        self.names = [f"U{i}" for i in range(count)]
        self.nets = [f"N{i}" for i in range(count)]
        self.kinds = [chance.randrange(len(KINDS)) for _ in range(count)]
        self.inputs = [[chance.randrange(count) for _ in range(count)] for _ in range(2)]

    def write_commands(self, path: Path) -> int:
        """The commands of the design; returns how many there are."""
        lines: List[str] = []
        for kind in KINDS:
            lines.append(f"ADD COMPONENT {kind}")
            lines += [f"ADD PIN {kind} {pin} {direction}" for pin, direction in PINS.items()]
        lines += [f"ADD INSTANCE {KINDS[kind]} {name}" for kind, name in zip(self.kinds, self.names)]
        lines += [f"CONNECT SIGNAL {net} {name}.O" for net, name in zip(self.nets, self.names)]
        for pin in range(2):
            lines += [f"CONNECT SIGNAL N{driver} {name}.I{pin}"
                      for driver, name in zip(self.inputs[pin], self.names)]
        path.write_text("\n".join(lines) + "\n")
        return len(lines)


def with_components() -> orn_hdl.Design:
    """A design with the gates and nothing else."""
    design = orn_hdl.Design("bench")
    for kind in KINDS:
        design.component(kind, **PINS)
    return design


def from_lists(made: Made) -> orn_hdl.Design:
    design = with_components()
    design.add_instances(made.names, [KINDS[kind] for kind in made.kinds])
    design.connect_many(made.nets, made.names, "O")
    for pin in range(2):
        design.connect_many([made.nets[driver] for driver in made.inputs[pin]], made.names, f"I{pin}")
    return design


def from_arrays(made: Made, arrays: Dict[str, Any]) -> orn_hdl.Design:
    design = with_components()
    design.add_instances(made.names, (KINDS, arrays["kinds"]))
    every = arrays["every"]
    design.connect_many((made.nets, every), (made.names, every), "O")
    for pin in range(2):
        design.connect_many((made.nets, arrays[f"I{pin}"]), (made.names, every), f"I{pin}")
    return design


def by_calls(made: Made) -> orn_hdl.Design:
    design = with_components()
    for i, name in enumerate(made.names):
        design.instance(name, KINDS[made.kinds[i]], I0=f"N{made.inputs[0][i]}", I1=f"N{made.inputs[1][i]}",
                        O=made.nets[i])
    return design


def seconds(action: Callable[[], Any], repeat: int) -> float:
    """The median of an action's processor time; what it returns is destroyed outside of it."""
    times = []
    for _ in range(repeat):
        gc.collect()
        start = time.process_time()
        result = action()
        times.append(time.process_time() - start)
        del result
    return statistics.median(times)


def walk(design: orn_hdl.Design) -> int:
    count = 0
    for net, instance, pin in design.connections():
        count += 1
    return count


def main() -> None:
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("--instances", type=int, default=1000000)
    parser.add_argument("--repeat", type=int, default=3)
    arguments = parser.parse_args()
    made, repeat = Made(arguments.instances), arguments.repeat
    arrays: Dict[str, Any] = {}
    if numpy is not None:
        arrays = {"kinds": numpy.array(made.kinds), "every": numpy.arange(made.count),
                  "I0": numpy.array(made.inputs[0]), "I1": numpy.array(made.inputs[1])}

    def replay(path: Path) -> orn_hdl.Design:
        design = orn_hdl.Design("bench")
        design.read_commands(path)
        return design

    def only_instances() -> orn_hdl.Design:
        design = with_components()
        design.add_instances(made.names, (KINDS, made.kinds))
        return design

    rows = []
    with tempfile.TemporaryDirectory() as folder:
        path, first = Path(folder) / "bench.cmd", Path(folder) / "instances.cmd"
        lines = made.write_commands(path)
        with path.open() as whole, first.open("w") as part:
            part.writelines(line for line in whole if not line.startswith("CONNECT"))
        rows.append(("replay, instances alone", made.count, seconds(lambda: replay(first), repeat)))
        rows.append(("add_instances", made.count, seconds(only_instances, repeat)))
        rows.append(("replay, the whole design", lines, seconds(lambda: replay(path), repeat)))
    rows.append(("calls with lists of names", lines, seconds(lambda: from_lists(made), repeat)))
    if arrays:
        rows.append(("calls with arrays of indices", lines, seconds(lambda: from_arrays(made, arrays), repeat)))
    few = Made(max(1, made.count // 10))
    rows.append(("a call an instance", 4 * few.count, seconds(lambda: by_calls(few), repeat)))
    design = from_lists(made)
    connections = walk(design)
    rows.append(("connections(), unpacked", connections, seconds(lambda: walk(design), repeat)))
    rows.append(("connection_arrays()", connections, seconds(design.connection_arrays, repeat)))
    print("| what | objects | seconds | million a second |\n| --- | --- | --- | --- |")
    for what, count, taken in rows:
        print(f"| {what} | {count:,} | {taken:.2f} | {count / taken / 1e6:.2f} |")


if __name__ == "__main__":
    main()
