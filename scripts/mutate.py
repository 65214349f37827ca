#!/usr/bin/env python3
"""Puts small mistakes into s/, one at a time, and sees whether the unit tests find them.

    scripts/mutate.py --count 12                  # the first dozen of seed 1
    scripts/mutate.py --seed 2 --count 300        # other ones; goes on where an earlier run stopped
    scripts/mutate.py --file s/Port/File.cpp --count 20
    scripts/mutate.py --sources --count 300       # none in headers, of which each rebuilds much
    scripts/mutate.py --settle                    # the other test programs, for what is still open
    scripts/mutate.py --settle --again            # what survived too, when tests have been added
    scripts/mutate.py --settle --sanitize         # all programs with sanitizers, for what is not found
    scripts/mutate.py --list --count 20           # only shows them
    scripts/mutate.py --report                    # what the results say, with every survivor

The mistakes go into a copy of the tree in build/mutation, which is built without optimisation and with
ccache. First each mistake meets the test program of its own folder, which finds most of them, with few random
cases a property. What is left is "open" until `--settle` runs all programs in full. Each result is a line of
JSON in build/mutation/results.jsonl: "killed" by a test program, "open", "survived" all of them, or "invalid"
when it does not compile. The same seed gives the same mistakes in the same order, taken from each file in
turn, and one that has a result is not tried again.

A mistake that changes nothing that anybody can see is no gap in the tests. scripts/mutants.txt lists those
that were looked at, each with the reason, and the report counts them apart. One whose line has changed since
it was tried is "gone", whatever became of it, and counts for nothing.
"""

from __future__ import annotations

import argparse
import dataclasses
import functools
import hashlib
import json
import math
import os
import random
import re
import resource
import shutil
import signal
import subprocess
import sys
import tempfile
import time
from collections import Counter
from collections.abc import Iterator
from pathlib import Path

PROJECT = Path(__file__).resolve().parents[1]
WORK = PROJECT / "build" / "mutation"
TREE = WORK / "tree"
REASONS = PROJECT / "scripts" / "mutants.txt"

# All programs, quick ones first; the folder of the changed file comes before them.
PROGRAMS = ["Writers", "Options", "Header", "Verilog", "Vhdl", "HdlCmd", "Port", "Streams", "HdlModel",
            "Containers", "HdlEngine", "C", "Check", "Legal", "Readers", "Proof", "Robustness", "Threads"]
# Where no folder below tests/ has the name of the one below s/.
TESTED_BY = {"Exception": "HdlEngine"}
# Large designs take minutes and find nothing that small ones do not.
FILTER = "-LargeInput.*"
SEED = "seed=20261120"
# For the first try: what some random cases find needs no more of them.
FEW_CASES = SEED + " max_success=25"
JOBS = 1
MOST_MEMORY = 8 << 30
MOST_WRITTEN = 4 << 30
# How much longer than its time on the processor a program may take in all.
WAITING = 6


@dataclasses.dataclass(frozen=True)
class Build:
    """How the copy is built."""

    folder: Path
    flags: str
    most_memory: int


PLAIN = Build(WORK / "build", "-O0", MOST_MEMORY)
# AddressSanitizer maps far more memory than there is.
SANITIZED = Build(WORK / "sanitized", "-O1 -fsanitize=address,undefined -fno-sanitize-recover=undefined",
                  resource.RLIM_INFINITY)
in_use = PLAIN


@dataclasses.dataclass(frozen=True)
class Mutant:
    """One change of one line."""

    file: str
    line: int
    operator: str
    before: str
    after: str
    # How many equal lines stand above this one.
    equals: int = 0

    @property
    def name(self) -> str:
        """Stays the same while lines are added above."""
        text = "\0".join([self.file, self.operator, self.before, self.after] +
                         ([str(self.equals)] if self.equals else []))
        return hashlib.sha256(text.encode()).hexdigest()[:12]


# The operators


def swaps(line: str, pairs: dict[str, str]) -> Iterator[str]:
    """The line with one operator between blanks exchanged for another."""
    pattern = "|".join(re.escape(word) for word in sorted(pairs, key=len, reverse=True))
    for found in re.finditer(rf"(?<= )(?:{pattern})(?= )", line):
        yield line[:found.start()] + pairs[found[0]] + line[found.end():]


def words(line: str, pairs: dict[str, str]) -> Iterator[str]:
    """The line with one word exchanged for another."""
    for found in re.finditer(rf"\b(?:{'|'.join(pairs)})\b", line):
        yield line[:found.start()] + pairs[found[0]] + line[found.end():]


def boundaries(line: str) -> Iterator[str]:
    yield from swaps(line, {"<": "<=", "<=": "<", ">": ">=", ">=": ">"})


def comparisons(line: str) -> Iterator[str]:
    yield from swaps(line, {"==": "!=", "!=": "=="})


def connectives(line: str) -> Iterator[str]:
    yield from swaps(line, {"&&": "||", "||": "&&"})


def sums(line: str) -> Iterator[str]:
    yield from swaps(line, {"+": "-", "-": "+", "+=": "-=", "-=": "+="})


def steps(line: str) -> Iterator[str]:
    for found in re.finditer(r"\+\+|--", line):
        other = "--" if found[0] == "++" else "++"
        yield line[:found.start()] + other + line[found.end():]


def constants(line: str) -> Iterator[str]:
    yield from words(line, {"true": "false", "false": "true"})
    for found in re.finditer(r"(?<![\w.'\"])\d+(?![\w.'\"])", line):
        yield line[:found.start()] + str(int(found[0]) + 1) + line[found.end():]


def negations(line: str) -> Iterator[str]:
    """A condition that stands on one line, negated."""
    if found := re.fullmatch(r"(\s*(?:\} else )?(?:if|while) \()(.*)(\) \{)", line):
        if found[2].count("(") == found[2].count(")") and " = " not in found[2]:
            yield f"{found[1]}!({found[2]}){found[3]}"


DECLARATION = re.compile(r"\s*(?:const|auto|static|constexpr|using|return|throw|delete|break|continue|"
                         r"case|default|namespace|friend|template|typedef|struct|class|enum|extern|"
                         r"public|private|protected|virtual|explicit)\b|.*= (?:default|delete);|"
                         r"\s*[\w:]+(?:<.*>)?[*&]* (?:const )?[*&]?\w+(?: =|\(|;|\{)|"
                         r"\s*[A-Z]\w+\(.*\w& \w+")
STATEMENT = re.compile(r"\s+[*(\w][^{}]*(?:\)| = .*|\+\+|--|\+= .*);")


def removals(line: str, former: str) -> Iterator[str]:
    """A call or assignment that stands on one line, left out."""
    begins = not former.strip() or former.rstrip().endswith((";", "{", "}", ":")) or \
        former.lstrip().startswith("//")
    if begins and STATEMENT.fullmatch(line) and not DECLARATION.match(line):
        yield re.sub(r"\S.*", ";", line)


OPERATORS = [boundaries, comparisons, connectives, sums, steps, constants, negations]


def hidden(line: str) -> bool:
    """Whether a line is of no interest: preprocessor, comments, tables of texts, declarations of names."""
    start = line.lstrip()
    return not start or start.startswith(("#", "//", "static_assert", "using ", "namespace ", "template",
                                          "friend ")) or '"' in line or "R(" in line


def mutants_of(file: str) -> list[Mutant]:
    """Every mistake that can be put into a file."""
    found = []
    former = ""
    met = Counter()
    for number, line in enumerate((PROJECT / file).read_text().splitlines(), 1):
        code, comment = re.fullmatch(r"(.*?)(\s*//.*)?", line).groups()
        if not hidden(code):
            for operator in OPERATORS:
                found += [Mutant(file, number, operator.__name__, line, after + (comment or ""), met[line])
                          for after in operator(code)]
            found += [Mutant(file, number, "removals", line, after, met[line])
                      for after in removals(code, former)]
        met[line] += 1
        former = line
    return found


def chosen(files: list[str], seed: int) -> list[Mutant]:
    """All mistakes, shuffled, from each file in turn."""
    dice = random.Random(seed)
    ranked = []
    for file in sorted(files):
        mutants = sorted(mutants_of(file), key=lambda mutant: (mutant.line, mutant.name))
        dice.shuffle(mutants)
        ranked += [(rank, dice.random(), mutant) for rank, mutant in enumerate(mutants)]
    return [mutant for _, _, mutant in sorted(ranked, key=lambda entry: entry[:2])]


# The copy


def environment() -> dict[str, str]:
    return dict(os.environ, CMAKE_CXX_COMPILER_LAUNCHER="ccache", CCACHE_BASEDIR=str(TREE),
                CCACHE_NOHASHDIR="1", TMPDIR=str(WORK / "tmp"))


def build(*targets: str) -> bool:
    return subprocess.run(["nice", "ninja", "-C", in_use.folder, f"-j{JOBS}", *targets], env=environment(), check=False,
                          stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL).returncode == 0


def target(program: str) -> str:
    return f"orn_hdl_{program}_tests"


def prepare() -> None:
    """Brings the copy up to date."""
    tracked = subprocess.run(["git", "ls-files", "-z"], cwd=PROJECT, check=True, capture_output=True,
                             text=True).stdout.split("\0")
    kept = {name for name in tracked if name and (PROJECT / name).is_file()}
    for name in kept:
        source, copy = PROJECT / name, TREE / name
        if not copy.exists() or copy.read_bytes() != source.read_bytes():
            copy.parent.mkdir(parents=True, exist_ok=True)
            shutil.copyfile(source, copy)
    for copy in list(TREE.rglob("*")):
        if copy.is_file() and copy.relative_to(TREE).as_posix() not in kept:
            copy.unlink()
    subprocess.run(["cmake", "-S", TREE, "-B", in_use.folder, "-G", "Ninja", "-DCMAKE_BUILD_TYPE=Debug",
                    f"-DCMAKE_CXX_FLAGS_DEBUG={in_use.flags}", "-DCMAKE_LINK_DEPENDS_NO_SHARED=ON",
                    "-DORN_HDL_BUILD_TOOL=OFF"],
                   env=environment(), check=True, stdout=subprocess.DEVNULL)


@functools.cache
def usual_time(program: str) -> float:
    """Builds a test program and returns how long it takes when all is well."""
    print(f"building and running {program}", file=sys.stderr)
    # Some programs hold the library's objects, others load the library.
    if not build("Orn_Hdl", target(program)):
        sys.exit("the tree does not build")
    start = time.monotonic()
    if failure := run(program, 1800):
        sys.exit(f"{program} fails without any mistake: {failure}")
    return time.monotonic() - start


def limit(seconds: int) -> None:
    """What a program gone wild may take."""
    resource.setrlimit(resource.RLIMIT_AS, (in_use.most_memory, in_use.most_memory))
    resource.setrlimit(resource.RLIMIT_FSIZE, (MOST_WRITTEN, MOST_WRITTEN))
    resource.setrlimit(resource.RLIMIT_CPU, (seconds, seconds + 5))


def run(program: str, seconds: float, cases: str = SEED) -> str:
    """Why a test program fails; empty when it passes.

    The seconds are time on the processor, as the machine may have other work to do. A program that
    only waits is ended after WAITING times as long.
    """
    with tempfile.TemporaryDirectory(dir=WORK / "tmp") as folder:
        # Some tests become a user who is not root, and make folders of their own.
        os.chmod(folder, 0o777)
        command = [in_use.folder / "tests" / target(program), "--gtest_brief=1", "--gtest_fail_fast",
                   f"--gtest_filter={FILTER}"]
        try:
            ended = subprocess.run(command, env=environment() | {"TMPDIR": folder, "RC_PARAMS": cases}, cwd=folder,
                                   preexec_fn=lambda: limit(math.ceil(seconds)), timeout=WAITING * seconds,
                                   check=False, text=True, errors="replace", stdin=subprocess.DEVNULL,
                                   stdout=subprocess.PIPE, stderr=subprocess.DEVNULL)
        except subprocess.TimeoutExpired:
            return "time"
    if ended.returncode == 0:
        return ""
    if ended.returncode == -signal.SIGXCPU:
        return "time"
    failed = re.search(r"^\[  FAILED  \] ([\w./]+)", ended.stdout, re.M)
    return failed[1] if failed else f"status {ended.returncode}"


def own_program(file: str) -> str:
    """The program that knows a file best."""
    folder = Path(file).parts[1]
    return TESTED_BY.get(folder, folder)


def attempt(mutant: Mutant, programs: list[str], cases: str, otherwise: str) -> dict[str, str]:
    """Builds the copy with the mistake and runs the programs until one of them fails."""
    times = {program: usual_time(program) for program in programs}
    copy = TREE / mutant.file
    original = copy.read_text()
    lines = original.split("\n")
    lines[mutant.line - 1] = mutant.after
    copy.write_text("\n".join(lines))
    try:
        for program, seconds in times.items():
            if not build("Orn_Hdl", target(program)):
                return {"status": "invalid"}
            if failure := run(program, 20 + 10 * seconds, cases):
                return {"status": "killed", "by": program, "test": failure}
        return {"status": otherwise}
    finally:
        copy.write_text(original)


def try_first(mutant: Mutant) -> dict[str, str]:
    return attempt(mutant, [own_program(mutant.file)], FEW_CASES, "open")


def settle(mutant: Mutant) -> dict[str, str]:
    own = own_program(mutant.file)
    return attempt(mutant, sorted(PROGRAMS, key=lambda program: program != own), SEED, "survived")


# The results


def results(path: Path) -> list[dict]:
    return [json.loads(line) for line in path.read_text().splitlines()] if path.exists() else []


def latest(path: Path) -> dict[str, dict]:
    """The latest word on each mistake."""
    return {result["name"]: result for result in results(path)}


def reasons() -> dict[str, str]:
    """Why mistakes that were looked at change nothing that a test could see, by name."""
    lines = REASONS.read_text().splitlines() if REASONS.exists() else []
    return dict(line.split(maxsplit=1) for line in lines if line and not line.startswith("#"))


def is_unsettled(result: dict, sanitized: bool, again: bool) -> bool:
    """Whether all programs are to run on a mistake that has that result."""
    unsettled = ["open", "survived"] if sanitized or again else ["open"]
    return result.get("status") in unsettled or (again and result.get("test") == "time")


def show(result: dict) -> None:
    print(f"\n{result['name']} {result['file']}:{result['line']} ({result['operator']})\n"
          f"- {result['before'].strip()}\n+ {result['after'].strip()}")


def is_there(result: dict) -> bool:
    """Whether the file still has the line that was changed."""
    path = PROJECT / result["file"]
    return path.exists() and result["before"] in path.read_text().split("\n")


def report(path: Path) -> None:
    """How many were found, and every one that was not."""
    known = reasons()
    found = latest(path)
    for name, result in found.items():
        if not is_there(result):
            result["status"] = "gone"
        elif result["status"] in ("open", "survived") and name in known:
            result["status"] = "equivalent"
    counts = Counter(result["status"] for result in found.values())
    print(f"{len(found)} mistakes: " + ", ".join(
        f"{counts[status]} {status}"
        for status in ("killed", "survived", "open", "equivalent", "invalid", "gone")))
    if tried := counts["killed"] + counts["survived"] + counts["open"]:
        print(f"{100 * counts['killed'] / tried:.1f} % of those that change something are found")
    for status in ("survived", "open", "equivalent"):
        if counts[status]:
            print(f"\n# {status}")
        for name, result in found.items():
            if result["status"] == status:
                show(result)
                if status == "equivalent":
                    print(f"  {known[name]}")


def main() -> None:
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("--seed", type=int, default=1, help="chooses the mistakes")
    parser.add_argument("--count", type=int, default=12, help="how many, those with a result included")
    parser.add_argument("--file", action="append", help="only in this file; may be repeated")
    parser.add_argument("--sources", action="store_true", help="none in headers")
    parser.add_argument("--settle", action="store_true",
                        help="run all programs on those that are still open")
    parser.add_argument("--again", action="store_true",
                        help="with --settle: try what survived, and what only took too long, once more")
    parser.add_argument("--sanitize", action="store_true",
                        help="with --settle: use AddressSanitizer and UndefinedBehaviorSanitizer, on "
                             "what survived, too")
    parser.add_argument("--results", type=Path, default=WORK / "results.jsonl", help="one JSON a line")
    parser.add_argument("--list", action="store_true", help="show the mistakes and stop")
    parser.add_argument("--report", action="store_true", help="show what is known and stop")
    options = parser.parse_args()
    if (options.sanitize or options.again) and not options.settle:
        parser.error("--sanitize and --again go with --settle")
    if options.report:
        report(options.results)
        return
    if options.sanitize:
        global in_use  # pylint: disable=global-statement
        in_use = SANITIZED
    pattern = "*.cpp" if options.sources else "*.[ch]*"
    files = options.file or [path.relative_to(PROJECT).as_posix()
                             for path in (PROJECT / "s").rglob(pattern)]
    mutants = chosen(files, options.seed)
    print(f"{len(mutants)} mistakes in {len(files)} files", file=sys.stderr)
    known = latest(options.results)
    if options.settle:
        excused = reasons()
        mutants = [mutant for mutant in mutants if mutant.name not in excused and
                   is_unsettled(known.get(mutant.name, {}), options.sanitize, options.again)]
    else:
        mutants = mutants[:options.count]
    if options.list:
        for mutant in mutants:
            show(dataclasses.asdict(mutant) | {"name": mutant.name})
        return
    if not options.settle:
        mutants = [mutant for mutant in mutants if mutant.name not in known]
    (WORK / "tmp").mkdir(parents=True, exist_ok=True)
    options.results.parent.mkdir(parents=True, exist_ok=True)
    prepare()
    with options.results.open("a") as out:
        for mutant in mutants:
            start = time.monotonic()
            result = settle(mutant) if options.settle else try_first(mutant)
            entry = {"name": mutant.name, **dataclasses.asdict(mutant), **result,
                     "seconds": round(time.monotonic() - start, 1)}
            print(json.dumps(entry), file=out, flush=True)
            print(f"{result['status']} {mutant.file}:{mutant.line} {result.get('test', '')}",
                  file=sys.stderr)
    report(options.results)


if __name__ == "__main__":
    main()
