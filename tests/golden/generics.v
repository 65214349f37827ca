`timescale 1ns / 1ps

module generics(A, 
                Y, 
                Z);

   parameter WIDTH = 4;
   parameter START = 1'b1;
   // synopsys translate_off
   parameter NOTE = "model only";
   parameter QUICK = "TRUE";
   // synopsys translate_on

    input [3:0] A;
   output Y;
   output Z;


   LUT4 U1 (.I(A[3:0]), 
            .O(Y));
   defparam U1.INIT = 16'h8000;
   LUT4 U2 (.I(A[3:0]), 
            .O(Z));
   defparam U2.INIT = 16'hFFFE;
endmodule
