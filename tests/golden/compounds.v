`timescale 1ns / 1ps

module compounds(P, 
                 X, 
                 Y, 
                 C, 
                 R);

    input [2:0] P;
    input X;
    input Y;
   output C;
   output [3:0] R;

   wire K;
   wire L;
   wire M;
   wire [1:0] N;
   wire [1:0] T;

   assign {M, N[1:0]} = 3'b101;
   assign {K, L} = {P[2], Y};
   assign R[1:0] = T[1:0];
   ADD4 U1 (.A({X, P[2:0]}), 
            .B({P[1], P[2:1], Y}), 
            .CI(X), 
            .CO(C), 
            .S({R[3:2], T[1:0]}));
endmodule
