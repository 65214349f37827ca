#!/usr/bin/env python3
"""Compares what a built library exports with the list that is checked in.

A name that vanished breaks programs that were linked before: it asks for a new SOVERSION. A new
name must be kept from then on. Either way the change is acknowledged by writing the list anew, from
a release build by g++:

    packaging/symbols.py --update build/release/libOrn_Hdl.so
"""

from __future__ import annotations

import argparse
import difflib
import re
import subprocess
import sys
from pathlib import Path

LIST = Path(__file__).with_name("symbols.txt")
VERSION_NODE = re.compile(r"@@?ORN_HDL_(C_)?\d+$")


def exported_symbols(library: Path) -> list[str]:
    """The exported names as C++ spells them, sorted, each once."""
    command = ["nm", "--dynamic", "--defined-only", "--demangle", str(library)]
    listing = subprocess.run(command, check=True, capture_output=True, text=True).stdout
    names = set()
    for line in listing.splitlines():
        _address, kind, name = line.split(maxsplit=2)
        if kind != "A":
            names.add(VERSION_NODE.sub("", name))
    return sorted(names)


def main() -> int:
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("library", type=Path)
    parser.add_argument("--update", action="store_true", help="write the list anew")
    arguments = parser.parse_args()

    present = exported_symbols(arguments.library)
    if arguments.update:
        LIST.write_text("\n".join(present) + "\n", encoding="ascii")
    listed = LIST.read_text(encoding="ascii").splitlines()
    difference = list(difflib.unified_diff(listed, present, "symbols.txt", arguments.library.name,
                                           lineterm="", n=0))
    print("\n".join(difference + [f"symbols: {len(present)} exported, {len(listed)} listed"]))
    if difference:
        print("symbols: acknowledge the change with packaging/symbols.py --update LIBRARY",
              file=sys.stderr)
        return 1
    return 0


if __name__ == "__main__":
    raise SystemExit(main())
