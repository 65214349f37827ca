#!/usr/bin/env python3
"""Each rule of `orn-hdl check` has a command file that it finds something in, and one beside it in
which it finds nothing; the real tools agree with both.

    check_rules.py --tool build/release/tools/orn-hdl/orn-hdl [RULE...]

Of the bad file, each tool makes what the findings say it does, or better where a finding says only
that it warns. The good file is accepted, without a warning, by every tool that minds the bad one.
What a netlist only names is there neither time: libraries, include files and configurations.
"""

from __future__ import annotations

import argparse
import os
import subprocess
import sys
import tempfile
from pathlib import Path

from check_judging import ACCEPTED, LEVELS, REJECTED, WARNED, Judges, read_commands
from check_random import JUDGES, foretold, run_check

RULES = Path(__file__).resolve().parents[1] / "check" / "rules"


def names_of_rules(tool: Path) -> list[str]:
    done = subprocess.run([tool, "check", "--list"], capture_output=True, text=True, check=True)
    return [line.split()[0] for line in done.stdout.splitlines()]


def judge(tool: Path, source: Path, work: Path) -> tuple[list[dict], dict]:
    """The findings, and the verdicts of the tools on what is written."""
    text = source.read_text("latin-1")
    (work / "X.cmd").write_text(text, "latin-1")
    for language, name in (("--verilog", "X.v"), ("--vhdl", "X.vhd")):
        subprocess.run([tool, "run", "--quiet", "--no-header", language, name, "X.cmd"], cwd=work,
                       check=True, capture_output=True)
    _, findings, _ = run_check(tool, work)
    commands = read_commands(text, "X")
    given = "missing-configuration" not in {finding["rule"] for finding in findings}
    commands.libraries = []
    commands.suppressed = False
    return findings, Judges(work, commands, configurations=given).all()


def check_rule(tool: Path, rule: str) -> list[str]:
    """What is wrong with a rule."""
    wrong = []
    with tempfile.TemporaryDirectory() as folder:
        work = Path(folder)
        (work / "bad").mkdir()
        (work / "good").mkdir()
        findings, verdicts = judge(tool, RULES / rule / "bad.cmd", work / "bad")
        fine, good_verdicts = judge(tool, RULES / rule / "good.cmd", work / "good")
    mine = [finding for finding in findings if finding["rule"] == rule]
    if not mine:
        wrong.append("nothing is found in bad.cmd")
    wrong += [f"good.cmd: {finding['message']}" for finding in fine if finding["rule"] == rule]
    for name in JUDGES:
        told, came = foretold(findings, name), verdicts[name].level
        if (told == REJECTED) != (came == REJECTED) and told != WARNED:
            wrong.append(f"bad.cmd: {name} was foretold {LEVELS[told]}, but {verdicts[name]}")
        if told == ACCEPTED and came != ACCEPTED:
            wrong.append(f"bad.cmd: {name} minds something else: {verdicts[name]}")
        if foretold(mine, name) != ACCEPTED and good_verdicts[name].level != ACCEPTED \
                and foretold(fine, name) == ACCEPTED:
            wrong.append(f"good.cmd: {name} {good_verdicts[name]}")
    return wrong


def main() -> int:
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("--tool", type=Path, required=True)
    parser.add_argument("rules", nargs="*")
    options = parser.parse_args()
    os.environ["SOURCE_DATE_EPOCH"] = "0"
    tool = options.tool.resolve()
    rules = options.rules or names_of_rules(tool)
    failed = 0
    for rule in rules:
        wrong = check_rule(tool, rule)
        failed += bool(wrong)
        for line in wrong:
            print(f"FAIL {rule}: {line}"[:500])
    extra = {path.name for path in RULES.iterdir()} - set(names_of_rules(tool))
    for name in sorted(extra):
        print(f"FAIL {name}: there is no such rule")
    print(f"{len(rules) - failed} rules hold, {failed} do not")
    return 1 if failed or extra else 0


if __name__ == "__main__":
    sys.exit(main())
