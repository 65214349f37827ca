`timescale 1ns / 1ps

module synthesis_attributes(A, 
                            Y);

    input A;
   output Y;

   wire n1;

   INV U1 (.I(A), 
           .O(n1));
   INV U2 (.I(n1), 
           .O(Y));
endmodule
