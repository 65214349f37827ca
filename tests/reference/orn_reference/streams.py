"""The output stream that indents lines and wraps them at eighty columns."""

from __future__ import annotations

from typing import Optional, Union

WIDTH = 80
INDENTATION = b"   "
CONTINUATION = 2 * INDENTATION
COMMENT_MARKS = (b"//", b"--", b"/*")

Piece = Union[bytes, int]


def _break_position(line: bytes) -> Optional[int]:
    """The last blank outside double quotes, else the last such comma, else the end; none
    within a literal.

    A quote behind a backslash ends a literal in VHDL and does not in Verilog: what either takes for
    a part of a literal is left whole.
    """
    found = {0x20: -1, 0x2C: -1}
    quoted = quoted_in_verilog = escaped = False
    for position, character in enumerate(line):
        if character == 0x22:
            quoted = not quoted
            if not escaped:
                quoted_in_verilog = not quoted_in_verilog
        elif not (quoted or quoted_in_verilog) and character in found:
            found[character] = position
        escaped = character == 0x5C and not escaped
    for position in found.values():
        if position >= 0:
            return position
    return None if quoted or quoted_in_verilog else len(line) - 1


class OutStream:
    """Collects what a file of the given name receives."""

    def __init__(self, file_name: bytes) -> None:
        self.file_name = file_name
        self._level = 0
        self._line = b""
        self._written: list[bytes] = []

    def indent(self) -> None:
        self._level += 1

    def unindent(self) -> None:
        self._level = max(0, self._level - 1)

    def put(self, *pieces: Piece) -> None:
        """Writes each piece by itself: a line can only be broken between two pieces."""
        for piece in pieces:
            self._put_text(b"%d" % piece if isinstance(piece, int) else piece)

    def end_line(self) -> None:
        self._put_text(b"\n")

    def put_line(self, *pieces: Piece) -> None:
        self.put(*pieces)
        self.end_line()

    def empty_line(self) -> None:
        """A line without indentation."""
        level = self._level
        self._level = 0
        self.end_line()
        self._level = level

    def spaces(self, count: int) -> None:
        self.put(b" " * count)

    def close(self) -> bytes:
        """Ends an open line and gives the whole text."""
        if self._line:
            self._break(len(self._line) - 1)
            self._line = b""
        return b"".join(self._written)

    def _put_text(self, text: bytes) -> None:
        while b"\n" in text:
            part, text = text.split(b"\n", 1)
            self._start_line()
            self._written.append(self._line + part + b"\n")
            self._line = b""
        if text:
            self._append(text)

    def _append(self, text: bytes) -> None:
        self._start_line()
        is_comment = any(mark in self._line for mark in COMMENT_MARKS)
        if not is_comment and len(self._line) + len(text) > WIDTH:
            position = _break_position(self._line)
            if position is not None:
                self._break(position)
        self._line += text

    def _start_line(self) -> None:
        if not self._line:
            self._line = INDENTATION * self._level

    def _break(self, position: int) -> None:
        self._written.append(self._line[: position + 1] + b"\n")
        rest = self._line[position + 1 :]
        self._line = INDENTATION * self._level + CONTINUATION + rest
