`timescale 1ns / 1ps

module bus_directions(D, 
                      V, 
                      W, 
                      Z);

    input [7:0] D;
   output [0:3] V;
   output [0:3] W;
   output [3:0] Z;

   wire [3:0] N;

   assign {N[0], N[1]} = 2'b10;
   assign N[3:2] = 2'b01;
   assign W[0:3] = {D[1], D[2], D[3], D[4]};
   REV4 U1 (.I(D[7:4]), 
            .O(V[0:3]));
   REV4 U2 (.I({D[0], D[1], D[2], D[3]}), 
            .O(Z[3:0]));
endmodule
