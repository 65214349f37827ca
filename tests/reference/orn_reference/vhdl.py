"""The structural VHDL of a netlist."""

from __future__ import annotations

from typing import Callable, Iterable, Optional

from .attributes import (
    Attribute,
    BitAttribute,
    BitVectorAttribute,
    BooleanAttribute,
    FloatAttribute,
    HdlObject,
    IntegerAttribute,
    StringAttribute,
    UserAttribute,
    attributes_of,
    effective_attributes,
    find_init,
    split_generics,
)
from .containment import on_one_line
from .containers import StringSet
from .header import write_header
from .names import (
    MAX_EXPANDED_BITS,
    base_name,
    expand_bus,
    is_bus,
    parse_bus,
    single_bit,
    slice_name,
)
from .netlist import Netlist, has_level_halvex, longest_attribute_name, longest_name
from .objects import (
    BIDIRECTIONAL,
    INPUT,
    Bus,
    BusIndex,
    BusPin,
    BusSlice,
    Component,
    CompoundBus,
    Instance,
    Pin,
    ScalarSignal,
    Signal,
)
from .options import Options
from .streams import OutStream
from .text import equal_ignoring_case, remove_quotes

_MODES = {INPUT: b"in   ", BIDIRECTIONAL: b"inout"}
_BASE_PREFIXES = {2: b"b", 8: b"o"}
_TRANSLATE_OFF = b"-- synopsys translate_off"
_TRANSLATE_ON = b"-- synopsys translate_on"
_TYPES = {
    StringAttribute: b"string",
    IntegerAttribute: b"integer",
    FloatAttribute: b"real",
    BitAttribute: b"bit",
    BitVectorAttribute: b"bit_vector",
    BooleanAttribute: b"boolean",
}


class VhdlNetlister:
    def __init__(self, out: OutStream, options: Options) -> None:
        self._out = out
        self._options = options
        self._declared_attributes = StringSet()
        self._passes_init = False

    def write(self, netlist: Netlist) -> None:
        netlist.sort()
        netlist.create_dummy_signals()
        netlist.mark_black_boxes()
        if not self._options.open_pin:
            netlist.connect_open_pins()
        self._passes_init = (
            b"MHALVEX" in netlist.name
            and find_init(*split_generics(attributes_of(netlist))) is not None
        )
        if self._options.write_header:
            write_header(self._out, b"--", netlist.name, self._options)
        self._write_comment(netlist)
        self._out.empty_line()
        self._write_libraries()
        self._write_entity(netlist)
        self._write_architecture(netlist)
        self._out.empty_line()
        if not self._options.suppress_configuration:
            self._write_configuration(netlist)
            self._out.empty_line()

    def _write_libraries(self) -> None:
        for library in self._options.libraries:
            self._out.put_line(b"library", b" ", library, b";")
        for use_clause in self._options.use_clauses:
            self._out.put_line(b"use", b" ", use_clause, b";")
        if self._options.use_default_library:
            self._out.put_line(b"library", b" ieee;")
            self._out.put_line(b"use", b" ieee.std_logic_1164.ALL;")
            self._out.put_line(b"use", b" ieee.numeric_std.ALL;")
            self._out.put_line(b"library", b" KESTRA;")
            self._out.put_line(b"use", b" KESTRA.Vcomponents.ALL;")
            self._out.empty_line()

    def _write_comment(self, item: HdlObject) -> None:
        for line in item.comment_lines():
            self._out.put(b"-- ", on_one_line(line), b"\n")

    # Entity

    def _write_entity(self, netlist: Netlist) -> None:
        self._out.put_line(b"entity", b" ", netlist.name, b" ", b"is")
        self._out.indent()
        self._write_generic_clause(netlist)
        ports = [signal for signal in netlist.signals if _is_declared(signal) and signal.is_port()]
        width = longest_name(netlist.signals, lambda signal: signal.is_port())
        self._write_port_clause([(port.name, port.port_polarity()) for port in ports], width)
        attribute_width = longest_attribute_name(netlist)
        for port in ports:
            self._declare_attributes(port, attribute_width)
            self._assign_attributes(port, port.base_name(), b"signal")
        self._out.unindent()
        self._out.put_line(b"end", b" ", netlist.name, b";")

    def _write_port_clause(self, ports: list[tuple[bytes, int]], width: int) -> None:
        self._out.put(b"port", b" ( ")
        for number, (name, polarity) in enumerate(ports):
            if number > 0:
                self._out.put(b"; ")
                self._out.end_line()
                self._out.spaces(7)
            self._put_name_column(name, width)
            self._out.put(b":", b" ", _MODES.get(polarity, b"out  "), b" ")
            self._put_type(name)
        self._out.put_line(b");")

    def _put_name_column(self, name: bytes, width: int) -> None:
        bus = parse_bus(name)
        shown = bus.base if bus else name
        self._out.put(shown, b" ")
        self._out.spaces(width - len(shown))

    def _put_type(self, name: bytes) -> None:
        bus = parse_bus(name)
        if bus is None:
            self._out.put(b"std_logic")
        else:
            self._out.put(b"std_logic_vector", b" ")
            self._put_range(bus.left, bus.right)

    def _put_range(self, first: int, second: int) -> None:
        direction = b"downto" if first >= second else b"to"
        self._out.put(b"(", first, b" ", direction, b" ", second, b")")

    def _put_bus(self, name: bytes) -> None:
        """A bus name with its range in words; any other name as it is."""
        bus = parse_bus(name)
        if bus is None:
            self._out.put(name)
        else:
            self._out.put(bus.base)
            self._put_range(bus.left, bus.right)

    # Generic clauses and maps

    def _write_generic_clause(self, holder: HdlObject) -> None:
        syn, nosyn = split_generics(attributes_of(holder))
        self._write_generics(
            b"generic", b";", [self._declaration(a) for a in syn],
            [self._declaration(a) for a in nosyn], (b")", b";"),
        )

    def _write_instance_generics(self, instance: Instance) -> None:
        syn, nosyn = split_generics(effective_attributes(instance, instance.component))
        init = find_init(syn, nosyn) if self._passes_init else None
        first = [] if init is None else [lambda: self._out.put(init.name, b" => ", init.name)]
        self._out.indent()
        self._write_generics(
            b"generic map", b",",
            first + [self._association(a) for a in syn if a is not init],
            [self._association(a) for a in nosyn if a is not init],
            (b")",),
        )
        self._out.unindent()

    def _declaration(self, attribute: Attribute) -> Callable[[], None]:
        def put() -> None:
            self._out.put(attribute.name, b" : ", _type_name(attribute), b" :=  ")
            self._put_value(attribute)

        return put

    def _association(self, attribute: Attribute) -> Callable[[], None]:
        def put() -> None:
            self._out.put(attribute.name, b" => ")
            self._put_value(attribute)

        return put

    def _write_generics(
        self,
        keyword: bytes,
        separator: bytes,
        syn: list[Callable[[], None]],
        nosyn: list[Callable[[], None]],
        closing: tuple[bytes, ...],
    ) -> None:
        """The items that synthesis sees, then the others between directives that hide them."""
        if not syn and not nosyn:
            return
        if not syn:
            self._out.put_line(_TRANSLATE_OFF)
        self._out.put(keyword, b"( ")
        self._put_generic_items(syn or nosyn, separator)
        if syn and nosyn:
            self._out.end_line()
            self._out.put_line(_TRANSLATE_OFF)
            self._out.put_line(separator)
            self._out.spaces(9)
            self._put_generic_items(nosyn, separator)
            self._out.end_line()
            self._out.put_line(_TRANSLATE_ON)
        self._out.put_line(*closing)
        if not syn:
            self._out.put_line(_TRANSLATE_ON)

    def _put_generic_items(self, items: list[Callable[[], None]], separator: bytes) -> None:
        for number, put in enumerate(items):
            if number > 0:
                self._out.put_line(separator)
                self._out.spaces(9)
            put()

    def _put_value(self, attribute: Attribute) -> None:
        text = attribute.value_text()
        if isinstance(attribute, StringAttribute):
            self._out.put(b'"', on_one_line(remove_quotes(text)), b'"')
        elif isinstance(attribute, BitAttribute):
            self._out.put(b"'", text, b"'")
        elif isinstance(attribute, BitVectorAttribute):
            if attribute.value.has_base_and_length:
                self._out.put(_base_prefix(attribute.value.base))
            self._out.put(b'"', on_one_line(text), b'"')
        elif isinstance(attribute, UserAttribute):
            self._out.put(text or b'""')
        else:
            self._out.put(text)

    # Attributes

    def _declare_attributes(self, holder: HdlObject, width: int) -> None:
        """Declares each attribute name once in the file."""
        for attribute in attributes_of(holder):
            declared = self._declared_attributes.contains_ignoring_case(attribute.name)
            if attribute.synthesis == b"ASSIGN" and not declared:
                self._out.put(b"attribute", b" ", attribute.name, b" ")
                self._out.spaces(width - len(attribute.name))
                typed = self._options.typed_attributes
                self._out.put(b": ", _type_name(attribute) if typed else b"string")
                self._out.put_line(b" ;")
                self._declared_attributes.add(attribute.name)

    def _assign_attributes(self, holder: HdlObject, name: bytes, kind: bytes) -> None:
        for attribute in attributes_of(holder):
            if attribute.synthesis != b"NONE":
                self._assign_attribute(attribute, name, kind)

    def _assign_attribute(self, attribute: Attribute, name: bytes, kind: bytes) -> None:
        self._out.put(b"attribute", b" ", attribute.name, b" ", b"of", b" ", name)
        self._out.put(b" : ", kind, b" ", b"is", b" ")
        if self._options.typed_attributes:
            self._put_value(attribute)
        else:
            self._out.put(b'"', on_one_line(remove_quotes(attribute.value_text())), b'"')
        self._out.put_line(b";")

    def _declare_architecture_attributes(self, netlist: Netlist) -> None:
        width = longest_attribute_name(netlist)
        for signal in _inner_signals(netlist):
            self._declare_attributes(signal, width)
        for instance in netlist.instances:
            self._declare_attributes(instance.component, width)
            self._declare_attributes(instance, width)

    def _assign_architecture_attributes(self, netlist: Netlist) -> None:
        for signal in _inner_signals(netlist):
            self._assign_attributes(signal, signal.base_name(), b"signal")
        for instance in netlist.instances:
            for attribute in attributes_of(instance):
                inherited = instance.component.get_attribute(attribute.name)
                is_repeated = inherited is not None and inherited.equals(attribute)
                if attribute.synthesis != b"NONE" and not is_repeated:
                    self._assign_attribute(attribute, instance.name, b"label")

    # Architecture

    def _write_architecture(self, netlist: Netlist) -> None:
        self._out.put_line(
            b"architecture", b" BEHAVIORAL ", b"of", b" ", netlist.name, b" ", b"is"
        )
        self._out.indent()
        self._declare_architecture_attributes(netlist)
        self._write_signal_declarations(netlist)
        if not self._options.suppress_component:
            self._write_components(netlist)
        self._assign_architecture_attributes(netlist)
        self._out.unindent()
        self._out.put_line(b"begin")
        self._out.indent()
        self._write_constants(netlist)
        self._write_aliases(netlist)
        for instance in netlist.instances:
            self._write_instance(instance)
        self._out.unindent()
        self._out.put_line(b"end", b" BEHAVIORAL;")

    def _write_signal_declarations(self, netlist: Netlist) -> None:
        width = longest_name(netlist.signals, lambda signal: signal.needs_declaration())
        for signal in _inner_signals(netlist):
            self._write_comment(signal)
            self._out.put(b"signal", b" ")
            self._put_name_column(signal.name, width)
            self._out.put(b":", b" ")
            self._put_type(signal.name)
            self._out.put_line(b";")

    def _write_components(self, netlist: Netlist) -> None:
        declared = StringSet()
        for instance in netlist.instances:
            if not declared.contains_ignoring_case(instance.component.name):
                declared.add(instance.component.name)
                self._write_component(instance.component)

    def _write_component(self, component: Component) -> None:
        self._write_comment(component)
        self._out.put_line(b"component", b" ", component.name)
        self._out.indent()
        self._write_generic_clause(component)
        if component.pins:
            width = longest_name(component.pins, lambda pin: True)
            self._write_port_clause([(pin.name, pin.polarity) for pin in component.pins], width)
        self._out.unindent()
        self._out.put_line(b"end", b" ", b"component", b";")
        self._assign_attributes(component, component.name, b"component")
        self._out.empty_line()

    # Assignments

    def _write_constants(self, netlist: Netlist) -> None:
        for signal in netlist.signals:
            if signal.constant.digits and not _is_nameless(signal.name):
                if _takes_constants_by_bits(signal):
                    self._write_constant_bits(signal)
                else:
                    self._write_constant(signal)

    def _write_constant(self, signal: Signal) -> None:
        value = signal.constant
        if isinstance(signal, (ScalarSignal, BusIndex)):
            self._write_bit_constant(signal.name, value.digits)
            return
        self._put_bus(signal.name)
        self._out.put(b" <= ")
        if value.has_base_and_length:
            self._out.put(_base_prefix(value.base))
        self._out.put_line(b'"', on_one_line(value.digits), b'"', b";")

    def _write_bit_constant(self, name: bytes, digits: bytes) -> None:
        self._out.put(name, b" <= ")
        self._out.put_line(b"'", b"0" if digits.endswith(b"0") else b"1", b"'", b";")

    def _write_constant_bits(self, signal: Signal) -> None:
        """Bit by bit where the digits are the bits; else the value cannot be expressed."""
        value = signal.constant
        if value.base != 2 or set(value.digits) - set(b"01"):
            return
        if len(value.digits) != signal.width():
            return
        bits = _bits_of(signal)
        if bits is None:
            return
        for bit, digit in zip(bits, value.digits):
            if not _is_nameless(bit):
                self._out.put_line(bit, b" <= ", b"'", bytes([digit]), b"'", b";")

    def _write_aliases(self, netlist: Netlist) -> None:
        for signal in netlist.signals:
            for other in signal.signals:
                if not _is_nameless(signal.name) and not _is_nameless(other.name):
                    self._write_alias(signal, other)

    def _write_alias(self, left: Signal, right: Signal) -> None:
        left_bits = right_bits = None
        if _needs_bits(left) or _needs_bits(right):
            left_bits = _bits_of(left)
            right_bits = _bits_of(right)
        if (
            left_bits is None
            or right_bits is None
            or min(len(left_bits), len(right_bits)) > MAX_EXPANDED_BITS
        ):
            self._put_bus(left.name)
            self._out.put(b" <= ")
            self._put_bus(right.name)
            self._out.put_line(b";")
            return
        for left_bit, right_bit in zip(left_bits, right_bits):
            if not _is_nameless(left_bit) and not _is_nameless(right_bit):
                self._out.put_line(left_bit, b" <= ", right_bit, b";")

    # Instances

    def _write_instance(self, instance: Instance) -> None:
        self._write_comment(instance)
        self._out.put_line(instance.name, b" : ", instance.component.name)
        self._write_instance_generics(instance)
        self._out.indent()
        if instance.pins:
            self._out.put(b"port", b" ", b"map", b" (")
            port_map = _PortMap(self._out, self._options.one_port_per_line, self._put_bus)
            for pin in instance.pins:
                port_map.put(pin)
            self._out.put(b")")
        self._out.put_line(b";")
        self._out.unindent()

    # Configuration

    def _write_configuration(self, netlist: Netlist) -> None:
        name = netlist.name
        self._out.put_line(_TRANSLATE_OFF)
        self._out.put_line(
            b"configuration", b" ", b"CFG_", name, b" ", b"of", b"  ", name, b" ", b"is"
        )
        self._out.indent()
        self._out.put_line(b"for", b" ", b"BEHAVIORAL")
        self._out.indent()
        for component in netlist.components:
            instances = netlist.instances_of(component)
            if instances and not has_level_halvex(component):
                self._write_configuration_item(component, instances)
        self._out.unindent()
        self._out.put_line(b"end", b" ", b"for", b";")
        self._out.unindent()
        self._out.put_line(b"end", b" ", b"CFG_", name, b";")
        self._out.put_line(_TRANSLATE_ON)

    def _write_configuration_item(self, component: Component, instances: list[Instance]) -> None:
        self._out.put(b"for", b" ")
        for number, instance in enumerate(instances):
            if number > 0:
                self._out.put(b", ")
            self._out.put(instance.name)
        self._out.put_line(b" : ", component.name)
        self._out.indent()
        self._out.put_line(
            b"use", b" ", b"configuration", b" ", b"WORK.CFG_", component.name, b";"
        )
        self._out.unindent()
        self._out.put_line(b"end", b" ", b"for", b";")


class _Formal:
    """The formal side of an association: a pin's name or a piece of it."""

    def __init__(self, name: bytes) -> None:
        bit = single_bit(name)
        self.name = bit or name
        self.is_scalar = bit is not None or not is_bus(name)

    def piece(self, start: int, count: int) -> _Formal:
        """Only a range can be cut into pieces."""
        if not is_bus(self.name):
            return self
        return _Formal(slice_name(self.name, start, count))


class _PortMap:
    """Writes the associations of one instance, one after another."""

    def __init__(
        self, out: OutStream, one_per_line: bool, put_bus: Callable[[bytes], None]
    ) -> None:
        self._out = out
        self._put_bus = put_bus
        self._separator = b""
        self._installed = b",\n          " if one_per_line else b", "

    def put(self, pin: Pin) -> None:
        signal: Optional[Signal] = pin.signal
        if signal is None:
            signal = Bus(b"") if isinstance(pin, BusPin) else ScalarSignal(b"")
        self._visit(signal, _Formal(pin.name))

    def _visit(self, signal: Signal, formal: _Formal) -> None:
        if isinstance(signal, CompoundBus):
            self._visit_members(signal, formal)
        elif isinstance(signal, BusSlice):
            self._visit_slice(signal, formal)
        elif isinstance(signal, Bus):
            self._visit_bus(signal.name, formal)
        else:
            self._associate(formal.name, signal.name or b"open")

    def _visit_members(self, compound: CompoundBus, formal: _Formal) -> None:
        offset = 0
        for member in compound.members:
            width = member.width()
            if width > 0:
                self._visit(member, formal.piece(offset, width))
            offset += width

    def _visit_slice(self, part: BusSlice, formal: _Formal) -> None:
        bits = None if part.has_parents_direction() else expand_bus(part.name)
        if bits is None:
            self._start(formal)
            self._put_bus(b"open" if _is_nameless(part.name) else part.name)
            return
        for number, bit in enumerate(bits):
            self._associate(formal.piece(number, 1).name, bit)

    def _visit_bus(self, name: bytes, formal: _Formal) -> None:
        if not name:
            self._associate(base_name(formal.name), b"open")
            return
        self._start(formal)
        self._put_bus(single_bit(name) or name)

    def _start(self, formal: _Formal) -> None:
        self._put_separator()
        if formal.is_scalar:
            self._out.put(formal.name)
        else:
            self._put_bus(formal.name)
        self._out.put(b"=>")

    def _associate(self, formal: bytes, actual: bytes) -> None:
        self._put_separator()
        self._out.put(formal, b"=>", actual)

    def _put_separator(self) -> None:
        self._out.put(self._separator)
        self._separator = self._installed


def _is_nameless(name: bytes) -> bool:
    """True for names that stand for no signal at all."""
    return not name or equal_ignoring_case(name, b"open")


def _is_declared(signal: Signal) -> bool:
    return signal.needs_declaration() and not _is_nameless(signal.name)


def _inner_signals(netlist: Netlist) -> Iterable[Signal]:
    return [s for s in netlist.signals if _is_declared(s) and not s.is_port()]


def _takes_constants_by_bits(signal: Signal) -> bool:
    return (isinstance(signal, CompoundBus) or _runs_against_parent(signal)
            or isinstance(signal, BusSlice) and signal.is_bit_of_ascending_bus())


def _runs_against_parent(signal: Signal) -> bool:
    return isinstance(signal, BusSlice) and signal.runs_against_parent()


def _needs_bits(signal: Signal) -> bool:
    if isinstance(signal, (Bus, BusSlice)) and single_bit(signal.name) is not None:
        return True
    return isinstance(signal, CompoundBus) or _runs_against_parent(signal)


def _bits_of(signal: Signal) -> Optional[list[bytes]]:
    """The names of a signal's bits from left to right; None where they cannot be listed."""
    if isinstance(signal, CompoundBus):
        bits: list[bytes] = []
        for member in signal.members:
            member_bits = _bits_of(member)
            if member_bits is None:
                return None
            bits += member_bits
        return bits
    if isinstance(signal, (Bus, BusSlice)):
        return expand_bus(signal.name)
    return [signal.name]


def _type_name(attribute: Attribute) -> bytes:
    if isinstance(attribute, UserAttribute):
        return attribute.user_type
    return _TYPES[type(attribute)]


def _base_prefix(base: int) -> bytes:
    return _BASE_PREFIXES.get(base, b"x")
