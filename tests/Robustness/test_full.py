"""Writing to a full file system: the failure is reported, former files are unchanged, and nothing is left
behind. The file system has 64 KiB in memory and is mounted for this test, which needs root.

Environment: ORN_HDL_TOOL names the tool.
"""

from __future__ import annotations

import os
import subprocess
import tempfile
import unittest
from pathlib import Path

TOOL = Path(os.environ["ORN_HDL_TOOL"]).resolve()
FORMER = "what stood here before\n"
FILE_FAILED = 3


class FullFileSystem(unittest.TestCase):
    def setUp(self) -> None:
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = Path(folder.name)
        (self.folder / "disk").mkdir()
        (self.folder / "large.cmd").write_text(
            "".join(f"ADD SIGNAL a_signal_with_a_name_{i}\n" for i in range(5000)))
        mounted = self.on_disk("true")
        if mounted.returncode != 0:
            self.skipTest(f"no file system can be mounted: {mounted.stderr.strip()}")

    def on_disk(self, script: str) -> subprocess.CompletedProcess[str]:
        """Runs a script in the small file system, which ends with it."""
        mount = f"mount -t tmpfs -o size=64k tmpfs {self.folder}/disk && cd {self.folder}/disk && "
        return subprocess.run(["unshare", "--mount", "sh", "-c", mount + script],
                              capture_output=True, text=True, timeout=300, check=False)

    def test_replacing_keeps_the_former_file(self) -> None:
        done = self.on_disk(f"printf '{FORMER}' >o.v && {TOOL} run ../large.cmd --verilog o.v; "
                            "status=$?; cat o.v; ls -A; exit $status")
        self.assertEqual(done.stderr, "orn-hdl: cannot write o.v: No space left on device\n")
        self.assertEqual(done.returncode, FILE_FAILED)
        self.assertEqual(done.stdout, FORMER + "o.v\n")

    def test_a_new_file_does_not_stay(self) -> None:
        done = self.on_disk(f"{TOOL} run ../large.cmd --vhdl o.vhd; status=$?; ls -A; exit $status")
        self.assertEqual(done.stderr, "orn-hdl: cannot write o.vhd: No space left on device\n")
        self.assertEqual((done.returncode, done.stdout), (FILE_FAILED, ""))

    def test_appending_keeps_what_was_there(self) -> None:
        (self.folder / "append.cmd").write_text(
            (self.folder / "large.cmd").read_text() + "WRITE VERILOG -APPEND -NOHEADER o.v\n")
        done = self.on_disk(f"printf '{FORMER}' >o.v && {TOOL} run ../append.cmd; "
                            "status=$?; head -n 1 o.v; ls -A; exit $status")
        self.assertEqual(done.stderr, "../append.cmd:5001: error: cannot write o.v: "
                                      "No space left on device\n"
                                      " 5001 | WRITE VERILOG -APPEND -NOHEADER o.v\n"
                                      "      |                                 ^~~\n")
        self.assertEqual((done.returncode, done.stdout), (FILE_FAILED, FORMER + "o.v\n"))

    def test_what_fits_is_written_afterwards(self) -> None:
        (self.folder / "small.cmd").write_text("ADD PORT A input\n")
        done = self.on_disk(f"{TOOL} run ../large.cmd --verilog o.v 2>/dev/null; "
                            f"{TOOL} run ../small.cmd --verilog o.v && tail -n 1 o.v")
        self.assertEqual((done.returncode, done.stdout), (0, "endmodule\n"))


if __name__ == "__main__":
    unittest.main()
