`timescale 1ns / 1ps

module wired_or_output(A, 
                       B, 
                       Y, 
                       Z);

    input A;
    input B;
   output Y;
   output Z;

   wire Y_DUMMY;

   assign Y = Y_DUMMY;
   INV U1 (.I(A), 
           .O(Y_DUMMY));
   INV U2 (.I(B), 
           .O(Y_DUMMY));
   INV U3 (.I(B), 
           .O(Z));
endmodule
