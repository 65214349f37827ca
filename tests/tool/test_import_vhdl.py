"""orn-hdl import: netlists in VHDL."""

from __future__ import annotations

import unittest

from support import FAILED, FILE, SUCCESS, USAGE, ToolTest

DESIGN = """\
library ieee;
use ieee.std_logic_1164.all;
entity top is
  port (a : in std_logic; b : in std_logic_vector(1 downto 0); y : out std_logic);
end top;
architecture s of top is
  component NAND2 is port (A, B : in std_logic; Y : out std_logic); end component;
  signal wire : std_logic;
begin
  u1 : NAND2 port map (A => a, B => b(0), Y => wire);
  u2 : NAND2 port map (A => wire, B => b(1), Y => y);
end s;
"""

PAD = """\
library ieee;
use ieee.std_logic_1164.all;
entity PAD is
  port (P : inout std_logic; D : in std_logic_vector(0 to 1));
end;
"""

PADS = "module pads(inout p, input [1:0] d);\n  PAD u(.P(p), .D(d));\nendmodule\n"


class Vhdl(ToolTest):
    def test_design(self) -> None:
        for name, options in (("d.vhd", []), ("d.VHDL", []), ("d.txt", ["--from", "vhdl"])):
            self.write(name, DESIGN)
            self.expect(self.run_tool("import", name, "--verilog", "x.v", *options), SUCCESS)
            text = " ".join(self.read("x.v").split())
            self.assertIn("module top(a, b, y); input a; input [1:0] b; output y;", text)
            self.assertIn("NAND2 u1 (.A(a), .B(b[0]), .Y(wire_2));", text)

    def test_command_file(self) -> None:
        self.write("d.vhd", DESIGN)
        self.expect(self.run_tool("import", "d.vhd", "-o", "d.cmd", "--verilog", "d1.v"), SUCCESS)
        self.expect(self.run_tool("run", "d.cmd", "--verilog", "d2.v"), SUCCESS)
        self.assertEqual(self.read("d1.v"), self.read("d2.v").replace("d2.", "d1."))

    def test_name_map(self) -> None:
        self.write("d.vhd", DESIGN)
        self.expect(self.run_tool("import", "d.vhd", "--name-map", "names"), SUCCESS)
        self.assertIn("net\twire\twire_2\n", self.read("names"))

    def test_errors_show_their_place(self) -> None:
        self.write("d.vhd", DESIGN.replace("B => b(1)", "B => b(2)"))
        done = self.run_tool("import", "d.vhd")
        self.assertEqual(done.status, FAILED)
        self.assertTrue(done.err.startswith("d.vhd:11: error: "), done.err)
        self.assertIn("\n   11 |   u2 : NAND2 port map (A => wire, B => b(2), Y => y);\n", done.err)

    def test_there_and_back(self) -> None:
        self.write("d.vhd", DESIGN)
        self.expect(self.run_tool("import", "d.vhd", "--names", "both", "--verilog", "x.v",
                                  "--vhdl", "x.vhd"), SUCCESS)
        self.expect(self.run_tool("import", "x.vhd", "--names", "both", "--verilog", "y.v"), SUCCESS)
        self.assertEqual(self.read("x.v"), self.read("y.v").replace("y.v", "x.v"))

    def test_trouble(self) -> None:
        self.expect(self.run_tool("import", "none.vhd"), FILE,
                    "orn-hdl: cannot read none.vhd: No such file or directory\n")
        self.write("d.vhd", DESIGN)
        self.expect(self.run_tool("import", "d.vhd", "--x-as", "1"), USAGE,
                    "orn-hdl: --x-as 1 applies to JSON netlists alone; see --help\n")


class Libraries(ToolTest):
    def test_vhdl_for_verilog(self) -> None:
        self.write("pad.vhd", PAD)
        self.write("d.v", PADS)
        self.expect(self.run_tool("import", "d.v", "-l", "pad.vhd", "--vhdl", "x.vhd"), SUCCESS)
        self.assertIn("D : in std_logic_vector (0 to 1));", " ".join(self.read("x.vhd").split()))

    def test_vhdl_that_cannot_be_read(self) -> None:
        self.write("pad.vhd", "entity PAD is port(\n")
        self.write("d.v", PADS)
        done = self.run_tool("import", "d.v", "-l", "pad.vhd")
        self.assertEqual(done.status, FAILED)
        self.assertTrue(done.err.startswith("pad.vhd:"), done.err)
        self.expect(self.run_tool("import", "d.v", "-l", "none.vhd"), FILE,
                    "orn-hdl: cannot read none.vhd: No such file or directory\n")

    def test_others_for_vhdl(self) -> None:
        self.write("d.vhd", DESIGN.replace(
            "component NAND2 is port (A, B : in std_logic; Y : out std_logic); end component;", ""))
        self.assertEqual(self.run_tool("import", "d.vhd").status, FAILED)
        self.write("cells.v", "module NAND2(input A, B, output Y); endmodule\n")
        self.write("cells.lib", "library (c) { cell (NAND2) { pin (A) { direction : input; } "
                                "pin (B) { direction : input; } pin (Y) { direction : output; } } }\n")
        for library in ("cells.v", "cells.lib"):
            self.expect(self.run_tool("import", "d.vhd", "-l", library, "--verilog", "x.v"), SUCCESS)
            self.assertIn("NAND2 u1 (", self.read("x.v"))


if __name__ == "__main__":
    unittest.main()
