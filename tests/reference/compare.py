#!/usr/bin/env python3
"""Runs random command files through the reference and the real tool and compares everything.

Compared are the errors on standard error, the exit status and every written file; of a banner the
emblem, the copyright wording and the version are left out.
"""

from __future__ import annotations

import argparse
import difflib
import os
import re
import shutil
import subprocess
import sys
import tempfile
from dataclasses import dataclass
from pathlib import Path

from generate import DEFAULT_LINES, KINDS, generate
from orn_reference.header import mask_free_lines
from orn_reference.replay import replay

MODEL_NAMES = (b"top", b"MHALVEX_T", b"HHALVEX_T", b"a-b", b"Counter8")
SHOWN_FAILURES = 5
SHOWN_DIFF_LINES = 24
TIME_LIMIT_SECONDS = 60


@dataclass
class Result:
    """What one run left behind, by name: the messages, the status, each file."""

    parts: dict[str, bytes]


def files_in(folder: Path) -> dict[str, bytes]:
    return {
        "file " + repr(entry.name): mask_free_lines(entry.read_bytes())
        for entry in sorted(folder.iterdir())
    }


def run_reference(folder: Path, model: bytes, source: Path) -> Result:
    previous = os.getcwd()
    os.chdir(folder)
    try:
        outcome = replay(os.fsencode(source), model_name=model, keep_going=True)
    finally:
        os.chdir(previous)
    messages = b"".join(message + b"\n" for message in outcome.messages)
    status = b"%d\n" % outcome.status
    return Result({"status": status, "standard error": messages, **files_in(folder)})


def errors_of(source: Path, printed: bytes) -> bytes:
    """The first line of each message, without source lines, notes and counts."""
    head = re.compile(re.escape(os.fsencode(source)) + rb":\d+: error: ")
    return b"".join(line + b"\n" for line in printed.split(b"\n") if head.match(line))


def run_tool(tool: str, folder: Path, model: bytes, source: Path) -> Result:
    command = [tool, "run", "--keep-going", "--quiet", "--model", model, source]
    try:
        done = subprocess.run(
            command,
            cwd=folder,
            stdin=subprocess.DEVNULL,
            stdout=subprocess.DEVNULL,
            stderr=subprocess.PIPE,
            timeout=TIME_LIMIT_SECONDS,
            check=False,
        )
        status, messages = b"%d\n" % done.returncode, errors_of(source, done.stderr)
    except subprocess.TimeoutExpired:
        status, messages = b"out of time\n", b""
    return Result({"status": status, "standard error": messages, **files_in(folder)})


def visible(text: bytes) -> list[str]:
    """Lines in which every byte that is not plain ASCII shows."""
    lines = text.decode("latin-1").split("\n")
    return [line.encode("unicode_escape").decode("ascii") for line in lines]


def differences(expected: Result, actual: Result) -> list[str]:
    shown: list[str] = []
    for name in sorted(expected.parts.keys() | actual.parts.keys()):
        left, right = expected.parts.get(name), actual.parts.get(name)
        if left == right:
            continue
        if left is None or right is None:
            shown.append(f"{name}: only from the {'tool' if left is None else 'reference'}")
            continue
        diff = list(
            difflib.unified_diff(
                visible(left), visible(right), f"reference: {name}", f"tool: {name}",
                n=2, lineterm="",
            )
        )
        shown += diff[:SHOWN_DIFF_LINES]
        if len(diff) > SHOWN_DIFF_LINES:
            shown.append(f"... and {len(diff) - SHOWN_DIFF_LINES} more lines")
    return shown


def compare_seed(tool: str, root: Path, seed: int, kind: str, lines: int) -> list[str]:
    """The differences of one seed; its folder stays only when there are some."""
    folder = root / f"{kind}-{seed}"
    reference_folder, tool_folder = folder / "reference", folder / "tool"
    reference_folder.mkdir(parents=True)
    tool_folder.mkdir()
    source = folder / "input.cmd"
    source.write_bytes(generate(seed, kind, lines))
    model = MODEL_NAMES[seed % len(MODEL_NAMES)]
    shown = differences(
        run_reference(reference_folder, model, source),
        run_tool(tool, tool_folder, model, source),
    )
    if shown:
        name = model.decode("ascii")
        shown.append(f"input: {source} (--seed {seed} --kind {kind} --lines {lines}, model {name})")
    else:
        shutil.rmtree(folder)
    return shown


def seed_range(text: str) -> range:
    first, _, last = text.partition("-")
    return range(int(first), int(last or first) + 1)


def main() -> int:
    parser = argparse.ArgumentParser(description=__doc__)
    parser.add_argument("--tool", required=True, type=os.path.abspath)
    parser.add_argument("--seeds", required=True, type=seed_range, metavar="A-B")
    parser.add_argument("--kind", choices=KINDS, help="default: each in turn")
    parser.add_argument("--lines", type=int, default=DEFAULT_LINES)
    parser.add_argument("--keep", type=Path, help="folder for failing inputs and their files")
    arguments = parser.parse_args()
    os.environ["SOURCE_DATE_EPOCH"] = "0"
    if arguments.keep is not None:
        arguments.keep.mkdir(parents=True, exist_ok=True)
    root = Path(tempfile.mkdtemp(prefix="compare-", dir=arguments.keep)).resolve()
    failed = 0
    for seed in arguments.seeds:
        kind = arguments.kind or KINDS[seed % len(KINDS)]
        shown = compare_seed(arguments.tool, root, seed, kind, arguments.lines)
        if shown:
            failed += 1
            print(f"FAILED seed {seed} ({kind})")
            if failed <= SHOWN_FAILURES:
                print("\n".join(shown))
    if failed == 0:
        root.rmdir()
    print(f"{len(arguments.seeds) - failed} passed, {failed} failed")
    return 1 if failed else 0


if __name__ == "__main__":
    sys.exit(main())
