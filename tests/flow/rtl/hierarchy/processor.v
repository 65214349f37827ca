// A processor of 8 bits: program, register file and ALU are modules of their own.
module program_store(input [4:0] at, output reg [11:0] word);
  // Operation, destination, source, and for LOAD a value of four bits in the source's place.
  always @*
    case (at)
      5'd0: word = 12'h105;
      5'd1: word = 12'h113;
      5'd2: word = 12'h201;
      5'd3: word = 12'h321;
      5'd4: word = 12'h402;
      5'd5: word = 12'h512;
      5'd6: word = 12'h623;
      5'd7: word = 12'h230;
      5'd8: word = 12'h703;
      5'd9: word = 12'h312;
      default: word = {at[2:0], 1'b0, at[3:0], at[4:1]};
    endcase
endmodule

module register_file #(parameter WIDTH = 8, parameter INDEX = 2)
  (input clk, input reset, input write, input [INDEX-1:0] to, input [INDEX-1:0] from_a, input [INDEX-1:0] from_b,
   input [WIDTH-1:0] value, output [WIDTH-1:0] a, output [WIDTH-1:0] b);
  reg [WIDTH-1:0] words [0:(1 << INDEX)-1];
  integer i;
  always @(posedge clk)
    if (reset) for (i = 0; i < (1 << INDEX); i = i + 1) words[i] <= i;
    else if (write) words[to] <= value;
  assign a = words[from_a];
  assign b = words[from_b];
endmodule

module processor_alu #(parameter WIDTH = 8)
  (input [2:0] operation, input [WIDTH-1:0] a, input [WIDTH-1:0] b, output reg [WIDTH-1:0] y,
   output zero);
  always @*
    case (operation)
      3'd0: y = b;
      3'd1: y = b + 8'd1;
      3'd2: y = a + b;
      3'd3: y = a - b;
      3'd4: y = a & b;
      3'd5: y = a ^ b;
      3'd6: y = $signed(a) >>> b[1:0];
      3'd7: y = a < b ? a : a[3:0] * b[3:0];
    endcase
  assign zero = ~|y;
endmodule

module processor(input clk, input reset, input run, input [7:0] port_in, output reg [7:0] port_out,
                 output [4:0] place, output was_zero);
  reg [4:0] counter;
  reg flag;
  wire [11:0] word;
  wire [7:0] a, b, y;
  wire zero;
  wire [2:0] operation = word[10:8];
  program_store store(.at(counter), .word(word));
  register_file #(.WIDTH(8), .INDEX(2)) registers(.clk(clk), .reset(reset), .write(run & ~word[11]), .to(word[5:4]),
    .from_a(word[5:4]), .from_b(word[1:0]), .value(y), .a(a), .b(b));
  processor_alu alu(.operation(operation), .a(a),
    .b(operation == 3'd1 ? {4'd0, word[3:0]} ^ port_in : b), .y(y), .zero(zero));
  always @(posedge clk)
    if (reset) begin
      counter <= 5'd0;
      flag <= 1'b0;
      port_out <= 8'd0;
    end else if (run) begin
      counter <= flag && word[11] ? word[4:0] : counter + 5'd1;
      flag <= zero;
      if (word[11]) port_out <= a;
    end
  assign place = counter;
  assign was_zero = flag;
endmodule
