"""One flat design: its objects by name, sorting, and the helper signals made before writing."""

from __future__ import annotations

import functools
from typing import Callable, Iterable, NamedTuple, Optional

from .attributes import BitVectorValue, HdlObject, create_attribute
from .containers import NameMap, StringSet
from .names import base_name, compare_naturally, normalize
from .objects import (
    BIDIRECTIONAL,
    INPUT,
    OUTPUT,
    Bus,
    BusIndexPin,
    BusPin,
    BusSlice,
    Component,
    CompoundBus,
    Instance,
    Pin,
    ScalarSignal,
    Signal,
)
from .text import equal_ignoring_case

_natural_key = functools.cmp_to_key(compare_naturally)


class Dummy(NamedTuple):
    """A dummy signal and the signal that it stands in for."""

    original: Signal
    signal: Signal
    drives_port: bool  # the port is an output: the dummy carries what the design drives


class Netlist(HdlObject):
    def __init__(self) -> None:
        super().__init__(b"")
        self.name = b"hdlNetlist"
        self.components: list[Component] = []
        self.instances: list[Instance] = []
        self.signals: list[Signal] = []
        self._dummies: dict[int, Dummy] = {}  # by identity of the original, in order of making
        self._components_by_name: NameMap[Component] = NameMap()
        self._instances_by_name: NameMap[Instance] = NameMap()
        self._signals_by_name: NameMap[Signal] = NameMap()
        self._buses_by_base_name: NameMap[Bus] = NameMap()

    # Objects by name

    def add_component(self, component: Component) -> None:
        self.components.append(component)
        self._components_by_name.add(component.name, component)

    def add_instance(self, instance: Instance) -> None:
        self.instances.append(instance)
        self._instances_by_name.add(instance.name, instance)

    def add_signal(self, signal: Signal) -> None:
        self.signals.append(signal)
        self._signals_by_name.add(signal.name, signal)
        if isinstance(signal, Bus):
            self._buses_by_base_name.add(signal.base_name(), signal)

    def get_component(self, name: bytes) -> Optional[Component]:
        return self._components_by_name.get(normalize(name))

    def get_instance(self, name: bytes) -> Optional[Instance]:
        return self._instances_by_name.get(normalize(name))

    def get_signal(self, name: bytes) -> Optional[Signal]:
        return self._signals_by_name.get(normalize(name))

    def get_parent_bus(self, name: bytes) -> Optional[Bus]:
        return self._buses_by_base_name.get(base_name(name))

    def instances_of(self, component: Component) -> list[Instance]:
        return [instance for instance in self.instances if instance.component is component]

    # Widening

    def widen_bus(self, old: Bus, name: bytes) -> Bus:
        """Replaces a bus by a wider one; a slice with the old name takes its place everywhere."""
        new = Bus(name)
        new.polarity = old.polarity
        new.comment = old.comment
        new.attributes = old.attributes
        part = BusSlice(old.name, new)
        part.constant = old.constant
        part.clone_connections(old)
        for moved in old.parts:
            moved.parent = new
            new.parts.append(moved)
        self._remove_bus(old)
        self._redirect(old, part)
        self.add_signal(new)
        self.add_signal(part)
        return new

    def _remove_bus(self, bus: Bus) -> None:
        self.signals = [signal for signal in self.signals if signal is not bus]
        self._signals_by_name.remove_if_holds(bus.name, bus)
        self._buses_by_base_name.remove_if_holds(bus.base_name(), bus)
        self._dummies = {
            key: dummy
            for key, dummy in self._dummies.items()
            if bus is not dummy.original and bus is not dummy.signal
        }

    def _redirect(self, old: Signal, new: Signal) -> None:
        for instance in self.instances:
            for pin in instance.pins:
                if pin.signal is old:
                    pin.signal = new
        for signal in self.signals:
            signal.signals = [new if other is old else other for other in signal.signals]
        for compound in self._compounds():
            compound.replace_member(old, new)

    def _compounds(self) -> list[CompoundBus]:
        return [signal for signal in self.signals if isinstance(signal, CompoundBus)]

    # Order

    def sort(self) -> None:
        """By natural name; signals and pins by direction first. Equal names keep their order."""
        self.signals.sort(key=lambda s: (s.port_polarity(), _natural_key(s.name)))
        self.components.sort(key=lambda c: _natural_key(c.name))
        self.instances.sort(key=lambda i: _natural_key(i.name))
        for instance in self.instances:
            instance.pins.sort(key=lambda p: (p.polarity, _natural_key(p.name)))

    # Dummy signals of ports that are read or driven against their direction

    def create_dummy_signals(self) -> None:
        self._refresh_dummies()
        names = StringSet()
        for collect, drives_port in (
            (self._collect_read_outputs, True),
            (self._collect_driven_inputs, False),
            (self._collect_wired_or_outputs, True),
        ):
            collect(names)
            self._add_dummies(names, drives_port)
            names.empty()

    def _collect_read_outputs(self, names: StringSet) -> None:
        for instance in self.instances:
            for pin in instance.pins_facing_port((INPUT, BIDIRECTIONAL), OUTPUT):
                pin.signal.add_base_names(names)

    def _collect_driven_inputs(self, names: StringSet) -> None:
        for instance in self.instances:
            for pin in instance.pins_facing_port((OUTPUT, BIDIRECTIONAL), INPUT):
                pin.signal.add_base_names(names)

    def _collect_wired_or_outputs(self, names: StringSet) -> None:
        for signal in self.signals:
            if signal.port_polarity() == OUTPUT and signal.has_multi_driver():
                signal.add_base_names(names)

    def _add_dummies(self, names: StringSet, drives_port: bool) -> None:
        wanted_port = OUTPUT if drives_port else INPUT
        compounds: list[CompoundBus] = []
        for name in names:
            signal = self.get_signal(name)
            bus = self.get_parent_bus(name)
            if isinstance(signal, ScalarSignal):
                if signal.port_polarity() == wanted_port:
                    self._add_dummy(signal, drives_port, None)
            elif isinstance(signal, CompoundBus):
                compounds.append(signal)
            elif bus is not None and bus.port_polarity() == wanted_port:
                self._add_bus_dummy(bus, drives_port)
        for compound in compounds:
            dummy = self._add_dummy(compound, drives_port, None)
            if dummy is not None:
                dummy.members = [self._dummy_or_itself(member) for member in compound.members]

    def _add_bus_dummy(self, bus: Bus, drives_port: bool) -> None:
        dummy = self._add_dummy(bus, drives_port, None)
        if dummy is not None:
            for part in list(bus.parts):
                self._add_dummy(part, drives_port, dummy)

    def _add_dummy(
        self, signal: Signal, drives_port: bool, parent: Optional[Bus]
    ) -> Optional[Signal]:
        """The new dummy of a signal; None where it has one or the name is taken."""
        name = signal.dummy_name()
        if id(signal) in self._dummies or self.get_signal(name) is not None:
            return None
        if isinstance(signal, Bus) and self.get_parent_bus(name) is not None:
            return None
        dummy = Dummy(signal, signal.create_dummy(parent), drives_port)
        self.add_signal(dummy.signal)
        self._dummies[id(signal)] = dummy
        self._take_over(dummy)
        return dummy.signal

    def _take_over(self, dummy: Dummy) -> None:
        """Moves the pins to the dummy, and all drivers too when the port is an output."""
        original, signal, drives_port = dummy
        signal.clone_connections(original)
        if drives_port:
            original.signals.clear()
            if original.constant.digits:
                signal.constant = original.constant
                original.constant = BitVectorValue()
        if isinstance(original, (ScalarSignal, Bus)):
            if drives_port:
                original.connect_signal(signal)
            else:
                signal.connect_signal(original)
        if not isinstance(original, CompoundBus):
            for compound in self._compounds():
                compound.replace_member(original, signal)

    def _refresh_dummies(self) -> None:
        """Every dummy gets what its signal has gained since the last write."""
        for dummy in list(self._dummies.values()):
            self._take_over(dummy)
            if isinstance(dummy.original, Bus):
                for part in list(dummy.original.parts):
                    self._add_dummy(part, dummy.drives_port, dummy.signal)

    def _dummy_or_itself(self, signal: Signal) -> Signal:
        dummy = self._dummies.get(id(signal))
        return dummy.signal if dummy else signal

    # Open pins and black boxes

    def connect_open_pins(self) -> None:
        """Gives each open input pin a signal; the signal does not list the pin."""
        for instance in self.instances:
            for pin in instance.pins:
                if pin.signal is None and pin.polarity == INPUT:
                    pin.signal = self._open_signal(instance, pin)

    def _open_signal(self, instance: Instance, pin: Pin) -> Optional[Signal]:
        if isinstance(pin, BusIndexPin):
            return None
        name = pin.generated_name(instance.name, b"openSignal")
        signal = self.get_signal(name)
        if signal is None:
            signal = Bus(name) if isinstance(pin, BusPin) else ScalarSignal(name)
            self.add_signal(signal)
        return signal

    def mark_black_boxes(self) -> None:
        for component in self.components:
            if has_level_halvex(component) and component.get_attribute(b"BOX_TYPE") is None:
                mark = create_attribute(b"String", b"BOX_TYPE", b"BLACK_BOX")
                mark.set_synthesis(b"ASSIGN")
                component.add_attribute(mark)


def has_level_halvex(component: Component) -> bool:
    """True for a primitive cell of the vendor's library."""
    level = component.get_attribute(b"Level")
    return level is not None and equal_ignoring_case(level.value_text(), b"HALVEX")


def longest_name(objects: Iterable[HdlObject], wanted: Callable[..., bool]) -> int:
    return max((len(item.name) for item in objects if wanted(item)), default=0)


def longest_attribute_name(netlist: Netlist) -> int:
    """Over all attributes but those of pins."""
    holders: list[HdlObject] = [netlist, *netlist.signals, *netlist.components, *netlist.instances]
    return max((len(a.name) for holder in holders for a in holder.attributes.values()), default=0)
