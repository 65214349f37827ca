"""orn-hdl import: the names of an import that is meant for one language, and ports that keep theirs."""

from __future__ import annotations

import json
import shutil
import unittest

from support import FAILED, SUCCESS, USAGE
from yosys_json import ImportTest, Json, black_box, cell, design, net, port

# Names of ports that are no VHDL, or the same in VHDL.
PORTS = ["_a", "a_", "a__b", "signal", "Shared", "SHARED", "shared", "entity", "std_logic", "string1",
         "KESTRA", "END", "begin", "end", "logic", "u1.count", "a$b", "a+b", "+1", "comment"]

CELLS = """`timescale 1ns / 1ps
module LEAF(input I, output O); assign O = !I; endmodule
module WIDE(input [1:0] I, output O); assign O = ^I; endmodule
module SHARED(input I, output O); assign O = !I; endmodule
module \\$_NOT_ (input A, input \\B.x , input d, input D, output Y);
   parameter INIT = 0;
   assign Y = A ^ \\B.x ^ d ^ D;
endmodule
"""


class VerilogNames(ImportTest):
    def import_verilog(self, contents: Json, *options: str) -> tuple[str, list[str]]:
        """The Verilog of an import to this language alone, which every tool reads; the warnings."""
        self.write("d.json", json.dumps(contents))
        outcome = self.run_tool("import", "d.json", "--verilog", "x.v", "--no-header", *options)
        self.assertEqual((outcome.status, outcome.out), (SUCCESS, ""), outcome.err)
        self.write("cells.v", CELLS)
        for tool, command in (
                ("iverilog", ["iverilog", "-g2005", "-Wall", "-tnull", "-s", "top", "x.v", "cells.v"]),
                ("verilator", ["verilator", "--lint-only", "-Wno-LITENDIAN", "--top-module", "top",
                               "x.v", "-v", "cells.v"]),
                ("yosys", ["yosys", "-q", "-p", "read_verilog -lib cells.v; read_verilog x.v; "
                           "hierarchy -check -top top; check -assert"])):
            if shutil.which(tool) is None:
                self.skipTest(f"{tool} is not installed")
            self.judge(command)
        return self.read("x.v"), self.read_warnings(outcome.err)

    def read_ports(self) -> dict[str, str]:
        """The ports that Yosys finds in the netlist, with their directions."""
        self.judge(["yosys", "-q", "-p", "read_verilog -lib cells.v; read_verilog x.v; "
                    "hierarchy -top top; write_json y.json"])
        module = json.loads(self.read("y.json"))["modules"]["top"]
        return {name: p["direction"] for name, p in module["ports"].items()}

    def test_ports_keep_their_names(self) -> None:
        _, warnings = self.import_verilog(design(
            {**{name: port("input", 2 * i + 2) for i, name in enumerate(PORTS)},
             **{name + "Y": port("output", 2 * i + 3) for i, name in enumerate(PORTS)}},
            {f"u{i}": cell("LEAF", "io", I=[2 * i + 2], O=[2 * i + 3]) for i in range(len(PORTS))}),
            "--keep-ports")
        self.assertEqual(warnings, [])
        self.assertEqual(self.read_ports(), {**{name: "input" for name in PORTS},
                                             **{name + "Y": "output" for name in PORTS}})

    def test_ports_that_are_parts_of_buses(self) -> None:
        verilog, _ = self.import_verilog(design(
            {"a.b": port("input", 2), "c": port("input", 3), "C": port("input", 4),
             "y.0": port("output", 5), "y.1": port("output", 6)},
            {"u": cell("WIDE", "io", I=[2, 4], O=[5]), "v": cell("WIDE", "io", I=[5, 3], O=[6])}),
            "--keep-ports")
        self.assertIn("assign a_b_net = \\a.b ;", verilog)
        self.assertIn("u (.I({C_net, a_b_net})", verilog)
        self.assertIn("assign \\y.0  = y_0_net;", verilog)
        self.assertIn("v (.I({c, y_0_net})", verilog)

    def test_ports_without_cells(self) -> None:
        verilog, _ = self.import_verilog(design(
            {"a.i": port("input", 2), "b.i": port("input", 3), "c": port("input", 4),
             "unused.i": port("input", 5), "a.o": port("output", 2), "b": port("output", 3),
             "c.o": port("output", 4), "one.o": port("output", "1")}), "--keep-ports")
        self.assertIn("assign \\a.o  = a_i_net;", verilog)
        self.assertIn("assign b = b_i_net;", verilog)
        self.assertIn("assign \\c.o  = c;", verilog)
        self.assertIn("assign \\one.o  = 1;", verilog)

    def test_ports_that_cannot_keep_their_names(self) -> None:
        contents = design(
            {"a.b": port("input", 2, 3), "Q": port("output", 4), "q": port("output", 5, 6),
             "c[0]": port("input", 7), "p.x": port("inout", 8), "x_DUMMY": port("input", 9),
             "process": port("input", 10)},
            {"u": cell("WIDE", "io", I=[2, 3], O=[4]), "v": cell("LEAF", "io", I=[7], O=[5]),
             "w": cell("LEAF", "io", I=[7], O=[6])})
        _, warnings = self.import_verilog(contents)
        self.assertEqual(warnings, [f"d.json: warning: modules.top.ports{line}" for line in (
            '["a.b"]: "a.b" cannot be kept as a name in Verilog; the port is renamed to a_b',
            '.q: another object has the name "q"; the port is renamed to q_1',
            '["c[0]"]: "c[0]" cannot be kept as a name in Verilog; the port is renamed to c_0',
            '["p.x"]: "p.x" cannot be kept as a name in Verilog; the port is renamed to p_x',
            '.x_DUMMY: "x_DUMMY" cannot be kept as a name in Verilog; '
            'the port is renamed to x_DUMMY_1',
            '.process: "process" cannot be kept as a name in Verilog; '
            'the port is renamed to process_1')])
        (self.folder / "x.v").unlink()
        self.refuse(contents, 'modules.top.ports["a.b"]: "a.b" cannot be kept as a name in Verilog, '
                    "and --keep-ports forbids renaming the port", "--keep-ports", "--names",
                    "verilog")

    def test_ports_come_first(self) -> None:
        verilog, warnings = self.import_verilog(design(
            {"SHARED": port("input", 2, 3), "leaf": port("output", 5), "N": port("output", 6)},
            {"shared": cell("SHARED", "io", I=[2], O=[4]), "n": cell("LEAF", "io", I=[4], O=[5]),
             "v": cell("LEAF", "io", I=[3], O=[6])},
            {"Leaf": net(4)}), "--keep-ports")
        self.assertEqual(warnings, [])
        self.assertIn("\\SHARED  shared_1 (.I(SHARED[0])", verilog)
        self.assertIn("\\LEAF  n_1 (", verilog)

    def test_cell_types_keep_their_names(self) -> None:
        verilog, warnings = self.import_verilog(design(
            {"a": port("input", 2), "y": port("output", 3)},
            {"u": cell("$_NOT_", "iiioi", parameters={"INIT": "1"}, A=["1"], d=["1"], D=[2], Y=[3],
                       **{"B.x": ["0"]})}))
        self.assertEqual(warnings, [])
        self.assertIn("\\$_NOT_  u (.A(u_A_CONST_SIGNAL)", verilog)
        self.assertIn(".\\B.x (const_0)", verilog)
        self.assertIn(".\\D (a)", verilog)

    def test_name_of_the_design(self) -> None:
        self.write("d.json", json.dumps(design({"a": port("input", 2)}, name="1.5")))
        self.expect(self.run_tool("import", "d.json", "--verilog", "x.v"), SUCCESS)
        self.assertIn("module \\1.5 (a);", self.read("x.v"))

    def test_attributes_keep_their_names(self) -> None:
        verilog, _ = self.import_verilog(design(
            {"keep": port("input", 2), "y": port("output", 3)},
            {"u": cell("LEAF", "io", I=[2], O=[3], attributes={"keep": "1"})}), "--attributes")
        self.assertIn("attribute keep of u", verilog)

    def test_command_file(self) -> None:
        """A command file of Verilog names gives the same netlist, but takes no period in a port."""
        contents = design({"a+b": port("input", 2), "end": port("output", 3), "a.b": port("input", 4)},
                          {"u": cell("WIDE", "io", I=[2, 4], O=[3])})
        verilog, warnings = self.import_verilog(contents, "--names", "verilog", "-o", "x.cmd")
        self.assertIn("input \\a+b ;", verilog)
        self.assertIn("output \\end ;", verilog)
        self.assertIn('d.json: warning: modules.top.ports["a.b"]: "a.b" cannot be kept as a name in '
                      "Verilog; the port is renamed to a_b", warnings)
        self.expect(self.run_tool("run", "x.cmd", "--verilog", "r.v", "--no-header"), SUCCESS)
        self.assertEqual(self.read("r.v"), verilog)


class Choice(ImportTest):
    CONTENTS = design({"wire": port("input", 2), "signal": port("input", 3), "_a": port("input", 4)})

    def ports(self, *options: str) -> list[str]:
        """The names that the ports get, and the warnings."""
        self.write("d.json", json.dumps(self.CONTENTS))
        outcome = self.run_tool("import", "d.json", "--name-map", "x.map", *options)
        self.assertEqual(outcome.status, SUCCESS, outcome.err)
        self.assertEqual(len(self.read_warnings(outcome.err)),
                         sum(old != new.strip("\\ ") for (kind, old), new in self.read_names().items()
                             if kind == "port"))
        return [new for (kind, _), new in self.read_names().items() if kind == "port"]

    def test_languages_of_the_outputs(self) -> None:
        both, verilog, vhdl = (["wire_1", "signal_1", "a"], ["\\wire ", "signal", "_a"],
                               ["wire", "signal_1", "a"])
        self.assertEqual(self.ports(), both)
        self.assertEqual(self.ports("--verilog", "x.v"), verilog)
        self.assertEqual(self.ports("--vhdl", "x.vhd"), vhdl)
        self.assertEqual(self.ports("--verilog", "x.v", "--vhdl", "x.vhd"), both)
        self.assertEqual(self.ports("--verilog", "x.v", "-o", "x.cmd"), both)
        self.assertEqual(self.ports("--vhdl", "x.vhd", "-o", "x.cmd"), both)
        self.assertEqual(self.ports("--names", "verilog"), verilog)
        self.assertEqual(self.ports("--names", "vhdl", "--verilog", "x.v"), vhdl)
        self.assertEqual(self.ports("--names", "both", "--verilog", "x.v"), both)

    def test_vhdl_names_are_vhdl(self) -> None:
        self.ports("--vhdl", "x.vhdl")
        self.judge_vhdl("")

    def test_warnings_and_refusal(self) -> None:
        self.write("d.json", json.dumps(self.CONTENTS))
        self.expect(self.run_tool("import", "d.json"), SUCCESS, "".join(
            f'd.json: warning: modules.top.ports.{old}: "{old}" is not a legal name in Verilog and '
            f"VHDL; the port is renamed to {new}\n"
            for old, new in (("wire", "wire_1"), ("signal", "signal_1"), ("_a", "a"))) + "3 warnings\n")
        self.expect(self.run_tool("import", "d.json", "--vhdl", "x.vhd"), SUCCESS, "".join(
            f'd.json: warning: modules.top.ports.{old}: "{old}" is not a legal name in VHDL; '
            f"the port is renamed to {new}\n" for old, new in (("signal", "signal_1"), ("_a", "a"))) +
                    "2 warnings\n")
        self.write("x.vhd", "before")
        self.expect(self.run_tool("import", "d.json", "--vhdl", "x.vhd", "--keep-ports"), FAILED,
                    'd.json: error: modules.top.ports.signal: "signal" is not a legal name in VHDL, '
                    "and --keep-ports forbids renaming the port\n")
        self.assertEqual(self.read("x.vhd"), "before")

    def test_port_of_the_name_of_a_component(self) -> None:
        self.write("d.json", json.dumps(design({"inv": port("input", 2)},
                                               {"u": cell("INV", "i", I=[2])},
                                               INV=black_box({"I": port("input", 2)}))))
        self.expect(self.run_tool("import", "d.json"), SUCCESS,
                    'd.json: warning: modules.top.ports.inv: another object has the name "inv"; '
                    "the port is renamed to inv_1\n")

    def test_unknown_choice(self) -> None:
        outcome = self.run_tool("import", "d.json", "--names", "ada")
        self.assertEqual(outcome.status, USAGE)
        self.assertIn("--names", outcome.err)


if __name__ == "__main__":
    unittest.main()
