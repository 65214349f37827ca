"""Time and memory grow in proportion to the input, whatever its shape.

Eight times the input takes eight times as long; anything quadratic takes some fifty times as long. What
lies between the two is no noise, since only processor time is counted and the best of several runs."""

from __future__ import annotations

import json
import os
import subprocess
import unittest
from collections.abc import Callable
from pathlib import Path

from support import TOOL, ToolTest
from yosys_json import Json

FACTOR = 8
MOST = 3 * FACTOR
# Below this, a ratio says nothing.
LEAST_SECONDS = 0.02
RUNS = 3


def cell(connections: dict[str, list[int]], parameters: dict[str, str]) -> Json:
    return {"type": "C", "parameters": parameters, "connections": connections,
            "port_directions": {pin: "input" for pin in connections}}


def design(cells: dict[str, Json], **modules: Json) -> str:
    port = {"a": {"direction": "input", "bits": [2]}}
    top = {"attributes": {"top": "1"}, "ports": port, "cells": cells, "netnames": {}}
    return json.dumps({"modules": {"t": top, **modules}})


def parameters_of_one_cell(size: int) -> str:
    return design({"u": cell({"I": [2]}, {f"P{i}": "0101" for i in range(size)})})


def cells_with_a_parameter_each(size: int) -> str:
    return design({f"u{i}": cell({"I": [2]}, {f"P{i}": "0101"}) for i in range(size)})


def cells_with_a_pin_each(size: int) -> str:
    return design({f"u{i}": cell({f"I{i}": [2]}, {}) for i in range(size)})


def modules_with_distant_bits(size: int) -> str:
    return design({}, **{f"m{i}": {"ports": {"a": {"direction": "input", "bits": [60 * size + i]}},
                                   "cells": {}, "netnames": {}} for i in range(size)})


def box_with_pins(size: int) -> str:
    pins = [f"ADD PIN W p{k} {('INPUT', 'OUTPUT')[k % 2]}\n" for k in range(size)]
    wires = [f"CONNECT SIGNAL n{k} u.p{k}\n" for k in range(size)]
    return "".join(["ADD COMPONENT W\n", *pins, "ADD INSTANCE W u\n", *wires])


def undeclared_gates(size: int) -> str:
    """Buses cut into bits; the direction of each pin follows from the gate before."""
    gates = [f"  G u{i}(.A(n[{i}]), .B(a), .Y(n[{i + 1}]));\n" for i in range(size)]
    return (f"module t(input a, output y);\n  wire [{size}:0] n;\n  assign n[0] = a, y = n[{size}];\n"
            + "".join(gates) + "endmodule\n")


def undeclared_cell_with_pins(size: int) -> str:
    pins = ", ".join(f".p{i}(a)" for i in range(size))
    others = ", ".join(f".p{i}(a)" for i in reversed(range(size)))
    return f"module t(input a);\n  G u({pins});\n  G v({others});\nendmodule\n"


def undeclared_cells_of_each_kind(size: int) -> str:
    cells = [f"  wire n{i + 1};\n  G{i} u{i}(.A(n{i}), .Y(n{i + 1}));\n  G{i} v{i}(.A(a));\n"
             for i in range(size)]
    return ("module t(input a, output y);\n  wire n0 = a;\n" + "".join(cells) +
            f"  assign y = n{size};\nendmodule\n")


def attributes_set_again(size: int) -> str:
    """Attributes of one instance, each of which is a parameter of another type too."""
    first = ", ".join(f"P{i} = \"5\"" for i in range(size))
    again = ", ".join(f".P{i}(5)" for i in range(size))
    return f"module t(input a);\n  (* {first} *) G #({again}) u(.I(a));\nendmodule\n"


def rows_of_gates(size: int, name: str) -> str:
    """Gates in rows that are alike; a net drives all of them, and only the ends of a row are ports."""
    row = 50
    lines = ["ADD COMPONENT G", "ADD PIN G C input", "ADD PIN G I input", "ADD PIN G O output",
             "ADD PORT c input", f"ADD PORT a({size // row}:0) input"]
    for i in range(size):
        source = f"a({i // row})" if i % row == 0 else f"{name}n{i - 1}"
        lines += [f"ADD INSTANCE G {name}{i}", f"CONNECT SIGNAL c {name}{i}.C",
                  f"CONNECT SIGNAL {source} {name}{i}.I", f"CONNECT SIGNAL {name}n{i} {name}{i}.O"]
    return "\n".join(lines) + "\n"


class Growth(ToolTest):
    def setUp(self) -> None:
        super().setUp()
        # A dot that takes no time.
        programs = self.folder / "programs"
        programs.mkdir()
        (programs / "dot").write_text("#!/bin/sh\nexec cat\n")
        (programs / "dot").chmod(0o755)
        self.environment = {**os.environ, "PATH": f"{programs}:{os.environ['PATH']}"}

    def measure(self, arguments: list[str | Path]) -> tuple[float, float]:
        """Seconds of the processor and peak bytes, the least of several runs."""
        seconds, peaks = [], []
        for _ in range(RUNS):
            with subprocess.Popen([TOOL, *map(str, arguments)], cwd=self.folder,
                                  env=self.environment, stdout=subprocess.DEVNULL,
                                  stderr=subprocess.DEVNULL) as process:
                _, status, usage = os.wait4(process.pid, 0)
                process.returncode = os.waitstatus_to_exitcode(status)
            self.assertEqual(process.returncode, 0)
            seconds.append(usage.ru_utime + usage.ru_stime)
            peaks.append(usage.ru_maxrss * 1024.0)
        return min(seconds), min(peaks)

    def check(self, make: Callable[[int], str], size: int, *words: str) -> None:
        small_file = self.write("small", make(size))
        large_file = self.write("large", make(FACTOR * size))
        small = self.measure([words[0], small_file, *words[1:]])
        large = self.measure([words[0], large_file, *words[1:]])
        self.assertLess(large[0], MOST * max(small[0], LEAST_SECONDS))
        self.assertLess(large[1], MOST * small[1])

    def check_import(self, make: Callable[[int], str], size: int) -> None:
        self.check(make, size, "import", "-o", "o.cmd", "--verilog", "o.v", "--vhdl", "o.vhd")

    def test_parameters_of_one_imported_cell(self) -> None:
        self.check_import(parameters_of_one_cell, 4000)

    def test_imported_cells_that_each_add_a_parameter_to_their_type(self) -> None:
        self.check_import(cells_with_a_parameter_each, 500)

    def test_imported_cells_that_each_add_a_pin_to_their_type(self) -> None:
        self.check_import(cells_with_a_pin_each, 250)

    def test_bit_numbers_far_apart_in_many_modules(self) -> None:
        self.check_import(modules_with_distant_bits, 1000)

    def test_netlists_of_cells_that_nothing_declares(self) -> None:
        for make, size in ((undeclared_gates, 4000), (undeclared_cell_with_pins, 2000),
                           (undeclared_cells_of_each_kind, 1000)):
            with self.subTest(make.__name__):
                self.check(make, size, "import", "--from", "verilog")

    def test_attributes_that_are_parameters_too(self) -> None:
        self.check(attributes_set_again, 2000, "import", "--from", "verilog", "--attributes")

    def test_designs_with_other_names(self) -> None:
        costs = []
        for size in (4000, FACTOR * 4000):
            self.write("a.cmd", rows_of_gates(size, "a"))
            self.write("b.cmd", rows_of_gates(size, "b"))
            costs.append(self.measure(["diff", "--ignore", "names", "a.cmd", "b.cmd"]))
        (small, small_peak), (large, large_peak) = costs
        self.assertLess(large, MOST * max(small, LEAST_SECONDS))
        self.assertLess(large_peak, MOST * small_peak)

    def test_a_drawn_box_with_many_pins(self) -> None:
        self.check(box_with_pins, 2000, "draw", "-o", "o.svg")


if __name__ == "__main__":
    unittest.main()
