#!/usr/bin/env python3
"""Command files, the examples and the VHDL-93 cases, before the judges in both languages.

Each file is replayed and its netlists judged, and once more those that a replay writes as its
second of either language. The counter is run against its own test bench too, and the processor's
command file must be what its synthesis script and the import make of the RTL.
"""

from __future__ import annotations

import shutil
from pathlib import Path

from judging import Design, Forms, Tally, judge, main
from designs import COMMAND_FILES, EXAMPLES
from judges import CELL_BODIES, Rejected, run_tool, simulate_verilog
from tool import Tool


def run_test_bench(forms: Forms, work: Path) -> None:
    """The counter's own test bench, netlist and RTL side by side."""
    folder = EXAMPLES / "counter8"
    shown = simulate_verilog([folder / "counter8_tb.v", folder / "counter8_rtl.v", forms.verilog,
                              CELL_BODIES], "counter8_tb", work)
    if "PASS" not in shown:
        raise Rejected(shown)


def refuse_stale_commands(tool: Tool, work: Path) -> None:
    """Synthesises and imports the processor anew and compares with the file that is kept."""
    copy = work / "examples"
    for folder in ("cells", "cpu8"):
        shutil.copytree(EXAMPLES / folder, copy / folder)
    run_tool(["yosys", "-q", "cpu8.ys"], copy / "cpu8")
    tool.run(copy / "cpu8", "import", "cpu8.json", "-o", "cpu8.cmd")
    if (copy / "cpu8" / "cpu8.cmd").read_bytes() != (EXAMPLES / "cpu8" / "cpu8.cmd").read_bytes():
        raise Rejected("cpu8.cmd is not what cpu8.ys and the import give")


def run_design(tally: Tally, program: Path, design: Design, work: Path) -> None:
    def check(what, *arguments):
        return tally.check(f"{design.name}: {what}", *arguments)

    tool = Tool(program)
    forms = check("replay", tool.replay, design.source, work)
    if forms:
        judge(tally, design.name, design, forms, work / "judged")
    repeated = check("repeated writes", tool.replay_repeatedly, design.source, work)
    if repeated:
        judge(tally, f"{design.name}, written again", design, repeated, work / "repeated")
    if forms and design.name == "counter8":
        check("test bench", run_test_bench, forms, work)
    if design.name == "cpu8":
        check("command file is up to date", refuse_stale_commands, tool, work)


if __name__ == "__main__":
    raise SystemExit(main(__doc__.splitlines()[0], COMMAND_FILES, run_design))
