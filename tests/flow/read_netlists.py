#!/usr/bin/env python3
"""Netlists read by the library's own reader.

Random designs: what is written in either language is read and written again, and is the same. RTL:
the netlist that Yosys writes is read and written, with and without Yosys' attributes; the result has
the same cells, wired alike, and is equivalent. So is what is written as VHDL, which GHDL analyses,
read and written as Verilog; and what GHDL makes of that netlist and writes as VHDL. GHDL's netlists
of the RTL itself hold processes and functions, so the netlist of cells is what it is given.
"""

from __future__ import annotations

import argparse
import random
import tempfile
from pathlib import Path

from judging import Design, Tally
from designs import RTL_DESIGNS
from equivalence import BLACK_BOXES, Netlist, prove_equivalent, same_names, same_structure
from judges import CELL_BLACK_BOXES, CELLS, Rejected, quoted, run_tool, run_yosys
from random_designs import RandomDesign, random_leaves
from roundtrip import BATCH, batches, parse_seeds


def read_back(program: Path, seeds: list[int], work: Path) -> None:
    leaves = random_leaves(random.Random(f"leaves {seeds[0] // BATCH}"))
    files = []
    for seed in seeds:
        files.append(work / f"d{seed}.cmd")
        files[-1].write_text("\n".join(RandomDesign(f"d{seed}", seed, leaves).commands) + "\n")
    run_tool([program, "back", *files], work)


def synthesise(design: Design, options: str, target: Path, passes: str = "") -> None:
    run_yosys(f"read_verilog -lib {quoted(CELL_BLACK_BOXES)}; "
              f"read_verilog {quoted(design.source)}; hierarchy -check -top {design.name}; "
              f"script to_cells.ys; {passes} check -assert; write_verilog {options} {quoted(target)}", CELLS)


# Names of Yosys' own that VHDL can have.
VHDL_NAMES = "rename -enumerate -pattern auto%"


# Designs with ports whose names VHDL does not have.
NOT_VHDL = ["names", "feedback", "wires"]
# GHDL ties the open bits of this design to "ZZZ", which no model has.
NOT_FROM_GHDL = ["fifo"]


def rewrite(program: Path, library: Path | str, source: Path, target: Path) -> dict[str, str]:
    """The new names that netlists read and written have, with the old ones."""
    printed = run_tool([program, "rewrite", library, source, target], source.parent).stdout
    pairs = [line.split("\t") for line in printed.splitlines()]
    old_names = {new: old for old, new in pairs}
    if len(old_names) < len(pairs):
        raise Rejected("two names became one")
    return old_names


def compare(program: Path, design: Design, options: str, work: Path) -> None:
    """The netlist that Yosys writes and what the library writes of it are the same circuit."""
    source, target = work / "yosys.v", work / "written.v"
    synthesise(design, options, source)
    old_names = rewrite(program, CELL_BLACK_BOXES, source, target)
    prove_same(source, target, design.name, work, old_names)


def prove_same(source: Path, target: Path, top: str, work: Path, old_names: dict[str, str]) -> None:
    def old_name(name: str) -> str:
        return old_names.get(name, name)

    pairs = same_structure(Netlist.read(source, top, work, BLACK_BOXES),
                           Netlist.read(target, top, work, BLACK_BOXES, old_name))
    prove_equivalent(Netlist.read(source, top, work),
                     Netlist.read(target, top, work, port_names=old_name), pairs, work)


def compare_vhdl(program: Path, design: Design, work: Path) -> None:
    """The netlist that Yosys writes, as VHDL that is read back, is the same circuit; so is the
    netlist that GHDL writes of that VHDL."""
    source, vhdl, target = work / "yosys.v", work / "written.vhd", work / "back.v"
    synthesise(design, "-noattr", source, f"{VHDL_NAMES};")
    old_names = rewrite(program, CELL_BLACK_BOXES, source, vhdl)
    run_tool(["ghdl", "-a", "--std=93c", vhdl], work)
    if rewrite(program, "-", vhdl, target):
        raise Rejected("names that were written are not read")
    prove_same(source, target, design.name, work, old_names)
    if design.name in NOT_FROM_GHDL:
        return
    synthesised, again = work / "ghdl.vhd", work / "again.v"
    synthesised.write_text(run_tool(["ghdl", "--synth", "--std=93c", "--out=vhdl", design.name],
                                    work).stdout)
    cells = work / "cells.vhd"
    cells.write_text(package_of_components(vhdl.read_text()))
    rewrite(program, cells, synthesised, again)
    gold, gate = (Netlist.read(file, design.name, work) for file in (target, again))
    prove_equivalent(gold, gate, same_names(gold, gate), work)


def package_of_components(vhdl: str) -> str:
    """The component declarations of an architecture as a library: GHDL drops them."""
    first = vhdl.index("   component ")
    last = vhdl.rindex("end component;") + len("end component;")
    return f"package cells is\n{vhdl[first:last]}\nend cells;\n"


def main() -> int:
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("--program", type=Path, required=True,
                        help="orn_hdl_reading, the program that reads")
    parser.add_argument("--seeds", type=parse_seeds, default=(1, 100), metavar="FIRST-LAST")
    parser.add_argument("designs", nargs="*", help="RTL designs; all when none is named")
    options = parser.parse_args()
    program = options.program.resolve()
    tally = Tally()
    with tempfile.TemporaryDirectory() as scratch:
        work = Path(scratch)
        for seeds in batches(*options.seeds):
            tally.check(f"designs {seeds[0]} to {seeds[-1]}: read back", read_back, program, seeds,
                        work)
        for design in RTL_DESIGNS:
            if not options.designs or design.name in options.designs:
                for form in ("", "-noattr"):
                    tally.check(f"{design.name} {form}: equivalent to Yosys' netlist", compare,
                                program, design, form, work)
                if design.name not in NOT_VHDL:
                    tally.check(f"{design.name}: equivalent as VHDL that is read", compare_vhdl,
                                program, design, work)
    return tally.close()


if __name__ == "__main__":
    raise SystemExit(main())
