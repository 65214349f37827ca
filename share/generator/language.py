"""What the tool says of itself: the command language and its own options."""

from __future__ import annotations

import re
import subprocess
from dataclasses import dataclass
from pathlib import Path


@dataclass(frozen=True)
class Command:
    """One phrase of the command language."""

    phrase: str
    arguments: str
    help: str


@dataclass(frozen=True)
class Option:
    """An option of the tool or, without a dash, an argument; `value` names what follows it."""

    names: tuple[str, ...]
    value: str
    help: str


@dataclass(frozen=True)
class Subcommand:
    """One command of the tool."""

    name: str
    help: str
    usage: str
    arguments: tuple[Option, ...]
    options: tuple[Option, ...]
    footer: str


@dataclass(frozen=True)
class Language:
    """All that the generated files are made of."""

    version: str
    description: str
    page: str
    introduction: str
    commands: tuple[Command, ...]
    subcommands: tuple[Subcommand, ...]

    @property
    def first_words(self) -> list[str]:
        return sorted({command.phrase.split()[0].upper() for command in self.commands})

    @property
    def option_words(self) -> list[str]:
        """The words of commands that begin with a dash, such as -NOHEADER and -TYPE=."""
        texts = " ".join(f"{command.arguments} {command.help}" for command in self.commands)
        return sorted(set(re.findall(r"-[A-Z]{2,}=?", texts)))

    @property
    def choices(self) -> list[str]:
        """The plain words that a command offers as arguments, such as true and false."""
        texts = re.findall(r"[\[<]([a-z]+(?:\|[a-z]+)+)[\]>]",
                           " ".join(command.arguments for command in self.commands))
        return sorted({word for text in texts for word in text.split("|")})


def read_language(tool: Path) -> Language:
    def ask(*words: str) -> str:
        return subprocess.run([tool, *words], check=True, capture_output=True, text=True).stdout

    page = ask("commands", "--markdown")
    help_text = ask("--help")
    described = re.findall(r"^  (\w+) +(.+)$", help_text.partition("\nSubcommands:\n")[2], re.M)
    return Language(
        version=ask("--version").split()[1],
        description=help_text.splitlines()[0],
        page=page,
        introduction=page.partition("\n\n")[2].partition("\n\n|")[0],
        commands=tuple(_read_table(page)),
        subcommands=tuple(_read_subcommand(name, help_line, ask(name, "--help"))
                          for name, help_line in described))


def _read_table(page: str) -> list[Command]:
    rows = [line for line in page.splitlines() if line.startswith("| `")]
    commands = []
    for row in rows:
        cells = re.split(r"(?<!\\)\|", row.removesuffix(" |"), maxsplit=3)[1:]
        phrase, arguments, help_text = (cell.strip(" `").replace("\\|", "|") for cell in cells)
        commands.append(Command(phrase, arguments, help_text))
    return commands


def _read_subcommand(name: str, help_line: str, text: str) -> Subcommand:
    usage = re.search(r"^Usage: (.*)$", text, re.M).group(1)
    sections = re.split(r"^(Positionals|Options):\n", text, flags=re.M)
    found = dict(zip(sections[1::2], sections[2::2]))
    footer = " ".join(line for line in sections[-1].splitlines() if line and line[0] != " ")
    return Subcommand(name, help_line, usage, tuple(_read_options(found.get("Positionals", ""))),
                      tuple(_read_options(found.get("Options", ""))), footer)


def _read_options(section: str) -> list[Option]:
    # An option that leaves no room for its help has it on the next line.
    section = re.sub(r"\n {10,}", "  ", section)
    options = []
    for left, help_text in re.findall(r"^  (\S.*?) {2,}(\S.*)$", section, re.M):
        left = re.sub(r" (REQUIRED|\(Env:\w+\)|(Needs|Excludes): \S+)", "", left)
        names, _, value = left.partition(" ")
        if value.endswith(" ..."):
            names, value = f"{names}...", ""
        options.append(Option(tuple(names.split(",")), value.partition(":")[0], help_text))
    return options
