"""Models of the gate-level cells of Yosys, made from their names.

The letters in the name of a flip-flop or latch tell the active levels of its inputs, and the value that
a reset sets: `$_DFFE_PN1P_` has a rising clock, a reset that is active at 0 and sets 1, and an enable
that is active at 1.
"""

from __future__ import annotations

from dataclasses import dataclass
from itertools import product

# Names that VHDL reserves get the number that the import gives them.
_RESERVED = {"AND", "NAND", "NOR", "NOT", "OR", "XNOR", "XOR"}

_FUNCTIONS = {
    "BUF": "A",
    "NOT": "not A",
    "AND": "A and B",
    "NAND": "A nand B",
    "OR": "A or B",
    "NOR": "A nor B",
    "XOR": "A xor B",
    "XNOR": "not (A xor B)",
    "ANDNOT": "A and not B",
    "ORNOT": "A or not B",
    "AOI3": "not ((A and B) or C)",
    "OAI3": "not ((A or B) and C)",
    "AOI4": "not ((A and B) or (C and D))",
    "OAI4": "not ((A or B) and (C or D))",
}

# The letters that follow a family's name: c, s, r, e, l are the active levels of clock, set, reset,
# enable and load, v is the value that the reset sets.
_FAMILIES = [
    ("SR", "sr"),
    ("DFF", "c"), ("DFFE", "ce"), ("DFF", "crv"), ("DFFE", "crve"),
    ("ALDFF", "cl"), ("ALDFFE", "cle"), ("DFFSR", "csr"), ("DFFSRE", "csre"),
    ("SDFF", "crv"), ("SDFFE", "crve"), ("SDFFCE", "crve"),
    ("DLATCH", "e"), ("DLATCH", "erv"), ("DLATCHSR", "esr"),
]

_PINS = {"c": "C", "s": "S", "r": "R", "e": "E", "l": "L"}
_INDENT = "   "


@dataclass(frozen=True)
class Cell:
    """A cell type with the letters of its name, by what they stand for."""
    family: str
    letters: tuple[tuple[str, str], ...] = ()

    @property
    def short(self) -> str:
        code = "".join(letter for _, letter in self.letters)
        return f"{self.family}_{code}" if code else self.family

    @property
    def yosys(self) -> str:
        return f"$_{self.short}_"

    @property
    def entity(self) -> str:
        return self.short + "_1" if self.short in _RESERVED else self.short


def cells() -> list[Cell]:
    """All gate-level cells that have a meaning in a simulation."""
    result = [Cell(name) for name in [*_FUNCTIONS, "MUX", "NMUX", "MUX4", "MUX8", "MUX16", "TBUF"]]
    for family, roles in _FAMILIES:
        choices = ["01" if role == "v" else "NP" for role in roles]
        result += [Cell(family, tuple(zip(roles, letters))) for letters in product(*choices)]
    return result


def _text(cell: Cell, inputs: list[str], output: str, comment: str, body: list[str]) -> str:
    generics, start = [], ""
    if output == "Q":
        generics = [f"{_INDENT}generic (", 2 * _INDENT + 'INIT : string := "U"', f"{_INDENT});"]
        start = """ := std_logic'value("'" & INIT & "'")"""
    ports = [f"{pin} : in std_logic;" for pin in inputs] + [f"{output} : out std_logic{start}"]
    lines = [f"-- {cell.yosys}: {comment}", "library ieee;", "use ieee.std_logic_1164.all;", "",
             f"entity {cell.entity} is", *generics, f"{_INDENT}port ("]
    lines += [2 * _INDENT + port for port in ports]
    lines += [f"{_INDENT});", f"end {cell.entity};", "",
              f"architecture model of {cell.entity} is", "begin"]
    lines += [_INDENT + line for line in body]
    return "\n".join([*lines, "end model;", ""])


def model(cell: Cell) -> str:
    """The entity and architecture of a cell."""
    if cell.family in _FUNCTIONS:
        function = _FUNCTIONS[cell.family]
        inputs = [pin for pin in "ABCD" if pin in function]
        return _text(cell, inputs, "Y", f"Y is {function}.", [f"Y <= {function};"])
    if cell.family == "TBUF":
        return _text(cell, ["A", "E"], "Y", "Y is A while E is 1, otherwise Z.",
                     ["Y <= A when E = '1' else 'Z' when E = '0' else 'X';"])
    if "MUX" in cell.family:
        return _multiplexer(cell)
    return _storage(cell)


def _multiplexer(cell: Cell) -> str:
    inverts = cell.family == "NMUX"
    count = 2 if inverts else int(cell.family.removeprefix("MUX") or 2)
    data = [chr(ord("A") + number) for number in range(count)]
    selects = [chr(ord("S") + number) for number in range((count - 1).bit_length())]
    body = []
    # An unknown select does not matter where both of its inputs agree.
    level = data
    for number, select in enumerate(selects):
        target = [f"{select}{pair}" for pair in range(len(level) // 2)]
        for pair, name in enumerate(target):
            low, high = level[2 * pair:2 * pair + 2]
            body += [f"{name} := 'X';", f"if {select} = '0' or {low} = {high} then",
                     f"{_INDENT}{name} := {low};", f"elsif {select} = '1' then",
                     f"{_INDENT}{name} := {high};", "end if;"]
        level = target
    names = [line.split(" ")[0] for line in body if line.endswith(":= 'X';")]
    process = [f"process ({', '.join(data + selects)})",
               f"{_INDENT}variable {', '.join(names)} : std_logic;", "begin",
               *(_INDENT + line for line in body),
               f"{_INDENT}Y <= {'not ' if inverts else ''}{level[0]};", "end process;"]
    numbers = "".join(reversed(selects))
    comment = (f"Y is input number {numbers}, counted from A" + (", inverted." if inverts else "."))
    return _text(cell, data + selects, "Y", comment, process)


def _level(letter: str) -> str:
    return "1" if letter == "P" else "0"


def _branches(conditions: list[tuple[str, list[str]]]) -> list[str]:
    """Statements, of which the first one holds whose condition is met."""
    lines: list[str] = []
    for number, (condition, body) in enumerate(conditions):
        # Only the last one may have no condition.
        lines.append(f"{'els' if number else ''}if {condition} then" if condition else "else")
        lines += [_INDENT + line for line in body]
    return [*lines, "end if;"]


def _storage(cell: Cell) -> str:
    """A latch or flip-flop: what is asynchronous goes first, then the clock, then the rest."""
    letters = dict(cell.letters)
    active = {role: f"{_PINS[role]} = '{_level(letter)}'"
              for role, letter in letters.items() if role in _PINS}
    is_clocked = "c" in letters
    reset = (active["r"], [f"Q <= '{letters.get('v', '0')}';"]) if "r" in letters else None
    enable = active.get("e")
    load: list[str] = ["Q <= D;"] if cell.family != "SR" else []
    is_synchronous = cell.family.startswith("SDFF")

    first: list[tuple[str, list[str]]] = []
    if reset and not is_synchronous:
        first.append(reset)
    if "s" in letters:
        first.append((active["s"], ["Q <= '1';"]))
    if "l" in letters:
        first.append((active["l"], ["Q <= AD;"]))
    if is_clocked:
        load = _clocked(cell.family, load, reset if is_synchronous else None, enable)
        edge = "rising_edge" if letters["c"] == "P" else "falling_edge"
        first.append((f"{edge}(C)", load))
    elif enable:
        first.append((enable, load))

    inputs = [_PINS[role] for role in letters if role in _PINS]
    data = ["AD"] * ("l" in letters) + ["D"] * (cell.family != "SR")
    waits = [pin for pin in inputs if not is_clocked or not (
        pin == "E" or pin == "R" and is_synchronous)]
    waits += [pin for pin in data if pin == "AD" or not is_clocked]
    process = [f"process ({', '.join(waits)})", "begin",
               *(_INDENT + line for line in _branches(first)), "end process;"]
    return _text(cell, inputs + data, "Q", _describe(cell), process)


def _clocked(family: str, load: list[str], reset: tuple[str, list[str]] | None,
             enable: str | None) -> list[str]:
    """What happens at the clock's edge."""
    if reset is None:
        return _branches([(enable, load)]) if enable else load
    if family == "SDFFCE":
        return _branches([(enable or "", _branches([reset, ("", load)]))])
    return _branches([reset, (enable or "", load)])


def _describe(cell: Cell) -> str:
    letters = dict(cell.letters)
    edge = {"P": "rising", "N": "falling"}.get(letters.get("c", ""), "")
    kind = f"flip-flop with a {edge} clock" if edge else "latch"
    names = {"s": "set", "e": "enable", "l": "load"}
    parts = []
    if "r" in letters:
        kept = "synchronous " if cell.family.startswith("SDFF") else ""
        parts.append(f"{kept}reset to {letters.get('v', '0')} at {_level(letters['r'])}")
    parts += [f"{name} at {_level(letters[role])}" for role, name in names.items()
              if role in letters]
    text = f"{kind}{', ' if parts else ''}{', '.join(parts)}"
    if cell.family == "SDFFCE":
        text += "; the reset needs the enable"
    return text + "."
