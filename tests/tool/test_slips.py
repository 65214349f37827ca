"""What the tool prints for slips of its users: the whole message of each slip in slips.txt.

slips.txt holds one slip after the other:

    == what is wrong
    $ run slip.cmd
    lines of the file that the command names
    -- exit status
    what is printed on standard error

Without a line that begins with "$", the command is `run slip.cmd`. With " < " and a file in it, that
file is given on standard input by a pipe. A line "@NAME" stands for the lines of the block "== base NAME", and
"\\x" and two digits for a byte.

`test_slips.py --update` writes the file anew with what is printed now, to be read before it is kept.
"""

from __future__ import annotations

import re
import sys
import unittest
from dataclasses import dataclass
from pathlib import Path

from support import Outcome, ToolTest

FILE = Path(__file__).with_name("slips.txt")
DEFAULT = "run slip.cmd"


def plain(text: str) -> str:
    """The bytes that an escaped text stands for."""
    return re.sub(r"\\x([0-9a-f]{2})", lambda match: chr(int(match[1], 16)), text)


def escaped(text: str) -> str:
    return re.sub(r"[^\n -~]", lambda match: f"\\x{ord(match[0]):02x}", text)


@dataclass
class Slip:
    """One block of the file."""

    title: str
    command: str
    lines: list[str]
    status: int
    printed: str

    def text(self) -> str:
        command = [] if self.command == DEFAULT else [f"$ {self.command}"]
        head = [f"== {self.title}", *command, *self.lines, f"-- {self.status}"]
        return "\n".join(head) + "\n" + escaped(self.printed)


@dataclass
class Slips:
    """The file: its comment, the bases, and the slips."""

    head: str
    bases: dict[str, list[str]]
    slips: list[Slip]

    def contents(self, slip: Slip) -> str:
        lines = [expanded for line in slip.lines
                 for expanded in (self.bases[line[1:]] if line.startswith("@") else [line])]
        text = "".join(f"{line}\n" for line in lines)
        return plain(text)


def read() -> Slips:
    head, *blocks = re.split(r"^== ", FILE.read_text(encoding="ascii"), flags=re.M)
    bases, slips = {}, []
    for block in blocks:
        title, _, rest = block.partition("\n")
        if title.startswith("base "):
            bases[title.removeprefix("base ")] = rest.strip("\n").split("\n")
            continue
        given, status, printed = re.fullmatch(r"(.*?)^-- (\d*)\n(.*)", rest, re.S | re.M).groups()
        lines = given.splitlines()
        command = lines.pop(0)[2:] if lines and lines[0].startswith("$ ") else DEFAULT
        slips.append(Slip(title, command, lines, int(status or -1), plain(printed)))
    return Slips(head, bases, slips)


def write(slips: Slips) -> None:
    parts = [slips.head]
    parts += [f"== base {name}\n" + "\n".join(lines) + "\n\n" for name, lines in slips.bases.items()]
    parts += [slip.text() for slip in slips.slips]
    FILE.write_text("".join(parts), encoding="ascii")


class SlipsOfUsers(ToolTest):
    maxDiff = None

    def run_slip(self, slips: Slips, slip: Slip) -> Outcome:
        command, _, given = slip.command.partition(" < ")
        words = command.split()
        name = given or next(word for word in words if re.search(r"\w\.\w", word))
        contents = slips.contents(slip)
        if not name.startswith("none"):
            self.write(name, contents)
        outcome = self.run_tool(*words, stdin=contents if given else "")
        for path in self.folder.iterdir():
            path.unlink()
        return outcome

    def test_messages(self) -> None:
        slips = read()
        self.assertGreaterEqual(len(slips.slips), 62)
        for slip in slips.slips:
            with self.subTest(slip.title):
                outcome = self.run_slip(slips, slip)
                self.assertEqual(outcome.err, slip.printed)
                self.assertEqual(outcome.status, slip.status)

    def test_titles_differ(self) -> None:
        titles = [slip.title for slip in read().slips]
        self.assertEqual(len(titles), len(set(titles)))


def update() -> None:
    class Update(SlipsOfUsers):
        def test_messages(self) -> None:
            slips = read()
            for slip in slips.slips:
                outcome = self.run_slip(slips, slip)
                slip.status, slip.printed = outcome.status, outcome.err
            write(slips)

    unittest.TextTestRunner().run(Update("test_messages"))


if __name__ == "__main__":
    if sys.argv[1:] == ["--update"]:
        update()
    else:
        unittest.main()
