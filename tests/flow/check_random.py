#!/usr/bin/env python3
"""Compares what `orn-hdl check` foretells of random designs with what the real tools say.

    check_random.py --tool build/release/tools/orn-hdl/orn-hdl --seeds 1-2000

For each design and tool: a rejection that no finding announces is missed; a finding of severity
error for a tool that does not reject is a false alarm. Designs that all tools accept are read back
from both languages and compared; a difference that no finding announces is missed too. The exit
status tells whether anything was missed, or more than one announced rejection in a hundred is a false
alarm.
"""

from __future__ import annotations

import argparse
import json
import os
import re
import subprocess
import sys
import tempfile
from collections import Counter
from concurrent.futures import ProcessPoolExecutor
from dataclasses import dataclass, field
from pathlib import Path

from check_designs import generate
from check_judging import ACCEPTED, LEVELS, REJECTED, WARNED, Judges, clear, read_commands
from check_meaning import difference

TOOLS = ["icarus", "verilator", "yosys", "ghdl"]
JUDGES = {"icarus": ["icarus"], "verilator": ["verilator"], "yosys": ["yosys"],
          "ghdl_93": ["ghdl", "vhdl-93"], "ghdl_08": ["ghdl", "vhdl-2008"]}
MEANING = "read otherwise than meant by "
REJECTS = "rejected by "


@dataclass
class Outcome:
    """One design: per judge what was foretold and what came."""

    seed: int
    failed: str = ""
    verdicts: dict[str, tuple[int, int]] = field(default_factory=dict)
    said: dict[str, str] = field(default_factory=dict)
    findings: list[str] = field(default_factory=list)
    announced_difference: bool = False
    difference: str | None = None


def run_check(tool: Path, work: Path) -> tuple[int, list[dict], str]:
    done = subprocess.run([tool, "check", "--format", "json", "X.cmd"], cwd=work,
                          capture_output=True, timeout=60)
    text = done.stdout.decode()
    return done.returncode, json.loads(text)["findings"] if text else [], done.stderr.decode(
        "latin-1")


def targets_of(finding: dict, saying: str) -> set[str]:
    return {target for note in finding["notes"] if note.startswith(saying)
            for target in note[len(saying):].split(", ")}


def foretold(findings: list[dict], judge: str) -> int:
    """The worst that a finding says of a judge: of GHDL, what it says of the edition as well, unless
    it speaks of neither edition."""
    worst = ACCEPTED
    for finding in findings:
        targets = set(JUDGES[judge])
        if not {"vhdl-93", "vhdl-2008"} & set(finding["targets"]):
            targets &= set(TOOLS)
        if targets <= targets_of(finding, REJECTS):
            return REJECTED
        if targets <= set(finding["targets"]):
            worst = WARNED
    return worst


def write_design(tool: Path, work: Path, text: str) -> str:
    """Writes the netlists; lines that fail are taken out. Returns the file as it then is."""
    for _ in range(12):
        (work / "X.cmd").write_text(text, "latin-1")
        done = subprocess.run([tool, "run", "--quiet", "--keep-going", "X.cmd"], cwd=work,
                              capture_output=True, timeout=60)
        bad = {int(number) for number in re.findall(r"X\.cmd:(\d+): error",
                                                    done.stderr.decode("latin-1"))}
        if not bad:
            return text
        lines = text.split("\n")
        text = "\n".join(line for number, line in enumerate(lines, 1) if number not in bad)
    raise RuntimeError("lines go on failing")


def judge_seed(arguments: tuple[Path, int, Path | None]) -> Outcome:
    tool, seed, keep = arguments
    outcome = Outcome(seed)
    with tempfile.TemporaryDirectory() as folder:
        work = clear(keep / str(seed)) if keep else Path(folder)
        text = write_design(tool, work, generate(seed))
        status, findings, complaint = run_check(tool, work)
        if status not in (0, 1) or complaint:
            outcome.failed = f"check ends with {status}: {complaint}"
            return outcome
        # What the file only names has to be given: libraries, files, configurations.
        outcome.findings = [f"{f['line']}: {f['severity']}: {f['message']} [{f['rule']}]"
                            for f in findings]
        judges = Judges(work, read_commands(text, "X"))
        verilog = sorted(path.name for path in work.glob("[wX]*.v"))
        vhdl = sorted(path.name for path in work.glob("[wX]*.vhd"))
        for name, verdict in judges.all(verilog, vhdl).items():
            outcome.verdicts[name] = (foretold(findings, name), verdict.level)
            outcome.said[name] = str(verdict)[:300]
        if all(verdict[1] != REJECTED for verdict in outcome.verdicts.values()):
            outcome.announced_difference = any(targets_of(f, MEANING) for f in findings)
            if not {"two-drivers", "driven-input", "alias-loop", "assigned-input"} & {
                    f["rule"] for f in findings}:
                outcome.difference = difference(work, judges)
    return outcome


class Sums:
    """What came of all designs."""

    def __init__(self) -> None:
        self.table = {judge: Counter() for judge in JUDGES}
        self.missed: list[str] = []
        self.alarms: list[str] = []
        self.warnings: list[str] = []
        self.unannounced: list[str] = []
        self.failed: list[str] = []
        self.compared = self.differing = self.false_differences = 0
        self.missed_differences: list[str] = []

    def add(self, outcome: Outcome) -> None:
        if outcome.failed:
            self.failed.append(f"seed {outcome.seed}: {outcome.failed}")
        about = "\n    ".join(["", *outcome.findings])
        for judge, (told, came) in outcome.verdicts.items():
            self.table[judge][told, came] += 1
            where = f"seed {outcome.seed}, {judge}: {outcome.said[judge]}{about}"
            if came == REJECTED and told != REJECTED:
                (self.missed if told == ACCEPTED else self.warnings).append(where)
            if told == REJECTED and came != REJECTED:
                self.alarms.append(where)
            if told == ACCEPTED and came == WARNED:
                self.unannounced.append(where)
        if outcome.difference is not None:
            self.compared += 1
            if outcome.difference:
                self.differing += 1
                if not outcome.announced_difference:
                    self.missed_differences.append(
                        f"seed {outcome.seed}: {outcome.difference}{about}")
            elif outcome.announced_difference:
                self.false_differences += 1

    def report(self, verbose: bool) -> None:
        for title, cases in (("failed", self.failed), ("missed", self.missed),
                             ("false alarm", self.alarms),
                             ("missed difference", self.missed_differences),
                             ("announced as a warning only", self.warnings if verbose else []),
                             ("unannounced warning", self.unannounced if verbose else [])):
            for case in cases:
                print(f"{title}: {case}")
        print("| tool | rejections | announced as error | as warning only | missed | accepted "
              "| false alarms | warnings | of them announced |")
        print("| --- | --- | --- | --- | --- | --- | --- | --- | --- |")
        for judge, table in self.table.items():
            rejected = sum(n for (_, came), n in table.items() if came == REJECTED)
            accepted = sum(n for (_, came), n in table.items() if came != REJECTED)
            warned = sum(n for (_, came), n in table.items() if came == WARNED)
            told = sum(n for (t, came), n in table.items() if came == WARNED and t != ACCEPTED)
            alarms = table[REJECTED, ACCEPTED] + table[REJECTED, WARNED]
            print(f"| {judge} | {rejected} | {table[REJECTED, REJECTED]} "
                  f"| {table[WARNED, REJECTED]} | {table[ACCEPTED, REJECTED]} | {accepted} "
                  f"| {alarms} | {warned} | {told} |")
        print(f"{self.compared} designs compared in both languages, {self.differing} differ, "
              f"{len(self.missed_differences)} of them unannounced; "
              f"{self.false_differences} announced that do not differ")

    def is_good(self) -> bool:
        announced = sum(table[REJECTED, came] for table in self.table.values()
                        for came in (ACCEPTED, WARNED, REJECTED))
        return not (self.failed or self.missed or self.missed_differences) and \
            100 * len(self.alarms) <= announced


def main() -> int:
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("--tool", type=Path, required=True)
    parser.add_argument("--seeds", default="1-100", help="FIRST-LAST")
    parser.add_argument("--jobs", type=int, default=os.cpu_count())
    parser.add_argument("--keep", type=Path, help="a folder in which the files stay")
    parser.add_argument("--verbose", action="store_true")
    parser.add_argument("--legal", action="store_true",
                        help="write the designs with --legal, as check_legal.py does")
    options = parser.parse_args()
    os.environ["SOURCE_DATE_EPOCH"] = "0"
    first, _, last = options.seeds.partition("-")
    seeds = range(int(first), int(last or first) + 1)
    if options.legal:
        from check_legal import check_random
        return 0 if check_random(options.tool.resolve(), seeds, options.jobs, options.keep) else 1
    sums = Sums()
    with ProcessPoolExecutor(options.jobs) as pool:
        for outcome in pool.map(judge_seed,
                                [(options.tool.resolve(), seed, options.keep) for seed in seeds]):
            sums.add(outcome)
    sums.report(options.verbose)
    print(f"{len(seeds)} designs, {'good' if sums.is_good() else 'NOT good'}")
    return 0 if sums.is_good() else 1


if __name__ == "__main__":
    sys.exit(main())
