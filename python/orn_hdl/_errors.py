"""The exceptions of the package. All of them are an `Error`; most are also the exception of Python that
says the same, so that `except KeyError` finds a name that does not exist."""

from __future__ import annotations

import re
from typing import NamedTuple, Optional, Sequence, Tuple, Type


class Error(Exception):
    """Something that the library, or this package, refuses.

    `text` is the message as the library has it. `command` is the line of commands that failed, `file` and
    `line` the place in a file; each is None where there is none.
    """

    def __init__(self, text: str, *, command: Optional[str] = None, file: Optional[str] = None,
                 line: Optional[int] = None) -> None:
        super().__init__(text)
        self.text = text
        self.command = command
        self.file = file
        self.line = line

    def __str__(self) -> str:
        place = "" if self.file is None or self.line is None else f"{self.file}:{self.line}: "
        command = "" if self.command is None else f" [{self.command}]"
        return place + self.text + command


class NameTakenError(Error, ValueError):
    """A component, instance, signal or pin of that name exists."""


class NotFoundError(Error, KeyError):
    """There is nothing of that name."""

    __str__ = Error.__str__


class InvalidValueError(Error, ValueError):
    """A direction, a type, an option or a name is none that the library knows."""


class CommandSyntaxError(Error, ValueError):
    """A line begins with no known phrase, or its arguments are missing or wrong."""


class NetlistError(Error):
    """A netlist cannot be read. `column` is the place in the line, and None where there is none."""

    column: Optional[int] = None

    def __str__(self) -> str:
        # The text begins with the place.
        return self.text


class Difference(NamedTuple):
    """Where a netlist does not say what the design does."""

    message: str
    line: int
    column: int
    source: str


class ProofError(Error):
    """A written netlist does not mean what the design does; `differences` says where."""

    differences: Sequence[Difference] = ()


class LegalError(Error):
    """No legal netlist of the design can be written."""


class InexpressibleError(Error):
    """The design has something that no command can express."""


class DeletedError(Error, ReferenceError):
    """What an object of Python stands for has been removed from its design."""


class ClosedError(DeletedError):
    """The design, or its engine, has been closed."""


class BusyError(Error, RuntimeError):
    """Another thread is in a call to the same engine."""


class ChangedError(Error, RuntimeError):
    """The design was replaced during an iteration over it."""


_KINDS = {"gone": DeletedError, "closed": ClosedError, "busy": BusyError, "changed": ChangedError,
          "taken": NameTakenError, "netlist": NetlistError, "proof": ProofError}

# The first pattern that is found in a message of the library tells the class.
_MESSAGES: Sequence[Tuple[str, Type[Error]]] = [
    (r"already (defined|declared|has pin)", NameTakenError),
    (r"^No legal netlist", LegalError),
    (r"^No command can express", InexpressibleError),
    (r"^Command not find|: Invalid Arguments", CommandSyntaxError),
    (r"^Invalid ", InvalidValueError),
    (r"not found", NotFoundError),
]

_PLACE = re.compile(r":(\d+):(?:(\d+):)? error: ")


def _class_of(kind: str, text: str) -> Type[Error]:
    if kind in _KINDS:
        return _KINDS[kind]
    return next((error for pattern, error in _MESSAGES if re.search(pattern, text)), Error)


def make(kind: str, text: str, file: Optional[str], line: int, command: Optional[str],
         details: Optional[Sequence[Tuple[str, int, int, str]]]) -> BaseException:
    """The exception for what the extension reports."""
    text = text.rstrip("\n")
    if kind in ("index", "length"):
        return IndexError(text) if kind == "index" else ValueError(text)
    error = _class_of(kind, text)(text, command=command, file=file, line=line or None)
    if isinstance(error, NetlistError):
        place = _PLACE.search(text)
        error.line = int(place[1]) if place else None
        error.column = int(place[2]) if place and place[2] else None
    if isinstance(error, ProofError):
        error.differences = [Difference(*difference) for difference in details or ()]
    return error
