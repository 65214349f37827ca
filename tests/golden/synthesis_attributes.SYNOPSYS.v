`timescale 1ns / 1ps

module synthesis_attributes(A, 
                            Y);

    input A;
   /* synopsys attribute LOC "P1" */
   output Y;

   wire n1;
   /* synopsys attribute KEEP "TRUE" */

   INV U1 (.I(A), 
           .O(n1));
   /* synopsys attribute speed "fast"
                         RLOC "X0 Y1"
                         KIND "gate" */
   INV U2 (.I(n1), 
           .O(Y));
   /* synopsys attribute SPEED "slow"
                         KIND "gate" */
endmodule
