// Four levels, with open outputs, constants at inputs, ranges of all kinds, and slices of slices.
module level4(input [0:7] up, input [11:4] offset, output [0:7] left, output [11:4] right, output spare);
  assign left = up + offset;
  assign right = {up[4:7], offset[7:4]};
  assign spare = up[0];
endmodule

module level3(input [7:0] a, input [7:0] b, output [7:0] x, output [7:0] y);
  level4 low(.up(a), .offset({b[3:0], b[7:4]}), .left(x), .right(y), .spare());
endmodule

module level2(input clk, input [7:0] a, output [7:0] x, output reg [7:0] kept);
  wire [7:0] y;
  level3 constant(.a(a), .b(8'h3c), .x(x), .y(y));
  always @(negedge clk) kept <= y ^ x;
endmodule

module levels(input clk, input [7:0] a, input [7:0] b, output [7:0] x, output [15:0] kept);
  wire [7:0] between;
  reg [7:0] mixed;
  always @(posedge clk) mixed <= {a[3:0], b[3:0]};
  level2 first(.clk(clk), .a(mixed), .x(between), .kept(kept[15:8]));
  level2 second(.clk(clk), .a(between), .x(x), .kept(kept[7:0]));
endmodule
