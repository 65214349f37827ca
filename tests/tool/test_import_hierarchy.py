"""orn-hdl import: designs of several modules."""

from __future__ import annotations

import json
import re
import shutil
import subprocess
import unittest

from hierarchy_rtl import COUNTERS, MEMORY, PIPE, WORDS
from support import EXAMPLES, FAILED, SUCCESS, USAGE
from yosys_json import MARK, ImportTest, Json, black_box, cell, design, net, port


def module(ports: Json, cells: Json | None = None, **more: Json) -> Json:
    return {"ports": ports, "cells": cells or {}, "netnames": {}, **more}


def inverter(module_input: str = "I", module_output: str = "O") -> Json:
    """A module with a cell in it."""
    return module({module_input: port("input", 2), module_output: port("output", 3)},
                  {"v": cell("INV", "io", I=[2], O=[3])})


# The cells of the designs below.
LEAVES = ("module INV(input I, output O); endmodule\n", """\
library ieee;
use ieee.std_logic_1164.all;
entity INV is
   port (I : in std_logic; O : out std_logic);
end INV;
architecture EMPTY of INV is
begin
end EMPTY;
""")


class HierarchyTest(ImportTest):
    def import_both(self, contents: Json | None = None, *options: str,
                    message: str | None = "") -> tuple[str, str]:
        """Imports a design in both languages; the judges accept what is written."""
        if contents is not None:
            self.write("d.json", json.dumps(contents))
        outcome = self.run_tool("import", "d.json", "--verilog", "d.v", "--vhdl", "d.vhd",
                                "--name-map", "x.map", *options)
        self.assertEqual((outcome.status, outcome.out), (SUCCESS, ""), outcome.err)
        if message is not None:
            self.assertEqual(outcome.err, message)
        return self.read("d.v"), self.read("d.vhd")

    def judge_both(self, top: str = "top") -> None:
        self.write("leaves.v", LEAVES[0])
        self.write("leaves.vhd", LEAVES[1])
        if shutil.which("iverilog") is None or shutil.which("ghdl") is None:
            self.skipTest("a judge is not installed")
        self.judge(["iverilog", "-g2005", "-Wall", "-Wno-timescale", "-tnull", "-s", top, "d.v",
                    "leaves.v"])
        package = EXAMPLES / "cells" / "kestra_vcomponents.vhd"
        for edition in ("93c", "08"):  # By the strict rules of 93, only a configuration binds.
            folder = self.folder / f"ghdl{edition}"
            folder.mkdir(exist_ok=True)
            flags = [f"--std={edition}", f"--workdir={folder}", f"-P{folder}"]
            self.judge(["ghdl", "-a", *flags, "--work=KESTRA", str(package)])
            self.judge(["ghdl", "-a", *flags, "leaves.vhd", "d.vhd"])
            self.judge(["ghdl", "-e", *flags, top])

    @staticmethod
    def modules_of(verilog: str) -> list[str]:
        return re.findall(r"^module (\S+?)\(", verilog, re.MULTILINE)

    @staticmethod
    def entities_of(vhdl: str) -> list[str]:
        return re.findall(r"^entity (\w+) is", vhdl, re.MULTILINE)


class Order(HierarchyTest):
    def two_levels(self) -> Json:
        return design({"a": port("input", 2), "y": port("output", 4)},
                      {"u": cell("mid", "io", a=[2], y=[3]), "w": cell("low", "io", I=[3], O=[4])},
                      low=inverter(),
                      mid=module({"a": port("input", 2), "y": port("output", 3)},
                                 {"v": cell("low", "io", I=[2], O=[3])}),
                      spare=inverter())

    def test_used_modules_come_first(self) -> None:
        verilog, vhdl = self.import_both(self.two_levels())
        self.assertEqual(self.modules_of(verilog), ["low", "mid", "top"])
        self.assertEqual(self.entities_of(vhdl), ["low", "mid", "top"])
        self.judge_both()

    def test_one_header_names_the_top_module(self) -> None:
        for text in self.import_both(self.two_levels()):
            self.assertEqual(text.count("Vendor: Halvex"), 1)
            self.assertEqual(re.findall(r"Design Name: (.*)", text), ["top"])
            self.assertEqual(len(re.findall(r"Filename : d\.vh?d?$", text, re.MULTILINE)), 1)
        for text in self.import_both(None, "--no-header"):
            self.assertNotIn("Vendor", text)

    def test_standard_output(self) -> None:
        self.import_both(self.two_levels(), "--no-header")
        for language, file in (("verilog", "d.v"), ("vhdl", "d.vhd")):
            self.expect(self.run_tool("import", "d.json", f"--{language}", "-", "--no-header"),
                        SUCCESS, "", self.read(file))

    def test_single_module_is_as_ever(self) -> None:
        """The module below, imported alone, is what it is among others."""
        self.import_both(self.two_levels(), "--no-header")
        self.expect(self.run_tool("import", "d.json", "--top", "low", "--verilog", "low.v",
                                  "--vhdl", "low.vhd", "--no-header"), SUCCESS)
        self.assertTrue(self.read("d.v").startswith(self.read("low.v")))
        self.assertTrue(self.read("d.vhd").startswith(self.read("low.vhd")))

    def test_top_module(self) -> None:
        verilog, _ = self.import_both(self.two_levels(), "--top", "mid")
        self.assertEqual(self.modules_of(verilog), ["low", "mid"])

    def test_only_module_that_no_other_uses(self) -> None:
        contents = self.two_levels()
        del contents["modules"]["top"]["attributes"], contents["modules"]["spare"]
        self.assertEqual(self.modules_of(self.import_both(contents)[0]), ["low", "mid", "top"])

    def test_modules_alone(self) -> None:
        self.import_both(self.two_levels())
        whole = self.read("x.map")
        verilog, _ = self.import_both(None, "--module", "top", "--module", "low")
        self.assertEqual(self.modules_of(verilog), ["low", "top"])
        for line in self.read("x.map").splitlines():
            self.assertIn(line, whole.splitlines())

    def test_modules_that_cannot_be(self) -> None:
        self.refuse(self.two_levels(), 'modules: there is no module "high"', "--module", "high")
        contents = self.two_levels()
        contents["modules"]["BOX"] = black_box({"I": port("input", 2)})
        self.refuse(contents, "modules.BOX: the module has no contents", "--module", "BOX")
        outcome = self.run_tool("import", "d.json", "--module", "low", "--top", "top")
        self.assertEqual(outcome.status, USAGE)
        self.write("d.v", "module m(input a); endmodule")
        self.expect(self.run_tool("import", "d.v", "--module", "m"), USAGE,
                    "orn-hdl: --module applies to JSON netlists alone; see --help\n")

    def test_module_of_wires_has_contents(self) -> None:
        for bit in (2, "1"):
            verilog, _ = self.import_both(design(
                {"a": port("input", 2), "y": port("output", 3)},
                {"u": cell("sub", "io", I=[2], O=[3])},
                sub=module({"I": port("input", 2), "O": port("output", bit)})))
            self.assertEqual(self.modules_of(verilog), ["sub", "top"])
            self.judge_both()

    def test_recursion(self) -> None:
        contents = self.two_levels()
        contents["modules"]["low"]["cells"]["x"] = cell("mid", "io", a=[2], y=[9])
        self.refuse(contents, 'modules.low.cells.x.type: the module contains itself: "mid" > '
                              '"low" > "mid"')

    def test_thousand_levels(self) -> None:
        """The depth of a design is not that of the tool's stack."""
        levels = {f"m{i}": module({"a": port("input", 2)},
                                  {"u": cell(f"m{i + 1}", "i", a=[2])}) for i in range(1000)}
        levels["m1000"] = module({"a": port("input", 2)}, {"u": cell("INV", "i", I=[2])})
        levels["m0"]["attributes"] = {"top": MARK}
        verilog, _ = self.import_both({"modules": levels})
        self.assertEqual(self.modules_of(verilog), [f"m{i}" for i in range(1000, -1, -1)])


class Cells(HierarchyTest):
    def with_cell(self, instance: Json) -> Json:
        return design({"a": port("input", 2, 3), "y": port("output", 4)}, {"u": instance},
                      sub=module({"A": port("input", 2, 3), "Y": port("output", 4)},
                                 {"v": cell("INV", "io", I=[2], O=[4])},
                                 parameter_default_values={"P": "01"}))

    def test_open_and_constant_pins(self) -> None:
        verilog, vhdl = self.import_both(self.with_cell(cell("sub", "i", A=["0", 3])))
        self.assertEqual(self.modules_of(verilog), ["sub", "top"])
        self.assertIn("Y=>open", vhdl)
        self.judge_both()

    def test_parameters_of_a_module_have_their_values(self) -> None:
        _, vhdl = self.import_both(self.with_cell(cell("sub", "io", A=[2, 3], Y=[4])))
        self.assertNotIn("generic", vhdl)
        (self.folder / "x.map").unlink()
        self.refuse(self.with_cell(cell("sub", "io", parameters={"P": "11"}, A=[2, 3], Y=[4])),
                    'modules.top.cells.u.parameters: the parameters of the module "sub" have their '
                    "values already; let Yosys copy the module for these (hierarchy)")

    def test_wrong_connections(self) -> None:
        self.refuse(self.with_cell(cell("sub", "io", A=[2], Y=[4])),
                    "modules.top.cells.u.connections.A: 1 bits are connected to a port of 2 bits "
                    'of the module "sub"')
        self.refuse(self.with_cell(cell("sub", "i", B=[2])),
                    'modules.top.cells.u.connections.B: the module "sub" has no such port')

    def test_directions_of_ports_that_are_none(self) -> None:
        wrong = cell("sub", "io", A=[2, 3], Y=[4])
        wrong["port_directions"]["B"] = "input"
        self.refuse(self.with_cell(wrong),
                    'modules.top.cells.u.type: the module "sub" has no port "B", which the '
                    "directions of a cell name")

    def test_library_does_not_replace_a_module(self) -> None:
        self.write("c.v", "module sub(input I); endmodule")
        verilog, _ = self.import_both(self.with_cell(cell("sub", "io", A=[2, 3], Y=[4])), "-l",
                                      "c.v")
        self.assertEqual(self.modules_of(verilog), ["sub", "top"])

    def test_leaf_cells_of_two_modules_agree(self) -> None:
        """One name is one set of pins in the whole design."""
        verilog, vhdl = self.import_both(design(
            {"a": port("input", 2, 3), "y": port("output", 4)},
            {"u": cell("sub", "io", A=[2], Y=[4]), "v": cell("SUM", "i", I=[2, 3]),
             "w": cell("BUF", "i", I=[2])},
            sub=module({"A": port("input", 2), "Y": port("output", 3)},
                       {"v": cell("SUM", "io", I=[2], O=[3]), "w": cell("BUF", "i", I=[2])})),
            message=None)
        self.assertEqual(re.findall(r"component (\w+)", vhdl),
                         ["SUM", "BUF", "sub", "SUM_1", "BUF"])
        self.assertEqual(len(re.findall(r"\bSUM_1 v \(", verilog)), 1)


class Names(HierarchyTest):
    def test_renamed_port_is_renamed_in_every_instance(self) -> None:
        verilog, vhdl = self.import_both(design(
            {"a": port("input", 2), "y": port("output", 4)},
            {"u": cell("sub", "io", **{"in": [2], "a.b": [3]}),
             "w": cell("sub", "io", **{"in": [3], "a.b": [4]})},
            sub=inverter("in", "a.b")), message=None)
        for text in (verilog, vhdl):
            self.assertNotRegex(text, r"a\.b|\bin\b *(:|=>|\()")
        self.assertEqual(len(re.findall(r"\ba_b=>", vhdl)), 2)
        self.assertEqual(len(re.findall(r"\.a_b ?\(", verilog)), 2)
        self.judge_both()
        with self.subTest("names of Verilog alone"):
            self.expect(self.run_tool("import", "d.json", "--verilog", "d.v"), SUCCESS)
            self.assertEqual(self.read("d.v").count(".\\a.b "), 2)
            self.judge_both()

    def test_port_named_like_a_module(self) -> None:
        """In VHDL, both would stand in one region; the port of the module gives way."""
        contents = design({"a": port("input", 2), "y": port("output", 3)},
                          {"u": cell("mid", "io", low=[2], y=[3])}, low=inverter(),
                          mid=module({"low": port("input", 2), "y": port("output", 3)},
                                     {"v": cell("low", "io", I=[2], O=[3])}))
        _, vhdl = self.import_both(contents, message=None)
        self.assertIn("low_1=>a", vhdl)
        self.judge_both()
        self.expect(self.run_tool("import", "d.json", "--verilog", "d.v"), SUCCESS)
        self.judge_both()

    def test_names_that_differ_in_letter_case(self) -> None:
        contents = design({"a": port("input", 2), "y": port("output", 4)},
                          {"u": cell("Sub", "io", I=[2], O=[3]),
                           "w": cell("sub", "io", I=[3], O=[4])}, sub=inverter(), Sub=inverter())
        _, vhdl = self.import_both(contents, message=None)
        self.assertEqual(self.entities_of(vhdl), ["Sub_1", "sub", "top"])
        self.judge_both()
        self.expect(self.run_tool("import", "d.json", "--verilog", "d.v"), SUCCESS)
        self.judge_both()

    def test_copies_of_modules(self) -> None:
        hashed = "$paramod$b7ca9bd56160cd76a1240b83200703503dd53850\\fifo"
        wanted = {
            "$paramod\\fifo\\DEPTH=s32'00000000000000000000000000010000": "fifo_DEPTH_16",
            "$paramod\\fifo\\DEPTH=s32'11111111111111111111111111111111": "fifo_DEPTH_m1",
            "$paramod\\fifo\\A=3'101\\B=1'0": "fifo_A_5_B_0",
            "$paramod\\fifo\\MODE=t24'010001100100111101001111": "fifo_MODE_FOO",
            "$paramod\\fifo\\KEY=64'1111" + "0" * 60: "fifo_KEY_xf000000000000000",
            "$paramod\\fifo\\U=1'x": "fifo_U_x",
            hashed: "fifo_b7ca9bd5",
            "$paramod\\end.of\\W=s32'1": "end_of_W_m1",
        }
        cells = {f"u{i}": cell(name, "io", I=[2], O=[10 + i]) for i, name in enumerate(wanted)}
        self.import_both(design({"a": port("input", 2)}, cells,
                                **{name: inverter() for name in wanted}))
        names = self.read_names()
        self.assertEqual({name: names["module", name.replace("\\", "\\\\")] for name in wanted},
                         wanted)
        self.judge_both()

    def test_parameters_of_a_copy_with_a_number(self) -> None:
        """A long list of parameters is in no name."""
        name = "$paramod$b7ca9bd56160cd76a1240b83200703503dd53850\\fifo"
        for defaults, wanted in (
                ({"MODE": "FOO", "W": "0" * 28 + "1000", "Y": "11111111111111111111111111111110"},
                 "fifo_MODE_FOO_W_8_Y_m2"),
                ({"INIT": "1" * 300}, "fifo_INIT_xffffffffffffffff"),
                ({"A_LONG_NAME_OF_A_PARAMETER": "0" * 31 + "1", "B": "a text that is rather long"},
                 "fifo_b7ca9bd5")):
            self.import_both(design({"a": port("input", 2)},
                                    {"u": cell(name, "io", I=[2], O=[3])},
                                    **{name: {**inverter(), "parameter_default_values": defaults}}))
            self.assertEqual(self.read_names()["module", name.replace("\\", "\\\\")], wanted)

    def test_copies_that_would_share_a_name(self) -> None:
        """The names are distinct, and those of the file's own modules stay."""
        one, other = "$paramod\\m\\W=4'0001", "$paramod\\m\\W=8'00000001"
        self.import_both(design({"a": port("input", 2)},
                                {name: cell(name, "io", I=[2], O=[3 + i])
                                 for i, name in enumerate((one, other, "m_W_1"))},
                                **{one: inverter(), other: inverter(), "m_W_1": inverter()}))
        names = self.read_names()
        self.assertEqual([names["module", name.replace("\\", "\\\\")]
                          for name in (one, other, "m_W_1")], ["m_W_1_1", "m_W_1_2", "m_W_1"])

    def test_legal(self) -> None:
        self.write("d.json", json.dumps(design(
            {"a": port("input", 2), "y": port("output", 4)},
            {"u": cell("sub", "io", **{"in": [2], "a.b": [3]}),
             "w": cell("sub", "io", **{"in": [3], "a.b": [4]})},
            sub=inverter("in", "a.b"))))
        # Escaped names of Verilog are no names in VHDL.
        outcome = self.run_tool("import", "d.json", "--names", "verilog", "--legal", "--verify",
                                "--verilog", "d.v", "--vhdl", "d.vhd")
        self.assertEqual(outcome.status, SUCCESS, outcome.err)
        self.assertEqual(len(re.findall(r"\ba_b=>", self.read("d.vhd"))), 2)
        self.judge_both()


class Files(HierarchyTest):
    def setUp(self) -> None:
        super().setUp()
        self.contents = design({"a": port("input", 2), "y": port("output", 3)},
                               {"u": cell("sub", "io", I=[2], O=[3])}, sub=inverter())
        self.write("d.json", json.dumps(self.contents))

    def test_one_file_a_module(self) -> None:
        self.expect(self.run_tool("import", "d.json", "--output-dir", "out/rtl", "--vhdl",
                                  "d.list", "--verilog", "-", "-o", "c.list"), SUCCESS,
                    "", "out/rtl/sub.v\nout/rtl/top.v\n")
        self.assertEqual(self.read("d.list"), "out/rtl/sub.vhd\nout/rtl/top.vhd\n")
        self.assertEqual(self.read("c.list"), "out/rtl/sub.cmd\nout/rtl/top.cmd\n")
        self.assertIn("Design Name: sub", self.read("out/rtl/sub.v"))
        for name in ("sub", "top"):
            self.expect(self.run_tool("run", f"out/rtl/{name}.cmd", "--verilog", "r.v", "--vhdl",
                                      "r.vhd", "--no-header"), SUCCESS)
            written = self.read(f"out/rtl/{name}.vhd")
            self.assertTrue(written.endswith(self.read("r.vhd")))
            self.assertTrue(self.read(f"out/rtl/{name}.v").endswith(self.read("r.v")))

    def test_folder_of_command_files(self) -> None:
        self.expect(self.run_tool("import", "d.json", "-o", "cmd/"), SUCCESS)
        self.assertEqual(self.read("cmd/commands.txt"), "cmd/sub.cmd\ncmd/top.cmd\n")
        self.assertIn("SET NETLIST NAME sub\n", self.read("cmd/sub.cmd"))
        (self.folder / "there").mkdir()
        self.expect(self.run_tool("import", "d.json", "-o", "there"), SUCCESS)
        self.assertEqual(self.read("there/commands.txt"), "there/sub.cmd\nthere/top.cmd\n")

    def test_folders_of_netlists_in_the_languages(self) -> None:
        self.write("m.v", "module m(input a, output y); INV u(.I(a), .O(y)); endmodule\n")
        self.expect(self.run_tool("import", "m.v", "--output-dir", "out", "--vhdl", "-", "-o",
                                  "c.list"), SUCCESS, "", "out/m.vhd\n")
        self.assertEqual(self.read("c.list"), "out/m.cmd\n")
        self.expect(self.run_tool("import", "m.v", "-o", "cmd/"), SUCCESS)
        self.assertEqual(self.read("cmd/commands.txt"), "cmd/m.cmd\n")
        self.assertIn("SET NETLIST NAME m\n", self.read("cmd/m.cmd"))

    def test_one_command_file_holds_one_module(self) -> None:
        self.refuse(self.contents, "the design has 2 modules, and a command file holds one: -o DIR/ "
                                   "writes one file a module")
        self.expect(self.run_tool("import", "d.json", "-o", "x.cmd", "--module", "sub"), SUCCESS)

    def test_folder_that_cannot_be(self) -> None:
        self.write("taken", "")
        outcome = self.run_tool("import", "d.json", "--output-dir", "taken", "--vhdl", "d.list")
        self.assertEqual(outcome.status, 3)
        self.assertTrue(outcome.err.startswith("orn-hdl: cannot write taken: "), outcome.err)
        self.assertFalse((self.folder / "d.list").exists())

    def test_names_that_no_file_can_have(self) -> None:
        self.write("d.json", json.dumps(design(
            {"a": port("input", 2)}, {"u": cell("a/b", "io", I=[2], O=[3]),
                                      "w": cell("a.b", "io", I=[2], O=[4])},
            **{"a/b": inverter(), "a.b": inverter()})))
        outcome = self.run_tool("import", "d.json", "--output-dir", "out", "--verilog", "d.list")
        self.assertEqual(outcome.status, SUCCESS, outcome.err)
        self.assertEqual(self.read("d.list"), "out/a_b.v\nout/a_b_1.v\nout/top.v\n")

    def test_proof(self) -> None:
        plain, proven = (self.run_tool("import", "d.json", "--vhdl", "-", *more)
                         for more in ((), ("--verify",)))
        self.expect(proven, SUCCESS, "", plain.out)
        self.import_both(None, "--verify", "--no-header")
        self.judge_both()


class Clauses(HierarchyTest):
    def setUp(self) -> None:
        super().setUp()
        self.write("d.json", json.dumps(design(
            {"a": port("input", 2), "y": port("output", 4)},
            {"u": cell("sub", "io", I=[2], O=[3]), "v": cell("INV", "io", I=[3], O=[4])},
            sub=inverter())))

    def test_configurations(self) -> None:
        _, vhdl = self.import_both(None, "--configuration", "work", "--verify")
        self.assertEqual(re.findall(r"configuration (CFG_\w+) of", vhdl), ["CFG_sub", "CFG_top"])
        self.assertEqual(re.findall(r"use configuration (\S+);", vhdl), ["WORK.CFG_sub"])
        self.judge_both()
        self.judge(["ghdl", "-e", "--std=93c", "--workdir=ghdl93c", "-Pghdl93c", "CFG_top"])
        self.expect(self.run_tool("import", "d.json", "-o", "cmd/", "--configuration", "work"),
                    SUCCESS)
        self.expect(self.run_tool("run", "cmd/top.cmd", "--vhdl", "r.vhd", "--no-header"), SUCCESS)
        self.assertTrue(vhdl.endswith(self.read("r.vhd")))
        self.assertNotIn("CFG_", self.import_both(None, "--configuration", "none")[1])

    def test_configurations_that_cannot_be(self) -> None:
        self.refuse(design({"a": port("input", 2)}, {"u": cell("CFG_top", "io", I=[2], O=[3])},
                           CFG_top=inverter()),
                    "modules.top: another module has the name of its configuration, \"CFG_top\"",
                    "--configuration", "work")
        self.refuse(design({"a": port("input", 2)},
                           {"u": cell("BOX", "i", parameters={"Level": "1"}, I=[2])}),
                    "modules.top.cells.u.parameters: a configuration needs the name LEVEL, which "
                    "is that of a parameter", "--configuration", "work")

    def test_ieee_alone(self) -> None:
        _, vhdl = self.import_both(None, "--no-kestra", "--verify")
        self.assertNotIn("KESTRA", vhdl)
        self.assertEqual(vhdl.count("use ieee.std_logic_1164.ALL;"), 2)
        self.judge_both()
        self.expect(self.run_tool("import", "d.json", "-o", "cmd/", "--no-kestra"), SUCCESS)
        self.expect(self.run_tool("run", "cmd/top.cmd", "--vhdl", "r.vhd", "--no-header"), SUCCESS)
        self.assertTrue(vhdl.endswith(self.read("r.vhd")))

    def test_netlists_in_the_languages(self) -> None:
        self.write("d.v", "module m(input a); endmodule")
        for option in (("--configuration", "work"), ("--no-kestra",)):
            self.expect(self.run_tool("import", "d.v", *option), USAGE,
                        f"orn-hdl: {option[0]} applies to JSON netlists alone; see --help\n")


@unittest.skipIf(shutil.which("yosys") is None, "yosys is not installed")
class Designs(HierarchyTest):
    """Designs that Yosys has read, before and after synthesis; it proves the netlists equal."""

    def check_design(self, source: str, top: str, commands: str, *options: str,
                     proof: str = "-tempinduct -seq 1") -> None:
        self.write("rtl.v", source)
        self.yosys(f"read_verilog rtl.v; hierarchy -check -top {top}; {commands}; "
                   "write_json d.json")
        verilog, vhdl = self.import_both(None, *options, message=None)
        self.assertEqual(len(self.entities_of(vhdl)), len(self.modules_of(verilog)))
        self.write("bodies.v", self.make_bodies())
        self.yosys(
            f"read_verilog rtl.v; hierarchy -check -top {top}; proc; opt_clean; flatten; "
            f"memory; opt_clean; rename {top} gold; design -stash gold; "
            f"read_verilog d.v; read_verilog -icells bodies.v; hierarchy -check -top {top}; "
            f"flatten; opt_clean; memory_map; opt_clean; rename {top} gate; design -stash gate; "
            "design -copy-from gold gold; design -copy-from gate gate; "
            "miter -equiv -flatten -make_assert gold gate m; hierarchy -top m; "
            f"sat -verify -prove-asserts -set-init-zero {proof} m")
        self.analyse()

    def make_bodies(self) -> str:
        """A module for each leaf component, which is the cell of Yosys with its parameters."""
        lines = [line.split("\t") for line in self.read("x.map").splitlines()]
        modules = json.loads(self.read("d.json"))["modules"]
        cells = {c["type"]: c for m in modules.values() for c in m["cells"].values()
                 if c["type"] not in modules}
        parts: dict[tuple[str, str], tuple[dict[str, str], set[str]]] = {}
        for kind, old, new in lines:
            if kind == "component" and old in cells:
                parts[new, old] = ({}, set())
            elif kind in ("pin", "parameter") and old.rpartition(".")[0] in cells:
                component, _, name = new.rpartition(".")
                pins, parameters = parts[component, old.rpartition(".")[0]]
                if kind == "parameter":
                    parameters.add(name)
                else:
                    base, _, index = name.rstrip(")").partition("(")
                    pins[base] = f"[{index}] " if index else ""
        return "".join(self.make_body(new, cells[old], *parts[new, old]) for new, old in parts)

    @staticmethod
    def make_body(name: str, example: Json, pins: dict[str, str], parameters: set[str]) -> str:
        """\param pins their ranges."""
        ports = ", ".join(f"{example['port_directions'][pin]} {index}{pin}"
                          for pin, index in pins.items())
        wired = ", ".join(f".{pin}({pin})" for pin in pins)
        # The name of a memory is an escaped text, which became bits.
        told = sorted(parameters - {"MEMID"})
        declared = "".join(f"parameter {parameter} = 0; " for parameter in sorted(parameters))
        values = ", ".join([f".{parameter}({parameter})" for parameter in told] +
                           [r'.MEMID("\\words")'] * ("MEMID" in parameters))
        given = f" #({values})" if told else ""
        return f"module {name}({ports}); {declared}\\{example['type']}{given} g({wired}); endmodule\n"

    def analyse(self) -> None:
        if shutil.which("ghdl") is None:
            self.skipTest("ghdl is not installed")
        folder = self.folder / "ghdl"
        folder.mkdir()
        flags = ["--std=93", f"--workdir={folder}", f"-P{folder}"]
        package = EXAMPLES / "cells" / "kestra_vcomponents.vhd"
        self.judge(["ghdl", "-a", *flags, "--work=KESTRA", str(package)])
        self.judge(["ghdl", "-a", *flags, "d.vhd"])

    def yosys(self, script: str) -> None:
        done = subprocess.run(["yosys", "-q", "-p", script], cwd=self.folder, text=True,
                              capture_output=True, timeout=120, check=False)
        self.assertEqual(done.returncode, 0, done.stdout[-2000:] + done.stderr)

    def test_counters(self) -> None:
        self.check_design(COUNTERS, "counters", "proc; opt; synth; opt_clean")
        self.assertEqual(self.entities_of(self.read("d.vhd")),
                         ["step_WIDTH_8_BY_2", "counter_BY_2_WIDTH_8", "step_WIDTH_4_BY_1",
                          "counter", "step_WIDTH_7_BY_3", "counter_BY_3_WIDTH_7", "counters"])

    def test_pipe(self) -> None:
        self.check_design(PIPE, "pipe", "synth")
        self.assertEqual(self.entities_of(self.read("d.vhd"))[:2], ["half", "full"])

    def test_memory(self) -> None:
        """The contents come over as a parameter of a cell without a definition."""
        self.check_design(MEMORY, "memory", "proc; opt; memory -nomap", "--x-as", "0",
                          proof="-seq 4")
        contents = "".join(f"{3 * word + 1:08b}" for word in reversed(range(8)))
        self.assertRegex(self.read("d.vhd"), rf'INIT => *\s+b"{contents}"')
        self.assertRegex(self.read("d.v"), rf"INIT = *\s+64'b{contents};")

    def test_pads_and_records(self) -> None:
        self.check_design(WORDS, "words", "proc; opt_clean")


if __name__ == "__main__":
    unittest.main()
