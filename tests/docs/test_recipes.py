"""A command stands in every place that CONTRIBUTING.md names for one.

Environment: ORN_HDL_TOOL names the tool.
"""

from __future__ import annotations

import os
import re
import subprocess
import sys
import unittest
from pathlib import Path

PROJECT = Path(__file__).resolve().parents[2]
sys.path.insert(0, str(PROJECT / "tests" / "reference"))

from orn_reference.commands import phrases as reference_phrases  # noqa: E402

REFERENCE = "tests/reference/orn_reference/commands.py"
# The contents of these files do not depend on the phrases alone.
WITHOUT_PHRASES = {"CHANGELOG.md", "share/man/man1/orn-hdl.1",
                   "share/vim/vimfiles/ftdetect/orn-hdl.vim", "tests/docs/test_recipes.py"}


def phrases() -> list[str]:
    """The phrases as the tool lists them."""
    page = subprocess.run([os.environ["ORN_HDL_TOOL"], "commands", "--markdown"],
                          capture_output=True, text=True, check=True).stdout
    return re.findall(r"^\| `([^`]+)` \|", page, re.M)


def places() -> list[str]:
    """The files that the recipe names."""
    text = (PROJECT / "CONTRIBUTING.md").read_text()
    recipe = re.search(r"^\*\*Add a command\.\*\*.*?(?=^\*\*)", text, re.M | re.S).group()
    return [name for name in re.findall(r"`([\w./-]+)`", recipe) if (PROJECT / name).is_file()]


def generated() -> set[str]:
    """The files that share/generator writes."""
    source = (PROJECT / "share" / "generator" / "__main__.py").read_text()
    return set(re.findall(r'^        "([\w./-]+)": ', source, re.M))


def missing(phrases_of_tool: list[str], name: str) -> list[str]:
    """The phrases that do not stand in a file."""
    text = (PROJECT / name).read_text()
    if name.endswith(".md"):
        text = "\n".join(line for line in text.splitlines() if line.startswith("| `"))
    # Patterns spell a blank in their own ways.
    text = re.sub(r"\\+s\\?\+", " ", text).upper()
    absent = []
    # A phrase that is found is taken out: what is left of a longer one is no shorter one.
    for phrase in sorted(phrases_of_tool, key=len, reverse=True):
        if phrase.upper() not in text:
            absent.append(phrase)
        text = text.replace(phrase.upper(), "\0")
    return absent


class AddACommand(unittest.TestCase):
    def test_the_recipe_names_what_is_generated(self) -> None:
        self.assertGreater(len(generated()), 5)
        self.assertEqual(generated() - set(places()), set())

    def test_every_phrase_stands_in_every_place(self) -> None:
        listed = phrases()
        self.assertGreater(len(listed), 0)
        self.assertIn("s/HdlCmd/Catalogue.cpp", places())
        for name in places():
            if name == REFERENCE:
                spelt = [phrase.decode("ascii") for phrase in reference_phrases()]
                self.assertEqual(sorted(spelt), sorted(listed), name)
            elif name not in WITHOUT_PHRASES:
                self.assertEqual(missing(listed, name), [], name)


if __name__ == "__main__":
    unittest.main()
