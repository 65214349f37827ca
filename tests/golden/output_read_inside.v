`timescale 1ns / 1ps

module output_read_inside(A, 
                          Q, 
                          Y);

    input A;
   output [1:0] Q;
   output Y;

   wire [1:0] Q_DUMMY;
   wire Y_DUMMY;

   assign Q[1:0] = Q_DUMMY[1:0];
   assign Y = Y_DUMMY;
   INV U1 (.I(A), 
           .O(Y_DUMMY));
   INV U2 (.I(Y_DUMMY), 
           .O(Q_DUMMY[0]));
   INV U3 (.I(Q_DUMMY[0]), 
           .O(Q_DUMMY[1]));
endmodule
