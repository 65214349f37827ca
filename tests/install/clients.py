#!/usr/bin/env python3
"""Builds and runs a client of the library through every way in.

The build under test is installed (shared), the library is built anew as a part of a client (static)
and installed from there; both prefixes are then moved, and found with CMake and with pkg-config, by
g++ and clang++, as C++17 and C++20. A program in C finds both prefixes with pkg-config.
"""

from __future__ import annotations

import argparse
import os
import shlex
import shutil
import subprocess
import tempfile
from dataclasses import dataclass
from pathlib import Path

FOLDER = Path(__file__).resolve().parent
SOURCE = FOLDER.parents[1]
WARNINGS = ["-Wall", "-Wextra", "-Wpedantic", "-Wconversion", "-Wshadow", "-Werror"]
COMPILERS = ("g++", "clang++")
EDITIONS = ("17", "20")
EXAMPLE = SOURCE / "examples" / "embed"
C_FLAGS = ["-std=c99", "-Wall", "-Wextra", "-pedantic", "-Wstrict-prototypes", "-Werror"]
C_COMPILERS = ("gcc", "clang")


def run(*command: str | Path, **environment: str) -> str:
    """Runs a program that has to succeed. What it prints is shown when it does not."""
    done = subprocess.run([str(word) for word in command], env={**os.environ, **environment},
                          stdout=subprocess.PIPE, stderr=subprocess.STDOUT, text=True)
    if done.returncode != 0:
        raise SystemExit(f"{shlex.join(map(str, command))}\n{done.stdout}"
                         f"clients: failed with status {done.returncode}")
    return done.stdout


def configure(source: Path, build: Path, *settings: str) -> None:
    launcher = ["-DCMAKE_CXX_COMPILER_LAUNCHER=ccache"] if shutil.which("ccache") else []
    run("cmake", "-S", source, "-B", build, "-G", "Ninja", *launcher, *settings)


@dataclass(frozen=True)
class Prefix:
    """A place where the library is installed, and how it is linked there."""

    linkage: str
    path: Path

    @property
    def libraries(self) -> Path:
        return next(self.path.glob("**/pkgconfig")).parent


def expect_client(program: Path, linkage: str, edition: str, libraries: Path) -> None:
    printed = run(program, LD_LIBRARY_PATH=str(libraries))
    if printed != f"{linkage} C++{edition}\n":
        raise SystemExit(f"clients: {program.name} printed {printed!r}")


def install_moved(build: Path, linkage: str, work: Path) -> Prefix:
    """Installs a build and moves it: nothing in it may know where it was put."""
    first = work / f"{linkage}-first"
    moved = work / f"{linkage} moved"
    run("cmake", "--install", build, "--prefix", first)
    first.rename(moved)
    for file in (*moved.rglob("*.cmake"), *moved.rglob("*.pc")):
        check_installed_text(file.read_text(), work)
    return Prefix(linkage, moved)


def check_installed_text(text: str, work: Path) -> None:
    for stray in (str(work), str(SOURCE), "orn_hdl_warnings", "-Wall"):
        if stray in text:
            raise SystemExit(f"clients: an installed file speaks of {stray}")


def build_embedded(work: Path) -> Path:
    """A client that takes the library in as a folder, and lets it be installed."""
    build = work / "embedded"
    configure(FOLDER / "embedded", build, f"-DORN_HDL_SOURCE={SOURCE}", "-DBUILD_SHARED_LIBS=OFF",
              "-DORN_HDL_INSTALL=ON", "-DCMAKE_BUILD_TYPE=Debug", "-DCMAKE_UNITY_BUILD=ON")
    run("cmake", "--build", build)
    expect_client(build / "client17", "static", "17", build)
    return build


def find_with_cmake(prefix: Prefix, compiler: str, work: Path) -> int:
    build = work / f"found-{prefix.linkage}-{compiler}"
    configure(FOLDER / "found", build, f"-DCMAKE_PREFIX_PATH={prefix.path}",
              f"-DCMAKE_CXX_COMPILER={compiler}")
    run("cmake", "--build", build)
    for edition in EDITIONS:
        expect_client(build / f"client{edition}", prefix.linkage, edition, prefix.libraries)
    return len(EDITIONS)


def find_with_pkg_config(prefix: Prefix, compiler: str, work: Path) -> int:
    flags = shlex.split(run("pkg-config", "--cflags", "--libs", "orn_hdl",
                            PKG_CONFIG_PATH=str(prefix.libraries / "pkgconfig")))
    for edition in EDITIONS:
        program = work / f"pkg-{prefix.linkage}-{compiler}-{edition}"
        run(compiler, f"-std=c++{edition}", *WARNINGS, FOLDER / "client.cpp", "-o", program, *flags)
        expect_client(program, prefix.linkage, edition, prefix.libraries)
    return len(EDITIONS)


def build_c_program(prefix: Prefix, compiler: str, work: Path) -> int:
    """A program in C that finds the library with pkg-config."""
    kind = ["--static"] if prefix.linkage == "static" else []
    flags = shlex.split(run("pkg-config", *kind, "--cflags", "--libs", "orn_hdl",
                            PKG_CONFIG_PATH=str(prefix.libraries / "pkgconfig")))
    program = work / f"c-{prefix.linkage}-{compiler}"
    run(compiler, *C_FLAGS, EXAMPLE / "netlist.c", "-o", program, *flags)
    printed = run(program, EXAMPLE / "report.cmd", LD_LIBRARY_PATH=str(prefix.libraries))
    if printed != (EXAMPLE / "netlist.expected").read_text():
        raise SystemExit(f"clients: {program.name} printed {printed!r}")
    return 1


def main() -> int:
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("build", type=Path, help="the shared build to install")
    build = parser.parse_args().build
    with tempfile.TemporaryDirectory() as folder:
        work = Path(folder).resolve()
        embedded = build_embedded(work)
        prefixes = [install_moved(build, "shared", work), install_moved(embedded, "static", work)]
        clients = 1
        for prefix in prefixes:
            for compiler in COMPILERS:
                clients += find_with_cmake(prefix, compiler, work)
                clients += find_with_pkg_config(prefix, compiler, work)
            for compiler in C_COMPILERS:
                clients += build_c_program(prefix, compiler, work)
    print(f"clients: {clients} built and run, {len(COMPILERS)} compilers, shared and static")
    return 0


if __name__ == "__main__":
    raise SystemExit(main())
