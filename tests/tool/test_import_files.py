"""orn-hdl import: files that are no netlist, or not a flat one."""

from __future__ import annotations

import json
import re
import unittest

from support import FAILED, SUCCESS
from yosys_json import MARK, ImportTest, Json, black_box, cell, design, net, port

STRUCTURE = "invalid JSON: a comma, colon, quote or bracket is missing or superfluous"


class Malformed(ImportTest):
    def refuse_top(self, part: Json, message: str) -> None:
        """A top module of these parts is refused, the message behind the module's path."""
        self.refuse({"modules": {"top": part}}, f"modules.top.{message}")

    def test_no_json_at_all(self) -> None:
        for text in ("", " \n", "module top; endmodule", "{", '{"modules"', '{"modules": {}',
                     '{"modules": {"top": {"ports": {"a": {"bits": [', "\0", "{]", '"text'):
            with self.subTest(text):
                path = self.write("d.json", text)
                outcome = self.run_tool("import", path, "-o", "x.cmd")
                self.assertEqual((outcome.status, outcome.out), (FAILED, ""))
                self.assertIn("invalid JSON: ", outcome.err)
                self.assertRegex(outcome.err, rf"^{re.escape(str(path))}(:1)?: error: invalid JSON: "
                                              "|: modules[^ ]*: invalid JSON: ")
                self.assertEqual(outcome.err.count("error: "), 1)
                self.assertFalse((self.folder / "x.cmd").exists())

    def test_every_cut_of_a_file(self) -> None:
        text = json.dumps(design({"a": port("input", 2), "y": port("output", 3)},
                                 {"u": cell("INV", "io", I=[2], O=[3], parameters={"P": "1"})},
                                 {"a": net(2)}))
        for length in range(len(text)):
            self.write("d.json", text[:length])
            outcome = self.run_tool("import", "d.json")
            self.assertEqual(outcome.status, FAILED, text[:length])
            self.assertRegex(outcome.err, "^d.json(:1)?: error: ")
        self.write("d.json", text)
        self.expect(self.run_tool("import", "d.json"), SUCCESS)

    def test_the_place_of_a_syntax_error(self) -> None:
        self.refuse('{"modules": {"top": {"cells": {"u.1": {"type": "A", "connections": '
                    '{"P": [1, 2,, 3]}}}}}}',
                    f'modules.top.cells["u.1"].connections.P[2]: {STRUCTURE}',
                    place=" " * 79 + "^")
        self.refuse('{"modules": {"top": {"attributes": {"src": "x" "y"}}}}',
                    f"modules.top.attributes: {STRUCTURE}", place=" " * 47 + "^")

    def test_errors_in_what_is_not_needed(self) -> None:
        for wrong in ("[1 2]", '{"a" 1}', "truth", "nul", "1.", "01", '"\\x"', "-", "[1,]"):
            with self.subTest(wrong):
                path = self.write("d.json", '{"creator": %s, "modules": {"top": {}}}' % wrong)
                outcome = self.run_tool("import", path)
                self.assertEqual(outcome.status, FAILED)
                self.assertIn("invalid JSON: ", outcome.err)

    def test_what_is_not_needed_may_be_anything(self) -> None:
        contents = design({"a": port("input", 2)})
        contents["models"] = {"m": [["port", 1, 2.5, -1e3, True, False, None, {"x": []}]]}
        self.import_design(contents)

    def test_something_behind_the_netlist(self) -> None:
        self.refuse('{"modules": {"top": {}}} {}', "nothing may follow the netlist")

    def test_bytes_that_are_no_utf_8(self) -> None:
        self.refuse(b'{"modules": {"\xff": {}}}',
                    "invalid JSON: a byte that is not UTF-8", place=" " * 14 + "^")

    def test_other_json(self) -> None:
        self.refuse("[]", "an object is expected")
        self.refuse("{}", 'not a netlist: "modules" is missing')
        self.refuse('{"modules": []}', "modules: an object is expected")
        self.refuse('{"modules": {}}', "modules: there is no module with contents")
        self.refuse('{"modules": {"top": 1}}', "modules.top: an object is expected")

    def test_deep_nesting(self) -> None:
        self.write("d.json", '{"x": ' + "[" * 100_000 + "]" * 100_000 + "}")
        outcome = self.run_tool("import", "d.json")
        self.assertEqual(outcome.status, FAILED)
        self.assertTrue(outcome.err.endswith("nested too deeply\n"), outcome.err[-100:])

    def test_wrong_ports(self) -> None:
        self.refuse_top({"ports": []}, "ports: an object is expected")
        self.refuse_top({"ports": {"a": {"bits": [2]}}}, "ports.a: a port needs a direction")
        self.refuse_top({"ports": {"a": {"direction": "input"}}},
                        "ports.a: a port needs at least one bit")
        self.refuse_top({"ports": {"a": {"direction": "in", "bits": [2]}}},
                        'ports.a.direction: a direction is "input", "output" or "inout"')
        self.refuse_top({"ports": {"a": {"direction": 1, "bits": [2]}}},
                        "ports.a.direction: a text is expected")
        self.refuse_top({"ports": {"a": {"direction": "input", "bits": 2}}},
                        "ports.a.bits: a list is expected")
        self.refuse_top({"ports": {"a": {"direction": "input", "bits": [2], "offset": "1"}}},
                        "ports.a.offset: an integer is expected")

    def test_wrong_bits(self) -> None:
        bit = 'a bit is a number or one of "0", "1", "x" and "z"'
        for wrong, message in ((-1, "the number of a net is negative"), ("2", bit), ("", bit),
                               ("01", bit), (1.5, "an integer is expected"),
                               (2**64, "an integer is expected"), (None, "a text is expected"),
                               ([], "a text is expected")):
            with self.subTest(wrong):
                self.refuse_top({"netnames": {"n": {"bits": [2, wrong]}}},
                                f"netnames.n.bits[1]: {message}")

    def test_wrong_cells(self) -> None:
        self.refuse_top({"cells": {"u": {}}}, "cells.u: a cell needs a type")
        self.refuse_top({"cells": {"u": {"type": ""}}}, "cells.u: a cell needs a type")
        self.refuse_top({"cells": {"u": {"type": "A", "connections": []}}},
                        "cells.u.connections: an object is expected")
        self.refuse_top({"cells": {"u": {"type": "A", "parameters": {"P": []}}}},
                        "cells.u.parameters.P: a text is expected")
        self.refuse_top({"cells": {"u": {"type": "A", "port_directions": {"P": "up"}}}},
                        'cells.u.port_directions.P: a direction is "input", "output" or "inout"')

    def test_names_that_occur_twice(self) -> None:
        self.refuse('{"modules": {"a": {}, "a": {}}}', "modules.a: the name occurs twice")
        self.refuse('{"modules": {"a": {"cells": {"u": {"type": "A"}, "u": {"type": "A"}}}}}',
                    "modules.a.cells.u: the name occurs twice")
        self.refuse('{"modules": {"a": {"cells": {"u": {"type": "A", "connections": '
                    '{"P": [1], "P": [2]}}}}}}',
                    "modules.a.cells.u.connections.P: the pin is connected twice")

    def test_fields_in_any_order(self) -> None:
        done = self.import_design({"modules": {"top": {
            "cells": {"u": {"connections": {"I": [2]}, "port_directions": {"I": "input"},
                            "type": "INV"}},
            "netnames": {}, "ports": {"a": {"bits": [2], "direction": "input"}}}}})
        self.assertEqual(done.lines("CONNECT SIGNAL"), ["a u.I"])

    def test_control_characters_in_messages(self) -> None:
        self.refuse('{"modules": {"a\\n\\u001b[2J\\"": 1}}',
                    'modules["a??[2J\\""]: an object is expected')


class Top(ImportTest):
    def several(self) -> Json:
        return {"modules": {name: {"ports": {f"in_{name}": port("input", 2)}, "cells": {
            "u": cell("LEAF", "i", I=[2])}} for name in ("one", "two")}}

    def test_only_module(self) -> None:
        self.import_design({"modules": {"one": {"ports": {"a": port("input", 2)}}}})

    def test_only_module_that_is_no_black_box(self) -> None:
        done = self.import_design({"modules": {
            "LEAF": black_box({"I": port("input", 2)}), "one": self.several()["modules"]["one"]}})
        self.assertEqual(done.lines("SET NETLIST NAME"), ["one"])

    def test_marked_module(self) -> None:
        for mark in (MARK, "1", 1):
            contents = self.several()
            contents["modules"]["two"]["attributes"] = {"top": mark}
            done = self.import_design(contents)
            self.assertEqual(done.lines("SET NETLIST NAME"), ["two"])

    def test_mark_that_is_zero(self) -> None:
        contents = self.several()
        contents["modules"]["two"]["attributes"] = {"top": "0000"}
        self.refuse(contents, "modules: several modules could be the top one; name it with --top")

    def test_named_module(self) -> None:
        done = self.import_design(self.several(), "--top", "one")
        self.assertEqual(done.lines("SET NETLIST NAME"), ["one"])

    def test_named_before_marked(self) -> None:
        contents = self.several()
        contents["modules"]["two"]["attributes"] = {"top": MARK}
        done = self.import_design(contents, "--top", "one")
        self.assertEqual(done.lines("SET NETLIST NAME"), ["one"])

    def test_no_choice(self) -> None:
        self.refuse(self.several(),
                    "modules: several modules could be the top one; name it with --top")
        self.refuse(self.several(), 'modules: there is no module "three"', "--top", "three")
        self.refuse({"modules": {"LEAF": black_box({"I": port("input", 2)})}},
                    "modules: there is no module with contents")


class Hierarchy(ImportTest):
    def with_module(self, module: Json) -> Json:
        return design({"a": port("input", 2)}, {"u": cell("sub", "i", I=[2])}, sub=module)

    def test_empty_module(self) -> None:
        self.import_design(self.with_module({"ports": {"I": port("input", 2),
                                                       "O": port("output", 3)}}))

    def test_white_box(self) -> None:
        self.import_design(self.with_module({
            "attributes": {"whitebox": MARK}, "ports": {"I": port("input", 2)},
            "cells": {"v": cell("LEAF", "i", I=[2])}}))

    def test_module_that_holds_itself(self) -> None:
        self.refuse(design({"a": port("input", 2)}, {"u": cell("top", "i", I=[2])}),
                    'modules.top.cells.u.type: the module contains itself: "top" > "top"')


if __name__ == "__main__":
    unittest.main()
