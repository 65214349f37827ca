"""orn-hdl import: how ports, nets, cells and parameters come over."""

from __future__ import annotations

import json
import re
import subprocess
import shutil
import unittest

from support import FAILED, FILE, SUCCESS
from yosys_json import MARK, ImportTest, Json, black_box, cell, design, net, port


class Ports(ImportTest):
    def test_directions_and_ranges(self) -> None:
        done = self.import_design(design({
            "a": port("input", 2),
            "b": port("input", 3, 4, 5, 6),
            "up": port("input", 7, 8, 9, upto=1),
            "high": port("input", 10, 11, offset=4),
            "high_up": port("input", 12, 13, offset=4, upto=1),
            "one": port("input", 14, offset=3),
            "pad": port("inout", 15, 16),
            "y": port("output", 17)}))
        self.assertEqual(done.lines("ADD PORT"), [
            "a Input", "b(3:0) Input", "up(0:2) Input", "high(5:4) Input", "high_up(4:5) Input",
            "one(3:3) Input", "pad(1:0) BiDirectional", "y Output"])

    def test_range_of_the_net_of_an_older_file(self) -> None:
        done = self.import_design(design({"a": port("input", 2, 3)},
                                         nets={"a": net(2, 3, offset=2, upto=1)}))
        self.assertEqual(done.lines("ADD PORT"), ["a(2:3) Input"])

    def test_negative_indices_are_moved(self) -> None:
        done = self.import_design(design({"a": port("input", 2, 3, 4, offset=-2)}))
        self.assertEqual(done.lines("ADD PORT"), ["a(2:0) Input"])
        self.assertEqual(done.warnings, ["d.json: warning: modules.top.ports.a: indices below 0, "
                                         "or beyond 32 bits, cannot be written; counted from 0"])

    def test_greatest_index(self) -> None:
        done = self.import_design(design({"a": port("input", 2, 3, offset=2**31 - 2)}))
        self.assertEqual(done.lines("ADD PORT"), ["a(2147483647:2147483646) Input"])

    def test_indices_beyond_32_bits_are_moved(self) -> None:
        for offset in (2**31 - 1, 2**62):
            done = self.import_design(design({"a": port("input", 2, 3, offset=offset)}))
            self.assertEqual(done.lines("ADD PORT"), ["a(1:0) Input"])

    def test_design_without_contents(self) -> None:
        done = self.import_design(design({"a": port("input", 2)}))
        self.assertIn("module top(a);", done.verilog)

    def test_design_without_ports(self) -> None:
        contents = design({}, {"u": cell("LEAF", "i", I=["0"])})
        contents["modules"]["top"]["ports"] = {}
        self.write("d.json", json.dumps(contents))
        self.expect(self.run_tool("import", "d.json", "--verilog", "x.v"), SUCCESS,
                    "d.json: warning: modules.top.ports: VHDL does not allow a design without "
                    "ports\n")
        self.assertIn("module top();", self.read("x.v"))

    def test_output_is_an_input(self) -> None:
        done = self.import_design(design({"a": port("input", 2, 3), "y": port("output", 2, 3)}))
        self.assertEqual(done.lines("CONNECT SIGNAL"), ["y(1:0) a(1:0)"])

    def test_output_is_parts_of_inputs(self) -> None:
        done = self.import_design(design({"a": port("input", 2, 3, 4), "b": port("input", 5),
                                          "y": port("output", 4, 5, 2, 3, "1", "0")}))
        self.assertEqual(done.lines("CONNECT SIGNAL"), ["y(3:2) a(1:0)", "y(1) b", "y(0) a(2)"])
        self.assertEqual(done.lines("ASSIGN CONSTANT"), ["y(5:4) 2:B:01"])

    def test_reversed_output(self) -> None:
        done = self.import_design(design({"a": port("input", 2, 3), "y": port("output", 3, 2)}))
        self.assertEqual(done.lines("CONNECT SIGNAL"), ["y(1) a(0)", "y(0) a(1)"])

    def test_outputs_of_both_directions(self) -> None:
        done = self.import_design(design({"a": port("input", 2, 3, 4),
                                          "y": port("output", 2, 3, 4, upto=1)}))
        self.assertEqual(done.lines("CONNECT SIGNAL"), ["y(0:2) a(2:0)"])

    def test_constant_outputs(self) -> None:
        done = self.import_design(design({
            "y": port("output", "1"), "z": port("output", "0", "1", "1", "0"),
            "one": port("output", "1", offset=5), "up": port("output", "1", "0", upto=1)}))
        self.assertEqual(done.lines("ASSIGN CONSTANT"),
                         ["y 1", "z(3:0) 4:B:0110", "one(5:5) 1:B:1", "up(0:1) 2:B:01"])

    def test_outputs_that_share_a_driver(self) -> None:
        done = self.import_design(design(
            {"a": port("input", 2), "y": port("output", 3), "z": port("output", 3)},
            {"u": cell("INV", "io", I=[2], O=[3])},
            {"a": net(2), "y": net(3), "z": net(3)}))
        self.assertEqual(done.lines("ADD SIGNAL"), ["y_net"])
        self.assertEqual(done.lines("CONNECT SIGNAL"),
                         ["y y_net", "z y_net", "a u.I", "y_net u.O"])

    def test_outputs_that_share_a_net_with_a_name(self) -> None:
        done = self.import_design(design(
            {"a": port("input", 2, 3), "y": port("output", 4, 5), "z": port("output", 5, 4)},
            {"u": cell("INV2", "io", I=[2, 3], O=[4, 5])},
            {"state": net(4, 5), "$1": net(4, 5, hidden=1)}))
        self.assertEqual(done.lines("ADD SIGNAL"), ["state(1:0)"])
        self.assertEqual(done.lines("CONNECT SIGNAL"),
                         ["y(1:0) state(1:0)", "z(1) state(0)", "z(0) state(1)",
                          "a(1:0) u.I(1:0)", "state(1:0) u.O(1:0)"])

    def test_output_that_shares_a_bit_is_an_alias_as_a_whole(self) -> None:
        done = self.import_design(design(
            {"a": port("input", 2, 3), "y": port("output", 4, 5), "z": port("output", 5)},
            {"u": cell("INV2", "io", I=[2, 3], O=[4, 5])}))
        self.assertEqual(done.lines("CONNECT SIGNAL"),
                         ["y(1:0) y_net(1:0)", "z y_net(1)",
                          "a(1:0) u.I(1:0)", "y_net(1:0) u.O(1:0)"])

    def test_one_bit_twice_in_an_output(self) -> None:
        done = self.import_design(design(
            {"a": port("input", 2), "y": port("output", 3, 3)},
            {"u": cell("INV", "io", I=[2], O=[3])}))
        self.assertEqual(done.lines("CONNECT SIGNAL"),
                         ["y(1) y_net_0", "y(0) y_net_0", "a u.I", "y_net_0 u.O"])

    def test_output_follows_an_inout(self) -> None:
        done = self.import_design(design({"pad": port("inout", 2), "y": port("output", 2)}))
        self.assertEqual(done.lines("CONNECT SIGNAL"), ["y pad"])

    def test_inout_follows_an_input(self) -> None:
        done = self.import_design(design({"a": port("input", 2, 3), "pad": port("inout", 3, 4)}))
        self.assertEqual(done.lines("CONNECT SIGNAL"), ["pad(0) a(1)"])

    def test_inout_that_nothing_drives(self) -> None:
        done = self.import_design(design({"pad": port("inout", "z", "z")}))
        self.assertEqual(done.lines("ADD PORT"), ["pad(1:0) BiDirectional"])
        self.assertEqual(done.lines("ASSIGN CONSTANT"), [])

    def test_feedback(self) -> None:
        done = self.import_design(design(
            {"clk": port("input", 2), "q": port("output", 3)},
            {"u": cell("DFF", "iio", C=[2], D=[4], Q=[3]), "v": cell("INV", "io", I=[3], O=[4])}))
        self.assertIn("assign q = q_DUMMY;", done.verilog)

    def test_contradictions(self) -> None:
        self.refuse(design({"a": port("input", 2), "b": port("input", 3, 2)}),
                    "modules.top.ports.b.bits[1]: two input ports share this bit")
        self.refuse(design({"a": port("inout", 2, 2)}),
                    "modules.top.ports.a.bits[1]: two inout ports share this bit")
        self.refuse(design({"a": port("input", "0")}),
                    "modules.top.ports.a.bits[0]: an input port cannot be a constant")


class Nets(ImportTest):
    def test_public_names_come_first(self) -> None:
        done = self.import_design(design(
            {"a": port("input", 2)},
            {"u": cell("INV", "io", I=[2], O=[3]), "v": cell("INV", "io", I=[3], O=[4])},
            {"$hidden": net(3, hidden=1), "shown": net(3), "also": net(3), "last": net(4)}))
        self.assertEqual(done.lines("ADD SIGNAL"), ["shown", "last"])
        self.assertEqual(done.names["net", "also"], "shown")
        self.assertEqual(done.names["net", "$hidden"], "shown")

    def test_names_that_need_no_change_come_first(self) -> None:
        done = self.import_design(design(
            {}, {"u": cell("LEAF", "o", O=[3]), "v": cell("OTHER", "i", I=[3])},
            {"u1.out": net(3), "result": net(3)}))
        self.assertEqual(done.lines("ADD SIGNAL"), ["result"])

    def test_buses_come_before_their_bits(self) -> None:
        done = self.import_design(design(
            {}, {"u": cell("LEAF", "o", O=[3, 4]), "v": cell("OTHER", "i", I=[4])},
            {"bit1": net(4), "word": net(3, 4)}))
        self.assertEqual(done.lines("ADD SIGNAL"), ["word(1:0)"])
        self.assertEqual(done.names["net", "bit1"], "word(1)")

    def test_only_the_used_part_of_a_bus_is_declared(self) -> None:
        done = self.import_design(design(
            {"a": port("input", 2, 3)},
            {"u": cell("LEAF", "o", O=[5, 6]), "v": cell("OTHER", "i", I=[5, 6])},
            {"sum": net(2, 3, 4, 5, 6, 7, upto=1, offset=1)}))
        self.assertEqual(done.lines("ADD SIGNAL"), ["sum(2:3)"])

    def test_last_bit_of_a_bus_is_a_scalar(self) -> None:
        done = self.import_design(design(
            {}, {"u": cell("LEAF", "o", O=[5]), "v": cell("OTHER", "i", I=[5])},
            {"sum": net(2, 3, 4, 5, offset=4)}))
        self.assertEqual(done.lines("ADD SIGNAL"), ["sum_7"])
        self.assertEqual(done.names["net", "sum"], "sum_7")

    def test_one_bit_net_with_an_offset(self) -> None:
        done = self.import_design(design(
            {}, {"u": cell("LEAF", "o", O=[5]), "v": cell("OTHER", "i", I=[5])}, {"n": net(5, offset=3)}))
        self.assertEqual(done.lines("ADD SIGNAL"), ["n(3:3)"])
        self.assertEqual(done.lines("CONNECT SIGNAL"), ["n(3:3) u.O", "n(3:3) v.I"])

    def test_bits_without_a_name(self) -> None:
        done = self.import_design(design(
            {}, {"u": cell("LEAF", "o", O=[70]), "v": cell("OTHER", "i", I=[70])}))
        self.assertEqual(len(done.lines("ADD SIGNAL")), 1)

    def test_sparse_numbers(self) -> None:
        done = self.import_design(design(
            {}, {"u": cell("LEAF", "o", O=[2**62]), "v": cell("OTHER", "i", I=[2**62])}))
        self.assertEqual(len(done.lines("ADD SIGNAL")), 1)

    def test_unused_nets_are_dropped(self) -> None:
        done = self.import_design(design({}, {}, {"n": net(3, "x"), "k": net("0", "1")}))
        self.assertEqual(done.lines("ADD SIGNAL"), [])
        self.assertEqual(done.names["net", "n"], "-")

    def test_slices_in_both_directions(self) -> None:
        done = self.import_design(design(
            {"d": port("input", 2, 3, 4, 5), "u": port("input", 6, 7, 8, 9, upto=1)},
            {"x": cell("LEAF", "ii", I=[2, 3, 4], J=[5, 4, 3]),
             "y": cell("LEAF", "ii", I=[6, 7, 8], J=[9, 8, 7])}))
        self.assertEqual(done.lines("CONNECT SIGNAL"),
                         ["d(2:0) x.I(2:0)", "d(1:3) x.J(2:0)",
                          "u(1:3) y.I(2:0)", "u(2:0) y.J(2:0)"])

    def test_bus_reversed_as_a_whole(self) -> None:
        done = self.import_design(design(
            {"d": port("input", 2, 3, 4), "e": port("input", 5, 6)},
            {"x": cell("LEAF", "i", I=[4, 3, 2]), "y": cell("OTHER", "i", I=[6, 5])}))
        self.assertEqual(done.lines("CONNECT SIGNAL"), ["d(0),d(1:2) x.I(2:0)",
                                                        "e(0),e(1) y.I(1:0)"])
        self.assertEqual(done.lines("ADD PORT"), ["d(2:0) Input", "e(1:0) Input"])

    def test_concatenations(self) -> None:
        done = self.import_design(design(
            {"a": port("input", 2), "b": port("input", 3, 4, 5, 6), "k": port("input", 7, 8, 9)},
            {"u": cell("LEAF", "i", I=[9, 3, 4, 5, 6, 2, 2])}))
        self.assertEqual(done.lines("CONNECT SIGNAL"), ["a,a,b(3:0),k(2) u.I(6:0)"])
        self.assertIn("{a, a, b[3:0], k[2]}", done.verilog)


class Cells(ImportTest):
    def test_constants_on_pins(self) -> None:
        done = self.import_design(design({}, {
            "u": cell("LEAF", "ii", I=["1"], J=["0", "1", "1"]),
            "v": cell("UP", "i", I=["1", "0"])},
            UP=black_box({"I": port("input", 2, 3, upto=1, offset=4)})))
        self.assertEqual(done.lines("ASSIGN CONSTANT"), ["u.I 1", "u.J(2:0) 3:B:110",
                                                         "v.I(4:5) 2:B:01"])
        self.assertIn("assign u_J_CONST_SIGNAL = 3'b110;", done.verilog)

    def test_constants_among_nets(self) -> None:
        done = self.import_design(design(
            {"a": port("input", 2, 3)}, {"u": cell("LEAF", "i", I=["1", 2, 3, "0", "0"])}))
        self.assertEqual(done.lines("ADD SIGNAL"), ["const_1", "const_0"])
        self.assertEqual(done.lines("ASSIGN CONSTANT"), ["const_0 0", "const_1 1"])
        self.assertEqual(done.lines("CONNECT SIGNAL"),
                         ["const_0,const_0,a(1:0),const_1 u.I(4:0)"])

    def test_constant_signals_of_one_name(self) -> None:
        done = self.import_design(design({}, {
            "a": cell("LEAF", "i", b_c=["0"]), "a_b": cell("OTHER", "i", c=["1"]),
            "A_B": cell("OTHER", "i", c=["0"])}))
        self.assertEqual(done.lines("ASSIGN CONSTANT"), ["const_1 1", "a.b_c 0", "A_B_1.c 0"])
        self.assertEqual(done.lines("CONNECT SIGNAL"), ["const_1 a_b.c"])

    def test_unknown_values_are_refused(self) -> None:
        self.refuse(design({}, {"u": cell("LEAF", "i", I=["0", "x"])}),
                    "modules.top.cells.u.connections.I[1]: the value x cannot be written; "
                    "choose another one with --x-as")
        self.refuse(design({}, {"u": cell("LEAF", "i", I=["z"])}),
                    "modules.top.cells.u.connections.I[0]: the value z cannot be written; "
                    "choose another one with --x-as")
        self.refuse(design({"y": port("output", "1", "x")}),
                    "modules.top.ports.y.bits[1]: the value x cannot be written; "
                    "choose another one with --x-as")
        self.refuse(design({}, {"u": cell("LEAF", "i", I=[2], parameters={"P": "1z"})}),
                    "modules.top.cells.u.parameters.P: the value z cannot be written; "
                    "choose another one with --x-as")

    def test_unknown_values_as_chosen(self) -> None:
        contents = design({"y": port("output", "x", "z")},
                          {"u": cell("LEAF", "i", I=["x", "0", "z"], parameters={"P": "1x"})})
        done = self.import_design(contents, "--x-as", "1")
        self.assertEqual(done.lines("ASSIGN CONSTANT"), ["y(1:0) 2:B:11", "u.I(2:0) 3:B:101"])
        self.assertIn("u -TYPE=BitVector P 2:B:11", done.lines("ADD INSTANCE ATTRIBUTE"))
        self.assertEqual(done.warnings, [
            "d.json: warning: modules.top.ports.y.bits[0]: the value x becomes 1 (and 1 more place)",
            "d.json: warning: modules.top.ports.y.bits[1]: the value z becomes 1 (and 1 more place)",
            "d.json: warning: modules.top.cells.u.parameters.P: x and z in a parameter become 1"])
        done = self.import_design(contents, "--x-as", "0")
        self.assertEqual(done.lines("ASSIGN CONSTANT"), ["y(1:0) 2:B:00", "u.I(2:0) 3:B:000"])

    def test_replaced_values_are_counted(self) -> None:
        """What is open is not replaced."""
        done = self.import_design(design(
            {"y": port("output", 9), "p": port("inout", "z")},
            {f"u{i}": cell("LEAF", "iob", I=["x", "x"], O=["x"], P=["z"]) for i in range(3)}),
            "--x-as", "0", allowed="")
        self.assertEqual(done.warnings, ["d.json: warning: modules.top.cells.u0.connections.I[0]: "
                                         "the value x becomes 0 (and 5 more places)"])

    def test_unconnected_pins_stay_open(self) -> None:
        done = self.import_design(design({}, {
            "u": cell("LEAF", "oo", O=[], Q=[5]), "v": cell("LEAF", "oo", O=[6, 7], Q=[8]),
            "w": cell("OTHER", "i", I=[8])}, {"$q": net(5, hidden=1)}))
        self.assertEqual(done.lines("ADD PIN"), ["LEAF O(1:0) Output", "LEAF Q Output", "OTHER I Input"])
        self.assertEqual(len(done.lines("CONNECT SIGNAL")), 2)
        self.assertIn(".O(),", done.verilog)
        self.assertIn("Q=>open", done.vhdl)

    def test_unconnected_output_with_a_name_keeps_it(self) -> None:
        done = self.import_design(design({}, {"u": cell("LEAF", "o", O=[5])}, {"spare": net(5)}))
        self.assertEqual(done.lines("CONNECT SIGNAL"), ["spare u.O"])

    def test_bits_of_a_pin_that_lead_nowhere(self) -> None:
        done = self.import_design(design(
            {"y": port("output", 5)}, {"u": cell("LEAF", "o", O=[5, 6, "x"])}))
        self.assertEqual(len(done.lines("ADD SIGNAL")), 2)

    def test_pins_of_the_black_box_that_a_cell_leaves_out(self) -> None:
        done = self.import_design(design(
            {}, {"u": cell("LEAF", "i", I=["0"])},
            LEAF=black_box({"I": port("input", 2), "O": port("output", 3), "B": port("inout", 4)})))
        self.assertEqual(done.lines("ADD PIN"), ["LEAF I Input", "LEAF O Output", "LEAF B BiDirectional"])
        self.assertNotIn("SET OPEN PIN FALSE", done.commands)

    def test_open_inputs_get_signals_in_vhdl(self) -> None:
        done = self.import_design(design(
            {}, {"u": cell("LEAF", "i", I=[])}, LEAF=black_box({"I": port("input", 2, 3)})),
            allowed="dangling input port")
        self.assertIn("SET OPEN PIN FALSE", done.commands)
        self.assertIn(".I()", done.verilog)
        self.assertIn("u_I_openSignal", done.vhdl)

    def test_constants_at_output_pins_stay_open(self) -> None:
        done = self.import_design(design({}, {"u": cell("LEAF", "oo", O=["x"], Q=["1"])}))
        self.assertEqual(done.lines("CONNECT SIGNAL"), [])
        self.assertEqual(done.warnings, ["d.json: warning: modules.top.cells.u.connections.Q[0]: "
                                         "an output pin is tied to a constant; left open"])

    def test_inout_pins(self) -> None:
        done = self.import_design(design(
            {"pad": port("inout", 2, 3)},
            {"u": cell("IOPAD", "b", P=[2]), "v": cell("IOPAD", "b", P=["z"]),
             "w": cell("IOPAD", "b", P=[3])}))
        self.assertEqual(done.lines("CONNECT SIGNAL"), ["pad(0) u.P", "pad(1) w.P"])

    def test_directions_that_nothing_tells(self) -> None:
        contents = design({"a": port("input", 2)}, {"u": cell("LEAF", "i", P=[2])})
        del contents["modules"]["top"]["cells"]["u"]["port_directions"]
        done = self.import_design(contents)
        self.assertEqual(done.lines("ADD PIN"), ["LEAF P BiDirectional"])
        self.assertEqual(done.warnings, [
            "d.json: warning: modules.top.cells.u.port_directions: the direction of pin "
            '"P" is unknown; taken as inout'])

    def test_ranges_come_from_the_black_box(self) -> None:
        done = self.import_design(design(
            {"a": port("input", 2, 3)}, {"u": cell("LEAF", "i", P=[2, 3])},
            LEAF=black_box({"P": port("input", 2, 3, offset=4, upto=1)})))
        self.assertEqual(done.lines("ADD PIN"), ["LEAF P(4:5) Input"])
        self.assertEqual(done.lines("CONNECT SIGNAL"), ["a(1:0) u.P(4:5)"])

    def test_widths_that_differ(self) -> None:
        done = self.import_design(design(
            {"a": port("input", 2, 3)},
            {"u": cell("LEAF", "i", P=[2, 3]), "v": cell("LEAF", "i", P=[2]), "w": cell("LEAF", "i", P=[3])}))
        self.assertEqual(done.lines("ADD PIN"), ["LEAF P(1:0) Input", "LEAF_1 P Input"])
        self.assertEqual(done.lines("ADD INSTANCE"), ["LEAF u", "LEAF_1 v", "LEAF_1 w"])
        self.assertEqual(done.warnings, [
            "d.json: warning: modules.top.cells.v.type: other cells of the type have other pin "
            "widths; this component is named LEAF_1"])

    def test_pin_that_the_black_box_does_not_have(self) -> None:
        self.refuse(design({}, {"u": cell("LEAF", "i", Q=[2])}, LEAF=black_box({"P": port("input", 2)})),
                    'modules.top.cells.u.connections.Q: the module "LEAF" has no such port')

    def test_cells_with_few_pins_in_common(self) -> None:
        # With one component for all, each of the 300 instances would have 299 open pins.
        cells = {f"u{i}": cell("LEAF", "ib", **{f"P{i}": [2], f"Q{i}": [3]}) for i in range(299)}
        cells["twin"] = cell("LEAF", "ib", P7=[2], Q7=[3, 4])
        cells["same"] = cell("LEAF", "ib", P7=[2], Q7=[3])
        file = self.write("d.json", json.dumps(design({"a": port("input", 2)}, cells)))
        outcome = self.run_tool("import", file, "-o", "d.cmd")
        self.assertEqual(outcome.status, SUCCESS)
        lines = self.read("d.cmd").splitlines()
        self.assertEqual(len([line for line in lines if line.startswith("ADD COMPONENT ")]), 300)
        self.assertEqual([line for line in lines if line.startswith("ADD PIN LEAF_7 ")],
                         ["ADD PIN LEAF_7 P7 Input", "ADD PIN LEAF_7 Q7 BiDirectional"])
        self.assertEqual([line for line in lines if line.startswith("ADD PIN LEAF_299 ")],
                         ["ADD PIN LEAF_299 P7 Input", "ADD PIN LEAF_299 Q7(1:0) BiDirectional"])
        self.assertIn("ADD INSTANCE LEAF_7 same", lines)
        self.assertIn("ADD INSTANCE LEAF_299 twin", lines)
        self.assertIn("CONNECT SIGNAL a same.P7", lines)
        self.assertIn("modules.top.cells.u7.type: the cells of the type have few pins in common; "
                      "this component is named LEAF_7\n", outcome.err)

    def test_cells_with_few_parameters_in_common(self) -> None:
        # With one component for all, each of the 300 instances would leave out 299 generics.
        cells = {f"u{i}": cell("LEAF", "i", parameters={f"P{i}": "1"}, I=[2]) for i in range(300)}
        cells["same"] = cell("LEAF", "i", parameters={"P7": "0"}, I=[2])
        file = self.write("d.json", json.dumps(design({"a": port("input", 2)}, cells)))
        outcome = self.run_tool("import", file, "-o", "d.cmd")
        self.assertEqual(outcome.status, SUCCESS)
        lines = self.read("d.cmd").splitlines()
        self.assertEqual(len([line for line in lines if line.startswith("ADD PIN ")]), 300)
        self.assertEqual([line for line in lines if line.startswith("ADD COMPONENT ATTRIBUTE LEAF_7 ")],
                         ["ADD COMPONENT ATTRIBUTE LEAF_7 -TYPE=BitVector P7 1:B:1"])
        self.assertIn("ADD INSTANCE LEAF_7 same", lines)
        self.assertIn("modules.top.cells.u7.type: the cells of the type have few parameters in "
                      "common; this component is named LEAF_7\n", outcome.err)

    def test_scope_information_is_no_cell(self) -> None:
        done = self.import_design(design({}, {"s": cell("$scopeinfo", "")}))
        self.assertEqual(done.lines("ADD COMPONENT"), [])

    def test_cell_without_pins(self) -> None:
        done = self.import_design(design({}, {"u": cell("LEAF", "")}))
        self.assertEqual(done.lines("ADD INSTANCE"), ["LEAF u"])

    def test_memories_give_a_warning(self) -> None:
        contents = design({"a": port("input", 2)})
        contents["modules"]["top"]["memories"] = {"m": {"width": 8, "size": 4}}
        done = self.import_design(contents)
        self.assertEqual(done.warnings, ["d.json: warning: modules.top.memories: memories are not "
                                         "imported; map them to cells first"])

    def test_first_values_of_registers_give_a_warning(self) -> None:
        nets = {"q": net(2, 3, attributes={"init": "x1"}), "r": net(4, attributes={"init": 0}),
                "s": net(5, attributes={"init": "x"}), "t": net(6, attributes={"src": "01"})}
        contents = design({"a": port("input", 2)}, {}, nets)
        warning = ("d.json: warning: modules.top.netnames.q.attributes.init: the first values of "
                   "registers are not imported: a register is unknown until it is reset or loaded "
                   "(and 1 more place)")
        self.assertEqual(self.import_design(contents).warnings, [warning])
        self.assertIn(warning, self.import_design(contents, "--attributes").warnings)


class Parameters(ImportTest):
    def one(self, value: str | int, *options: str) -> str:
        """The generic that the one parameter of a cell becomes."""
        done = self.import_design(design({}, {"u": cell("LEAF", "o", O=[2], parameters={"P": value})}),
                                  *options)
        self.warnings = done.warnings
        self.assertEqual(done.lines("SET INSTANCE ATTRIBUTE OPTION"), ["u P -GENERIC=SYN"])
        self.assertEqual(done.lines("SET COMPONENT ATTRIBUTE OPTION"), ["LEAF P -GENERIC=SYN"])
        (line,) = done.lines("ADD INSTANCE ATTRIBUTE")
        self.assertIn(f"LEAF {line[2:]}", done.lines("ADD COMPONENT ATTRIBUTE"))
        return line[2:]

    def test_kinds(self) -> None:
        self.assertEqual(self.one("0101"), "-TYPE=BitVector P 4:B:0101")
        self.assertEqual(self.one("1"), "-TYPE=BitVector P 1:B:1")
        self.assertEqual(self.one(-5), "-TYPE=Integer P -5")
        self.assertEqual(self.one("SLOW"), "-TYPE=String P SLOW")
        self.assertEqual(self.warnings, [])

    def test_texts_that_look_like_bits(self) -> None:
        self.assertEqual(self.one("0101 "), "-TYPE=String P 0101")
        self.assertEqual(self.one("01  "), '-TYPE=String P "01 "')
        self.assertEqual(self.one(" "), '-TYPE=String P ""')
        self.assertEqual(self.one("1 1"), '-TYPE=String P "1 1"')
        self.assertEqual(self.one("x "), "-TYPE=String P x")

    def test_texts_that_need_quotes(self) -> None:
        self.assertEqual(self.one("two  words"), '-TYPE=String P "two  words"')
        self.assertEqual(self.one("it's"), "-TYPE=String P it's")
        self.assertEqual(self.one("'tis"), "-TYPE=String P \"'tis\"")

    def test_texts_that_no_literal_holds(self) -> None:
        for text in ('"', "'a'", "\\", "a\nb", "\t"):
            bits = "".join(f"{ord(c):08b}" for c in text)
            self.assertEqual(self.one(text), f"-TYPE=BitVector P {len(bits)}:B:{bits}")
            self.assertEqual(self.warnings, [
                "d.json: warning: modules.top.cells.u.parameters.P: a text with quotes, "
                "backslashes or special characters becomes a bit vector"
                # The component's default is the same value.
                " (and 1 more place)"])

    def test_values_of_ambiguous_type(self) -> None:
        self.assertEqual(self.one("0" * 32), f"-TYPE=BitVector P 32:B:{'0' * 32}")
        self.assertEqual(self.warnings, [
            "d.json: warning: modules.top.cells.u.parameters: the JSON does not distinguish integers "
            "from 32-bit vectors; written as bit vectors: P"])
        self.assertEqual(self.one("1.5"), "-TYPE=String P 1.5")
        self.assertEqual(self.warnings, [
            "d.json: warning: modules.top.cells.u.parameters: the JSON does not distinguish real "
            "numbers from strings; written as strings: P"])

    def test_default_of_the_black_box(self) -> None:
        done = self.import_design(design(
            {}, {"u": cell("LEAF", "o", O=[2], parameters={"P": "10"}), "v": cell("LEAF", "o", O=[3])},
            LEAF=black_box({"O": port("output", 2)}, P="01", UNUSED="1")))
        self.assertEqual(done.lines("ADD COMPONENT ATTRIBUTE"), ["LEAF -TYPE=BitVector P 2:B:01"])
        self.assertEqual(done.lines("ADD INSTANCE ATTRIBUTE"), ["u -TYPE=BitVector P 2:B:10"])

    ANY = ("x means any value in a parameter; the parameter is left out if its default is known, "
           "otherwise x becomes 0")

    def test_any_value_with_a_default(self) -> None:
        """Where the type has a default, it stands for any value."""
        black_boxes = {"LEAF": black_box({"O": port("output", 2)}, P="11", Q="1")}
        done = self.import_design(design({}, {
            "u": cell("LEAF", "o", O=[2], parameters={"P": "1x", "Q": "x"}),
            "v": cell("LEAF", "o", O=[3], parameters={"P": "10", "Q": "x"})}, **black_boxes))
        self.assertEqual(done.lines("ADD COMPONENT ATTRIBUTE"), ["LEAF -TYPE=BitVector P 2:B:11"])
        self.assertEqual(done.lines("ADD INSTANCE ATTRIBUTE"), ["v -TYPE=BitVector P 2:B:10"])
        self.assertEqual(done.warnings, [f"d.json: warning: modules.top.cells.u.parameters.P: "
                                         f"{self.ANY} (and 2 more places)"])

    def test_any_value_without_a_default(self) -> None:
        done = self.import_design(design({}, {
            "u": cell("LEAF", "o", O=[2], parameters={"P": "1x1x"}),
            "v": cell("LEAF", "o", O=[3], parameters={"P": "0x10"})}))
        self.assertEqual(done.lines("ADD COMPONENT ATTRIBUTE"), ["LEAF -TYPE=BitVector P 4:B:1010"])
        self.assertEqual(done.lines("ADD INSTANCE ATTRIBUTE"),
                         ["u -TYPE=BitVector P 4:B:1010", "v -TYPE=BitVector P 4:B:0010"])
        self.assertEqual(done.warnings, [f"d.json: warning: modules.top.cells.u.parameters.P: "
                                         f"{self.ANY} (and 1 more place)"])

    def test_default_that_is_any_value(self) -> None:
        contents = design(
            {}, {"u": cell("LEAF", "o", O=[2], parameters={"P": "10"}), "v": cell("LEAF", "o", O=[3])},
            LEAF=black_box({"O": port("output", 2)}, P="1x"))
        done = self.import_design(contents)
        self.assertEqual(done.lines("ADD COMPONENT ATTRIBUTE"), ["LEAF -TYPE=BitVector P 2:B:10"])
        self.assertEqual(done.warnings, [
            f"d.json: warning: modules.LEAF.parameter_default_values.P: {self.ANY}"])
        contents["modules"]["LEAF"]["parameter_default_values"]["P"] = "z1"
        self.refuse_again(contents, "modules.LEAF.parameter_default_values.P: the value z cannot be "
                                    "written; choose another one with --x-as")
        contents["modules"]["top"]["cells"]["v"]["parameters"] = {"P": "11"}
        self.import_design(contents)

    def refuse_again(self, contents: Json, message: str) -> None:
        """Like `refuse`, where an earlier import has left its files."""
        for path in self.folder.glob("x.*"):
            path.unlink()
        self.refuse(contents, message)

    def test_parameters_that_only_some_cells_set(self) -> None:
        done = self.import_design(design({}, {
            "u": cell("LEAF", "o", O=[2], parameters={"P": "10", "COMMON": "1"}),
            "v": cell("LEAF", "o", O=[3], parameters={"COMMON": "0", "MODE": "FAST"}),
            "w": cell("LEAF", "o", O=[4], parameters={"N": 5, "COMMON": "0"})}))
        self.assertEqual(done.lines("ADD COMPONENT"), [
            "LEAF", "ATTRIBUTE LEAF -TYPE=BitVector P 2:B:00",
            "ATTRIBUTE LEAF -TYPE=BitVector COMMON 1:B:1", 'ATTRIBUTE LEAF -TYPE=String MODE ""',
            "ATTRIBUTE LEAF -TYPE=Integer N 0"])
        # What has no option hides the component's generic from the instance.
        options = [line.removesuffix(" -GENERIC=SYN")
                   for line in done.lines("SET INSTANCE ATTRIBUTE OPTION")]
        self.assertEqual(options, ["u P", "u COMMON", "v COMMON", "v MODE", "w N", "w COMMON"])
        self.assertEqual(
            {" ".join(line.split()[0:3:2]) for line in done.lines("ADD INSTANCE ATTRIBUTE")},
            {f"{cell} {name}" for cell in "uvw" for name in ("P", "COMMON", "MODE", "N")})
        self.assertEqual(done.warnings, [
            "d.json: warning: modules.top.cells.u.parameters: other cells of the type have other "
            "parameters, and their defaults are unknown; in VHDL they are 0 or empty: P, MODE, N"])
        self.assertEqual(re.findall(r"defparam (\S+) = (\S+);", done.verilog), [
            ("u.P", "2'b10"), ("u.COMMON", "1'b1"), ("v.COMMON", "1'b0"), ("v.MODE", '"FAST"'),
            ("w.N", "5"), ("w.COMMON", "1'b0")])

    def test_defaults_do_not_matter_in_verilog(self) -> None:
        self.write("d.json", json.dumps(design({"y": port("output", 2)}, {
            "u": cell("LEAF", "o", O=[2], parameters={"P": "1"}), "v": cell("LEAF", "o", O=[3])})))
        self.expect(self.run_tool("import", "d.json", "--verilog", "x.v", "--no-header"), SUCCESS)
        self.assertEqual(self.read("x.v").count("defparam"), 1)

    def test_parameters_of_components_of_other_widths(self) -> None:
        """A component only declares the parameters that its own cells have."""
        done = self.import_design(design({}, {
            "u": cell("LEAF", "o", O=[2], parameters={"P": "10"}),
            "v": cell("LEAF", "o", O=[3, 4], parameters={"Q": "1"})}))
        self.assertEqual(done.lines("ADD COMPONENT ATTRIBUTE"),
                         ["LEAF -TYPE=BitVector P 2:B:10", "LEAF_1 -TYPE=BitVector Q 1:B:1"])

    def test_kinds_that_differ(self) -> None:
        contents = design({}, {"u": cell("LEAF", "o", O=[2], parameters={"P": "10"}),
                               "v": cell("LEAF", "o", O=[3], parameters={"P": "TEN"})})
        (self.folder / "d.json").write_text(json.dumps(contents), encoding="utf-8")
        self.expect(self.run_tool("import", "d.json"), SUCCESS,
                    "d.json: warning: modules.top.cells.u.parameters: other cells of the type have "
                    "values of another kind, which VHDL does not allow: P\n")

    def test_values_that_are_none(self) -> None:
        cells = {"u": cell("LEAF", "o", O=[2], parameters={"P": 1.5})}
        self.refuse(design({}, cells), "modules.top.cells.u.parameters.P: an integer is expected")
        cells["u"]["parameters"]["P"] = 2**31
        self.refuse(design({}, cells),
                    "modules.top.cells.u.parameters.P: the number does not fit in 32 bits")
        cells["u"]["parameters"]["P"] = None
        self.refuse(design({}, cells), "modules.top.cells.u.parameters.P: a text is expected")


class Attributes(ImportTest):
    CONTENTS = design(
        {"a": port("input", 2)},
        {"u": cell("LEAF", "io", I=[2], O=[3], attributes={"src": "top.v:3.4-5.6", "keep": MARK}),
         "v": cell("LEAF", "io", I=[3], O=[4], attributes={"loc": "101", "odd": "x1"})},
        {"a": net(2, attributes={"src": 'a "b"\\'}), "n": net(3, attributes={"keep": MARK}),
         "other": net(3, attributes={"lost": "1"})})

    def test_dropped_without_the_option(self) -> None:
        done = self.import_design(self.CONTENTS)
        self.assertEqual([line for line in done.commands if "ATTRIBUTE" in line], [])

    def test_taken_over(self) -> None:
        done = self.import_design(self.CONTENTS, "--attributes")
        self.assertEqual(done.lines("ADD SIGNAL ATTRIBUTE"),
                         ['a -TYPE=String src "a _b__"', "n -TYPE=Integer keep 1"])
        self.assertEqual(done.lines("ADD INSTANCE ATTRIBUTE"),
                         ["u -TYPE=String src top.v:3.4-5.6", "u -TYPE=Integer keep 1",
                          "v -TYPE=BitVector loc 3:B:101", "v -TYPE=String odd x1"])
        self.assertIn("u src -SYNATTR=ASSIGN", done.lines("SET INSTANCE ATTRIBUTE OPTION"))
        self.assertIn('// synthesis attribute src of u is "top.v:3.4-5.6"', done.verilog)
        self.assertIn('attribute keep of n : signal is "1";', done.vhdl)
        self.assertEqual(done.warnings, [
            "d.json: warning: modules.top.netnames.a.attributes.src: quotes, backslashes and "
            'special characters are replaced by "_"'])

    def test_names(self) -> None:
        done = self.import_design(design(
            {"keep": port("input", 2)},
            {"u": cell("LEAF", "i", I=[2], attributes={"keep": "1", "INIT": "0", "a-b": "1"},
                       parameters={"init": "1"})}), "--attributes")
        self.assertEqual(done.lines("ADD INSTANCE ATTRIBUTE"),
                         ["u -TYPE=BitVector init 1:B:1", "u -TYPE=BitVector keep_1 1:B:1",
                          "u -TYPE=BitVector INIT_1 1:B:0", "u -TYPE=BitVector a_b 1:B:1"])


class Files(ImportTest):
    def test_without_an_output_the_file_is_checked(self) -> None:
        self.write("d.json", json.dumps(design({"a": port("input", 2)})))
        self.expect(self.run_tool("import", "d.json"), SUCCESS)
        self.write("d.json", json.dumps(design({"a": port("input", "1")})))
        self.assertEqual(self.run_tool("import", "d.json").status, FAILED)

    def test_standard_input(self) -> None:
        self.expect(self.run_tool("import", "-", "-o", "x.cmd",
                                  stdin=json.dumps(design({"a": port("input", 2)}))), SUCCESS)
        self.assertIn("ADD PORT a Input", self.read("x.cmd"))

    def test_unreadable(self) -> None:
        self.expect(self.run_tool("import", "none"), FILE,
                    "orn-hdl: cannot read none: No such file or directory\n")
        self.expect(self.run_tool("import", "."), FILE, "orn-hdl: cannot read .: Is a directory\n")

    def test_unwritable(self) -> None:
        self.write("d.json", json.dumps(design({"a": port("input", 2)})))
        for option in ("-o", "--verilog", "--vhdl", "--name-map"):
            self.expect(self.run_tool("import", "d.json", option, "/dev/full"), FILE,
                        "orn-hdl: cannot write /dev/full: No space left on device\n")
            self.expect(self.run_tool("import", "d.json", option, "no/x"), FILE,
                        "orn-hdl: cannot write no/x: No such file or directory\n")

    def test_a_failure_leaves_every_file_as_it_was(self) -> None:
        files = ("x.cmd", "x.v", "x.vhd", "x.map")
        options = ("-o", "--verilog", "--vhdl", "--name-map")
        for name in files:
            self.write(name, "before")
        self.write("d.json", json.dumps(design({"a": port("input", "1")})))
        arguments = [word for pair in zip(options, files, strict=True) for word in pair]
        self.assertEqual(self.run_tool("import", "d.json", *arguments).status, FAILED)
        self.write("d.json", json.dumps(design({"a": port("input", 2)})))
        for unwritable in ("/dev/full", "no/x"):
            for others in (("-o", "x.cmd", "--name-map"), ("--name-map", "x.map", "-o"),
                           ("-o", "x.cmd", "--name-map", "x.map", "--verilog")):
                outcome = self.run_tool("import", "d.json", *others, unwritable)
                self.assertEqual(outcome.status, FILE, outcome.err)
        self.assertEqual([self.read(name) for name in files], ["before"] * 4)
        self.assertEqual(len(list(self.folder.iterdir())), 5)

    def test_files_are_replaced_as_a_whole(self) -> None:
        """Nobody ever reads a half-written file: who has the former one open keeps all of it."""
        self.write("d.json", json.dumps(design({"a": port("input", 2)})))
        for option in ("-o", "--verilog", "--vhdl", "--name-map"):
            self.write("x", "before")
            (self.folder / "link").unlink(missing_ok=True)
            (self.folder / "link").symlink_to("x")
            with open(self.folder / "x", encoding="latin-1") as former:
                self.expect(self.run_tool("import", "d.json", option, "link"), SUCCESS)
                self.assertEqual(former.read(), "before")
            self.assertTrue((self.folder / "link").is_symlink())
            self.assertNotEqual(self.read("x"), "before")

    def test_same_on_every_run(self) -> None:
        contents = design(
            {"a": port("input", 2)},
            {f"$u{i}": cell("INV", "io", I=[i + 2], O=[i + 3], hidden=1) for i in range(50)},
            {f"$n{i}": net(i + 2, hidden=1) for i in range(60)})
        first = self.import_design(contents)
        self.assertEqual(first, self.import_design(contents))

    def test_header(self) -> None:
        self.write("d.json", json.dumps(design({"a": port("input", 2)})))
        self.expect(self.run_tool("import", "d.json", "--verilog", "x.v"), SUCCESS)
        self.assertIn("Design Name: top", self.read("x.v"))

    def test_standard_output(self) -> None:
        self.write("d.json", json.dumps(design({"a": port("input", 2)},
                                               {"u": cell("$inv", "i", I=[2])})))
        files = self.run_tool("import", "d.json", "--verilog", "x.v", "--vhdl", "x.vhd", "--no-header")
        self.assertIn("warning: ", files.err)
        self.expect(self.run_tool("import", "d.json", "--verilog", "-", "--vhdl", "-", "--no-header"),
                    SUCCESS, files.err, self.read("x.v") + self.read("x.vhd"))

    @unittest.skipIf(shutil.which("yosys") is None, "Yosys is not installed")
    def test_what_yosys_writes(self) -> None:
        self.write("d.v", """
            module d(input clk, input [3:0] a, output reg [3:0] q, output [3:0] r);
               always @(posedge clk) q <= q + a;
               assign r = ~q;
            endmodule""")
        subprocess.run(["yosys", "-q", "-p", "read_verilog d.v; synth -flatten -noabc; "
                        "write_json d.json; write_json -compat-int c.json"],
                       cwd=self.folder, check=True)
        done = self.import_file("d.json")
        self.assertIn("ADD PORT q(3:0) Output", done.commands)
        self.assertTrue(done.names["component", "$_DFF_P_"], "DFF_P")
        self.import_file("c.json", "--attributes")


if __name__ == "__main__":
    unittest.main()
