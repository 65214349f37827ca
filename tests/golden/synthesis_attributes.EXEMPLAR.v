`timescale 1ns / 1ps

module synthesis_attributes(A, 
                            Y);

    input A;
   // exemplar attribute A LOC P1
   output Y;

   wire n1;
   // exemplar attribute n1 KEEP TRUE

   INV U1 (.I(A), 
           .O(n1));
   // exemplar attribute U1 speed fast
   // exemplar attribute U1 RLOC X0 Y1
   // exemplar attribute U1 KIND gate
   INV U2 (.I(n1), 
           .O(Y));
   // exemplar attribute U2 SPEED slow
   // exemplar attribute U2 KIND gate
endmodule
