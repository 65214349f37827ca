`timescale 1ns / 1ps

module input_driven_inside(A, 
                           B, 
                           Y);

    input A;
    input B;
   output Y;

   wire A_DUMMY;

   assign A_DUMMY = A;
   INV U1 (.I(B), 
           .O(A_DUMMY));
   INV U2 (.I(A_DUMMY), 
           .O(Y));
endmodule
