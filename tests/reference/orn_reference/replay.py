"""Replaying a command file the way the command-line tool does."""

from __future__ import annotations

import os
from dataclasses import dataclass, field
from typing import Iterator, Optional

from .commands import execute, write_netlist
from .model import HdlError, Model

OK, COMMAND_FAILED, USAGE_ERROR, FILE_ERROR = 0, 1, 2, 3


@dataclass
class Outcome:
    status: int = OK
    messages: list[bytes] = field(default_factory=list)


def lines_of(content: bytes) -> Iterator[bytes]:
    """The commands of a file: no line ends, nothing from a NUL byte on."""
    lines = content.split(b"\n")
    if lines[-1] == b"":
        lines.pop()
    for line in lines:
        yield line.removesuffix(b"\r").split(b"\0", 1)[0]


def default_model_name(file_name: bytes) -> bytes:
    """The file's name without folder and extension."""
    return os.path.splitext(os.path.basename(file_name))[0]


def replay(
    file_name: bytes,
    model_name: Optional[bytes] = None,
    verilog: Optional[bytes] = None,
    vhdl: Optional[bytes] = None,
    header: bool = True,
    keep_going: bool = False,
) -> Outcome:
    outcome = Outcome()
    try:
        with open(file_name, "rb") as file:
            content = file.read()
    except OSError as error:
        return Outcome(FILE_ERROR, [_file_message(file_name, error)])
    model = Model(default_model_name(file_name) if model_name is None else model_name)
    model.source_file_name = file_name
    for number, line in enumerate(lines_of(content), start=1):
        try:
            execute(model, line)
        except HdlError as error:
            text = error.description.removesuffix(b"\n")
            outcome.messages.append(b"%s:%d: error: %s" % (file_name, number, text))
            outcome.status = COMMAND_FAILED
            if not keep_going:
                break
    if outcome.status == OK or keep_going:
        for language, name in (("verilog", verilog), ("vhdl", vhdl)):
            if name is not None:
                write_netlist(model, language, name, append=False, header=header)
    if model.file_errors:
        outcome.status = FILE_ERROR
        outcome.messages += [_file_message(name, error) for name, error in model.file_errors]
    return outcome


def _file_message(name: bytes, error: OSError) -> bytes:
    return b"%s: error: %s" % (name, os.fsencode(error.strerror or "unknown error"))
