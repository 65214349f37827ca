// Generate blocks, nested and with instances of their own: names such as g[3].u.
module lane #(parameter W = 4, parameter signed [7:0] STEP = -3)(input clk, input rst, input [W-1:0] d,
            output reg [W-1:0] q, output carry);
   wire [W:0] sum = {1'b0, q} + {1'b0, d};
   assign carry = sum[W];
   always @(posedge clk or posedge rst)
      if (rst) q <= STEP;
      else q <= sum[W-1:0];
endmodule

module lanes(input clk, input rst, input [15:0] d, output [15:0] q, output [3:0] carry, output any);
   genvar i, j;
   generate
      for (i = 0; i < 4; i = i + 1) begin : g
         wire [3:0] mixed;
         for (j = 0; j < 4; j = j + 1) begin : bits
            XOR2 x(.I0(d[i*4 + j]), .I1(q[(i*5 + j*3) % 16] & d[j]), .O(mixed[j]));
         end
         lane #(.STEP(i - 2)) u(.clk(clk), .rst(rst), .d(mixed), .q(q[i*4 +: 4]), .carry(carry[i]));
      end
   endgenerate
   assign any = |carry;
endmodule
