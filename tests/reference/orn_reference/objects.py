"""Signals, pins, components and instances, and the links between them."""

from __future__ import annotations

from typing import Iterator, Optional

from .attributes import BitVectorValue, HdlObject
from .containers import StringSet
from .names import base_name, is_bit, is_bus, normalize, parse_bit, parse_bus
from .text import INT_MAX, equal_ignoring_case

INVALID, INPUT, OUTPUT, BIDIRECTIONAL = -1, 0, 1, 2
_POLARITY_WORDS = ((b"INPUT", INPUT), (b"OUTPUT", OUTPUT), (b"BIDIRECTIONAL", BIDIRECTIONAL))
DUMMY_SUFFIX = b"_DUMMY"


def polarity_of(text: bytes) -> int:
    """The direction that the text abbreviates."""
    if not text:
        return INVALID
    matching = (value for word, value in _POLARITY_WORDS if word.startswith(text.upper()))
    return next(matching, INVALID)


def _with_dummy_suffix(name: bytes) -> bytes:
    return name if name.upper().endswith(DUMMY_SUFFIX) else name + DUMMY_SUFFIX


def _is_down_to(name: bytes) -> bool:
    bus = parse_bus(name)
    return bus is not None and bus.is_down_to


class Pin(HdlObject):
    def __init__(self, name: bytes, polarity: int) -> None:
        super().__init__(name)
        self.polarity = polarity
        self.signal: Optional[Signal] = None

    def clone(self) -> Pin:
        return type(self)(self.name, self.polarity)

    def base_name(self) -> bytes:
        return self.name

    def generated_name(self, instance: bytes, word: bytes) -> bytes:
        """instance_pin_word, the pin's range behind the word."""
        return instance + b"_" + self.name + b"_" + word


class ScalarPin(Pin):
    pass


class BusPin(Pin):
    def base_name(self) -> bytes:
        return parse_bus(self.name).base

    def generated_name(self, instance: bytes, word: bytes) -> bytes:
        bus = parse_bus(self.name)
        return instance + b"_" + bus.base + b"_" + word + bus.range_text


class BusIndexPin(Pin):
    def base_name(self) -> bytes:
        return parse_bit(self.name).base

    def generated_name(self, instance: bytes, word: bytes) -> bytes:
        bit = parse_bit(self.name)
        return instance + b"_" + bit.base + b"_" + word + b"(" + bit.index_text + b")"


def create_pin(name: bytes, polarity: int) -> Pin:
    """The kind of pin follows the form of its name."""
    name = normalize(name)
    kind = BusPin if is_bus(name) else BusIndexPin if is_bit(name) else ScalarPin
    return kind(name, polarity)


class Signal(HdlObject):
    """What a pin can be wired to."""

    def __init__(self, name: bytes) -> None:
        super().__init__(name)
        self.pins: dict[int, Pin] = {}  # by identity, in order of connection
        self.signals: list[Signal] = []
        self.constant = BitVectorValue()

    def connect_pin(self, pin: Pin) -> None:
        self.pins.setdefault(id(pin), pin)
        pin.signal = self

    def connect_signal(self, other: Signal) -> None:
        if other is not self and not any(signal is other for signal in self.signals):
            self.signals.append(other)

    def clone_connections(self, other: Signal) -> None:
        for pin in list(other.pins.values()):
            if pin.signal is other:
                self.connect_pin(pin)
        for signal in list(other.signals):
            self.connect_signal(signal)

    def has_multi_driver(self) -> bool:
        drivers = [p for p in self.pins.values() if p.polarity == OUTPUT and p.signal is self]
        return len(drivers) > 1

    def base_name(self) -> bytes:
        return base_name(self.name)

    def port_polarity(self) -> int:
        raise NotImplementedError

    def is_port(self) -> bool:
        return False

    def needs_declaration(self) -> bool:
        return False

    def width(self) -> int:
        raise NotImplementedError

    def dummy_name(self) -> bytes:
        raise NotImplementedError

    def add_base_names(self, names: StringSet) -> None:
        names.add(self.base_name())

    def create_dummy(self, parent: Optional[Bus]) -> Signal:
        return type(self)(self.dummy_name())


class ScalarSignal(Signal):
    def __init__(self, name: bytes) -> None:
        super().__init__(name)
        self.polarity = INVALID

    def port_polarity(self) -> int:
        return self.polarity

    def is_port(self) -> bool:
        return self.polarity != INVALID

    def needs_declaration(self) -> bool:
        return True

    def width(self) -> int:
        return 1

    def dummy_name(self) -> bytes:
        return _with_dummy_suffix(self.name)

    def add_base_names(self, names: StringSet) -> None:
        names.add(self.name)


class Bus(Signal):
    def __init__(self, name: bytes) -> None:
        super().__init__(name)
        self.polarity = INVALID
        self.parts: list[Signal] = []  # slices and bits

    def port_polarity(self) -> int:
        return self.polarity

    def is_port(self) -> bool:
        return self.polarity != INVALID

    def needs_declaration(self) -> bool:
        return True

    def width(self) -> int:
        bus = parse_bus(self.name)
        return bus.width if bus else 0

    def dummy_name(self) -> bytes:
        bus = parse_bus(self.name)
        return _with_dummy_suffix(bus.base) + bus.range_text if bus else self.name


class _BusPart(Signal):
    """A slice or a bit of a bus."""

    def __init__(self, name: bytes, parent: Optional[Bus]) -> None:
        super().__init__(name)
        self.parent = parent
        if parent is not None:
            parent.parts.append(self)

    def port_polarity(self) -> int:
        return self.parent.port_polarity() if self.parent else INVALID

    def create_dummy(self, parent: Optional[Bus]) -> Signal:
        return type(self)(self.dummy_name(), parent)


class BusSlice(_BusPart):
    def width(self) -> int:
        bus = parse_bus(self.name)
        return bus.width if bus else 0

    def dummy_name(self) -> bytes:
        bus = parse_bus(self.name)
        return bus.base + DUMMY_SUFFIX + bus.range_text if bus else self.name

    def has_parents_direction(self) -> bool:
        """False for one bit, which has no direction."""
        if self.parent is None:
            return True
        return self.width() != 1 and _is_down_to(self.name) == _is_down_to(self.parent.name)

    def runs_against_parent(self) -> bool:
        return self.width() != 1 and not self.has_parents_direction()

    def is_bit_of_ascending_bus(self) -> bool:
        """Its range reads as a descending one, which cannot stand for a part of its bus in VHDL."""
        return (self.width() == 1 and self.parent is not None and self.parent.width() > 1
                and not _is_down_to(self.parent.name))


class BusIndex(_BusPart):
    def is_port(self) -> bool:
        return self.port_polarity() != INVALID

    def width(self) -> int:
        return 1

    def dummy_name(self) -> bytes:
        bit = parse_bit(self.name)
        return bit.base + DUMMY_SUFFIX + b"(" + bit.index_text + b")"


class CompoundBus(Signal):
    def __init__(self, name: bytes) -> None:
        super().__init__(name)
        self.members: list[Signal] = []

    def port_polarity(self) -> int:
        polarities = {member.port_polarity() for member in self.members}
        return polarities.pop() if len(polarities) == 1 else INVALID

    def width(self) -> int:
        return min(INT_MAX, sum(member.width() for member in self.members))

    def dummy_name(self) -> bytes:
        return b",".join(member.dummy_name() for member in self.members)

    def add_base_names(self, names: StringSet) -> None:
        for member in self.members:
            member.add_base_names(names)
        names.add(self.name)

    def replace_member(self, old: Signal, new: Signal) -> None:
        self.members = [new if member is old else member for member in self.members]


class Component(HdlObject):
    def __init__(self, name: bytes) -> None:
        super().__init__(name)
        self.pins: list[Pin] = []


class Instance(HdlObject):
    """A placement of a component with its own copies of the pins that stood there then."""

    def __init__(self, name: bytes, component: Component) -> None:
        super().__init__(name)
        self.component = component
        self.pins = [pin.clone() for pin in component.pins]

    def pins_facing_port(self, pin_polarities: tuple[int, int], port: int) -> Iterator[Pin]:
        """The pins of these directions whose signal touches a port of that direction."""
        for pin in self.pins:
            if pin.polarity in pin_polarities and pin.signal is not None:
                signals = [pin.signal]
                if isinstance(pin.signal, CompoundBus):
                    signals += pin.signal.members
                if any(signal.port_polarity() == port for signal in signals):
                    yield pin


def find_pin(owner: Component | Instance, name: bytes) -> Optional[Pin]:
    name = normalize(name)
    return next((pin for pin in owner.pins if equal_ignoring_case(pin.name, name)), None)
