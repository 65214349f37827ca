// A module in several sizes, with parameters that are numbers, bits and text.
module measure #(parameter WIDTH = 4, parameter [3:0] STEP = 4'd1, parameter MODE = "UP")
  (input clk, input reset, input enable, input [WIDTH-1:0] limit, output reg [WIDTH-1:0] count,
   output reached);
  assign reached = MODE == "UP" ? count >= limit : count <= limit;
  always @(posedge clk or negedge reset)
    if (!reset) count <= MODE == "UP" ? {WIDTH{1'b0}} : {WIDTH{1'b1}};
    else if (enable) count <= MODE == "UP" ? count + STEP : count - STEP;
endmodule

module sizes(input clk, input reset, input enable, input [15:0] limit, output [15:0] wide,
             output [6:0] middle, output narrow, output [2:0] down, output [3:0] reached);
  measure #(.WIDTH(16), .STEP(4'd9)) m16(.clk(clk), .reset(reset), .enable(enable), .limit(limit),
    .count(wide), .reached(reached[0]));
  measure #(.WIDTH(7)) m7(.clk(clk), .reset(reset), .enable(enable), .limit(limit[6:0]),
    .count(middle), .reached(reached[1]));
  measure #(.WIDTH(1)) m1(.clk(clk), .reset(reset), .enable(enable), .limit(limit[0]),
    .count(narrow), .reached(reached[2]));
  measure #(.WIDTH(3), .STEP(4'd3), .MODE("DOWN")) m3(.clk(clk), .reset(reset), .enable(enable),
    .limit(limit[4:2]), .count(down), .reached(reached[3]));
endmodule
