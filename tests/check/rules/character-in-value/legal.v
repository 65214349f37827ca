`timescale 1ns / 1ps

module X(A, 
         B, 
         Y, 
         Z);

 input A;
// synthesis attribute NOTE of A is "a	b"
 input [3:0] B;
output Y;
output [3:0] Z;


BUF1 U1 (.I(A), 
         .O(Y));
REG4 U2 (.D(B[3:0]), 
         .Q(Z[3:0]));
endmodule
