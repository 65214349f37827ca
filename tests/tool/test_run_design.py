"""orn-hdl run with several command files: the models of a design."""

from __future__ import annotations

import json
import re
import shutil
import subprocess
import unittest

from support import EXAMPLES, FAILED, FILE, INVERTER, SUCCESS, USAGE, ToolTest

HALF = """\
SET NETLIST NAME half
ADD COMPONENT INV
ADD PIN INV I input
ADD PIN INV O output
ADD PORT A(1:0) input
ADD PORT Y(1:0) output
ADD INSTANCE INV U0
ADD INSTANCE INV U1
CONNECT SIGNAL A(0) U0.I
CONNECT SIGNAL A(1) U1.I
CONNECT SIGNAL Y(0) U0.O
CONNECT SIGNAL Y(1) U1.O
SUPPRESS CONFIGURATION TRUE
"""
WHOLE = """\
ADD COMPONENT half
ADD PIN half A(1:0) input
ADD PIN half Y(1:0) output
ADD PORT D(1:0) input
ADD PORT Q(1:0) output
ADD INSTANCE half first
ADD INSTANCE half second
CONNECT SIGNAL D(1:0) first.A(1:0)
CONNECT SIGNAL M(1:0) first.Y(1:0)
CONNECT SIGNAL M(1:0) second.A(1:0)
CONNECT SIGNAL Q(1:0) second.Y(1:0)
SUPPRESS CONFIGURATION TRUE
"""


class RunDesignTest(ToolTest):
    def setUp(self) -> None:
        super().setUp()
        self.write("half.cmd", HALF)
        self.write("whole.cmd", WHOLE)

    def judge(self, *command: str) -> None:
        done = subprocess.run(command, cwd=self.folder, text=True, capture_output=True, timeout=60,
                              check=False)
        self.assertEqual((done.returncode, done.stdout + done.stderr), (0, ""), " ".join(command))

    def judge_both(self, top: str = "whole") -> None:
        self.write("leaves.v", "module INV(input I, output O); endmodule\n")
        if shutil.which("iverilog") is None or shutil.which("ghdl") is None:
            self.skipTest("a judge is not installed")
        self.judge("iverilog", "-g2005", "-Wall", "-Wno-timescale", "-tnull", "-s", top, "d.v",
                   "leaves.v")
        package = str(EXAMPLES / "cells" / "kestra_vcomponents.vhd")
        for edition in ("93c", "08"):
            folder = self.folder / f"ghdl{edition}"
            folder.mkdir(exist_ok=True)
            flags = [f"--std={edition}", f"--workdir={folder}", f"-P{folder}"]
            self.judge("ghdl", "-a", *flags, "--work=KESTRA", package)
            self.judge("ghdl", "-a", *flags, "d.vhd")


class Files(RunDesignTest):
    def test_all_models_in_one_file(self) -> None:
        self.expect(self.run_tool("run", "half.cmd", "whole.cmd", "--verilog", "d.v", "--vhdl",
                                  "d.vhd", "--verify"), SUCCESS)
        for file, word in (("d.v", "module"), ("d.vhd", "entity")):
            text = self.read(file)
            self.assertEqual(re.findall(rf"^{word} (\w+)", text, re.M), ["half", "whole"])
            self.assertEqual(re.findall(r"Design Name: (.*)", text), ["whole"])
            self.assertEqual(text.count("Vendor: "), 1)
            self.assertIn(f"Filename : {file}\n", text)
        self.judge_both()

    def test_each_model_is_what_its_file_alone_gives(self) -> None:
        for language in ("verilog", "vhdl"):
            out = {}
            for files in (("half.cmd",), ("whole.cmd",), ("half.cmd", "whole.cmd")):
                outcome = self.run_tool("run", *files, f"--{language}", "-", "--no-header")
                self.expect(outcome, SUCCESS, "", outcome.out)
                out[files] = outcome.out
            between = "\n" if language == "verilog" else ""
            self.assertEqual(out["half.cmd", "whole.cmd"],
                             out["half.cmd",] + between + out["whole.cmd",])

    def test_order_is_that_of_the_files(self) -> None:
        outcome = self.run_tool("run", "whole.cmd", "half.cmd", "--verilog", "-", "--no-header")
        self.assertEqual(re.findall(r"^module (\w+)", outcome.out, re.M), ["whole", "half"])

    def test_import_and_run(self) -> None:
        """The scripts of a design with hierarchy give the netlists that the import writes."""
        inverter = {"hide_name": 0, "type": "INV", "port_directions": {"I": "input", "O": "output"},
                    "connections": {"I": [2], "O": [3]}}
        ports = {"I": {"direction": "input", "bits": [2]}, "O": {"direction": "output", "bits": [3]}}
        modules = {"low": {"ports": ports, "cells": {"u": inverter}},
                   "top": {"ports": ports, "cells": {"u": {**inverter, "type": "low"}}}}
        self.write("d.json", json.dumps({"modules": modules}))
        self.expect(self.run_tool("import", "d.json", "-o", "cmd/", "--verilog", "i.v", "--vhdl",
                                  "i.vhd", "--no-header"), SUCCESS)
        files = self.read("cmd/commands.txt").split()
        self.expect(self.run_tool("run", *files, "--verilog", "d.v", "--vhdl", "d.vhd",
                                  "--no-header"), SUCCESS)
        self.assertEqual(self.read("d.v"), self.read("i.v"))
        self.assertEqual(self.read("d.vhd"), self.read("i.vhd"))
        self.judge_both("top")

    def test_standard_input(self) -> None:
        outcome = self.run_tool("run", "-", "whole.cmd", "--verilog", "-", "--no-header",
                                stdin=HALF)
        self.assertEqual((outcome.status, outcome.err), (SUCCESS, ""))
        self.expect(self.run_tool("run", "-", "-"), USAGE,
                    "orn-hdl: standard input can be read once\n")

    def test_a_file_that_fails(self) -> None:
        self.write("half.cmd", "ADD\n")
        outcome = self.run_tool("run", "half.cmd", "whole.cmd", "--verilog", "d.v")
        self.assertEqual(outcome.status, FAILED)
        self.assertTrue(outcome.err.startswith("half.cmd:1: error: "), outcome.err)
        self.assertFalse((self.folder / "d.v").exists())
        outcome = self.run_tool("run", "missing.cmd", "whole.cmd", "--verilog", "d.v")
        self.assertEqual(outcome.status, FILE)

    def test_messages_of_all_files_are_one_document(self) -> None:
        self.write("half.cmd", "ADD\n" + HALF)
        self.write("whole.cmd", "ADD\n" + WHOLE)
        outcome = self.run_tool("run", "half.cmd", "whole.cmd", "--keep-going", "--diagnostics",
                                "json")
        found = json.loads(outcome.err)["diagnostics"]
        self.assertEqual([d["file"] for d in found], ["half.cmd", "whole.cmd"])

    def test_options_of_a_single_file(self) -> None:
        for option in ("--model", "--output-commands"):
            self.expect(self.run_tool("run", "half.cmd", "whole.cmd", option, "x"), USAGE,
                        f"orn-hdl: {option} is for one command file; see --help\n")
        self.expect(self.run_tool("run", "half.cmd", "whole.cmd", "--verify", "--certificate", "x"),
                    USAGE, "orn-hdl: --certificate is for one command file; see --help\n")

    def test_check(self) -> None:
        self.write("half.cmd", HALF.replace("half", "signal"))
        self.write("whole.cmd", WHOLE.replace("half", "signal"))
        outcome = self.run_tool("run", "half.cmd", "whole.cmd", "--check", "--verilog", "d.v",
                                "--vhdl", "d.vhd")
        self.assertEqual(outcome.status, FAILED)
        self.assertTrue((self.folder / "d.v").exists())
        self.assertFalse((self.folder / "d.vhd").exists())


class Components(RunDesignTest):
    def refuse(self, old: str, new: str, *lines: str) -> None:
        """Expects the run to fail for a change of the design that uses the other."""
        self.write("whole.cmd", WHOLE.replace(old, new))
        outcome = self.run_tool("run", "half.cmd", "whole.cmd", "--verilog", "d.v")
        self.assertEqual(outcome.status, FAILED)
        self.assertEqual([line for line in outcome.err.splitlines() if ".cmd" in line],
                         list(lines))
        self.assertFalse((self.folder / "d.v").exists())

    def test_direction(self) -> None:
        self.write("half.cmd", HALF)
        self.write("whole.cmd", WHOLE.replace("half A(1:0) input", "half A(1:0) output"))
        self.expect(self.run_tool("run", "half.cmd", "whole.cmd"), FAILED, """\
whole.cmd:2: error: the pin "A(1:0)" of the component "half" is Output, but the port is Input
    2 | ADD PIN half A(1:0) output
      |              ^~~~~~
half.cmd:5: note: the port of "half"
    5 | ADD PORT A(1:0) input
      |          ^~~~~~
""")

    def test_width(self) -> None:
        self.refuse(WHOLE, "ADD COMPONENT half\nADD PIN half A(2:0) input\nADD PIN half Y(1:0) output\n",
                    'whole.cmd:2: error: the pin "A(2:0)" of the component "half" is 3 bits wide, '
                    "but the port has 2 bits", 'half.cmd:5: note: the port of "half"')

    def test_scalar_and_bus(self) -> None:
        self.write("half.cmd", INVERTER + "SET NETLIST NAME half\n")
        self.write("whole.cmd", "ADD COMPONENT half\nADD PIN half A(0:0) input\n"
                                "ADD PIN half Y output\nADD INSTANCE half u\n")
        outcome = self.run_tool("run", "half.cmd", "whole.cmd")
        self.assertEqual(outcome.status, FAILED)
        self.assertIn('"A(0:0)" of the component "half" is a bus, but the port is a scalar',
                      outcome.err)

    def test_pin_that_is_no_port(self) -> None:
        self.refuse("ADD PORT D", "ADD PIN half Z input\nADD PORT D",
                    'whole.cmd:4: error: the pin "Z" is no port of the design "half"',
                    'note: the design "half" comes from half.cmd')

    def test_port_without_a_pin(self) -> None:
        self.write("half.cmd", HALF + "ADD PORT Z input\n")
        self.refuse("", "", 'whole.cmd:1: error: the component "half" has no pin for the port "Z"',
                    'half.cmd:14: note: the port of "half"')

    def test_two_designs_of_one_name(self) -> None:
        self.write("other.cmd", HALF.replace("NAME half", "NAME HALF"))
        self.expect(self.run_tool("run", "half.cmd", "other.cmd"), FAILED,
                    'other.cmd: error: the design has the name "HALF", as that of half.cmd has\n')

    def test_recursion(self) -> None:
        self.write("half.cmd", HALF + "ADD COMPONENT whole\nADD PIN whole D(1:0) input\n"
                                      "ADD PIN whole Q(1:0) output\nADD INSTANCE whole again\n")
        self.expect(self.run_tool("run", "half.cmd", "whole.cmd"), FAILED,
                    'half.cmd: error: the design contains itself: "half" > "whole" > "half"\n')


class Legal(RunDesignTest):
    def test_names_agree(self) -> None:
        """Ports and models that get other names get them in every instance."""
        names = {"half": "signal", "A(1:0)": "in(1:0)", "Y(1:0)": "_out(1:0)"}
        for file, text in (("half.cmd", HALF), ("whole.cmd", WHOLE)):
            for old, new in names.items():
                text = text.replace(old, new)
            self.write(file, text.replace("A(", "in(").replace("Y(", "_out("))
        for files in (("half.cmd", "whole.cmd"), ("whole.cmd", "half.cmd")):
            outcome = self.run_tool("run", *files, "--legal", "--verify", "--name-map", "n.map",
                                    "--no-warn", "all", "--verilog", "d.v", "--vhdl", "d.vhd")
            self.assertEqual((outcome.status, outcome.err), (SUCCESS, ""))
            vhdl = self.read("d.vhd")
            self.assertEqual(len(re.findall(r"\bout_1\(1 downto 0\)=>", vhdl)), 2)
            self.assertEqual(len(re.findall(r"^ +(?:first|second) : signal_1$", vhdl, re.M)), 2)
            self.assertIn("module\tsignal\tsignal_1\n", self.read("n.map"))
            if files[0] == "half.cmd":
                self.judge_both()

    def test_port_named_like_a_component(self) -> None:
        """In VHDL the component and the port stand in one region, and the port gives way."""
        self.write("half.cmd", HALF.replace("A(", "INV("))
        self.write("whole.cmd", WHOLE.replace("A(", "INV("))
        self.expect(self.run_tool("run", "half.cmd", "whole.cmd", "--legal", "--verilog", "d.v",
                                  "--vhdl", "d.vhd"), SUCCESS)
        self.assertEqual(self.read("d.vhd").count("INV_1(1 downto 0)=>"), 2)
        self.judge_both()

    def test_two_models_that_would_share_a_name(self) -> None:
        self.write("half.cmd", HALF.replace("half", "a$b"))
        self.write("other.cmd", HALF.replace("half", "a%b"))
        self.write("whole.cmd", WHOLE.replace("half first", "a$b first")
                   .replace("half", "a$b"))
        self.expect(self.run_tool("run", "half.cmd", "other.cmd", "whole.cmd", "--legal",
                                  "--verilog", "d.v", "--vhdl", "d.vhd"), SUCCESS)
        self.assertEqual(re.findall(r"^entity (\w+)", self.read("d.vhd"), re.M),
                         ["a_b", "a_b_1", "whole"])
        self.judge_both()


if __name__ == "__main__":
    unittest.main()
