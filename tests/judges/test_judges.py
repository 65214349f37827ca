"""Every judge accepts something good and rejects something bad."""

from __future__ import annotations

import json
import tempfile
import unittest
from pathlib import Path

import judges
from equivalence import (BLACK_BOXES, OWN_CELLS, Netlist, prove_equivalent, same_names,
                         same_structure)
from judges import CELL_BLACK_BOXES, CELL_BODIES, Ghdl, Rejected, quoted, run_yosys

VERILOG = """`timescale 1ns / 1ps

module top(A, C, R, Y, P);
   input [1:0] A;
   input C, R;
   output Y;
   inout P;
   wire n, q, s;
   XOR2 U1 (.I0(A[0]), .I1(q), .O(n));
   DFFC U2 (.C(C), .CLR(R), .D(n), .Q(q));
   MUX2 U3 (.I0(A[1]), .I1(q), .S(A[0]), .O(s));
   LUT4 U4 (.I({s, A, q}), .O(Y));
   defparam U4.INIT = 16'hCA5E;
   IOBUF U5 (.I(q), .T(A[0]), .O(), .IO(P));
endmodule
"""

VHDL = """library ieee;
use ieee.std_logic_1164.all;
library KESTRA;
use KESTRA.Vcomponents.all;

entity top is
   port (A : in    std_logic_vector (1 downto 0);
         C : in    std_logic;
         R : in    std_logic;
         Y : out   std_logic;
         P : inout std_logic);
end top;

architecture BEHAVIORAL of top is
   signal n, q, s : std_logic;
   component XOR2
      port (I0, I1 : in std_logic; O : out std_logic);
   end component;
   component DFFC
      port (C, CLR, D : in std_logic; Q : out std_logic);
   end component;
   component MUX2
      port (I0, I1, S : in std_logic; O : out std_logic);
   end component;
   component LUT4
      generic (INIT : bit_vector := X"0000");
      port (I : in std_logic_vector (3 downto 0); O : out std_logic);
   end component;
   component IOBUF
      port (I, T : in std_logic; O : out std_logic; IO : inout std_logic);
   end component;
begin
   U1 : XOR2 port map (I0=>A(0), I1=>q, O=>n);
   U2 : DFFC port map (C=>C, CLR=>R, D=>n, Q=>q);
   U3 : MUX2 port map (I0=>A(1), I1=>q, S=>A(0), O=>s);
   U4 : LUT4 generic map (INIT=>X"CA5E")
             port map (I(3)=>s, I(2 downto 1)=>A, I(0)=>q, O=>Y);
   U5 : IOBUF port map (I=>q, T=>A(0), O=>open, IO=>P);
end BEHAVIORAL;

configuration CFG_top of top is
   for BEHAVIORAL
      for U1 : XOR2 use configuration WORK.CFG_XOR2; end for;
   end for;
end CFG_top;
"""

# The same cells and nets under other names, in another order.
RENAMED = """module top(input [1:0] A, input C, R, output Y, inout P);
   wire w1, w2, w3;
   LUT4 #(.INIT(16'hCA5E)) x4 (.I({w3, A, w2}), .O(Y));
   MUX2 x3 (.I0(A[1]), .I1(w2), .S(A[0]), .O(w3));
   IOBUF x5 (.I(w2), .T(A[0]), .IO(P));
   XOR2 x1 (.I0(A[0]), .I1(w2), .O(w1));
   DFFC x2 (.C(C), .CLR(R), .D(w1), .Q(w2));
endmodule
"""


class JudgeTest(unittest.TestCase):
    def setUp(self) -> None:
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.work = Path(folder.name)

    def file(self, name: str, text: str, *changes: tuple[str, str]) -> Path:
        """A file of the text after the changes, each of which must change something."""
        for old, new in changes:
            self.assertIn(old, text)
            text = text.replace(old, new)
        path = self.work / name
        path.write_text(text)
        return path

    def verilog(self, *changes: tuple[str, str]) -> Path:
        return self.file("top.v", VERILOG, *changes)

    def vhdl(self, *changes: tuple[str, str]) -> Path:
        return self.file("top.vhd", VHDL, *changes)

    def rejects(self, words: str):
        return self.assertRaisesRegex(Rejected, words)


class VerilogJudges(JudgeTest):
    def test_iverilog(self) -> None:
        judges.iverilog(self.verilog(), "top")
        with self.rejects("syntax error"):
            judges.iverilog(self.verilog(("endmodule", "")), "top")
        with self.rejects("Unknown module type"):
            judges.iverilog(self.verilog(("XOR2", "XOR3")), "top")

    def test_iverilog_warnings(self) -> None:
        dangling = self.verilog((".S(A[0])", ".S()"))
        judges.iverilog(dangling, "top", [judges.DANGLING_INPUT])
        with self.rejects("dangling input"):
            judges.iverilog(dangling, "top")

    def test_verilator(self) -> None:
        judges.verilator(self.verilog(), "top")
        with self.rejects("WIDTH"):
            judges.verilator(self.verilog(("{s, A, q}", "{s, A}")), "top")
        with self.rejects("PINNOTFOUND"):
            judges.verilator(self.verilog((".D(n)", ".DD(n)")), "top")

    def test_verilator_accepts_upward_buses(self) -> None:
        judges.verilator(self.verilog(("input [1:0] A", "input [0:1] A")), "top")

    def test_yosys(self) -> None:
        judges.yosys(self.verilog(), "top")
        with self.rejects("not part of the design"):
            judges.yosys(self.verilog(("XOR2", "XOR3")), "top")
        with self.rejects("multiple conflicting drivers"):
            judges.yosys(self.verilog((".O(s)", ".O(n)")), "top")

    def test_yosys_warnings(self) -> None:
        undriven = self.verilog((".O(s)", ".O()"))
        judges.yosys(undriven, "top", [judges.UNDRIVEN])
        with self.rejects("no driver"):
            judges.yosys(undriven, "top")

    def test_simulation(self) -> None:
        bench = "module bench; reg a = 1'b{}; initial if (a) $display(\"ran\"); else $fatal; " \
                "endmodule\n"
        good = self.file("good.v", bench.format(1))
        self.assertEqual(judges.simulate_verilog([good], "bench", self.work), "ran\n")
        with self.rejects("FATAL"):
            judges.simulate_verilog([self.file("bad.v", bench.format(0))], "bench", self.work)


class VhdlJudges(JudgeTest):
    def ghdl(self, standard: str = "93") -> Ghdl:
        folder = self.work / f"ghdl{len(list(self.work.iterdir()))}"
        folder.mkdir()
        return Ghdl(standard, folder)

    def test_analysis(self) -> None:
        for standard in ("93", "08"):
            self.ghdl(standard).analyse(self.vhdl())
            with self.rejects("no declaration"):
                self.ghdl(standard).analyse(self.vhdl(("I0=>A(0)", "I0=>B(0)")))

    def test_only_the_later_edition_reads_outputs(self) -> None:
        reading = self.vhdl(("I(0)=>q", "I(0)=>Y"))
        self.ghdl("08").analyse(reading)
        with self.rejects("cannot be read|mode out"):
            self.ghdl("93").analyse(reading)

    def test_stub_library_is_there(self) -> None:
        with self.rejects("KESTRB"):
            self.ghdl().analyse(self.vhdl(("library KESTRA", "library KESTRB")))

    def test_elaboration(self) -> None:
        for standard in ("93", "08"):
            ghdl = self.ghdl(standard)
            ghdl.analyse(self.vhdl())
            ghdl.elaborate("top")
            ghdl.elaborate("CFG_top")
            ghdl = self.ghdl(standard)
            ghdl.analyse(self.vhdl(("XOR2", "XOR3"), ("CFG_XOR3", "CFG_XOR2")))
            with self.rejects("not bound|XOR3|xor3"):
                ghdl.elaborate("top")

    def test_missing_configuration(self) -> None:
        with self.rejects("cfg_missing"):
            self.ghdl().analyse(self.vhdl(("WORK.CFG_XOR2", "WORK.CFG_MISSING")))

    def test_simulation(self) -> None:
        bench = "entity bench is end bench;\narchitecture run of bench is\nbegin\n" \
                "   assert {} report \"no\" severity error;\nend run;\n"
        for condition, accepted in (("1 = 1", True), ("1 = 2", False)):
            ghdl = self.ghdl()
            ghdl.analyse(self.file("bench.vhd", bench.format(condition)))
            if accepted:
                ghdl.run("bench")
            else:
                with self.rejects("assertion error"):
                    ghdl.run("bench")

    def test_synthesis(self) -> None:
        ghdl = self.ghdl()
        ghdl.analyse(self.vhdl())
        ghdl.synthesise("top", self.work / "synthesised.v")
        self.assertIn("module top", (self.work / "synthesised.v").read_text())
        with self.rejects("missing"):
            ghdl.synthesise("missing", self.work / "missing.v")


class Equivalence(JudgeTest):
    def prove_renamed(self, *changes: tuple[str, str]) -> None:
        gold = self.verilog()
        gate = self.file("renamed.v", RENAMED, *changes)
        pairs = same_structure(Netlist.read(gold, "top", self.work, BLACK_BOXES),
                               Netlist.read(gate, "top", self.work, BLACK_BOXES))
        prove_equivalent(Netlist.read(gold, "top", self.work),
                         Netlist.read(gate, "top", self.work), pairs, self.work)

    def prove_vhdl(self, *changes: tuple[str, str]) -> None:
        folder = self.work / "ghdl"
        folder.mkdir()
        ghdl = Ghdl("93", folder)
        ghdl.analyse(self.vhdl(*changes))
        ghdl.synthesise("top", self.work / "synthesised.v")
        gold = Netlist.read(self.verilog(), "top", self.work)
        gate = Netlist.read(self.work / "synthesised.v", "top", self.work, OWN_CELLS)
        prove_equivalent(gold, gate, same_names(gold, gate), self.work, outer_pins=False)

    def test_renamed_cells(self) -> None:
        self.prove_renamed()

    def test_swapped_pins_change_the_structure(self) -> None:
        with self.rejects("structure differs"):
            self.prove_renamed((".I0(A[1]), .I1(w2)", ".I0(w2), .I1(A[1])"))

    def test_parameters_are_part_of_the_structure(self) -> None:
        with self.rejects("structure differs"):
            self.prove_renamed(("CA5E", "CA5F"))

    def test_missing_cell_changes_the_structure(self) -> None:
        with self.rejects("structure differs"):
            self.prove_renamed(("   IOBUF x5 (.I(w2), .T(A[0]), .IO(P));\n", ""))

    def test_ports_are_part_of_the_structure(self) -> None:
        with self.rejects("ports differ"):
            self.prove_renamed(("output Y,", "output Y, Z,"))
        with self.rejects("ports differ"):
            self.prove_renamed(("input C, R", "inout C, R"))

    def test_twin_cells_are_not_distinguished(self) -> None:
        """Two cells on the same nets cannot be distinguished, and need not be."""
        twins = "module top(input A, B, output [1:0] Y);\n" \
                "   wire n, m;\n" \
                "   AND2 {} (.I0(A), .I1(B), .O(n));\n   AND2 {} (.I0(A), .I1(B), .O(m));\n" \
                "   OR2 c (.I0(n), .I1(m), .O(Y[0]));\n   OR2 d (.I0({}), .I1(m), .O(Y[1]));\n" \
                "endmodule\n"
        gold = Netlist.read(self.file("gold.v", twins.format("a", "b", "n")), "top", self.work,
                            BLACK_BOXES)
        for cells, same in ((("b", "a", "n"), True), (("a", "b", "m"), False)):
            gate = Netlist.read(self.file("gate.v", twins.format(*cells)), "top", self.work,
                                BLACK_BOXES)
            if same:
                self.assertEqual(len(same_structure(gold, gate)), 4)
            else:
                with self.rejects("structure differs"):
                    same_structure(gold, gate)

    def test_proof_itself_rejects(self) -> None:
        """Whatever pairs it is given, the proof fails for circuits that differ."""
        pairs = {f"U{number}": f"U{number}" for number in range(1, 6)}
        gold = Netlist.read(self.verilog(), "top", self.work)
        for change in ((".I0(A[1]), .I1(q)", ".I0(q), .I1(A[1])"), ("CA5E", "CA5F"),
                       (".CLR(R)", ".CLR(A[1])"), (".T(A[0])", ".T(A[1])")):
            gate = Netlist.read(self.verilog(change), "top", self.work)
            with self.subTest(change), self.rejects("nproven"):
                prove_equivalent(gold, gate, pairs, self.work)

    def test_pads_stay_at_their_ports(self) -> None:
        pairs = {f"U{number}": f"U{number}" for number in range(1, 6)}
        ports = (("Y, P);", "Y, P, O);"), ("inout P;", "inout P, O;"))
        gold = Netlist.read(self.verilog(*ports), "top", self.work)
        gate = Netlist.read(self.verilog(*ports, (".IO(P)", ".IO(O)")), "top", self.work)
        prove_equivalent(gold, gold, pairs, self.work)
        with self.rejects("pads"):
            prove_equivalent(gold, gate, pairs, self.work)

    def test_vhdl(self) -> None:
        self.prove_vhdl()

    def test_vhdl_that_differs(self) -> None:
        with self.rejects("nproven"):
            self.prove_vhdl(("I0=>A(1), I1=>q", "I0=>q, I1=>A(1)"))

    def test_vhdl_generic_that_differs(self) -> None:
        with self.rejects("nproven"):
            self.prove_vhdl(("CA5E", "CA5F"))

    def test_vhdl_with_other_cells(self) -> None:
        with self.rejects("cells differ"):
            self.prove_vhdl(("U3 :", "U9 :"))


class Cells(JudgeTest):
    """The three descriptions of the leaf cells agree."""

    def ports(self, read: str) -> dict[str, object]:
        target = self.work / "cells.json"
        run_yosys(f"{read}; proc; write_json {quoted(target)}")
        modules = json.loads(target.read_text())["modules"]
        return {name: ({port: {key: its[key] for key in its if key != "bits"} | {
                            "width": len(its["bits"])} for port, its in module["ports"].items()},
                       module.get("parameter_default_values"))
                for name, module in modules.items()}

    def test_black_boxes_have_the_ports_of_the_bodies(self) -> None:
        self.assertEqual(self.ports(f"read_verilog {quoted(CELL_BODIES)}"),
                         self.ports(f"read_verilog -lib {quoted(CELL_BLACK_BOXES)}"))

    def test_entities_are_equivalent_to_the_bodies(self) -> None:
        ghdl = Ghdl("93", self.work)
        cells = self.ports(f"read_verilog {quoted(CELL_BODIES)}").keys() - {"IOBUF"}
        self.assertGreater(len(cells), 20)
        for cell in sorted(cells):
            with self.subTest(cell):
                synthesised = self.work / f"{cell}.v"
                ghdl.synthesise(cell, synthesised)
                prove_equivalent(Netlist.read(CELL_BODIES, cell, self.work, OWN_CELLS),
                                 Netlist.read(synthesised, cell, self.work, OWN_CELLS),
                                 {}, self.work)


if __name__ == "__main__":
    unittest.main()
