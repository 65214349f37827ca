"""orn-hdl import --initial-values: registers begin as the RTL says, in simulation."""

from __future__ import annotations

import json
import shutil
import subprocess
import unittest

from support import SUCCESS, USAGE
from yosys_json import ImportTest, Json, cell, design, net, port

# A counter without a reset, a register of which one bit is not known at first, and a latch.
RTL = """\
module top(input clk, input en, output reg [3:0] q, output reg [2:0] p, output t, output reg l);
   reg f = 1;
   initial begin q = 4'd5; p = 3'b1x0; l = 1; end
   assign t = f;
   always @(posedge clk) begin
      q <= q + 3;
      f <= ~f;
      if (en) p <= {p[1:0], f};
   end
   always @* if (en) l = q[1];
endmodule
"""

VERILOG_BENCH = """\
module bench;
   reg clk = 0, en = 0;
   wire [3:0] q;
   wire [2:0] p;
   wire t, l;
   integer i;
   top d(clk, en, q, p, t, l);
   initial begin
      for (i = 0; i < 20; i = i + 1) begin
         #1 $display("%b%b%b%b", q, p, t, l);
         clk = 1;
         #1 clk = 0;
         if (i == 3) en = 1;
      end
      $finish;
   end
endmodule
"""

VHDL_BENCH = """\
library ieee;
use ieee.std_logic_1164.all;
use std.textio.all;

entity bench is
end;

architecture test of bench is
   signal clk, en : std_logic := '0';
   signal q : std_logic_vector(3 downto 0);
   signal p : std_logic_vector(2 downto 0);
   signal t, l : std_logic;
   constant letters : string(1 to 9) := "xx01zx01x";
begin
   d : entity work.top port map (clk => clk, en => en, q => q, p => p, t => t, l => l);
   process
      variable text : line;
      variable shown : std_logic_vector(8 downto 0);
   begin
      for step in 0 to 19 loop
         wait for 1 ns;
         shown := q & p & t & l;
         for i in shown'range loop
            write(text, letters(std_logic'pos(shown(i)) + 1));
         end loop;
         writeline(output, text);
         clk <= '1';
         wait for 1 ns;
         clk <= '0';
         if step = 3 then
            en <= '1';
         end if;
      end loop;
      wait;
   end process;
end;
"""


class FirstValues(ImportTest):
    def import_vhdl(self, contents: Json, *options: str) -> tuple[str, str]:
        """The VHDL netlist and the messages."""
        (self.folder / "d.json").write_text(json.dumps(contents), encoding="utf-8")
        outcome = self.run_tool("import", "d.json", "--vhdl", "top.vhd", "--write-cells", "cells.vhd",
                                "--no-header", "--no-kestra", "--verify", *options)
        self.assertEqual(outcome.status, SUCCESS, outcome.err)
        return self.read("top.vhd"), outcome.err

    def run_program(self, *words: str) -> str:
        done = subprocess.run(words, cwd=self.folder, capture_output=True, text=True, timeout=120, check=False)
        self.assertEqual(done.returncode, 0, done.stdout + done.stderr)
        return done.stdout

    def simulate_vhdl(self) -> str:
        flags = ["--std=93", "--syn-binding"]
        self.run_program("ghdl", "-a", *flags, "cells.vhd", "top.vhd", "bench.vhd")
        self.run_program("ghdl", "-e", *flags, "bench")
        return self.run_program("ghdl", "-r", *flags, "bench")

    def test_trace_is_that_of_the_rtl(self) -> None:
        for program in ("yosys", "iverilog", "ghdl"):
            if shutil.which(program) is None:
                self.skipTest(f"{program} is not installed")
        self.write("top.v", RTL)
        self.write("bench.v", VERILOG_BENCH)
        self.write("bench.vhd", VHDL_BENCH)
        self.run_program("iverilog", "-g2005", "-o", "bench.vvp", "top.v", "bench.v")
        wanted = self.run_program("vvp", "-n", "bench.vvp")
        self.assertEqual(wanted.splitlines()[0], "01011x011")
        for flow in ("proc; opt", "synth -noabc"):
            self.run_program("yosys", "-q", "-p", f"read_verilog top.v; {flow}; write_json d.json")
            contents = json.loads(self.read("d.json"))
            _, messages = self.import_vhdl(contents, "--initial-values")
            self.assertNotIn("first values", messages)
            self.assertEqual(self.simulate_vhdl(), wanted, flow)
            # Without the option, the counter never leaves the unknown state.
            netlist, messages = self.import_vhdl(contents)
            self.assertIn("the first values of registers are not imported", messages)
            self.assertNotIn("INIT", netlist)
            self.assertEqual({line[:4] for line in self.simulate_vhdl().splitlines()}, {"xxxx"})

    def flip_flops(self, **inits: str) -> Json:
        """Flip-flops whose outputs are nets with the names and first values given."""
        cells, nets, ports = {}, {}, {"c": port("input", 2)}
        for bit, (name, value) in enumerate(inits.items(), 3):
            cells["u" + name] = cell("$_DFF_P_", "iio", D=[2], C=[2], Q=[bit])
            ports[name] = port("output", bit)
            nets[name] = net(bit)
            if value:
                nets[name]["attributes"] = {"init": value}
        return design(ports, cells, nets)

    def test_all_registers_of_a_type_tell(self) -> None:
        netlist, _ = self.import_vhdl(self.flip_flops(q="1", r="0", s="", t="x"), "--initial-values")
        self.assertEqual([line.split('"')[1] for line in netlist.splitlines() if "INIT =>" in line],
                         ["1", "0", "U", "U"])

    def test_types_without_first_values_stay(self) -> None:
        netlist, _ = self.import_vhdl(self.flip_flops(q="x", r=""), "--initial-values")
        self.assertNotIn("INIT", netlist)

    def test_net_that_no_register_drives(self) -> None:
        contents = self.flip_flops(q="1")
        contents["modules"]["top"]["ports"]["y"] = port("output", 9)
        contents["modules"]["top"]["cells"]["v"] = cell("LEAF", "o", Q=[9])
        contents["modules"]["top"]["netnames"]["y"] = {**net(9), "attributes": {"init": "1"}}
        _, messages = self.import_vhdl(contents, "--initial-values")
        self.assertIn("netnames.y.attributes.init: the first values of registers are not imported", messages)
        self.assertNotIn("netnames.q", messages)

    def test_values_of_a_bus_by_bits(self) -> None:
        """A net gives each register the digits of its bits, the rightmost bit first; missing ones are unknown."""
        contents = self.flip_flops(q="", r="", s="")
        contents["modules"]["top"]["netnames"]["bus"] = {**net(3, 4, 5), "attributes": {"init": "01"}}
        netlist, _ = self.import_vhdl(contents, "--initial-values")
        self.assertEqual([line.split('"')[1] for line in netlist.splitlines() if "INIT =>" in line],
                         ["1", "0", "U"])

    def test_not_for_verilog(self) -> None:
        (self.folder / "d.json").write_text(json.dumps(self.flip_flops(q="1")), encoding="utf-8")
        self.expect(self.run_tool("import", "d.json", "--initial-values", "--verilog", "x.v"), USAGE,
                    "orn-hdl: --initial-values is for VHDL: the registers of Yosys have no such parameter\n")
        self.write("d.v", "module d; endmodule\n")
        self.expect(self.run_tool("import", "d.v", "--initial-values"), USAGE,
                    "orn-hdl: --initial-values applies to JSON netlists alone; see --help\n")


if __name__ == "__main__":
    unittest.main()
