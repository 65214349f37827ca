"""`orn-hdl run --legal` and `orn-hdl import --legal`: netlists, messages, the table of names."""

from __future__ import annotations

import json
import unittest

from support import FAILED, INVERTER, SUCCESS, USAGE, ToolTest

SOUND = "SET NETLIST NAME top\nSUPPRESS CONFIGURATION true\n" + INVERTER
RESERVED = "ADD PORT signal(1:0) input\nADD PORT a$1 input\n"
TWO_DRIVERS = "ADD INSTANCE INV U2\nCONNECT SIGNAL A U2.I\nCONNECT SIGNAL Y U2.O\n"


class Legal(ToolTest):
    def legal(self, text: str, *options: str):
        self.write("t.cmd", text)
        return self.run_tool("run", "--quiet", "--legal", "--no-header", *options, "t.cmd")

    def test_sound_design_is_written_as_it_stands(self) -> None:
        self.legal(SOUND, "--verilog", "a.v", "--vhdl", "a.vhd")
        self.run_tool("run", "--quiet", "--no-header", "--verilog", "b.v", "--vhdl", "b.vhd", "t.cmd")
        self.assertEqual(self.read("a.v"), self.read("b.v"))
        self.assertEqual(self.read("a.vhd"), self.read("b.vhd"))

    def test_both_languages_get_the_same_names(self) -> None:
        outcome = self.legal(SOUND + RESERVED, "--verilog", "a.v", "--vhdl", "a.vhd",
                             "--name-map", "a.names")
        self.assertEqual((outcome.status, outcome.err), (SUCCESS, ""))
        self.assertIn("input [1:0] signal_1;", self.read("a.v"))
        self.assertIn("signal_1      : in    std_logic_vector (1 downto 0)", self.read("a.vhd"))
        self.assertEqual(self.read("a.names"), """\
module\ttop\ttop
component\tINV\tINV
pin\tINV.I\tINV.I
pin\tINV.O\tINV.O
port\tA\tA
port\tY\tY
port\tsignal(1:0)\tsignal_1(1:0)
port\ta$1\ta_1
cell\tU1\tU1
""")

    def test_names_are_escaped(self) -> None:
        self.legal(SOUND + "ADD PORT a$1 input\n", "--names", "escape", "--vhdl", "a.vhd")
        self.assertIn("\\a$1\\", self.read("a.vhd"))

    def test_written_by_a_command(self) -> None:
        outcome = self.legal(SOUND + RESERVED + "WRITE VHDL -NOHEADER w.vhd\n")
        self.assertEqual(outcome.status, SUCCESS)
        self.assertIn("signal_1", self.read("w.vhd"))

    def test_what_cannot_be_mended(self) -> None:
        message = 't.cmd:13: error: "Y" has two drivers [two-drivers]\n'
        for outcome in (self.legal(SOUND + TWO_DRIVERS, "--verilog", "a.v", "--name-map", "a.names"),
                        self.legal(SOUND + TWO_DRIVERS + "WRITE VERILOG a.v\n")):
            self.assertEqual(outcome.status, FAILED)
            self.assertIn(message, outcome.err)
            self.assertFalse((self.folder / "a.v").exists())
            self.assertFalse((self.folder / "a.names").exists())

    def test_options_that_need_it(self) -> None:
        self.write("t.cmd", SOUND)
        for options in (("--names", "escape"), ("--name-map", "a.names"), ("--check", "--legal")):
            self.assertEqual(self.run_tool("run", *options, "t.cmd").status, USAGE)


class LegalImport(ToolTest):
    def test_design_without_ports(self) -> None:
        design = {"modules": {"bare": {"attributes": {"top": 1}, "ports": {}, "cells": {},
                                       "netnames": {}}}}
        self.write("t.json", json.dumps(design))
        outcome = self.run_tool("import", "--legal", "--vhdl", "a.vhd", "t.json")
        self.assertEqual(outcome.status, SUCCESS)
        self.assertNotIn("port (", self.read("a.vhd"))


if __name__ == "__main__":
    unittest.main()
