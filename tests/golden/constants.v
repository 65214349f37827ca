`timescale 1ns / 1ps

module constants(Y, 
                 Z);

   output [7:0] Y;
   output Z;

   wire [3:0] B;
   wire N;
   wire O1;
   wire [3:0] S1;
   wire U1_I0_CONST_SIGNAL;
   wire U1_I1_CONST_SIGNAL;
   wire [3:0] U2_A_CONST_SIGNAL;
   wire [3:0] U2_B_CONST_SIGNAL;
   wire U2_CI_CONST_SIGNAL;
   wire [8:0] X;

   assign B[2:0] = 3'b010;
   assign B[3] = 1;
   assign N = 0;
   assign U1_I0_CONST_SIGNAL = 1;
   assign U1_I1_CONST_SIGNAL = 0;
   assign U2_A_CONST_SIGNAL = 4'b1010;
   assign U2_B_CONST_SIGNAL = 4'hF;
   assign U2_CI_CONST_SIGNAL = 1;
   assign X = 9'o245;
   assign Y = 8'hA5;
   assign Z = 1;
   AND2 U1 (.I0(U1_I0_CONST_SIGNAL), 
            .I1(U1_I1_CONST_SIGNAL), 
            .O(O1));
   ADD4 U2 (.A(U2_A_CONST_SIGNAL[3:0]), 
            .B(U2_B_CONST_SIGNAL[3:0]), 
            .CI(U2_CI_CONST_SIGNAL), 
            .CO(), 
            .S(S1[3:0]));
endmodule
