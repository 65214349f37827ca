// An accumulator machine with four registers, one instruction a clock. The
// program memory is outside: pc asks, instr answers in the same cycle.
//
// instr is {operation, operand}; the operand is an immediate, a jump target or,
// in its low two bits, a register number.

`timescale 1ns / 1ps

module cpu8(input             clk,
            input             reset,
            input      [11:0] instr,
            input       [7:0] data_in,
            output reg  [7:0] pc,
            output reg  [7:0] data_out,
            output reg        data_strobe,
            output reg        zero,
            output reg        carry);

   localparam [3:0] LOADI = 4'h0, LOAD = 4'h1, STORE = 4'h2, ADD   = 4'h3,
                    SUB   = 4'h4, ANDR = 4'h5, ORR   = 4'h6, XORR  = 4'h7,
                    ADDI  = 4'h8, ROR  = 4'h9, INP   = 4'hA, OUTP  = 4'hB,
                    JUMP  = 4'hC, JZ   = 4'hD, JC    = 4'hE, SWAP  = 4'hF;

   wire [3:0] operation = instr[11:8];
   wire [7:0] operand   = instr[7:0];

   reg  [7:0] acc;
   reg  [7:0] r0, r1, r2, r3;

   wire [7:0] selected = operand[1] ? (operand[0] ? r3 : r2)
                                    : (operand[0] ? r1 : r0);

   // Addition and subtraction share one adder.
   wire [7:0] addend = operation == ADDI ? operand
                     : operation == SUB  ? ~selected : selected;
   wire [8:0] sum    = {1'b0, acc} + {1'b0, addend} + {8'd0, operation == SUB};

   reg [7:0] result;
   reg       carryOut;
   reg       setsAcc;

   always @* begin
      setsAcc  = 1'b1;
      carryOut = carry;
      result   = operand;
      case (operation)
         LOADI: result = operand;
         LOAD, SWAP: result = selected;
         ADD, SUB, ADDI: {carryOut, result} = sum;
         ANDR: result = acc & selected;
         ORR:  result = acc | selected;
         XORR: result = acc ^ selected;
         ROR:  {result, carryOut} = {carry, acc};
         INP:  result = data_in;
         default: setsAcc = 1'b0;
      endcase
   end

   wire jumps = operation == JUMP
             || (operation == JZ && zero)
             || (operation == JC && carry);
   wire stores = operation == STORE || operation == SWAP;

   always @(posedge clk or posedge reset)
      if (reset) begin
         pc          <= 8'd0;
         acc         <= 8'd0;
         zero        <= 1'b1;
         carry       <= 1'b0;
         data_out    <= 8'd0;
         data_strobe <= 1'b0;
         r0          <= 8'd0;
         r1          <= 8'd0;
         r2          <= 8'd0;
         r3          <= 8'd0;
      end else begin
         pc <= jumps ? operand : pc + 8'd1;
         if (setsAcc) begin
            acc   <= result;
            zero  <= result == 8'd0;
            carry <= carryOut;
         end
         if (stores)
            case (operand[1:0])
               2'd0: r0 <= acc;
               2'd1: r1 <= acc;
               2'd2: r2 <= acc;
               2'd3: r3 <= acc;
            endcase
         data_strobe <= operation == OUTP;
         if (operation == OUTP)
            data_out <= acc;
      end
endmodule
