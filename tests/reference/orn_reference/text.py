"""Letter case, numbers and quotes: the small text rules that everything else uses.

All text is bytes, so that any byte value works; `bytes.upper` knows ASCII letters only.
"""

from __future__ import annotations

import math
import re

INT_MIN = -(2**31)
INT_MAX = 2**31 - 1

_ATOI = re.compile(rb"[ \t\n\v\f\r]*([+-]?)([0-9]*)")
_DECIMAL = re.compile(rb"[+-]?([0-9]+\.?[0-9]*|\.[0-9]+)([eE][+-]?[0-9]+)?")
_HEXADECIMAL = re.compile(
    rb"[+-]?0[xX]([0-9A-Fa-f]+\.?[0-9A-Fa-f]*|\.[0-9A-Fa-f]+)([pP][+-]?[0-9]+)?"
)


def equal_ignoring_case(first: bytes, second: bytes) -> bool:
    return first.upper() == second.upper()


def _saturate(sign: bytes, digits: bytes) -> int:
    """The 32-bit number of a sign and decimal digits (perhaps thousands of them)."""
    digits = digits.lstrip(b"0")
    value = int(digits) if 0 < len(digits) <= 10 else (2**40 if digits else 0)
    return max(INT_MIN, -value) if sign == b"-" else min(INT_MAX, value)


def atoi(text: bytes) -> int:
    """The number at the start of the text; 0 without one; saturates."""
    match = _ATOI.match(text)
    assert match is not None
    return _saturate(match.group(1), match.group(2))


def atof(text: bytes) -> float:
    """The floating-point number at the start of the text; 0.0 without a finite one."""
    text = text.lstrip(b" \t\n\v\f\r")
    hexadecimal = _HEXADECIMAL.match(text)
    if hexadecimal is not None:
        try:
            return float.fromhex(hexadecimal.group().decode("ascii"))
        except OverflowError:
            return 0.0
    decimal = _DECIMAL.match(text)
    if decimal is None:
        return 0.0
    value = float(decimal.group())
    return value if math.isfinite(value) else 0.0


def remove_quotes(text: bytes) -> bytes:
    """Double quotes off both ends if they stand at both; otherwise single quotes, if they do."""
    for quote in (b'"', b"'"):
        if text.startswith(quote) and text.endswith(quote):
            return text.strip(quote)
    return text
