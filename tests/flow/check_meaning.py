"""Whether the Verilog and the VHDL of one design are wired alike, read by Yosys and by GHDL.

The leaf cells are black boxes in both. For each bit of a cell's input and of an output port, what
drives it is looked up: a bit of an input port or of a cell's output, or a constant. Pins and ports of
both directions are left out: GHDL has no netlist of them.
"""

from __future__ import annotations

import json
import re
import subprocess
from pathlib import Path
from typing import Any

Sources = dict[tuple, str]


def _yosys(work: Path, script: str, result: str) -> dict[str, Any] | None:
    done = subprocess.run(["yosys", "-q", "-p", f"{script}; write_json {result}"], cwd=work,
                          capture_output=True, timeout=60)
    return json.loads((work / result).read_text("latin-1"))["modules"] if done.returncode == 0 else None


def _lower(table: dict[str, Any]) -> dict[str, Any]:
    return {name.lower(): value for name, value in table.items()}


def _sources(modules: dict[str, Any], top: str) -> tuple[Sources, dict[tuple, Any]]:
    """What drives each bit that is read, and the parameters of each cell."""
    module = next(m for name, m in modules.items() if name.lower() == top.lower())
    drivers: dict[Any, set[str]] = {}
    sinks: dict[tuple, Any] = {}
    parameters: dict[tuple, Any] = {}
    for name, port in _lower(module["ports"]).items():
        for position, bit in enumerate(port["bits"]):
            if port["direction"] == "input":
                drivers.setdefault(bit, set()).add(f"port {name}[{position}]")
            elif port["direction"] == "output":
                sinks["port", name, position] = bit
    for name, cell in _lower(module["cells"]).items():
        kinds = _lower(modules[cell["type"]]["ports"]) if cell["type"] in modules else {}
        for parameter, value in _lower(cell["parameters"]).items():
            parameters[name, parameter] = value
        for pin, bits in _lower(cell["connections"]).items():
            direction = kinds.get(pin, {}).get("direction", "inout")
            for position, bit in enumerate(bits):
                if direction == "output":
                    drivers.setdefault(bit, set()).add(f"cell {name}.{pin}[{position}]")
                elif direction == "input":
                    sinks[name, pin, position] = bit

    def source(bit: Any) -> str:
        if bit in ("0", "1"):
            return str(bit)
        found = drivers.get(bit, set())
        return sorted(found)[0] if found else "nothing"

    return {sink: source(bit) for sink, bit in sinks.items()}, parameters


def _number(value: Any) -> int | str:
    text = str(value)
    return int(text, 2) if re.fullmatch(r"[01]+", text) else text


def difference(work: Path, judges: Any) -> str | None:
    """The first difference, "" for none; None when the two cannot be compared."""
    top = judges.commands.top
    verilog = _yosys(work, f"read_verilog -lib cells_bb.v; read_verilog X.v; "
                           f"hierarchy -top {top}", "v.json")
    folder = work / "synth"
    folder.mkdir(exist_ok=True)
    flags = ["--std=08", f"--workdir={folder}", f"-P{work / 'ghdl08'}"]
    subprocess.run(["ghdl", "-a", *flags, "../X.vhd"], cwd=folder, capture_output=True, timeout=60)
    done = subprocess.run(["ghdl", "--synth", *flags, "--out=verilog", top], cwd=folder,
                          capture_output=True, timeout=60)
    if verilog is None or done.returncode != 0:
        return None
    (work / "S.v").write_bytes(done.stdout)
    vhdl = _yosys(work, "read_verilog -sv S.v; hierarchy", "s.json")
    if vhdl is None or not any(name.lower() == top.lower() for name in vhdl):
        return None
    ours, our_parameters = _sources(verilog, top)
    theirs, their_parameters = _sources(vhdl, top)
    for sink in sorted(set(ours) | set(theirs), key=str):
        one, other = ours.get(sink, "nothing"), theirs.get(sink, "nothing")
        if one != other:
            return f"{sink}: {one} in Verilog, {other} in VHDL"
    for key in sorted(set(our_parameters) & set(their_parameters)):
        one, other = our_parameters[key], their_parameters[key]
        if _number(one) != _number(other) and isinstance(_number(one), int) and \
                isinstance(_number(other), int):
            return f"{key}: {one} in Verilog, {other} in VHDL"
    return ""
