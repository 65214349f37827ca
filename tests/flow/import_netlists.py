#!/usr/bin/env python3
"""Netlists of other tools, imported by orn-hdl and proved equal to what they were.

Yosys maps each RTL design to the leaf cells and writes it with and without attributes; the import
gets the cells from a library, or tells their pins' directions from the design. It also writes the
gates that it makes by itself, as instances of cells that no file declares, and ABC writes what it
mapped to cells of its own. What the import writes in Verilog has the same cells, wired alike, and is
equivalent; its VHDL, as GHDL synthesises it, is equivalent too; and so is what becomes of GHDL's own
netlists, in both languages, when they are imported again.
"""

from __future__ import annotations

import argparse
import re
import tempfile
from pathlib import Path

from judging import Design, Forms, Tally, prove_languages_agree
from designs import RTL_DESIGNS
from equivalence import BLACK_BOXES, OWN_CELLS, Netlist, prove_equivalent, same_structure
from judges import CELL_BLACK_BOXES, CELLS, Ghdl, Rejected, quoted, run_tool, run_yosys
from tool import Tool

# A design without registers for tools that map it to cells of their own.
RTL_TOP = "mixer"
RTL = """\
module mixer(input [3:0] a, input [3:0] b, input s, output [4:0] y, output any);
  wire [4:0] sum = a + b;
  assign y = s ? sum : {1'b0, a ^ b};
  assign any = |(a & ~b);
endmodule
"""

# ABC's cells, as it reads them and as Yosys does.
GENLIB = """\
GATE inv   1 O=!a;     PIN * INV 1 999 1 0 1 0
GATE nand2 2 O=!(a*b); PIN * INV 1 999 1 0 1 0
GATE nor2  2 O=!(a+b); PIN * INV 1 999 1 0 1 0
GATE zero  1 O=CONST0;
GATE one   1 O=CONST1;
"""
GENLIB_BODIES = """\
module inv(input a, output O); assign O = ~a; endmodule
module nand2(input a, b, output O); assign O = ~(a & b); endmodule
module nor2(input a, b, output O); assign O = ~(a | b); endmodule
module zero(output O); assign O = 1'b0; endmodule
module one(output O); assign O = 1'b1; endmodule
"""


def synthesise(design: Design, options: str, target: Path) -> None:
    run_yosys(f"read_verilog -lib {quoted(CELL_BLACK_BOXES)}; "
              f"read_verilog {quoted(design.source)}; hierarchy -check -top {design.name}; "
              f"script to_cells.ys; check -assert; write_verilog {options} {quoted(target)}", CELLS)


class Names:
    """What the import has called everything."""

    def __init__(self, table: Path) -> None:
        self.ports: dict[str, str] = {}
        self.components: dict[str, str] = {}
        for line in table.read_text().splitlines():
            kind, old, new = line.split("\t")
            if kind == "port":
                self.ports[new] = old
            elif kind == "component":
                self.components[new] = old

    def old_port(self, name: str) -> str:
        return self.ports.get(name, name)


class Import:
    """One design that another tool has written, and what the import makes of it."""

    def __init__(self, tool: Tool, source: Path, top: str, work: Path, *options: str | Path) -> None:
        self.source, self.top, self.work = source, top, work
        # Yosys assigns output ports to each other, which VHDL-93 cannot read.
        tool.run(work, "import", source, "--top", top, "--names", "both", "--legal", "--verilog",
                 "X.v", "--vhdl", "X.vhd", "--name-map", "X.map", *options)
        self.verilog = work / "X.v"
        self.names = Names(work / "X.map")

    def prove_verilog(self) -> None:
        pairs = same_structure(
            Netlist.read(self.source, self.top, self.work, BLACK_BOXES),
            Netlist.read(self.verilog, self.top, self.work, BLACK_BOXES, self.names.old_port))
        prove_equivalent(
            Netlist.read(self.source, self.top, self.work),
            Netlist.read(self.verilog, self.top, self.work, port_names=self.names.old_port), pairs,
            self.work)

    def prove_vhdl(self) -> None:
        prove_languages_agree(self.top, Forms(self.verilog, self.work / "X.vhd"), self.work)


def check_cells(tally: Tally, tool: Tool, design: Design, work: Path) -> None:
    """The design on the leaf cells, declared and not."""
    for form in ("", "-noattr"):
        label = f"{design.name} {form or 'with attributes'}"
        folder = work / (form or "attributes")
        folder.mkdir()
        source = folder / "yosys.v"
        synthesise(design, form, source)
        options = [] if form else ["--attributes"]
        done = tally.check(f"{label}: imported", Import, tool, source, design.name,
                           folder / "declared", "-l", CELL_BLACK_BOXES, *options)
        if done:
            tally.check(f"{label}: Verilog proved", done.prove_verilog)
            if form:
                tally.check(f"{label}: VHDL proved", done.prove_vhdl)
                # GHDL drives two-way ports with "z", which no design has.
                if not design.stimulus.driven_when:
                    back = f"{label}: by GHDL and back"
                    tally.check(back, check_ghdl, tally, back, tool, done, work)
    tally.check(f"{design.name}: undeclared", check_undeclared, tool, source, design, work)


def check_undeclared(tool: Tool, source: Path, design: Design, work: Path) -> None:
    """Without a library the result is the same, or the message lists pins."""
    folder = work / "undeclared"
    try:
        done = Import(tool, source, design.name, folder)
    except Rejected as refusal:
        if "direction does not follow from the design" not in str(refusal):
            raise
        return
    if done.verilog.read_text() != (work / "-noattr" / "declared" / "X.v").read_text():
        done.prove_verilog()


def check_ghdl(tally: Tally, label: str, tool: Tool, done: Import, work: Path) -> None:
    """What GHDL makes of the VHDL, in both languages, is still the same when it is imported."""
    ghdl_folder = work / "back"
    ghdl_folder.mkdir()
    attribute = r'^ *attribute \w+ *(?:of|:)(?:"[^"]*"|[^";])*;'
    bare = ghdl_folder / "bare.vhd"
    bare.write_text(re.sub(attribute, "", (done.work / "X.vhd").read_text(), flags=re.MULTILINE))
    ghdl = Ghdl("93", ghdl_folder)
    ghdl.analyse(bare)
    synthesised = ghdl_folder / "synthesised.v"
    ghdl.synthesise(done.top, synthesised)
    plain = ghdl_folder / "plain.vhd"
    plain.write_text(run_tool(["ghdl", "--synth", *ghdl.flags, "--out=raw-vhdl", done.top],
                              ghdl_folder).stdout)
    gold = Netlist.read(synthesised, done.top, work, OWN_CELLS)
    for source in (synthesised, plain):
        # The leaf cells have bodies there, which no import reads; their heads are enough.
        try:
            again = Import(tool, source, done.top, ghdl_folder / f"from {source.name}")
        except Rejected as refusal:
            # GHDL writes "z" for bits that nothing drives, which no design has.
            message = re.search(r"error: (the (?:digit|value) '?[Zz]'?: a model has the values .*)",
                                str(refusal))
            if message is None:
                raise
            tally.refuse(f"{label}, {source.name}", message[1])
            continue
        gate = Netlist.read(again.verilog, done.top, work, leaves_of(synthesised, done.top, work),
                            again.names.old_port)
        prove_equivalent(gold, gate, same_structure(gold, gate), work, outer_pins=False)


def leaves_of(source: Path, top: str, work: Path) -> str:
    """Yosys commands that read all modules of a file but the top."""
    leaves = work / "leaves.v"
    text = source.read_text()
    leaves.write_text(re.sub(rf"^module {top}\b.*?^endmodule", "", text,
                             flags=re.MULTILINE | re.DOTALL))
    return f"read_verilog {quoted(leaves)}; "


def check_gates(tool: Tool, work: Path) -> None:
    """Yosys' own gates, whose names are no names in other languages."""
    source = work / "gates.v"
    run_yosys(f"read_verilog {quoted(work / 'rtl.v')}; synth -flatten -top {RTL_TOP}; "
              f"abc -g AND,NOR,XOR,MUX; opt_clean; write_verilog -noexpr -noattr {quoted(source)}")
    done = Import(tool, source, RTL_TOP, work / "gates")
    bodies = work / "gates" / "bodies.v"
    bodies.write_text("".join(gate_body(new, old, done.verilog.read_text())
                              for new, old in done.names.components.items()))
    prove_combinational(source, "", done.verilog, f"read_verilog -icells {quoted(bodies)}; ", work)


def gate_body(new: str, old: str, netlist: str) -> str:
    """A module that is one of Yosys' gates, with the pins that its instances have."""
    found = re.search(rf"\b{new} \w+ \((.*?)\);", netlist, flags=re.DOTALL)
    pins = re.findall(r"\.(\w+)", found[1]) if found else []
    declared = ", ".join(("output " if pin == "Y" else "input ") + pin for pin in pins)
    wired = ", ".join(f".{pin}({pin})" for pin in pins)
    return f"module {new}({declared}); \\{old} g({wired}); endmodule\n"


def check_abc(tool: Tool, work: Path) -> None:
    """Cells that ABC has mapped to, which no file declares."""
    (work / "cells.genlib").write_text(GENLIB)
    (work / "bodies.v").write_text(GENLIB_BODIES)
    run_yosys(f"read_verilog rtl.v; synth -flatten -top {RTL_TOP}; splitnets -ports -format _; "
              f"write_blif design.blif", work)
    run_tool(["yosys-abc", "-c", "read_genlib cells.genlib; read_blif design.blif; strash; map; "
              "write_verilog abc.v"], work)
    done = Import(tool, work / "abc.v", RTL_TOP, work / "abc")
    bodies = f"read_verilog {quoted(work / 'bodies.v')}; "
    prove_combinational(work / "abc.v", bodies, done.verilog, bodies, work)


def prove_combinational(source: Path, source_cells: str, target: Path, target_cells: str,
                        work: Path) -> None:
    """Proves two netlists without registers equal, over cells that Yosys commands read."""
    script = "".join(
        f"{cells}read_verilog -icells {quoted(file)}; hierarchy -check -top {RTL_TOP}; flatten; "
        f"rename {RTL_TOP} {role}; design -stash {role}; "
        for role, file, cells in (("gold", source, source_cells), ("gate", target, target_cells)))
    run_yosys(script + "design -copy-from gold gold; design -copy-from gate gate; "
              "miter -equiv -flatten gold gate m; hierarchy -top m; "
              "sat -verify -prove trigger 0 m", work)


def main() -> int:
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("--tool", type=Path, required=True, help="the orn-hdl to be judged")
    parser.add_argument("designs", nargs="*", help="RTL designs; all when none is named")
    options = parser.parse_args()
    tool = Tool(options.tool)
    tally = Tally()
    for design in RTL_DESIGNS:
        if options.designs and design.name not in options.designs:
            continue
        with tempfile.TemporaryDirectory() as scratch:
            check_cells(tally, tool, design, Path(scratch))
    with tempfile.TemporaryDirectory() as scratch:
        (Path(scratch) / "rtl.v").write_text(RTL)
        tally.check("gates of Yosys", check_gates, tool, Path(scratch))
        tally.check("cells of ABC", check_abc, tool, Path(scratch))
    return tally.close()


if __name__ == "__main__":
    raise SystemExit(main())
