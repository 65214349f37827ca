#!/usr/bin/env python3
"""RTL through Yosys and orn-hdl to netlists in both languages, and these before the judges.

For each design: synthesis to leaf cells; import of the JSON netlist as a command file and straight
to both languages; the command file replayed must give the same bytes. Then the judges, twice: on
the netlists as imported, and on those that a replay writes as its second of either language. At
last the Verilog is compared, cell by cell, with Yosys' own netlist and proven equivalent to it; so
is the Verilog of an import that follows the rules for names of Verilog alone.
"""

from __future__ import annotations

from pathlib import Path

from judging import Design, Forms, Tally, judge, main
import judges
from designs import RTL_DESIGNS
from equivalence import BLACK_BOXES, Netlist, prove_equivalent, same_structure
from judges import CELL_BLACK_BOXES, CELLS, Rejected, quoted, run_yosys
from tool import Tool


def synthesise(design: Design, work: Path) -> tuple[Path, Path]:
    """Has Yosys map the RTL to leaf cells; returns its netlist as JSON and as Verilog."""
    json_netlist, verilog = work / f"{design.name}.json", work / "yosys.v"
    run_yosys(f"read_verilog -lib {quoted(CELL_BLACK_BOXES)}; "
              f"read_verilog {quoted(design.source)}; hierarchy -check -top {design.name}; "
              f"script to_cells.ys; check -assert; "
              f"write_json {quoted(json_netlist)}; write_verilog {quoted(verilog)}", CELLS)
    return json_netlist, verilog


def compare_with_yosys(top: str, forms: Forms, reference: Path, work: Path) -> None:
    """The written Verilog has the cells of Yosys' own netlist, wired alike, and is equivalent."""
    old_names = {new: old for old, new in forms.port_names.items()}

    def old_name(port: str) -> str:
        return old_names.get(port, port)

    pairs = same_structure(Netlist.read(reference, top, work, BLACK_BOXES),
                           Netlist.read(forms.verilog, top, work, BLACK_BOXES, old_name))
    prove_equivalent(Netlist.read(reference, top, work),
                     Netlist.read(forms.verilog, top, work, port_names=old_name), pairs, work)


def refuse_other_bytes(imported: Forms, replayed: Forms) -> None:
    for first, second in ((imported.verilog, replayed.verilog), (imported.vhdl, replayed.vhdl)):
        if first.read_bytes() != second.read_bytes():
            raise Rejected(f"{second} is not what the import wrote to {first}")


def judge_alone(check, top: str, forms: Forms, reference: Path, work: Path) -> None:
    """What follows the rules for names of one language only is accepted by the tools for it."""
    check("iverilog, Verilog names", judges.iverilog, forms.verilog, top)
    check("verilator, Verilog names", judges.verilator, forms.verilog, top)
    check("yosys, Verilog names", judges.yosys, forms.verilog, top)
    check("equivalent to Yosys' netlist, Verilog names", compare_with_yosys, top, forms,
          reference, work)
    folder = work / "vhdl93"
    folder.mkdir()
    check("ghdl, VHDL names", judges.Ghdl("93", folder).analyse, forms.vhdl)


def run_design(tally: Tally, program: Path, design: Design, work: Path) -> None:
    """The whole way of one design; what cannot be had is not judged."""
    def check(what, *arguments):
        return tally.check(f"{design.name}: {what}", *arguments)

    tool = Tool(program)
    netlists = check("synthesis", synthesise, design, work)
    forms = netlists and check("import", tool.import_netlist, netlists[0],
                               design.name, work)
    if not forms:
        return
    judge(tally, design.name, design, forms, work / "imported")
    check("equivalent to Yosys' netlist", compare_with_yosys, design.name, forms, netlists[1],
          work)
    alone = check("import to one language", tool.import_alone, netlists[0], work / "alone")
    if alone:
        judge_alone(check, design.name, alone, netlists[1], work / "alone")
    replayed = check("replay", tool.replay, work / "X.cmd", work / "replayed")
    if replayed:
        check("replay gives the same bytes", refuse_other_bytes, forms, replayed)
    repeated = check("repeated writes", tool.replay_repeatedly, work / "X.cmd", work)
    if repeated:
        repeated.port_names = forms.port_names
        judge(tally, f"{design.name}, written again", design, repeated, work / "repeated")


if __name__ == "__main__":
    raise SystemExit(main(__doc__.splitlines()[0], RTL_DESIGNS, run_design))
