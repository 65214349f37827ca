#!/usr/bin/env python3
"""`orn-hdl run --legal` writes what every tool takes, or says by which rule it cannot.

    check_legal.py --tool build/release/tools/orn-hdl/orn-hdl [RULE...]

The command file that breaks a rule of `orn-hdl check` is written with --legal: every tool accepts the
netlists and both languages mean the same, or nothing is written and the message names the rule. The
file beside it, which keeps the rule, is written too.
"""

from __future__ import annotations

import argparse
import os
import re
import subprocess
import sys
import tempfile
from collections import Counter
from concurrent.futures import ProcessPoolExecutor
from dataclasses import dataclass
from pathlib import Path

from check_designs import generate
from check_judging import REJECTED, Commands, Judges, clear, read_commands
from check_meaning import difference
from check_random import write_design

RULES = Path(__file__).resolve().parents[1] / "check" / "rules"

# No netlist can mend these.
REFUSED = {"alias-bits", "alias-width", "assigned-input", "constant-character", "constant-length",
           "driven-input", "generic-type", "pin-width", "slice-outside", "two-drivers", "wide-bus"}
NOT_COMPARABLE = "the languages cannot be compared"
# Both languages write such a net, and no tool that compares them can.
NOT_COMPARED = {"alias-loop"}


def write_legally(tool: Path, work: Path, *options: str) -> tuple[int, str]:
    """Writes X.v, X.vhd and the table X.names from X.cmd."""
    done = subprocess.run([tool, "run", "--quiet", "--no-header", "--legal", "--no-write", "--keep-going",
                           "--no-warn", "all", "--name-map", "X.names", "--verilog", "X.v", "--vhdl", "X.vhd", *options,
                           "X.cmd"], cwd=work, capture_output=True, timeout=120)
    return done.returncode, done.stderr.decode("latin-1")


def without_writes(text: str) -> str:
    return "".join(line + "\n" for line in text.splitlines() if not line.upper().startswith("WRITE "))


def names_of(table: Path) -> dict[tuple[str, str], str]:
    """The new names, by kind and old name in small letters."""
    names = {}
    for line in table.read_text("latin-1").splitlines():
        kind, old, new = line.split("\t")
        old = re.sub(r"\\(.)", lambda m: {"t": "\t", "n": "\n"}.get(m[1], m[1]), old)
        names[kind, old.lower()] = new
    return names


def rename(commands: Commands, names: dict[tuple[str, str], str], generics: bool = True) -> None:
    """Gives the cells that the tools are given the names that the netlists use."""
    commands.top = next(new for (kind, _), new in names.items() if kind == "module")
    for key, cell in commands.cells.items():
        new = names.get(("component", key), cell.name)
        cell.name = new.upper() if commands.case == "UPPER" else \
            new.lower() if commands.case == "LOWER" else new
        pins = []
        for pin, direction in cell.pins:
            renamed = names.get(("pin", f"{key}.{pin.lower()}"))
            pins.append((pin if renamed is None else renamed[len(new) + 1:], direction))
        cell.pins = pins
        cell.generics = {
            names.get(("parameter", f"{key}.{name.lower()}"),
                      f"{new}.{names.get(('attribute', name.lower()), name)}")[len(new) + 1:]:
            (kind, "component") for name, (kind, _) in cell.generics.items()}


def judge_legal(tool: Path, text: str, work: Path, compared: bool,
                *options: str) -> tuple[list[str], str]:
    """What is wrong with the netlists, and the complaint when there are none."""
    text = without_writes(text)
    (work / "X.cmd").write_text(text, "latin-1")
    status, complaint = write_legally(tool, work, *options)
    if status != 0:
        left = [name for name in ("X.v", "X.vhd", "X.names") if (work / name).exists()]
        return [f"{name} is left behind" for name in left], complaint or f"status {status}"
    commands = read_commands(text, "X")
    rename(commands, names_of(work / "X.names"))
    declared = re.findall(r"^library (\w+);", (work / "X.vhd").read_text("latin-1"), re.M)
    commands.libraries = declared
    commands.suppressed = "component " not in (work / "X.vhd").read_text("latin-1")
    for name in commands.includes:
        if re.match(r"\w[\w./]*$", name):
            (work / name).parent.mkdir(parents=True, exist_ok=True)
            (work / name).write_text("")
    judges = Judges(work, commands)
    wrong = [f"{name} {verdict}" for name, verdict in judges.all().items()
             if verdict.level == REJECTED]
    if compared and not wrong:
        strip(work / "X.vhd")
        found = difference(work, judges)
        if found:
            wrong.append(f"the languages differ: {found}")
        if found is None:
            wrong.append(NOT_COMPARABLE)
    return wrong, ""


def strip(netlist: Path) -> None:
    """Takes out what GHDL cannot synthesise: attributes of ports, and configurations."""
    text = netlist.read_text("latin-1")
    text = re.sub(r'^ *attribute (?:"[^"]*"|[^";])*; *\n', "", text, flags=re.M)
    text = re.sub(r"^-- synopsys translate_off\nconfiguration .*", "", text, flags=re.M | re.S)
    netlist.write_text(text, "latin-1")


def check_rule(tool: Path, rule: str) -> list[str]:
    wrong = []
    for name in ("bad", "good"):
        for names in ("rename", "escape"):
            with tempfile.TemporaryDirectory() as folder:
                text = (RULES / rule / f"{name}.cmd").read_text("latin-1")
                # GHDL's netlists have no escaped names.
                compared = rule not in NOT_COMPARED and names == "rename"
                faults, complaint = judge_legal(tool, text, Path(folder), compared,
                                                "--names", names)
            refused = name == "bad" and rule in REFUSED
            wrong += [f"{name}.cmd, {names}: {fault}" for fault in faults]
            if complaint and (not refused or f"[{rule}]" not in complaint):
                wrong.append(f"{name}.cmd, {names}: {complaint}")
            if refused and not complaint:
                wrong.append(f"{name}.cmd, {names} is written")
    return wrong


@dataclass
class Outcome:
    """What came of one random design."""

    seed: int
    wrong: list[str]
    refusals: list[str]
    compared: bool = False


def check_seed(arguments: tuple[Path, int, Path | None]) -> Outcome:
    """Writes a random design legally. What is refused must break a rule that no netlist can mend."""
    tool, seed, keep = arguments
    with tempfile.TemporaryDirectory() as folder:
        work = clear(keep / str(seed)) if keep else Path(folder)
        text = write_design(tool, work, generate(seed))
        for written in [*work.glob("*.v"), *work.glob("*.vhd")]:
            written.unlink()
        wrong, complaint = judge_legal(tool, text, work, True)
        refusals = re.findall(r"(?:error|warning): .* \[([a-z-]+)\]$", complaint, re.M)
        allowed = REFUSED | {"undeclared-generic", "constant-left-out", "constant-width",
                             "constant-digits", "include-file", "character-in-value"}
        wrong += [f"refused: {complaint}"] if complaint and (
            not refusals or not set(refusals) <= allowed) else []
        announced = run_text(tool, work)
        # A loop of aliases is legal, and the tools that compare find no driver in it.
        if "[alias-loop]" in announced:
            wrong = [fault for fault in wrong if not fault.startswith("the languages")]
        # What a package of the user may declare is a warning, and the package is not there.
        if re.search(r"warning: .*\[(undeclared-attribute|user-type|undeclared-component)\]", announced):
            wrong = [fault for fault in wrong if not fault.startswith("ghdl_")]
        not_compared = [fault for fault in wrong if fault == NOT_COMPARABLE]
        wrong = [fault for fault in wrong if fault != NOT_COMPARABLE]
        if not complaint and not wrong:
            wrong += check_stability(tool, text, work)
        return Outcome(seed, wrong, refusals, not complaint and not not_compared)


def run_text(tool: Path, work: Path) -> str:
    done = subprocess.run([tool, "check", "X.cmd"], cwd=work, capture_output=True, timeout=60)
    return done.stdout.decode("latin-1")


def check_stability(tool: Path, text: str, work: Path) -> list[str]:
    """The same commands give the same bytes, and in another order the same names."""
    names = (work / "X.names").read_text("latin-1")
    verilog = (work / "X.v").read_text("latin-1")
    write_legally(tool, work)
    wrong = [] if (work / "X.v").read_text("latin-1") == verilog else ["written twice, it differs"]
    lines = without_writes(text).splitlines()
    first = next((i for i, line in enumerate(lines) if line.startswith("ADD PORT ")), 0)
    last = first
    while last < len(lines) and lines[last].startswith("ADD PORT "):
        last += 1
    lines[first:last] = reversed(lines[first:last])
    (work / "X.cmd").write_text("\n".join(lines) + "\n", "latin-1")
    status, _ = write_legally(tool, work)
    (work / "X.cmd").write_text(without_writes(text), "latin-1")
    if status == 0 and set((work / "X.names").read_text("latin-1").splitlines()) != set(
            names.splitlines()):
        wrong.append("ports in another order get other names")
    return wrong


def check_random(tool: Path, seeds: range, jobs: int | None, keep: Path | None) -> bool:
    refused: Counter[str] = Counter()
    written = compared = failed = 0
    with ProcessPoolExecutor(jobs) as pool:
        for outcome in pool.map(check_seed, [(tool, seed, keep) for seed in seeds]):
            failed += bool(outcome.wrong)
            for line in outcome.wrong:
                print(f"FAIL seed {outcome.seed}: {line}"[:700], flush=True)
            refused.update(set(outcome.refusals))
            written += not outcome.refusals
            compared += outcome.compared
    print(f"{len(seeds)} designs: {written} written, {compared} of them compared in both languages, "
          f"{failed} wrong")
    for rule, count in refused.most_common():
        print(f"    {count} refused by {rule}")
    return failed == 0


def main() -> int:
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("--tool", type=Path, required=True)
    parser.add_argument("--seeds", help="FIRST-LAST: write these random designs instead of the rules'")
    parser.add_argument("--jobs", type=int, default=os.cpu_count())
    parser.add_argument("--keep", type=Path, help="a folder in which the files stay")
    parser.add_argument("rules", nargs="*")
    options = parser.parse_args()
    os.environ["SOURCE_DATE_EPOCH"] = "0"
    if options.seeds:
        first, _, last = options.seeds.partition("-")
        return 0 if check_random(options.tool.resolve(), range(int(first), int(last or first) + 1),
                                 options.jobs, options.keep) else 1
    rules = options.rules or sorted(path.name for path in RULES.iterdir())
    failed = 0
    for rule in rules:
        wrong = check_rule(options.tool.resolve(), rule)
        failed += bool(wrong)
        for line in wrong:
            print(f"FAIL {rule}: {line}"[:700])
    print(f"{len(rules) - failed} rules hold, {failed} do not")
    return 1 if failed else 0


if __name__ == "__main__":
    sys.exit(main())
