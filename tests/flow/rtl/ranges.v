// Ranges of every kind: downwards, upwards, from an offset, of one bit away
// from 0; wired across each other.
module ranges(input          clk,
              input          rst,
              input   [7:0]  down,
              input   [0:7]  up,
              input  [15:12] high,
              input   [3:6]  late,
              input   [5:5]  one,
              output  [0:7]  sum_up,
              output reg [11:4] sum_down,
              output  [2:2]  any,
              output  [4:9]  slice);

   wire [0:3]  nibble;
   wire [19:16] mirrored;

   REV4 first(.I(up[2:5]), .O(nibble));
   REV4 second(.I(high), .O(mirrored));
   ADD4 adder(.A(late), .B(nibble), .CI(one), .S(slice[4:7]), .CO(slice[8]));

   assign sum_up   = down + up;
   assign any      = |late;
   assign slice[9] = mirrored[17];

   always @(posedge clk or posedge rst)
      if (rst) sum_down <= 8'd0;
      else sum_down <= down ^ {mirrored, high};
endmodule
