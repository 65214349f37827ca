// A register file with two read ports: a memory that becomes flip-flops.
module regfile(input clk, input rst, input we, input [2:0] wa, input [7:0] wd, input [2:0] ra,
               input [2:0] rb, output [7:0] a, output reg [0:7] b);
   reg [7:0] mem [0:7];
   integer i;
   assign a = mem[ra];
   always @(posedge clk or posedge rst)
      if (rst) begin
         for (i = 0; i < 8; i = i + 1) mem[i] <= 8'd0;
         b <= 8'd0;
      end else begin
         if (we) mem[wa] <= wd;
         b <= mem[rb];
      end
endmodule
