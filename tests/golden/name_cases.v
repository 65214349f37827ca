`timescale 1ns / 1ps

module name_cases(data, 
                  y);

    input [1:0] data;
   output y;

   wire mid;

   AND2 U1 (.I0(data[0]), 
            .I1(data[1]), 
            .O(mid));
   AND2 U2 (.I0(mid), 
            .I1(data[1]), 
            .O(y));
endmodule
