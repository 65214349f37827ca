// What counter8.cmd builds of gates and flip-flops.

`timescale 1ns / 1ps

module counter8_rtl(input CLK, input CLR, input CE, output reg [7:0] Q, output TC);
   initial Q = 8'd0;

   always @(posedge CLK or posedge CLR)
      if (CLR) Q <= 8'd0;
      else if (CE) Q <= Q + 8'd1;

   assign TC = CE && Q == 8'hFF;
endmodule
