// Arithmetic and logic of eight bits, without state; the flag that the
// sixteen-entry table gives and the adder are leaf cells, placed by hand.
module alu(input  [7:0] a,
           input  [7:0] b,
           input  [3:0] op,
           output [7:0] y,
           output       carry,
           output       zero,
           output       flag);

   wire       subtract = op[0];
   wire [7:0] addend   = subtract ? ~b : b;
   wire [7:0] sum;
   wire       half;
   wire       overflow;

   ADD4 low(.A(a[3:0]), .B(addend[3:0]), .CI(subtract), .S(sum[3:0]), .CO(half));
   ADD4 high(.A(a[7:4]), .B(addend[7:4]), .CI(half), .S(sum[7:4]), .CO(overflow));
   LUT4 #(.INIT(16'hCA5E)) table4(.I({half, op[3:2], a[0]}), .O(flag));

   reg [7:0] result;
   always @*
      case (op[3:1])
         3'd0: result = sum;
         3'd1: result = a & b;
         3'd2: result = a | b;
         3'd3: result = a ^ b;
         3'd4: result = a << b[2:0];
         3'd5: result = a >> b[2:0];
         3'd6: result = {8{$signed(a) < $signed(b)}};
         3'd7: result = {a[3:0], b[7:4]};
      endcase

   assign y     = result;
   assign carry = overflow;
   assign zero  = result == 8'd0;
endmodule
