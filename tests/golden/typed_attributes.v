`timescale 1ns / 1ps

module typed_attributes(A, 
                        Y);

    input A;
   output Y;


   INV U1 (.I(A), 
           .O(Y));
   // synthesis attribute NAME of U1 is "alpha"
   // synthesis attribute COUNT of U1 is "5"
   // synthesis attribute RATIO of U1 is "2.50"
   // synthesis attribute ENABLE of U1 is "TRUE"
   // synthesis attribute FLAG of U1 is "1"
   // synthesis attribute MASK of U1 is "A"
   // synthesis attribute LOUDNESS of U1 is "warning"
endmodule
