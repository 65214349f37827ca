`timescale 1ns / 1ps

module X(A, 
         B, 
         W, 
         Y, 
         Z);

 input A;
 input [3:0] B;
output W;
output Y;
output [3:0] Z;

wire Y_DUMMY;

assign W = Y_DUMMY;
assign Y = Y_DUMMY;
BUF1 U1 (.I(A), 
         .O(Y_DUMMY));
REG4 U2 (.D(B[3:0]), 
         .Q(Z[3:0]));
endmodule
