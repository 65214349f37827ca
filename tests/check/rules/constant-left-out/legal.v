`timescale 1ns / 1ps

module X(A, 
         B, 
         W, 
         Y, 
         Z);

 input A;
 input [3:0] B;
output [7:0] W;
output Y;
output [3:0] Z;


assign W[3:0] = 4'b0000;
assign {W[4], W[5], W[6], W[7]} = 4'b0101;
BUF1 U1 (.I(A), 
         .O(Y));
REG4 U2 (.D(B[3:0]), 
         .Q(Z[3:0]));
endmodule
