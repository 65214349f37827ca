"""The banner of comment lines that opens a netlist, and the masking of what is free in it."""

from __future__ import annotations

import os
import time

from .containment import on_one_line
from .options import Options
from .streams import OutStream
from .tokenizer import split

EMBLEM_LINES = 9
_LABELS = (b"Vendor: Halvex", b"Version : ", b"Application : ", b"Filename : ", b"Timestamp : ")
_FIRST_LABEL_LINE = 2
_VERSION_LABEL = 1
_TEXT_INDENTATION = b"    "
_FIRST_COLUMN = 6
_LAST_COLUMN = 79


def current_time() -> bytes:
    epoch = os.environ.get("SOURCE_DATE_EPOCH")
    moment = time.localtime() if epoch is None else time.gmtime(int(epoch))
    return time.strftime("%m/%d/%Y %H:%M:%S", moment).encode("ascii")


def write_header(out: OutStream, prefix: bytes, design_name: bytes, options: Options) -> None:
    def one_line(text: bytes) -> bytes:
        return on_one_line(text)

    out.put_line(prefix * 40)
    out.put_line(prefix, b" Copyright")
    out.put_line(prefix * 40)
    values = (b"", b"", one_line(options.application), one_line(out.file_name), current_time())
    for line in range(EMBLEM_LINES):
        label = line - _FIRST_LABEL_LINE
        if 0 <= label < len(_LABELS):
            out.put_line(prefix, b" " * 17, _LABELS[label], values[label])
        else:
            out.put_line(prefix)
    out.put_line(prefix, b"Command: ", one_line(options.command))
    out.put_line(prefix, b"Design Name: ", one_line(design_name))
    out.put_line(prefix, b"Device: ", one_line(options.device))
    out.put_line(prefix, b"Purpose:")
    _write_sentences(out, prefix, options.purpose)
    out.put_line(prefix, b"Reference")
    _write_sentences(out, prefix, options.reference)


def _write_sentences(out: OutStream, prefix: bytes, text: bytes) -> None:
    """Words as many as fit a line, a blank behind each; a line feed in a word ends the line."""
    out.put(prefix, _TEXT_INDENTATION)
    column = _FIRST_COLUMN
    for word in split(text, b" "):
        if len(word) + column + 1 > _LAST_COLUMN:
            out.put(b"\n", prefix, _TEXT_INDENTATION)
            column = _FIRST_COLUMN
        column = _write_word(out, prefix, word, column)
    out.end_line()


def _write_word(out: OutStream, prefix: bytes, word: bytes, column: int) -> int:
    if b"\n" not in word:
        out.put(on_one_line(word), b" ")
        return column + len(word) + 1
    first, *others = split(word, b"\n") or [b""]
    out.put(on_one_line(first), b"\n", prefix, _TEXT_INDENTATION)
    column = _FIRST_COLUMN
    for number, piece in enumerate(others):
        out.put(on_one_line(piece), b" ")
        column += len(piece) + 1
        if number + 1 < len(others):
            out.put(b"\n", prefix, _TEXT_INDENTATION)
            column = _FIRST_COLUMN
    return column


def mask_free_lines(text: bytes) -> bytes:
    """Replaces each banner's copyright wording, emblem art and version by fixed words.

    What stands behind the labels beside the emblem is kept.
    """
    lines = text.split(b"\n")
    for prefix in (b"//", b"--"):
        divider = prefix * 40
        for number, line in enumerate(lines):
            is_banner = line == divider and lines[number + 2 : number + 3] == [divider]
            if is_banner and lines[number + 1].startswith(prefix + b" "):
                lines[number + 1] = prefix + b" <copyright>"
                for offset in range(EMBLEM_LINES):
                    position = number + 3 + offset
                    if position < len(lines):
                        lines[position] = _mask_emblem_line(prefix, lines[position], offset)
    return b"\n".join(lines)


def _mask_emblem_line(prefix: bytes, line: bytes, offset: int) -> bytes:
    if not line.startswith(prefix):
        return line
    label = offset - _FIRST_LABEL_LINE
    if not 0 <= label < len(_LABELS):
        return prefix + b" <emblem>"
    position = line.find(_LABELS[label])
    if position < 0:
        return prefix + b" <emblem without " + _LABELS[label] + b">"
    shown = _LABELS[label] if label == _VERSION_LABEL else line[position:]
    return prefix + b" <emblem> " + shown
