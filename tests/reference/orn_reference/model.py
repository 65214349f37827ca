"""The operations that commands perform on a design, with their checks and messages."""

from __future__ import annotations

from typing import Callable, Optional

from .attributes import Attribute, BitVectorValue, HdlObject, UserAttribute, create_attribute
from .names import (
    BusName,
    compound_members,
    is_bit,
    is_bus,
    is_compound,
    normalize,
    parse_bit,
    parse_bus,
)
from .netlist import Netlist
from .objects import (
    Bus,
    BusIndex,
    BusSlice,
    Component,
    CompoundBus,
    Instance,
    Pin,
    ScalarSignal,
    Signal,
    create_pin,
    find_pin,
)
from .options import Options


class HdlError(Exception):
    """A command that failed; the description ends in a line feed."""

    def __init__(self, description: bytes) -> None:
        super().__init__(description)
        self.description = description


class Model:
    def __init__(self, name: bytes) -> None:
        self.netlist = Netlist()
        self.netlist.name = name
        self.source_file_name = b""
        self.options = Options()
        self.file_errors: list[tuple[bytes, OSError]] = []

    # Building

    def add_component(self, name: bytes) -> None:
        self._check_unused(name)
        self.netlist.add_component(Component(name))

    def add_pin(self, component_name: bytes, pin_name: bytes, polarity: int) -> None:
        component = self._component(component_name, b'Component "%s" not found.\n')
        if find_pin(component, pin_name) is not None:
            raise HdlError(
                b'Component "%s" already has pin "%s".\n' % (component_name, pin_name)
            )
        component.pins.append(create_pin(pin_name, polarity))

    def add_instance(self, name: bytes, component_name: bytes) -> None:
        self._check_unused(name)
        component = self._component(component_name, b'Component "%s" not found.\n')
        self.netlist.add_instance(Instance(name, component))

    def add_port(self, name: bytes, polarity: int) -> None:
        self.add_signal(name)
        self.netlist.get_signal(name).polarity = polarity

    def add_signal(self, name: bytes) -> None:
        self._check_unused(name)
        if not is_bus(normalize(name)):
            self.netlist.add_signal(ScalarSignal(name))
        elif self.netlist.get_parent_bus(name) is None:
            self.netlist.add_signal(Bus(name))
        else:
            raise HdlError(b'Signal "%s" already declared.\n' % name)

    def connect_signal_to_pin(self, name: bytes, instance_name: bytes, pin_name: bytes) -> None:
        signal = self._get_or_create_signal(name)
        instance = self._instance(instance_name, b'Signal "%s" not found.\n')
        pin = find_pin(instance, pin_name)
        if pin is None:
            raise HdlError(b'Pin "%s.%s" not found.\n' % (instance_name, pin_name))
        signal.connect_pin(pin)

    def connect_signals(self, first_name: bytes, second_name: bytes) -> None:
        first_name_kept = self._get_or_create_signal(first_name).name
        second = self._get_or_create_signal(second_name)
        # Looked up again: the second may have widened the bus that was the first.
        self.netlist.get_signal(first_name_kept).connect_signal(second)

    def assign_constant_to_signal(self, name: bytes, value: bytes) -> None:
        self._get_or_create_signal(name).constant = BitVectorValue(value)

    def assign_constant_to_pin(self, instance_name: bytes, pin_name: bytes, value: bytes) -> None:
        instance = self._instance(instance_name, b'Signal "%s" not found.\n')
        pin = find_pin(instance, pin_name)
        if pin is None:
            raise HdlError(b'Pin "%s" not found.\n' % pin_name)
        name = pin.generated_name(instance.name, b"CONST_SIGNAL")
        if self.netlist.get_signal(name) is None:
            self.add_signal(name)
        signal = self.netlist.get_signal(name)
        signal.constant = BitVectorValue(value)
        pin.signal = signal

    def add_notes(self, text: bytes) -> None:
        self.netlist.add_comment(text)

    # Signals made on first use

    def _get_or_create_signal(self, name: bytes) -> Signal:
        signal = self.netlist.get_signal(name)
        if signal is not None:
            return signal
        plain = normalize(name)
        if is_bit(name) and is_bit(plain):
            signal = self._create_bit(plain)
        elif is_bus(name) and is_bus(plain):
            signal = self._create_slice(name)
        elif is_compound(name) and is_compound(plain):
            signal = self._create_compound(plain)
        else:
            self.add_signal(name)
            signal = self.netlist.get_signal(name)
        if signal is None:
            raise HdlError(b'Signal "%s" not found.\n' % name)
        return signal

    def _create_bit(self, name: bytes) -> Optional[Signal]:
        bus = self.netlist.get_parent_bus(name)
        if bus is None:
            return None
        bit = BusIndex(bus.base_name() + b"(" + parse_bit(name).index_text + b")", bus)
        self.netlist.add_signal(bit)
        return bit

    def _create_slice(self, name: bytes) -> Optional[Signal]:
        bus = self.netlist.get_parent_bus(name)
        if bus is None:
            self.add_signal(name)
            return self.netlist.get_signal(name)
        wanted: BusName = parse_bus(name)
        spelled = bus.base_name() + wanted.range_text
        if bus.width() <= wanted.width:
            return self.netlist.widen_bus(bus, spelled)
        part = BusSlice(spelled, bus)
        self.netlist.add_signal(part)
        return part

    def _create_compound(self, name: bytes) -> Signal:
        members = compound_members(name)
        for member in members:
            self._ensure_member(member)
        compound = CompoundBus(name)
        compound.members = [self.netlist.get_signal(member) for member in members]
        self.netlist.add_signal(compound)
        return compound

    def _ensure_member(self, name: bytes) -> None:
        if self.netlist.get_signal(name) is not None:
            return
        if is_bit(name) and self.netlist.get_parent_bus(name) is not None:
            self._create_bit(name)
        elif is_bus(name):
            self._create_slice(name)
        else:
            self.add_signal(name)

    # Comments

    def add_component_comment(self, name: bytes, text: bytes) -> None:
        self._component(name).add_comment(text)

    def add_instance_comment(self, name: bytes, text: bytes) -> None:
        self._instance(name).add_comment(text)

    def add_signal_comment(self, name: bytes, text: bytes) -> None:
        self._signal(name).add_comment(text)

    # Objects that carry attributes

    def module_holder(self) -> HdlObject:
        return self.netlist

    def component_holder(self, name: bytes) -> HdlObject:
        return self._component(name)

    def instance_holder(self, name: bytes) -> HdlObject:
        return self._instance(name)

    def signal_holder(self, name: bytes) -> HdlObject:
        return self._signal(name)

    def component_pin_holder(self, component_name: bytes, pin_name: bytes) -> HdlObject:
        return self._pin(self.netlist.get_component(component_name), pin_name)

    def instance_pin_holder(self, instance_name: bytes, pin_name: bytes) -> HdlObject:
        return self._pin(self.netlist.get_instance(instance_name), pin_name)

    # Look-ups that report what is missing

    def _check_unused(self, name: bytes) -> None:
        look_ups: tuple[Callable[[bytes], object], ...] = (
            self.netlist.get_component,
            self.netlist.get_instance,
            self.netlist.get_signal,
        )
        if any(look_up(name) is not None for look_up in look_ups):
            raise HdlError(b'Identifier "%s" already defined.\n' % name)

    def _component(self, name: bytes, message: bytes = b'"%s" not found.\n') -> Component:
        component = self.netlist.get_component(name)
        if component is None:
            raise HdlError(message % name)
        return component

    def _instance(self, name: bytes, message: bytes = b'"%s" not found.\n') -> Instance:
        instance = self.netlist.get_instance(name)
        if instance is None:
            raise HdlError(message % name)
        return instance

    def _signal(self, name: bytes) -> Signal:
        signal = self.netlist.get_signal(name)
        if signal is None:
            raise HdlError(b'"%s" not found.\n' % name)
        return signal

    @staticmethod
    def _pin(owner: Component | Instance | None, pin_name: bytes) -> Pin:
        pin = find_pin(owner, pin_name) if owner is not None else None
        if pin is None:
            raise HdlError(b'Pin "%s" not found.\n' % pin_name)
        return pin


# Operations on the attributes of one object


def add_attribute(holder: HdlObject, name: bytes, value: bytes, type_name: bytes) -> None:
    present = holder.get_attribute(name)
    if present is not None:
        present.set_value(value)
        return
    attribute = create_attribute(type_name, name, value)
    if attribute is None:
        raise HdlError(b"Invalid attribute type.\n")
    holder.add_attribute(attribute)


def find_attribute(holder: HdlObject, name: bytes) -> Attribute:
    """The object's attribute; for an instance also its component's."""
    attribute = holder.get_attribute(name)
    if attribute is None and isinstance(holder, Instance):
        attribute = holder.component.get_attribute(name)
    if attribute is None:
        raise HdlError(b'Attribute "%s" not found.\n' % name)
    return attribute


def set_attribute_value(holder: HdlObject, name: bytes, value: bytes) -> None:
    find_attribute(holder, name).set_value(value)


def set_user_type(holder: HdlObject, name: bytes, user_type: bytes) -> None:
    attribute = find_attribute(holder, name)
    if not isinstance(attribute, UserAttribute):
        raise HdlError(b"Invalid attribute type.\n")
    attribute.user_type = user_type


def set_generic_option(holder: HdlObject, name: bytes, option: bytes) -> None:
    if not find_attribute(holder, name).set_generic(option):
        raise HdlError(b"Invalid generic value.\n")


def set_synthesis_option(holder: HdlObject, name: bytes, option: bytes) -> None:
    if not find_attribute(holder, name).set_synthesis(option):
        raise HdlError(b"Invalid generic value.\n")
