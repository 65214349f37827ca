#!/usr/bin/env python3
"""`orn-hdl run --verify` on random designs and on the files of every rule of `orn-hdl check`.

    prove_designs.py --tool build/release/tools/orn-hdl/orn-hdl --seeds 1-10000

Each design is written twice. With --legal, every netlist has to be proven, or nothing may be written
because of a rule that no netlist can mend. As it stands, a netlist that is not proven has to be one of
which a rule of `orn-hdl check` tells: the message names it. The exit status tells whether all of that
holds.
"""

from __future__ import annotations

import argparse
import os
import subprocess
import sys
import tempfile
from collections import Counter
from concurrent.futures import ProcessPoolExecutor
from pathlib import Path

from check_designs import generate

RULES = Path(__file__).resolve().parents[1] / "check" / "rules"
UNPROVEN = 4
LANGUAGES = {"verilog": "v", "vhdl": "vhd"}
RULE_IS_NAMED = "note: what helps: "


def run(tool: Path, work: Path, *options: str) -> tuple[int, str]:
    done = subprocess.run([tool, "run", "--quiet", "--no-header", "--no-write", "--keep-going",
                           "--no-warn", "all", *options, "X.cmd"],
                          cwd=work, capture_output=True, timeout=120)
    return done.returncode, done.stderr.decode("latin-1")


def without_failing_lines(tool: Path, work: Path, text: str) -> str:
    """The commands that can be carried out, without the writing ones."""
    text = "".join(line + "\n" for line in text.splitlines()
                   if not line.upper().startswith("WRITE "))
    while True:
        (work / "X.cmd").write_text(text, "latin-1")
        status, complaint = run(tool, work)
        if status == 0:
            return text
        bad = {int(line.split(":")[1]) for line in complaint.splitlines()
               if line.startswith("X.cmd:") and ": error: " in line}
        text = "".join(line + "\n" for number, line in enumerate(text.splitlines(), 1)
                       if number not in bad)


def try_design(tool: Path, text: str, languages: list[str], names: str) -> tuple[Counter, list[str]]:
    counts: Counter = Counter()
    wrong = []
    with tempfile.TemporaryDirectory() as folder:
        work = Path(folder)
        without_failing_lines(tool, work, text)
        for language in languages:
            out = f"X.{LANGUAGES[language]}"
            for legal in (True, False):
                (work / out).write_text("former\n")
                options = ["--legal", "--names", names] if legal else []
                status, complaint = run(tool, work, "--verify", *options, f"--{language}", out)
                is_old = (work / out).read_text("latin-1") == "former\n"
                what = f"{language}, {'legal' if legal else 'literal'}"
                if status not in (0, 1, UNPROVEN):
                    wrong.append(f"{what}: status {status}: {complaint}")
                elif (status == 0) == is_old:
                    wrong.append(f"{what}: status {status}, and the former file "
                                 f"{'stays' if is_old else 'is gone'}")
                elif status == 1 and not legal:
                    wrong.append(f"{what}: {complaint}")
                elif status == UNPROVEN and (legal or RULE_IS_NAMED not in complaint):
                    wrong.append(f"{what}: {complaint}")
                counts[what, {0: "proven", 1: "refused", UNPROVEN: "not proven"}.get(status, "")] += 1
    return counts, wrong


def try_seed(arguments: tuple[Path, int, list[str]]) -> tuple[str, Counter, list[str]]:
    tool, seed, languages = arguments
    names = "escape" if seed % 4 == 0 else "rename"
    return (f"seed {seed}", *try_design(tool, generate(seed), languages, names))


def try_rule(arguments: tuple[Path, str, list[str]]) -> tuple[str, Counter, list[str]]:
    tool, rule, languages = arguments
    counts: Counter = Counter()
    wrong = []
    for file in ("bad", "good"):
        for names in ("rename", "escape"):
            text = (RULES / rule / f"{file}.cmd").read_text("latin-1")
            more, faults = try_design(tool, text, languages, names)
            counts += more
            wrong += [f"{file}.cmd: {fault}" for fault in faults]
    return rule, counts, wrong


def main() -> int:
    parser = argparse.ArgumentParser(description=__doc__.split("\n")[0])
    parser.add_argument("--tool", type=lambda text: Path(text).resolve(), required=True)
    parser.add_argument("--seeds", default="1-200", help="FIRST-LAST")
    parser.add_argument("--language", choices=list(LANGUAGES), action="append")
    parser.add_argument("--jobs", type=int, default=os.cpu_count())
    arguments = parser.parse_args()
    languages = arguments.language or list(LANGUAGES)
    first, _, last = arguments.seeds.partition("-")
    counts: Counter = Counter()
    failed = 0
    with ProcessPoolExecutor(arguments.jobs) as pool:
        rules = [(arguments.tool, rule.name, languages) for rule in sorted(RULES.iterdir())]
        seeds = [(arguments.tool, seed, languages) for seed in range(int(first), int(last) + 1)]
        for results in (pool.map(try_rule, rules), pool.map(try_seed, seeds, chunksize=8)):
            for name, more, wrong in results:
                counts += more
                failed += bool(wrong)
                for fault in wrong:
                    print(f"{name}: {fault}")
    for (what, outcome), count in sorted(counts.items()):
        print(f"{what}: {outcome}: {count}")
    print(f"{len(rules) + len(seeds) - failed} passed, {failed} failed")
    return 1 if failed else 0


if __name__ == "__main__":
    sys.exit(main())
