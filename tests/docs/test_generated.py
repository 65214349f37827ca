"""The generated files are current, and do what they are for on the example command files.

Environment: ORN_HDL_TOOL names the tool.
"""

from __future__ import annotations

import json
import os
import re
import shutil
import subprocess
import sys
import tempfile
import unittest
from pathlib import Path

PROJECT = Path(__file__).resolve().parents[2]
TOOL = Path(os.environ["ORN_HDL_TOOL"])
SHARE = PROJECT / "share"
# One example uses a phrase that its program adds.
EXAMPLES = sorted(set((PROJECT / "examples").rglob("*.cmd")) -
                  {PROJECT / "examples" / "embed" / "chain.cmd"})
ODD = 'noop a "note\nadd pin INV I input\nADD PINS x\nset purpose "one word" two\'s 8:h:a5 "open\n'


def run(*command: str | Path, **options) -> str:
    done = subprocess.run([str(word) for word in command], capture_output=True, text=True,
                          **options)
    if done.returncode != 0:
        raise AssertionError(f"{command[0]}: {done.returncode}\n{done.stdout}{done.stderr}")
    return done.stdout


def options_of(command: str) -> list[str]:
    """The options that the help of one of the tool's commands names."""
    found = re.findall(r"^  ((?:-\w\b,?)?(?:--[\w-]+,?)*)", run(TOOL, command, "--help"), re.M)
    options = sorted({name for names in found for name in names.split(",") if name})
    if "--help" not in options:
        raise AssertionError(f"the help of {command} is not understood")
    return options


class Current(unittest.TestCase):
    def test_files_are_what_the_tool_says(self) -> None:
        run(sys.executable, SHARE / "generator", "--check", TOOL)


class Grammar:
    """As much of a TextMate grammar as plain `match` patterns need."""

    def __init__(self, file: Path) -> None:
        patterns = json.loads(file.read_text())["patterns"]
        self.patterns = [(entry["name"].rsplit(".", 1)[0], re.compile(entry["match"]))
                         for entry in patterns]

    def tokens(self, line: str) -> list[tuple[str, str]]:
        """The earliest match at each step; of several the first pattern's."""
        position, found = 0, []
        while position <= len(line):
            matches = [(match.start(), order, name, match)
                       for order, (name, pattern) in enumerate(self.patterns)
                       if (match := pattern.search(line, position)) and match.end() > match.start()]
            if not matches:
                break
            _, _, name, match = min(matches, key=lambda entry: entry[:2])
            found.append((name, match.group()))
            position = match.end()
        return found


class TextMate(unittest.TestCase):
    grammar = Grammar(SHARE / "orn-hdl" / "orn-hdl.tmLanguage.json")

    def test_every_line_of_the_examples_begins_with_a_phrase(self) -> None:
        self.assertTrue(EXAMPLES)
        for file in EXAMPLES:
            for number, line in enumerate(file.read_text().splitlines(), 1):
                names = [name for name, _ in self.grammar.tokens(line)]
                with self.subTest(f"{file.name}:{number}"):
                    self.assertIn(names[0] if line.strip() else "comment.line",
                                  ("comment.line", "keyword.control"))
                    self.assertNotIn("invalid.illegal", names)

    def test_words_get_their_kind(self) -> None:
        lines = [self.grammar.tokens(line) for line in ODD.splitlines()]
        self.assertEqual(lines, [
            [("comment.line", 'noop a "note')],
            [("keyword.control", "add pin"), ("constant.language", "input")],
            [("invalid.illegal", "ADD PINS x")],
            [("keyword.control", "set purpose"), ("string.quoted.double", '"one word"'),
             ("constant.numeric", "8:h:a5")]])


@unittest.skipUnless(shutil.which("vim"), "vim is not installed")
class Vim(unittest.TestCase):
    def kinds(self, file: Path) -> list[list[str]]:
        """Of each line, the syntax groups that its characters belong to, in order."""
        script = r"""
            let found = []
            for number in range(1, line('$'))
              let groups = []
              for column in range(1, strlen(getline(number)))
                let group = synIDattr(synID(number, column, 1), 'name')
                if group != '' && (groups == [] || groups[-1] != group)
                  call add(groups, group)
                endif
              endfor
              call add(found, join(groups))
            endfor
            call writefile(found, $FOUND)
            qall!
        """
        with tempfile.TemporaryDirectory() as folder:
            commands = Path(folder, "look.vim")
            commands.write_text(script)
            found = Path(folder, "found")
            runtime = SHARE / "vim" / "vimfiles"
            run("vim", "-Nes", "-u", "NONE", "-i", "NONE",
                "--cmd", f"set runtimepath^={runtime} noswapfile", "--cmd", "filetype on",
                "--cmd", "syntax on", file, "-S", commands,
                env={**os.environ, "FOUND": str(found), "TERM": "dumb"}, timeout=300)
            return [line.split() for line in found.read_text().splitlines()]

    def test_examples_are_detected_and_begin_with_phrases(self) -> None:
        for file in EXAMPLES:
            lines = file.read_text().splitlines()
            kinds = self.kinds(file)
            self.assertEqual(len(kinds), len(lines))
            for number, (line, groups) in enumerate(zip(lines, kinds), 1):
                with self.subTest(f"{file.name}:{number}"):
                    self.assertIn(groups[0] if line.strip() else "ornHdlNote",
                                  ("ornHdlNote", "ornHdlPhrase"))
                    self.assertNotIn("ornHdlUnknown", groups)

    def test_words_get_their_kind(self) -> None:
        with tempfile.TemporaryDirectory() as folder:
            file = Path(folder, "odd.cmd")
            file.write_text(ODD)
            self.assertEqual(self.kinds(file), [
                ["ornHdlNote"], ["ornHdlPhrase", "ornHdlChoice"], ["ornHdlUnknown"],
                ["ornHdlPhrase", "ornHdlString", "ornHdlNumber"]])


class Bash(unittest.TestCase):
    def complete(self, *words: str, folder: str | None = None) -> list[str]:
        quoted = " ".join(f"'{word}'" for word in words)
        script = f"""
            compopt() {{ :; }}
            source '{SHARE}/bash-completion/completions/orn-hdl'
            COMP_WORDS=(orn-hdl {quoted}) COMP_CWORD={len(words)}
            _orn_hdl
            printf '%s\\n' "${{COMPREPLY[@]}}"
        """
        return sorted(set(run("bash", "-c", script, cwd=folder).split()))

    def test_commands_and_options(self) -> None:
        self.assertEqual(self.complete("co"), ["commands"])
        self.assertEqual(self.complete("run", "--v"), ["--verify", "--verilog", "--vhdl"])
        self.assertEqual(self.complete("run", "--model", ""), [])
        self.assertEqual(self.complete("import", "--x-as", ""), ["-", "0", "1"])
        self.assertEqual(self.complete("unknown", ""), [])
        self.assertEqual(self.complete("help", "dr"), ["draw"])

    def test_every_option_of_every_command(self) -> None:
        for command in ("run", "import", "check", "draw", "commands"):
            with self.subTest(command):
                self.assertEqual(self.complete(command, "-"), options_of(command))

    def test_words_of_the_language(self) -> None:
        self.assertEqual(self.complete("commands", "a"), ["ADD", "ASSIGN"])
        self.assertEqual(self.complete("commands", "write", ""), ["VERILOG", "VHDL"])
        self.assertEqual(self.complete("commands", "ADD", "component", "P"), ["PIN"])

    def test_files(self) -> None:
        with tempfile.TemporaryDirectory() as folder:
            Path(folder, "top.cmd").touch()
            self.assertEqual(self.complete("run", "t", folder=folder), ["top.cmd"])
            self.assertEqual(self.complete("run", "--verilog", "t", folder=folder), ["top.cmd"])


@unittest.skipUnless(shutil.which("zsh"), "zsh is not installed")
class Zsh(unittest.TestCase):
    def words(self, *given: str) -> list[str]:
        """What follows the words of `orn-hdl commands`, and what is typed of the next one."""
        script = f"""
            _arguments() {{ return 0; }}
            compadd() {{ print -l ${{(P)@[-1]}}; }}
            source {SHARE}/zsh/_orn-hdl
            words=(commands {' '.join(given)} '') CURRENT={len(given) + 2}
            _orn_hdl_words
        """
        return sorted(set(run("zsh", "-fc", script).split()))

    def test_words_of_the_language(self) -> None:
        self.assertIn("ADD", self.words())
        self.assertEqual(self.words("write"), ["VERILOG", "VHDL"])
        self.assertEqual(self.words("ADD", "component"), ["ATTRIBUTE", "COMMENT", "PIN"])

    def test_every_option_of_every_command(self) -> None:
        script = (SHARE / "zsh" / "_orn-hdl").read_text()
        for command in ("run", "import", "check", "draw", "commands"):
            branch = re.search(rf"^ +{command}\) _arguments(.*?);;$", script, re.M | re.S)[1]
            named = sorted(re.findall(r"'(?:\(.*?\))?(--?[\w-]+)\[", branch))
            with self.subTest(command):
                self.assertEqual(named, options_of(command))

    def test_syntax(self) -> None:
        run("zsh", "-n", SHARE / "zsh" / "_orn-hdl")


class Manuals(unittest.TestCase):
    def test_pages_name_every_phrase(self) -> None:
        page = (SHARE / "man" / "man5" / "orn-hdl.5").read_text().upper()
        phrases = [line.split("  ")[0] for line in run(TOOL, "commands").splitlines()]
        self.assertEqual(len(phrases), 61)
        for phrase in phrases:
            words = re.split(r" [<\[]", phrase)[0].upper()
            with self.subTest(words):
                self.assertIn(f"\\FB{words}\\FR", page)

    @unittest.skipUnless(shutil.which("man"), "man is not installed")
    def test_pages_are_set_without_warnings(self) -> None:
        for page in (SHARE / "man").rglob("orn-hdl.*"):
            done = subprocess.run(["man", "--warnings", "-E", "UTF-8", "-l", "-Tutf8", "-Z", page],
                                  capture_output=True, text=True,
                                  env={**os.environ, "MANWIDTH": "80"})
            self.assertEqual((done.returncode, done.stderr), (0, ""), page.name)


if __name__ == "__main__":
    unittest.main()
