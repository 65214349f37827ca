`timescale 1ns / 1ps

module one_bit_buses(N, 
                     S, 
                     M, 
                     T, 
                     V);

    input N;
    input [0:0] S;
   output M;
   output [0:0] T;
   output [3:1] V;


   assign V[1] = N;
   assign V[2:2] = S[0:0];
   INV1 U1 (.I(S[0]), 
            .O(T[0]));
   INV1 U2 (.I(N), 
            .O(M));
   INV U3 (.I(S[0]), 
           .O(V[3:3]));
endmodule
