"""Helpers for the tests of the tool: they run it in a temporary folder."""

from __future__ import annotations

import os
import subprocess
import tempfile
import unittest
from dataclasses import dataclass
from pathlib import Path

TOOL = os.environ.get("ORN_HDL_TOOL", "orn-hdl")
EXAMPLES = Path(__file__).resolve().parents[2] / "examples"

SUCCESS, FAILED, USAGE, FILE = 0, 1, 2, 3

# A design of one gate, as commands.
INVERTER = """\
ADD COMPONENT INV
ADD PIN INV I input
ADD PIN INV O output
ADD PORT A input
ADD PORT Y output
ADD INSTANCE INV U1
CONNECT SIGNAL A U1.I
CONNECT SIGNAL Y U1.O
"""


# What is said of a line that holds nothing but ADD.
ADD_NOTE = ("note: ADD is followed by COMPONENT, PIN, INSTANCE, PORT, SIGNAL, INCLUDE, LIBRARY, USE, NOTES "
            "or MODULE\n")


def lone_add(line: int) -> str:
    """What is printed of such a line behind the error."""
    number = f"{line:5}"
    return f"{number} | ADD\n{' ' * len(number)} |    ^\n{ADD_NOTE}"


@dataclass
class Outcome:
    """The exit status and the output of a run."""

    status: int
    out: str
    err: str


class ToolTest(unittest.TestCase):
    """A test with a folder of its own, in which the tool runs."""

    def setUp(self) -> None:
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = Path(folder.name)

    def run_tool(self, *arguments: str | Path, stdin: str = "", **environment: str) -> Outcome:
        """Runs the tool. Texts are Latin-1, so that no byte is lost."""
        done = subprocess.run([TOOL, *map(str, arguments)], cwd=self.folder,
                              input=stdin.encode("latin-1"), capture_output=True, timeout=300,
                              env={**os.environ, "SOURCE_DATE_EPOCH": "0", **environment})
        return Outcome(done.returncode, done.stdout.decode("latin-1"),
                       done.stderr.decode("latin-1"))

    def write(self, name: str, text: str) -> Path:
        path = self.folder / name
        path.write_bytes(text.encode("latin-1"))
        return path

    def read(self, name: str) -> str:
        return (self.folder / name).read_bytes().decode("latin-1")

    def expect(self, outcome: Outcome, status: int, err: str = "", out: str = "") -> None:
        """Compares the results of a run; the messages first, which explain most."""
        self.assertEqual(outcome.err, err)
        self.assertEqual(outcome.status, status)
        self.assertEqual(outcome.out, out)
