"""The orn-hdl under test."""

from __future__ import annotations

import os
from pathlib import Path

from judging import Forms
from judges import run_tool


def read_port_names(name_map: Path) -> dict[str, str]:
    """What ports are called in a netlist; an escaped name is the name without the escape."""
    names = {}
    for line in name_map.read_text().splitlines():
        kind, old, new = line.split("\t")
        if kind == "port":
            names[old] = new.removeprefix("\\").rstrip(" ")
    return names


class Tool:
    """Runs orn-hdl in a folder; what it writes holds no time of day."""

    def __init__(self, program: Path) -> None:
        self.program = program.resolve()
        os.environ["SOURCE_DATE_EPOCH"] = "0"

    def import_netlist(self, source: Path, top: str, work: Path) -> Forms:
        """Imports JSON as a command file, X.cmd, and straight to both languages.

        A line of the table of names holds a kind, the old name and the new one, separated by tabs.
        """
        self.run(work, "import", source, "-o", "X.cmd", "--name-map", "X.map")
        self.run(work, "import", source, "--names", "both", "--verilog", "X.v")
        self.run(work, "import", source, "--names", "both", "--vhdl", "X.vhd")
        return Forms(work / "X.v", work / "X.vhd", read_port_names(work / "X.map"))

    def import_alone(self, source: Path, work: Path) -> Forms:
        """Imports JSON to each language alone, so that only its own rules for names apply.

        The names of the ports are those in the Verilog.
        """
        self.run(work, "import", source, "--verilog", "X.v", "--name-map", "X.map")
        self.run(work, "import", source, "--vhdl", "X.vhd")
        return Forms(work / "X.v", work / "X.vhd", read_port_names(work / "X.map"))

    def replay(self, commands: Path, work: Path) -> Forms:
        """Replays a command file once for each language."""
        self.run(work, "run", "--quiet", "--verilog", "X.v", commands)
        self.run(work, "run", "--quiet", "--vhdl", "X.vhd", commands)
        return Forms(work / "X.v", work / "X.vhd")

    def replay_repeatedly(self, commands: Path, work: Path) -> Forms:
        """Has one replay write VHDL, Verilog, VHDL, Verilog; returns the last of each."""
        script = work / "repeated.cmd"
        script.write_text(commands.read_text() +
                          "WRITE VHDL first.vhd\nWRITE VERILOG first.v\n"
                          "WRITE VHDL second.vhd\nWRITE VERILOG second.v\n")
        self.run(work, "run", "--quiet", script)
        return Forms(work / "second.v", work / "second.vhd")

    def run(self, work: Path, *arguments: str | Path) -> None:
        work.mkdir(parents=True, exist_ok=True)
        run_tool([self.program, *arguments], work)
