"""orn-hdl import --x-as -: don't cares from a JSON netlist to both languages and back."""

from __future__ import annotations

import json
import re
import shutil
import subprocess
import unittest

from support import FAILED, SUCCESS, USAGE
from yosys_json import ImportTest, Json, cell, design, port

# y(2) is a don't care, y(1) is 1, y(0) comes from a.
DESIGN = design({"a": port("input", 2), "y": port("output", 2, "1", "x"), "q": port("output", 3)},
                {"u": cell("LEAF", "iio", I=["x", "0", "x"], J=[2, "x"], Q=[3]),
                 "v": cell("ONE", "i", I=["x"])})
# What verify ends with for a netlist that is not the design's.
DIFFERENT = 4
NOTE = "NOOP Write netlists with --dont-cares: the digit - of constants says so."

# Prints each bit of y, and ends.
BENCH = """\
library ieee; use ieee.std_logic_1164.all; use std.textio.all;
entity bench is end;
architecture b of bench is
   signal y : std_logic_vector(2 downto 0);
begin
   d : entity work.top port map (a => '1', q => open, y => y);
   process
      variable text : line;
   begin
      wait for 1 ns;
      for i in y'range loop
         write(text, std_logic'image(y(i)));
      end loop;
      writeline(output, text);
      wait;
   end process;
end;
"""


class DontCares(ImportTest):
    def test_all_forms(self) -> None:
        """The forms agree, and Icarus and GHDL take them."""
        done = self.import_design(DESIGN, "--x-as", "-")
        self.assertEqual(done.commands[0], NOTE)
        self.assertEqual(done.lines("ASSIGN CONSTANT"), ["const_x -", "y(2:1) 2:B:-1",
                                                         "u.I(2:0) 3:B:-0-", "v.I -"])
        self.assertEqual(done.lines("CONNECT SIGNAL")[1], "const_x,a u.J(1:0)")
        self.assertEqual(done.warnings, ["d.json: warning: modules.top.ports.y.bits[2]: the value x "
                                         "becomes - (and 4 more places)"])
        for line in ("const_x = 1'bx;", "u_I_CONST_SIGNAL = 3'bx0x;", "v_I_CONST_SIGNAL = 1'bx;",
                     "y[2:1] = 2'bx1;"):
            self.assertIn("assign " + line, done.verilog)
        for line in ("const_x <= '-';", 'u_I_CONST_SIGNAL(2 downto 0) <= "-0-";',
                     "v_I_CONST_SIGNAL <= '-';", 'y(2 downto 1) <= "-1";'):
            self.assertIn(line, done.vhdl)

    def test_design_without_any_needs_no_option(self) -> None:
        done = self.import_design(design({"a": port("input", 2), "y": port("output", 2)}),
                                  "--x-as", "-")
        self.assertNotIn(NOTE, done.commands)
        self.assertEqual(done.warnings, [])

    def test_yosys_reads_x(self) -> None:
        if shutil.which("yosys") is None:
            self.skipTest("yosys is not installed")
        self.import_design(DESIGN, "--x-as", "-")
        subprocess.run(["yosys", "-q", "-p", "read_verilog x.verilog cells.v; write_json x.json"],
                       cwd=self.folder, check=True)
        top = json.loads(self.read("x.json"))["modules"]["top"]
        self.assertEqual(top["ports"]["y"]["bits"][1:], ["1", "x"])
        self.assertEqual(self.drivers(top, top["cells"]["u"]["connections"]["I"]), ["x", "0", "x"])

    @staticmethod
    def drivers(module: Json, bits: list[int | str]) -> list[int | str]:
        return [bit if isinstance(bit, str) else "net" for bit in bits]

    def test_ghdl_simulates_dont_cares(self) -> None:
        if shutil.which("ghdl") is None:
            self.skipTest("ghdl is not installed")
        self.import_design(DESIGN, "--x-as", "-")
        self.write("bench.vhd", BENCH)
        flags = ["--std=93", "--workdir=ghdl93", "-Pghdl93"]
        for command in (["-a", *flags, "bench.vhd"], ["-e", *flags, "bench"]):
            subprocess.run(["ghdl", *command], cwd=self.folder, check=True, capture_output=True)
        ran = subprocess.run(["ghdl", "-r", *flags, "bench"], cwd=self.folder, check=True,
                             capture_output=True, text=True)
        self.assertEqual(ran.stdout, "'-''1''1'\n")

    def test_inout_that_is_open_stays_open(self) -> None:
        done = self.import_design(design({"p": port("inout", "z"), "y": port("output", "z")}),
                                  "--x-as", "-")
        self.assertEqual(done.lines("ASSIGN CONSTANT"), ["y -"])
        done = self.import_design(design({"p": port("inout", "z", "1", "z")}), "--x-as", "0")
        self.assertEqual(done.lines("ASSIGN CONSTANT"), ["p(1) 1"])

    def test_parameters_have_none(self) -> None:
        """There is no literal for one: a parameter of which any value will do becomes 0."""
        done = self.import_design(
            design({}, {"u": cell("LEAF", "i", I=[2], parameters={"P": "1x", "Q": "z1"})}),
            "--x-as", "-")
        self.assertEqual([line.split()[2:] for line in done.lines("ADD INSTANCE ATTRIBUTE")],
                         [["P", "2:B:10"], ["Q", "2:B:01"]])
        self.assertEqual(len(done.warnings), 1)
        self.assertIn("x means any value in a parameter", done.warnings[0])

    def test_check_run_verify_and_diff(self) -> None:
        done = self.import_design(DESIGN, "--x-as", "-")
        self.write("x.v", done.verilog)
        for options, checked, verified in (([], FAILED, DIFFERENT), (["--dont-cares"], SUCCESS, SUCCESS)):
            self.assertEqual(self.run_tool("check", "x.cmd", *options).status, checked)
            compared = self.run_tool("verify", "x.v", "--commands", "x.cmd", *options)
            self.assertEqual(compared.status, verified, compared.err)
        self.expect(self.run_tool("run", "x.cmd", "--dont-cares", "--verify", "--verilog", "y.v",
                                  "--vhdl", "y.vhd"), SUCCESS)
        self.expect(self.run_tool("run", "x.cmd", "--dont-cares", "--legal", "--verify", "--verilog",
                                  "y.v", "--vhdl", "y.vhd"), SUCCESS)
        for other in ("x.cmd", "y.vhd", "d.json"):
            self.expect(self.run_tool("diff", "y.v", other, "-l", "cells.v", "--ignore", "order"), SUCCESS,
                        out="no differences\n")
        self.write("z.v", done.verilog.replace("3'bx0x", "3'bx00"))
        self.assertEqual(self.run_tool("diff", "y.v", "z.v", "-l", "cells.v").status, FAILED)

    def test_netlists_of_the_languages(self) -> None:
        self.import_design(DESIGN, "--x-as", "-")
        for language in ("verilog", "vhdl"):
            read = self.run_tool("import", f"x.{language}", "--from", language, "--x-as", "-", "-l",
                                 "cells.v", "--no-header", "-o", "y.cmd", "--verilog", "y.v")
            self.expect(read, SUCCESS)
            self.assertEqual(self.read("y.cmd").splitlines()[0], NOTE)
            self.assertEqual(sorted(re.findall("assign .*", self.read("y.v").replace("L_2", "L"))),
                             sorted(re.findall("assign .*", self.read("x.verilog"))))
            self.assertEqual(self.run_tool("import", f"x.{language}", "--from", language, "-l",
                                           "cells.v").status, FAILED)

    def test_without_the_option_a_run_warns(self) -> None:
        self.import_design(DESIGN, "--x-as", "-")
        said = self.run_tool("run", "x.cmd").err
        self.assertIn("constant-digit", said)
        self.assertIn("note: what helps: --dont-cares, if a digit - is a don't care", said)
        self.expect(self.run_tool("run", "x.cmd", "--dont-cares"), SUCCESS)

    def test_other_values_are_refused(self) -> None:
        self.expect(self.run_tool("import", "d.json", "--x-as", "z"), USAGE,
                    "orn-hdl: --x-as: 0, 1 or - is needed; see --help\n")


if __name__ == "__main__":
    unittest.main()
