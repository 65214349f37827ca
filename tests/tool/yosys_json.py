"""Small designs as Yosys writes them in JSON, whose imports are checked by real tools."""

from __future__ import annotations

import json
import re
import shlex
import shutil
import subprocess
from dataclasses import dataclass
from pathlib import Path
from typing import Any

from support import EXAMPLES, SUCCESS, ToolTest

Json = dict[str, Any]
MARK = "00000000000000000000000000000001"


def port(direction: str, *bits: int | str, **more: int) -> Json:
    return {"direction": direction, "bits": list(bits), **more}


def net(*bits: int | str, hidden: int = 0, **more: Any) -> Json:
    return {"hide_name": hidden, "bits": list(bits), "attributes": {}, **more}


def cell(kind: str, directions: str, hidden: int = 0, parameters: Json | None = None,
         attributes: Json | None = None, **pins: list[int | str]) -> Json:
    """A cell; `directions` holds a letter, i, o or b, for each pin."""
    names = {"i": "input", "o": "output", "b": "inout"}
    return {"hide_name": hidden, "type": kind, "parameters": parameters or {},
            "attributes": attributes or {},
            "port_directions": {pin: names[d] for pin, d in zip(pins, directions, strict=True)},
            "connections": pins}


def black_box(ports: Json, **defaults: str) -> Json:
    return {"attributes": {"blackbox": MARK}, "parameter_default_values": defaults,
            "ports": ports, "cells": {}, "netnames": {}}


def design(ports: Json, cells: Json | None = None, nets: Json | None = None, name: str = "top",
           **modules: Json) -> Json:
    """A file with one module of contents, and black boxes.

    A design without ports gets one: VHDL has no empty port list.
    """
    top = {"attributes": {"top": MARK}, "ports": ports or {"idle": port("input", 1)},
           "cells": cells or {},
           "netnames": nets or {}}
    return {"creator": "Yosys 0.23", "modules": {name: top, **modules}}


@dataclass
class Imported:
    """The results of an import."""

    commands: list[str]
    verilog: str
    vhdl: str
    warnings: list[str]
    names: dict[tuple[str, str], str]

    def lines(self, start: str) -> list[str]:
        """The commands that begin with `start`, without it."""
        return [line[len(start) + 1:] for line in self.commands if line.startswith(start + " ")]


class ImportTest(ToolTest):
    """A test that imports designs and has every result judged."""

    def import_file(self, name: str, *options: str, allowed: str = "") -> Imported:
        """Imports a file in every form, and checks that the forms agree and are accepted.

        A tool may say what matches `allowed`.
        """
        outcome = self.run_tool("import", name, "-o", "x.cmd", "--name-map", "x.map", *options)
        self.assertEqual((outcome.status, outcome.out), (SUCCESS, ""), outcome.err)
        for language in ("verilog", "vhdl"):
            self.expect(self.run_tool("import", name, f"--{language}", f"x.{language}",
                                      "--names", "both", "--no-header", *options),
                        SUCCESS, outcome.err)
            self.expect(self.run_tool("run", "x.cmd", f"--{language}", f"r.{language}",
                                      "--no-header", *(["--dont-cares"] if "-" in options else [])),
                        SUCCESS)
            self.assertEqual(self.read(f"x.{language}"), self.read(f"r.{language}"))
        commands = self.read("x.cmd").splitlines()
        self.judge_verilog(commands, allowed)
        self.judge_vhdl(allowed)
        return Imported(commands, self.read("x.verilog"), self.read("x.vhdl"),
                        self.read_warnings(outcome.err), self.read_names())

    def read_warnings(self, printed: str) -> list[str]:
        """The warnings; behind several of them stands their number."""
        warnings = printed.splitlines()
        if len(warnings) > 1:
            self.assertEqual(warnings.pop(), f"{len(warnings)} warnings")
        return warnings

    def import_design(self, contents: Json, *options: str, allowed: str = "") -> Imported:
        (self.folder / "d.json").write_text(json.dumps(contents), encoding="utf-8")
        return self.import_file("d.json", *options, allowed=allowed)

    def judge_verilog(self, commands: list[str], allowed: str) -> None:
        """Icarus elaborates the netlist over empty modules for its leaf cells."""
        if shutil.which("iverilog") is None:
            self.skipTest("iverilog is not installed")
        self.write("cells.v", "\n".join(make_stubs(commands)))
        netlist = self.folder / "x.verilog"
        self.judge(["iverilog", "-g2005", "-Wall", "-Wno-timescale", "-tnull", "-s",
                    re.search(r"^module (\w+)", netlist.read_text(), re.M)[1],
                    "x.verilog", "cells.v"], allowed)

    def judge_vhdl(self, allowed: str) -> None:
        """GHDL analyses the netlist in both editions of the language."""
        if shutil.which("ghdl") is None:
            self.skipTest("ghdl is not installed")
        package = EXAMPLES / "cells" / "kestra_vcomponents.vhd"
        for edition in ("93", "08"):
            folder = self.folder / f"ghdl{edition}"
            folder.mkdir(exist_ok=True)
            flags = [f"--std={edition}", f"--workdir={folder}", f"-P{folder}"]
            self.judge(["ghdl", "-a", *flags, "--work=KESTRA", str(package)])
            self.judge(["ghdl", "-a", *flags, "x.vhdl"], allowed)

    def judge(self, command: list[str], allowed: str = "") -> None:
        done = subprocess.run(command, cwd=self.folder, text=True, capture_output=True,
                              timeout=60, check=False)
        said = [line for line in (done.stdout + done.stderr).splitlines()
                if not allowed or not re.search(allowed, line)]
        self.assertEqual((done.returncode, said), (0, []), shlex.join(command))

    def read_names(self) -> dict[tuple[str, str], str]:
        """The name map; of several components of one type, the last."""
        names = {}
        for line in (self.folder / "x.map").read_text("utf-8").split("\n")[:-1]:
            kind, old, new = line.split("\t")
            names[kind, old] = new
        return names

    def compare_wiring(self, old: Json, new: Json) -> None:
        """Compares a module, bit by bit, with what was read of the netlist that it became."""
        names = self.read_names()
        wiring = Wiring(self)
        for name, p in old["ports"].items():
            other = find_named(new["ports"], names["port", escape(name)])
            for key in ("direction", "offset", "upto"):
                self.assertEqual(p.get(key), other.get(key), name)
            wiring.meet_all(f"port {name}", p["bits"], other["bits"])
        self.assertEqual(len(old["cells"]), len(new["cells"]))
        for name, c in old["cells"].items():
            other = find_named(new["cells"], names["cell", escape(name)])
            self.assertEqual(re.sub(r"_\d+$", "", names["component", escape(c["type"])]),
                             re.sub(r"_\d+$", "", other["type"]))
            for pin, bits in c["connections"].items():
                _, new_pin = names["pin", escape(f"{c['type']}.{pin}")].split(".")
                others = other["connections"].get(new_pin.partition("(")[0])
                wiring.meet_pin(f"{name}.{pin}", bits, others)

    def refuse(self, contents: Json | str | bytes, message: str, *options: str, line: int = 1,
               place: str = "") -> None:
        """Expects an import to fail with a message behind the file's name, and to write nothing.

        If the contents are no JSON, `line` is the line that the message names, and `place` the mark
        under it.
        """
        path = self.folder / "d.json"
        if isinstance(contents, bytes):
            path.write_bytes(contents)
        else:
            path.write_text(contents if isinstance(contents, str) else json.dumps(contents),
                            encoding="utf-8")
        outcome = self.run_tool("import", "d.json", "-o", "x.cmd", "--verilog", "x.v", "--vhdl",
                                "x.vhd", "--name-map", "x.map", *options)
        if place:
            source = self.read("d.json").splitlines()[line - 1]
            self.expect(outcome, 1, f"d.json:{line}: error: {message}\n{line:5} | {source}\n"
                                    f"      | {place}\n")
        else:
            self.expect(outcome, 1, f"d.json: error: {message}\n")
        self.assertEqual([p.name for p in self.folder.iterdir() if p.name.startswith("x.")], [])


class Wiring:
    """Pairs the nets of a design with those that were read of its netlist."""

    def __init__(self, test: ImportTest) -> None:
        self._test = test
        self._partners: dict[int | str, int | str] = {}
        self._back: dict[int | str, int | str] = {}

    def meet(self, place: str, one: int | str, other: int | str) -> None:
        if isinstance(one, str) or isinstance(other, str):
            self._test.assertEqual(one, other, place)
        self._test.assertEqual(self._partners.setdefault(one, other), other, place)
        self._test.assertEqual(self._back.setdefault(other, one), one, place)

    def meet_all(self, place: str, bits: list[int | str], others: list[int | str]) -> None:
        for one, other in zip(bits, others, strict=True):
            self.meet(place, one, other)

    def meet_pin(self, place: str, bits: list[int | str],
                 others: list[int | str] | None) -> None:
        if others:
            self.meet_all(f"pin {place}", bits, others)
            return
        # Left open: nothing else may be known to hang on these bits.
        for position, bit in enumerate(bits):
            nothing = f"open {place}.{position}"
            self._test.assertEqual(self._partners.setdefault(bit, nothing), nothing, place)


def escape(name: str) -> str:
    """As a field of the name map."""
    return name.replace("\\", "\\\\").replace("\t", "\\t").replace("\n", "\\n")


def identifier(name: str) -> str:
    """A name without the marks of an escaped name."""
    return name.removeprefix("\\").rstrip(" ")


def find_named(objects: Json, name: str) -> Json:
    """The object of a name; Yosys keeps the backslash before a "$" or a digit."""
    plain = identifier(name)
    return objects["\\" + plain if "\\" + plain in objects else plain]


def make_stubs(commands: list[str]) -> list[str]:
    """Empty Verilog modules for the components of a command file."""
    pins: dict[str, list[str]] = {}
    parameters: dict[str, list[str]] = {}
    directions = {"Input": "input", "Output": "output", "BiDirectional": "inout"}
    for line in commands:
        words = line.split()
        if words[:2] == ["ADD", "PIN"]:
            base, _, index = words[3].rstrip(")").partition("(")
            pins[words[2]].append(f"{directions[words[4]]} {f'[{index}]' if index else ''} {base}")
        elif words[:3] == ["ADD", "COMPONENT", "ATTRIBUTE"]:
            parameters[words[3]].append(f"parameter {words[5]} = 0;")
        elif words[:2] == ["ADD", "COMPONENT"]:
            pins[words[2]] = []
            parameters[words[2]] = []
    return [f"module {name}({', '.join(pins[name])}); {' '.join(parameters[name])} endmodule"
            for name in pins]
