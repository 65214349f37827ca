`timescale 1ns / 1ps

module synthesis_attributes(A, 
                            Y);

    input A;
   // synthesis attribute LOC of A is "P1"
   output Y;

   wire n1;
   // synthesis attribute KEEP of n1 is "TRUE"

   INV U1 (.I(A), 
           .O(n1));
   // synthesis attribute speed of U1 is "fast"
   // synthesis attribute RLOC of U1 is "X0 Y1"
   // synthesis attribute KIND of U1 is "gate"
   INV U2 (.I(n1), 
           .O(Y));
   // synthesis attribute SPEED of U2 is "slow"
   // synthesis attribute KIND of U2 is "gate"
endmodule
