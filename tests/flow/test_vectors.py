"""The same vectors accept a correct netlist and reject a wrong one, in either language."""

from __future__ import annotations

import contextlib
import io
import tempfile
import unittest
from pathlib import Path

from judging import Design, Forms, Tally, simulate
from judges import Ghdl, Rejected
from vectors import CYCLES, Stimulus, refuse_difference

RTL = """`timescale 1ns / 1ps
module wide(input clk, input rst, input on, input [3:0] d, output reg [3:0] q, inout [1:0] p);
   always @(posedge clk or posedge rst)
      if (rst) q <= 4'd0;
      else q <= d;
   assign p = on ? q[1:0] : 2'bzz;
endmodule
"""

VERILOG = """`timescale 1ns / 1ps
module wide(input clk, input rst, input on, input [3:0] d, output [3:0] q, inout [1:0] p);
   wire off;
   INV U0 (.I(on), .O(off));
   REG4 U1 (.C(clk), .CE(1'b1), .CLR(rst), .D(d), .Q(q));
   IOBUF U2 (.I(q[0]), .T(off), .O(), .IO(p[0]));
   IOBUF U3 (.I(q[1]), .T(off), .O(), .IO(p[1]));
endmodule
"""

VHDL = """library ieee;
use ieee.std_logic_1164.all;

entity wide is
   port (clk, rst, on_x : in std_logic;
         d : in    std_logic_vector (3 downto 0);
         q : out   std_logic_vector (3 downto 0);
         p : inout std_logic_vector (1 downto 0));
end wide;

architecture BEHAVIORAL of wide is
   signal state : std_logic_vector (3 downto 0);
begin
   process (clk, rst)
   begin
      if rst = '1' then
         state <= "0000";
      elsif rising_edge(clk) then
         state <= d;
      end if;
   end process;
   q <= state;
   p <= state(1 downto 0) when on_x = '1' else "ZZ";
end BEHAVIORAL;
"""


class VectorTest(unittest.TestCase):
    def setUp(self) -> None:
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.work = Path(folder.name)

    def simulate(self, rtl: str = RTL, verilog: str = VERILOG, vhdl: str = VHDL) -> None:
        """All three forms; the VHDL has a name of its own for the port "on"."""
        paths = [self.work / name for name in ("rtl.v", "wide.v", "wide.vhd")]
        for path, text in zip(paths, (rtl, verilog.replace(" on,", " on_x,").replace("(on)",
                                                                                   "(on_x)"),
                                      vhdl)):
            path.write_text(text)
        ghdl = Ghdl("93", self.work)
        ghdl.analyse(paths[2])
        design = Design("wide", Stimulus("clk", {"rst": 1}, {"p": ("on", 1)}), rtl=paths[0])
        simulate(design, Forms(paths[1], paths[2], {"on": "on_x"}), {"93": ghdl}, self.work)

    def test_same_circuit(self) -> None:
        self.simulate()

    def test_wrong_verilog(self) -> None:
        with self.assertRaisesRegex(Rejected, "Verilog netlist: cycle"):
            self.simulate(verilog=VERILOG.replace(".D(d)", ".D({d[0], d[3:1]})"))

    def test_wrong_vhdl(self) -> None:
        with self.assertRaisesRegex(Rejected, "VHDL-93 netlist: cycle"):
            self.simulate(vhdl=VHDL.replace("state <= d;", "state <= d(0) & d(3 downto 1);"))

    def test_wrong_pad(self) -> None:
        with self.assertRaisesRegex(Rejected, "VHDL-93 netlist: cycle"):
            self.simulate(vhdl=VHDL.replace("state(1 downto 0) when", "state(2 downto 1) when"))

    def test_rtl_without_an_answer(self) -> None:
        with self.assertRaisesRegex(Rejected, "unknown outputs"):
            self.simulate(rtl=RTL.replace("q <= 4'd0", "q <= 4'dx"))

    def test_runs_of_other_length(self) -> None:
        refuse_difference(["0"] * CYCLES, ["0"] * CYCLES, "run")
        for found in ([], ["0"] * (CYCLES - 1)):
            with self.assertRaisesRegex(Rejected, "cycles"):
                refuse_difference(["0"] * CYCLES, found, "run")


class TallyTest(unittest.TestCase):
    def test_counts_and_goes_on(self) -> None:
        def reject() -> None:
            raise Rejected("on purpose")

        tally = Tally()
        with contextlib.redirect_stdout(io.StringIO()) as shown:
            self.assertEqual(tally.check("answer", lambda: 7), 7)
            self.assertIs(tally.check("no answer", lambda: None), True)
            self.assertIs(tally.check("a rejection", reject), False)
            self.assertEqual((tally.passed, tally.failed, tally.close()), (2, 1, 1))
        self.assertEqual(shown.getvalue().splitlines(),
                         ["FAIL a rejection: on purpose", "2 passed, 1 failed"])


if __name__ == "__main__":
    unittest.main()
