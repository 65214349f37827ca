`timescale 1ns / 1ps

module synthesis_attributes(A, 
                            Y);

    input A/* synthesis "LOC=P1" */;
   output Y;

   wire n1/* synthesis "KEEP=TRUE" */;

   INV U1 (.I(A), 
           .O(n1))/* synthesis "speed=fast, \
                         RLOC=X0 Y1, \
                         KIND=gate" */;
   INV U2 (.I(n1), 
           .O(Y))/* synthesis "SPEED=slow, \
                         KIND=gate" */;
endmodule
