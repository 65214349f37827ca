"""orn-hdl import: random designs, imported, written as Verilog, read back by Yosys, and compared bit by
bit. ORN_HDL_SEEDS=1-1000 tries other seeds than the usual ones."""

from __future__ import annotations

import json
import os
import random
import shutil
import subprocess
import unittest

from support import SUCCESS
from test_import_names import FINE_NAMES, ODD_NAMES
from yosys_json import ImportTest, Json, black_box, cell, design, net, port

FIRST_SEED, LAST_SEED = map(int, os.environ.get("ORN_HDL_SEEDS", "1-30").split("-"))


class Generator:
    """Makes a valid design of ports, cells and nets that share bits in every way."""

    def __init__(self, seed: int) -> None:
        self.random = random.Random(seed)
        self.bits = 1
        self.driven: list[int] = []
        self.names = self.random.sample([*ODD_NAMES, *FINE_NAMES], len(ODD_NAMES) + len(FINE_NAMES))

    def name(self) -> str:
        return self.names.pop() if self.names else f"n{self.bits}${self.random.random()}"

    def new_bits(self, count: int) -> list[int]:
        self.bits += count
        return list(range(self.bits - count + 1, self.bits + 1))

    def range_of(self, width: int) -> dict[str, int]:
        """A random numbering; one bit without an offset is no bus."""
        choice = {"offset": self.random.choice([0, 0, 0, 1, 7]), "upto": self.random.getrandbits(1)}
        return {key: value for key, value in choice.items() if value and (width > 1 or key != "upto")}

    def some_bits(self, width: int) -> list[int | str]:
        """Bits to read: runs of driven bits in both directions, single ones, constants."""
        result: list[int | str] = []
        while len(result) < width:
            kind = self.random.random()
            if kind < 0.15 or not self.driven:
                result.append(self.random.choice("01"))
            elif kind < 0.4:
                result.append(self.random.choice(self.driven))
            else:
                start = self.random.randrange(len(self.driven))
                run = self.driven[start:start + self.random.randint(1, width)]
                result += run if self.random.random() < 0.6 else run[::-1]
        return result[:width]

    def make(self) -> Json:
        ports: Json = {}
        for _ in range(self.random.randint(1, 5)):
            width = self.random.randint(1, 6)
            bits = self.new_bits(width)
            self.driven += bits
            ports[self.name()] = port(self.random.choice(["input", "input", "inout"]), *bits,
                                      **self.range_of(width))
        leaves = {f"LEAF{i}": self.make_leaf() for i in range(self.random.randint(1, 4))}
        cells: Json = {}
        for _ in range(self.random.randint(1, 12)):
            kind = self.random.choice(list(leaves))
            cells[self.name()] = self.make_cell(kind, leaves[kind])
        self.random.shuffle(self.driven)
        for _ in range(self.random.randint(1, 5)):
            width = self.random.randint(1, 6)
            ports[self.name()] = port("output", *self.some_bits(width), **self.range_of(width))
        nets: Json = {name: net(*p["bits"]) for name, p in ports.items()}
        for _ in range(self.random.randint(0, 15)):
            width = self.random.randint(1, 8)
            nets[self.name()] = net(*self.some_bits(width), hidden=self.random.getrandbits(1),
                                    **self.range_of(width))
        return design(ports, cells, nets, **leaves)

    def make_leaf(self) -> Json:
        pins = {}
        for letter in self.random.sample("ABCDEFGH", self.random.randint(1, 6)):
            width = self.random.randint(1, 6)
            pins[letter] = port(self.random.choice(["input", "output"]), *range(2, 2 + width),
                                **self.range_of(width))
        return black_box(pins)

    def make_cell(self, kind: str, leaf: Json) -> Json:
        pins: dict[str, list[int | str]] = {}
        directions = ""
        for name, pin in leaf["ports"].items():
            width = len(pin["bits"])
            if pin["direction"] == "input":
                pins[name] = self.some_bits(width)
                directions += "i"
            elif self.random.random() < 0.8:
                bits = self.new_bits(width)
                self.driven += bits
                pins[name] = [*bits]
                directions += "o"
        return cell(kind, directions, hidden=self.random.getrandbits(1), **pins)


@unittest.skipIf(shutil.which("yosys") is None, "Yosys is not installed")
class RandomDesigns(ImportTest):
    def test_connectivity_survives(self) -> None:
        for seed in range(FIRST_SEED, LAST_SEED + 1):
            with self.subTest(seed=seed):
                contents = Generator(seed).make()
                before, after = contents["modules"]["top"], self.read_back(contents)
                self.compare_wiring(before, after["modules"]["top"])

    def test_connectivity_survives_with_names_of_verilog(self) -> None:
        for seed in range(FIRST_SEED, LAST_SEED + 1):
            with self.subTest(seed=seed):
                contents = Generator(seed).make()
                after = self.read_back(contents, "--names", "verilog")
                self.compare_wiring(contents["modules"]["top"], after["modules"]["top"])

    def read_back(self, contents: Json, *options: str) -> Json:
        """What Yosys reads of the written Verilog."""
        (self.folder / "d.json").write_text(json.dumps(contents), encoding="utf-8")
        outcome = self.run_tool("import", "d.json", "-o", "x.cmd", "--verilog", "x.v",
                                "--name-map", "x.map", *options)
        self.assertEqual(outcome.status, SUCCESS, outcome.err)
        self.expect(self.run_tool("run", "x.cmd", "--verilog", "r.v", "--model", "any"), SUCCESS)
        self.assertEqual(self.read("x.v").replace("x.v", "r.v"), self.read("r.v"))
        self.write("leaves.v", "\n".join(make_leaf_modules(contents)))
        subprocess.run(["yosys", "-q", "-p", "read_verilog -lib leaves.v; read_verilog x.v; "
                        "hierarchy -check -top top; proc; write_json x.json"], cwd=self.folder,
                       check=True, stderr=subprocess.DEVNULL)
        return json.loads(self.read("x.json"))

def make_leaf_modules(contents: Json) -> list[str]:
    """The black boxes of a design as Verilog."""
    lines = []
    for name, module in contents["modules"].items():
        if name == "top":
            continue
        pins = []
        for pin, p in module["ports"].items():
            low = p.get("offset", 0)
            high = low + len(p["bits"]) - 1
            index = (low, high) if p.get("upto") else (high, low)
            bounds = f"[{index[0]}:{index[1]}] " if high or low else ""
            pins.append(f"{p['direction']} {bounds}{pin}")
        lines.append(f"(* blackbox *) module {name}({', '.join(pins)}); endmodule")
    return lines


if __name__ == "__main__":
    unittest.main()
