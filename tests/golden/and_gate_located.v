`timescale 1ns / 1ps

module top(A, 
           Y);

    input [1:0] A;
   output Y;

   wire n1;

   AND2 U1 (.I0(A[0]), 
            .I1(n1), 
            .O(Y));
   // synthesis attribute LOC of U1 is "P1"
endmodule
