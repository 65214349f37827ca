"""Ends the tool while it writes: the file that it was to replace stands as it was."""

from __future__ import annotations

import os
import signal
import subprocess
import tempfile
import time
import unittest
from pathlib import Path

TOOL = os.environ["ORN_HDL_TOOL"]
FORMER = b"what stood here before\n"
INSTANCES = 60_000
ATTEMPTS = 5


def make_design(path: Path, out: str) -> None:
    """A design whose netlist takes a while to write."""
    lines = ["ADD COMPONENT C", "ADD PIN C I input", "ADD PIN C O output"]
    for i in range(INSTANCES):
        lines += [f"ADD INSTANCE C U{i}", f"CONNECT SIGNAL n{i} U{i}.O"]
    lines.append(f"WRITE VERILOG -NOHEADER {out}")
    path.write_text("\n".join(lines) + "\n")


class Killed(unittest.TestCase):
    """The tool is killed as soon as its temporary file shows."""

    def setUp(self) -> None:
        self.folder = tempfile.TemporaryDirectory()
        self.addCleanup(self.folder.cleanup)
        self.path = Path(self.folder.name)
        self.out = self.path / "out" / "netlist.v"
        self.out.parent.mkdir()
        make_design(self.path / "design.cmd", str(self.out))

    def kill_in_mid_write(self, what: signal.Signals) -> bool:
        """Returns whether the tool was still writing when it was killed."""
        self.out.write_bytes(FORMER)
        with subprocess.Popen([TOOL, "run", "--quiet", self.path / "design.cmd"]) as tool:
            while tool.poll() is None and len(os.listdir(self.out.parent)) < 2:
                time.sleep(0)
            tool.send_signal(what)
            tool.wait()
        return tool.returncode == -what

    def test_the_former_file_stands(self) -> None:
        for attempt in range(ATTEMPTS):
            if self.kill_in_mid_write(signal.SIGKILL):
                self.assertEqual(self.out.read_bytes(), FORMER)
                # The next run is not held up by what the killed one left behind.
                subprocess.run([TOOL, "run", "--quiet", self.path / "design.cmd"], check=True)
                self.assertGreater(self.out.stat().st_size, INSTANCES * 20)
                return
        self.fail(f"the tool was never caught in mid-write, in {ATTEMPTS} attempts")


if __name__ == "__main__":
    unittest.main()
