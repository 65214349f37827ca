"""orn-hdl import --write-cells: which models it writes, and when it refuses to."""

from __future__ import annotations

import itertools
import json
import re
import shutil
import subprocess
import unittest
from pathlib import Path

from support import FAILED, SUCCESS, USAGE
from yosys_json import ImportTest, Json, cell, design, port

SHARE = Path(__file__).resolve().parents[2] / "share" / "orn-hdl" / "cells"
GATES = {"u": cell("$_AND_", "iio", A=[2], B=[3], Y=[4]),
         "v": cell("$_NOT_", "io", A=[4], Y=[5])}
PORTS = {"a": port("input", 2), "b": port("input", 3), "y": port("output", 5)}
WIDTH = {"A_SIGNED": "0" * 32, "A_WIDTH": format(1, "032b"), "Y_WIDTH": format(1, "032b")}


class CellModels(ImportTest):
    def models(self, file: Json, *options: str, status: int = SUCCESS) -> tuple[str, str]:
        """The models that are written for a design, and the messages."""
        self.write("d.json", json.dumps(file))
        outcome = self.run_tool("import", "d.json", "--vhdl", "top.vhd", "--write-cells", "models.vhd",
                                *options)
        self.assertEqual(outcome.status, status, outcome.err)
        return self.read("models.vhd") if (self.folder / "models.vhd").exists() else "", outcome.err

    def entities(self, file: Json) -> list[str]:
        return re.findall(r"^entity (\w+) is", self.models(file)[0], re.MULTILINE)

    def test_only_what_is_used(self) -> None:
        self.assertEqual(self.entities(design(PORTS, GATES)), ["AND_1", "NOT_1"])

    def test_name_that_another_component_has(self) -> None:
        size = {"WIDTH": format(1, "032b")}
        cells = {"u": cell("$mux", "iiio", parameters=size, A=[2], B=[3], S=[3], Y=[5]),
                 "v": cell("$_MUX_", "iiio", A=[2], B=[3], S=[2], Y=[6])}
        text, _ = self.models(design(PORTS, cells))
        self.assertEqual(re.findall(r"^entity (\w+) is", text, re.MULTILINE),
                         ["orn_hdl_mux", "mux", "MUX_1"])
        self.assertIn("architecture model of MUX_1 is", text)

    def test_all_gates(self) -> None:
        """The file that is installed has the names that the import gives."""
        installed = (SHARE / "gates.vhd").read_text()
        cells, nets = {}, itertools.count(10)
        for model in installed.split("\n\n-- $")[1:]:
            pins = re.findall(r"^      (\w+) : (in|out) std_logic", model, re.MULTILINE)
            cells[f"u{len(cells)}"] = cell("$" + model.partition(":")[0],
                                           "".join(direction[0] for _, direction in pins),
                                           **{pin: [next(nets)] for pin, _ in pins})
        text, _ = self.models(design({}, cells), "--names", "both")
        self.assertEqual(text.partition("\n\n")[2], installed.partition("\n\n")[2])

    def test_every_cell_has_a_model_or_a_reason(self) -> None:
        """The page names all cells of Yosys that have no model, and no others."""
        if shutil.which("yosys") is None:
            self.skipTest("yosys is not installed")
        told = subprocess.run(["yosys", "-p", "help -cells"], check=True, capture_output=True, text=True).stdout
        if "Yosys 0.23 " not in told:
            self.skipTest("the page is about Yosys 0.23")
        known = set(re.findall(r"^    (\$\w+)", told, re.MULTILINE))
        models = {name for file in SHARE.glob("*.vhd")
                  for name in re.findall(r"^-- (\$\w+):", file.read_text(), re.MULTILINE)}
        page = (SHARE.parents[2] / "docs" / "import.md").read_text()
        table = page.partition("| cells without a model |")[2].partition("\n\n")[0]
        named = {name for row in table.splitlines()[2:]
                 for name in re.findall(r"`(\$\w+)`", row.split("|")[1])}
        self.assertGreater(len(models), 200)
        self.assertEqual(models - known, set())
        self.assertEqual(named, known - models)

    def test_tables_of_state_machines_are_texts(self) -> None:
        """Two machines of one component, one of which has no "-" in its table."""
        size = {name: bits for name, bits in (("CTRL_IN_WIDTH", 1), ("CTRL_OUT_WIDTH", 1), ("TRANS_NUM", 1))}
        cells = {f"u{i}": cell("$fsm", "iiio", CLK=[2], ARST=[3], CTRL_IN=[2], CTRL_OUT=[5 + i],
                               parameters={**size, "TRANS_TABLE": table})
                 for i, table in enumerate(("00-01", "00x01"))}
        text, messages = self.models(design({"a": port("input", 2), "b": port("input", 3)}, cells))
        self.assertIn("TRANS_TABLE : string", text)
        self.assertIn("TRANS_TABLE => TRANS_TABLE", text)
        self.assertEqual(self.read("top.vhd").count('TRANS_TABLE => "00'), 2)
        self.assertNotIn("x means any value", messages)

    def test_word_has_package_and_entity_once(self) -> None:
        wide = {**WIDTH, "A_WIDTH": format(2, "032b")}
        cells = {"u": cell("$not", "io", parameters=WIDTH, A=[2], Y=[5]),
                 "v": cell("$not", "io", parameters=wide, A=[2, 3], Y=[6])}
        text, _ = self.models(design(PORTS, cells))
        self.assertEqual(text.count("\npackage orn_hdl_cells is"), 1)
        self.assertEqual(re.findall(r"^entity (\w+) is", text, re.MULTILINE),
                         ["orn_hdl_not", "not_1", "not_2"])
        self.assertIn("A(0) => A", text)
        self.assertIn("A : in std_logic_vector(1 downto 0)", text)

    def test_integers_become_bits(self) -> None:
        numbers = {"A_SIGNED": 0, "A_WIDTH": 1, "Y_WIDTH": 1}
        text, _ = self.models(design(PORTS, {"u": cell("$not", "io", parameters=numbers,
                                                       A=[2], Y=[5])}))
        self.assertIn("A_WIDTH : integer", text)
        self.assertIn("A_WIDTH => work.orn_hdl_cells.bits_of(A_WIDTH)", text)

    def test_no_model(self) -> None:
        text, messages = self.models(design(PORTS, {"u": cell("$_FF_", "io", D=[2], Q=[5]),
                                                    "w": cell("BOX", "i", A=[3])}))
        self.assertNotIn("entity", text)
        self.assertIn('there is no simulation model of "$_FF_"; VHDL needs an entity FF', messages)
        self.assertNotIn("BOX", messages)

    def test_pins_that_the_cell_does_not_have(self) -> None:
        text, messages = self.models(design(PORTS, {"u": cell("$_NOT_", "io", IN=[2], Y=[5])}))
        self.assertNotIn("entity", text)
        self.assertIn("there is no simulation model", messages)

    def test_name_that_models_need(self) -> None:
        text, messages = self.models(design(PORTS, GATES, name="Orn_Hdl_add"), status=FAILED)
        self.assertEqual(text, "")
        self.assertIn('"Orn_Hdl_add": the models of cells have names that begin with "orn_hdl_"',
                      messages)

    def test_names_for_verilog_alone(self) -> None:
        text, messages = self.models(design(PORTS, GATES), "--names", "verilog", status=USAGE)
        self.assertEqual(text, "")
        self.assertIn("--write-cells needs names that are legal in VHDL", messages)

    def test_netlist_in_verilog(self) -> None:
        self.write("top.v", "module top(input a); BOX u(.A(a)); endmodule\n")
        outcome = self.run_tool("import", "top.v", "--write-cells", "models.vhd")
        self.assertEqual(outcome.status, USAGE)
        self.assertIn("--write-cells applies to JSON netlists alone", outcome.err)

    def test_file_stays_after_an_error(self) -> None:
        self.write("models.vhd", "before")
        text, _ = self.models(design(PORTS, {"u": cell("$_NOT_", "io", A=["x"], Y=[5])}),
                              status=FAILED)
        self.assertEqual(text, "before")


if __name__ == "__main__":
    unittest.main()
