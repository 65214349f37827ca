`timescale 1ns / 1ps

module long_lines(D, 
                  a_port_whose_name_is_so_long_that_its_declaration_cannot_fit, 
                  W);

    input [16:0] D;
   output [15:0] a_port_whose_name_is_so_long_that_its_declaration_cannot_fit;
   output [0:15] W;


   assign a_port_whose_name_is_so_long_that_its_declaration_cannot_fit[15:0] = 
         D[15:0];
   assign W[0:15] = {D[0], D[1], D[2], D[3], D[4], D[5], D[6], D[7], D[8], 
         D[9], D[10], D[11], D[12], D[13], D[14], D[15]};
endmodule
