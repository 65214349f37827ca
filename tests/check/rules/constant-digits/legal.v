`timescale 1ns / 1ps

module X(A, 
         B, 
         Y, 
         Z);

 input A;
 input [3:0] B;
output Y;
output [3:0] Z;

wire [3:0] K;

assign K = 4'b1010;
BUF1 U1 (.I(A), 
         .O(Y));
REG4 U2 (.D(B[3:0]), 
         .Q(Z[3:0]));
REG4 U5 (.D(K[3:0]), 
         .Q());
endmodule
