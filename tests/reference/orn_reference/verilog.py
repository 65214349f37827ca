"""The structural Verilog of a netlist."""

from __future__ import annotations

from typing import Callable, Optional, Sequence

from .attributes import (
    Attribute,
    BitAttribute,
    BitVectorAttribute,
    BitVectorValue,
    BooleanAttribute,
    HdlObject,
    StringAttribute,
    UserAttribute,
    attributes_of,
    effective_attributes,
    find_init,
    split_generics,
)
from .containment import on_one_line
from .header import write_header
from .names import base_name, expand_bus, parse_bus, single_bit, to_brackets
from .netlist import Netlist
from .objects import (
    BIDIRECTIONAL,
    INPUT,
    Bus,
    BusIndex,
    BusSlice,
    CompoundBus,
    Instance,
    ScalarSignal,
    Signal,
)
from .options import Case, Options
from .streams import OutStream, Piece
from .text import equal_ignoring_case, remove_quotes

_DIRECTIONS = {INPUT: b" input", BIDIRECTIONAL: b" inout"}
_BASE_LETTERS = {2: b"b", 8: b"o"}
_LIST_INDENTATION = b" " * 22


class VerilogNetlister:
    def __init__(self, out: OutStream, options: Options) -> None:
        self._out = out
        self._options = options
        self._hierarchical_init = False

    def write(self, netlist: Netlist) -> None:
        netlist.sort()
        netlist.create_dummy_signals()
        self._set_name_case(netlist)
        self._hierarchical_init = (
            b"MHALVEX" in netlist.name or b"HHALVEX" in netlist.name
        ) and find_init(*split_generics(attributes_of(netlist))) is not None
        if self._options.write_header:
            write_header(self._out, b"//", netlist.name, self._options)
        self._write_comment(netlist)
        for include in self._options.includes:
            self._out.put_line(b'`include "' + on_one_line(remove_quotes(include)) + b'"')
        self._out.put_line(b"`timescale", b" ", b"1ns", b" / ", b"1ps")
        self._out.empty_line()
        self._write_module_head(netlist)
        self._out.indent()
        self._write_parameters(netlist)
        self._write_port_declarations(netlist)
        self._write_wire_declarations(netlist)
        self._write_constants(netlist)
        self._write_aliases(netlist)
        for instance in netlist.instances:
            self._write_instance(instance)
            self._write_defparams(instance)
        self._out.unindent()
        self._out.put_line(b"endmodule")

    def _set_name_case(self, netlist: Netlist) -> None:
        passes: tuple[tuple[Sequence[HdlObject], Case], ...] = (
            (netlist.signals, self._options.signal_case),
            (netlist.components, self._options.component_case),
            (netlist.instances, self._options.instance_case),
        )
        for objects, case in passes:
            for item in objects:
                if case is Case.UPPER:
                    item.name = item.name.upper()
                elif case is Case.LOWER:
                    item.name = item.name.lower()

    # Module head and declarations

    def _write_module_head(self, netlist: Netlist) -> None:
        self._out.put(b"module", b" ", netlist.name, b"(")
        for number, port in enumerate(filter(_is_declared_port, netlist.signals)):
            if number > 0:
                self._separate(len(netlist.name) + 8)
            self._out.put(port.base_name() if parse_bus(port.name) else port.name)
        self._out.put_line(b");")
        self._out.empty_line()

    def _separate(self, indentation: int) -> None:
        self._out.put(b", ")
        if self._options.one_port_per_line:
            self._out.end_line()
            self._out.spaces(indentation)

    def _write_parameters(self, netlist: Netlist) -> None:
        syn, nosyn = split_generics(attributes_of(netlist))
        if not syn and not nosyn:
            return
        self._write_generic_statements(syn, nosyn, lambda name: (b"parameter", b" ", name))
        self._out.empty_line()

    def _write_generic_statements(
        self,
        syn: list[Attribute],
        nosyn: list[Attribute],
        target: Callable[[bytes], tuple[Piece, ...]],
    ) -> None:
        for attribute in syn:
            self._write_generic_statement(attribute, target)
        if nosyn:
            self._out.put_line(b"// synopsys translate_off")
            for attribute in nosyn:
                self._write_generic_statement(attribute, target)
            self._out.put_line(b"// synopsys translate_on")

    def _write_generic_statement(
        self, attribute: Attribute, target: Callable[[bytes], tuple[Piece, ...]]
    ) -> None:
        self._out.put(*target(attribute.name), b" = ", *_value_pieces(attribute))
        self._out.put_line(b";")

    def _write_port_declarations(self, netlist: Netlist) -> None:
        for signal in filter(_is_declared_port, netlist.signals):
            self._write_comment(signal)
            self._out.put(_DIRECTIONS.get(signal.port_polarity(), b"output"), b" ")
            self._put_range_and_name(signal.name)
            self._end_statement(attributes_of(signal), signal.base_name())
        self._out.empty_line()

    def _write_wire_declarations(self, netlist: Netlist) -> None:
        for signal in netlist.signals:
            if _is_declared(signal) and not signal.is_port():
                self._write_comment(signal)
                self._out.put(b"wire", b" ")
                self._put_range_and_name(signal.name)
                self._end_statement(attributes_of(signal), signal.base_name())
        self._out.empty_line()

    def _put_range_and_name(self, name: bytes) -> None:
        bus = parse_bus(name)
        if bus is None:
            self._out.put(name)
        else:
            self._out.put(b"[", bus.left, b":", bus.right, b"]", b" ", bus.base)

    def _write_comment(self, item: HdlObject) -> None:
        for line in item.comment_lines():
            self._out.put(b"// ", on_one_line(line), b"\n")

    # Assignments

    def _write_constants(self, netlist: Netlist) -> None:
        for signal in netlist.signals:
            if signal.constant.digits and signal.name:
                self._out.put(b"assign", b" ")
                if isinstance(signal, (ScalarSignal, Bus)):
                    self._out.put(base_name(signal.name))
                else:
                    self._put_reference(signal)
                is_single_bit = isinstance(signal, (ScalarSignal, BusIndex))
                self._out.put(b" = ", *_constant_pieces(signal.constant, is_single_bit))
                self._out.put_line(b";")

    def _write_aliases(self, netlist: Netlist) -> None:
        for signal in netlist.signals:
            for other in signal.signals:
                if signal.name and other.name:
                    self._out.put(b"assign", b" ")
                    self._put_alias_side(signal)
                    self._out.put(b" = ")
                    self._put_alias_side(other)
                    self._out.put_line(b";")

    def _put_alias_side(self, signal: Signal) -> None:
        if not isinstance(signal, (ScalarSignal, Bus)):
            self._put_reference(signal)
            return
        bus = parse_bus(signal.name)
        if bus is None:
            self._out.put(signal.name)
        else:
            self._out.put(bus.base, b"[", bus.left, b":", bus.right, b"]")

    def _put_reference(self, signal: Signal, on_pin: bool = False) -> None:
        """The signal as an expression; on a pin nothing for one that stands for an open pin."""
        name = signal.name
        if on_pin and (not name or equal_ignoring_case(name, b"open")):
            return
        if isinstance(signal, CompoundBus):
            self._out.put(b"{")
            for number, member in enumerate(signal.members):
                if number > 0:
                    self._out.put(b", ")
                self._put_reference(member, on_pin)
            self._out.put(b"}")
        elif isinstance(signal, BusSlice) and signal.runs_against_parent() and expand_bus(name):
            pieces: list[Piece] = []
            for bit in expand_bus(name):
                pieces += [b", ", to_brackets(bit)]
            self._out.put(b"{", *pieces[1:], b"}")
        elif isinstance(signal, ScalarSignal):
            self._out.put(name)
        elif isinstance(signal, Bus):
            self._out.put(to_brackets(single_bit(name) or name))
        else:
            self._out.put(to_brackets(name))

    # Instances

    def _write_instance(self, instance: Instance) -> None:
        component = instance.component
        self._write_comment(component)
        self._write_comment(instance)
        self._out.put(component.name, b" ", instance.name, b" ", b"(")
        for number, pin in enumerate(instance.pins):
            if number > 0:
                self._separate(len(component.name) + len(instance.name) + 3)
            self._out.put(b".", pin.base_name(), b"(")
            if pin.signal is not None:
                self._put_reference(pin.signal, on_pin=True)
            self._out.put(b")")
        self._out.put(b")")
        self._end_statement(effective_attributes(instance, component), instance.name)

    def _write_defparams(self, instance: Instance) -> None:
        syn, nosyn = split_generics(effective_attributes(instance, instance.component))
        init = self._init_to_pass_down(instance)
        if init is not None:
            self._out.put(b"defparam", b" ", instance.name, b".", init.name, b" = ", init.name)
            self._out.put_line(b";")
        self._write_generic_statements(
            [attribute for attribute in syn if attribute is not init],
            nosyn,
            lambda name: (b"defparam", b" ", instance.name, b".", name),
        )

    def _init_to_pass_down(self, instance: Instance) -> Optional[Attribute]:
        if not self._hierarchical_init:
            return None
        return find_init(*split_generics(effective_attributes(instance, instance.component)))

    # Ends of statements and synthesis attributes

    def _end_statement(self, attributes: list[Attribute], name: bytes) -> None:
        """The semicolon with the synthesis attributes behind it or, for one tool, before it."""
        marked = [attribute for attribute in attributes if attribute.synthesis != b"NONE"]
        if self._options.synthesis_type == b"SYNPLICITY":
            self._write_synplicity_attributes(marked)
            self._out.put_line(b";")
            return
        self._out.put_line(b";")
        if self._options.synthesis_type == b"SYNOPSYS":
            self._write_synopsys_attributes(marked)
        elif self._options.synthesis_type != b"VERILOG2001":
            for attribute in marked:
                self._write_attribute_line(attribute, name)

    def _write_attribute_line(self, attribute: Attribute, owner: bytes) -> None:
        value = on_one_line(remove_quotes(attribute.value_text()))
        name = attribute.name
        forms: dict[bytes, tuple[bytes, ...]] = {
            b"EXEMPLAR": (b"// exemplar attribute ", owner, b" ", name, b" ", value),
            b"PRECISION": (b"//pragma attribute ", owner, b" ", name, b" ", value),
            b"QSN": (
                b"// synthesis attribute ", name, b" ", b"of", b" ", owner, b" ", b"is", b" ",
                b'"', value, b'"',
            ),
        }
        self._out.put_line(*forms[self._options.synthesis_type])

    def _write_synplicity_attributes(self, attributes: list[Attribute]) -> None:
        for number, attribute in enumerate(attributes):
            if number == 0:
                self._out.put(b'/* synthesis "')
            else:
                self._out.put_line(b", \\")
                self._out.put(_LIST_INDENTATION)
            self._out.put(attribute.name, b"=", on_one_line(remove_quotes(attribute.value_text())))
        if attributes:
            self._out.put(b'" ', b"*/")

    def _write_synopsys_attributes(self, attributes: list[Attribute]) -> None:
        for number, attribute in enumerate(attributes):
            if number == 0:
                self._out.put(b"/* synopsys attribute ")
            else:
                self._out.end_line()
                self._out.put(_LIST_INDENTATION)
            value = on_one_line(remove_quotes(attribute.value_text()))
            self._out.put(attribute.name, b" ", b'"', value, b'"')
        if attributes:
            self._out.put_line(b" */")


def _is_declared(signal: Signal) -> bool:
    return signal.needs_declaration() and signal.name != b""


def _is_declared_port(signal: Signal) -> bool:
    return _is_declared(signal) and signal.is_port()


def _base_pieces(value: BitVectorValue) -> tuple[Piece, ...]:
    if not value.has_base_and_length:
        return ()
    return value.length, b"'", _BASE_LETTERS.get(value.base, b"h")


def _constant_pieces(value: BitVectorValue, is_single_bit: bool) -> tuple[Piece, ...]:
    if is_single_bit:
        return (b"0" if value.digits.endswith(b"0") else b"1",)
    return *_base_pieces(value), on_one_line(value.digits, b"_")


def _value_pieces(attribute: Attribute) -> tuple[Piece, ...]:
    text = attribute.value_text()
    if isinstance(attribute, StringAttribute):
        return b'"', on_one_line(remove_quotes(text)), b'"'
    if isinstance(attribute, (BooleanAttribute, UserAttribute)):
        return b'"', on_one_line(text), b'"'
    if isinstance(attribute, BitAttribute):
        return b"1'b", text
    if isinstance(attribute, BitVectorAttribute):
        return *_base_pieces(attribute.value), on_one_line(text, b"_")
    return (text,)
