`timescale 1ns / 1ps

module open_output_pins(A, 
                        B, 
                        X, 
                        S, 
                        Y, 
                        Z);

    input [3:0] A;
    input [3:0] B;
    input X;
   output [3:0] S;
   output Y;
   output Z;


   ADD4 U1 (.A(A[3:0]), 
            .B(B[3:0]), 
            .CI(X), 
            .CO(), 
            .S(S[3:0]));
   ADD4 U2 (.A(A[3:0]), 
            .B(B[3:0]), 
            .CI(X), 
            .CO(Z), 
            .S());
   AND2 U3 (.I0(X), 
            .I1(A[0]), 
            .O(Y));
endmodule
