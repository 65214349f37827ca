#!/usr/bin/env python3
"""Runs the example clients and compares what they print with the .expected files beside them."""

from __future__ import annotations

import difflib
import subprocess
import sys
from pathlib import Path

FOLDER = Path(__file__).resolve().parents[2] / "examples" / "embed"
RUNS = {"adder": ["2"], "report": ["report.cmd"], "chain": ["chain.cmd"],
        "netlist": ["report.cmd"]}


def main(programs: Path) -> int:
    failed = 0
    for name, arguments in RUNS.items():
        done = subprocess.run([programs / name, *arguments], cwd=FOLDER, capture_output=True,
                              text=True)
        expected = (FOLDER / f"{name}.expected").read_text()
        if done.returncode != 0 or done.stderr or done.stdout != expected:
            failed += 1
            print(f"embed: {name} ended with status {done.returncode}\n{done.stderr}", end="")
            sys.stdout.writelines(difflib.unified_diff(
                expected.splitlines(True), done.stdout.splitlines(True), f"{name}.expected", name))
    print(f"embed: {len(RUNS)} programs run, {failed} failed")
    return 1 if failed else 0


if __name__ == "__main__":
    raise SystemExit(main(Path(sys.argv[1]).resolve()))
