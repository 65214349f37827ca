"""The page of limits shows the rules of the check, and the check finds every pinned case.

Environment: ORN_HDL_TOOL names the tool.
"""

from __future__ import annotations

import json
import os
import re
import subprocess
import unittest
from pathlib import Path

PROJECT = Path(__file__).resolve().parents[2]
TOOL = os.environ["ORN_HDL_TOOL"]


class Limits(unittest.TestCase):
    def test_page_shows_the_rules(self) -> None:
        page = (PROJECT / "docs" / "limits.md").read_text(encoding="utf-8")
        shown = re.search(r"<!-- rules -->\n(.*?)<!-- end of rules -->", page, re.S)[1]
        done = subprocess.run([TOOL, "check", "--markdown"], capture_output=True, text=True, check=True)
        self.assertEqual(shown, done.stdout)

    def test_every_pinned_case_is_found(self) -> None:
        cases = sorted((PROJECT / "tests" / "judges" / "limits").glob("*.cmd"))
        self.assertGreater(len(cases), 20)
        for case in cases:
            done = subprocess.run([TOOL, "check", "--format", "json", case], capture_output=True)
            rules = {finding["rule"] for finding in json.loads(done.stdout)["findings"]}
            if case.stem != "missing_configuration":
                rules.discard("missing-configuration")
            with self.subTest(case.stem):
                self.assertTrue(rules)

    def test_every_rule_has_its_files(self) -> None:
        listed = subprocess.run([TOOL, "check", "--list"], capture_output=True, text=True,
                                check=True).stdout.splitlines()
        folders = sorted(path.name for path in (PROJECT / "tests" / "check" / "rules").iterdir())
        self.assertEqual(sorted(line.split()[0] for line in listed), folders)


if __name__ == "__main__":
    unittest.main()
