`timescale 1ns / 1ps

module X(A, 
         B, 
         Y, 
         Z);

 input A;
 input [3:0] B;
output Y;
output [3:0] Z;

wire N;

BUF1 U1 (.I(A), 
         .O(Y));
REG4 U2 (.D(B[3:0]), 
         .Q(Z[3:0]));
BUF1 U3 (.I(N), 
         .O());
endmodule
