`timescale 1ns / 1ps

module synthesis_attributes(A, 
                            Y);

    input A;
   //pragma attribute A LOC P1
   output Y;

   wire n1;
   //pragma attribute n1 KEEP TRUE

   INV U1 (.I(A), 
           .O(n1));
   //pragma attribute U1 speed fast
   //pragma attribute U1 RLOC X0 Y1
   //pragma attribute U1 KIND gate
   INV U2 (.I(n1), 
           .O(Y));
   //pragma attribute U2 SPEED slow
   //pragma attribute U2 KIND gate
endmodule
