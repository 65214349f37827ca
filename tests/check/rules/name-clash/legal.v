`timescale 1ns / 1ps

module X(A, 
         B, 
         U1, 
         Y, 
         Z);

 input A;
 input [3:0] B;
 input [1:0] U1;
output Y;
output [3:0] Z;


BUF1 U1_1 (.I(A), 
           .O(Y));
REG4 U2 (.D(B[3:0]), 
         .Q(Z[3:0]));
endmodule
