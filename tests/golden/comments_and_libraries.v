// Two inverters, one after the other.
//   Written   by hand. This line is a comment and stays in one piece although it is long.
`include "defines.vh"
`include "defines.vh"
`timescale 1ns / 1ps

module comments_and_libraries(A, 
                              Y);

   // the input
    input A;
   output Y;

   // between the two
   // and its second line
   wire n1;

   // an inverter
   // the first
   INV U1 (.I(A), 
           .O(n1));
   // an inverter
   INV U2 (.I(n1), 
           .O(Y));
endmodule
