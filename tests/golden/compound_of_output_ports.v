`timescale 1ns / 1ps

module compound_of_output_ports(X, 
                                W, 
                                Y, 
                                Z);

    input X;
   output W;
   output Y;
   output [1:0] Z;

   wire Y_DUMMY;
   wire [1:0] Z_DUMMY;

   assign Y = Y_DUMMY;
   assign Z[1:0] = Z_DUMMY[1:0];
   BUF1 U1 (.I(X), 
            .O(Y_DUMMY));
   BUF1 U2 (.I(X), 
            .O(Z_DUMMY[0]));
   BUF1 U3 (.I(X), 
            .O(Z_DUMMY[1]));
   LUT4 U4 (.I({Y_DUMMY, Z_DUMMY[1:0], X}), 
            .O(W));
endmodule
