// Four nibbles in, four out, each taken from any input through leaf cells with
// bus pins, wired with slices, concatenations and constants; then a register
// over pieces of two buses and outputs put together of parts.
module crossbar(input         clk,
                input         rst,
                input  [15:0] in_bus,
                input   [7:0] choice,
                output [15:0] out_bus,
                output  [7:0] mixed,
                output  [3:0] mirrored,
                output  [5:0] shuffled);

   wire [15:0] routed;

   genvar port, lane;
   generate
      for (port = 0; port < 4; port = port + 1) begin : to
         for (lane = 0; lane < 4; lane = lane + 1) begin : bit_
            MUX4 select(.D({in_bus[12 + lane], in_bus[8 + lane], in_bus[4 + lane], in_bus[lane]}),
                        .S(choice[2 * port +: 2]), .O(routed[4 * port + lane]));
         end
      end
   endgenerate

   wire [3:0] sum;
   wire       over;
   ADD4 add(.A(routed[7:4]), .B({2'b10, routed[1], routed[8]}), .CI(1'b1), .S(sum), .CO(over));
   ADD4 skewed(.A({choice[0], routed[15:13]}), .B({in_bus[3:2], sum[1:0]}), .CI(over),
               .S({mixed[7:6], mixed[1:0]}), .CO(mixed[2]));
   REG4 hold(.C(clk), .CE(choice[7]), .CLR(rst), .D({sum[0], over, routed[3:2]}),
             .Q({mixed[3], mixed[5:4], shuffled[5]}));
   REV4 mirror(.I(in_bus[9:6]), .O(mirrored));

   assign out_bus       = {routed[3:0], routed[15:4]};
   assign shuffled[4:0] = {sum[1], routed[12], sum[3], in_bus[15], 1'b1};
endmodule
