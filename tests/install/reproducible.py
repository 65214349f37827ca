#!/usr/bin/env python3
"""The same sources and commands give the same bytes.

The library's sources are copied to another folder and built anew, without a cache. The result must equal
the library of the build under test. The tool must write the same netlists, headers included, in
different folders, locales and time zones.
"""

from __future__ import annotations

import argparse
import os
import re
import shutil
import subprocess
import tempfile
from pathlib import Path

PROJECT = Path(__file__).resolve().parents[2]
SOURCES = ("CMakeLists.txt", "cmake", "include", "s")
EPOCH = "1700000000"


def run(*command: str | Path, **options) -> str:
    done = subprocess.run([str(word) for word in command], stdout=subprocess.PIPE,
                          stderr=subprocess.STDOUT, text=True, **options)
    if done.returncode != 0:
        raise SystemExit(f"reproducible: {command[0]} failed\n{done.stdout}")
    return done.stdout


def build_elsewhere(build: Path, folder: Path) -> Path:
    """Builds the library from a copy of its sources, with the settings that shape the code."""
    source = folder / "another place" / "sources"
    for name in SOURCES:
        copy = source / name
        copy.parent.mkdir(parents=True, exist_ok=True)
        original = PROJECT / name
        shutil.copytree(original, copy) if original.is_dir() else shutil.copy(original, copy)
    cache = (build / "CMakeCache.txt").read_text()
    settings = [f"-D{name}={value}" for name, value in re.findall(
        r"^(CMAKE_BUILD_TYPE|CMAKE_CXX_COMPILER|CMAKE_CXX_FLAGS|BUILD_SHARED_LIBS):\w+=(.*)$",
        cache, re.M)]
    other = folder / "build"
    run("cmake", "-S", source, "-B", other, "-G", "Ninja", *settings, "-DORN_HDL_BUILD_TESTS=OFF",
        "-DORN_HDL_BUILD_TOOL=OFF", "-DORN_HDL_INSTALL=OFF")
    run("cmake", "--build", other, env={**os.environ, "CCACHE_DISABLE": "1"})
    return other


def make_locale(folder: Path) -> dict[str, str]:
    """Makes a locale whose letter case and numbers differ, for programs started with the result."""
    locales = folder / "locales"
    locales.mkdir()
    run("localedef", "-i", "tr_TR", "-f", "UTF-8", locales / "tr_TR.UTF-8")
    return {"LOCPATH": str(locales), "LC_ALL": "tr_TR.UTF-8"}


def write_netlists(build: Path, folder: Path, place: dict[str, str]) -> dict[str, bytes]:
    """What the tool of a build makes of every example, by the name of the file."""
    folder.mkdir(parents=True)
    for example in sorted((PROJECT / "examples").rglob("*.cmd")):
        if example.parent.name != "embed":
            shutil.copy(example, folder)
            run(build / "tools" / "orn-hdl" / "orn-hdl", "run", "--verilog", f"{example.stem}.v",
                "--vhdl", f"{example.stem}.vhd", example.name, cwd=folder,
                env={**os.environ, **place, "SOURCE_DATE_EPOCH": EPOCH})
    return {file.name: file.read_bytes() for file in sorted(folder.iterdir())}


def main() -> int:
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("build", type=Path, help="the build under test")
    build = parser.parse_args().build.resolve()
    with tempfile.TemporaryDirectory() as name:
        folder = Path(name)
        other = build_elsewhere(build, folder)
        libraries = [next(path.glob("libOrn_Hdl.so.*.*")).read_bytes() for path in (build, other)]
        netlists = [
            write_netlists(build, folder / "here", {"LC_ALL": "C", "TZ": "UTC"}),
            write_netlists(build, folder / "some" / "where",
                           {**make_locale(folder), "TZ": "Asia/Kolkata"})]
    differing = [file for file in netlists[0] if netlists[0][file] != netlists[1].get(file)]
    if not netlists[0] or netlists[0].keys() != netlists[1].keys():
        differing.append("the list of files")
    if libraries[0] != libraries[1]:
        differing.append("the library")
    print(*(f"reproducible: {file} differs" for file in differing),
          f"reproducible: {len(netlists[0])} files and the library, {len(differing)} differ",
          sep="\n")
    return 1 if differing else 0


if __name__ == "__main__":
    raise SystemExit(main())
