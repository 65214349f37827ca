"""Texts that a line end would let leave their comment or literal."""

from __future__ import annotations

import re

_LINE_END = re.compile(rb"[\n-\r]")


def on_one_line(text: bytes, instead: bytes = b" ") -> bytes:
    return _LINE_END.sub(instead, text)
