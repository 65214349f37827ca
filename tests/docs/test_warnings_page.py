"""The page of warnings shows the table of the tool.

Environment: ORN_HDL_TOOL names the tool.
"""

from __future__ import annotations

import os
import re
import subprocess
import unittest
from pathlib import Path

PROJECT = Path(__file__).resolve().parents[2]


class WarningsPage(unittest.TestCase):
    def test_page_shows_the_warnings(self) -> None:
        page = (PROJECT / "docs" / "warnings.md").read_text(encoding="utf-8")
        shown = re.search(r"<!-- warnings -->\n(.*?)<!-- end of warnings -->", page, re.S)[1]
        done = subprocess.run([os.environ["ORN_HDL_TOOL"], "warnings", "--markdown"],
                              capture_output=True, text=True, check=True)
        self.assertEqual(shown, done.stdout)


if __name__ == "__main__":
    unittest.main()
