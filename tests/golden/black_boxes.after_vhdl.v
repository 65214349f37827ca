`timescale 1ns / 1ps

module black_boxes(A, 
                   Y);

    input A;
   output Y;

   wire n1;

   BUF1 U1 (.I(A), 
            .O(n1));
   // synthesis attribute BOX_TYPE of U1 is "BLACK_BOX"
   INV U2 (.I(n1), 
           .O(Y));
endmodule
