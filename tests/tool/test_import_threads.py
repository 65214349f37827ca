"""orn-hdl import: a JSON netlist gives the same, however many threads there are."""

from __future__ import annotations

import gzip
import json
import unittest

from support import FAILED, FILE, SUCCESS
from yosys_json import ImportTest, cell, design, net, port

THREADS = ("1", "2", "3", "8")


def long_design() -> str:
    """A text that is long enough to be scanned ahead."""
    count = 4000
    text = json.dumps(design(
        {"a": port("input", 2), "y": port("output", count + 2)},
        {f"u.{i}": cell("BUF", "io", parameters={"INIT": "01"}, I=[i + 2], O=[i + 3])
         for i in range(count)},
        {f"n{i}": net(i + 3) for i in range(count - 1)}))
    assert len(text) > 1 << 19
    return text


class Threads(ImportTest):
    def outcomes(self, file: str, *options: str) -> set[tuple[int, str, str, bytes, bytes]]:
        """What an import gives by each number of threads: status, messages and netlists."""
        found = set()
        for threads in THREADS:
            names = ("x.v", "x.vhd")
            for name in names:
                self.write(name, "")
            done = self.run_tool("import", file, "--threads", threads, "--no-header", "--verilog",
                                 "x.v", "--vhdl", "x.vhd", *options)
            found.add((done.status, done.out, done.err,
                       *((self.folder / name).read_bytes() for name in names)))
        return found

    def expect_one(self, file: str, status: int, text: str = "") -> None:
        """Expects the same outcome of all numbers of threads, with a text in its messages."""
        outcomes = self.outcomes(file)
        self.assertEqual(len(outcomes), 1, file)
        outcome = next(iter(outcomes))
        self.assertEqual(outcome[0], status, outcome[2])
        self.assertIn(text, outcome[2])
        self.assertEqual(bool(outcome[3]), status == SUCCESS)

    def test_netlists_are_the_same(self) -> None:
        self.write("d.json", long_design())
        self.expect_one("d.json", SUCCESS)

    def test_errors_and_their_places_are_the_same(self) -> None:
        text = long_design()
        self.write("cut.json", text[:400000])
        self.expect_one("cut.json", FAILED, "cut.json:1: error: modules.top.cells")
        self.write("byte.json", text[:400000].replace('"u.900"', '"u.900" ?') + text[400000:])
        self.expect_one("byte.json", FAILED, "byte.json:1: error")
        self.write("first.json", text.replace('"u.900"', '"u.899"')[:400000])
        self.expect_one("first.json", FAILED, "the name occurs twice")

    def test_damage_is_the_same(self) -> None:
        packed = gzip.compress(long_design().encode(), 0)
        (self.folder / "d.json.gz").write_bytes(packed)
        self.expect_one("d.json.gz", SUCCESS)
        (self.folder / "cut.json.gz").write_bytes(packed[:400000])
        self.expect_one("cut.json.gz", FILE, "cut.json.gz")


if __name__ == "__main__":
    unittest.main()
