// Latches, and registers with resets and enables in both orders, in modules of their own.
module transparent #(parameter WIDTH = 4) (input open, input [WIDTH-1:0] in,
                                           output reg [WIDTH-1:0] out);
  always @* if (open) out = in;
endmodule

module held(input clk, input enable, input reset, input [3:0] in, output reg [3:0] out,
            output reg [3:0] last);
  always @(posedge clk)
    if (reset) out <= 4'h9;
    else if (enable) out <= in;
  always @(posedge clk)
    if (enable)
      if (reset) last <= 4'h6;
      else last <= out;
endmodule

module gated(input clk, input reset, input open, input enable, input [3:0] in, output [3:0] latched,
             output [3:0] out, output [3:0] last);
  // The latches open and close while their data rest.
  reg asked, opened;
  reg [3:0] data;
  always @(posedge clk) {asked, data} <= {open, in};
  always @(negedge clk) opened <= asked;
  transparent #(.WIDTH(4)) t(.open(opened), .in(data), .out(latched));
  held h(.clk(clk), .enable(enable), .reset(reset), .in(in ^ {4{enable}}), .out(out), .last(last));
endmodule
