// Generate loops: a network that sorts, of exchangers in rows, and a register behind each row.
module exchanger #(parameter WIDTH = 4)
  (input [WIDTH-1:0] a, input [WIDTH-1:0] b, output [WIDTH-1:0] low, output [WIDTH-1:0] high);
  wire swap = b < a;
  assign low = swap ? b : a;
  assign high = swap ? a : b;
endmodule

module sorting_row #(parameter COUNT = 6, parameter WIDTH = 4, parameter FIRST = 0)
  (input clk, input [COUNT*WIDTH-1:0] in, output reg [COUNT*WIDTH-1:0] out);
  wire [COUNT*WIDTH-1:0] next;
  genvar i;
  generate
    for (i = 0; i < COUNT; i = i + 1) begin : places
      if (i % 2 == FIRST && i + 1 < COUNT) begin : pair
        exchanger #(.WIDTH(WIDTH)) e(.a(in[i*WIDTH +: WIDTH]), .b(in[(i+1)*WIDTH +: WIDTH]),
          .low(next[i*WIDTH +: WIDTH]), .high(next[(i+1)*WIDTH +: WIDTH]));
      end else if (i % 2 == FIRST || i == 0) begin : alone
        assign next[i*WIDTH +: WIDTH] = in[i*WIDTH +: WIDTH];
      end
    end
  endgenerate
  always @(posedge clk) out <= next;
endmodule

module sorting(input clk, input [23:0] in, output [23:0] out);
  wire [23:0] rows [0:6];
  assign rows[0] = in;
  assign out = rows[6];
  genvar r;
  generate
    for (r = 0; r < 6; r = r + 1) begin : row
      sorting_row #(.COUNT(6), .WIDTH(4), .FIRST(r % 2)) s(.clk(clk), .in(rows[r]), .out(rows[r+1]));
    end
  endgenerate
endmodule
