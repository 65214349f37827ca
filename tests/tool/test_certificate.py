"""Certificates: what was proven, with the SHA-256 of the files."""

from __future__ import annotations

import hashlib
import json
import unittest

from support import FILE, INVERTER, SUCCESS, USAGE, ToolTest
from yosys_json import cell, design, port

VERILOG = "module top(input a, output y);\n   wire n;\n   INV u(.I(a), .O(n));\n" \
          "   INV v(.I(n), .O(y));\nendmodule\n"
LIBRARY = "module INV(input I, output O); endmodule\n"
NO_FILES = "orn-hdl: a certificate is of files: name the netlist to read and those to write\n"


class CertificateTest(ToolTest):
    def digest(self, name: str) -> str:
        return hashlib.sha256((self.folder / name).read_bytes()).hexdigest()

    def certify(self, *command: str) -> dict:
        """Expects success and the right digests. Returns the certificate."""
        outcome = self.run_tool(*command, "--certificate", "c.json")
        self.assertEqual(outcome.status, SUCCESS, outcome.err)
        found = json.loads(self.read("c.json"))
        self.assertEqual(found["tool"], "orn-hdl")
        for kind in ("commands", "inputs", "netlists"):
            for file in found.get(kind, []):
                self.assertEqual(file["sha256"], self.digest(file["file"]), file)
        return found

    def counts(self, found: dict, key: str) -> dict[str, int]:
        return {(file["file"], file["module"]): file[key] for file in found["netlists"]}


class Runs(CertificateTest):
    def test_of_a_command_file(self) -> None:
        self.write("d.cmd", "SET NETLIST NAME top\n" + INVERTER + "WRITE VHDL w.vhd\n")
        found = self.certify("run", "--verify", "--verilog", "d.v", "d.cmd")
        self.assertEqual([file["file"] for file in found["commands"]], ["d.cmd"])
        self.assertNotIn("inputs", found)
        self.assertEqual(self.counts(found, "instances"), {("w.vhd", "top"): 1, ("d.v", "top"): 1})
        self.assertEqual(self.counts(found, "ports"), {("w.vhd", "top"): 2, ("d.v", "top"): 2})

    def test_counts_what_was_written(self) -> None:
        """Open inputs get signals of their own in a legal netlist."""
        commands = "SET NETLIST NAME signal\n" + INVERTER + "ADD INSTANCE INV U2\n" \
                   "ADD INSTANCE INV U3\nCONNECT SIGNAL n U2.O\nCONNECT SIGNAL m U3.O\n"
        self.write("d.cmd", commands)
        plain = self.certify("run", "--verify", "--verilog", "d.v", "d.cmd")
        self.write("d.cmd", commands + "WRITE VHDL w.vhd\nWRITE VERILOG w.v\n")
        self.assertEqual(self.counts(plain, "signals"), {("d.v", "signal"): 4})
        legal = self.certify("run", "--verify", "--legal", "--verilog", "d.v", "--vhdl", "d.vhd",
                             "d.cmd")
        self.assertEqual(self.counts(legal, "signals"),
                         {(name, "signal_1"): 6 for name in ("w.vhd", "w.v", "d.v", "d.vhd")})
        self.assertEqual(set(self.counts(legal, "openPins").values()), {0})

    def test_of_an_existing_netlist(self) -> None:
        self.write("d.cmd", "SET NETLIST NAME top\n" + INVERTER)
        run = self.certify("run", "--verify", "--verilog", "d.v", "d.cmd")
        self.assertEqual(self.certify("verify", "d.v", "--commands", "d.cmd"), run)

    def test_none_of_a_netlist_that_is_not_proven(self) -> None:
        self.write("d.cmd", "SET NETLIST NAME top\n" + INVERTER +
                   "ADD SIGNAL K(3:0)\nASSIGN CONSTANT K(3:0) 1010\n")
        outcome = self.run_tool("run", "--verify", "--verilog", "d.v", "d.cmd",
                                "--certificate", "c.json")
        self.assertEqual(outcome.status, 4)
        self.assertFalse((self.folder / "c.json").exists())


class Imports(CertificateTest):
    def setUp(self) -> None:
        super().setUp()
        self.write("in.v", VERILOG)
        self.write("cells.v", LIBRARY)

    def test_of_a_netlist(self) -> None:
        found = self.certify("import", "in.v", "-l", "cells.v", "--verify", "--vhdl", "out.vhd")
        self.assertEqual([file["file"] for file in found["inputs"]], ["in.v", "cells.v"])
        self.assertNotIn("commands", found)
        self.assertEqual(self.counts(found, "instances"), {("out.vhd", "top"): 2})

    def test_of_a_netlist_that_takes_the_place_of_its_input(self) -> None:
        before = self.digest("in.v")
        outcome = self.run_tool("import", "in.v", "-l", "cells.v", "--verify", "--verilog", "in.v",
                                "--certificate", "c.json")
        self.assertEqual(outcome.status, SUCCESS, outcome.err)
        found = json.loads(self.read("c.json"))
        self.assertEqual(found["inputs"][0]["sha256"], before)
        self.assertEqual(found["netlists"][0]["sha256"], self.digest("in.v"))

    def test_of_a_design_with_hierarchy(self) -> None:
        sub = {"ports": {"I": port("input", 2), "O": port("output", 3)},
               "cells": {"w": cell("INV", "io", I=[2], O=[3])}}
        self.write("d.json", json.dumps(design(
            {"a": port("input", 2), "y": port("output", 4)},
            {"u": cell("sub", "io", I=[2], O=[3]), "v": cell("sub", "io", I=[3], O=[4])},
            sub=sub)))
        found = self.certify("import", "d.json", "--verify", "--verilog", "d.v", "--legal")
        self.assertEqual(self.counts(found, "instances"), {("d.v", "sub"): 1, ("d.v", "top"): 2})
        found = self.certify("import", "d.json", "--verify", "--vhdl", "d.list",
                             "--output-dir", "out")
        self.assertEqual(self.counts(found, "instances"),
                         {("out/sub.vhd", "sub"): 1, ("out/top.vhd", "top"): 2})

    def test_needs_files(self) -> None:
        for more in (("in.v",), ("in.v", "--verilog", "-"), ("-", "--verilog", "out.v")):
            self.expect(self.run_tool("import", *more, "--verify", "--certificate", "c.json"),
                        USAGE, NO_FILES)
        outcome = self.run_tool("import", "in.v", "--verilog", "out.v", "--certificate", "c.json")
        self.assertEqual(outcome.status, USAGE)
        self.assertIn("--verify", outcome.err)

    def test_that_cannot_be_written(self) -> None:
        outcome = self.run_tool("import", "in.v", "-l", "cells.v", "--verify", "--vhdl", "out.vhd",
                                "--certificate", "none/c.json")
        self.assertEqual(outcome.status, FILE)
        self.assertIn("none/c.json", outcome.err)


if __name__ == "__main__":
    unittest.main()
