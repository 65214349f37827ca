"""What a text names: a scalar, a bus, a bit, a compound; and the order of names."""

from __future__ import annotations

import re
from typing import NamedTuple, Optional

from .text import INT_MAX, atoi
from .tokenizer import split

MAX_EXPANDED_BITS = 1_048_576

_BRACKETS = bytes.maketrans(b"[{<]}>-", b"((()))" + b":")
_BASE = rb"[A-Za-z'_][A-Za-z0-9_]*"
_INTEGER = rb"[+-]?[0-9]+"
_BASE_NAME = re.compile(_BASE)
_BUS_NAME = re.compile(rb"(%s)\((%s):(%s)\)" % (_BASE, _INTEGER, _INTEGER))
_BIT_NAME = re.compile(rb"(%s)\((%s)\)" % (_BASE, _INTEGER))


class BusName(NamedTuple):
    """A bus name taken apart; the index texts as written and as 32-bit numbers."""

    base: bytes
    left_text: bytes
    right_text: bytes

    @property
    def left(self) -> int:
        return atoi(self.left_text)

    @property
    def right(self) -> int:
        return atoi(self.right_text)

    @property
    def width(self) -> int:
        return min(INT_MAX, abs(self.left - self.right) + 1)

    @property
    def is_down_to(self) -> bool:
        return self.left > self.right

    @property
    def range_text(self) -> bytes:
        return b"(" + self.left_text + b":" + self.right_text + b")"


class BitName(NamedTuple):
    base: bytes
    index_text: bytes


def normalize(name: bytes) -> bytes:
    return name.translate(_BRACKETS)


def is_base_name(name: bytes) -> bool:
    return _BASE_NAME.fullmatch(name) is not None


def parse_bus(name: bytes) -> Optional[BusName]:
    match = _BUS_NAME.fullmatch(name)
    return BusName(*match.groups()) if match else None


def parse_bit(name: bytes) -> Optional[BitName]:
    match = _BIT_NAME.fullmatch(name)
    return BitName(*match.groups()) if match else None


def is_bus(name: bytes) -> bool:
    return parse_bus(name) is not None


def is_bit(name: bytes) -> bool:
    return parse_bit(name) is not None


def compound_members(name: bytes) -> list[bytes]:
    return split(name, b",\\")


def is_compound(name: bytes) -> bool:
    members = compound_members(name)
    return len(members) > 1 and all(
        is_base_name(member) or is_bus(member) or is_bit(member) for member in members
    )


def bit_name(base: bytes, index: int) -> bytes:
    return b"%s(%d)" % (base, index)


def single_bit(name: bytes) -> Optional[bytes]:
    """The one bit of a bus name whose two indices agree."""
    bus = parse_bus(name)
    return bit_name(bus.base, bus.left) if bus and bus.left == bus.right else None


def expand_bus(name: bytes) -> Optional[list[bytes]]:
    """The bits of a bus name from left to right; None for other names and absurd widths."""
    bus = parse_bus(name)
    if bus is None or bus.width > MAX_EXPANDED_BITS:
        return None
    step = -1 if bus.left >= bus.right else 1
    return [bit_name(bus.base, index) for index in range(bus.left, bus.right + step, step)]


def slice_name(name: bytes, start: int, count: int) -> bytes:
    """The piece of a bus name that starts `start` bits from its left and spans `count` bits."""
    bus = parse_bus(name)
    if bus is None:
        return b"%s(%d:%d)" % (name, start, count)
    step = -1 if bus.is_down_to else 1
    left = bus.left + step * start
    return b"%s(%d:%d)" % (bus.base, left, left + step * (count - 1))


def base_name(name: bytes) -> bytes:
    """The part before the first parenthesis, unless the text lists several signals."""
    name = normalize(name)
    if b"(" in name and b")" in name and b"," not in name:
        return name[: name.index(b"(")]
    return name


def to_brackets(name: bytes) -> bytes:
    return name.replace(b"(", b"[").replace(b")", b"]")


def _digit_run(name: bytes, start: int) -> int:
    end = start
    while end < len(name) and 0x30 <= name[end] <= 0x39:
        end += 1
    return end - start


def compare_naturally(first: bytes, second: bytes) -> int:
    """Negative, zero or positive: U2 before U10, letters without case, digits after the rest."""
    first = first.upper()
    second = second.upper()
    position = 0
    while position < min(len(first), len(second)) and first[position] == second[position]:
        position += 1
    if position == len(first) or position == len(second):
        return len(first) - len(second)
    first_run = _digit_run(first, position)
    second_run = _digit_run(second, position)
    if first_run != second_run:
        return first_run - second_run
    return first[position] - second[position]
