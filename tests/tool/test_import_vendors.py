"""orn-hdl import: designs that Yosys maps to the cells of FPGAs import without an option."""

from __future__ import annotations

import json
import shutil
import unittest
from pathlib import Path

from yosys_json import ImportTest, Json, make_stubs

RTL = Path(__file__).resolve().parents[1] / "flow" / "rtl"


@unittest.skipIf(shutil.which("yosys") is None, "Yosys is not installed")
class Vendors(ImportTest):
    def import_mapped(self, design: str, vendor: str) -> None:
        """Has Yosys map a design with its own library; compares what it reads of the result."""
        self.judge(["yosys", "-q", "-p", f"read_verilog {RTL / design}.v; "
                    f"synth_{vendor} -flatten -top {design}; write_json d.json"], allowed=".")
        old = json.loads(self.read("d.json"))["modules"][design]
        # VHDL leaves no open input and Icarus tells of them; an LUT may have some.
        done = self.import_file("d.json", allowed="dangling input port")
        self.write("stubs.v", "\n".join(make_stubs(done.commands)))
        self.judge(["yosys", "-q", "-p", "read_verilog -lib stubs.v; read_verilog x.verilog; "
                    f"hierarchy -check -top {design}; write_json y.json"])
        new = json.loads(self.read("y.json"))["modules"][design]
        self.compare_wiring(old, new)
        self.compare_parameters(old, new, done.names)
        components = done.lines("ADD COMPONENT")
        self.assertEqual(len([line for line in components if not line.startswith("ATTRIBUTE")]),
                         len({cell["type"] for cell in old["cells"].values()}))

    def compare_parameters(self, old: Json, new: Json, names: dict[tuple[str, str], str]) -> None:
        """Each parameter keeps its value; x is left out, or 0."""
        for name, cell in old["cells"].items():
            parameters = dict(new["cells"][names["cell", name]]["parameters"])
            for key, value in cell["parameters"].items():
                self.assertIn(parameters.pop(key, value.replace("x", "0")),
                              (value, value.replace("x", "0")), f"{name}.{key}")
            self.assertEqual(parameters, {}, name)


def make_test(design: str, vendor: str):
    return lambda self: self.import_mapped(design, vendor)


for design in ("counter", "feedback"):
    for vendor in ("xilinx", "ice40", "ecp5"):
        setattr(Vendors, f"test_{design}_{vendor}", make_test(design, vendor))


if __name__ == "__main__":
    unittest.main()
