#!/usr/bin/env python3
"""Checks of the reference itself against results worked out by hand."""

from __future__ import annotations

import itertools
import os
import tempfile
import unittest

from generate import KINDS, generate
from orn_reference.attributes import BitVectorValue, create_attribute
from orn_reference.commands import execute, find_phrase, phrases
from orn_reference.containers import HashTable, NameMap, StringSet, hash_name
from orn_reference.header import mask_free_lines
from orn_reference.model import HdlError, Model
from orn_reference.names import (
    base_name,
    compare_naturally,
    compound_members,
    expand_bus,
    is_base_name,
    is_bit,
    is_bus,
    is_compound,
    normalize,
    parse_bus,
    slice_name,
)
from orn_reference.netlist import longest_name
from orn_reference.objects import (
    Bus,
    BusIndex,
    BusSlice,
    CompoundBus,
    ScalarSignal,
    create_pin,
    polarity_of,
)
from orn_reference.options import Options
from orn_reference.replay import lines_of, replay
from orn_reference.streams import OutStream
from orn_reference.text import INT_MAX, atof, atoi, remove_quotes
from orn_reference.tokenizer import split_command

AND2_DESIGN = """
ADD COMPONENT AND2
ADD PIN AND2 I0 in
ADD PIN AND2 I1 in
ADD PIN AND2 O out
ADD PORT A[1:0] in
ADD PORT Y out
ADD SIGNAL n1
ADD INSTANCE AND2 U1
CONNECT SIGNAL A(0) U1.I0
CONNECT SIGNAL n1 U1.I1
CONNECT SIGNAL Y U1.O
"""
ONE_GATE = """
ADD COMPONENT G
ADD PIN G I in
ADD PIN G O out
ADD INSTANCE G U1
"""


def run(text: str) -> tuple[Model, list[bytes]]:
    """A model after these lines, and the messages of those that failed."""
    model = Model(b"top")
    messages = []
    for line in lines_of(text.encode("latin-1")):
        try:
            execute(model, line)
        except HdlError as error:
            messages.append(error.description)
    return model, messages


def build(text: str) -> Model:
    model, messages = run(text)
    assert not messages, messages
    return model


def write(model: Model, language: str, flags: str = "-NOHEADER") -> list[str]:
    """The lines that a write command gives."""
    previous = os.getcwd()
    with tempfile.TemporaryDirectory() as folder:
        os.chdir(folder)
        try:
            execute(model, f"WRITE {language} {flags} out".encode("ascii"))
            with open("out", "rb") as file:
                text = file.read()
        finally:
            os.chdir(previous)
    assert text.endswith(b"\n")
    return text.decode("latin-1").split("\n")[:-1]


def verilog(text: str) -> list[str]:
    return write(build(text), "VERILOG")


def vhdl(text: str) -> list[str]:
    return write(build(text), "VHDL")


def signal_names(model: Model) -> list[bytes]:
    return [signal.name for signal in model.netlist.signals]


class CommandLines(unittest.TestCase):
    def test_words(self) -> None:
        cases = {
            b"ADD  COMPONENT   AND2 ": [b"ADD", b"COMPONENT", b"AND2"],
            b'SET NAME "a b" x': [b"SET", b"NAME", b"a b", b"x"],
            b'SET NAME "" x': [b"SET", b"NAME", b"", b"x"],
            b'SET NAME ""': [b"SET", b"NAME"],
            b"it's": [b"it's"],
            b"'it s'": [b"it s"],
            b'"ab"cd ef"': [b"abcd ef"],
            b'"a\\"b"': [b'a"b'],
            b'"a\\nb"': [b"a\\nb"],
            b'"abc': [b"abc"],
            b'""': [],
            b'"" ""': [b""],
            b"add\tcomponent": [b"add\tcomponent"],
            b"\"it's\" 'x\"y'": [b"it's", b'x"y'],
            b"": [],
            b"   ": [],
        }
        for line, words in cases.items():
            self.assertEqual(split_command(line), words, line)

    def test_lines(self) -> None:
        self.assertEqual(list(lines_of(b"")), [])
        self.assertEqual(list(lines_of(b"\n")), [b""])
        self.assertEqual(list(lines_of(b"a\r\nb\r\r\nc")), [b"a", b"b\r", b"c"])
        self.assertEqual(list(lines_of(b"a\0b\r\n\0")), [b"a", b""])

    def test_longest_phrase_wins(self) -> None:
        self.assertEqual(len(phrases()), 61)
        self.assertEqual(find_phrase([b"add", b"Component", b"x"]), b"ADD COMPONENT")
        words = [b"ADD", b"COMPONENT", b"pin", b"COMMENT", b"a.b", b"c"]
        self.assertEqual(find_phrase(words), b"ADD COMPONENT PIN COMMENT")
        self.assertEqual(find_phrase([b"ADD COMPONENT", b"x"]), b"ADD COMPONENT")
        self.assertIsNone(find_phrase([b"ADD"]))

    def test_messages_of_bad_lines(self) -> None:
        cases = {
            "SET NETLIST NAME": b"SET NETLIST NAME: Invalid Arguments.\n",
            "add pin AND2": b"ADD PIN: Invalid Arguments.\n",
            "ADD PIN AND2 A sideways": b"ADD PIN: Invalid Arguments.\n",
            "UPPERCASE SIGNAL": b"UPPERCASE: Invalid Arguments.\n",
            "LOWERCASE siganl": b"LOWERCASE: Invalid Arguments.\n",
            "set device": b"Set Device: Invalid Arguments.\n",
            "ADD SIGNAL a nowhere": b"ADD SIGNAL: Invalid Arguments.\n",
            "ADD COMPONENT PIN COMMENT AND2 text": b"ADD COMPONENT PIN COMMENT: "
            b"Invalid Arguments.\n",
            "SET MODULE ATTRIBUTE OPTION a b": b"SET MODULE ATTRIBUTE OPTION: "
            b"Invalid Arguments.\n",
            "WRITE VERILOG": b"WRITE VERILOG: Invalid Arguments.\n",
            "ADD": b"Command not find.\n",
            "# comment": b"Command not find.\n",
            "add\tcomponent x": b"Command not find.\n",
        }
        for line, message in cases.items():
            self.assertEqual(run(line)[1], [message], line)
        self.assertEqual(run("NOOP\n\n   \nUPPERCASE SIGANL")[1], [])

    def test_flags(self) -> None:
        self.assertTrue(build("FLATTEN BUS").options.flatten_bus)
        self.assertFalse(build("FLATTEN BUS\nFLATTEN BUS FALSE").options.flatten_bus)
        self.assertFalse(build("set open pin false").options.open_pin)

    def test_joined_text(self) -> None:
        model = build('ADD NOTES a  b\nADD MODULE COMMENT "c  d" e')
        self.assertEqual(model.netlist.comment, b"a b\nc  d e\n")

    def test_replay_stops_at_the_first_failure(self) -> None:
        with tempfile.TemporaryDirectory() as folder:
            name = os.fsencode(os.path.join(folder, "my.design.cmd"))
            with open(name, "wb") as file:
                file.write(b"NOOP\nnonsense\nmore nonsense\n")
            stopped = replay(name)
            self.assertEqual(stopped.messages, [name + b":2: error: Command not find."])
            self.assertEqual((stopped.status, replay(folder.encode()).status), (1, 3))
            self.assertEqual(len(replay(name, keep_going=True).messages), 2)


class Names(unittest.TestCase):
    def test_forms(self) -> None:
        self.assertEqual(normalize(b"A[3-0]{x}<y>"), b"A(3:0)(x)(y)")
        self.assertTrue(is_base_name(b"'a_1"))
        for name in (b"", b"a'b", b"1a", b"a b", b"a\n"):
            self.assertFalse(is_base_name(name), name)
        for name in (b"A(7:0)", b"A(+7:-0)", b"A(0:7)"):
            self.assertTrue(is_bus(name), name)
        for name in (b"A(7)", b"A(7:0)x", b"A[7:0]", b"A(:0)", b"(1:0)", b"A((1:0)"):
            self.assertFalse(is_bus(name), name)
        self.assertTrue(is_bit(b"A(3)"))
        self.assertFalse(is_bit(b"A()"))
        self.assertTrue(is_compound(b"A,B(3:0)\\K(2)"))
        self.assertFalse(is_compound(b"A"))
        self.assertEqual(compound_members(b",A,,B\\C,"), [b"A", b"B", b"C"])

    def test_base_name(self) -> None:
        cases = {b"A(3)": b"A", b"A[3]": b"A", b"A,B(3)": b"A,B(3)", b"A": b"A", b"A(": b"A("}
        for name, base in cases.items():
            self.assertEqual(base_name(name), base)

    def test_indices(self) -> None:
        self.assertEqual(expand_bus(b"D(2:0)"), [b"D(2)", b"D(1)", b"D(0)"])
        self.assertEqual(expand_bus(b"D(0:1)"), [b"D(0)", b"D(1)"])
        self.assertIsNone(expand_bus(b"D(1048576:0)"))
        self.assertEqual(parse_bus(b"D(99999999999:0)").width, INT_MAX)
        self.assertEqual(slice_name(b"D(7:0)", 0, 4), b"D(7:4)")
        self.assertEqual(slice_name(b"D(0:7)", 2, 1), b"D(2:2)")
        self.assertEqual(slice_name(b"D", 2, 1), b"D(2:1)")

    def test_natural_order(self) -> None:
        ascending = [b"", b"A", b"a_B", b"A1", b"a1b", b"A2", b"A10", b"A010", b"b"]
        for first, second in zip(ascending, ascending[1:]):
            self.assertLess(compare_naturally(first, second), 0, (first, second))
            self.assertGreater(compare_naturally(second, first), 0, (first, second))
        self.assertEqual(compare_naturally(b"u1", b"U1"), 0)

    def test_numbers(self) -> None:
        numbers = {b"12abc": 12, b"abc": 0, b" \t-7": -7, b"+": 0, b"9" * 5000: INT_MAX}
        for text, number in numbers.items():
            self.assertEqual(atoi(text), number)
        floats = {b"12.345": 12.345, b".5x": 0.5, b"1e999": 0.0, b"inf": 0.0, b"0x1p4": 16.0}
        for text, value in floats.items():
            self.assertEqual(atof(text), value)

    def test_quotes(self) -> None:
        cases = {b'""a""': b"a", b"'a'": b"a", b"\"'a'\"": b"'a'", b'"': b"", b'"a': b'"a'}
        for text, plain in cases.items():
            self.assertEqual(remove_quotes(text), plain)


class Containers(unittest.TestCase):
    def test_hash(self) -> None:
        self.assertEqual(hash_name(b""), 5381)
        self.assertEqual(hash_name(b"ab"), (5381 * 33 + 97) * 33 + 98)
        self.assertEqual(hash_name(b"\xff"), 5381 * 33 - 1)

    def test_walk_order(self) -> None:
        a, b, c = [n for n in (b"n%d" % i for i in range(3000)) if hash_name(n) % 193 == 7][:3]
        table = HashTable()
        for name in (a, b, c):
            table.add(name)
        self.assertEqual(list(table), [a, c, b])
        table.remove(a)
        table.add(a)
        self.assertEqual(list(table), [c, a, b])

    def test_growth_reverses_a_bucket(self) -> None:
        names = (b"n%x" % (i * 7919) for i in itertools.count())
        meeting = (n for n in names if hash_name(n) % 193 == 5 and hash_name(n) % 389 == 5)
        a, b, c = itertools.islice(meeting, 3)
        others = (b"m%d" % i for i in itertools.count())
        rest = list(itertools.islice((n for n in others if hash_name(n) % 193 != 5), 191))
        table = HashTable()
        for name in [a, b, c] + rest[:190]:
            table.add(name)
        self.assertEqual([n for n in table if n in (a, b, c)], [a, c, b])
        table.add(rest[190])
        self.assertEqual([n for n in table if n in (a, b, c)], [b, c, a])

    def test_set(self) -> None:
        names = StringSet()
        names.add(b"a")
        names.add(b"A")
        self.assertTrue(names.contains(b"A") and names.contains_ignoring_case(b"a"))
        self.assertEqual(sorted(names), [b"A", b"a"])
        names.remove(b"A")
        self.assertEqual(list(names), [b"a"])
        self.assertFalse(names.contains_ignoring_case(b"a"))
        names.add(b"b")
        names.empty()
        self.assertTrue(names.is_empty() and names.contains_ignoring_case(b"B"))

    def test_map(self) -> None:
        table: NameMap[int] = NameMap()
        table.add(b"Clk", 1)
        table.add(b"CLK", 2)
        self.assertEqual((table.get(b"clk"), table.get(b"x")), (2, None))


class Streams(unittest.TestCase):
    def test_indentation(self) -> None:
        out = OutStream(b"")
        out.indent()
        out.indent()
        out.put_line(b"a")
        out.end_line()
        out.empty_line()
        self.assertEqual(out.close(), b"      a\n      \n\n")

    def test_break_at_the_last_blank(self) -> None:
        out = OutStream(b"")
        out.put(b"x" * 30 + b", " + b"y" * 48, b"z")
        self.assertEqual(out.close(), b"x" * 30 + b", \n      " + b"y" * 48 + b"z\n")

    def test_break_at_a_comma_or_the_end(self) -> None:
        out = OutStream(b"")
        out.put(b"x" * 30 + b"," + b"y" * 49, b"z")
        self.assertEqual(out.close(), b"x" * 30 + b",\n      " + b"y" * 49 + b"z\n")
        out = OutStream(b"")
        out.put(b"x" * 80, b"z")
        self.assertEqual(out.close(), b"x" * 80 + b"\n      z\n")

    def test_long_piece_on_an_empty_line(self) -> None:
        out = OutStream(b"")
        out.put(b"x" * 81)
        self.assertEqual(out.close(), b"\n      " + b"x" * 81 + b"\n")

    def test_no_break_in_literals_and_comments(self) -> None:
        out = OutStream(b"")
        out.put(b"a ", b'"', b"b " * 35, b"c " * 10)
        self.assertEqual(out.close(), b'a \n      "' + b"b " * 35 + b"c " * 10 + b"\n")
        out = OutStream(b"")
        out.put(b"// ", b"b " * 60, b"c")
        self.assertEqual(out.close(), b"// " + b"b " * 60 + b"c\n")


class Attributes(unittest.TestCase):
    def test_values(self) -> None:
        cases = [
            (b"String", b'"a"', b'"a"'),
            (b"integer", b"12abc", b"12"),
            (b"Integer", b"", b"0"),
            (b"Float", b"5", b"5.0"),
            (b"Float", b"12.345", b"12.345"),
            (b"Float", b"3.14159", b"3.14159"),
            (b"Float", b".5", b"0.5"),
            (b"Float", b"abc", b"  0.0"),
            (b"Float", b"", b"0.0"),
            (b"Boolean", b"TRUE", b"TRUE"),
            (b"Boolean", b"yes", b"FALSE"),
            (b"Bit", b"1", b"1"),
            (b"Bit", b"01", b"0"),
            (b"BitVector", b"8:H:A5", b"A5"),
            (b"User", b"RED", b"RED"),
        ]
        for type_name, text, shown in cases:
            self.assertEqual(create_attribute(type_name, b"n", text).value_text(), shown)
        self.assertIsNone(create_attribute(b"", b"n", b""))

    def test_bit_vectors(self) -> None:
        given = BitVectorValue(b"8:H:A5:x")
        self.assertEqual((given.length, given.base, given.digits), (8, 16, b"A5"))
        plain = BitVectorValue(b"8:H")
        self.assertEqual((plain.length, plain.base, plain.digits), (1, 2, b"8:H"))
        self.assertFalse(plain.has_base_and_length)

    def test_options(self) -> None:
        attribute = create_attribute(b"String", b"n", b"v")
        self.assertTrue(attribute.set_generic(b"syn"))
        self.assertFalse(attribute.set_synthesis(b"ASSIGN_NODEC"))
        self.assertEqual((attribute.generic, attribute.synthesis), (b"SYN", b"NONE"))

    def test_commands(self) -> None:
        model, messages = run(
            ONE_GATE
            + "ADD MODULE ATTRIBUTE A 1\nADD MODULE ATTRIBUTE -TYPE=Integer a 2\n"
            + "SET MODULE ATTRIBUTE USERTYPE A t\nADD MODULE ATTRIBUTE -TYPE= B\n"
            + "SET MODULE ATTRIBUTE OPTION A -GENERIC=SYN -SYNATTR=bad\n"
            + "SET MODULE ATTRIBUTE VALUE C 1\nADD COMPONENT ATTRIBUTE G X 1\n"
            + "SET INSTANCE ATTRIBUTE VALUE U1 x 2\nADD SIGNAL ATTRIBUTE s X 1\n"
            + "ADD INSTANCE PIN ATTRIBUTE U9.I X 1\nADD MODULE ATTRIBUTE -TYPE=User\n"
        )
        self.assertEqual(
            messages,
            [
                b"Invalid attribute type.\n",
                b"Invalid attribute type.\n",
                b"Invalid generic value.\n",
                b'Attribute "C" not found.\n',
                b'"s" not found.\n',
                b'Pin "I" not found.\n',
                b"ADD MODULE ATTRIBUTE: Invalid Arguments.\n",
            ],
        )
        attribute = model.netlist.get_attribute(b"a")
        self.assertEqual((attribute.type_name, attribute.value_text()), (b"String", b"2"))
        self.assertEqual(attribute.generic, b"SYN")
        component = model.netlist.get_component(b"g")
        self.assertEqual(component.get_attribute(b"X").value_text(), b"2")


class SignalsAndPins(unittest.TestCase):
    def test_polarity(self) -> None:
        cases = {b"in": 0, b"I": 0, b"OUT": 1, b"b": 2, b"bidir": 2, b"": -1, b"input2": -1}
        for text, value in cases.items():
            self.assertEqual(polarity_of(text), value)

    def test_widths_and_directions(self) -> None:
        bus = Bus(b"D[0-7]")
        part = BusSlice(b"D(3:0)", bus)
        compound = CompoundBus(b"A,D(3:0)")
        compound.members = [ScalarSignal(b"A"), part]
        self.assertEqual((bus.name, bus.width(), compound.width()), (b"D(0:7)", 8, 5))
        self.assertTrue(part.runs_against_parent())
        self.assertFalse(BusSlice(b"D(3:3)", bus).runs_against_parent())
        self.assertEqual(compound.dummy_name(), b"A_DUMMY,D_DUMMY(3:0)")

    def test_dummy_names(self) -> None:
        self.assertEqual(ScalarSignal(b"X_dummy").dummy_name(), b"X_dummy")
        self.assertEqual(Bus(b"D(+7:0)").dummy_name(), b"D_DUMMY(+7:0)")
        self.assertEqual(Bus(b"D_DUMMY(7:0)").dummy_name(), b"D_DUMMY(7:0)")
        self.assertEqual(BusIndex(b"D_DUMMY(7)", None).dummy_name(), b"D_DUMMY_DUMMY(7)")

    def test_connections(self) -> None:
        signal, other, pin = ScalarSignal(b"a"), ScalarSignal(b"b"), create_pin(b"p", 1)
        signal.connect_pin(pin)
        signal.connect_pin(pin)
        signal.connect_signal(other)
        signal.connect_signal(other)
        signal.connect_signal(signal)
        self.assertEqual((len(signal.pins), signal.signals, other.signals), (1, [other], []))
        other.clone_connections(signal)
        self.assertIs(pin.signal, other)
        self.assertEqual(other.signals, [])

    def test_port_polarity(self) -> None:
        bus = Bus(b"D(1:0)")
        bit = BusIndex(b"D(0)", bus)
        self.assertFalse(bit.is_port())
        bus.polarity = 1
        compound = CompoundBus(b"D(0),x")
        compound.members = [bit]
        self.assertTrue(bit.is_port())
        self.assertEqual(compound.port_polarity(), 1)
        compound.members.append(ScalarSignal(b"x"))
        self.assertEqual(compound.port_polarity(), -1)


class Models(unittest.TestCase):
    def test_one_name_space(self) -> None:
        self.assertEqual(
            run("ADD COMPONENT X\nADD SIGNAL x\nADD INSTANCE X X\nADD INSTANCE Y U\nADD PIN X A i\n"
                "ADD PIN x a o\nADD PORT X in\n")[1],
            [
                b'Identifier "x" already defined.\n',
                b'Identifier "X" already defined.\n',
                b'Component "Y" not found.\n',
                b'Component "x" already has pin "a".\n',
                b'Identifier "X" already defined.\n',
            ],
        )

    def test_missing_things(self) -> None:
        self.assertEqual(
            run(ONE_GATE + "CONNECT SIGNAL N1 U9.A\nCONNECT SIGNAL N1 U1.A\n"
                "ASSIGN CONSTANT U9.A 1\nASSIGN CONSTANT U1.A 1\nCONNECT SIGNAL Z(3) N1\n")[1],
            [
                b'Signal "U9" not found.\n',
                b'Pin "U1.A" not found.\n',
                b'Signal "U9" not found.\n',
                b'Pin "A" not found.\n',
                b'Signal "Z(3)" not found.\n',
            ],
        )

    def test_signals_on_first_use(self) -> None:
        model, messages = run(
            "ADD SIGNAL B[7-0]\nCONNECT SIGNAL B(3) X\nCONNECT SIGNAL B<2> X\n"
            "CONNECT SIGNAL B<3:0> X\nADD SIGNAL A(7:0)\nADD SIGNAL A(3:0)\nCONNECT SIGNAL b(1) X"
        )
        self.assertEqual(
            signal_names(model), [b"B(7:0)", b"B(3)", b"X", b"B(2)", b"A(7:0)", b"B(1)"]
        )
        kinds = [type(model.netlist.get_signal(name)) for name in (b"B(3)", b"B(2)", b"B(1)")]
        self.assertEqual(kinds, [BusIndex, ScalarSignal, BusIndex])
        self.assertEqual(
            messages,
            [b'Signal "B<3:0>" already declared.\n', b'Signal "A(3:0)" already declared.\n'],
        )

    def test_negative_index_is_no_bus(self) -> None:
        model = build("CONNECT SIGNAL A(-1:0) X")
        self.assertIsInstance(model.netlist.get_signal(b"A(:1:0)"), ScalarSignal)

    def test_widening(self) -> None:
        model = build(
            ONE_GATE + "ADD PORT Q(7:0) out\nADD SIGNAL COMMENT Q(7:0) c\n"
            "CONNECT SIGNAL Q(7:0) U1.O\nCONNECT SIGNAL Q(3) U1.I\nCONNECT SIGNAL R Q(7:0)\n"
            "CONNECT SIGNAL Q(7:0),R S\nASSIGN CONSTANT Q(7:0) 1\nCONNECT SIGNAL q(15:0) T"
        )
        new, part = (model.netlist.get_signal(name) for name in (b"Q(15:0)", b"Q(7:0)"))
        bit = model.netlist.get_signal(b"Q(3)")
        self.assertEqual(signal_names(model)[-3:], [b"Q(15:0)", b"Q(7:0)", b"T"])
        self.assertEqual((new.polarity, new.comment, new.constant.digits), (1, b"c\n", b""))
        self.assertEqual((new.parts, bit.parent), ([part, bit], new))
        self.assertEqual([pin.name for pin in part.pins.values()], [b"O"])
        self.assertEqual(part.constant.digits, b"1")
        self.assertIs(model.netlist.get_signal(b"R").signals[0], part)
        self.assertIs(model.netlist.get_signal(b"Q(7:0),R").members[0], part)

    def test_second_signal_widens_the_first(self) -> None:
        model = build("CONNECT SIGNAL Q(7:0) Q(15:0)")
        part = model.netlist.get_signal(b"Q(7:0)")
        self.assertIsInstance(part, BusSlice)
        self.assertEqual(part.signals, [model.netlist.get_signal(b"Q(15:0)")])

    def test_compounds(self) -> None:
        model = build("ADD SIGNAL B(7:0)\nCONNECT SIGNAL A,B(3:0)\\K(2),,B(1) X")
        compound = model.netlist.get_signal(b"a,b(3:0)\\k(2),,b(1)")
        self.assertEqual(
            [(member.name, type(member)) for member in compound.members],
            [(b"A", ScalarSignal), (b"B(3:0)", BusSlice), (b"K(2)", ScalarSignal),
             (b"B(1)", BusIndex)],
        )

    def test_constants_on_pins(self) -> None:
        model = build(
            "ADD COMPONENT C\nADD PIN C CE in\nADD PIN C D(3:0) in\nADD PIN C S(1) in\n"
            "ADD INSTANCE C U1\nASSIGN CONSTANT U1.ce 1\nASSIGN CONSTANT U1.D[3-0] 4:H:A\n"
            "ASSIGN CONSTANT U1.S(1) 0"
        )
        self.assertEqual(
            signal_names(model),
            [b"U1_CE_CONST_SIGNAL", b"U1_D_CONST_SIGNAL(3:0)", b"U1_S_CONST_SIGNAL(1)"],
        )
        self.assertEqual(model.netlist.signals[0].pins, {})

    def test_sorting(self) -> None:
        model = build(
            "ADD COMPONENT C\nADD PIN C O out\nADD PIN C I2 in\nADD PIN C I10 in\n"
            "ADD INSTANCE C U10\nADD INSTANCE C U2\nADD INSTANCE C U1\nADD PIN C late in\n"
            "ADD PORT y out\nADD PORT b inout\nADD SIGNAL n\nADD PORT i in"
            .replace("inout", "bi")
        )
        model.netlist.sort()
        self.assertEqual([i.name for i in model.netlist.instances], [b"U1", b"U2", b"U10"])
        pins = [pin.name for pin in model.netlist.instances[0].pins]
        self.assertEqual(pins, [b"I2", b"I10", b"O"])
        self.assertEqual(signal_names(model), [b"n", b"i", b"y", b"b"])
        self.assertEqual(longest_name(model.netlist.signals, lambda signal: True), 1)


class Dummies(unittest.TestCase):
    def test_read_output(self) -> None:
        lines = verilog(ONE_GATE + "ADD PORT S out\nCONNECT SIGNAL S U1.O\nCONNECT SIGNAL S U1.I\n")
        self.assertIn("   wire S_DUMMY;", lines)
        self.assertIn("   assign S = S_DUMMY;", lines)
        self.assertIn("   G U1 (.I(S_DUMMY), ", lines)
        self.assertIn("         .O(S_DUMMY));", lines)

    def test_port_keeps_one_driver(self) -> None:
        model = build(
            ONE_GATE + "ADD PORT S out\nCONNECT SIGNAL S U1.I\nCONNECT SIGNAL S n\n"
            "ASSIGN CONSTANT S 1\n"
        )
        model.netlist.create_dummy_signals()
        port, dummy = (model.netlist.get_signal(name) for name in (b"S", b"S_DUMMY"))
        self.assertEqual((port.signals, port.constant.digits), ([dummy], b""))
        self.assertEqual([signal.name for signal in dummy.signals], [b"n"])
        self.assertEqual(dummy.constant.digits, b"1")

    def test_driven_input(self) -> None:
        model = build(ONE_GATE + "ADD PORT X in\nCONNECT SIGNAL X U1.O\nCONNECT SIGNAL X n\n")
        model.netlist.create_dummy_signals()
        port, dummy = (model.netlist.get_signal(name) for name in (b"X", b"X_DUMMY"))
        self.assertEqual([signal.name for signal in port.signals], [b"n"])
        self.assertEqual([signal.name for signal in dummy.signals], [b"n", b"X"])

    def test_bus_with_parts_and_compound(self) -> None:
        model = build(
            ONE_GATE + "ADD PORT Q(3:0) out\nCONNECT SIGNAL Q(1:0) n\nCONNECT SIGNAL Q(2) U1.I\n"
            "CONNECT SIGNAL Q(1:0),k U1.O\n"
        )
        model.netlist.create_dummy_signals()
        self.assertEqual(
            signal_names(model)[-3:], [b"Q_DUMMY(3:0)", b"Q_DUMMY(1:0)", b"Q_DUMMY(2)"]
        )
        compound = model.netlist.get_signal(b"Q(1:0),k")
        self.assertEqual([member.name for member in compound.members], [b"Q_DUMMY(1:0)", b"k"])

    def test_compound_gets_a_dummy(self) -> None:
        model = build(ONE_GATE + "ADD PORT S out\nCONNECT SIGNAL S,k U1.I\n")
        model.netlist.create_dummy_signals()
        dummy = model.netlist.instances[0].pins[0].signal
        self.assertEqual(dummy.name, b"S_DUMMY,k_DUMMY")
        self.assertEqual([member.name for member in dummy.members], [b"S_DUMMY", b"k"])

    def test_wired_or(self) -> None:
        model = build(
            ONE_GATE + "ADD INSTANCE G U2\nADD PORT S out\nCONNECT SIGNAL S U1.O\n"
            "CONNECT SIGNAL S U2.O\n"
        )
        model.netlist.create_dummy_signals()
        self.assertIsNotNone(model.netlist.get_signal(b"S_DUMMY"))

    def test_taken_name(self) -> None:
        model = build(ONE_GATE + "ADD PORT S out\nADD SIGNAL s_dummy\nCONNECT SIGNAL S U1.I\n")
        model.netlist.create_dummy_signals()
        self.assertEqual(len(model.netlist.signals), 2)

    def test_writing_again(self) -> None:
        model = build(ONE_GATE + "ADD PORT S out\nCONNECT SIGNAL S U1.O\nCONNECT SIGNAL S U1.I\n")
        first = write(model, "VERILOG")
        self.assertEqual(first, write(model, "VERILOG"))
        execute(model, b"ADD INSTANCE G U2")
        execute(model, b"CONNECT SIGNAL S U2.I")
        execute(model, b"CONNECT SIGNAL S n")
        lines = write(model, "VERILOG")
        self.assertEqual([line for line in lines if "assign" in line],
                         ["   assign S_DUMMY = n;", "   assign S = S_DUMMY;"])
        self.assertIn("   G U2 (.I(S_DUMMY), ", lines)

    def test_open_pins(self) -> None:
        model = build(
            "ADD COMPONENT C\nADD PIN C A in\nADD PIN C D(3:0) in\nADD PIN C S(1) in\n"
            "ADD PIN C O out\nADD INSTANCE C U1\nSET OPEN PIN false\n"
        )
        lines = write(model, "VHDL")
        self.assertIn("      port map (A=>U1_A_openSignal,", lines)
        self.assertIn("                D(3 downto 0)=>U1_D_openSignal(3 downto 0),", lines)
        self.assertIn("                S(1)=>open,", lines)
        self.assertIn("                O=>open);", lines)
        self.assertEqual(lines, write(model, "VHDL"))


class Banner(unittest.TestCase):
    def setUp(self) -> None:
        os.environ["SOURCE_DATE_EPOCH"] = "0"

    def banner(self, language: str, flags: str = "-OVERWRITE") -> list[str]:
        model = build(
            "SET APPLICATION app\nSET COMMAND run  it\nSET DEVICE dev\nSET REFERENCE ref\n"
            "SET PURPOSE " + "word " * 30
        )
        text = "\n".join(write(model, language, flags)).encode("latin-1")
        return mask_free_lines(text).decode("latin-1").split("\n")

    def test_verilog(self) -> None:
        lines = self.banner("VERILOG")
        self.assertEqual(lines[0], "/" * 80)
        self.assertEqual(lines[2], "/" * 80)
        self.assertEqual(
            lines[5:10],
            ["// <emblem> " + label for label in (
                "Vendor: Halvex", "Version : ", "Application : app", "Filename : out",
                "Timestamp : 01/01/1970 00:00:00")],
        )
        self.assertEqual(lines[12:16],
                         ["//Command: run it", "//Design Name: top", "//Device: dev", "//Purpose:"])
        self.assertEqual(lines[16:19], ["//    " + "word " * 14] * 2 + ["//    word word "])
        self.assertEqual(lines[19:22], ["//Reference", "//    ref ", "`timescale 1ns / 1ps"])

    def test_vhdl(self) -> None:
        lines = self.banner("VHDL")
        self.assertEqual(lines[0], "-" * 80)
        self.assertIn("--Design Name: top", lines)

    def test_none(self) -> None:
        self.assertEqual(self.banner("VERILOG", "-noheader -x")[0], "`timescale 1ns / 1ps")


class Verilog(unittest.TestCase):
    def test_and_gate(self) -> None:
        lines = verilog(
            AND2_DESIGN
            + "ADD INSTANCE ATTRIBUTE U1 LOC P1\n"
            + "SET INSTANCE ATTRIBUTE OPTION U1 LOC -SYNATTR=ASSIGN\n"
        )
        self.assertEqual(
            lines,
            [
                "`timescale 1ns / 1ps",
                "",
                "module top(A, ",
                "           Y);",
                "",
                "    input [1:0] A;",
                "   output Y;",
                "",
                "   wire n1;",
                "",
                "   AND2 U1 (.I0(A[0]), ",
                "            .I1(n1), ",
                "            .O(Y));",
                '   // synthesis attribute LOC of U1 is "P1"',
                "endmodule",
            ],
        )

    def test_no_ports(self) -> None:
        self.assertIn("module top();", verilog("NOOP"))

    def test_constants(self) -> None:
        lines = verilog(
            "ADD SIGNAL D(7:0)\nASSIGN CONSTANT D(7:0) 8:H:FF\nASSIGN CONSTANT D(3) 10\n"
            "ASSIGN CONSTANT s x\nASSIGN CONSTANT D(3:2) 2:B:01\nASSIGN CONSTANT D(0:1) 11\n"
            "ASSIGN CONSTANT s,D(0:1) 3:O:7\n"
        )
        assigns = sorted(line.strip() for line in lines if "assign" in line)
        self.assertEqual(
            assigns,
            [
                "assign D = 8'hFF;",
                "assign D[3:2] = 2'b01;",
                "assign D[3] = 0;",
                "assign s = 1;",
                "assign {D[0], D[1]} = 11;",
                "assign {s, {D[0], D[1]}} = 3'o7;",
            ],
        )

    def test_aliases(self) -> None:
        lines = verilog(
            "ADD SIGNAL D(7:0)\nCONNECT SIGNAL D(3) X\nCONNECT SIGNAL A,B(3:0) C\n"
            "CONNECT SIGNAL E(+3:0) D(7:4)\nADD SIGNAL F(2:2)\nCONNECT SIGNAL F(2:2) X\n"
        )
        for line in ("assign D[3] = X;", "assign {A, B[3:0]} = C;", "assign E[3:0] = D[7:4];",
                     "assign F[2:2] = X;"):
            self.assertIn("   " + line, lines)

    def test_references(self) -> None:
        lines = verilog(
            "ADD COMPONENT C\nADD PIN C A in\nADD PIN C B(1:0) in\nADD INSTANCE C U1\n"
            "ADD SIGNAL F(2:2)\nCONNECT SIGNAL F(2:2) U1.A\nCONNECT SIGNAL OPEN U1.B(1:0)\n"
        )
        self.assertIn("   C U1 (.A(F[2]), ", lines)
        self.assertIn("         .B());", lines)

    def synthesis(self, kind: str) -> list[str]:
        return verilog(
            f"SET SYNTHESIS {kind}\nADD PORT A in\nADD SIGNAL ATTRIBUTE A LOC P1\n"
            "SET SIGNAL ATTRIBUTE OPTION A LOC -SYNATTR=ASSIGN\nADD SIGNAL ATTRIBUTE A B 2\n"
            "SET SIGNAL ATTRIBUTE OPTION A B -SYNATTR=ASSIGN\nADD SIGNAL ATTRIBUTE A C 2\n"
        )[4:]

    def test_synthesis_attributes(self) -> None:
        self.assertEqual(self.synthesis("SYNPLICITY")[:2], [
            '    input A/* synthesis "LOC=P1, \\', " " * 25 + 'B=2" */;'])
        self.assertEqual(self.synthesis("SYNOPSYS")[:3], [
            "    input A;", '   /* synopsys attribute LOC "P1"', " " * 25 + 'B "2" */'])
        self.assertEqual(self.synthesis("EXEMPLAR")[1:3], [
            "   // exemplar attribute A LOC P1", "   // exemplar attribute A B 2"])
        self.assertEqual(self.synthesis("precision")[1], "   //pragma attribute A LOC P1")
        self.assertEqual(self.synthesis("unknown")[1],
                         '   // synthesis attribute LOC of A is "P1"')
        self.assertEqual(self.synthesis("VERILOG2001")[:2], ["    input A;", ""])

    def test_parameters(self) -> None:
        lines = verilog(
            "SET NETLIST NAME MHALVEX_ADD4\nADD MODULE ATTRIBUTE INIT 7\n"
            "SET MODULE ATTRIBUTE OPTION INIT -GENERIC=SYN\nADD MODULE ATTRIBUTE -TYPE=Bit B 1\n"
            "SET MODULE ATTRIBUTE OPTION B -GENERIC=NOSYN\nADD COMPONENT C\n"
            "ADD COMPONENT ATTRIBUTE C INIT 8\n"
            "ADD COMPONENT ATTRIBUTE C -TYPE=BitVector W 4:B:1010\n"
            "SET COMPONENT ATTRIBUTE OPTION C INIT -GENERIC=SYN\n"
            "SET COMPONENT ATTRIBUTE OPTION C W -GENERIC=SYN\nADD INSTANCE C U1\n"
        )
        start = lines.index('   parameter INIT = "7";')
        self.assertEqual(lines[start + 1 : start + 5], [
            "   // synopsys translate_off", "   parameter B = 1'b1;",
            "   // synopsys translate_on", ""])
        self.assertEqual(lines[-4:], [
            "   C U1 ();", "   defparam U1.INIT = INIT;", "   defparam U1.W = 4'b1010;",
            "endmodule"])

    def test_letter_case(self) -> None:
        model = build(ONE_GATE + "UPPERCASE instance\nLOWERCASE component\nUPPERCASE siganl\n"
                      "CONNECT SIGNAL n u1.I\nADD INSTANCE G u2\n")
        lines = write(model, "VERILOG")
        self.assertIn("   g U2 (.I(), ", lines)
        self.assertIn("   wire N;", lines)

    def test_include_and_comments(self) -> None:
        lines = verilog("ADD NOTES one\nADD INCLUDE '\"a b.v\"'\nADD INCLUDE " + "x" * 75)
        self.assertEqual(lines[:4], ["// one", '`include "a b.v"', "",
                                     '      `include "' + "x" * 75 + '"'])

    def test_signal_without_a_name(self) -> None:
        lines = verilog('ADD PORT "" in\nCONNECT SIGNAL "" x\nASSIGN CONSTANT "" 1\n')
        self.assertIn("module top();", lines)
        self.assertFalse([line for line in lines if "assign" in line or "input" in line])


class Vhdl(unittest.TestCase):
    def test_and_gate(self) -> None:
        lines = vhdl(AND2_DESIGN)
        self.assertEqual(
            lines,
            [
                "",
                "library ieee;",
                "use ieee.std_logic_1164.ALL;",
                "use ieee.numeric_std.ALL;",
                "library KESTRA;",
                "use KESTRA.Vcomponents.ALL;",
                "",
                "entity top is",
                "   port ( A      : in    std_logic_vector (1 downto 0); ",
                "          Y      : out   std_logic);",
                "end top;",
                "architecture BEHAVIORAL of top is",
                "   signal n1     : std_logic;",
                "   component AND2",
                "      port ( I0 : in    std_logic; ",
                "             I1 : in    std_logic; ",
                "             O  : out   std_logic);",
                "   end component;",
                "",
                "begin",
                "   U1 : AND2",
                "      port map (I0=>A(0),",
                "                I1=>n1,",
                "                O=>Y);",
                "end BEHAVIORAL;",
                "",
                "-- synopsys translate_off",
                "configuration CFG_top of  top is",
                "   for BEHAVIORAL",
                "      for U1 : AND2",
                "         use configuration WORK.CFG_AND2;",
                "      end for;",
                "   end for;",
                "end CFG_top;",
                "-- synopsys translate_on",
                "",
            ],
        )

    def test_switches(self) -> None:
        lines = vhdl(ONE_GATE + "SUPPRESS COMPONENT\nSUPPRESS CONFIGURATION\n"
                     "USE DEFAULT LIBRARY false\nADD LIBRARY l\nADD USE LIBRARY l.p.all\n")
        self.assertEqual(lines[:5], ["", "library l;", "use l.p.all;", "entity top is",
                                     "   port ( );"])
        self.assertEqual(lines[-2:], ["end BEHAVIORAL;", ""])
        self.assertNotIn("   component G", lines)

    def port_map(self, pin: str, connections: str) -> list[str]:
        lines = vhdl(f"ADD COMPONENT C\nADD PIN C {pin} in\nADD INSTANCE C U1\n{connections}")
        start = next(i for i, line in enumerate(lines) if "port map" in line)
        return [line.strip() for line in lines[start : lines.index("end BEHAVIORAL;")]]

    def test_associations(self) -> None:
        cases = [
            ("D(3:0)", "", ["port map (D=>open);"]),
            ("D(3:3)", "", ["port map (D=>open);"]),
            ("D", "", ["port map (D=>open);"]),
            ("D(3)", "", ["port map (D(3)=>open);"]),
            ("D(3:0)", "CONNECT SIGNAL B(0:3) U1.D(3:0)",
             ["port map (D(3 downto 0)=>B(0 to 3));"]),
            ("D(3:3)", "CONNECT SIGNAL B(2:2) U1.D(3:3)", ["port map (D(3)=>B(2));"]),
            ("D(1:0)", "ADD SIGNAL B(0:7)\nCONNECT SIGNAL B(5:4) U1.D(1:0)",
             ["port map (D(1)=>B(5),", "D(0)=>B(4));"]),
            ("D", "ADD SIGNAL B(0:7)\nCONNECT SIGNAL B(5:5) U1.D", ["port map (D=>B(5));"]),
            ("D(0:3)", "ADD SIGNAL B(7:0)\nCONNECT SIGNAL a,B(7:6),B(0) U1.D(0:3)",
             ["port map (D(0)=>a,", "D(1 to 2)=>B(7 downto 6),", "D(3)=>B(0));"]),
            ("D", "CONNECT SIGNAL Open U1.D", ["port map (D=>Open);"]),
        ]
        for pin, connections, expected in cases:
            self.assertEqual(self.port_map(pin, connections), expected, (pin, connections))

    def assignments(self, text: str) -> list[str]:
        return [line.strip() for line in vhdl(text) if "<=" in line]

    def test_constants(self) -> None:
        self.assertEqual(
            self.assignments(
                "ADD SIGNAL D(7:0)\nASSIGN CONSTANT D(7:0) 8:H:FF\nASSIGN CONSTANT s 0101\n"
                "ASSIGN CONSTANT D(0:1) 10\nASSIGN CONSTANT D(2:3) 2:H:10\n"
                "ASSIGN CONSTANT s,D(7) 011\nASSIGN CONSTANT s,D(6) 01\n"
            ),
            ["D(0) <= '1';", "D(1) <= '0';", 'D(7 downto 0) <= x"FF";', "s <= '1';",
             "s <= '0';", "D(6) <= '1';"],
        )

    def test_aliases(self) -> None:
        self.assertEqual(
            self.assignments(
                "ADD SIGNAL D(3:0)\nCONNECT SIGNAL D(3:0) E(0:3)\nCONNECT SIGNAL a,b D(2:1)\n"
                "CONNECT SIGNAL D(0:1) c\nCONNECT SIGNAL F(1:1) D(0)\n"
            ),
            ["a <= D(2);", "b <= D(1);", "D(0) <= c;",
             "D(3 downto 0) <= E(0 to 3);", "F(1) <= D(0);"],
        )

    def generics(self, options: str) -> list[str]:
        lines = vhdl("ADD COMPONENT C\nADD INSTANCE C U1\n"
                     + "".join(f"ADD COMPONENT ATTRIBUTE C {name} {name}v\n"
                               f"SET COMPONENT ATTRIBUTE OPTION C {name} -GENERIC={option}\n"
                               for name, option in zip("ABCD", options.split())))
        start = lines.index("   component C")
        instance = lines.index("   U1 : C")
        return lines[start + 1 : lines.index("   end component;")] + lines[instance + 1 :][:9]

    def test_generic_clauses(self) -> None:
        self.assertEqual(
            self.generics("SYN NOSYN SYN NOSYN"),
            [
                '      generic( A : string :=  "Av";',
                '               C : string :=  "Cv"',
                "      -- synopsys translate_off",
                "      ;",
                '               B : string :=  "Bv";',
                '               D : string :=  "Dv"',
                "      -- synopsys translate_on",
                "      );",
                '      generic map( A => "Av",',
                '               C => "Cv"',
                "      -- synopsys translate_off",
                "      ,",
                '               B => "Bv",',
                '               D => "Dv"',
                "      -- synopsys translate_on",
                "      )",
                "      ;",
            ],
        )
        self.assertEqual(
            self.generics("NOSYN")[:7],
            [
                "      -- synopsys translate_off",
                '      generic( A : string :=  "Av");',
                "      -- synopsys translate_on",
                "      -- synopsys translate_off",
                '      generic map( A => "Av")',
                "      -- synopsys translate_on",
                "      ;",
            ],
        )

    def test_init_is_passed_down(self) -> None:
        lines = vhdl(
            "SET NETLIST NAME MHALVEX\nADD MODULE ATTRIBUTE INIT 7\n"
            "SET MODULE ATTRIBUTE OPTION INIT -GENERIC=SYN\nADD COMPONENT C\n"
            "ADD COMPONENT ATTRIBUTE C A 1\nSET COMPONENT ATTRIBUTE OPTION C A -GENERIC=SYN\n"
            "ADD INSTANCE C U1\nADD INSTANCE ATTRIBUTE U1 INIT 8\n"
            "SET INSTANCE ATTRIBUTE OPTION U1 INIT -GENERIC=NOSYN\n"
        )
        start = lines.index("   U1 : C")
        self.assertEqual(lines[start + 1 : start + 4], [
            "      generic map( INIT => INIT,", '               A => "1")', "      ;"])

    def test_attributes(self) -> None:
        lines = vhdl(
            ONE_GATE + "USE ATTRTYPE\nADD COMPONENT ATTRIBUTE G Level halvex\n"
            "ADD COMPONENT ATTRIBUTE G -TYPE=Integer N 5\nADD PORT P in\n"
            "SET COMPONENT ATTRIBUTE OPTION G N -SYNATTR=ASSIGN\n"
            "ADD INSTANCE ATTRIBUTE U1 N 5\nSET INSTANCE ATTRIBUTE OPTION U1 N -SYNATTR=ASSIGN\n"
            "ADD INSTANCE G U2\nADD INSTANCE ATTRIBUTE U2 N 6\n"
            "SET INSTANCE ATTRIBUTE OPTION U2 N -SYNATTR=ASSIGNNODEC\n"
            "ADD SIGNAL ATTRIBUTE P -TYPE=User n e\nSET SIGNAL ATTRIBUTE USERTYPE P n my_t\n"
            "SET SIGNAL ATTRIBUTE OPTION P n -SYNATTR=ASSIGN\n"
        )
        self.assertEqual(
            [line.strip() for line in lines if "attribute" in line],
            [
                "attribute n        : my_t ;",
                "attribute n of P : signal is e;",
                "attribute BOX_TYPE : string ;",
                "attribute N of G : component is 5;",
                'attribute BOX_TYPE of G : component is "BLACK_BOX";',
                'attribute N of U2 : label is "6";',
            ],
        )
        self.assertNotIn("         use configuration WORK.CFG_G;", lines)

    def test_open_is_no_signal(self) -> None:
        lines = vhdl("ADD PORT Open in\nCONNECT SIGNAL open x\nASSIGN CONSTANT open 1\n")
        self.assertIn("   port ( );", lines)
        self.assertFalse([line for line in lines if "<=" in line])


class GeneratorRuns(unittest.TestCase):
    def test_same_seed_same_file(self) -> None:
        for kind in KINDS:
            self.assertEqual(generate(7, kind, 60), generate(7, kind, 60))
            self.assertNotEqual(generate(7, kind, 60), generate(8, kind, 60))

    def test_every_phrase_is_reached(self) -> None:
        for kind in KINDS:
            reached = set()
            for seed in range(150):
                for line in lines_of(generate(seed, kind, 150)):
                    reached.add(find_phrase(split_command(line)))
            self.assertEqual(set(phrases()) - reached, set(), kind)


class DefaultOptions(unittest.TestCase):
    def test_defaults(self) -> None:
        options = Options()
        self.assertEqual(options.synthesis_type, b"QSN")
        self.assertTrue(
            options.write_header and options.open_pin and options.use_default_library
            and options.one_port_per_line
        )
        options.set_synthesis_type(b"synplicity")
        self.assertEqual(options.synthesis_type, b"SYNPLICITY")
        options.set_synthesis_type(b"XYZ")
        self.assertEqual(options.synthesis_type, b"QSN")


if __name__ == "__main__":
    unittest.main()
