"""What the real tools say of a written netlist: accepted, warned of, or rejected.

The leaf cells of a command file are declared here as the file itself declares them, so that a tool
judges the netlist and not the lack of a library.
"""

from __future__ import annotations

import re
import shutil
import subprocess
from collections.abc import Iterable, Sequence
from dataclasses import dataclass, field
from pathlib import Path

ACCEPTED, WARNED, REJECTED = range(3)
LEVELS = ("accepted", "warned", "rejected")
TIME_LIMIT = 60  # seconds
MOST_MEMORY = 2_000_000  # kilobytes

_PLAIN_VERILOG = re.compile(r"[A-Za-z_][A-Za-z0-9_$]*$")
_PLAIN_VHDL = re.compile(r"[A-Za-z](_?[A-Za-z0-9])*$")
_RANGE = re.compile(r"(.*)\(([-+]?\d+):([-+]?\d+)\)$")
_BIT = re.compile(r"(.*)\(([-+]?\d+)\)$")
_NORMAL = str.maketrans("[]{}<>-", "()()():")


@dataclass(frozen=True)
class Verdict:
    """How a tool took a netlist, and what it said."""

    level: int
    text: str = ""

    def __str__(self) -> str:
        lines = [line for line in self.text.splitlines()
                 if re.search(r"error|warning|sorry|%|:\d+:", line, re.IGNORECASE)]
        return f"{LEVELS[self.level]}: {' | '.join((lines or [self.text])[:2])}"


@dataclass
class Cell:
    """A leaf cell as the command file declares it."""

    name: str
    pins: list[tuple[str, str]] = field(default_factory=list)
    generics: dict[str, tuple[str, str]] = field(default_factory=dict)


@dataclass
class Commands:
    """What of a command file the tools have to be given, or that they are asked about."""

    top: str = "X"
    cells: dict[str, Cell] = field(default_factory=dict)
    instances: dict[str, str] = field(default_factory=dict)
    case: str = ""
    libraries: list[str] = field(default_factory=list)
    includes: list[str] = field(default_factory=list)
    suppressed: bool = False


def words_of(line: str) -> list[str]:
    """The words of a command line; quotes and backslashes as the command language has them."""
    words: list[str] = []
    word, started, quoted = "", False, False
    index = 0
    while index < len(line):
        character = line[index]
        if character == "\\" and index + 1 < len(line):
            word += line[index + 1]
            started = True
            index += 1
        elif character == '"':
            quoted = not quoted
            started = True
        elif character == " " and not quoted:
            if started:
                words.append(word)
            word, started = "", False
        else:
            word += character
            started = True
        index += 1
    return words + ([word] if started else [])


def read_commands(text: str, name: str) -> Commands:
    """The cells of a command file, in which every line succeeds."""
    found = Commands(name)
    options: list[tuple[str, str, str, str]] = []
    attributes: dict[tuple[str, str, str], tuple[str, str]] = {}
    for line in text.splitlines():
        words = words_of(line)
        phrase = " ".join(words[:3]).upper()
        if phrase == "SET NETLIST NAME":
            found.top = words[3]
        elif phrase.startswith("ADD COMPONENT ") and len(words) == 3:
            found.cells.setdefault(words[2].translate(_NORMAL).lower(),
                                   Cell(words[2].translate(_NORMAL)))
        elif phrase.startswith("ADD PIN ") and len(words) >= 5:
            cell = found.cells.get(words[2].translate(_NORMAL).lower())
            if cell:
                cell.pins.append((words[3].translate(_NORMAL), words[4][:1].lower()))
        elif phrase.startswith("ADD INSTANCE ") and len(words) == 4:
            found.instances.setdefault(words[3].translate(_NORMAL).lower(),
                                       words[2].translate(_NORMAL).lower())
        elif phrase in ("UPPERCASE COMPONENT", "LOWERCASE COMPONENT"):
            found.case = phrase[:5]
        elif phrase.startswith("SUPPRESS COMPONENT"):
            found.suppressed = not (len(words) > 2 and words[2].lower() == "false")
        elif phrase.startswith("ADD LIBRARY ") and len(words) == 3:
            found.libraries.append(words[2])
        elif phrase.startswith("ADD INCLUDE ") and len(words) == 3:
            found.includes.append(words[2].strip('"'))
        elif phrase in ("ADD COMPONENT ATTRIBUTE", "ADD INSTANCE ATTRIBUTE"):
            kind, owner, rest = words[1].lower(), words[3].translate(_NORMAL).lower(), words[4:]
            kept = "String"
            if rest and rest[0].upper().startswith("-TYPE="):
                kept, rest = rest[0][6:], rest[1:]
            key = (kind, owner, rest[0].translate(_NORMAL).lower())
            spelled = rest[0].translate(_NORMAL)
            if key not in attributes:
                attributes[key] = (spelled, kept)
        elif " ".join(words[:4]).upper() in ("SET COMPONENT ATTRIBUTE OPTION",
                                             "SET INSTANCE ATTRIBUTE OPTION"):
            for option in words[6:8]:
                if option.upper().startswith("-GENERIC="):
                    options.append((words[1].lower(), words[4].translate(_NORMAL).lower(),
                                    words[5].translate(_NORMAL).lower(), option[9:].upper()))
    generic: dict[tuple[str, str, str], bool] = {}
    for kind, owner, attribute, option in options:
        if kind == "instance" and (kind, owner, attribute) not in attributes:
            kind, owner = "component", found.instances.get(owner, "")
        generic[kind, owner, attribute] = option != "NONE"
    for (kind, owner, attribute), on in generic.items():
        cell = found.cells.get(owner if kind == "component" else found.instances.get(owner, ""))
        if on and cell and (kind, owner, attribute) in attributes:
            spelled, kept = attributes[kind, owner, attribute]
            if kind == "component" or attribute not in {g.lower() for g in cell.generics}:
                cell.generics = {g: v for g, v in cell.generics.items() if g.lower() != attribute}
                cell.generics[spelled] = (kept, kind)
    if found.case:
        for cell in found.cells.values():
            cell.name = cell.name.upper() if found.case == "UPPER" else cell.name.lower()
    return found


def _verilog_cell(cell: Cell, body: bool) -> str:
    ports: dict[str, tuple[str, str, str]] = {}
    for pin, direction in cell.pins:
        bus, bit = _RANGE.match(pin), _BIT.match(pin)
        base = (bus or bit)[1] if bus or bit else pin
        rng = f"[{int(bus[2])}:{int(bus[3])}] " if bus else ""
        ports.setdefault(base, (rng, direction, ""))
    if not all(_PLAIN_VERILOG.match(name) for name in [cell.name, *ports, *cell.generics]):
        return ""
    lines = [f"module {cell.name}({', '.join(ports)});"]
    lines += [f"  parameter {name} = 0;" for name in cell.generics]
    inputs = [base for base, (_, direction, _) in ports.items() if direction == "i"]
    for base, (rng, direction, _) in ports.items():
        word = {"i": "input", "o": "output", "b": "inout"}[direction]
        lines.append(f"  {word} {rng}{base};")
    if body and inputs:
        clock = inputs[0] + (f"[{_first(ports[inputs[0]][0])}]" if ports[inputs[0]][0] else "")
        for base, (rng, direction, _) in ports.items():
            if direction == "o":
                lines += [f"  reg {rng}{base}_kept;", f"  assign {base} = {base}_kept;",
                          f"  always @(posedge {clock}) {base}_kept <= ~{base}_kept;"]
    lines.append("endmodule")
    return "\n".join(lines) + "\n"


def _first(rng: str) -> str:
    return rng.strip("[] ").split(":")[0]


_VHDL_TYPES = {"string": ("string", '""'), "integer": ("integer", "0"), "float": ("real", "0.0"),
               "boolean": ("boolean", "false"), "bit": ("bit", "'0'"),
               "bitvector": ("bit_vector", '""')}


def _vhdl_parts(cell: Cell) -> str | None:
    """The generic and port clauses; None when the cell has a name that VHDL has not."""
    ports: list[str] = []
    generics = [(name, *_VHDL_TYPES.get(kind.lower(), ("string", '""')))
                for name, (kind, owner) in cell.generics.items() if owner == "component"]
    for pin, direction in cell.pins:
        bus = _RANGE.match(pin)
        base = bus[1] if bus else pin
        mode = {"i": "in", "o": "out", "b": "inout"}[direction]
        kind = "std_logic"
        if bus:
            way = "downto" if int(bus[2]) >= int(bus[3]) else "to"
            kind = f"std_logic_vector({int(bus[2])} {way} {int(bus[3])})"
        if not _PLAIN_VHDL.match(base):
            return None
        ports.append(f"{base} : {mode} {kind}")
    if not all(_PLAIN_VHDL.match(name) for name in [cell.name, *(g[0] for g in generics)]):
        return None
    text = ""
    if generics:
        text += f"  generic ({'; '.join(f'{n} : {t} := {v}' for n, t, v in generics)});\n"
    if ports:
        text += f"  port ({'; '.join(ports)});\n"
    return text


def _vhdl_component(cell: Cell) -> str:
    parts = _vhdl_parts(cell)
    return "" if parts is None else f"component {cell.name}\n{parts}end component;\n"


def _vhdl_cell(cell: Cell, configuration: bool) -> str:
    """The entity, an empty architecture, and perhaps the configuration that a design can name."""
    parts = _vhdl_parts(cell)
    if parts is None:
        return ""
    name = cell.name
    return (f"library ieee;\nuse ieee.std_logic_1164.all;\nentity {name} is\n{parts}end {name};\n"
            f"architecture stub of {name} is\nbegin\nend stub;\n" +
            (f"configuration CFG_{name} of {name} is\nfor stub\nend for;\nend CFG_{name};\n"
             if configuration else ""))


def _limit() -> None:
    import resource
    resource.setrlimit(resource.RLIMIT_AS, (MOST_MEMORY * 1024, MOST_MEMORY * 1024))


def _run(command: list[str], work: Path, time_limit: int = TIME_LIMIT) -> tuple[int, str]:
    try:
        done = subprocess.run(command, cwd=work, capture_output=True, timeout=time_limit,
                              stdin=subprocess.DEVNULL, preexec_fn=_limit)
    except subprocess.TimeoutExpired:
        return 1, "error: out of time"
    return done.returncode, (done.stdout + done.stderr).decode("latin-1")


def _verdict(status: int, text: str, warning: str = r"\bwarning\b") -> Verdict:
    if status != 0:
        return Verdict(REJECTED, text)
    if re.search(warning, text, re.IGNORECASE):
        return Verdict(WARNED, text)
    return Verdict(ACCEPTED)


class Judges:
    """All tools over the netlists of one command file, in a folder of its own."""

    def __init__(self, work: Path, commands: Commands, configurations: bool = True) -> None:
        self.work = work
        self.commands = commands
        placed = [commands.cells[name] for name in dict.fromkeys(commands.instances.values())
                  if name in commands.cells]
        cells = [cell for cell in placed if cell.name != commands.top]
        (work / "cells.v").write_text(
            "`timescale 1ns / 1ps\n" + "".join(_verilog_cell(c, True) for c in cells), "latin-1")
        (work / "cells_bb.v").write_text("".join(_verilog_cell(c, False) for c in cells),
                                         "latin-1")
        self.vhdl_cells = [text for text in (_vhdl_cell(cell, configurations) for cell in cells
                                             if cell.name.lower() != commands.top.lower()) if text]
        components = "".join(text for text in map(_vhdl_component, cells)) if commands.suppressed else ""
        self.package = ("library ieee;\nuse ieee.std_logic_1164.all;\npackage Vcomponents is\n"
                        f"{components}end Vcomponents;\n")
        for name in commands.includes:
            if re.match(r"[\w. ]+$", name):
                (work / name).write_text("")

    def icarus(self, netlist: str, generation: str = "2005") -> Verdict:
        return _verdict(*_run(["iverilog", f"-g{generation}", "-Wall", "-tnull", "-s",
                               self.commands.top, netlist, "cells.v"], self.work))

    def verilator(self, netlist: str) -> Verdict:
        """Warnings alone do not make it stop here, as they do without the option."""
        return _verdict(*_run(["verilator", "--lint-only", "-Wno-LITENDIAN", "-Wno-fatal",
                               "--top-module", self.commands.top, netlist, "-v", "cells.v"],
                              self.work), r"%Warning")

    def yosys(self, netlist: str) -> Verdict:
        script = (f"read_verilog -lib cells_bb.v; read_verilog {netlist}; "
                  f"hierarchy -check -top {self.commands.top}; check")
        return _verdict(*_run(["yosys", "-q", "-p", script], self.work))

    def ghdl(self, netlist: str, standard: str) -> Verdict:
        """Analyses the netlist with its cells, and elaborates the entity."""
        folder = self.work / f"ghdl{standard}"
        if not folder.exists():
            folder.mkdir()
            for library in {"KESTRA", *self.commands.libraries}:
                if re.match(r"[A-Za-z]\w*$", library) and library.lower() not in ("ieee", "std",
                                                                                  "work"):
                    source = folder / f"{library}.vhd"
                    source.write_text(self.package if library == "KESTRA" else
                                      "package parts is\nend parts;\n", "latin-1")
                    _run(["ghdl", "-a", f"--std={standard}", f"--workdir={folder}",
                          f"--work={library}", str(source)], folder)
        flags = [f"--std={standard}", "--syn-binding", f"--workdir={folder}", f"-P{folder}"]
        for index, cell in enumerate(self.vhdl_cells):
            source = folder / f"cell{index}.vhd"
            if not source.exists():
                source.write_text(cell, "latin-1")
                _run(["ghdl", "-a", *flags, source.name], folder)
        status, text = _run(["ghdl", "-a", *flags, str(self.work / netlist)], folder)
        if status == 0:
            status, more = _run(["ghdl", "-e", *flags, self.commands.top], folder)
            text += more
        # What fails when the design is run is no mere warning.
        # Several netlists of one design replace each other in the library; that is no fault of theirs.
        text = "\n".join(line for line in text.splitlines() if "-Wlibrary" not in line)
        return _verdict(status or "-Wruntime-error" in text, text)

    def all(self, verilog: Sequence[str] = ("X.v",),
            vhdl: Sequence[str] = ("X.vhd",)) -> dict[str, Verdict]:
        """What each tool says of the worst of the netlists of its language."""
        def worst(verdicts: Iterable[Verdict]) -> Verdict:
            return max(verdicts, key=lambda verdict: verdict.level)

        return {"icarus": worst(map(self.icarus, verilog)),
                "verilator": worst(map(self.verilator, verilog)),
                "yosys": worst(map(self.yosys, verilog)),
                "ghdl_93": worst(self.ghdl(name, "93") for name in vhdl),
                "ghdl_08": worst(self.ghdl(name, "08") for name in vhdl)}


def clear(folder: Path) -> Path:
    shutil.rmtree(folder, ignore_errors=True)
    folder.mkdir(parents=True)
    return folder
