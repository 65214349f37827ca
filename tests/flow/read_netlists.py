#!/usr/bin/env python3
"""Netlists read by the library's own reader.

Random designs: what is written is read and written again, and is the same. RTL: the netlist that
Yosys writes is read and written, with and without Yosys' attributes; the result has the same cells,
wired alike, and is equivalent.
"""

from __future__ import annotations

import argparse
import random
import tempfile
from pathlib import Path

from judging import Design, Tally
from designs import RTL_DESIGNS
from equivalence import BLACK_BOXES, Netlist, prove_equivalent, same_structure
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


def synthesise(design: Design, options: str, target: Path) -> None:
    run_yosys(f"read_verilog -lib {quoted(CELL_BLACK_BOXES)}; "
              f"read_verilog {quoted(design.source)}; hierarchy -check -top {design.name}; "
              f"script to_cells.ys; check -assert; write_verilog {options} {quoted(target)}", CELLS)


def compare(program: Path, design: Design, options: str, work: Path) -> None:
    """The netlist that Yosys writes and what the library writes of it are the same circuit."""
    source, target = work / "yosys.v", work / "written.v"
    synthesise(design, options, source)
    printed = run_tool([program, "rewrite", CELL_BLACK_BOXES, source, target], work).stdout
    pairs_of_names = [line.split("\t") for line in printed.splitlines()]
    old_names = {new: old for old, new in pairs_of_names}
    if len(old_names) < len(pairs_of_names):
        raise Rejected("two names became one")

    def old_name(name: str) -> str:
        return old_names.get(name, name)

    pairs = same_structure(Netlist.read(source, design.name, work, BLACK_BOXES),
                           Netlist.read(target, design.name, work, BLACK_BOXES, old_name))
    prove_equivalent(Netlist.read(source, design.name, work),
                     Netlist.read(target, design.name, work, port_names=old_name), pairs, work)


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
    return tally.close()


if __name__ == "__main__":
    raise SystemExit(main())
