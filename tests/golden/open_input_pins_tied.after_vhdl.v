`timescale 1ns / 1ps

module open_input_pins_tied(A, 
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

   wire [3:0] U2_B_openSignal;
   wire U3_I1_openSignal;

   ADD4 U1 (.A(A[3:0]), 
            .B(B[3:0]), 
            .CI(X), 
            .CO(), 
            .S(S[3:0]));
   ADD4 U2 (.A(A[3:0]), 
            .B(U2_B_openSignal[3:0]), 
            .CI(X), 
            .CO(Z), 
            .S());
   AND2 U3 (.I0(X), 
            .I1(U3_I1_openSignal), 
            .O(Y));
endmodule
