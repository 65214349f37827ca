// The leaf cells as black boxes, for synthesis into them. Ports as in cells.v.

(* blackbox *) module BUF1(input I, output O); endmodule
(* blackbox *) module INV(input I, output O); endmodule
(* blackbox *) module AND2(input I0, input I1, output O); endmodule
(* blackbox *) module OR2(input I0, input I1, output O); endmodule
(* blackbox *) module NAND2(input I0, input I1, output O); endmodule
(* blackbox *) module NOR2(input I0, input I1, output O); endmodule
(* blackbox *) module XOR2(input I0, input I1, output O); endmodule
(* blackbox *) module XNOR2(input I0, input I1, output O); endmodule
(* blackbox *) module MUX2(input I0, input I1, input S, output O); endmodule
(* blackbox *) module MUX4(input [3:0] D, input [1:0] S, output O); endmodule
(* blackbox *) module LUT4(input [3:0] I, output O);
   parameter [15:0] INIT = 16'h0000;
endmodule
(* blackbox *) module ADD4(input [3:0] A, input [3:0] B, input CI, output [3:0] S, output CO);
endmodule
(* blackbox *) module INV1(input [0:0] I, output [0:0] O); endmodule
(* blackbox *) module REV4(input [0:3] I, output [0:3] O); endmodule
(* blackbox *) module DFF(input C, input D, output Q); endmodule
(* blackbox *) module DFFE(input C, input CE, input D, output Q); endmodule
(* blackbox *) module DFFC(input C, input CLR, input D, output Q); endmodule
(* blackbox *) module DFFS(input C, input PRE, input D, output Q); endmodule
(* blackbox *) module DFFCE(input C, input CE, input CLR, input D, output Q); endmodule
(* blackbox *) module DFFSE(input C, input CE, input PRE, input D, output Q); endmodule
(* blackbox *) module REG4(input C, input CE, input CLR, input [3:0] D, output [3:0] Q);
endmodule
(* blackbox *) module IOBUF(input I, input T, output O, inout IO);
   parameter SLEW = "SLOW";
endmodule
