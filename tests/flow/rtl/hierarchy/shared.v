// A module that is used twice, one by way of another, and one that nothing uses.
module nobody(input a, output y);
  assign y = ~a;
endmodule

module parity(input [3:0] a, output y);
  assign y = ^a;
endmodule

module checked(input clk, input [3:0] a, output reg [4:0] kept);
  wire p;
  parity own(.a(a), .y(p));
  always @(posedge clk) kept <= {p, a};
endmodule

module shared(input clk, input [3:0] a, input [3:0] b, output [4:0] kept_a, output [4:0] kept_b,
              output same);
  wire p, q;
  parity first(.a(a), .y(p));
  parity second(.a(b), .y(q));
  checked one(.clk(clk), .a(a), .kept(kept_a));
  checked two(.clk(clk), .a(b), .kept(kept_b));
  assign same = p == q;
endmodule
