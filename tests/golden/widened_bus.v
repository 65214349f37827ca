`timescale 1ns / 1ps

module widened_bus(A, 
                   B, 
                   X, 
                   Q);

    input [3:0] A;
    input [3:0] B;
    input X;
   output [7:0] Q;

   wire carry;
   wire [7:0] T;

   assign Q[7:0] = T[7:0];
   ADD4 U1 (.A(A[3:0]), 
            .B(B[3:0]), 
            .CI(X), 
            .CO(carry), 
            .S(T[3:0]));
   ADD4 U2 (.A(A[3:0]), 
            .B(B[3:0]), 
            .CI(carry), 
            .CO(), 
            .S(T[7:4]));
endmodule
