"""orn-hdl commands: the command language as printed."""

from __future__ import annotations

import unittest

from support import SUCCESS, USAGE, ToolTest


class Commands(ToolTest):
    def list(self, *words: str) -> list[str]:
        outcome = self.run_tool("commands", *words)
        self.assertEqual((outcome.status, outcome.err), (SUCCESS, ""))
        return outcome.out.splitlines()

    def test_every_command_is_one_line(self) -> None:
        lines = self.list()
        self.assertEqual(len(lines), 61)
        self.assertTrue(lines[0].startswith("NOOP "))
        self.assertTrue(any(line.startswith("Set Open Pin ") for line in lines))

    def test_help_texts_stand_in_one_column(self) -> None:
        lines = self.list()
        column = lines[0].index("Does")
        for line in lines:
            self.assertEqual(line[column - 2:column], "  ", line)
            self.assertNotEqual(line[column], " ", line)

    def test_lines_that_begin_with_words(self) -> None:
        lines = self.list("set", "INSTANCE", "pin")
        self.assertEqual(len(lines), 3)
        for line in lines:
            self.assertTrue(line.startswith("SET INSTANCE PIN ATTRIBUTE "))

    def test_words_in_one_argument(self) -> None:
        self.assertEqual(self.list("set instance pin"), self.list("set", "instance", "pin"))

    def test_only_whole_words_count(self) -> None:
        self.assertEqual(self.run_tool("commands", "set", "inst").status, USAGE)

    def test_exact_phrase_is_shown_in_full(self) -> None:
        lines = self.list("add", "pin")
        self.assertEqual(lines[0], "Command:    ADD PIN")
        self.assertEqual(lines[1], "Arguments:  <component> <pin> <direction> [default]")
        self.assertEqual(len(lines), 4)

    def test_exact_phrase_without_arguments(self) -> None:
        self.assertEqual(self.list("noop")[:2], ["Command:    NOOP", "Arguments:  none"])

    def test_longer_phrases_follow_an_exact_one(self) -> None:
        lines = self.list("ADD", "COMPONENT")
        self.assertEqual(lines[0], "Command:    ADD COMPONENT")
        self.assertTrue(any(line.startswith("ADD COMPONENT PIN COMMENT ") for line in lines[4:]))

    def test_unknown_words(self) -> None:
        self.expect(self.run_tool("commands", "add", "nothing"), USAGE,
                    'orn-hdl: no command begins with "add nothing"; '
                    '"orn-hdl commands" lists them all\n')

    def test_page(self) -> None:
        lines = self.list("--markdown")
        self.assertTrue(lines[0].startswith("# "))
        rows = [line for line in lines if line.startswith("| `")]
        self.assertEqual(len(rows), 61)
        for row in rows:
            cells = row.replace("\\|", "").strip("|").split("|")
            self.assertEqual(len(cells), 3, row)

    def test_page_and_list_agree(self) -> None:
        rows = [line for line in self.list("--markdown") if line.startswith("| `")]
        for row, line in zip(rows, self.list()):
            phrase, arguments, text = (cell.strip().strip("`") for cell in
                                       row.replace("\\|", "\0").strip("|").split("|"))
            synopsis = f"{phrase} {arguments}".strip().replace("\0", "|")
            self.assertEqual(line[:len(synopsis)], synopsis)
            self.assertEqual(line[len(synopsis):].strip(), text.replace("\0", "|"))


if __name__ == "__main__":
    unittest.main()
