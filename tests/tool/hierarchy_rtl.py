"""Designs with hierarchy in Verilog, for tests that let Yosys read them."""

# A module used twice, one with parameters in two sizes, names that no language takes, and a module
# that nothing uses.
COUNTERS = """\
module step #(parameter WIDTH = 4, parameter [1:0] BY = 1)
             (input [WIDTH-1:0] in, output [WIDTH-1:0] out);
   assign out = in + BY;
endmodule
module counter #(parameter WIDTH = 4, parameter [1:0] BY = 1)
                (input clk, input rst, output reg [WIDTH-1:0] \\signal );
   wire [WIDTH-1:0] next;
   step #(.WIDTH(WIDTH), .BY(BY)) add(.in(\\signal ), .out(next));
   always @(posedge clk) if (rst) \\signal <= 0; else \\signal <= next;
endmodule
module unused(input a, output b);
   assign b = ~a;
endmodule
module counters(input clk, input rst, output [3:0] a, output [3:0] b, output [6:0] c,
                output [7:0] d);
   counter one(.clk(clk), .rst(rst), .\\signal (a));
   counter two(.clk(clk), .rst(rst), .\\signal (b));
   counter #(.WIDTH(7), .BY(3)) three(.clk(clk), .rst(rst), .\\signal (c));
   counter #(.WIDTH(8), .BY(2)) four(.clk(clk), .rst(rst), .\\signal (d));
endmodule
"""

# Several levels, a bus that is spread over instances, and pads in both directions.
PIPE = """\
module half(input a, input b, output sum, output carry);
   assign {carry, sum} = a + b;
endmodule
module full(input a, input b, input in, output sum, output out);
   wire s, c1, c2;
   half first(.a(a), .b(b), .sum(s), .carry(c1));
   half second(.a(s), .b(in), .sum(sum), .carry(c2));
   assign out = c1 | c2;
endmodule
module adder #(parameter N = 3)(input [N-1:0] a, input [N-1:0] b, output [N:0] y);
   wire [N:0] c;
   assign c[0] = 1'b0;
   genvar i;
   generate for (i = 0; i < N; i = i + 1) begin : bits
      full \\bit (.a(a[i]), .b(b[i]), .in(c[i]), .sum(y[i]), .out(c[i+1]));
   end endgenerate
   assign y[N] = c[N];
endmodule
module pipe(input clk, input [4:0] a, input [4:0] b, output reg [5:0] y);
   reg [4:0] p, q;
   wire [5:0] s;
   adder #(.N(5)) sum(.a(p), .b(q), .y(s));
   always @(posedge clk) begin
      p <= a;
      q <= b;
      y <= s;
   end
endmodule
"""

# A memory with contents, in a module of its own.
MEMORY = """\
module store(input clk, input we, input [2:0] at, input [7:0] in, output [7:0] out);
   reg [7:0] words [0:7];
   integer i;
   initial for (i = 0; i < 8; i = i + 1) words[i] = 3 * i + 1;
   always @(posedge clk) if (we) words[at] <= in;
   assign out = words[at];
endmodule
module memory(input clk, input we, input [2:0] at, input [7:0] word, output [7:0] y);
   wire [7:0] q;
   store data(.clk(clk), .we(we), .at(at), .in(word ^ 8'h5a), .out(q));
   assign y = q;
endmodule
"""

# Cells that only Yosys knows, with parameters in several sizes, and ports in either direction.
WORDS = """\
module unit #(parameter W = 3)(input signed [W-1:0] a, input [0:W-1] b, output [W:1] y, output less);
   assign y = a + b;
   assign less = a < b;
endmodule
module words(input [2:0] a, input [0:2] b, input [9:0] c, output [2:0] y, output [12:3] z,
             output [1:0] less);
   unit small(.a(a), .b(b), .y(y), .less(less[0]));
   unit #(.W(10)) large(.a(c), .b({c[4:0], 5'd3}), .y(z), .less(less[1]));
endmodule
"""
