"""The page of limits has a row for every pinned case, and no other."""

from __future__ import annotations

import re
import unittest
from pathlib import Path

PROJECT = Path(__file__).resolve().parents[2]


class Limits(unittest.TestCase):
    def test_page_and_cases_agree(self) -> None:
        page = (PROJECT / "docs" / "limits.md").read_text(encoding="utf-8")
        rows = re.findall(r"^\| `(\w+)` \|", page, re.M)
        cases = [file.stem for file in (PROJECT / "tests" / "judges" / "limits").glob("*.cmd")]
        self.assertEqual(sorted(rows), sorted(cases))


if __name__ == "__main__":
    unittest.main()
