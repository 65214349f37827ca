// Leaf cells of the examples and of the flow designs: behaviour for simulation
// and for equivalence checks. Flip-flops start at 0; resets act at once.

`timescale 1ns / 1ps

module BUF1(input I, output O);
   assign O = I;
endmodule

module INV(input I, output O);
   assign O = ~I;
endmodule

module AND2(input I0, input I1, output O);
   assign O = I0 & I1;
endmodule

module OR2(input I0, input I1, output O);
   assign O = I0 | I1;
endmodule

module NAND2(input I0, input I1, output O);
   assign O = ~(I0 & I1);
endmodule

module NOR2(input I0, input I1, output O);
   assign O = ~(I0 | I1);
endmodule

module XOR2(input I0, input I1, output O);
   assign O = I0 ^ I1;
endmodule

module XNOR2(input I0, input I1, output O);
   assign O = ~(I0 ^ I1);
endmodule

// O is I1 when S is high.
module MUX2(input I0, input I1, input S, output O);
   assign O = S ? I1 : I0;
endmodule

module MUX4(input [3:0] D, input [1:0] S, output O);
   assign O = D[S];
endmodule

// O is the bit of INIT that I selects.
module LUT4(input [3:0] I, output O);
   parameter [15:0] INIT = 16'h0000;
   assign O = INIT[I];
endmodule

module ADD4(input [3:0] A, input [3:0] B, input CI, output [3:0] S, output CO);
   assign {CO, S} = {1'b0, A} + {1'b0, B} + {4'b0000, CI};
endmodule

// A bus of one bit on either side.
module INV1(input [0:0] I, output [0:0] O);
   assign O = ~I;
endmodule

// Mirrors a nibble; both buses count upwards.
module REV4(input [0:3] I, output [0:3] O);
   assign O = {I[3], I[2], I[1], I[0]};
endmodule

module DFF(input C, input D, output reg Q);
   initial Q = 1'b0;
   always @(posedge C) Q <= D;
endmodule

// With clock enable.
module DFFE(input C, input CE, input D, output reg Q);
   initial Q = 1'b0;
   always @(posedge C) if (CE) Q <= D;
endmodule

// With asynchronous clear.
module DFFC(input C, input CLR, input D, output reg Q);
   initial Q = 1'b0;
   always @(posedge C or posedge CLR)
      if (CLR) Q <= 1'b0;
      else Q <= D;
endmodule

// With asynchronous preset.
module DFFS(input C, input PRE, input D, output reg Q);
   initial Q = 1'b0;
   always @(posedge C or posedge PRE)
      if (PRE) Q <= 1'b1;
      else Q <= D;
endmodule

module DFFCE(input C, input CE, input CLR, input D, output reg Q);
   initial Q = 1'b0;
   always @(posedge C or posedge CLR)
      if (CLR) Q <= 1'b0;
      else if (CE) Q <= D;
endmodule

module DFFSE(input C, input CE, input PRE, input D, output reg Q);
   initial Q = 1'b0;
   always @(posedge C or posedge PRE)
      if (PRE) Q <= 1'b1;
      else if (CE) Q <= D;
endmodule

// Four flip-flops with clock enable and asynchronous clear.
module REG4(input C, input CE, input CLR, input [3:0] D, output reg [3:0] Q);
   initial Q = 4'b0000;
   always @(posedge C or posedge CLR)
      if (CLR) Q <= 4'b0000;
      else if (CE) Q <= D;
endmodule

// Pad: drives IO with I unless T is high; O is what IO shows.
module IOBUF(input I, input T, output O, inout IO);
   parameter SLEW = "SLOW";
   assign IO = T ? 1'bz : I;
   assign O = IO;
endmodule
