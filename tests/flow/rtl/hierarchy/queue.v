// A queue with a memory; both of its pointers are of one module.
module queue_pointer #(parameter BITS = 3) (input clk, input reset, input step,
                                            output reg [BITS:0] at);
  always @(posedge clk or posedge reset)
    if (reset) at <= 0;
    else if (step) at <= at + 1'b1;
endmodule

module queue_store #(parameter BITS = 3, parameter WIDTH = 8)
  (input clk, input write, input [BITS-1:0] to, input [WIDTH-1:0] value, input read,
   input [BITS-1:0] from, output reg [WIDTH-1:0] out);
  reg [WIDTH-1:0] words [0:(1 << BITS)-1];
  integer i;
  initial for (i = 0; i < (1 << BITS); i = i + 1) words[i] = 8'h50 + i;
  always @(posedge clk) begin
    if (write) words[to] <= value;
    if (read) out <= words[from];
  end
endmodule

module queue(input clk, input reset, input push, input pop, input [7:0] in, output [7:0] out,
             output full, output empty);
  wire [3:0] head, tail;
  wire do_push = push & ~full;
  wire do_pop = pop & ~empty;
  queue_pointer #(.BITS(3)) front(.clk(clk), .reset(reset), .step(do_pop), .at(head));
  queue_pointer #(.BITS(3)) back(.clk(clk), .reset(reset), .step(do_push), .at(tail));
  queue_store #(.BITS(3), .WIDTH(8)) store(.clk(clk), .write(do_push), .to(tail[2:0]), .value(in),
    .read(do_pop), .from(head[2:0]), .out(out));
  assign empty = head == tail;
  assign full = head == {~tail[3], tail[2:0]};
endmodule
