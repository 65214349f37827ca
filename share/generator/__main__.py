"""Writes everything that is made from the command table, and the models of cells, or checks that it is
current.

python3 share/generator [--check] TOOL
"""

from __future__ import annotations

import argparse
import re
from datetime import datetime
from email.utils import parsedate_to_datetime
from pathlib import Path

import cells
import completions
import editors
import manuals
from language import read_language

PROJECT = Path(__file__).resolve().parents[2]


def release_date() -> str:
    """The day of the present release, from the packages' change log."""
    changes = (PROJECT / "packaging" / "changelog").read_text(encoding="utf-8")
    stamp: datetime = parsedate_to_datetime(re.search(r"^ -- .*>  (.*)$", changes, re.M).group(1))
    return stamp.strftime("%Y-%m-%d")


def with_table(readme: str, page: str) -> str:
    """The README with the page's table in the place of its own."""
    table = re.compile(r"^\| Command \|.*?(?=^$)", re.M | re.S)
    return table.sub(lambda _: table.search(page + "\n").group(), readme)


def generate(tool: Path) -> dict[str, str]:
    """The text of every generated file, by its name in the project."""
    language = read_language(tool)
    date = release_date()
    return {
        "docs/commands.md": language.page,
        "README.md": with_table((PROJECT / "README.md").read_text(encoding="utf-8"), language.page),
        "share/man/man1/orn-hdl.1": manuals.tool_page(language, date),
        "share/man/man5/orn-hdl.5": manuals.language_page(language, date),
        "share/bash-completion/completions/orn-hdl": completions.bash(language),
        "share/zsh/_orn-hdl": completions.zsh(language),
        "share/vim/vimfiles/syntax/orn-hdl.vim": editors.vim_syntax(language),
        "share/vim/vimfiles/ftdetect/orn-hdl.vim": editors.vim_detect(language),
        "share/orn-hdl/orn-hdl.tmLanguage.json": editors.textmate(language),
        **cells.files(),
    }


def main() -> int:
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("--check", action="store_true", help="write nothing; fail when one differs")
    parser.add_argument("tool", type=Path)
    arguments = parser.parse_args()
    texts = generate(arguments.tool.resolve())
    stale = []
    for name, text in texts.items():
        file = PROJECT / name
        if not file.exists() or file.read_text(encoding="utf-8") != text:
            stale.append(name)
            if not arguments.check:
                file.parent.mkdir(parents=True, exist_ok=True)
                file.write_text(text, encoding="utf-8")
    for name in stale:
        print(f"{'not current' if arguments.check else 'written'}: {name}")
    print(f"generator: {len(texts)} files, {len(texts) - len(stale)} current")
    return 1 if stale and arguments.check else 0


if __name__ == "__main__":
    raise SystemExit(main())
