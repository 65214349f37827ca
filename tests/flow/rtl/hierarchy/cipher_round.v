// A round of the cipher AES for one column, with one S-box that computes.
module field_double(input [7:0] a, output [7:0] y);
  assign y = {a[6:0], 1'b0} ^ (a[7] ? 8'h1b : 8'h00);
endmodule

module field_product(input [7:0] a, input [7:0] b, output [7:0] y);
  wire [63:0] powers;
  wire [71:0] sums;
  assign powers[7:0] = a;
  assign sums[7:0] = 8'd0;
  genvar i;
  generate
    for (i = 0; i < 8; i = i + 1) begin : bits
      if (i < 7) begin : next
        field_double double(.a(powers[8*i +: 8]), .y(powers[8*i+8 +: 8]));
      end
      assign sums[8*i+8 +: 8] = sums[8*i +: 8] ^ (b[i] ? powers[8*i +: 8] : 8'd0);
    end
  endgenerate
  assign y = sums[71:64];
endmodule

module field_square(input [7:0] a, output [7:0] y);
  assign y = {a[7] ^ a[6], a[5] ^ a[3], a[5] ^ a[6], a[4] ^ a[2] ^ a[7], a[4] ^ a[5] ^ a[6] ^ a[7],
              a[1] ^ a[5], a[4] ^ a[6] ^ a[7], a[0] ^ a[4] ^ a[6]};
endmodule

// The inverse in the field, which is the power 254, and an affine map.
module substitute(input [7:0] a, output [7:0] y);
  wire [7:0] a2, a3, a6, a12, a15, a30, a60, a120, a240, a252, n;
  field_square p2(.a(a), .y(a2));
  field_product p3(.a(a2), .b(a), .y(a3));
  field_square p6(.a(a3), .y(a6));
  field_square p12(.a(a6), .y(a12));
  field_product p15(.a(a12), .b(a3), .y(a15));
  field_square p30(.a(a15), .y(a30));
  field_square p60(.a(a30), .y(a60));
  field_square p120(.a(a60), .y(a120));
  field_square p240(.a(a120), .y(a240));
  field_product p252(.a(a240), .b(a12), .y(a252));
  field_product p254(.a(a252), .b(a2), .y(n));
  assign y = n ^ {n[6:0], n[7]} ^ {n[5:0], n[7:6]} ^ {n[4:0], n[7:5]} ^ {n[3:0], n[7:4]} ^ 8'h63;
endmodule

module mix_column(input [31:0] a, output [31:0] y);
  wire [31:0] twice;
  genvar i;
  generate
    for (i = 0; i < 4; i = i + 1) begin : rows
      field_double double(.a(a[8*i +: 8]), .y(twice[8*i +: 8]));
      assign y[8*i +: 8] = twice[8*i +: 8] ^ twice[8*((i+3)%4) +: 8] ^ a[8*((i+3)%4) +: 8] ^
                           a[8*((i+2)%4) +: 8] ^ a[8*((i+1)%4) +: 8];
    end
  endgenerate
endmodule

// One column: four clocks substitute its bytes, one each, then it is mixed and meets the key.
module cipher_round(input clk, input reset, input load, input [31:0] column, input [31:0] key,
                    output reg [31:0] state, output reg [2:0] step);
  wire [7:0] replaced;
  wire [31:0] mixed;
  substitute box(.a(state[31:24]), .y(replaced));
  mix_column mix(.a(state), .y(mixed));
  always @(posedge clk)
    if (reset) begin
      state <= 32'd0;
      step <= 3'd0;
    end else begin
      step <= step[2] | load ? 3'd0 : step + 3'd1;
      if (load) state <= column;
      else if (step[2]) state <= mixed ^ key;
      else state <= {state[23:0], replaced};
    end
endmodule
