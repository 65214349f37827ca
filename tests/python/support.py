"""Helpers for the tests of the package: small designs, and what the tool makes of command files."""

from __future__ import annotations

import os
import subprocess
from pathlib import Path
from typing import Dict, Tuple

import orn_hdl

PROJECT = Path(__file__).resolve().parents[2]
TOOL = os.environ.get("ORN_HDL_TOOL", "orn-hdl")


def half_adder() -> orn_hdl.Design:
    """Two gates, four ports."""
    d = orn_hdl.Design("half")
    a, b = d.port("A", "in"), d.port("B", "in")
    and2 = d.component("AND2", I0="in", I1="in", O="out")
    xor2 = d.component("XOR2", I0="in", I1="in", O="out")
    d.instance("U1", and2, I0=a, I1=b, O=d.port("C", "out"))
    d.instance("U2", xor2, I0=a, I1=b, O=d.port("S", "out"))
    return d


def replay(folder: Path, lines: str) -> Tuple[bytes, bytes]:
    """The Verilog and the VHDL that the tool writes for lines of commands."""
    source = folder / "replayed.cmd"
    source.write_text(lines)
    subprocess.run([TOOL, "run", "--quiet", "--no-warn", "all", "--no-header", "--model", "top", "--verilog",
                    folder / "replayed.v", "--vhdl", folder / "replayed.vhd", source], check=True)
    return (folder / "replayed.v").read_bytes(), (folder / "replayed.vhd").read_bytes()


def written(design: orn_hdl.Design, folder: Path) -> Tuple[bytes, bytes]:
    """The Verilog and the VHDL that a design writes."""
    design.write_verilog(folder / "written.v", header=False)
    design.write_vhdl(folder / "written.vhd", header=False)
    return (folder / "written.v").read_bytes(), (folder / "written.vhd").read_bytes()


def files_in(folder: Path) -> Dict[str, bytes]:
    """The contents of all files of a folder by name."""
    return {path.name: path.read_bytes() for path in sorted(folder.iterdir())}
