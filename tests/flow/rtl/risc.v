// A load-store machine of several modules: four registers of eight bits, built
// in a generate loop, so that flattened names hold dots and brackets.
module risc(input         clk,
            input         rst_n,
            input  [15:0] instr,
            input   [7:0] mem_in,
            output  [7:0] mem_out,
            output  [7:0] mem_addr,
            output        mem_write,
            output  [7:0] pc);

   // instr: operation, target, source, immediate flag, unused bit, operand
   wire [3:0] op     = instr[15:12];
   wire [1:0] target = instr[11:10];
   wire [1:0] source = instr[9:8];
   wire [7:0] imm    = instr[7:0];
   wire       loads  = op == 4'd8;
   wire       writes = op < 4'd9;
   wire       jumps  = op == 4'd10 || (op == 4'd11 && zero);
   wire       zero;
   wire [7:0] x, y, result;

   register_file regs(.clk(clk), .rst_n(rst_n), .write(writes), .target(target),
                      .source(source), .value(loads ? mem_in : result), .x(x), .y(y));
   execute unit(.op(op[2:0]), .x(x), .y(y), .imm(imm), .result(result));
   program_counter counter(.clk(clk), .rst_n(rst_n), .jump(jumps), .to(imm), .pc(pc));

   assign zero      = x == 8'd0;
   assign mem_addr  = y + imm;
   assign mem_out   = x;
   assign mem_write = op == 4'd9;
endmodule

module register_file(input clk, input rst_n, input write, input [1:0] target,
                     input [1:0] source, input [7:0] value, output [7:0] x, output [7:0] y);
   wire [31:0] all;

   genvar n;
   generate
      for (n = 0; n < 4; n = n + 1) begin : word
         reg [7:0] bits;
         always @(posedge clk or negedge rst_n)
            if (!rst_n) bits <= 8'd0;
            else if (write && target == n) bits <= value;
         assign all[8 * n +: 8] = bits;
      end
   endgenerate

   assign x = all[8 * target +: 8];
   assign y = all[8 * source +: 8];
endmodule

module execute(input [2:0] op, input [7:0] x, input [7:0] y, input [7:0] imm,
               output reg [7:0] result);
   always @*
      case (op)
         3'd0: result = imm;
         3'd1: result = x + y;
         3'd2: result = x - y;
         3'd3: result = x & y;
         3'd4: result = x | y;
         3'd5: result = x ^ y;
         3'd6: result = {y[6:0], y[7]};
         3'd7: result = x + imm;
      endcase
endmodule

module program_counter(input clk, input rst_n, input jump, input [7:0] to,
                       output reg [7:0] pc);
   always @(posedge clk or negedge rst_n)
      if (!rst_n) pc <= 8'd0;
      else pc <= jump ? to : pc + 8'd1;
endmodule
