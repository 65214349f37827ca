`timescale 1ns / 1ps

module MHALVEX_LUT(A, 
                   Y, 
                   Z);

   parameter INIT = 16'h1234;

    input [3:0] A;
   output Y;
   output Z;


   LUT4 U1 (.I(A[3:0]), 
            .O(Y));
   defparam U1.INIT = INIT;
   LUT4 U2 (.I(A[3:0]), 
            .O(Z));
   defparam U2.INIT = INIT;
endmodule
