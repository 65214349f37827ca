#!/usr/bin/env python3
"""Writes a random command file; the same seed, kind and length give the same file."""

from __future__ import annotations

import argparse
import os
import random
from typing import Callable, Sequence

from orn_reference.commands import find_phrase, phrases, write_target
from orn_reference.tokenizer import split_command

DEFAULT_LINES = 150
KINDS = ("valid", "wild", "mixed")

LONG_NAME = "a_name_that_goes_on_for_quite_a_while_so_that_lines_wrap_soon"
COMPONENTS = ["AND2", "or3", "DFF", "RAM16", "MUX4", "IOBUF", "buf_" + LONG_NAME]
PINS = ["I0", "I1", "I10", "I2", "O", "CE", "q", "A", "DATA(3:0)", "B(0:3)", "ADDR(7:0)",
        "S(1)", "S(0)", "ONE(2:2)", "T[1:0]", "W<7-0>", "bidir_pin"]
INSTANCES = [f"U{number}" for number in (1, 2, 3, 9, 10, 11, 20)]
INSTANCES += ["u_core", "FF_9", "FF_10", "I_" + LONG_NAME]
SCALARS = ["CLK", "rst", "x", "Y", "z", "n_1", "N9", "N10", "net_a", "sel",
           LONG_NAME, "sig_DUMMY", "done"]
BUSES = ["D", "Q", "BUS_A", "addr", "data", "W1", "K", "bus_" + LONG_NAME]
RANGES = [(7, 0), (3, 0), (0, 7), (0, 3), (3, 3), (0, 0), (15, 8), (15, 0), (8, 15), (1, 0),
          (2, 1), (1, 2), (4, 7), (7, 4), (0, 15)]
DIRECTIONS = ["in", "Input", "I", "out", "OUTPUT", "o", "b", "bidir", "BiDirectional", "inp"]
ATTRIBUTES = ["LOC", "INIT", "init", "RLOC", "Level", "BOX_TYPE", "IOSTANDARD", "keep",
              "WIDTH", "an_attribute_with_a_rather_long_name", "A[1-0]"]
VALUES = {
    "String": ["P1", '"two words"', "'\"quoted\"'", "SLOW", '""', "HALVEX", "halvex", "a\rb",
               '"a, b, c and a text that is long enough to pass the border of the line, surely"'],
    "Integer": ["0", "12", "-7", "12abc", "99999999999", "+3"],
    "Float": ["5", "12.345", ".5", "3.14159", "-2.50", "1e3", "0x1p4", "1.", "abc"],
    "Boolean": ["true", "TRUE", "False", "1"],
    "Bit": ["0", "1", "x"],
    "BitVector": ["1010", "8:H:A5", "4:B:1010", "6:o:17", "8:x:FF", "4::1010", "H:A5"],
    "User": ["RED", '"user text"', '""', "3"],
}
CONSTANTS = ["0", "1", "1010", "00001111", "4:B:1010", "8:H:A5", "6:O:17", "1:B:1", "1'b0",
             "x", "101", "10", "FF"]
TEXTS = ["a comment", "a\rreturn", '"two  blanks"', "don't panic", '"a \\"quoted\\" word"', "end; // -- /*",
         "plain", '" lead"', "x" * 90, "many words that together are longer than one line of "
         "the file can be, so that something has to happen to them at the right border"]
LIBRARIES = ["mylib", "UNISIM", "a_library"]
USES = ["mylib.cells.ALL", "UNISIM.vcomponents.all"]
INCLUDES = ["cells.v", '"my cells.v"', "'\"deep/cells.v\"'", "very/" + "long/" * 18 + "path.v"]
SYNTHESIS = ["QSN", "exemplar", "SYNPLICITY", "Synopsys", "VERILOG2001", "PRECISION", "other"]
NETLISTS = ["top", "MHALVEX_ADD4", "HHALVEX_ADD4", "my-top", "TOP_" + LONG_NAME]
SIGNAL_WORDS = {"UPPERCASE": "siganl", "LOWERCASE": "signal"}
FLAGS = ["", "true", "false", "FALSE", "on"]

NASTY = [
    '""', "''", '"a b"', '"unclosed text', "it's", '"a\\"b"', '"a"b c"', "'single quoted'", "open",
    "OPEN", "Open", "A<3>", "A{3:0}", "D[3-0]", "D[7:0]", "D(-1:0)", "D(+3:0)", "D(+7:0)",
    "D(99999999999:0)", "W9(2000000:0),x", "W9(1500000:0)", "W9(0:1500000)",
    "Q(2147483647:-2147483648)", "Q(99999999999:99999999999)", "D((3:0)",
    "D(3:0))", "D(3:0)x", "D(3)x", ")(", ":", ",", "\\", "x,,Y", "x\\Y", ",x", "x,", "D(3),z",
    "D[3],z", "Q(3:0)\\K(2),x", "'x", "x'y", ".", "U1.", ".I0", "U1.I0.x", "U1.O", "-TYPE=",
    "-type=integer", "-TYPE=Nonsense", "-GENERIC=", "-generic=syn", "-SYNATTR=assign",
    "-SynAttr=x", "-APPEND", "-noheader", "%s%n%d", "caf\xe9", "\xff\xfe", "\xb5\xdf", "x\ty",
    "\t", "a\rb", "D(2000000:0)", "D(0:1500000)", "d(3)", "q(1:0)", "u1", "And2", "clk", "D", "Q",
    "D_DUMMY", "x_DUMMY", "Q_DUMMY(7:0)", "U1_I0_CONST_SIGNAL", "D(03:0)", "D(3:3)", "open,x",
    "a" * 79, "b" * 200, '"', "'", '"\\', "\\\"", "0", "-5", "false", "-", "<", "D<0>",
    "\"'tick\"", "\"'tick,x\"", "2bad", "a b", "A.B", "U(1)", "U(1)_x", "*",
    "x(", "x)", "x(1", "x:1)", "caf\xe9(3:0)",
]


def is_safe(line: bytes) -> bool:
    """False for a line that would write a file somewhere else or nowhere."""
    words = split_command(line.removesuffix(b"\r").split(b"\0", 1)[0])
    if find_phrase(words) not in (b"WRITE VERILOG", b"WRITE VHDL"):
        return True
    name = write_target(words)[0]
    return b"/" not in name and len(name) < 100 and name not in (b".", b"..")


def swap_case(text: str) -> str:
    """Of ASCII letters only, so that one byte stays one byte."""
    return text.encode("latin-1").swapcase().decode("latin-1")


class Generator:
    """Makes lines one by one and remembers, roughly, what they have declared."""

    def __init__(self, seed: int, kind: str) -> None:
        self._random = random.Random(f"{kind} {seed}")
        self._kind = kind
        self._components: dict[str, list[str]] = {}
        self._instances: dict[str, list[str]] = {}
        self._ranges: dict[str, tuple[int, int]] = {}
        self._signals: list[str] = []
        self._drivers: dict[str, list[str]] = {}  # output pins of each component
        self._attributes: dict[str, dict[str, str]] = {}
        self._lines: list[str] = []
        self._operations: list[tuple[int, Callable[[], None]]] = [
            (2, self._add_component),
            (3, self._add_pin),
            (8, self._add_instance),
            (3, self._add_port),
            (3, self._add_signal),
            (30, self._connect_pin),
            (12, self._connect_signals),
            (6, self._assign_to_signal),
            (4, self._assign_to_pin),
            (5, self._add_comment),
            (10, self._add_attribute),
            (1, self._mark_level),
            (1, self._share_output),
            (1, self._hand_init_down),
            (4, self._set_attribute_value),
            (2, self._set_user_type),
            (9, self._set_attribute_option),
            (6, self._set_option),
            (2, self._write),
        ]

    def file(self, lines: int) -> bytes:
        """The whole command file, about as many lines as wanted."""
        self._start()
        if self._kind == "valid" and self._chance(0.03):
            self._many_read_outputs()
        while len(self._lines) < lines:
            self._one_step()
        for language in self._random.sample(["VERILOG", "VHDL"], 2):
            self._write(language)
        return self._encoded()

    # Steps

    def _start(self) -> None:
        for _ in range(self._random.randint(0, 6)):
            self._set_option()
        for _ in range(self._random.randint(1, 4)):
            self._add_component()
        for _ in range(self._random.choice([0, 2, 4, 6, 8])):
            self._add_port()
        for _ in range(self._random.randint(0, 4)):
            self._add_signal()
        for _ in range(self._random.randint(1, 5)):
            self._add_instance()

    def _one_step(self) -> None:
        wildness = {"valid": 0.0, "mixed": 0.15, "wild": 0.6}[self._kind]
        if self._chance(wildness):
            choice = self._random.choice
            steps = [self._nonsense, self._nasty_arguments, self._mutated, self._mutated]
            choice(steps + [self._repeated])()
            return
        weights = [weight for weight, _ in self._operations]
        self._random.choices([step for _, step in self._operations], weights)[0]()

    def _encoded(self) -> bytes:
        ends = ["\n"] if self._kind == "valid" else self._random.choice([["\n"], ["\r\n", "\n"]])
        text = b""
        for line in self._lines:
            encoded = line.encode("latin-1")
            if is_safe(encoded):
                text += encoded + self._random.choice(ends).encode("latin-1")
        if self._kind != "valid" and self._chance(0.2):
            text = text.removesuffix(b"\n")
        return text

    def _chance(self, probability: float) -> bool:
        return self._random.random() < probability

    def _pick(self, items: Sequence[str]) -> str:
        return self._random.choice(items)

    def _emit(self, *words: str) -> None:
        """One line; the phrase in odd letter case now and then."""
        line = " ".join(word for word in words if word)
        if self._chance(0.05):
            phrase, *rest = line.split(" ", 2)
            line = " ".join([swap_case(phrase), *rest])
        if self._chance(0.02):
            line = "  " + line.replace(" ", "  ", 2) + " "
        self._lines.append(line)

    # Names

    def _fresh(self, pool: Sequence[str], used: object) -> str:
        free = [name for name in pool if name not in used]  # type: ignore[operator]
        return self._pick(free) if free else self._pick(pool) + str(self._random.randint(1, 999))

    def _bus(self) -> str:
        base = self._pick(BUSES)
        if base not in self._ranges:
            self._ranges[base] = self._random.choice(RANGES)
        left, right = self._ranges[base]
        return f"{base}({left}:{right})"

    def _slice(self) -> str:
        base = self._pick(list(self._ranges) or BUSES)
        if base not in self._ranges:
            return self._bus()
        left, right = self._ranges[base]
        low, high = min(left, right), max(left, right)
        first, second = (self._random.randint(low, high) for _ in range(2))
        if (first > second) != (left > right) and self._chance(0.7):
            first, second = second, first
        return f"{base}({first}:{second})"

    def _bit(self) -> str:
        base = self._pick(list(self._ranges) or BUSES)
        if base not in self._ranges:
            return self._bus()
        left, right = self._ranges[base]
        return f"{base}({self._random.randint(min(left, right), max(left, right))})"

    def _wider(self) -> str:
        base = self._pick(list(self._ranges) or BUSES)
        left, right = self._ranges.get(base, (3, 0))
        grow = self._random.randint(0, 4)
        left, right = (left + grow, right) if left >= right else (left, right + grow)
        if self._chance(0.15):
            left, right = right, left
        self._ranges[base] = (left, right)
        return f"{base}({left}:{right})"

    def _plain_reference(self) -> str:
        makers = [lambda: self._pick(SCALARS), self._bus, self._slice, self._bit]
        return self._random.choices(makers, [40, 15, 25, 20])[0]()

    def _reference(self) -> str:
        """A signal of any shape, perhaps one that comes to be by this use."""
        roll = self._random.random()
        if roll < 0.12:
            count = self._random.choice([2, 2, 3, 4, 9])
            separator = self._random.choice([",", ",", ",", "\\"])
            return separator.join(self._plain_reference() for _ in range(count))
        if roll < 0.15:
            return self._wider()
        if roll < 0.25 and self._signals:
            return self._pick(self._signals)
        if roll < 0.26:
            return self._pick(["open", "OPEN", "open,x"])
        if roll < 0.29 and self._kind != "valid":
            return self._generated_name()
        return self._plain_reference()

    def _generated_name(self) -> str:
        """A name that a constant, an open pin or a dummy has or will have, or one much like it."""
        if self._chance(0.5):
            word = self._pick(["CONST_SIGNAL", "openSignal"])
            instance, _, pin = self._terminal(self._instances).partition(".")
            base, parenthesis, rest = pin.partition("(")
            if parenthesis and self._chance(0.3):
                rest = "15:0)"
            return f"{instance}_{base}_{word}{parenthesis}{rest}"
        base, parenthesis, rest = self._reference().partition("(")
        return f"{base}_DUMMY{parenthesis}{rest}"

    def _terminal(self, owners: dict[str, list[str]]) -> str:
        with_pins = [name for name, pins in owners.items() if pins]
        if not with_pins:
            return "U1.I0"
        owner = self._pick(with_pins)
        return owner + "." + self._pick(owners[owner])

    def _text(self) -> str:
        return " ".join(self._pick(TEXTS) for _ in range(self._random.choice([1, 1, 1, 2, 3])))

    # Building

    def _add_component(self) -> None:
        name = self._fresh(COMPONENTS, self._components)
        self._components[name] = []
        self._emit("ADD COMPONENT", name)
        for _ in range(self._random.choice([0, 1, 2, 3, 3, 4, 5, 6])):
            self._add_pin_to(name)

    def _add_pin(self) -> None:
        if self._components:
            self._add_pin_to(self._pick(list(self._components)))

    def _add_pin_to(self, component: str) -> None:
        pin = self._fresh(PINS, self._components[component])
        self._components[component].append(pin)
        default = self._pick(CONSTANTS) if self._chance(0.1) else ""
        direction = self._pick(DIRECTIONS)
        if direction[0] in "oO":
            self._drivers.setdefault(component, []).append(pin)
        self._emit("ADD PIN", component, pin, direction, default)

    def _add_instance(self) -> None:
        if not self._components:
            return
        component = self._pick(list(self._components))
        name = self._fresh(INSTANCES, self._instances)
        self._instances[name] = list(self._components[component])
        self._emit("ADD INSTANCE", component, name)

    def _add_port(self) -> None:
        name = self._new_signal()
        if name:
            self._emit("ADD PORT", name, self._pick(DIRECTIONS))

    def _add_signal(self) -> None:
        name = self._new_signal()
        if name:
            direction = self._pick(DIRECTIONS) if self._chance(0.2) else ""
            self._emit("ADD SIGNAL", name, direction)

    def _new_signal(self) -> str:
        """A name that has not been declared, nor used before its declaration, or nothing."""
        used = " ".join(self._lines)
        if self._chance(0.5):
            free = [name for name in SCALARS if name not in used]
            name = self._pick(free) if free else ""
        else:
            buses = [base for base in BUSES if base not in self._ranges]
            if not buses:
                return ""
            base = self._pick(buses)
            left, right = self._ranges[base] = self._random.choice(RANGES)
            form = self._random.choice(["{}({}:{})", "{}({}:{})", "{}[{}-{}]", "{}<{}:{}>"])
            name = form.format(base, left, right)
        if name:
            self._signals.append(name)
        return name

    def _connect_pin(self) -> None:
        if not any(self._instances.values()):
            self._add_component()
            self._add_instance()
            return
        self._emit("CONNECT SIGNAL", self._reference(), self._terminal(self._instances))

    def _connect_signals(self) -> None:
        self._emit("CONNECT SIGNAL", self._reference(), self._reference())

    def _assign_to_signal(self) -> None:
        self._emit("ASSIGN CONSTANT", self._reference(), self._pick(CONSTANTS))

    def _assign_to_pin(self) -> None:
        if any(self._instances.values()):
            self._emit("ASSIGN CONSTANT", self._terminal(self._instances), self._pick(CONSTANTS))

    def _mark_level(self) -> None:
        if self._components:
            level = self._pick(["HALVEX", "halvex", "LEAF", ""])
            component = self._pick(list(self._components))
            self._emit("ADD COMPONENT ATTRIBUTE", component, "Level", level)

    def _share_output(self) -> None:
        """A new output port that several outputs drive and nothing reads."""
        component = self._pick(list(self._drivers) or [""])
        port = self._new_signal()
        if not component or not port:
            return
        self._emit("ADD PORT", port, "out")
        for _ in range(2):
            instance = self._fresh(INSTANCES, self._instances)
            self._instances[instance] = list(self._components[component])
            self._emit("ADD INSTANCE", component, instance)
            part = port if self._chance(0.6) else self._slice()
            pin = self._pick(self._drivers[component])
            self._emit("CONNECT SIGNAL", part, f"{instance}.{pin}")

    def _hand_init_down(self) -> None:
        """An INIT of the module and one of a part, as generics."""
        parts = [("COMPONENT", name) for name in self._components]
        parts += [("INSTANCE", name) for name in self._instances]
        for kind, owner in [("MODULE", ""), *(self._random.sample(parts, 1) if parts else [])]:
            self._emit("ADD", kind, "ATTRIBUTE", owner, "INIT", "ABCD")
            option = self._pick(["-GENERIC=SYN", "-GENERIC=SYN", "-GENERIC=NOSYN"])
            self._emit("SET", kind, "ATTRIBUTE OPTION", owner, "INIT", option)
        if self._chance(0.5):
            self._emit("SET NETLIST NAME", self._pick(["MHALVEX_ADD4", "HHALVEX_ADD4"]))

    def _many_read_outputs(self) -> None:
        """More output ports that are read than the table of their names first has room for."""
        self._emit("ADD COMPONENT READER")
        self._emit("ADD PIN READER I in")
        for number in range(self._random.randint(190, 420)):
            port = f"port_{self._random.randint(0, 10**6)}_{number}"
            self._emit("ADD PORT", port, "out")
            self._emit(f"ADD INSTANCE READER R{number}")
            self._emit(f"CONNECT SIGNAL {port} R{number}.I")

    # Comments, attributes, options, files

    def _add_comment(self) -> None:
        kind = self._random.choice(
            ["NOTES", "MODULE", "COMPONENT", "INSTANCE", "SIGNAL", "COMPONENT PIN", "INSTANCE PIN"]
        )
        if kind == "NOTES":
            self._emit("ADD NOTES", self._text())
        else:
            self._emit("ADD", kind, "COMMENT", self._owner(kind), self._text())

    def _owner(self, kind: str) -> str:
        if kind == "MODULE":
            return ""
        if kind.endswith("PIN"):
            component = kind.startswith("COMPONENT")
            return self._terminal(self._components if component else self._instances)
        pools = {
            "COMPONENT": list(self._components),
            "INSTANCE": list(self._instances),
            "SIGNAL": self._signals,
        }
        return self._pick(pools[kind] or ["nobody"])

    def _any_owner(self) -> tuple[str, str]:
        kinds = ["MODULE", "COMPONENT", "INSTANCE", "SIGNAL", "COMPONENT PIN", "INSTANCE PIN"]
        kind = self._random.choices(kinds, [5, 5, 6, 5, 1, 1])[0]
        return kind, self._owner(kind)

    def _add_attribute(self) -> None:
        kind, owner = self._any_owner()
        self._add_attribute_to(kind, owner)

    def _add_attribute_to(self, kind: str, owner: str) -> None:
        name = self._pick(ATTRIBUTES)
        type_name = self._pick(list(VALUES))
        option = f"-TYPE={type_name}"
        if self._chance(0.2):
            option = swap_case(option)
        if type_name == "String" and self._chance(0.7):
            option = ""
        value = self._pick(VALUES[type_name]) if self._chance(0.95) else ""
        self._attributes.setdefault(f"{kind} {owner}", {}).setdefault(name, type_name)
        self._emit("ADD", kind, "ATTRIBUTE", owner, option, name, value)

    def _known_attribute(self, wanted_type: str = "") -> tuple[str, str, str, str]:
        """Kind and name of an owner, one of its attributes and that one's type."""
        for _ in range(20):
            if not self._attributes:
                break
            key = self._pick(list(self._attributes))
            name = self._pick(list(self._attributes[key]))
            type_name = self._attributes[key][name]
            if wanted_type in ("", type_name):
                kind = next(
                    words
                    for words in ("COMPONENT PIN", "INSTANCE PIN", "MODULE", "COMPONENT",
                                  "INSTANCE", "SIGNAL")
                    if key.startswith(words + " ")
                )
                return kind, key[len(kind) + 1 :], name, type_name
        return "", "", "", ""

    def _set_attribute_value(self) -> None:
        kind, owner, name, type_name = self._known_attribute()
        if kind:
            value = self._pick([v for v in VALUES[type_name] if v != '""'])
            self._emit("SET", kind, "ATTRIBUTE VALUE", owner, name, value)

    def _set_user_type(self) -> None:
        kind, owner, name, _ = self._known_attribute("User")
        if kind:
            self._emit("SET", kind, "ATTRIBUTE USERTYPE", owner, name, "colour_t")

    def _set_attribute_option(self) -> None:
        kind, owner, name, _ = self._known_attribute()
        if not kind:
            return
        bad = [] if self._kind == "valid" else ["other", ""]
        options = ["-GENERIC=" + self._pick(["SYN", "NOSYN", "syn", "NONE", *bad]),
                   "-SYNATTR=" + self._pick(["ASSIGN", "assign", "ASSIGNNODEC", "NONE", *bad])]
        if self._chance(0.5):
            options = [self._pick(options)]
        if self._chance(0.1):
            options = options[:1] * 2
        self._emit("SET", kind, "ATTRIBUTE OPTION", owner, name, *options)

    def _set_option(self) -> None:
        case = self._pick(list(SIGNAL_WORDS))
        choices = [
            ("NOOP",),
            ("SET NETLIST NAME", self._pick(NETLISTS)),
            ("SET SOURCE FILE", "design.src"),
            ("ADD INCLUDE", self._pick(INCLUDES)),
            ("SET SYNTHESIS", self._pick(SYNTHESIS)),
            ("SET SYNTHESIS", self._pick(SYNTHESIS)),
            (case, self._pick(["instance", "component", SIGNAL_WORDS[case]])),
            ("FLATTEN BUS", self._pick(FLAGS)),
            ("SUPPRESS CONFIGURATION", self._pick(FLAGS)),
            ("SUPPRESS COMPONENT", self._pick(FLAGS)),
            ("USE DEFAULT LIBRARY", self._pick(FLAGS)),
            ("ADD LIBRARY", self._pick(LIBRARIES)),
            ("ADD USE LIBRARY", self._pick(USES)),
            ("SET PORT ONEPERLINE",),
            ("Use AttrType",),
            ("Set Application", self._pick(["Orn", '"An Application"'])),
            ("Set Command", self._text()),
            ("Set Device", "hx7-100"),
            ("Set Purpose", self._text()),
            ("Set Reference", self._text()),
            ("Set Open Pin", self._pick(FLAGS)),
        ]
        self._emit(*self._random.choice(choices))

    def _write(self, language: str = "") -> None:
        language = language or self._pick(["VERILOG", "VHDL"])
        extension = {"VERILOG": "v", "VHDL": "vhd"}[language]
        name = f"out{self._random.randint(1, 3)}.{extension}"
        options = ["-APPEND", "-append", "-NOHEADER", "-NoHeader", "-OVERWRITE"]
        chosen = self._random.sample(options, self._random.choice([0, 0, 1, 1, 2]))
        if self._chance(0.03):
            self._emit("WRITE", language, name, "-APPEND", "-NOHEADER", "more")
        self._emit("WRITE", language, *chosen, name)

    # Nonsense

    def _nonsense(self) -> None:
        roll = self._random.random()
        if roll < 0.3:
            count = self._random.randint(0, 12)
            self._lines.append("".join(self._pick(" AD\"'\\\t\0\r(:)x,") for _ in range(count)))
        elif roll < 0.6:
            self._lines.append(" ".join(self._pick(NASTY) for _ in range(3)))
        elif roll < 0.75:
            self._lines.append(self._pick(["", "   ", "# comment", "ADD", "ADD\tCOMPONENT x"]))
        else:
            phrase = self._pick(phrases()).decode("ascii")
            words = phrase.split(" ")
            self._lines.append(" ".join(words[: self._random.randint(1, len(words))]))

    def _nasty_arguments(self) -> None:
        """A phrase with words from everywhere behind it."""
        phrase = self._pick(phrases()).decode("ascii")
        pools: list[Sequence[str]] = [
            NASTY, NASTY, COMPONENTS, PINS, INSTANCES, SCALARS, DIRECTIONS, ATTRIBUTES,
            [self._terminal(self._instances), self._terminal(self._components)],
            [self._reference(), self._reference()],
        ]
        count = self._random.choice([0, 1, 1, 2, 2, 2, 3, 3, 4, 5])
        words = [self._pick(self._random.choice(pools)) for _ in range(count)]
        self._lines.append(" ".join([phrase, *words]))

    def _repeated(self) -> None:
        """An earlier line once more, perhaps in another letter case."""
        if self._lines:
            line = self._pick(self._lines)
            self._lines.append(swap_case(line) if self._chance(0.3) else line)

    def _mutated(self) -> None:
        """A sensible line with something wrong."""
        before = len(self._lines)
        weights = [weight for weight, _ in self._operations]
        self._random.choices([step for _, step in self._operations], weights)[0]()
        if len(self._lines) == before:
            return
        words = self._lines[-1].split(" ")
        position = self._random.randrange(len(words))
        word = words[position]
        roll = self._random.random()
        if roll < 0.12:
            del words[position]
        elif roll < 0.2:
            words.insert(position, word)
        elif roll < 0.4:
            words[position] = self._pick(NASTY)
        elif roll < 0.5:
            words[position] = swap_case(word)
        elif roll < 0.6:
            brackets = self._pick(["[-]", "<:>", "{-}"])
            words[position] = word.translate(str.maketrans("(:)", brackets))
        elif roll < 0.7:
            words[position] = word.replace("(", self._pick(["((", "(+", "(-", ""]))
        elif roll < 0.8:
            words[position] = self._pick(["\"{}\"", "'{}'", "\"{}", "{}\"", "\"{}\"x"]).format(word)
        elif roll < 0.9:
            cut = self._random.randint(0, len(word))
            inserted = self._pick(["\t", "\r", "\0", '"', "'", "\\", "\xe9", ".", ",", "-", "_"])
            words[position] = word[:cut] + inserted + word[cut:]
        else:
            words[position] = word + self._pick(["y" * 70, "Z" * 300, "(3:0)", "(2)", "_DUMMY"])
        self._lines[-1] = " ".join(words)


def generate(seed: int, kind: str, lines: int) -> bytes:
    return Generator(seed, kind).file(lines)


def main() -> None:
    parser = argparse.ArgumentParser(description=__doc__)
    parser.add_argument("--seed", type=int, required=True)
    parser.add_argument("--lines", type=int, default=DEFAULT_LINES)
    parser.add_argument("--kind", choices=KINDS, default="mixed")
    parser.add_argument("-o", dest="output", required=True, type=os.fsencode)
    arguments = parser.parse_args()
    with open(arguments.output, "wb") as file:
        file.write(generate(arguments.seed, arguments.kind, arguments.lines))


if __name__ == "__main__":
    main()
