"""docs/interface.md lists every message that the library throws, and no other."""

from __future__ import annotations

import re
import unittest
from pathlib import Path

PROJECT = Path(__file__).resolve().parents[2]
# A call of Fail, FailInModel and the like with its message.
THROWN = re.compile(r'\bFail\w*\([^;]*?"((?:[^"\\]|\\.)*)\\n"')
LISTED = re.compile(r"^\| `([^`]*\.)` \|", re.M)


def shape(message: str) -> str:
    """The message with "%s" for every inserted text."""
    return re.sub(r"[A-Z]{3,}", "%s", message.replace('\\"', '"'))


class Messages(unittest.TestCase):
    def test_the_page_lists_them(self) -> None:
        sources = "".join(path.read_text() for path in sorted((PROJECT / "s").rglob("*.*")))
        thrown = {shape(message) for message in THROWN.findall(sources)}
        # A ProofException makes its text itself.
        proof = "does not mean what the design does"
        self.assertIn(proof, sources)
        thrown.add(f'"%s" {proof}: %s.')
        page = (PROJECT / "docs" / "interface.md").read_text()
        self.assertGreater(len(thrown), 10)
        self.assertEqual(thrown, {shape(message) for message in LISTED.findall(page)})


if __name__ == "__main__":
    unittest.main()
