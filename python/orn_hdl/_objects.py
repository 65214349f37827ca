"""The objects of a design: components, instances, pins and nets."""

from __future__ import annotations

from typing import TYPE_CHECKING, Dict, Iterator, List, Optional, Sequence, Tuple, Type, Union

from ._attributes import Holder, key_of
from ._errors import DeletedError, NotFoundError
from ._kinds import (BIT_SIGNAL, BUS, BUS_SIGNAL, COMPONENT, COMPONENT_PIN, COMPOUND_SIGNAL, INSTANCE,
                     INSTANCE_PIN, SCALAR_SIGNAL, SIGNAL, SLICE_SIGNAL)

if TYPE_CHECKING:
    from ._design import Design
    from ._orn_hdl import Model

Width = Union[None, int, Tuple[int, int]]


def ranged_name(name: str, width: Width) -> str:
    """A name with the range of a width: 8 gives (7:0), and a pair is the range itself."""
    if width is None:
        return name
    if isinstance(width, int):
        if width < 1:
            raise ValueError("a width is at least 1")
        width = (width - 1, 0)
    return f"{name}({width[0]}:{width[1]})"


class Constant:
    """A constant for a pin or a net: digits, or LENGTH:BASE:DIGITS with base B, O or H.

    >>> Constant("8:H:A5")
    Constant('8:H:A5')
    """

    __slots__ = ("value",)

    def __init__(self, value: Union[str, int]) -> None:
        self.value = str(value)

    def __repr__(self) -> str:
        return f"Constant({self.value!r})"


class _Named(Holder):
    """A holder that is found by its name alone."""

    __slots__ = ("_name",)

    _kind = SIGNAL

    def __init__(self, design: Design, name: str) -> None:
        super().__init__(design)
        self._name = name

    def _address(self) -> Tuple[int, str, str]:
        return (self._kind, self._name, "")

    @property
    def name(self) -> str:
        """The name. Assigning another one renames the object; other Python objects for it then raise
        DeletedError. Raises NameTakenError if something has the new name."""
        return self._present_name()

    @name.setter
    def name(self, name: str) -> None:
        self._model().rename(self._kind, self._name, name)
        self._design._note_removal(self._key())
        self._name = name
        self._born = self._design._removals

    def _present_name(self) -> str:
        """The name as the design has it. Raises DeletedError if there is no such object."""
        found = self._model().find(self._kind, self._name)
        if found is None:
            raise DeletedError(f"{self!r} has been removed from its design")
        return found[1]

    def remove(self) -> None:
        """Takes the object out of the design. What was connected to it is open then."""
        self._model().remove(self._kind, self._name)
        self._design._note_removal(self._key())

    def __repr__(self) -> str:
        return f"<{type(self).__name__} {self._name}>"


class Pin(Holder):
    """A pin of a component or of an instance."""

    __slots__ = ("_owner", "_name")

    def __init__(self, owner: Union[Component, Instance], name: str) -> None:
        super().__init__(owner._design)
        self._owner = owner
        self._name = name

    def _address(self) -> Tuple[int, str, str]:
        self._owner._model()
        return (self._owner._pin_kind, self._owner._name, self._name)

    def _key(self) -> Tuple[object, ...]:
        return (self._owner._pin_kind, key_of(self._owner._name), key_of(self._name))

    def _get(self) -> Tuple[str, str, int, str, Optional[Tuple[int, str]]]:
        return self._model().pin(*self._address())

    @property
    def name(self) -> str:
        """The name, of a pin with a range the range too: "D(7:0)"."""
        return self._get()[0]

    @property
    def owner(self) -> Union[Component, Instance]:
        """The component or the instance."""
        return self._owner

    @property
    def direction(self) -> str:
        """ "input", "output" or "bidirectional"."""
        return self._get()[1]

    @property
    def width(self) -> int:
        """The number of bits."""
        return self._get()[2]

    @property
    def default(self) -> str:
        """The digits of the default value; empty for none."""
        return self._get()[3]

    @property
    def net(self) -> Optional[Net]:
        """The net at the pin; None when it is open. A net, a name, a constant, or None to open the pin, can be
        assigned, as `connect` takes them."""
        signal = self._get()[4]
        return None if signal is None else self._design._make_net(*signal)

    @net.setter
    def net(self, net: Connection) -> None:
        self.connect(net)

    def connect(self, net: Connection) -> None:
        """Connects the pin of an instance.

        `net` is a `Net`, the name of one, of a bus with or without its range, which is declared if there is
        none, a `Constant`, an int for a constant, several of the first two for a concatenation, the leftmost first, or None to open the pin.
        Raises NotFoundError for a bit that its bus does not have, and TypeError for a pin of a component.
        """
        if not isinstance(self._owner, Instance):
            raise TypeError("a pin of a component cannot be connected")
        model = self._model()
        self._get()
        if net is None:
            model.disconnect(self._owner._name, self._name)
        elif isinstance(net, (Constant, int)):
            value = net.value if isinstance(net, Constant) else str(net)
            model.tie_pin(self._owner._name, self._name, value)
        else:
            model.connect(self._design._name_of(net), self._owner._name, self._name)

    def disconnect(self) -> None:
        """Opens the pin of an instance."""
        self.connect(None)

    def remove(self) -> None:
        """Takes the pin out; that of a component also out of the instances of the component."""
        self._model().remove_pin(*self._address())
        self._design._note_removal(self._key())

    def __repr__(self) -> str:
        return f"<Pin {self._owner._name}.{self._name}>"


class _PinOwner(_Named):
    """A component or an instance."""

    __slots__ = ()

    _pin_kind = INSTANCE_PIN

    @property
    def pins(self) -> List[Pin]:
        """The pins, in order."""
        names = self._model().pins(self._pin_kind, self._name)
        return [Pin(self, name) for name in names]  # type: ignore[arg-type]

    def __getitem__(self, name: str) -> Pin:
        """The pin of that name, with or without its range. Raises NotFoundError if there is none."""
        found = self._model().find_pin(self._pin_kind, self._name, name)
        if found is None:
            raise NotFoundError(f'{self!r} has no pin "{name}"')
        return Pin(self, found)  # type: ignore[arg-type]

    def __contains__(self, name: str) -> bool:
        return self._model().find_pin(self._pin_kind, self._name, name) is not None

    def __iter__(self) -> Iterator[Pin]:
        return iter(self.pins)


class Component(_PinOwner):
    """A cell type with its pins."""

    __slots__ = ()

    _kind = COMPONENT
    _pin_kind = COMPONENT_PIN

    def pin(self, name: str, direction: str, width: Width = None, default: str = "") -> Pin:
        """Adds a pin. Instances that are there already do not get it.

        `direction` is "in", "out", "inout" or a longer form of these, `width` a number of bits or a pair of
        indices. Raises InvalidValueError for any other direction, NameTakenError if there is such a pin.
        """
        name = ranged_name(name, width)
        self._model().add_pin(self._name, name, direction, default)
        return self[name]

    @property
    def instances(self) -> List[Instance]:
        """The instances of the component."""
        return [u for u in self._design.instances if u.component == self]


class Instance(_PinOwner):
    """A placement of a component."""

    __slots__ = ()

    _kind = INSTANCE

    @property
    def component(self) -> Optional[Component]:
        """The component; None when it has been removed."""
        name = self._model().component_of(self._name)
        return None if name is None else Component(self._design, name)

    @property
    def connections(self) -> Dict[str, Optional[Net]]:
        """The net at each pin, None for an open one."""
        return {pin.name: pin.net for pin in self.pins}

    def connect(self, **nets: Connection) -> None:
        """Connects pins by name, as `Pin.connect` does: `u.connect(I0=a, O="n1")`."""
        for name, net in nets.items():
            self[name].connect(net)


class Net(_Named):
    """A net of one bit, and the base of all nets. A net with a direction is a port of the design."""

    __slots__ = ()

    def _get(self) -> Tuple[int, str, int, str, str, Optional[Tuple[int, int]]]:
        return self._model().signal(self._kind, self._name)

    def _present_name(self) -> str:
        return self._get()[1]

    def _is_used(self) -> bool:
        """Whether the design knows the net; a slice or bit is there from its first use on."""
        self._get()
        return True

    @property
    def width(self) -> int:
        """The number of bits."""
        return self._get()[2]

    @property
    def direction(self) -> Optional[str]:
        """The direction of a port: "input", "output" or "bidirectional"; None for any other net. Assigning one
        makes the net a port; None makes it a net that is no port."""
        return self._get()[3] or None

    @direction.setter
    def direction(self, direction: Optional[str]) -> None:
        self._model().set_direction(self._kind, self._name, direction or "")

    @property
    def is_port(self) -> bool:
        """Whether the net is a port."""
        return self.direction is not None

    @property
    def constant(self) -> Optional[str]:
        """The constant that the net is tied to, as the commands spell it; None for none. Assigning one ties the
        net to it; the value is not checked."""
        return self._get()[4] or None if self._is_used() else None

    @constant.setter
    def constant(self, value: Union[str, int, Constant]) -> None:
        text = value.value if isinstance(value, Constant) else str(value)
        self._model().tie_signal(self._design._name_of(self), text)

    @property
    def pins(self) -> List[Pin]:
        """The pins of instances at this net itself, in the order in which they were connected. Those at the
        slices and bits of a bus are at these, and a pin that was tied to a constant is not listed by the net
        that carries it."""
        if not self._is_used():
            return []
        pairs = self._model().pins_of_signal(self._kind, self._name)
        return [Pin(Instance(self._design, instance), pin) for instance, pin in pairs]

    @property
    def aliases(self) -> List[Net]:
        """The nets that drive this one by an assignment."""
        if not self._is_used():
            return []
        found = self._model().aliases(self._kind, self._name)
        return [self._design._make_net(*signal) for signal in found]

    def assign(self, other: Union[Net, str]) -> None:
        """Makes an assignment: the other net drives this one. Raises NotFoundError for a bit that its bus does
        not have."""
        self._model()
        self._design._native.add_alias(self._design._name_of(self), self._design._name_of(other))

    def unassign(self, other: Net) -> None:
        """Takes an assignment away. Nothing happens if there is none."""
        self._model().remove_alias(self._kind, self._name, other._kind, other._name)

    def connect(self, *pins: Pin) -> None:
        """Connects pins of instances to the net."""
        for pin in pins:
            pin.connect(self)


class Bus(Net):
    """A net with a range. `bus[3]` is a bit and `bus[3:0]` a slice, by the indices of the range, both of which
    belong to the slice; `len(bus)` is the width, and iterating gives the bits from the left."""

    __slots__ = ()

    _kind = BUS

    def _present_name(self) -> str:
        return self._get()[1].partition("(")[0]

    def _range(self) -> Tuple[int, int]:
        indices = self._get()[5]
        assert indices is not None
        return indices

    @property
    def full_name(self) -> str:
        """The name with the range, such as "D(7:0)"."""
        return self._get()[1]

    @property
    def left(self) -> int:
        """The left index of the range."""
        return self._range()[0]

    @property
    def right(self) -> int:
        """The right index of the range."""
        return self._range()[1]

    @_Named.name.setter  # type: ignore[attr-defined,misc]
    def name(self, name: str) -> None:
        left, right = self._range()
        base = name.partition("(")[0]
        self._model().rename(self._kind, self._name, f"{base}({left}:{right})")
        self._design._note_removal(self._key())
        self._name = base
        self._born = self._design._removals

    def __len__(self) -> int:
        return self.width

    def __bool__(self) -> bool:
        return True

    def __getitem__(self, index: Union[int, slice]) -> Net:
        """A bit or a slice. Raises IndexError for what the range does not have, and for a slice that runs
        against it."""
        left, right = self._range()
        low, high = min(left, right), max(left, right)
        if not isinstance(index, slice):
            if not low <= index <= high:
                raise IndexError(f"{self.full_name} has no bit {index}")
            return Bit(self._design, f"{self._name}({index})")
        if index.step is not None:
            raise IndexError("a slice of a bus has no step")
        first = left if index.start is None else index.start
        last = right if index.stop is None else index.stop
        if not (low <= first <= high and low <= last <= high):
            raise IndexError(f"{self.full_name} has no slice {first}:{last}")
        if (first - last) * (left - right) < 0:
            raise IndexError(f"the slice {first}:{last} runs against {self.full_name}")
        if (first, last) == (left, right):
            return self
        return Slice(self._design, f"{self._name}({first}:{last})")

    def __iter__(self) -> Iterator[Net]:
        left, right = self._range()
        step = -1 if left > right else 1
        return (Bit(self._design, f"{self._name}({i})") for i in range(left, right + step, step))

    def __contains__(self, bit: object) -> bool:
        return any(bit == own for own in self)

    @property
    def parts(self) -> List[Net]:
        """The slices and bits that are in use."""
        return [self._design._make_net(*part) for part in self._model().parts(self._kind, self._name)]

    def __repr__(self) -> str:
        indices = self._design._bus_range(self._name)
        return f"<Bus {self._name}>" if indices is None else f"<Bus {self._name}{indices}>"


class _Part(Net):
    """A slice or a bit, which the design knows from its first use on."""

    __slots__ = ()

    def _model(self) -> Model:
        if self._born != self._design._removals:
            bus = (BUS, key_of(self._name.partition("(")[0]), "")
            if self._design._is_removed(bus, self._born):
                raise DeletedError(f"the bus of {self!r} has been removed from its design")
        return super()._model()

    def _present_name(self) -> str:
        self.bus._get()
        return self._name

    @property
    def bus(self) -> Bus:
        """The bus."""
        self._model()
        return Bus(self._design, self._name.partition("(")[0])

    def _is_used(self) -> bool:
        self.bus._get()
        return self._model().has_signal(self._kind, self._name)

    def _indices(self) -> Tuple[int, int]:
        first, _, last = self._name.partition("(")[2].rstrip(")").partition(":")
        return int(first), int(last or first)

    @property
    def width(self) -> int:
        """The number of bits."""
        self.bus._get()
        first, last = self._indices()
        return abs(first - last) + 1

    @property
    def direction(self) -> Optional[str]:
        """The direction of the bus."""
        return self.bus.direction

    @direction.setter
    def direction(self, direction: Optional[str]) -> None:
        raise AttributeError("the direction is that of the bus")

    def remove(self) -> None:
        """Takes the part out of the design, if it is in use. The bus stays."""
        if self._is_used():
            super().remove()


class Slice(_Part):
    """A part of a bus with a range of its own, such as D(3:0)."""

    __slots__ = ()

    @property
    def left(self) -> int:
        """The left index."""
        return self._indices()[0]

    @property
    def right(self) -> int:
        """The right index."""
        return self._indices()[1]


class Bit(_Part):
    """One bit of a bus, such as D(2)."""

    __slots__ = ()

    @property
    def index(self) -> int:
        """The index in the bus."""
        return self._indices()[0]


class Compound(Net):
    """A concatenation of nets."""

    __slots__ = ()

    @property
    def members(self) -> List[Net]:
        """The members, leftmost first."""
        return [self._design._make_net(*part) for part in self._model().parts(self._kind, self._name)]


Connection = Union[Net, str, int, Constant, Sequence[Union[Net, str]], None]

NET_CLASSES: Dict[int, Type[Net]] = {SCALAR_SIGNAL: Net, BUS_SIGNAL: Bus, SLICE_SIGNAL: Slice,
                                     BIT_SIGNAL: Bit, COMPOUND_SIGNAL: Compound}
