"""orn-hdl import --cells: what libraries in Verilog, JSON and Liberty tell of the cell types."""

from __future__ import annotations

import json
import re
import shutil
import subprocess
import unittest
from pathlib import Path

from support import FAILED, FILE, SUCCESS
from yosys_json import MARK, ImportTest, Imported, Json, black_box, cell, design, port

VERILOG = """// module COMMENT(input A); endmodule
/* module COMMENT(input A);
   endmodule */
`timescale 1ns / 1ps
`define DEFAULT(x) = x
(* blackbox, src = "a*)b" *) module ANSI #(
      parameter [3:0] INIT = 4'hA, MASK = 4'b1x0_1, parameter MODE = "FAST", parameter integer N = -3,
      localparam L = 1, parameter E = N + 1, parameter [7:0] SHORT = 5)
   (input wire [3:0] A, B, input C `DEFAULT(1'b0), (* keep *) output reg [0:2] Q,
    inout \\p.x , output logic [N-1:0] W);
   always @(*) Q = A;
   function f; input IN_FUNCTION; f = IN_FUNCTION; endfunction
   task t; output IN_TASK; IN_TASK = 1; endtask
   specify (A *> Q) = 1; endspecify
endmodule
module OLD(A, B, .Q(internal), Y);
   parameter P = 8'd255, R = 12; parameter S = 16'sh00ff;
   input [7+8:0] A; input B;
   output Q; output reg [1:1] Y;
   reg [1:1] Y;
   initial $display("endmodule");
endmodule
`ifdef NEVER
module ANSI(input WRONG); endmodule
`elsif NEVER_EITHER
garbage (((
`else
`ifndef NEVER
module BRANCH(input A); endmodule
`endif
`endif
module \\esc[0] (input A); endmodule
primitive UDP(q, d); output q; input d; table 0 : 0; endtable endprimitive
module NOTHING; endmodule
module LAST(...); input A; output Y; endmodule
"""

LIBERTY = """/* a library */
library(test) {
  define(extra, cell, string);
  type (WORD) { base_type : array; bit_width : 4; bit_from : 3; bit_to : 0; downto : true; }
  type(UP) { bit_from : 0; bit_to : 1 }
  cell(AND2) {
    area : 1.5;
    pg_pin(VPWR) { pg_type : primary_power; }
    pin(A, B) { direction : input; capacitance : 0.1; }
    pin(hidden) { direction : "internal"; }
    pin("Y") { direction : output; function : "(A * B)";
      timing() { related_pin : "A B"; values("1, 2", \\
        "3, 4"); } }
  }
  cell("REG") {
    bus(D) { bus_type : WORD; direction : input; pin(D[0]) { capacitance : 1; } }
    bus(Q) { bus_type : UP
      direction : output }
    bundle(C) { direction : inout; members(C0, C1); }
  }
}
"""


class CellsTest(ImportTest):
    def import_types(self, file: str, text: str, *types: str, **pins: list[int | str]) -> Imported:
        """Imports a cell of each type with a library; every cell only has the pins given."""
        self.write(file, text)
        cells = {}
        for i, name in enumerate(types):
            cells[f"u{i}"] = cell(name, "")
            cells[f"u{i}"]["connections"] = pins
        return self.import_design(design({}, cells), "--cells", file,
                                  allowed="dangling|floating|inherited|timescale")


class Verilog(CellsTest):
    def test_ports(self) -> None:
        done = self.import_types("c.v", VERILOG, "ANSI", "OLD", "BRANCH", "LAST", "NOTHING")
        self.assertEqual(done.lines("ADD PIN"), [
            "ANSI A(3:0) Input", "ANSI B(3:0) Input", "ANSI C Input", "ANSI Q(0:2) Output",
            "ANSI p_x BiDirectional", "ANSI W Output",
            "OLD A(15:0) Input", "OLD B Input", "OLD Q Output", "OLD Y(1:1) Output",
            "BRANCH A Input", "LAST A Input", "LAST Y Output"])

    def test_escaped_name_of_a_module(self) -> None:
        done = self.import_types("c.v", VERILOG, "esc[0]")
        self.assertEqual(done.lines("ADD PIN"), ["esc_0 A Input"])

    def defaults(self, parameters: Json) -> dict[str, str]:
        """The defaults of the generics, where one cell sets these parameters and another none."""
        self.write("c.v", VERILOG)
        done = self.import_design(design({}, {
            "u": cell("ANSI" if "INIT" in parameters else "OLD", "", parameters=parameters),
            "v": cell("ANSI" if "INIT" in parameters else "OLD", "")}), "--cells", "c.v",
            allowed="dangling|floating")
        self.said = done.warnings
        return {line.split()[2]: line.split(maxsplit=3)[3]
                for line in done.lines("ADD COMPONENT ATTRIBUTE")}

    def test_defaults(self) -> None:
        self.assertEqual(self.defaults({
            "INIT": "0000", "MODE": "SLOW", "N": "0" * 32, "E": "1", "SHORT": "0" * 8}), {
                "INIT": "4:B:1010", "MODE": "FAST", "N": f"32:B:{'1' * 30}01",
                "E": "1:B:0", "SHORT": "8:B:00000101"})
        self.assertEqual([w for w in self.said if "unknown; in VHDL" in w], [
            "d.json: warning: modules.top.cells.u.parameters: other cells of the type have other "
            "parameters, and their defaults are unknown; in VHDL they are 0 or empty: E"])
        self.assertEqual(self.defaults({"P": "0" * 8, "R": "0" * 32, "S": "0" * 16}), {
            "P": "8:B:11111111", "R": f"32:B:{12:032b}", "S": "16:B:0000000011111111"})

    def test_any_value_is_left_out_where_the_library_has_a_default(self) -> None:
        self.write("c.v", VERILOG)
        done = self.import_design(design({}, {
            "u": cell("ANSI", "", parameters={"INIT": "xxxx", "E": "x", "OTHER": "x"})}),
            "--cells", "c.v", allowed="dangling|floating")
        self.assertEqual(done.lines("ADD INSTANCE ATTRIBUTE"), ["u -TYPE=BitVector OTHER 1:B:0"])

    def test_directions_replace_the_unknown_ones(self) -> None:
        done = self.import_types("c.v", VERILOG, "BRANCH", A=["0"])
        self.assertEqual((done.lines("ADD PIN"), done.warnings), (["BRANCH A Input"], []))

    def test_width_that_differs_from_the_library(self) -> None:
        self.write("c.v", VERILOG)
        contents = design({}, {"u": cell("BRANCH", "i", A=["0", "1"])})
        done = self.import_design(contents, "--cells", "c.v")
        self.assertEqual(done.lines("ADD PIN"), ["BRANCH A(1:0) Input"])

    def test_width_that_the_library_does_not_tell(self) -> None:
        done = self.import_types("c.v", VERILOG, "ANSI", W=[2, 3])
        self.assertIn("ANSI W(1:0) Output", done.lines("ADD PIN"))

    def test_pin_that_the_library_does_not_have(self) -> None:
        self.write("c.v", VERILOG)
        self.refuse(design({}, {"u": cell("BRANCH", "i", Z=["0"])}),
                    'modules.top.cells.u.connections.Z: the module "BRANCH" has no such port',
                    "--cells", "c.v")

    def test_first_library_holds(self) -> None:
        self.write("a.v", "module X(input A); endmodule module X(input B); endmodule")
        self.write("b.v", "module X(output C); endmodule module Y(output Q); endmodule")
        done = self.import_design(design({}, {"u": cell("X", ""), "v": cell("Y", "")},
                                         X=black_box({"D": port("input", 2)})),
                                  "--cells", "a.v", "--cells", "b.v", allowed="dangling|floating")
        self.assertEqual(done.lines("ADD PIN"), ["X A Input", "Y Q Output"])

    def test_errors(self) -> None:
        for text, line, message in (
                ("\nmodule", 2, "the name of a module is expected"),
                ("module a", 1, '";" is expected'),
                ("module a;\n\n", 3, '"endmodule" is missing for module a'),
                ("module a(\n;", 2, '")" is expected'),
                ("module a(1); endmodule", 1, "the name of a port is expected"),
                ("module a(input [3:0); endmodule", 1, '"]" is expected'),
                ("module a(input, b); endmodule", 1, "the name of a port is expected"),
                ("module a #(parameter = 1)(); endmodule", 1, "the name of a parameter is expected"),
                ("module a #(parameter P = 1", 1, '")" is expected'),
                ("module a; function f;\nendmodule", 1, '"endfunction" is missing for this function'),
                ("\n/* ", 2, "the end of the comment is missing"),
                ('\n"text\n"', 2, "the end of the string is missing"),
                ("(* attribute", 1, "the end of the attribute is missing"),
                ("`ifdef A", 1, "`endif is missing"),
                ("\n`else", 2, "`else without `ifdef"),
                ("`M(((", 1, "the end of the macro's arguments is missing")):
            with self.subTest(text):
                self.refuse_cells("c.v", text, line, message)

    def refuse_cells(self, file: str, text: str, line: int, message: str) -> None:
        self.write("d.json", json.dumps(design({})))
        self.write(file, text)
        self.expect(self.run_tool("import", "d.json", "--cells", file, "-o", "x.cmd"), FAILED,
                    f"{file}:{line}: error: {message}\n")
        self.assertFalse((self.folder / "x.cmd").exists())

    def test_every_cut_of_a_file(self) -> None:
        """A part of a file is read or refused; nothing else happens."""
        self.write("d.json", json.dumps(design({}, {"u": cell("ANSI", "")})))
        for name, text in (("c.v", VERILOG), ("c.lib", LIBERTY)):
            for length in range(0, len(text), 3):
                self.write(name, text[:length])
                outcome = self.run_tool("import", "d.json", "--cells", name)
                self.assertIn(outcome.status, (SUCCESS, FAILED), text[:length])
                if outcome.status == FAILED:
                    self.assertRegex(outcome.err, rf"\A{name}:\d+: error: .*\n\Z")

    def test_a_short_number_is_no_huge_text(self) -> None:
        self.write("d.json", json.dumps(design({}, {"u": cell("A", ""), "v": cell("A", "")})))
        self.write("c.v", "module A(input [2147483647:0] X); " +
                   "parameter P = 999999999'b0; parameter [99999999:0] Q = 0;" * 1000 + "endmodule")
        self.expect(self.run_tool("import", "d.json", "--cells", "c.v", "-o", "x.cmd"), SUCCESS)
        self.assertIn("ADD PIN A X Input", self.read("x.cmd"))

    def test_unreadable(self) -> None:
        self.write("d.json", json.dumps(design({})))
        self.expect(self.run_tool("import", "d.json", "--cells", "no.v"), FILE,
                    "orn-hdl: cannot read no.v: No such file or directory\n")


@unittest.skipIf(shutil.which("yosys") is None, "Yosys is not installed")
class RealLibraries(CellsTest):
    """Yosys' own libraries, as Yosys itself reads them."""

    def compare(self, library: str) -> None:
        file = Path(shutil.which("yosys")).parents[1] / "share" / "yosys" / library
        if not file.exists():
            self.skipTest(f"{file} is not installed")
        subprocess.run(["yosys", "-q", "-p", f"read_verilog -D ICE40_HX -lib -specify {file}; proc; "
                        "write_json y.json"], cwd=self.folder, check=True, capture_output=True)
        modules = {name: module for name, module in
                   json.loads(self.read("y.json"))["modules"].items() if "$" not in name}
        self.write("d.json", json.dumps(design(
            {}, {f"u{i}": cell(name, "") for i, name in enumerate(modules)})))
        outcome = self.run_tool("import", "d.json", "--cells", file, "-o", "x.cmd", "--names",
                                "verilog")
        self.assertEqual(outcome.status, SUCCESS, outcome.err)
        pins: dict[str, dict[str, str]] = {name: {} for name in modules}
        for component, pin, direction in re.findall(r'^ADD PIN "?\\?(\w+) *"? (\S+) (\w+)$',
                                                    self.read("x.cmd"), re.M):
            pins[component][pin] = direction
        directions = {"input": "Input", "output": "Output", "inout": "BiDirectional"}
        for name, module in modules.items():
            self.assertEqual(pins[name], {
                pin + make_range(p): directions[p["direction"]]
                for pin, p in module["ports"].items()}, name)
        self.assertGreater(sum(map(len, pins.values())), 300)

    def test_xilinx(self) -> None:
        self.compare("xilinx/cells_xtra.v")

    def test_ice40(self) -> None:
        self.compare("ice40/cells_sim.v")


def make_range(p: Json) -> str:
    low, high = p.get("offset", 0), p.get("offset", 0) + len(p["bits"]) - 1
    if low == high == 0:
        return ""
    return f"({low}:{high})" if p.get("upto") else f"({high}:{low})"


class OtherForms(CellsTest):
    def test_json(self) -> None:
        library = {"modules": {
            "top": {"attributes": {"top": MARK}, "ports": {"A": port("input", 2)}},
            "BOX": black_box({"A": port("input", 2, 3), "Y": port("output", 4)}, P="01"),
            "FULL": {"ports": {"I": port("input", 2)}, "cells": {"x": cell("BOX", "i", A=[2, 2])}}}}
        done = self.import_types("c.json", json.dumps(library), "BOX", "FULL", "top_2")
        self.assertEqual(done.lines("ADD PIN"), ["BOX A(1:0) Input", "BOX Y Output", "FULL I Input"])

    def test_json_that_is_none(self) -> None:
        self.write("d.json", json.dumps(design({})))
        self.write("c.json", '{"modules": []}')
        self.expect(self.run_tool("import", "d.json", "--cells", "c.json"), FAILED,
                    "c.json: error: modules: an object is expected\n")

    def test_liberty(self) -> None:
        done = self.import_types("c.lib", LIBERTY, "AND2", "REG")
        self.assertEqual(done.lines("ADD PIN"), [
            "AND2 A Input", "AND2 B Input", "AND2 Y Output",
            "REG D(3:0) Input", "REG Q(0:1) Output", "REG C0 BiDirectional", "REG C1 BiDirectional"])

    def test_power_pins_of_liberty(self) -> None:
        done = self.import_types("c.lib", LIBERTY, "AND2", VPWR=["1"])
        self.assertIn("AND2 VPWR BiDirectional", done.lines("ADD PIN"))

    def test_errors_of_liberty(self) -> None:
        for text, line, message in (
                ("library(a) {\n", 1, '"}" is missing for this group'),
                ("library(a) { }\n }", 2, '"}" without a group'),
                ("library", 1, '":" or "(" is expected'),
                ("\n(", 2, "the name of a group or an attribute is expected"),
                ("library(a", 1, '")" is expected'),
                ("library(a) { cell() { } }", 1, "the name of a cell is expected"),
                ("a{", 1, '":" or "(" is expected'),
                ("cell(a) { pin(b) {\ndirection : up; } }", 2,
                 "a direction is input, output, inout or internal"),
                ("type(a) { bit_from : x; }", 1, "a number is expected"),
                ("a() {" * 101, 1, "nested too deeply"),
                ('a : "b', 1, "the end of the string is missing"),
                ("\n/*", 2, "the end of the comment is missing")):
            with self.subTest(text):
                Verilog.refuse_cells(self, "c.lib", text, line, message)


class OneComponent(CellsTest):
    CELLS = {"u": cell("LEAF", "", parameters={"P": "10"}), "v": cell("LEAF", "")}
    LIBRARY = "module LEAF(output O); parameter [1:0] P = 2'b01; endmodule"

    def test_library_gives_the_default(self) -> None:
        self.write("c.v", self.LIBRARY)
        done = self.import_design(design({}, self.CELLS), "--cells", "c.v")
        self.assertEqual(done.lines("ADD COMPONENT"),
                         ["LEAF", "ATTRIBUTE LEAF -TYPE=BitVector P 2:B:01"])
        self.assertEqual(done.lines("ADD INSTANCE ATTRIBUTE"), ["u -TYPE=BitVector P 2:B:10"])
        self.assertEqual(done.warnings, [])


if __name__ == "__main__":
    unittest.main()
