"""orn-hdl import: every name becomes one that both languages hold. A case for each odd name."""

from __future__ import annotations

import json
import re
import unittest

from support import SUCCESS
from yosys_json import ImportTest, Json, black_box, cell, design, net, port

# Each odd name, and what becomes of it as a net.
ODD_NAMES = {
    # escaped identifiers
    "a.b": "a_b",
    "u1.u2.count": "u1_u2_count",
    "count[3]": "count_3",
    "count[3:0]": "count_3_0",
    "a+b": "a_b",
    "a b": "a_b",
    "-": "n",
    "": "n",
    "+1": "n1",
    "1st": "n1st",
    "42": "n42",
    "\\back": "back",
    "\\$dollar": "dollar",
    "a$b": "a_b",
    'quo"te': "quo_te",
    "it's": "it_s",
    "tab\there": "tab_here",
    "line\nend": "line_end",
    "a,b": "a_b",
    "a(1)": "a_1",
    "a(1:0)": "a_1_0",
    "D<3>": "D_3",
    "caf\u00e9": "caf",
    "\u540d\u524d": "n",
    "%s%n": "s_n",
    "a/b": "a_b",
    "u1.a": "u1_a",
    # underscores that VHDL does not have
    "_a": "a",
    "a_": "a_1",  # "a" is taken
    "a__b": "a_b",
    "__": "n",
    # words of the languages
    "signal": "signal_1",
    "Signal": "Signal_1",
    "ENTITY": "ENTITY_1",
    "open": "open_1",
    "Open": "Open_1",
    "in": "in_1",
    "xnor": "xnor_1",
    "wire": "wire_1",
    "module": "module_1",
    "force": "force_1",
    "logic": "logic_1",
    "bit": "bit_1",
    "always_ff": "always_ff_1",
    "localparam": "localparam_1",
    "genvar": "genvar_1",
    "priority": "priority_1",
    "default": "default_1",
    "context": "context_1",
    "protected": "protected_1",
    # names that written VHDL mentions
    "std_logic": "std_logic_1",
    "STD_LOGIC_VECTOR": "STD_LOGIC_VECTOR_1",
    "string": "string_1",
    "integer": "integer_1",
    "true": "true_1",
    "work": "work_1",
    "ieee": "ieee_1",
    "KESTRA": "KESTRA_1",
    "BEHAVIORAL": "BEHAVIORAL_1",
    # a word of the command language
    "comment": "comment_1",
    "ATTRIBUTE": "ATTRIBUTE_1",
    # ends of names that the library makes itself
    "q_DUMMY": "q_DUMMY_1",
    "q_dummy": "q_dummy_1",
    "u_I_CONST_SIGNAL": "u_I_CONST_SIGNAL_1",
    "u_I_openSignal": "u_I_openSignal_1",
    # made-up names
    "$1": "n1",
    "$auto$opt_dff.cc:744:run$12": "run_12",
    "$abc$97$new_n5_": "new_n5",
    "$abc$97$auto$blifparse.cc:386:parse_blif$103": "parse_blif_103",
    "$procdff$12": "procdff_12",
    "$add$top.v:12$3_Y": "add_3_Y",
    "$0\\q[3:0]": "n0_q_3_0",
    "$flatten\\u1.$procmux$5": "flatten_u1_procmux_5",
    "$auto$a.cc:1:": "n",
    "$": "n",
    "$$": "n",
    "$auto": "n",
}

# Names that stay as they are.
FINE_NAMES = ["a", "Z", "a_b", "a1_2b", "Wire", "MODULE", "dummy", "Const_Signal", "x_DUMMY_1",
              "FORCED", "signals", "n0", "open_1_2", "A0"]

LEGAL = re.compile(r"[A-Za-z][A-Za-z0-9]*(_[A-Za-z0-9]+)*")


class Names(ImportTest):
    def net_design(self, *names: str) -> Json:
        """Every name on a net between two cells."""
        cells = {}
        for i, _ in enumerate(names):
            cells[f"driver{i}"] = cell("DRIVER", "o", O=[i + 2])
            cells[f"reader{i}"] = cell("READER", "i", I=[i + 2])
        nets = {name: net(i + 2, hidden=int(name.startswith("$")))
                for i, name in enumerate(names)}
        return design({}, cells, nets)

    def import_names(self, contents: Json) -> list[str]:
        """The commands of an import, which no real tool judges: for many small designs."""
        self.write("d.json", json.dumps(contents))
        outcome = self.run_tool("import", "d.json", "-o", "x.cmd")
        self.assertEqual((outcome.status, outcome.out), (SUCCESS, ""), outcome.err)
        return self.read("x.cmd").splitlines()

    def test_odd_names_one_by_one(self) -> None:
        for old, new in ODD_NAMES.items():
            with self.subTest(old):
                names = [old, "a"] if old == "a_" else [old]
                self.assertIn(f"ADD SIGNAL {new}", self.import_names(self.net_design(*names)))
                self.assertIsNotNone(LEGAL.fullmatch(new))

    def test_odd_names_all_at_once(self) -> None:
        done = self.import_design(self.net_design(*ODD_NAMES))
        names = done.lines("ADD SIGNAL")
        self.assertEqual(len({name.lower() for name in names}), len(ODD_NAMES))
        for name in names:
            self.assertIsNotNone(LEGAL.fullmatch(name), name)

    def test_fine_names_stay(self) -> None:
        done = self.import_design(self.net_design(*FINE_NAMES))
        self.assertEqual(sorted(done.lines("ADD SIGNAL")), sorted(FINE_NAMES))

    def test_odd_names_of_ports(self) -> None:
        done = self.import_design(design({
            name: port("input", 2 * i + 2, 2 * i + 3) for i, name in enumerate(ODD_NAMES)}))
        names = [line.partition("(")[0] for line in done.lines("ADD PORT")]
        self.assertEqual(len({name.lower() for name in names}), len(ODD_NAMES))

    def test_odd_names_of_cells(self) -> None:
        done = self.import_design(design({}, {
            name: cell("LEAF", "i", I=["0"]) for name in ODD_NAMES}))
        names = [line.split()[1] for line in done.lines("ADD INSTANCE")]
        self.assertEqual(len({name.lower() for name in names}), len(ODD_NAMES))

    def test_odd_names_of_cell_types(self) -> None:
        done = self.import_design(design({}, {
            f"u{i}": cell(name, "i", I=["0"]) for i, name in enumerate(ODD_NAMES) if name}))
        self.assertEqual(len({name.lower() for name in done.lines("ADD COMPONENT")}),
                         len(ODD_NAMES) - 1)
        self.assertIn("is not a legal name in Verilog and VHDL; renamed to ", done.warnings[0])

    def test_messages_about_names(self) -> None:
        done = self.import_design(design({}, {
            "u": cell("$a\nb", "ii", parameters={"p": "1"}, P=["0"], **{"q[0]": ["0"]})}, name="t-op"))
        place = 'd.json: warning: modules["t-op"]'
        self.assertEqual(done.warnings, [
            f'{place}.cells.u.connections["q[0]"]: "q[0]" is not a legal name in Verilog and VHDL; '
            'renamed to q_0 in component "$a?b"',
            f'{place}.cells.u.parameters.p: another pin or parameter has the name "p"; '
            'renamed to p_1 in component "$a?b"',
            f'{place}.cells.u.type: "$a?b" is not a legal name in Verilog and VHDL; renamed to a_b',
            f'{place}: "t-op" is not a legal name in Verilog and VHDL; the netlist is renamed to t_op'])

    def test_odd_names_of_pins_and_parameters(self) -> None:
        done = self.import_design(design({}, {
            f"u{i}": cell(f"LEAF{i}", "i", parameters={name: "1"}, **{name: ["0"]})
            for i, name in enumerate(ODD_NAMES)}))
        pins = [line.split()[1].lower() for line in done.lines("ADD PIN")]
        generics = [line.split()[2].lower() for line in done.lines("ADD COMPONENT ATTRIBUTE")]
        self.assertEqual(len(pins), len(ODD_NAMES))
        for pin, generic in zip(pins, generics, strict=True):
            self.assertNotEqual(pin, generic)
        # Whoever writes the leaf cells must know of each name.
        self.assertEqual(len(done.warnings), 2 * len(ODD_NAMES))

    def test_odd_names_of_designs(self) -> None:
        for name in ODD_NAMES:
            with self.subTest(name):
                new = self.import_names(design({}, name=name))[0].removeprefix("SET NETLIST NAME ")
                self.assertIsNotNone(LEGAL.fullmatch(new))
        for name in ("$top", "entity", "std_logic", "1.5"):
            self.import_design(design({}, name=name))

    def test_odd_names_of_attributes(self) -> None:
        done = self.import_design(design({}, {
            "u": cell("LEAF", "i", I=["0"], attributes={name: "text" for name in ODD_NAMES})}),
            "--attributes")
        names = [line.split()[2] for line in done.lines("ADD INSTANCE ATTRIBUTE")]
        self.assertEqual(len({name.lower() for name in names}), len(ODD_NAMES))

    def test_names_equal_but_for_case(self) -> None:
        done = self.import_design(self.net_design("clk", "Clk", "CLK"))
        self.assertEqual(done.lines("ADD SIGNAL"), ["clk", "Clk_1", "CLK_2"])

    def test_ports_keep_their_names_before_nets_and_cells(self) -> None:
        done = self.import_design(design(
            {"X": port("input", 2)},
            {"x": cell("LEAF", "io", I=[2], O=[3]), "v": cell("LEAF", "io", I=[3], O=[])},
            {"x": net(3)}))
        self.assertEqual(done.lines("ADD PORT"), ["X Input"])
        self.assertEqual(done.lines("ADD SIGNAL"), ["x_1"])
        self.assertEqual(done.lines("ADD INSTANCE"), ["LEAF x_2", "LEAF v"])

    def test_net_and_cell_of_one_name(self) -> None:
        done = self.import_design(design(
            {}, {"n": cell("LEAF", "io", I=["1"], O=[3]), "v": cell("LEAF", "io", I=[3], O=[])},
            {"n": net(3)}))
        self.assertEqual(done.lines("ADD SIGNAL"), ["n"])
        self.assertEqual(done.lines("ADD INSTANCE"), ["LEAF n_1", "LEAF v"])

    def test_component_and_port_of_one_name(self) -> None:
        done = self.import_design(design({"inv": port("input", 2)},
                                         {"u": cell("INV", "i", I=[2])}))
        self.assertEqual(done.lines("ADD COMPONENT"), ["INV"])
        self.assertEqual(done.lines("ADD PORT"), ["inv_1 Input"])

    def test_design_and_port_of_one_name(self) -> None:
        # Legal in both languages, though GHDL mentions it; others call the port by its name.
        done = self.import_design(design({"top": port("input", 2)},
                                         {"Top": cell("LEAF", "i", I=[2])}), allowed="hides|top| \\^")
        self.assertEqual(done.lines("SET NETLIST NAME"), ["top"])
        self.assertEqual(done.lines("ADD PORT"), ["top Input"])

    def test_design_and_signal_of_one_name(self) -> None:
        done = self.import_design(design(
            {}, {"u": cell("LEAF", "o", O=[2]), "TOP": cell("OTHER", "i", I=[2])},
            {"Top": net(2)}))
        self.assertEqual(done.lines("ADD SIGNAL"), ["Top_1"])
        self.assertEqual(done.lines("ADD INSTANCE"), ["LEAF u", "OTHER TOP_2"])

    def test_design_and_component_of_one_name(self) -> None:
        done = self.import_design(design({"p": port("input", 2)}, {"u": cell("top", "i", I=[2])},
                                         name="$top"))
        self.assertEqual(done.lines("SET NETLIST NAME"), ["top_1"])

    def test_changed_names_leave_others_alone(self) -> None:
        done = self.import_design(self.net_design("a.b", "a_b", "a_b_1", "a+b"))
        self.assertEqual(done.names["net", "a_b"], "a_b")
        self.assertEqual(done.names["net", "a_b_1"], "a_b_1")
        self.assertEqual({done.names["net", "a.b"], done.names["net", "a+b"]}, {"a_b_2", "a_b_3"})

    def test_made_up_cell_names_tell_the_component(self) -> None:
        done = self.import_design(design(
            {}, {"$abc$1$auto$blifparse.cc:386:parse_blif$103": cell("INV", "i", 1, I=["0"]),
                 "$flatten\\u1.$procdff": cell("INV", "i", 1, I=["0"])}))
        self.assertEqual(done.lines("ADD INSTANCE"), ["INV INV_103", "INV flatten_u1_procdff"])

    def test_pins_equal_but_for_case(self) -> None:
        done = self.import_design(design(
            {}, {"u": cell("LEAF", "ii", d=["0"], D=["1"])}))
        self.assertEqual(done.lines("ADD PIN"), ["LEAF d Input", "LEAF D_1 Input"])

    def test_long_names(self) -> None:
        name = "long" * 100
        self.assertEqual(self.import_design(self.net_design(name)).lines("ADD SIGNAL"), [name])
        name = "long" * 250_000  # too much for some tools
        self.assertIn(f"ADD SIGNAL {name}", self.import_names(self.net_design(name)))

    def test_name_map(self) -> None:
        self.import_design(design(
            {"in": port("input", 2, 3)},
            {"u.1": cell("LEAF", "io", I=[2], O=[4], parameters={"P": "1"}),
             "v": cell("LEAF", "io", I=[4], O=[5], parameters={"P": "0"})},
            {"in": net(2, 3), "tab\there\\": net(4), "copy": net(3, 2), "unused": net(9)},
            LEAF=black_box({"I": port("input", 2), "O": port("output", 3)})))
        self.assertEqual(self.read("x.map").splitlines(), [
            "module\ttop\ttop",
            "component\tLEAF\tLEAF",
            "pin\tLEAF.I\tLEAF.I",
            "pin\tLEAF.O\tLEAF.O",
            "parameter\tLEAF.P\tLEAF.P",
            "port\tin\tin_1",
            "net\tin\tin_1",
            "net\ttab\\there\\\\\ttab_here",
            "net\tcopy\tin_1(0),in_1(1)",
            "net\tunused\t-",
            "cell\tu.1\tu_1",
            "cell\tv\tv"])


if __name__ == "__main__":
    unittest.main()
