"""Random designs as command files, together with what they must be wired to.

A design is valid: every bit has at most one driver, widths agree, no name needs escaping in either
language. Its generator keeps its own account of every connection, as sets of bits, and shares
nothing with the library: what a tool reads in a written netlist must be these sets.
"""

from __future__ import annotations

import random
from collections.abc import Callable
from dataclasses import dataclass, field

Bit = tuple[str, ...]  # of a signal: its name and index; or one of the constants
ZERO, ONE = ("0",), ("1",)

# Legal in both languages and yet not plain: words in other letters, numbers that sort by value,
# names that begin alike, and such as the library itself makes, all but their end.
NAMES = ["A", "B2", "b10", "B09", "Clk", "CLK_1", "reset", "D", "D_1", "data", "Data_1", "Q",
         "Q_DUMMY_x", "OPEN_x", "opening", "x", "X_1", "z9", "Z10", "n1", "N01", "n1_0", "sum",
         "CONST_SIGNAL_a", "u", "U_I0", "Carry", "a1b2c3", "A_1_0", "addr", "Bus_a", "dummy",
         "Top_x", "e", "E1", "net", "NET_1", "i", "O", "k" * 40, "L" * 70 + "_1", "y", "Y2"]
# Verilog's reserved words in capitals: they are no reserved words in Verilog, which is case-sensitive, nor
# in VHDL.
VERILOG_WORDS = ["WIRE", "Module", "REG", "Assign", "INITIAL", "Endmodule", "Defparam"]


@dataclass
class Pin:
    name: str
    direction: str  # i, o or b
    left: int | None = None  # no indices for a scalar
    right: int | None = None

    @property
    def width(self) -> int:
        return 1 if self.left is None else abs(self.left - self.right) + 1

    @property
    def full_name(self) -> str:
        return self.name if self.left is None else f"{self.name}({self.left}:{self.right})"


@dataclass
class Leaf:
    name: str
    pins: list[Pin]
    generics: dict[str, str] = field(default_factory=dict)  # name to digits

    @property
    def has_two_way_pins(self) -> bool:
        return any(pin.direction == "b" for pin in self.pins)


@dataclass
class Signal:
    """A scalar or a bus; a bus may begin with fewer bits than it will have."""

    name: str
    direction: str | None = None
    left: int | None = None
    right: int | None = None
    low: int = 0  # of the bits declared so far
    high: int = 0
    declared: bool = False

    @property
    def is_bus(self) -> bool:
        return self.left is not None

    @property
    def step(self) -> int:
        return -1 if self.left > self.right else 1

    def indices(self) -> list[int]:
        """Of all bits that it will have, from left to right."""
        return list(range(self.left, self.right + self.step, self.step)) if self.is_bus else [0]

    def bits(self) -> list[Bit]:
        return [(self.name, str(index)) for index in self.indices()]

    def bounds(self) -> tuple[int, int]:
        indices = self.indices()
        return min(indices), max(indices)

    def name_of(self, low: int, high: int, against: bool = False) -> str:
        """The name of a part, or of the whole."""
        if not self.is_bus:
            return self.name
        left, right = (high, low) if (self.step < 0) != against else (low, high)
        return f"{self.name}({left}:{right})"

    def full_name(self) -> str:
        return self.name_of(*self.bounds())

    def stop_growing(self) -> None:
        """What is declared so far is the whole of it."""
        if self.is_bus:
            self.left, self.right = ((self.high, self.low) if self.step < 0 else
                                     (self.low, self.high))


@dataclass
class Reference:
    """A name in a command, the bits it stands for, and the buses that it names as a whole."""

    name: str
    bits: list[Bit]
    wholes: list[Signal] = field(default_factory=list)
    against: bool = False  # a slice that does not run as its bus does


class Classes:
    """Bits that are connected to each other, by union and find."""

    def __init__(self) -> None:
        self._parents: dict[Bit, Bit] = {}

    def find(self, bit: Bit) -> Bit:
        root = bit
        while root in self._parents:
            root = self._parents[root]
        while bit != root:
            self._parents[bit], bit = root, self._parents[bit]
        return root

    def join(self, one: Bit, other: Bit) -> None:
        one, other = self.find(one), self.find(other)
        if one != other:
            # A constant stays the name of its class.
            if one in (ZERO, ONE):
                one, other = other, one
            self._parents[one] = other


def random_range(source: random.Random, width: int) -> tuple[int, int]:
    low = source.choice([0, 0, 0, 1, 4, 9])
    high = low + width - 1
    return (high, low) if source.random() < 0.65 else (low, high)


def random_leaves(source: random.Random) -> list[Leaf]:
    """Leaf cells with pins of every direction, width and range."""
    leaves = []
    for number in range(8):
        pins = []
        for letter in source.sample("ABCDEFGHIJ", source.randint(1, 6)):
            pin = Pin(letter + source.choice(["", "", "1", "_x", "10", "9"]),
                      source.choice("iiiooob" if number % 2 else "io"))
            if source.random() < 0.5:
                width = source.choice([1, 2, 2, 3, 4, 8])
                pin.left, pin.right = random_range(source, width)
            pins.append(pin)
        generics = {name: "".join(source.choices("01", k=source.randint(2, 9)))
                    for name in source.sample(["INIT", "mode", "W_1"], source.randint(0, 2))}
        leaves.append(Leaf(source.choice(["LEAF", "cell", "Box_"]) + str(number), pins, generics))
    return leaves


class RandomDesign:
    """One design: its commands, and to which bits its ports and pins must lead."""

    def __init__(self, name: str, seed: int, leaves: list[Leaf]) -> None:
        self.name = name
        self.commands: list[str] = []
        self._classes = Classes()
        self.signals: list[Signal] = []
        # For each instance its leaf, and for each of its pins what it is wired to.
        self.instances: dict[str, Leaf] = {}
        self._pins: dict[tuple[str, str], list[Bit]] = {}
        self.generics: dict[str, dict[str, str]] = {}
        self._random = random.Random(f"design {seed}")
        self._driven: set[Bit] = set()
        self._sources: set[Bit] = set()  # that which is driven by other things than an alias
        self._lowercase = self._chance(0.1)
        self.closes_open_pins = self._chance(0.2)
        self.has_two_way_ports = self._chance(0.5)
        # GHDL writes these words as they are in small letters.
        fit = self.has_two_way_ports and not self._lowercase
        self._names = NAMES + (VERILOG_WORDS if fit else [])
        self._random.shuffle(self._names)
        self._make(leaves)

    # What a tool that reads the netlist must find.

    def ports(self) -> list[Signal]:
        return [signal for signal in self.signals if signal.direction]

    def bits_of(self, port: Signal) -> list[Bit]:
        """The nets of its bits, from left to right."""
        return [self._classes.find(bit) for bit in port.bits()]

    def bits_at(self, instance: str, pin: Pin) -> list[Bit]:
        """Likewise; none when the pin is open."""
        return [self._classes.find(bit) for bit in self._pins[instance, pin.name]]

    def is_driven(self, net: Bit) -> bool:
        return net in (ZERO, ONE) or net in {self._classes.find(bit) for bit in self._sources}

    # Making.

    def _chance(self, probability: float) -> bool:
        return self._random.random() < probability

    def _emit(self, *words: str) -> None:
        self.commands.append(" ".join(words))

    def _new_name(self) -> str:
        return self._names.pop() if self._names else f"s{len(self.signals)}_{len(self.instances)}"

    def _spell(self, name: str) -> str:
        """A name in perhaps other letters: names are case-insensitive."""
        return name.swapcase() if self._chance(0.1) else name

    def _make(self, leaves: list[Leaf]) -> None:
        self._set_options()
        used = self._random.sample(
            [leaf for leaf in leaves if self.has_two_way_ports or not leaf.has_two_way_pins],
            self._random.randint(1, 3))
        for leaf in used:
            self._add_component(leaf)
        directions = ["input", "output"] * 2 + ["bidirectional"] * self.has_two_way_ports
        for _ in range(self._random.randint(2, 8)):
            self._add_signal(self._random.choice(directions))
        for _ in range(self._random.randint(0, 8)):
            self._add_signal(None)
        for _ in range(self._random.randint(1, 10)):
            self._add_instance(self._random.choice(used))
        for step in self._random_steps():
            step()
        for signal in self.signals:
            signal.stop_growing()
        self._write()

    def _set_options(self) -> None:
        self._emit("SET NETLIST NAME", self.name)
        self._emit("SUPPRESS CONFIGURATION TRUE")
        if self._lowercase:
            self._emit("LOWERCASE SIGNAL")
        elif self._chance(0.1):
            self._emit("UPPERCASE", self._random.choice(["SIGANL", "INSTANCE"]))
        if self.closes_open_pins:
            self._emit("SET OPEN PIN FALSE")

    def _random_steps(self) -> list[Callable[[], None]]:
        unwired = [(instance, pin) for instance, leaf in self.instances.items()
                   for pin in leaf.pins]
        steps: list[Callable[[], None]] = [
            lambda place=place: self._connect_pin(*place) for place in unwired]
        steps += [self._add_alias] * self._random.randint(0, 6)
        steps += [self._assign_constant] * self._random.randint(0, 3)
        steps += [self._decorate] * self._random.randint(0, 4)
        if not self.closes_open_pins and self._chance(0.25):
            steps += [self._write_early] * self._random.randint(1, 2)
        self._random.shuffle(steps)
        return steps

    def _write(self) -> None:
        languages = ["VERILOG", "VHDL"] * self._random.choice([1, 1, 1, 2])
        self._random.shuffle(languages)
        for language in languages:
            extension = {"VERILOG": "v", "VHDL": "vhd"}[language]
            self._emit("WRITE", language, f"{self.name}.{extension}")

    def _add_component(self, leaf: Leaf) -> None:
        self._emit("ADD COMPONENT", leaf.name)
        for pin in leaf.pins:
            direction = {"i": "input", "o": "output", "b": "bidirectional"}[pin.direction]
            self._emit("ADD PIN", leaf.name, pin.full_name, direction)
        for name, digits in leaf.generics.items():
            self._emit("ADD COMPONENT ATTRIBUTE", leaf.name, "-TYPE=BitVector", name,
                       f"{len(digits)}:B:{digits}")
            self._emit("SET COMPONENT ATTRIBUTE OPTION", leaf.name, name, "-GENERIC=SYN")

    def _add_signal(self, direction: str | None) -> None:
        signal = Signal(self._new_name(), direction)
        if self._chance(0.7):
            signal.left, signal.right = random_range(self._random,
                                                     self._random.choice([1, 2, 3, 4, 8, 12]))
            signal.low, signal.high = signal.bounds()
            if signal.high > signal.low and self._chance(0.15):
                signal.low, signal.high = sorted(self._random.sample(signal.indices(), 2))
        self.signals.append(signal)
        if direction == "input":
            self._drive(signal.bits())
        grows = signal.is_bus and (signal.low, signal.high) != signal.bounds()
        if direction:
            self._emit("ADD PORT", signal.name_of(signal.low, signal.high), direction)
        elif not signal.is_bus or grows or self._chance(0.5):
            self._emit("ADD SIGNAL", signal.name_of(signal.low, signal.high))
        else:
            return  # its first use declares it
        signal.declared = True

    def _add_instance(self, leaf: Leaf) -> None:
        name = self._new_name()
        self.instances[name] = leaf
        self._emit("ADD INSTANCE", self._spell(leaf.name), name)
        self.generics[name] = dict(leaf.generics)
        for generic, digits in leaf.generics.items():
            if self._chance(0.4):
                value = "".join(self._random.choices("01", k=len(digits)))
                self.generics[name][generic] = value
                self._emit("ADD INSTANCE ATTRIBUTE", name, "-TYPE=BitVector", generic,
                           f"{len(value)}:B:{value}")
                self._emit("SET INSTANCE ATTRIBUTE OPTION", name, generic, "-GENERIC=SYN")

    # References.

    def _piece(self, most: int, fits: Callable[[Bit], bool]) -> Reference | None:
        """A reference to at most so many bits of one signal, all of which fit."""
        signal = self._random.choice(self.signals)
        if not signal.is_bus or not signal.declared or self._chance(0.25):
            bits = signal.bits()
            if len(bits) > most or not all(map(fits, bits)):
                return None
            # Whoever names it first decides on its letters.
            name = signal.full_name()
            return Reference(self._spell(name) if signal.declared else name, bits, [signal])
        return self._part(signal, min(most, signal.high - signal.low + 1), fits)

    def _part(self, signal: Signal, most: int, fits: Callable[[Bit], bool]) -> Reference | None:
        """A slice or bit of what is declared of a bus."""
        present = signal.high - signal.low + 1
        count = self._random.randint(1, most)
        low = self._random.randint(signal.low, signal.high - count + 1)
        bits = [(signal.name, str(index)) for index in range(low, low + count)]
        if not all(map(fits, bits)):
            return None
        if count == 1 and self._chance(0.7):
            return Reference(self._spell(f"{signal.name}({low})"), bits)
        # The whole bus, named from right to left, would be declared anew.
        against = 1 < count < present and self._chance(0.25)
        if (signal.step < 0) != against:
            bits.reverse()
        return Reference(self._spell(signal.name_of(low, low + count - 1, against)), bits,
                         against=against)

    def _reference(self, width: int, fits: Callable[[Bit], bool],
                   repeats: bool = True) -> Reference | None:
        """A name of so many bits, a compound unless one piece is enough; None when unlucky."""
        whole = Reference("", [])
        separator = self._random.choice([",", ",", "\\"])
        for _ in range(40):
            taken = set() if repeats else set(whole.bits)
            piece = self._piece(width - len(whole.bits),
                                lambda bit, taken=taken: fits(bit) and bit not in taken)
            if piece:
                whole.name += (separator if whole.name else "") + piece.name
                whole.bits += piece.bits
                whole.wholes += piece.wholes
            if len(whole.bits) == width:
                return whole
        return None

    @staticmethod
    def _use(reference: Reference) -> str:
        """The name, which from now on is part of the design: buses have the range it needs."""
        for signal in reference.wholes:
            signal.declared = True
            signal.low, signal.high = signal.bounds()
        return reference.name

    def _drive(self, bits: list[Bit]) -> None:
        self._driven.update(bits)
        self._sources.update(bits)

    def _is_free(self, bit: Bit) -> bool:
        return bit not in self._driven

    def _may_be_driven_two_ways(self, bit: Bit) -> bool:
        """A bit for a bidirectional pin: of an inout port, or one that nothing else drives."""
        return bit not in self._driven or ("two-way", *bit) in self._driven

    def _is_worth_reading(self, bit: Bit) -> bool:
        return bit in self._driven or self._chance(0.3)

    # Connections.

    def _connect_pin(self, instance: str, pin: Pin) -> None:
        self._pins[instance, pin.name] = []
        place = f"{self._spell(instance)}.{self._spell(pin.full_name)}"
        if pin.direction == "i" and self._chance(0.12):
            self._assign_pin(instance, pin, place)
            return
        if self._may_stay_open(pin) and self._chance(0.12):
            if pin.direction == "o" and pin.left is None and self._chance(0.5):
                self._emit("CONNECT SIGNAL", self._random.choice(["open", "OPEN"]), place)
            return
        fits = {"i": self._is_worth_reading, "o": self._is_free,
                "b": self._may_be_driven_two_ways}[pin.direction]
        reference = self._reference(pin.width, fits, repeats=pin.direction == "i")
        if reference is None:
            if not self._may_stay_open(pin):
                self._assign_pin(instance, pin, place)
            return
        if pin.direction != "i":
            self._drive(reference.bits)
        if pin.direction == "b":
            self._driven.update(("two-way", *bit) for bit in reference.bits)
        self._pins[instance, pin.name] = reference.bits
        self._emit("CONNECT SIGNAL", self._use(reference), place)

    def _may_stay_open(self, pin: Pin) -> bool:
        """VHDL wants something at every input."""
        return pin.direction != "i" or self.closes_open_pins

    def _assign_pin(self, instance: str, pin: Pin, place: str) -> None:
        text, bits = self._constant(pin.width, bare=pin.left is None)
        self._pins[instance, pin.name] = bits
        self._emit("ASSIGN CONSTANT", place, text)

    def _constant(self, width: int, bare: bool, binary: bool = False) -> tuple[str, list[Bit]]:
        digits = "".join(self._random.choices("01", k=width))
        bits = [ONE if digit == "1" else ZERO for digit in digits]
        if bare:
            return digits, bits
        base, length = self._random.choice([("B", 1), ("H", 4), ("O", 3), ("b", 1)])
        if width % length != 0 or binary:
            base, length = "B", 1
        return (f"{width}:{base}:" + "".join(f"{int(digits[i:i + length], 2):X}"
                                             for i in range(0, width, length))), bits

    def _add_alias(self) -> None:
        width = self._random.choice([1, 1, 2, 3, 4, 8])
        target = self._reference(width, self._is_free, repeats=False)
        source = target and self._reference(width, self._is_worth_reading)
        if not source or self._makes_a_loop(target.bits, source.bits):
            return
        for to, origin in zip(target.bits, source.bits, strict=True):
            self._classes.join(to, origin)
            self._driven.add(to)
        self._emit("CONNECT SIGNAL", self._use(target), self._use(source))

    def _makes_a_loop(self, target: list[Bit], source: list[Bit]) -> bool:
        classes = [self._classes.find(bit) for bit in target]
        return (len(set(classes)) < len(classes) or
                any(self._classes.find(bit) in classes for bit in source))

    def _assign_constant(self) -> None:
        piece = self._piece(12, self._is_free)
        if piece is None:
            return
        # VHDL has no octal or hexadecimal digits for a slice against its bus.
        text, values = self._constant(len(piece.bits), bare=":" not in piece.name,
                                      binary=piece.against)
        for bit, value in zip(piece.bits, values, strict=True):
            self._classes.join(bit, value)
        self._drive(piece.bits)
        self._emit("ASSIGN CONSTANT", self._use(piece), text)

    # What must not change the connections.

    def _decorate(self) -> None:
        signal = self._random.choice(self.signals)
        instance = self._random.choice(list(self.instances))
        choices = [("ADD NOTES", "some text"),
                   ("ADD INSTANCE ATTRIBUTE", instance, "LOC", "P1"),
                   ("ADD INSTANCE COMMENT", instance, "a comment"),
                   ("ADD MODULE ATTRIBUTE", "revision", "7"),
                   ("SET PORT ONEPERLINE",)]
        if signal.declared:
            name = signal.name_of(signal.low, signal.high)
            choices += [("ADD SIGNAL ATTRIBUTE", name, "keep", "yes"),
                        ("ADD SIGNAL COMMENT", name, "a comment; // and a half")]
        self._emit(*self._random.choice(choices))

    def _write_early(self) -> None:
        """A netlist of a design that is not ready; it leaves signals of its own in the design."""
        self._emit("WRITE", self._random.choice(["VERILOG", "VHDL"]), "early")
