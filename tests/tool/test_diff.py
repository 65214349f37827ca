"""orn-hdl diff: every kind of difference, as text and as JSON, of files of every format."""

from __future__ import annotations

import json
import unittest

from support import INVERTER, USAGE, ToolTest

EQUAL, DIFFERENT = 0, 1

# Gates, a bus, an alias, a constant, attributes and comments.
DESIGN = """\
SET NETLIST NAME d
ADD COMPONENT INV
ADD PIN INV I input
ADD PIN INV O output
ADD COMPONENT REG
ADD PIN REG C input
ADD PIN REG D(3:0) input
ADD PIN REG Q(3:0) output
ADD PORT clk input
ADD PORT d(3:0) input
ADD PORT q(3:0) output
ADD PORT y output
ADD PORT z output
ADD SIGNAL n
ADD SIGNAL t(3:0)
ADD SIGNAL one
ADD INSTANCE INV U1
ADD INSTANCE INV U2
ADD INSTANCE REG R1
CONNECT SIGNAL d(0) U1.I
CONNECT SIGNAL n U1.O
CONNECT SIGNAL n U2.I
CONNECT SIGNAL y U2.O
CONNECT SIGNAL clk R1.C
CONNECT SIGNAL d(3:0) R1.D(3:0)
CONNECT SIGNAL t(3:0) R1.Q(3:0)
CONNECT SIGNAL q(3:0) t(3:0)
CONNECT SIGNAL z one
ASSIGN CONSTANT one 1
ADD INSTANCE ATTRIBUTE U1 LOC P1
ADD INSTANCE COMMENT U1 "first gate"
"""


def find(lines: str, text: str) -> int:
    """The number of the line that is the text."""
    return lines.splitlines().index(text) + 1


class DiffTest(ToolTest):
    def diff(self, a: str, b: str, *options: str, status: int = DIFFERENT) -> dict:
        """The JSON that is printed of two command files."""
        self.write("a.cmd", a)
        self.write("b.cmd", b)
        return self.diff_files("a.cmd", "b.cmd", *options, status=status)

    def diff_files(self, a: str, b: str, *options: str, status: int = DIFFERENT) -> dict:
        outcome = self.run_tool("diff", a, b, "--format", "json", *options)
        self.assertEqual((outcome.err, outcome.status), ("", status), outcome.out)
        return json.loads(outcome.out)

    def one(self, a: str, b: str, *options: str) -> dict:
        """The only difference of two command files."""
        found = self.diff(a, b, *options)
        self.assertEqual(len(found["differences"]), 1, found)
        difference = found["differences"][0]
        self.assertEqual({change: count for change, count in found["counts"].items() if count},
                         {difference["change"]: 1})
        return difference

    def replaced(self, old: str, new: str, *options: str) -> dict:
        self.assertIn(old, DESIGN)
        return self.one(DESIGN, DESIGN.replace(old, new), *options)


class Kinds(DiffTest):
    def test_equal(self) -> None:
        self.write("a.cmd", DESIGN)
        self.expect(self.run_tool("diff", "a.cmd", "a.cmd"), EQUAL, out="no differences\n")

    def test_order_of_commands_does_not_matter(self) -> None:
        lines = DESIGN.splitlines(keepends=True)
        moved = "".join(lines[:8] + sorted(lines[8:12], reverse=True) + lines[13:16] +
                        lines[12:13] + lines[18:19] + lines[16:18] + lines[:18:-1])
        self.diff(DESIGN, moved, status=EQUAL)

    def test_added_and_removed_instance(self) -> None:
        more = DESIGN + "ADD INSTANCE INV U3\n"
        self.assertEqual(self.one(DESIGN, more),
                         {"change": "added", "object": "instance",
                          "b": {"name": "U3", "line": find(more, "ADD INSTANCE INV U3")}})
        self.assertEqual(self.one(more, DESIGN)["a"]["name"], "U3")
        self.assertEqual(self.one(more, DESIGN)["change"], "removed")

    def test_added_port_signal_component_and_pin(self) -> None:
        for line, thing, name in (("ADD PORT p(1:0) output", "port", "p(1:0)"),
                                  ("ADD SIGNAL s", "signal", "s"),
                                  ("ADD COMPONENT C", "component", "C"),
                                  ("ADD PIN INV E input", "component pin", "INV.E"),
                                  ("CONNECT SIGNAL t(1:0) d(2:1)", "alias", "t(1:0) = d(2:1)")):
            with self.subTest(line):
                more = DESIGN + line + "\n"
                self.assertEqual(self.one(DESIGN, more),
                                 {"change": "added", "object": thing,
                                  "b": {"name": name, "line": find(more, line)}})

    def test_renamed_instance(self) -> None:
        self.assertEqual(self.replaced("U2", "G7"),
                         {"change": "renamed", "object": "instance",
                          "a": {"name": "U2", "line": find(DESIGN, "ADD INSTANCE INV U2")},
                          "b": {"name": "G7", "line": find(DESIGN, "ADD INSTANCE INV U2")}})

    def test_renamed_net_and_bus(self) -> None:
        renamed = self.replaced(" n\n", " m\n").keys()
        self.assertIn("change", renamed)
        for old, new in ((" n ", " m "), ("t(3:0)", "v(3:0)")):
            text = DESIGN.replace(" n\n", " m\n") if old == " n " else DESIGN
            difference = self.one(DESIGN, text.replace(old, new))
            self.assertEqual((difference["change"], difference["object"]), ("renamed", "signal"))
            self.assertEqual((difference["a"]["name"], difference["b"]["name"]),
                             (old.strip(), new.strip()))

    def test_bus_that_became_bits(self) -> None:
        bits = DESIGN.replace("ADD SIGNAL t(3:0)\n", "".join(f"ADD SIGNAL t{i}\n" for i in range(4)))
        bits = bits.replace("t(3:0)", "t3,t2,t1,t0")
        found = self.diff(DESIGN, bits)
        self.assertEqual({(each["a"]["name"], each["b"]["name"]) for each in found["differences"]},
                         {(f"t({i})", f"t{i}") for i in range(4)})
        self.assertEqual({each["change"] for each in found["differences"]}, {"renamed"})
        self.diff(DESIGN, bits, "--ignore", "names", status=EQUAL)

    def test_bus_connected_bit_by_bit(self) -> None:
        self.diff(DESIGN, DESIGN.replace("CONNECT SIGNAL d(3:0) R1.D(3:0)",
                                         "CONNECT SIGNAL d(3),d(2:1),d(0) R1.D(3:0)"), status=EQUAL)
        self.diff(DESIGN, DESIGN.replace("CONNECT SIGNAL q(3:0) t(3:0)\n", "".join(
            f"CONNECT SIGNAL q({i}) t({i})\n" for i in range(4))), status=EQUAL)

    def test_rewired_pin(self) -> None:
        difference = self.replaced("CONNECT SIGNAL d(0) U1.I", "CONNECT SIGNAL d(1) U1.I")
        line = find(DESIGN, "CONNECT SIGNAL d(0) U1.I")
        self.assertEqual(difference, {"change": "rewired", "object": "pin",
                                      "a": {"name": "U1.I", "text": "d(0)", "line": line},
                                      "b": {"name": "U1.I", "text": "d(1)", "line": line}})

    def test_opened_pin(self) -> None:
        difference = self.replaced("CONNECT SIGNAL d(0) U1.I\n", "")
        self.assertEqual(difference["change"], "rewired")
        self.assertEqual((difference["a"]["text"], difference["b"]["text"]), ("d(0)", "open"))

    def test_retied(self) -> None:
        difference = self.replaced("ASSIGN CONSTANT one 1", "ASSIGN CONSTANT one 0")
        self.assertEqual((difference["change"], difference["object"]), ("retied", "signal"))
        self.assertEqual((difference["a"]["text"], difference["b"]["text"]), ("1", "0"))
        self.assertEqual(difference["a"]["line"], find(DESIGN, "ASSIGN CONSTANT one 1"))
        tied = INVERTER + "ADD INSTANCE INV U2\nASSIGN CONSTANT U2.I 1\n"
        difference = self.one(tied, tied.replace("U2.I 1", "U2.I 0"))
        self.assertEqual((difference["change"], difference["object"]), ("retied", "pin"))
        self.assertEqual((difference["a"]["text"], difference["b"]["text"]),
                         ("constant 1", "constant 0"))

    def test_spelling_of_a_constant(self) -> None:
        a = "ADD PORT k(7:0) output\nASSIGN CONSTANT k(7:0) 8:H:A5\n"
        self.diff(a, a.replace("8:H:A5", "8:B:10100101"), status=EQUAL)
        self.diff(a, a.replace("k(7:0) 8:H:A5", "k(7:4) 4:H:A\nASSIGN CONSTANT k(3:0) 4:B:0101"),
                  status=EQUAL)
        self.assertEqual(self.one(a, a.replace("A5", "A7"))["b"]["text"], "10100111")

    def test_shape_of_a_port(self) -> None:
        for old, new, what, texts in (
                ("ADD PORT y output", "ADD PORT y bidirectional", "direction",
                 ("Output", "BiDirectional")),
                ("ADD PORT z output", "ADD PORT z(0:0) output", "range", ("none", "(0:0)"))):
            text = DESIGN.replace(old, new)
            if what == "range":
                text = text.replace("CONNECT SIGNAL z one", "CONNECT SIGNAL z(0:0) one")
            difference = self.one(DESIGN, text)
            self.assertEqual((difference["change"], difference["object"], difference["what"]),
                             ("changed", "port", what))
            self.assertEqual((difference["a"]["text"], difference["b"]["text"]), texts)

    def test_component(self) -> None:
        both = DESIGN.replace("ADD PORT clk", "ADD COMPONENT BUF\nADD PIN BUF I input\n"
                              "ADD PIN BUF O output\nADD PIN BUF E input\nADD PORT clk")
        difference = self.one(both, both.replace("ADD INSTANCE INV U2", "ADD INSTANCE BUF U2"))
        self.assertEqual((difference["change"], difference["what"], difference["a"]["text"],
                          difference["b"]["text"]), ("changed", "component", "INV", "BUF"))
        difference = self.one(DESIGN, DESIGN.replace("INV", "NOT"))
        self.assertEqual((difference["change"], difference["object"]), ("renamed", "component"))
        difference = self.replaced("ADD PIN REG C input", "ADD PIN REG C bidirectional")
        self.assertEqual((difference["object"], difference["what"]), ("component pin", "direction"))

    def test_attributes(self) -> None:
        difference = self.replaced("U1 LOC P1", "U1 LOC P2")
        line = find(DESIGN, "ADD INSTANCE ATTRIBUTE U1 LOC P1")
        self.assertEqual(difference, {
            "change": "changed", "object": "attribute",
            "a": {"name": "LOC of instance U1", "text": "P1 (String)", "line": line},
            "b": {"name": "LOC of instance U1", "text": "P2 (String)", "line": line}})
        self.assertEqual(self.replaced("U1 LOC P1", "U1 -TYPE=User LOC P1")["change"], "changed")
        for line in ("ADD MODULE ATTRIBUTE REV 7", "ADD COMPONENT ATTRIBUTE INV LEVEL HALVEX",
                     "ADD SIGNAL ATTRIBUTE n KEEP yes", "ADD COMPONENT PIN ATTRIBUTE INV.I X 1",
                     "ADD INSTANCE PIN ATTRIBUTE U1.I X 1",
                     "SET INSTANCE ATTRIBUTE OPTION U1 LOC -SYNATTR=ASSIGN"):
            with self.subTest(line):
                self.assertEqual(self.one(DESIGN, DESIGN + line + "\n")["object"], "attribute")
                self.diff(DESIGN, DESIGN + line + "\n", "--ignore", "attributes", status=EQUAL)

    def test_comments(self) -> None:
        difference = self.replaced('"first gate"', '"the gate"')
        self.assertEqual((difference["object"], difference["a"]["text"], difference["b"]["text"]),
                         ("comment", "first gate", "the gate"))
        self.diff(DESIGN, DESIGN + "ADD NOTES more\nADD SIGNAL COMMENT n net\n", "--ignore",
                  "comments", status=EQUAL)

    def test_order_of_pins(self) -> None:
        pins = "ADD PIN INV I input\nADD PIN INV O output\n"
        swapped = DESIGN.replace(pins, "ADD PIN INV O output\nADD PIN INV I input\n")
        difference = self.one(DESIGN, swapped)
        self.assertEqual((difference["object"], difference["what"], difference["a"]["text"],
                          difference["b"]["text"]),
                         ("component", "order of pins at pin 1", "I", "O"))
        self.diff(DESIGN, swapped, "--ignore", "order", status=EQUAL)

    def test_order_of_ports(self) -> None:
        self.write("a.v", "module m(a, b); input a, b; endmodule\n")
        self.write("b.v", "module m(b, a); input a, b; endmodule\n")
        (difference,) = self.diff_files("a.v", "b.v")["differences"]
        self.assertEqual((difference["object"], difference["what"]),
                         ("module", "order of ports at port 1"))
        self.diff_files("a.v", "b.v", "--ignore", "order", status=EQUAL)

    def test_name_of_the_design(self) -> None:
        self.assertEqual(self.replaced("NAME d", "NAME e")["object"], "module")
        self.diff(DESIGN, DESIGN.replace("NAME d", "NAME e"), "--ignore", "names", status=EQUAL)
        # What the name of the file gives is not compared.
        self.diff(INVERTER, INVERTER, status=EQUAL)
        self.diff(INVERTER, "SET NETLIST NAME x\n" + INVERTER, status=EQUAL)

    def test_alias_is_no_net_of_its_own(self) -> None:
        found = self.diff(DESIGN, DESIGN.replace("CONNECT SIGNAL z one", "CONNECT SIGNAL one z"))
        self.assertEqual([(each["change"], each["object"]) for each in found["differences"]],
                         [("removed", "alias"), ("added", "alias")])


class Names(DiffTest):
    def test_all_internal_names(self) -> None:
        shuffled = DESIGN
        for old, new in (("U1", "a9"), ("U2", "a8"), ("R1", "a7"), (" n\n", " w1\n"), (" n ", " w1 "),
                         ("t(3:0)", "w2(3:0)"), ("one", "w3")):
            shuffled = shuffled.replace(old, new)
        found = self.diff(DESIGN, shuffled)
        self.assertEqual(found["counts"]["renamed"], 6)
        self.assertEqual(len(found["differences"]), 6)
        self.diff(DESIGN, shuffled, "--ignore", "names", status=EQUAL)

    def test_swapped_names(self) -> None:
        swapped = DESIGN.replace("U1", "Ux").replace("U2", "U1").replace("Ux", "U2")
        self.diff(DESIGN, swapped, "--ignore", "names", status=EQUAL)
        # Names count before connections.
        self.assertEqual(self.diff(DESIGN, swapped)["counts"]["rewired"], 4)

    def test_chain(self) -> None:
        """Nothing but its distance from the ends tells a stage from the others."""
        count = 2000

        def chain(name: str) -> str:
            stages = "".join(f"ADD INSTANCE INV {name}{i}\nCONNECT SIGNAL {name}n{i} {name}{i}.I\n"
                             f"CONNECT SIGNAL {name}n{i + 1} {name}{i}.O\n" for i in range(count))
            return (INVERTER.replace("CONNECT SIGNAL A U1.I\n", "").replace("U1.O", "U1.O") + stages +
                    f"CONNECT SIGNAL A {name}0.I\nCONNECT SIGNAL {name}n{count} U1.I\n")

        self.diff(chain("a"), chain("b"), "--ignore", "names", status=EQUAL)
        counts = self.diff(chain("a"), chain("b"))["counts"]
        self.assertEqual({change for change, number in counts.items() if number}, {"renamed"})

    def test_symmetrical_parts(self) -> None:
        """Rows of gates that are alike, in rings, which nothing ties to a port."""

        def rings(name: str, order: list[int]) -> str:
            text = INVERTER
            for ring in order:
                for i in range(5):
                    text += f"ADD INSTANCE INV {name}{ring}x{i}\n"
                for i in range(5):
                    text += (f"CONNECT SIGNAL {name}n{ring}x{i} {name}{ring}x{i}.O\n"
                             f"CONNECT SIGNAL {name}n{ring}x{(i + 4) % 5} {name}{ring}x{i}.I\n")
            return text

        self.diff(rings("a", [0, 1, 2]), rings("b", [2, 0, 1]), "--ignore", "names", status=EQUAL)

    def test_ports_and_components_keep_their_names(self) -> None:
        for old, new in (("y", "yy"), ("INV", "NOT")):
            self.diff(DESIGN, DESIGN.replace(old, new), "--ignore", "names")


class Text(DiffTest):
    def test_groups_and_counts(self) -> None:
        self.write("a.cmd", DESIGN)
        self.write("b.cmd", DESIGN.replace("U2", "G7").replace("d(0) U1.I", "d(1) U1.I")
                   .replace("one 1", "one 0") + "ADD SIGNAL extra\n")
        last = len(DESIGN.splitlines()) + 1
        self.expect(self.run_tool("diff", "a.cmd", "b.cmd"), DIFFERENT, out=f"""\
added:
   signal extra (b.cmd:{last})
renamed:
   instance U2 -> G7 (a.cmd:18, b.cmd:18)
rewired:
   pin U1.I: d(0) -> d(1) (a.cmd:20, b.cmd:20)
retied:
   signal one: 1 -> 0 (a.cmd:29, b.cmd:29)
4 differences: 1 added, 1 renamed, 1 rewired, 1 retied
""")

    def test_limit(self) -> None:
        self.write("a.cmd", DESIGN)
        self.write("b.cmd", DESIGN + "".join(f"ADD SIGNAL s{i}\n" for i in range(150)))
        last = "150 differences: 150 added\n"
        for options, shown in ((["--limit", "2"], 2), ([], 100), (["--limit", "0"], 150)):
            out = self.run_tool("diff", "a.cmd", "b.cmd", *options).out
            self.assertEqual(out.count("signal s"), shown)
            more = f"and {150 - shown} more\n" if shown < 150 else ""
            self.assertTrue(out.endswith(more + last), out)
        found = self.diff_files("a.cmd", "b.cmd", "--limit", "3")
        self.assertEqual((found["counts"]["added"], len(found["differences"])), (150, 3))

    def test_in_the_order_of_the_lines(self) -> None:
        for new in ("G", "A"):
            other = DESIGN.replace("U1", f"{new}1").replace("U2", f"{new}2")
            found = self.diff(DESIGN, other.replace("t(3:0)", "v(3:0)"))
            lines = [each["a"]["line"] for each in found["differences"]]
            self.assertEqual(lines, sorted(lines))

    def test_same_output_every_time(self) -> None:
        self.write("a.cmd", DESIGN)
        self.write("b.cmd", DESIGN.replace("U", "G").replace("t(", "v("))
        first = self.run_tool("diff", "a.cmd", "b.cmd")
        self.assertEqual(self.run_tool("diff", "a.cmd", "b.cmd"), first)


class Trouble(DiffTest):
    def test_status_is_2(self) -> None:
        self.write("good.cmd", DESIGN)
        self.write("bad.cmd", "ADD NOTHING\n")
        self.write("bad.v", "module m(a); initial a = 1; endmodule\n")
        self.write("bad.json", "{")
        for files in (("good.cmd", "bad.cmd"), ("bad.v", "good.cmd"), ("good.cmd", "bad.json"),
                      ("good.cmd", "none.cmd"), ("none.v", "good.cmd"), ("good.cmd",),
                      ("good.cmd", "good.cmd", "--ignore", "nothing"),
                      ("good.cmd", "good.cmd", "--from-a", "json")):
            with self.subTest(files):
                outcome = self.run_tool("diff", *files)
                self.assertEqual((outcome.status, outcome.out), (USAGE, ""))
                self.assertTrue(outcome.err)

    def test_places_of_errors(self) -> None:
        self.write("good.cmd", DESIGN)
        self.write("bad.v", "module m(a);\n   input a;\n   initial a = 1;\nendmodule\n")
        err = self.run_tool("diff", "bad.v", "good.cmd").err
        self.assertTrue(err.startswith("bad.v:3: error: "), err)
        self.assertIn("   initial a = 1;", err)


class Formats(DiffTest):
    def test_standard_input_and_forced_format(self) -> None:
        self.write("a.cmd", DESIGN)
        self.assertEqual(self.run_tool("diff", "a.cmd", "-", stdin=DESIGN).status, EQUAL)
        outcome = self.run_tool("diff", "-", "a.cmd", "--from-b", "commands", stdin=DESIGN + "ADD SIGNAL x\n")
        self.assertEqual(outcome.status, DIFFERENT)
        self.assertIn("signal x (-:", outcome.out)
        self.run_tool("run", "a.cmd", "--verilog", "netlist.txt")
        self.assertEqual(self.run_tool("diff", "a.cmd", "netlist.txt", "--from-b", "verilog").status,
                         EQUAL)

    def test_lines_of_netlists(self) -> None:
        self.write("a.cmd", DESIGN)
        self.run_tool("run", "a.cmd", "--verilog", "a.v", "--vhdl", "a.vhd")
        self.write("b.cmd", DESIGN.replace("ADD INSTANCE INV U2", "ADD INSTANCE INV G7")
                   .replace("U2.", "G7.").replace("d(0) U1.I", "d(1) U1.I")
                   .replace("one 1", "one 0").replace("y output", "y bidirectional"))
        for netlist, texts in (("a.v", {"G7": "INV U2 (", "U1.I": ".I(d[0])", "one": "assign one =",
                                        "y": "output y;"}),
                               ("a.vhd", {"G7": "U2 : INV", "U1.I": "port map (I=>d(0)",
                                          "one": "one <= ", "y": "y : out"})):
            lines = [" ".join(line.split()) for line in self.read(netlist).splitlines()]
            found = self.diff_files(netlist, "b.cmd")["differences"]
            told = {each["b"]["name"]: lines[each["a"]["line"] - 1] for each in found
                    if each["object"] != "module"}
            for name, text in texts.items():
                with self.subTest(netlist=netlist, name=name):
                    self.assertIn(text, told[name])

    def test_lines_of_json(self) -> None:
        cell = {"type": "INV", "port_directions": {"I": "input", "O": "output"},
                "connections": {"I": [2], "O": [3]}}
        ports = {"a": {"direction": "input", "bits": [2]}, "y": {"direction": "output", "bits": [3]}}
        for name, instance in (("a.json", "U1"), ("b.json", "U2")):
            modules = {"m": {"attributes": {"top": "1"}, "ports": ports, "cells": {instance: cell},
                             "netnames": {}}}
            self.write(name, json.dumps({"modules": modules}, indent=1))
        (difference,) = self.diff_files("a.json", "b.json")["differences"]
        lines = self.read("a.json").splitlines()
        self.assertIn('"U1"', lines[difference["a"]["line"] - 1])

    def test_netlists_without_a_library(self) -> None:
        for name, net in (("a.v", "a"), ("b.v", "b")):
            self.write(name, "module m(input a, input b, output y);\n"
                       f"   INV U1(.I({net}), .O(y));\nendmodule\n")
        (difference,) = self.diff_files("a.v", "b.v")["differences"]
        self.assertEqual((difference["change"], difference["a"]["text"], difference["b"]["text"]),
                         ("rewired", "a", "b"))

    def test_library(self) -> None:
        self.write("cells.v", "module INV(input I, output O); endmodule\n")
        for name, instance in (("a.v", "U1"), ("b.v", "U2")):
            self.write(name, "module m(input a, output y);\n"
                       f"   INV {instance}(.I(a), .O(y));\nendmodule\n")
        (difference,) = self.diff_files("a.v", "b.v", "-l", "cells.v")["differences"]
        self.assertEqual((difference["change"], difference["a"]["name"], difference["b"]["name"]),
                         ("renamed", "U1", "U2"))


if __name__ == "__main__":
    unittest.main()
