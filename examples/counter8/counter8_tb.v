// Runs the netlist counter8 and counter8_rtl side by side and compares them in
// every cycle, through more than two full rounds of counting.

`timescale 1ns / 1ps

module counter8_tb;
   localparam CYCLES = 800;

   reg CLK = 1'b0;
   reg CLR = 1'b1;
   reg CE  = 1'b0;
   wire [7:0] netlistQ, rtlQ;
   wire       netlistTC, rtlTC;
   integer    cycle;
   integer    seed = 1;

   counter8     netlist(.CLK(CLK), .CLR(CLR), .CE(CE), .Q(netlistQ), .TC(netlistTC));
   counter8_rtl rtl(.CLK(CLK), .CLR(CLR), .CE(CE), .Q(rtlQ), .TC(rtlTC));

   initial begin
      for (cycle = 0; cycle < CYCLES; cycle = cycle + 1) begin
         // Enabled three cycles in four; cleared at the start and once in between.
         CE  = $random(seed) % 4 != 0;
         CLR = cycle == 0 || cycle == 300;
         #5;
         if ({netlistQ, netlistTC} !== {rtlQ, rtlTC}) begin
            $display("FAIL: cycle %0d: netlist %h %b, RTL %h %b",
                     cycle, netlistQ, netlistTC, rtlQ, rtlTC);
            $fatal(1);
         end
         CLK = 1'b1;
         #5;
         CLK = 1'b0;
      end
      $display("PASS: %0d cycles", CYCLES);
      $finish;
   end
endmodule
