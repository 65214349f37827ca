#!/usr/bin/env python3
"""Compiles or runs every code block of documentation pages, in order, in a folder a page.

What follows the three back-quotes decides:

    cpp               a program: compiled and run, and a text block behind it is what it prints;
                      without main, statements that see `engine` and `model`: compiled
    c                 a program in C99, or statements in C, in the same way
    cpp sources       a piece of the library's own sources: compiled
    orn               commands: replayed
    orn more          commands: replayed behind those of the blocks before
    verilog, vhdl     a passage of the netlist that the last commands give
    python            run by Python behind the blocks before; a text block behind it is what it prints
    tcl               run by tclsh with the installed package; a text block behind it is what it prints
    sh                run by bash; a text block behind it is what it prints
    LANGUAGE FILE     written to that file, for the blocks behind it

Links between pages must lead to a file.
"""

from __future__ import annotations

import argparse
import os
import re
import subprocess
import sys
import tempfile
import textwrap
from dataclasses import dataclass
from pathlib import Path

PROJECT = Path(__file__).resolve().parents[2]
BLOCK = re.compile(r"^```(\w+)(?: (\S+))?\n(.*?)^```$", re.M | re.S)
FENCE = re.compile(r"^```", re.M)
LINK = re.compile(r"\]\(([^)#:]+)(?:#[^)]*)?\)")
COMPILE = ["g++", "-std=c++17", "-O0", "-Wall", "-Wextra", "-Wpedantic", "-Wconversion", "-Wshadow",
           "-Werror"]
C_COMPILE = ["gcc", "-std=c99", "-O0", "-Wall", "-Wextra", "-pedantic", "-Wstrict-prototypes",
             "-Werror"]
C_STATEMENTS = """\
#include <Orn_Hdl/orn_hdl.h>
#include <stdio.h>
void Statements(orn_hdl_engine_t engine, orn_hdl_model_t model);
void Statements(orn_hdl_engine_t engine, orn_hdl_model_t model) {{
    (void)engine, (void)model;
    {{
{code}
    }}
}}
"""
STATEMENTS = """\
#include <Orn_Hdl/Orn_Hdl.h>
#include <iostream>
#include <string>
void Statements([[maybe_unused]] Orn_Hdl::Engine& engine, [[maybe_unused]] Orn_Hdl::Model& model) {{
{code}
}}
"""
SOURCES = """\
#include "HdlCmd/Executing.h"
#include "HdlCmd/Catalogue.h"
#include "HdlCmd/Parsing.h"
#include "Exception/Failure.h"
#include "Orn_Hdl/Orn_Hdl.h"
namespace Orn_Hdl {{
{code}
}}
"""


class Failed(Exception):
    """A block does not do what the page says."""


@dataclass(frozen=True)
class Block:
    language: str
    word: str
    code: str
    line: int


@dataclass(frozen=True)
class Installed:
    """Where the library and the tool are installed."""

    prefix: Path

    @property
    def libraries(self) -> Path:
        return next(self.prefix.glob("**/pkgconfig")).parent

    @property
    def environment(self) -> dict[str, str]:
        return {**os.environ, "LC_ALL": "C.UTF-8",
                "PATH": f"{self.prefix / 'bin'}:{os.environ['PATH']}",
                "CMAKE_PREFIX_PATH": str(self.prefix),
                "PKG_CONFIG_PATH": str(self.libraries / "pkgconfig"),
                "PYTHONPATH": str(self.prefix / "lib" / "python3" / "dist-packages"),
                "TCLLIBPATH": str(self.libraries / "tcltk"),
                "LD_LIBRARY_PATH": str(self.libraries)}


class Page:
    """The blocks of one page, and the folder in which they run."""

    def __init__(self, page: Path, folder: Path, installed: Installed) -> None:
        self.page = page
        self.folder = folder
        self.installed = installed
        self.printed: str | None = None
        self.commands = ""
        self.program = ""

    def run(self, *command: str | Path) -> str:
        done = subprocess.run([str(word) for word in command], cwd=self.folder,
                              env=self.installed.environment, stdout=subprocess.PIPE,
                              stderr=subprocess.STDOUT, text=True)
        if done.returncode != 0:
            raise Failed(f"ends with status {done.returncode}:\n{done.stdout}")
        return done.stdout

    def compile(self, code: str, *options: str | Path) -> None:
        source = self.folder / "block.cpp"
        source.write_text(code)
        self.run(*COMPILE, source, *options)

    def check(self, block: Block) -> None:
        printed, self.printed = self.printed, None
        if block.language == "text":
            self.check_printed(block, printed)
        elif block.language == "cpp" and block.word == "sources":
            self.compile(SOURCES.format(code=block.code), "-std=c++20", "-fsyntax-only",
                         "-Wno-unused-const-variable", f"-I{PROJECT / 'include'}",
                         f"-I{PROJECT / 's'}")
        elif block.language == "orn" and block.word == "more":
            self.replay(self.commands + block.code)
        elif block.word:
            (self.folder / block.word).write_text(block.code)
        elif block.language == "cpp":
            self.check_cpp(block.code)
        elif block.language == "c":
            self.check_c(block.code)
        elif block.language == "orn":
            self.replay(block.code)
        elif block.language in ("verilog", "vhdl"):
            netlist = (self.folder / f"block.{block.language}").read_text()
            if _without_ends(block.code) not in _without_ends(netlist):
                raise Failed(f"is no passage of\n{netlist}")
        elif block.language == "python":
            self.check_python(block.code)
        elif block.language == "tcl":
            (self.folder / "block.tcl").write_text(block.code)
            self.printed = self.run("tclsh", "block.tcl")
        elif block.language == "sh":
            self.printed = self.run("bash", "-euo", "pipefail", "-c", block.code)
        else:
            raise Failed("is of a language that no test knows")

    def replay(self, commands: str) -> None:
        self.commands = commands
        (self.folder / "block.cmd").write_text(commands)
        self.run("orn-hdl", "run", "--no-header", "--verilog", "block.verilog", "--vhdl",
                 "block.vhdl", "block.cmd")

    def check_cpp(self, code: str) -> None:
        include = f"-I{self.installed.prefix / 'include'}"
        if "int main(" in code:
            program = self.folder / "block"
            self.compile(code, include, f"-L{self.installed.libraries}", "-lOrn_Hdl", "-o", program)
            self.printed = self.run(program)
        else:
            self.compile(STATEMENTS.format(code=textwrap.indent(code, "    ")), include,
                         "-fsyntax-only")

    def check_c(self, code: str) -> None:
        is_program = "int main(" in code
        source = self.folder / "block.c"
        source.write_text(code if is_program else C_STATEMENTS.format(code=code))
        include = f"-I{self.installed.prefix / 'include'}"
        if is_program:
            program = self.folder / "block"
            self.run(*C_COMPILE, source, include, f"-L{self.installed.libraries}", "-lOrn_Hdl", "-o",
                     program)
            self.printed = self.run(program)
        else:
            self.run(*C_COMPILE, source, include, "-fsyntax-only")

    def check_python(self, code: str) -> None:
        """Runs a block with what those before have defined, and without what they print."""
        (self.folder / "before.py").write_text(self.program)
        program = ("import contextlib, io\n"
                   "with contextlib.redirect_stdout(io.StringIO()):\n"
                   "    exec(open('before.py').read())\n" + code)
        self.printed = self.run(sys.executable, "-c", program)
        self.program += code

    @staticmethod
    def check_printed(block: Block, printed: str | None) -> None:
        if printed is None:
            raise Failed("follows no block that prints")
        if _without_ends(block.code) != _without_ends(printed):
            raise Failed(f"differs from what is printed:\n{printed}")


def _without_ends(text: str) -> str:
    """Pages hold no blanks at the ends of lines."""
    return "\n".join(line.rstrip() for line in text.splitlines())


def blocks_of(text: str) -> list[Block]:
    blocks = [Block(match[1], match[2] or "", match[3], text.count("\n", 0, match.start()) + 1)
              for match in BLOCK.finditer(text)]
    if 2 * len(blocks) != len(FENCE.findall(text)):
        raise Failed("a block without a language, or without its end")
    return blocks


def check_page(file: Path, installed: Installed) -> tuple[int, list[str]]:
    """The number of blocks, and what is wrong with the page."""
    text = file.read_text(encoding="utf-8")
    wrong = [f"{file.name}: the link {link} leads nowhere" for link in LINK.findall(text)
             if not (file.parent / link).exists()]
    with tempfile.TemporaryDirectory() as folder:
        page = Page(file, Path(folder), installed)
        blocks = blocks_of(text)
        for block in blocks:
            try:
                page.check(block)
            except Failed as failure:
                wrong.append(f"{file.name}:{block.line}: the {block.language} block {failure}")
    return len(blocks), wrong


def main() -> int:
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("build", type=Path, help="the build to install and use")
    parser.add_argument("pages", type=Path, nargs="*", help="by default all that users read")
    arguments = parser.parse_args()
    pages = arguments.pages or [
        PROJECT / "README.md", PROJECT / "CONTRIBUTING.md",
        *sorted((PROJECT / "docs").glob("*.md")), *sorted((PROJECT / "examples").rglob("*.md"))]
    with tempfile.TemporaryDirectory() as folder:
        prefix = Path(folder)
        subprocess.run(["cmake", "--install", arguments.build, "--prefix", prefix], check=True,
                       stdout=subprocess.DEVNULL)
        results = [check_page(page.resolve(), Installed(prefix)) for page in pages]
    wrong = [line for _, lines in results for line in lines]
    print(*wrong, f"blocks: {sum(count for count, _ in results)} in {len(pages)} pages, "
                  f"{len(wrong)} failed", sep="\n")
    return 1 if wrong else 0


if __name__ == "__main__":
    sys.exit(main())
