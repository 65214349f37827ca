`timescale 1ns / 1ps

module aliases(A, 
               D, 
               P, 
               Q, 
               R, 
               Y, 
               Z);

    input A;
    input [3:0] D;
   output [0:3] P;
   output [3:0] Q;
   output [1:0] R;
   output Y;
   output Z;


   assign P[0:3] = D[3:0];
   assign Q[3:0] = D[3:0];
   assign R[1:0] = D[3:2];
   assign Y = A;
   assign Z = D[2];
endmodule
