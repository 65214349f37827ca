#!/usr/bin/env python3
"""Shows a header to Doxygen as people read it.

The comment of a function speaks for its overloads right below, too: Doxygen gets it once more for
each of them, on the same line, so that line numbers stay. Copy constructors and assignments that
have no comment do what is said of their class and are left out.
"""

from __future__ import annotations

import re
import sys

COMMENT = re.compile(r"^( *)///(?! \\file| \\[{}])(.*)$")
# Indentation, a type, a name; a constructor has no type.
FUNCTION = re.compile(r"^( *)(?!friend|explicit)[\w:<>*&, ]*[\w>*&] *[ *&](\w+|operator\S+)\(")
COPY = re.compile(r"^ *(\w+)(?:\(const \1&(?: \w+)?\)|& operator=\(const \1&(?: \w+)?\))"
                  r"(?: noexcept)?(?: = \w+)?;")


def filtered(lines: list[str]) -> list[str]:
    result = []
    comment: list[str] = []
    described: tuple[str, str] | None = None
    for line in lines:
        found = FUNCTION.match(line)
        function = (found[1], found[2]) if found else None
        if found := COMMENT.match(line):
            comment = ([] if described else comment) + [found[2].strip()]
            described = None
        elif not line.strip():
            comment, described = [], None
        elif comment and not described:
            described = function or ("", "")
        elif COPY.match(line):
            line = "\n"
        elif function and function == described:
            line = f"{function[0]}/** {' '.join(comment)} */ {line.lstrip()}"
        elif function and described and function[0] == described[0]:
            comment, described = [], None
        result.append(line)
    return result


if __name__ == "__main__":
    with open(sys.argv[1], encoding="utf-8") as header:
        sys.stdout.writelines(filtered(header.readlines()))
