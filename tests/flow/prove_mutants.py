#!/usr/bin/env python3
"""Changes one token of a written netlist and has `orn-hdl verify` compare it with the design.

    prove_mutants.py --tool build/release/tools/orn-hdl/orn-hdl --mutants 5000

A mutant changes a name, an index or a digit, a direction, swaps two connections or two names in one
statement, or loses a line. Every mutant that changes the meaning has to be found. One that is not found
is looked at by other means: its tokens are those of the netlist once comments that no tool reads are left
out, letter case aside in VHDL, or Yosys reads the same module. Whatever is left is printed, and the exit
status tells whether there is any.
"""

from __future__ import annotations

import argparse
import json
import os
import random
import re
import subprocess
import sys
import tempfile
from collections import Counter
from concurrent.futures import ProcessPoolExecutor
from pathlib import Path

from check_designs import generate

LANGUAGES = {"verilog": "v", "vhdl": "vhd"}
PER_DESIGN = 25
UNPROVEN = 4
NAME = re.compile(r"[A-Za-z_]\w*")
NUMBER = re.compile(r"\d+")
DIRECTIONS = [("input", "output"), ("output", "inout"), ("inout", "input"), (": in ", ": out"),
              (": out", ": inout"), (": inout", ": in "), ("downto", "to"), (" to ", " downto ")]
OBEYED = re.compile(r"(//|--|/\*)\s*(synopsys|synthesis|exemplar|pragma)\b")


def at_random(source: random.Random, text: str, pattern: re.Pattern) -> re.Match | None:
    found = list(pattern.finditer(text))
    return source.choice(found) if found else None


def replaced(text: str, match: re.Match, by: str) -> str:
    return text[:match.start()] + by + text[match.end():]


def change_name(source: random.Random, text: str) -> str:
    match = at_random(source, text, NAME)
    others = sorted({other for other in NAME.findall(text) if other != match[0]})
    return replaced(text, match, source.choice([*others, match[0] + "x", match[0][:-1] or "q"]))


def change_digit(source: random.Random, text: str) -> str:
    match = at_random(source, text, re.compile(r"\d"))
    if match is None:
        return text
    return replaced(text, match, source.choice([c for c in "0123456789" if c != match[0]]))


def change_index(source: random.Random, text: str) -> str:
    match = at_random(source, text, re.compile(r"(?<=[\[(:])\d+|\d+(?= (?:downto|to))|(?<=to )\d+"))
    return text if match is None else replaced(
        text, match, str(max(0, int(match[0]) + source.choice([-1, 1, 2]))))


def change_direction(source: random.Random, text: str) -> str:
    old, new = source.choice([pair for pair in DIRECTIONS if pair[0] in text] or [("", "")])
    match = at_random(source, text, re.compile(re.escape(old))) if old else None
    return text if match is None else replaced(text, match, new)


def swap_connections(source: random.Random, text: str) -> str:
    if "port map" in text:
        items = [m for m in re.finditer(r"(?<==>)[^,;\n]+?(?=,\n|\);)", text)]
    else:
        items = [m for m in re.finditer(r"(?<=\()[^()\n]*(?=\)(?:, ?$|\);))", text, re.M)]
    if len(items) < 2:
        return text
    first = source.randrange(len(items) - 1)
    a, b = items[first], items[first + 1]
    return text[:a.start()] + b[0] + text[a.end():b.start()] + a[0] + text[b.end():]


def lose_line(source: random.Random, text: str) -> str:
    lines = text.split("\n")
    at = source.choice([i for i, line in enumerate(lines) if line.strip()])
    return "\n".join(lines[:at] + lines[at + 1:])


KINDS = {"name": change_name, "digit": change_digit, "index": change_index,
         "direction": change_direction, "swap": swap_connections, "line": lose_line}


def tokens(text: str, language: str) -> list[str]:
    """What a tool reads: comments are left out unless a synthesis tool reads them."""
    mark = "//" if language == "verilog" else "--"
    kept = []
    for line in text.split("\n"):
        if mark in line and '"' not in line[:line.index(mark)] and not OBEYED.search(line):
            line = line[:line.index(mark)]
        kept.append(line)
    text = "\n".join(kept)
    # Nothing follows that could be hidden; a range of one bit has no direction; an output that is not
    # mentioned is open; what stands behind "end" is optional, and the reader compares names there.
    text = re.sub(r"--\s*synopsys translate_on\s*$", "", text.rstrip())
    text = re.sub(r"\b(\d+) (?:downto|to) \1\b", r"\1 to \1", text)
    if language == "verilog":
        # Nets without delays have no time, and a port that is not mentioned is open.
        text = re.sub(r"`timescale.*", "", text)
        text = re.sub(r"\.\w+\(\)\s*(?:,|(?=\);))", "", text)
        text = re.sub(r",\s*\);", ");", text)
    if language == "vhdl":
        text = re.sub(r"\w+\s*=>\s*open\s*(?:,|(?=\)))", "", text)
        text = re.sub(r",\s*\)", ")", text)
        text = re.sub(r"\bend (?!for|component|generate)\w+;", "end;", text)
    words = re.findall(r'"[^"]*"|\w+|[^\s\w]', text)
    return words if language == "verilog" else [
        word if word.startswith('"') else word.lower() for word in words]


def read_by_yosys(work: Path, file: str) -> object:
    """The module as Yosys reads it, without places; None when it does not."""
    # Included files are not there.
    text = (work / file).read_text("latin-1")
    (work / "read.v").write_text(re.sub(r"(?m)^\s*`include.*$", "", text), "latin-1")
    done = subprocess.run(["yosys", "-q", "-p", "read_verilog read.v; write_json out.json"],
                          cwd=work, capture_output=True, timeout=60)
    if done.returncode:
        return None
    design = json.loads((work / "out.json").read_text())

    def strip(node: object) -> object:
        if isinstance(node, dict):
            return {key: strip(value) for key, value in node.items() if key != "src"}
        return [strip(item) for item in node] if isinstance(node, list) else node
    return strip(design["modules"])


def verify(tool: Path, work: Path, file: str) -> tuple[int, str]:
    done = subprocess.run([tool, "verify", "--quiet", file, "--commands", "X.cmd", "--legal"],
                          cwd=work, capture_output=True, timeout=60)
    return done.returncode, done.stderr.decode("latin-1")


def try_seed(arguments: tuple[Path, int, list[str]]) -> tuple[Counter, list[str]]:
    tool, seed, languages = arguments
    counts: Counter = Counter()
    left = []
    source = random.Random(seed)
    with tempfile.TemporaryDirectory() as folder:
        work = Path(folder)
        text = "".join(line + "\n" for line in generate(seed).splitlines()
                       if not line.upper().startswith("WRITE "))
        for _ in range(8):
            (work / "X.cmd").write_text(text, "latin-1")
            # A write in one language may change the letter case of what the other one gets.
            for language, extension in LANGUAGES.items():
                done = subprocess.run(
                    [tool, "run", "--quiet", "--no-header", "--keep-going", "--no-warn", "all", "--legal",
                     f"--{language}", f"X.{extension}", "X.cmd"],
                    cwd=work, capture_output=True, timeout=60)
            bad = {int(n) for n in re.findall(r"^X\.cmd:(\d+): error", done.stderr.decode("latin-1"),
                                              re.M)}
            if done.returncode == 0 or not bad:
                break
            text = "".join(line + "\n" for number, line in enumerate(text.splitlines(), 1)
                           if number not in bad)
        for language in languages if done.returncode == 0 else []:
            file = f"M.{LANGUAGES[language]}"
            original = (work / f"X.{LANGUAGES[language]}").read_text("latin-1")
            (work / file).write_text(original, "latin-1")
            status, complaint = verify(tool, work, file)
            if status != 0:
                left.append(f"seed {seed}, {language}: the netlist itself is not proven: {complaint}")
                continue
            seen = set()
            for _ in range(PER_DESIGN):
                kind = source.choice(list(KINDS))
                mutant = KINDS[kind](source, original)
                if mutant == original or mutant in seen:
                    continue
                seen.add(mutant)
                (work / file).write_text(mutant, "latin-1")
                status, complaint = verify(tool, work, file)
                outcome = "found" if status == UNPROVEN else None
                if status not in (0, UNPROVEN):
                    left.append(f"seed {seed}, {language}: status {status}: {complaint}")
                if outcome is None and tokens(mutant, language) == tokens(original, language):
                    outcome = "the same tokens"
                if outcome is None and language == "verilog":
                    (work / "O.v").write_text(original, "latin-1")
                    mutated = read_by_yosys(work, file)
                    if mutated is not None and mutated == read_by_yosys(work, "O.v"):
                        outcome = "the same for Yosys"
                if outcome is None:
                    at = next((i for i, (a, b) in enumerate(zip(original, mutant)) if a != b),
                              min(len(original), len(mutant)))
                    left.append(f"seed {seed}, {language}, {kind}: not found: "
                                f"{original[max(0, at - 40):at + 40]!r} became "
                                f"{mutant[max(0, at - 40):at + 40]!r}")
                counts[language, kind, outcome or "not found"] += 1
    return counts, left


def main() -> int:
    parser = argparse.ArgumentParser(description=__doc__.split("\n")[0])
    parser.add_argument("--tool", type=lambda text: Path(text).resolve(), required=True)
    parser.add_argument("--mutants", type=int, default=5000, help="in each language")
    parser.add_argument("--first", type=int, default=1, help="the first seed")
    parser.add_argument("--language", choices=list(LANGUAGES), action="append")
    parser.add_argument("--jobs", type=int, default=os.cpu_count())
    arguments = parser.parse_args()
    languages = arguments.language or list(LANGUAGES)
    counts: Counter = Counter()
    failed = 0
    seed = arguments.first
    with ProcessPoolExecutor(arguments.jobs) as pool:
        while min(sum(n for (l, *_), n in counts.items() if l == language)
                  for language in languages) < arguments.mutants:
            batch = [(arguments.tool, s, languages) for s in range(seed, seed + 4 * arguments.jobs)]
            seed += len(batch)
            for more, left in pool.map(try_seed, batch):
                counts += more
                failed += len(left)
                for line in left:
                    print(line, flush=True)
    for (language, kind, outcome), count in sorted(counts.items()):
        print(f"{language}, {kind}: {outcome}: {count}")
    print(f"{sum(counts.values())} mutants, {failed} failed")
    return 1 if failed else 0


if __name__ == "__main__":
    sys.exit(main())
