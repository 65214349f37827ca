"""Every command does in Python what it does in the tool, byte for byte."""

from __future__ import annotations

import os
import subprocess
import sys
from pathlib import Path
from typing import List, Set

import orn_hdl
import pytest
from support import PROJECT, TOOL, files_in

sys.path.insert(0, str(PROJECT / "tests" / "reference"))
from generate import DEFAULT_LINES, KINDS, generate  # noqa: E402

SEEDS = range(int(os.environ.get("ORN_HDL_PYTHON_SEEDS", "40")))


def execute_lines(folder: Path, source: Path) -> List[int]:
    """Executes the lines one by one, and returns the numbers of those that fail."""
    failed = []
    previous = os.getcwd()
    os.chdir(folder)
    try:
        with orn_hdl.Design("top") as d:
            lines = source.read_bytes().decode(errors="surrogateescape").split("\n")
            for number, line in enumerate(lines, 1):
                try:
                    d.execute(line.partition("\0")[0].rstrip("\r"))
                except orn_hdl.Error:
                    failed.append(number)
    finally:
        os.chdir(previous)
    return failed


def run_tool(folder: Path, source: Path) -> List[int]:
    """Has the tool execute the file, and returns the numbers of the lines that fail."""
    done = subprocess.run([TOOL, "run", "--keep-going", "--quiet", "--no-warn", "all", "--model",
                           "top", source], cwd=folder, capture_output=True, check=False)
    heads = [line.removeprefix(os.fsencode(source) + b":") for line in done.stderr.split(b"\n")
             if line.startswith(os.fsencode(source) + b":") and b": error: " in line]
    return [int(head.split(b":")[0]) for head in heads]


def phrases_in(text: str) -> Set[str]:
    """The phrases of the commands in some lines."""
    known = [phrase for phrase, _, _ in orn_hdl.catalogue()]
    by_length = sorted(known, key=len, reverse=True)
    found = set()
    for line in text.upper().split("\n"):
        line = " ".join(line.split()) + " "
        found.update(next(([phrase] for phrase in by_length if line.startswith(phrase.upper() + " ")), []))
    return found


@pytest.mark.parametrize("seed", SEEDS)
def test_random_commands(seed: int, tmp_path: Path, monkeypatch: pytest.MonkeyPatch) -> None:
    monkeypatch.setenv("SOURCE_DATE_EPOCH", "0")
    source = tmp_path / "input.cmd"
    source.write_bytes(generate(seed, KINDS[seed % len(KINDS)], DEFAULT_LINES))
    by_python, by_tool = tmp_path / "python", tmp_path / "tool"
    by_python.mkdir()
    by_tool.mkdir()
    assert execute_lines(by_python, source) == run_tool(by_tool, source)
    assert files_in(by_python) == files_in(by_tool)


def test_the_whole_catalogue_is_among_them() -> None:
    seen: Set[str] = set()
    for seed in range(40):
        text = generate(seed, KINDS[seed % len(KINDS)], DEFAULT_LINES).decode(errors="surrogateescape")
        seen |= phrases_in(text)
    assert len(orn_hdl.catalogue()) == 61
    assert seen == {phrase for phrase, _, _ in orn_hdl.catalogue()}


def test_the_examples(tmp_path: Path) -> None:
    # Those in embed use commands that its programs add.
    files = [file for file in sorted((PROJECT / "examples").glob("*/*.cmd")) if file.parent.name != "embed"]
    assert len(files) >= 4
    for file in files:
        with orn_hdl.Design("top") as d:
            for line in file.read_text().splitlines():
                if not line.upper().startswith("WRITE"):
                    d.execute(line)
            d.write_verilog(tmp_path / "python.v", header=False)
            d.write_vhdl(tmp_path / "python.vhd", header=False)
        commands = "".join(line + "\n" for line in file.read_text().splitlines()
                           if not line.upper().startswith("WRITE"))
        (tmp_path / "example.cmd").write_text(commands)
        subprocess.run([TOOL, "run", "--quiet", "--no-warn", "all", "--no-header", "--model", "top",
                        "--verilog", "tool.v", "--vhdl", "tool.vhd", "example.cmd"], cwd=tmp_path, check=True)
        for suffix in ("v", "vhd"):
            by_python, by_tool = tmp_path / f"python.{suffix}", tmp_path / f"tool.{suffix}"
            assert by_python.read_bytes() == by_tool.read_bytes()
